#include <vorl/Platform/detail/SystemError.h>

#include <vorl/Platform/Gdi.h>

inline namespace vorl {
namespace vorl_detail {

#if defined(_WIN32)

std::string LastErrorText() {
  const DWORD code = GetLastError();
  char* text = nullptr;
  const DWORD length = FormatMessageA(
      FORMAT_MESSAGE_ALLOCATE_BUFFER | FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS,
      nullptr, code, 0, reinterpret_cast<char*>(&text), 0, nullptr);
  if (length == 0) {
    return "error " + std::to_string(code);
  }
  std::string line(text, length);
  LocalFree(text);
  line.erase(line.find_last_not_of(" \r\n") + 1);
  return line;
}

#else

std::string LastErrorText() {
  const DWORD code = GetLastError();
  switch (code) {
    case ERROR_SUCCESS:
      return "no reason is known";
    case ERROR_INVALID_HANDLE:
      return "the handle is invalid";
    case ERROR_NOT_ENOUGH_MEMORY:
      return "there is not enough memory";
    case ERROR_INVALID_PARAMETER:
      return "a parameter is invalid";
    case ERROR_BUSY:
      return "the object is in use";
    default:
      return "error " + std::to_string(code);
  }
}

#endif

}  // namespace vorl_detail
}  // namespace vorl
