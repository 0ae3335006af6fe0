#include <vorl/Platform/soft/Painter.h>

#include <algorithm>
#include <cstring>

inline namespace vorl {
namespace vorl_detail {
namespace {

// What the code minus 1 says, bit by bit: bit 0 the result for pen 0 and destination 0, bit 1 for
// pen 0 and destination 1, bit 2 for pen 1 and destination 0, bit 3 for pen 1 and destination 1.
std::uint32_t ResultBits(unsigned code, unsigned bit) {
  return (code >> bit & 1U) != 0 ? ~0U : 0U;
}

// A pixel's bits repeated over a byte, for depths below 8.
std::uint8_t ByteOf(std::uint32_t bits, int depth) {
  return depth == 1   ? static_cast<std::uint8_t>((bits & 1U) * 0xFFU)
         : depth == 4 ? static_cast<std::uint8_t>((bits & 0xFU) * 0x11U)
                      : static_cast<std::uint8_t>(bits);
}

void ApplyToByte(std::uint8_t* byte, unsigned mask, unsigned keep, unsigned flip) {
  *byte = static_cast<std::uint8_t>((*byte & (keep | ~mask)) ^ (flip & mask));
}

// Pixels of at most a byte: the columns' bits run from bit `begin` up to `end` of the row, counted
// from the highest bit of its first byte.
void ApplyToBits(std::uint8_t* row, std::int64_t begin, std::int64_t end, std::uint8_t keep,
                 std::uint8_t flip) {
  std::uint8_t* first = row + begin / 8;
  std::uint8_t* last = row + end / 8;
  const unsigned firstMask = 0xFFU >> static_cast<unsigned>(begin % 8);
  const unsigned lastMask = 0xFFU & ~(0xFFU >> static_cast<unsigned>(end % 8));
  if (first == last) {
    ApplyToByte(first, firstMask & lastMask, keep, flip);
    return;
  }
  if (begin % 8 != 0) {
    ApplyToByte(first++, firstMask, keep, flip);
  }
  if (keep == 0) {
    std::memset(first, flip, static_cast<std::size_t>(last - first));
  } else {
    for (; first != last; ++first) {
      *first = static_cast<std::uint8_t>((*first & keep) ^ flip);
    }
  }
  if (end % 8 != 0) {
    ApplyToByte(last, lastMask, keep, flip);
  }
}

// Writes a pixel once and copies what is there, twice as much each time.
void FillWith(std::uint8_t* pixels, std::size_t bytes, const std::uint8_t* pixel,
              std::size_t pixelBytes) {
  if (bytes == 0) {
    return;
  }
  std::memcpy(pixels, pixel, pixelBytes);
  for (std::size_t done = pixelBytes; done < bytes; done *= 2) {
    std::memcpy(pixels + done, pixels, std::min(done, bytes - done));
  }
}

// Pixels of several bytes.
template <int kBytes>
void ApplyToBytes(std::uint8_t* pixels, std::int64_t count, BitOperation operation) {
  std::uint8_t keep[kBytes];
  std::uint8_t flip[kBytes];
  for (unsigned i = 0; i < kBytes; ++i) {
    keep[i] = static_cast<std::uint8_t>(operation.keep >> (8 * i));
    flip[i] = static_cast<std::uint8_t>(operation.flip >> (8 * i));
  }
  if (std::all_of(keep, keep + kBytes, [](std::uint8_t mask) { return mask == 0; })) {
    FillWith(pixels, static_cast<std::size_t>(count) * kBytes, flip, kBytes);
    return;
  }
  for (std::int64_t x = 0; x < count; ++x, pixels += kBytes) {
    for (int i = 0; i < kBytes; ++i) {
      pixels[i] = static_cast<std::uint8_t>((pixels[i] & keep[i]) ^ flip[i]);
    }
  }
}

}  // namespace

BitOperation Rop2Operation(int rop2, std::uint32_t pixel) {
  const auto code = static_cast<unsigned>(rop2 - 1);
  const std::uint32_t on0 = (ResultBits(code, 2) & pixel) | (ResultBits(code, 0) & ~pixel);
  const std::uint32_t on1 = (ResultBits(code, 3) & pixel) | (ResultBits(code, 1) & ~pixel);
  return BitOperation{on0 ^ on1, on0};
}

void ApplyToRow(std::uint8_t* row, int depth, int x0, int x1, BitOperation operation) {
  const std::int64_t count = static_cast<std::int64_t>(x1) - x0;
  std::uint8_t* pixels = row + static_cast<std::ptrdiff_t>(x0) * (depth / 8);
  switch (depth) {
    case 16:
      return ApplyToBytes<2>(pixels, count, operation);
    case 24:
      return ApplyToBytes<3>(pixels, count, operation);
    case 32:
      return ApplyToBytes<4>(pixels, count, operation);
    default:
      return ApplyToBits(row, static_cast<std::int64_t>(x0) * depth,
                         static_cast<std::int64_t>(x1) * depth, ByteOf(operation.keep, depth),
                         ByteOf(operation.flip, depth));
  }
}

Painter::Painter(const DeviceContext& dc, COLORREF colour)
    : Painter(dc, Rop2Operation(dc.state.rop2, dc.PixelOf(colour))) {}

Painter::Painter(const DeviceContext& dc, BitOperation operation)
    : m_dc(dc), m_operation(operation) {}

void Painter::Point(int x, int y) const {
  if (m_dc.Visible().Contains(x, y)) {
    ApplyToRow(m_dc.Target().Row(y), m_dc.Target().format.depth, x, x + 1, m_operation);
  }
}

void Painter::Span(int y, int x0, int x1) const {
  for (const pixman_box32_t& box : m_dc.Visible().Boxes()) {
    if (box.y1 > y) {
      return;  // boxes are ordered from top to bottom
    }
    const int begin = std::max(x0, box.x1);
    const int end = std::min(x1, box.x2);
    if (y < box.y2 && begin < end) {
      ApplyToRow(m_dc.Target().Row(y), m_dc.Target().format.depth, begin, end, m_operation);
    }
  }
}

void Painter::Fill(const RECT& rect) const {
  const Surface& target = m_dc.Target();
  for (const pixman_box32_t& box : m_dc.Visible().Boxes()) {
    const RECT part = Intersection(rect, RECT{box.x1, box.y1, box.x2, box.y2});
    for (int y = part.top; y < part.bottom; ++y) {
      ApplyToRow(target.Row(y), target.format.depth, part.left, part.right, m_operation);
    }
  }
}

void Painter::Fill(const Region& region) const {
  for (const pixman_box32_t& box : region.Boxes()) {
    Fill(RECT{box.x1, box.y1, box.x2, box.y2});
  }
}

}  // namespace vorl_detail
}  // namespace vorl
