#ifndef VORL_IO_DETAIL_LITTLEENDIAN_H
#define VORL_IO_DETAIL_LITTLEENDIAN_H

/// @file
/// Numbers as they stand in a file, whatever the machine's own byte order.

#include <bit>
#include <concepts>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <type_traits>

inline namespace vorl {
namespace vorl_detail {

static_assert(std::numeric_limits<float>::is_iec559 && sizeof(float) == 4);
static_assert(std::numeric_limits<double>::is_iec559 && sizeof(double) == 8);

/// The unsigned integer that has the bits of `Number`.
template <class Number>
using BitsOf = std::conditional_t<
    sizeof(Number) == 1, std::uint8_t,
    std::conditional_t<sizeof(Number) == 2, std::uint16_t,
                       std::conditional_t<sizeof(Number) == 4, std::uint32_t, std::uint64_t>>>;

/// Writes the `sizeof(Number)` bytes of `value`, the lowest first.
template <class Number>
void StoreLittleEndian(unsigned char* bytes, Number value) {
  const auto bits = std::bit_cast<BitsOf<Number>>(value);
  for (std::size_t i = 0; i < sizeof(Number); ++i) {
    bytes[i] = static_cast<unsigned char>(bits >> (8 * i));
  }
}

/// The number whose bytes were written by `StoreLittleEndian`.
template <class Number>
Number LoadLittleEndian(const unsigned char* bytes) {
  std::uint64_t bits = 0;
  for (std::size_t i = 0; i < sizeof(Number); ++i) {
    bits |= static_cast<std::uint64_t>(bytes[i]) << (8 * i);
  }
  return std::bit_cast<Number>(static_cast<BitsOf<Number>>(bits));
}

/// True when an array of `Element` in memory is, byte for byte, an array of `Number` in a file.
template <class Number, class Element>
inline constexpr bool kSameLayout = sizeof(Number) == sizeof(Element) &&
                                    (sizeof(Number) == 1 ||
                                     std::endian::native == std::endian::little);

/// Elements converted at a time where an array has another layout in memory than in a file.
inline constexpr int kConversionChunk = 2048;

/// True when `Number` can hold `value`.
template <class Number, class Element>
constexpr bool Fits(Element value) {
  if constexpr (std::integral<Number> && sizeof(Element) > sizeof(Number)) {
    return value >= std::numeric_limits<Number>::min() &&
           value <= std::numeric_limits<Number>::max();
  }
  return true;
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
