#include <vorl/IO/detail/ItemFile.h>

#include <algorithm>
#include <limits>
#include <new>

#include <vorl/Platform/detail/File.h>

inline namespace vorl {
namespace vorl_detail {

namespace {

// Large enough to make the cost of small items vanish. Larger requests pass it by.
constexpr std::size_t kBufferSize = 64 * 1024;

bool FitsMemory(std::uint64_t size) {
  return size <= std::numeric_limits<std::size_t>::max();
}

}  // namespace

ItemFile::ItemFile(std::FILE* file) : m_buffer(new (std::nothrow) char[kBufferSize]), m_file(file) {
  if (m_buffer != nullptr) {
    std::setvbuf(m_file, m_buffer.get(), _IOFBF, kBufferSize);
  }
}

ItemFile::~ItemFile() {
  Close();
}

std::shared_ptr<ItemFile> ItemFile::Adopt(std::FILE* file) {
  if (file == nullptr) {
    return nullptr;
  }
  ItemFile* const itemFile = new (std::nothrow) ItemFile(file);
  if (itemFile == nullptr) {
    std::fclose(file);
    return nullptr;
  }
  try {
    return std::shared_ptr<ItemFile>(itemFile);  // deletes it when it throws
  } catch (const std::bad_alloc&) {
    return nullptr;
  }
}

std::shared_ptr<ItemFile> ItemFile::OpenForReading(const char* name) {
  std::shared_ptr<ItemFile> itemFile = Adopt(OpenFileForReading(name));
  if (itemFile != nullptr) {
    itemFile->m_remaining = FileSize(itemFile->m_file);
  }
  return itemFile;
}

std::shared_ptr<ItemFile> ItemFile::OpenForWriting(const char* name) {
  return Adopt(OpenFileForWriting(name));
}

bool ItemFile::Write(const void* data, std::uint64_t size) {
  if (m_file == nullptr || !FitsMemory(size)) {
    m_failed = true;
    return false;
  }
  const std::size_t count = static_cast<std::size_t>(size);
  const bool written = std::fwrite(data, 1, count, m_file) == count;
  m_failed = m_failed || !written;
  return written;
}

bool ItemFile::Flush() {
  m_failed = m_failed || (m_file != nullptr && std::fflush(m_file) != 0);
  return !m_failed;
}

bool ItemFile::Close() {
  if (m_file != nullptr) {
    m_failed = std::fclose(m_file) != 0 || m_failed;
    m_file = nullptr;
  }
  return !m_failed;
}

bool ItemFile::Read(void* data, std::uint64_t size) {
  if (m_file == nullptr || size > m_remaining || !FitsMemory(size)) {
    return false;
  }
  const std::size_t count = static_cast<std::size_t>(size);
  const bool read = std::fread(data, 1, count, m_file) == count;
  m_remaining = read ? m_remaining - size : 0;  // a file that shrank has ended
  return read;
}

int ItemFile::ReadByte() {
  unsigned char byte = 0;
  return Read(&byte, 1) ? byte : kEnd;
}

int ItemFile::PeekByte() {
  if (m_file == nullptr || m_remaining == 0) {
    return kEnd;
  }
  const int byte = std::getc(m_file);
  if (byte == EOF || std::ungetc(byte, m_file) == EOF) {
    return kEnd;
  }
  return byte;
}

}  // namespace vorl_detail
}  // namespace vorl
