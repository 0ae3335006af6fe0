#include <vorl/Platform/soft/Rop3.h>

#include <vorl/Platform/soft/RowConverter.h>

#include <cstring>

inline namespace vorl {
namespace vorl_detail {
namespace {

unsigned IndexOf(DWORD rop) {
  return rop >> 16U & 0xFFU;
}

// The result for a source bit, in terms of the destination. The index's bit at
// 4 * pattern + 2 * source + destination is the result.
BitOperation OperationFor(unsigned index, unsigned sourceBit, std::uint32_t pattern) {
  const auto result = [&](unsigned destinationBit) {
    const auto bits = [&](unsigned patternBit) {
      return (index >> (4 * patternBit + 2 * sourceBit + destinationBit) & 1U) != 0 ? ~0U : 0U;
    };
    return (bits(1) & pattern) | (bits(0) & ~pattern);
  };
  return BitOperation{result(0) ^ result(1), result(0)};
}

}  // namespace

bool UsesSource(DWORD rop) {
  const unsigned index = IndexOf(rop);
  return ((index >> 2U ^ index) & 0x33U) != 0;
}

bool UsesPattern(DWORD rop) {
  const unsigned index = IndexOf(rop);
  return ((index >> 4U ^ index) & 0x0FU) != 0;
}

Rop3::Rop3(DWORD rop, std::uint32_t patternPixel)
    : m_on0(OperationFor(IndexOf(rop), 0, patternPixel)),
      m_on1(OperationFor(IndexOf(rop), 1, patternPixel)),
      m_isCopy(IndexOf(rop) == IndexOf(SRCCOPY)) {}

template <int kBytes>
void Rop3::CombineUnits(std::uint8_t* target, const std::uint8_t* source, int count) const {
  std::uint8_t keep0[kBytes];
  std::uint8_t flip0[kBytes];
  std::uint8_t keepChange[kBytes];
  std::uint8_t flipChange[kBytes];
  for (unsigned i = 0; i < kBytes; ++i) {
    keep0[i] = static_cast<std::uint8_t>(m_on0.keep >> (8 * i));
    flip0[i] = static_cast<std::uint8_t>(m_on0.flip >> (8 * i));
    keepChange[i] = static_cast<std::uint8_t>((m_on0.keep ^ m_on1.keep) >> (8 * i));
    flipChange[i] = static_cast<std::uint8_t>((m_on0.flip ^ m_on1.flip) >> (8 * i));
  }
  for (int x = 0; x < count; ++x, target += kBytes, source += kBytes) {
    for (int i = 0; i < kBytes; ++i) {
      const int keep = keep0[i] ^ (source[i] & keepChange[i]);
      const int flip = flip0[i] ^ (source[i] & flipChange[i]);
      target[i] = static_cast<std::uint8_t>((target[i] & keep) ^ flip);
    }
  }
}

void Rop3::CombineRow(std::uint8_t* row, int depth, int x, int count, const std::uint8_t* source) {
  if (m_isCopy) {
    PackRow(row, depth, x, count, source);
    return;
  }
  if (depth < 8) {
    m_units.resize(static_cast<std::size_t>(count));
    UnpackRow(row, depth, x, count, m_units.data());
    CombineUnits<1>(m_units.data(), source, count);
    PackRow(row, depth, x, count, m_units.data());
    return;
  }
  std::uint8_t* target = row + static_cast<std::ptrdiff_t>(x) * (depth / 8);
  switch (depth) {
    case 8:
      return CombineUnits<1>(target, source, count);
    case 16:
      return CombineUnits<2>(target, source, count);
    case 24:
      return CombineUnits<3>(target, source, count);
    default:
      return CombineUnits<4>(target, source, count);
  }
}

}  // namespace vorl_detail
}  // namespace vorl
