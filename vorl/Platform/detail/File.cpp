// Files beyond 2 GiB also where a plain offset has 32 bits; stands before every include.
#define _FILE_OFFSET_BITS 64

#include <vorl/Platform/detail/File.h>

#include <sys/stat.h>
#include <sys/types.h>

#include <algorithm>
#include <cerrno>

#if defined(_WIN32)
#include <io.h>
#else
#include <fcntl.h>
#include <sys/uio.h>
#include <unistd.h>
#endif

inline namespace vorl {
namespace vorl_detail {

namespace {

#if defined(_WIN32)
using FileFacts = struct _stat64;

bool AskFacts(std::FILE* file, FileFacts& facts) {
  return _fstat64(_fileno(file), &facts) == 0;
}
#else
using FileFacts = struct stat;

bool AskFacts(std::FILE* file, FileFacts& facts) {
  return fstat(fileno(file), &facts) == 0;
}

// Opens without waiting: an open of a pipe would otherwise last until its other end is opened.
std::FILE* OpenWithoutWaiting(const char* name, int flags, const char* mode) {
  const int descriptor = open(name, flags | O_NONBLOCK | O_NOCTTY | O_CLOEXEC, 0666);
  if (descriptor < 0) {
    return nullptr;
  }
  std::FILE* const file = fdopen(descriptor, mode);
  if (file == nullptr) {
    close(descriptor);
    return nullptr;
  }
  fcntl(descriptor, F_SETFL, fcntl(descriptor, F_GETFL) & ~O_NONBLOCK);
  return file;
}
#endif

/// Closes the file unless it is of one of the two kinds.
std::FILE* KeepIfOfKind(std::FILE* file, unsigned int kind, unsigned int otherKind) {
  if (file == nullptr) {
    return nullptr;
  }
  FileFacts facts{};
  if (AskFacts(file, facts)) {
    const unsigned int actual = facts.st_mode & static_cast<unsigned int>(S_IFMT);
    if (actual == kind || actual == otherKind) {
      return file;
    }
  }
  std::fclose(file);
  return nullptr;
}

}  // namespace

std::FILE* OpenFileForReading(const char* name) {
#if defined(_WIN32)
  std::FILE* const file = std::fopen(name, "rb");
#else
  std::FILE* const file = OpenWithoutWaiting(name, O_RDONLY, "rb");
#endif
  return KeepIfOfKind(file, S_IFREG, S_IFREG);
}

std::FILE* OpenFileForWriting(const char* name) {
#if defined(_WIN32)
  std::FILE* const file = std::fopen(name, "wb");
#else
  std::FILE* const file = OpenWithoutWaiting(name, O_WRONLY | O_CREAT | O_TRUNC, "wb");
#endif
  return KeepIfOfKind(file, S_IFREG, S_IFCHR);
}

std::uint64_t FileSize(std::FILE* file) {
  FileFacts facts{};
  return AskFacts(file, facts) && facts.st_size > 0 ? static_cast<std::uint64_t>(facts.st_size) : 0;
}

bool SeekFile(std::FILE* file, std::uint64_t position) {
#if defined(_WIN32)
  return _fseeki64(file, static_cast<std::int64_t>(position), SEEK_SET) == 0;
#else
  return fseeko(file, static_cast<off_t>(position), SEEK_SET) == 0;
#endif
}

#if defined(_WIN32)
bool ReadFileRows(std::FILE* file, std::uint64_t position, unsigned char* first,
                  std::ptrdiff_t step, std::size_t rowBytes, std::size_t rows) {
  if (!SeekFile(file, position)) {
    return false;
  }
  for (std::size_t i = 0; i < rows; ++i) {
    if (std::fread(first + step * static_cast<std::ptrdiff_t>(i), 1, rowBytes, file) != rowBytes) {
      return false;
    }
  }
  return true;
}

bool WriteFileRows(std::FILE* file, const unsigned char* first, std::ptrdiff_t step,
                   std::size_t rowBytes, std::size_t rows) {
  for (std::size_t i = 0; i < rows; ++i) {
    const unsigned char* const row = first + step * static_cast<std::ptrdiff_t>(i);
    if (std::fwrite(row, 1, rowBytes, file) != rowBytes) {
      return false;
    }
  }
  return true;
}
#else
namespace {

/// Moves rows by calls of the system that take many pieces of memory at once, and that may stop
/// anywhere. `move` gets the pieces and how many bytes have been moved, and returns how many more
/// are.
template <class Move>
bool MoveRows(unsigned char* first, std::ptrdiff_t step, std::size_t rowBytes, std::size_t rows,
              Move move) {
  constexpr std::size_t kAtOnce = 64;
  std::uint64_t moved = 0;
  std::size_t row = 0;
  std::size_t begun = 0;  // bytes of that row
  while (row < rows && rowBytes != 0) {
    iovec parts[kAtOnce];
    const std::size_t count = std::min(kAtOnce, rows - row);
    for (std::size_t i = 0; i < count; ++i) {
      const std::size_t skipped = i == 0 ? begun : 0;
      parts[i].iov_base = first + step * static_cast<std::ptrdiff_t>(row + i) + skipped;
      parts[i].iov_len = rowBytes - skipped;
    }
    const ssize_t bytes = move(parts, static_cast<int>(count), moved);
    if (bytes < 0 && errno == EINTR) {
      continue;
    }
    if (bytes <= 0) {
      return false;
    }
    moved += static_cast<std::uint64_t>(bytes);
    begun += static_cast<std::size_t>(bytes);
    row += begun / rowBytes;
    begun %= rowBytes;
  }
  return true;
}

}  // namespace

bool ReadFileRows(std::FILE* file, std::uint64_t position, unsigned char* first,
                  std::ptrdiff_t step, std::size_t rowBytes, std::size_t rows) {
  return MoveRows(first, step, rowBytes, rows, [&](iovec* parts, int count, std::uint64_t moved) {
    return preadv(fileno(file), parts, count, static_cast<off_t>(position + moved));
  });
}

// Without a position, which not every device has.
bool WriteFileRows(std::FILE* file, const unsigned char* first, std::ptrdiff_t step,
                   std::size_t rowBytes, std::size_t rows) {
  return MoveRows(
      const_cast<unsigned char*>(first), step, rowBytes, rows,
      [&](iovec* parts, int count, std::uint64_t) { return writev(fileno(file), parts, count); });
}
#endif

}  // namespace vorl_detail
}  // namespace vorl
