#include <vorl/Platform/soft/Utf8.h>

#include <cstddef>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr char32_t kReplacement = 0xFFFD;

// What a first byte tells about its sequence.
struct Lead {
  std::size_t length;  // 0 for a byte that starts no sequence
  char32_t bits;
  char32_t lowest;  // smaller characters have a shorter form
};

Lead LeadOf(unsigned char byte) {
  if (byte < 0x80) {
    return {1, byte, 0};
  }
  if ((byte & 0xE0U) == 0xC0) {
    return {2, byte & 0x1FU, 0x80};
  }
  if ((byte & 0xF0U) == 0xE0) {
    return {3, byte & 0x0FU, 0x800};
  }
  if ((byte & 0xF8U) == 0xF0) {
    return {4, byte & 0x07U, 0x10000};
  }
  return {0, 0, 0};
}

bool IsCharacter(char32_t code) {
  return code <= 0x10FFFF && (code < 0xD800 || code > 0xDFFF);
}

// The character at the start of the text and the number of its bytes.
struct Decoded {
  char32_t code;
  std::size_t length;
};

Decoded DecodeFirst(std::string_view text) {
  const Lead lead = LeadOf(static_cast<unsigned char>(text[0]));
  if (lead.length == 0 || lead.length > text.size()) {
    return {kReplacement, 1};
  }
  char32_t code = lead.bits;
  for (std::size_t i = 1; i < lead.length; ++i) {
    const auto byte = static_cast<unsigned char>(text[i]);
    if ((byte & 0xC0U) != 0x80) {
      return {kReplacement, 1};
    }
    code = (code << 6U) | (byte & 0x3FU);
  }
  if (code < lead.lowest || !IsCharacter(code)) {
    return {kReplacement, 1};
  }
  return {code, lead.length};
}

}  // namespace

std::u32string DecodeUtf8(std::string_view text) {
  std::u32string characters;
  characters.reserve(text.size());
  while (!text.empty()) {
    const Decoded decoded = DecodeFirst(text);
    characters.push_back(decoded.code);
    text.remove_prefix(decoded.length);
  }
  return characters;
}

}  // namespace vorl_detail
}  // namespace vorl
