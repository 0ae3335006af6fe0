#ifndef VORL_PLATFORM_SOFT_PAINTER_H
#define VORL_PLATFORM_SOFT_PAINTER_H

#include <vorl/Platform/soft/DeviceContext.h>

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// Any of the 16 binary raster operations with a fixed pen colour: each bit of the destination is
/// kept, inverted, cleared or set, which is `(destination & keep) ^ flip`.
struct BitOperation {
  std::uint32_t keep;
  std::uint32_t flip;
};

/// The operation of a ROP2 code (1 to 16) with the given pixel value.
BitOperation Rop2Operation(int rop2, std::uint32_t pixel);

/// Applies an operation to the columns from x0 up to, but without, x1 of a row, which has them all.
void ApplyToRow(std::uint8_t* row, int depth, int x0, int x1, BitOperation operation);

/// Paints on a context's bitmap with a solid colour, through its raster operation and inside its
/// clip region. Coordinates may be any. With most raster operations it matters that a shape touches
/// each of its pixels once: either the caller sees to that, or it collects the shape in a `Region`.
class Painter {
 public:
  /// Takes the raster operation from the context's state.
  Painter(const DeviceContext& dc, COLORREF colour);
  /// With an operation of the caller's choice.
  Painter(const DeviceContext& dc, BitOperation operation);

  void Point(int x, int y) const;
  /// The columns from x0 up to, but without, x1 of a row; none when x1 <= x0.
  void Span(int y, int x0, int x1) const;
  /// A rectangle, right and bottom excluded; nothing when it is empty.
  void Fill(const RECT& rect) const;
  void Fill(const Region& region) const;

 private:
  const DeviceContext& m_dc;
  BitOperation m_operation;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
