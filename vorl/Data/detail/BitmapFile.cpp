#include <vorl/Data/detail/BitmapFile.h>

#include <filesystem>
#include <new>
#include <system_error>
#include <utility>

#include <vorl/Platform/detail/File.h>

inline namespace vorl {
namespace vorl_detail {

namespace fs = std::filesystem;

namespace {

bool IsDevice(const char* path) {
  std::error_code error;
  return fs::is_character_file(path, error);
}

}  // namespace

void RowBuffer::Attach(std::FILE* file) {
  constexpr std::size_t size = 131072;
  m_bytes.reset(new (std::nothrow) char[size]);
  if (m_bytes != nullptr) {
    std::setvbuf(file, m_bytes.get(), _IOFBF, size);
  }
}

bool FileExists(const char* path) {
  std::error_code error;
  return fs::exists(path, error);
}

bool MakeRoomForFile(const char* path) {
  std::error_code error;
  if (IsDevice(path)) {
    return true;
  }
  return fs::is_regular_file(path, error) && fs::remove(path, error);
}

BitmapFile::BitmapFile(const char* path) : m_file(nullptr) {
  try {
    m_path = path;
    m_file = OpenFileForWriting(path);
    if (m_file != nullptr) {
      m_buffer.Attach(m_file);
    }
  } catch (const std::bad_alloc&) {
    m_file = nullptr;  // a file whose name is not known could not be removed again
  }
}

BitmapFile::~BitmapFile() {
  if (m_file != nullptr) {
    std::fclose(m_file);
    std::error_code error;
    if (fs::is_regular_file(m_path, error)) {
      fs::remove(m_path, error);
    }
  }
}

bool BitmapFile::Write(const void* bytes, std::size_t count) {
  return count == 0 || std::fwrite(bytes, 1, count, m_file) == count;
}

bool BitmapFile::WriteRows(const unsigned char* first, std::ptrdiff_t step, std::size_t rowBytes,
                           std::size_t rows) {
  return WriteFileRows(m_file, first, step, rowBytes, rows);
}

bool BitmapFile::Flush() {
  return std::fflush(m_file) == 0;
}

bool BitmapFile::Finish() {
  if (!Flush()) {
    return false;
  }
  return std::fclose(std::exchange(m_file, nullptr)) == 0;
}

}  // namespace vorl_detail
}  // namespace vorl
