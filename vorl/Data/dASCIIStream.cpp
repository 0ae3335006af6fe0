#include <vorl/Data/dASCIIStream.h>

#include <algorithm>
#include <cstring>
#include <filesystem>
#include <limits>
#include <new>
#include <system_error>

#if defined(_WIN32)
#include <io.h>
#else
#include <unistd.h>
#endif

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Platform/detail/File.h>

inline namespace vorl {

namespace {

namespace fs = std::filesystem;

constexpr std::size_t kBufferSlack = 8;  // zero bytes behind the last character

bool HasReadPermission(const char* fileName) {
#if defined(_WIN32)
  constexpr int kRead = 4;
  return _access(fileName, kRead) == 0;
#else
  return access(fileName, R_OK) == 0;
#endif
}

bool Exists(const char* fileName) {
  std::error_code error;
  return fs::exists(fileName, error);
}

std::shared_ptr<std::FILE> OpenFile(const char* fileName) {
  std::FILE* file = vorl_detail::OpenFileForReading(fileName);
  if (file == nullptr) {
    return nullptr;
  }
  std::setvbuf(file, nullptr, _IONBF, 0);  // the stream has a buffer of its own
  return std::shared_ptr<std::FILE>(file, &std::fclose);
}

// Reads up to `count` bytes from a position; the number of bytes read.
std::size_t ReadAt(std::FILE* file, std::uint64_t position, char* out, std::size_t count) {
  if (position > static_cast<std::uint64_t>(std::numeric_limits<std::int64_t>::max())) {
    return 0;
  }
#if defined(_WIN32)
  const bool found = _fseeki64(file, static_cast<std::int64_t>(position), SEEK_SET) == 0;
#else
  const bool found = fseeko(file, static_cast<off_t>(position), SEEK_SET) == 0;
#endif
  return found ? std::fread(out, 1, count, file) : 0;
}

std::shared_ptr<char[]> AllocateBuffer(unsigned long size) {
  constexpr std::uint64_t kMostBytes =
      std::min<std::uint64_t>(std::numeric_limits<std::uint32_t>::max(),
                              std::numeric_limits<std::size_t>::max() - kBufferSlack);
  if (size > kMostBytes) {
    return nullptr;
  }
  char* buffer = new (std::nothrow) char[std::size_t{size} + kBufferSlack];
  return std::shared_ptr<char[]>(buffer);
}

}  // namespace

VORL_REGISTER_CLASS(dASCIIStreamIn, BaseClass);

dASCIIStreamIn::dASCIIStreamIn() = default;

dASCIIStreamIn::dASCIIStreamIn(const char* text) {
  Init(text);
}

dASCIIStreamIn::dASCIIStreamIn(const char* fileName, unsigned long bufferSize) {
  Init(fileName, bufferSize);
}

dASCIIStreamIn::dASCIIStreamIn(const dASCIIStreamIn& source) = default;
dASCIIStreamIn& dASCIIStreamIn::operator=(const dASCIIStreamIn& source) = default;
dASCIIStreamIn::~dASCIIStreamIn() = default;

void dASCIIStreamIn::Reset() {
  m_file.reset();
  m_ownedBuffer.reset();
  m_bufferOffset = 0;
  m_bufferCapacity = 0;
  m_bufferFill = 0;
  m_buffer = nullptr;
  m_bufferEnd = nullptr;
  m_current = nullptr;
}

bool dASCIIStreamIn::IsValid() {
  return m_file != nullptr && m_buffer != nullptr;
}

const dStatus& dASCIIStreamIn::GetStatus() const {
  return m_status;
}

bool dASCIIStreamIn::Init(const char* text) {
  LogContext context("dASCIIStreamIn::Init", __FILE__, __LINE__, true);
  Reset();
  if (text == nullptr) {
    m_status.Set(false, "given string is a 'NULL' pointer");
    context.Status(__LINE__, m_status);
    return false;
  }
  m_buffer = text;
  m_bufferCapacity = std::strlen(text) + 1;
  m_bufferFill = m_bufferCapacity;
  m_status = true;
  return true;
}

bool dASCIIStreamIn::Init(const char* fileName, unsigned long bufferSize) {
  LogContext context("dASCIIStreamIn::Init", __FILE__, __LINE__, true);
  Reset();
  if (fileName == nullptr || bufferSize == 0) {
    m_status.Set(false, "invalid parameter");
    context.Status(__LINE__, m_status);
    return false;
  }
  if (!CheckFile(fileName)) {
    return false;
  }
  m_file = OpenFile(fileName);
  if (m_file == nullptr) {
    m_status.Set(false, "can't to open '%s'", fileName);
    context.Status(__LINE__, m_status);
    return false;
  }
  m_ownedBuffer = AllocateBuffer(bufferSize);
  if (m_ownedBuffer == nullptr) {
    Reset();
    m_status.Set(false, "dASCIIStreamIn::Init()  out of memory(%llu bytes requested)",
                 static_cast<unsigned long long>(bufferSize) + kBufferSlack);
    context.Status(__LINE__, m_status);
    return false;
  }
  m_bufferCapacity = bufferSize;
  m_buffer = m_ownedBuffer.get();
  m_current = m_buffer;
  m_bufferEnd = m_buffer + bufferSize;
  m_status = true;
  return FillBuffer(0);
}

bool dASCIIStreamIn::CheckFile(const char* fileName) {
  LogContext context("dASCIIStreamIn::CheckFile", __FILE__, __LINE__, true);
  if (fileName == nullptr || *fileName == '\0') {
    m_status.Set(false, "given file name is 'NULL' or empty");
  } else if (!Exists(fileName)) {
    m_status.Set(false, "no such file: '%s'", fileName);
  } else if (!HasReadPermission(fileName)) {
    m_status.Set(false, "no read permission for '%s'", fileName);
  } else {
    return true;
  }
  context.Status(__LINE__, m_status);
  return false;
}

bool dASCIIStreamIn::FillBuffer(unsigned long position) {
  return FillFrom(position);
}

bool dASCIIStreamIn::FillFrom(std::uint64_t position) {
  LogContext context("dASCIIStreamIn::FillBuffer", __FILE__, __LINE__, true);
  if (m_buffer == nullptr) {
    m_status.Set(false, "FillBuffer(): buffer not initialized");
    context.Status(__LINE__, m_status);
    return false;
  }
  if (m_file == nullptr) {
    m_status.Set(false, "FillBuffer(): source isn't a file");
    context.Status(__LINE__, m_status);
    return false;
  }
  char* buffer = m_ownedBuffer.get();
  m_bufferOffset = position;
  m_bufferFill = ReadAt(m_file.get(), position, buffer, m_bufferCapacity);
  std::fill_n(buffer + m_bufferFill, kBufferSlack, '\0');
  m_bufferEnd = buffer + m_bufferFill;
  m_current = buffer;
  return m_bufferFill != 0;
}

bool dASCIIStreamIn::FillBuffer(unsigned long position, char* ch) {
  return FillFrom(position) ? Take(ch) : TakeNothing(ch);
}

bool dASCIIStreamIn::NextChar(char* ch) {
  if (ch == nullptr) {
    LogContext context("dASCIIStreamIn::NextChar", __FILE__, __LINE__, true);
    m_status.Set(false, "invalid parameter");
    context.Status(__LINE__, m_status);
    return false;
  }
  // A string has no end here: it does not serve reading character by character.
  const bool mustFill = m_bufferEnd == nullptr || m_current == m_bufferEnd;
  // The next stretch may begin behind what a position of the interface can say.
  return !mustFill || FillFrom(m_bufferOffset + m_bufferFill) ? Take(ch) : TakeNothing(ch);
}

bool dASCIIStreamIn::Take(char* ch) {
  const char next = *m_current++;
  if (ch != nullptr) {
    *ch = next;
  }
  return true;
}

bool dASCIIStreamIn::TakeNothing(char* ch) {
  if (ch != nullptr) {
    *ch = '\0';
  }
  return false;
}

bool dASCIIStreamIn::GetChar(char* ch) const {
  if (ch == nullptr) {
    return false;
  }
  if (m_current == nullptr) {
    *ch = '\0';
    return false;
  }
  *ch = *m_current;
  return true;
}

bool dASCIIStreamIn::Holds(unsigned long position) const {
  return position >= m_bufferOffset && position - m_bufferOffset < m_bufferFill;
}

bool dASCIIStreamIn::SetPos(unsigned long position) {
  if (Holds(position)) {
    m_current = m_buffer + (position - m_bufferOffset);
    return true;
  }
  return FillBuffer(position);
}

bool dASCIIStreamIn::GetString(unsigned long position, unsigned long length, char* out) {
  LogContext context("dASCIIStreamIn::GetString", __FILE__, __LINE__, true);
  if (out == nullptr) {
    m_status.Set(false, "invalid parameter");
    context.Status(__LINE__, m_status);
    return false;
  }
  // What ends exactly at the buffer's end is read from the file.
  if (Holds(position) && length < m_bufferFill - (position - m_bufferOffset)) {
    std::memcpy(out, m_buffer + (position - m_bufferOffset), length);
    out[length] = '\0';
    return true;
  }
  if (m_file != nullptr) {
    const std::size_t count = ReadAt(m_file.get(), position, out, length);
    out[count] = '\0';
    return count == length;
  }
  m_status.Set(false, "GetString() invalid string pos: %lu(length %lu)", position, length);
  context.Status(__LINE__, m_status);
  *out = '\0';
  return false;
}

}  // namespace vorl
