#include <vorl/Common/detail/FormatText.h>

#include <cstddef>
#include <cstdio>

inline namespace vorl {
namespace vorl_detail {

void FormatText(FormatBuffer& buffer, const char* format, std::va_list arguments) {
  buffer[0] = '\0';
  if (format == nullptr || *format == '\0') {
    return;
  }
  if (std::vsnprintf(buffer.data(), buffer.size(), format, arguments) < 0) {
    buffer[0] = '\0';
  }
}

void FormatTextWithoutArguments(FormatBuffer& buffer, const char* format) {
  std::size_t length = 0;
  if (format != nullptr) {
    for (const char* c = format; *c != '\0' && length + 1 < buffer.size(); ++c) {
      if (c[0] == '%' && c[1] == '%') {
        ++c;
      }
      buffer[length++] = *c;
    }
  }
  buffer[length] = '\0';
}

}  // namespace vorl_detail
}  // namespace vorl
