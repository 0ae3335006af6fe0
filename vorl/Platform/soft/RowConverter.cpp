#include <vorl/Platform/soft/RowConverter.h>

#include <algorithm>
#include <cstring>

inline namespace vorl {
namespace vorl_detail {
namespace {

constexpr std::size_t kKnownSize = 4096;

template <int kBytes>
std::uint32_t Load(const std::uint8_t* unit) {
  std::uint32_t pixel = 0;
  for (unsigned i = 0; i < kBytes; ++i) {
    pixel |= static_cast<std::uint32_t>(unit[i]) << (8 * i);
  }
  return pixel;
}

template <int kBytes>
void Store(std::uint8_t* unit, std::uint32_t pixel) {
  for (unsigned i = 0; i < kBytes; ++i) {
    unit[i] = static_cast<std::uint8_t>(pixel >> (8 * i));
  }
}

// The units of a byte, for each value that it can have.
template <int kDepth>
constexpr auto MakeUnitsOfByte() {
  constexpr unsigned kCount = 8 / kDepth;
  std::array<std::array<std::uint8_t, kCount>, 256> table{};
  for (unsigned byte = 0; byte < 256; ++byte) {
    for (unsigned i = 0; i < kCount; ++i) {
      table[byte][i] = byte >> (8 - kDepth * (i + 1)) & ((1U << kDepth) - 1U);
    }
  }
  return table;
}

// Whole bytes at once, what is before and behind them pixel by pixel.
template <int kDepth>
void UnpackSmall(const std::uint8_t* row, int x, int count, std::uint8_t* units) {
  static constexpr auto kUnits = MakeUnitsOfByte<kDepth>();
  constexpr int kPerByte = 8 / kDepth;
  int i = 0;
  for (; i < count && (x + i) % kPerByte != 0; ++i) {
    units[i] = static_cast<std::uint8_t>(ReadPixel(row, x + i, kDepth));
  }
  for (; count - i >= kPerByte; i += kPerByte) {
    std::memcpy(units + i, kUnits[row[(x + i) / kPerByte]].data(), kPerByte);
  }
  for (; i < count; ++i) {
    units[i] = static_cast<std::uint8_t>(ReadPixel(row, x + i, kDepth));
  }
}

template <int kDepth>
void PackSmall(std::uint8_t* row, int x, int count, const std::uint8_t* units) {
  constexpr int kPerByte = 8 / kDepth;
  int i = 0;
  for (; i < count && (x + i) % kPerByte != 0; ++i) {
    WritePixel(row, x + i, kDepth, units[i]);
  }
  for (; count - i >= kPerByte; i += kPerByte) {
    unsigned byte = 0;
    for (int k = 0; k < kPerByte; ++k) {
      byte = byte << kDepth | (units[i + k] & ((1U << kDepth) - 1U));
    }
    row[(x + i) / kPerByte] = static_cast<std::uint8_t>(byte);
  }
  for (; i < count; ++i) {
    WritePixel(row, x + i, kDepth, units[i]);
  }
}

}  // namespace

void UnpackRow(const std::uint8_t* row, int depth, int x, int count, std::uint8_t* units) {
  if (depth >= 8) {
    const int bytes = depth / 8;
    std::memcpy(units, row + static_cast<std::ptrdiff_t>(x) * bytes,
                static_cast<std::size_t>(count) * static_cast<std::size_t>(bytes));
    return;
  }
  return depth == 1 ? UnpackSmall<1>(row, x, count, units) : UnpackSmall<4>(row, x, count, units);
}

void PackRow(std::uint8_t* row, int depth, int x, int count, const std::uint8_t* units) {
  if (depth >= 8) {
    const int bytes = depth / 8;
    std::memcpy(row + static_cast<std::ptrdiff_t>(x) * bytes, units,
                static_cast<std::size_t>(count) * static_cast<std::size_t>(bytes));
    return;
  }
  return depth == 1 ? PackSmall<1>(row, x, count, units) : PackSmall<4>(row, x, count, units);
}

RowConverter::RowConverter(const PixelFormat& source, const PixelFormat& target,
                           const MonoColours& colours)
    : m_source(source), m_target(target), m_white(colours.white) {
  if (SamePixels(source, target)) {
    return;
  }
  if (source.depth <= 8) {
    ChooseForIndices(colours);
    return;
  }
  m_convert = ChooseForPixels();
}

void RowConverter::ChooseForIndices(const MonoColours& colours) {
  for (std::uint32_t i = 0; i < m_table.size(); ++i) {
    m_table[i] = m_source.monochrome   ? (i == 0 ? colours.text : colours.background)
                 : m_target.monochrome ? static_cast<std::uint32_t>(i == m_white)
                                       : NearestPixel(m_target, ColourOf(m_source, i));
  }
  switch (m_target.BytesPerUnit()) {
    case 1:
      m_convert = &RowConverter::ConvertIndices<1>;
      return;
    case 2:
      m_convert = &RowConverter::ConvertIndices<2>;
      return;
    case 3:
      m_convert = &RowConverter::ConvertIndices<3>;
      return;
    default:
      m_pixels = PixelTable(m_table);
      m_convert = &RowConverter::ConvertIndicesTo32;
  }
}

RowConverter::Function RowConverter::ChooseForPixels() const {
  static constexpr Function kFunctions[3][4] = {
      {&RowConverter::ConvertPixels<2, 1>, &RowConverter::ConvertPixels<2, 2>,
       &RowConverter::ConvertPixels<2, 3>, &RowConverter::ConvertPixels<2, 4>},
      {&RowConverter::ConvertPixels<3, 1>, &RowConverter::ConvertPixels<3, 2>,
       &RowConverter::ConvertPixels<3, 3>, &RowConverter::ConvertPixels<3, 4>},
      {&RowConverter::ConvertPixels<4, 1>, &RowConverter::ConvertPixels<4, 2>,
       &RowConverter::ConvertPixels<4, 3>, &RowConverter::ConvertPixels<4, 4>}};
  if (m_source.HasDefaultMasks() && m_target.HasDefaultMasks()) {
    if (m_source.depth == 24 && m_target.depth == 32) {
      return &RowConverter::Convert24To32;
    }
    if (m_source.depth == 32 && m_target.depth == 24) {
      return &RowConverter::Convert32To24;
    }
  }
  return kFunctions[m_source.BytesPerUnit() - 2][m_target.BytesPerUnit() - 1];
}

void RowConverter::Convert(const std::uint8_t* source, std::uint8_t* target, int count) {
  (this->*m_convert)(source, target, count);
}

std::uint32_t RowConverter::Translate(std::uint32_t pixel) {
  if (m_target.monochrome) {
    return pixel == m_white ? 1 : 0;
  }
  if (m_target.depth > 8) {
    return NearestPixel(m_target, ColourOf(m_source, pixel));
  }
  if (m_known.empty()) {
    m_known.resize(kKnownSize);
  }
  Known& known = m_known[(pixel * 2654435761U) >> 20U];
  if (!known.valid || known.pixel != pixel) {
    known = Known{pixel, NearestPixel(m_target, ColourOf(m_source, pixel)), true};
  }
  return known.result;
}

template <int kBytes>
void RowConverter::ConvertIndices(const std::uint8_t* source, std::uint8_t* target, int count) {
  for (int i = 0; i < count; ++i) {
    Store<kBytes>(target, m_table[source[i]]);
    target += kBytes;
  }
}

void RowConverter::ConvertIndicesTo32(const std::uint8_t* source, std::uint8_t* target, int count) {
  ActiveStretchKernels().mapTo32(source, target, static_cast<std::size_t>(count), m_pixels);
}

template <int kSourceBytes, int kTargetBytes>
void RowConverter::ConvertPixels(const std::uint8_t* source, std::uint8_t* target, int count) {
  for (int i = 0; i < count; ++i) {
    Store<kTargetBytes>(target, Translate(Load<kSourceBytes>(source)));
    source += kSourceBytes;
    target += kTargetBytes;
  }
}

void RowConverter::Convert24To32(const std::uint8_t* source, std::uint8_t* target, int count) {
  for (int i = 0; i < count; ++i, source += 3, target += 4) {
    Store<4>(target, Load<3>(source));
  }
}

void RowConverter::Convert32To24(const std::uint8_t* source, std::uint8_t* target, int count) {
  for (int i = 0; i < count; ++i, source += 4, target += 3) {
    Store<3>(target, Load<4>(source));
  }
}

}  // namespace vorl_detail
}  // namespace vorl
