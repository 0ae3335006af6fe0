#include <vorl/Common/detail/FormatText.h>

#include <cstddef>
#include <cstdio>
#include <exception>

#include <vorl/Platform/detail/KillShield.h>

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

void StoreText(std::string& text, std::string_view value) noexcept {
  const KillShield shield;
  try {
    text = value;
  } catch (const std::exception&) {
    text.clear();
  }
}

void AppendText(std::string& text, std::string_view addition) noexcept {
  const KillShield shield;
  try {
    text += addition;
  } catch (const std::exception&) {
    return;
  }
}

}  // namespace vorl_detail
}  // namespace vorl
