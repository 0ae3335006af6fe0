#ifndef VORL_DATA_DRECT_H
#define VORL_DATA_DRECT_H

/// @file
/// An integer rectangle.

#include <vorl/Common/BaseClass.h>
#include <vorl/IO/BinaryDataIO.h>
#include <vorl/Platform/GdiFwd.h>

#include <cstdint>

inline namespace vorl {

/// A signed position and an unsigned size, such as the pixel rectangle of an image. The right and
/// bottom edges, x + width and y + height, do not belong to the rectangle; they are computed in 64
/// bits, so that rectangles near the limits of the fields work like all others.
class VORL_API dRect : public DataBase, public IBinaryDataIO {
 public:
  /// Position (0, 0), size 0 x 0.
  dRect();
  dRect(int newX, int newY, unsigned int newWidth, unsigned int newHeight);
  dRect(const dRect& source);
  dRect& operator=(const dRect& source);
  /// Takes the rectangle between the edges, whichever of left and right, and of top and bottom, is
  /// the smaller.
  dRect& operator=(const tagRECT& rect);

  ClassInfo* GetClassInfo() override;
  ~dRect() override;
  /// Position (0, 0), size 0 x 0.
  void Reset() override;
  /// Writes x and y as signed, width and height as unsigned 32-bit items.
  void Write(BinaryDataOut& out) override;
  /// Reads what `Write` writes. When an item cannot be read, the stream throws its status and the
  /// rectangle stays as it was.
  void Read(BinaryDataIn& in) override;

  static dRect* Create();
  static ClassInfo& CI();

  void Set(int newX, int newY, unsigned int newWidth, unsigned int newHeight);
  void SetPos(int newX, int newY);
  /// Adds to the position, which stops at the limits of its 32 bits.
  void Move(int dx, int dy);

  /// All four fields are equal.
  bool operator==(const dRect& other) const;
  bool operator!=(const dRect& other) const;
  /// Width or height is 0.
  bool IsEmpty() const;
  /// x <= px < x + width and y <= py < y + height.
  bool IsInside(int px, int py) const;

  /// Becomes the overlap of both. It is reset when there is none: when a rectangle is empty, and
  /// also when the two only touch.
  dRect& operator&=(const dRect& other);
  /// Becomes the bounding rectangle of both. An empty rectangle adds nothing. A width or height
  /// beyond 32 bits is cut at 4294967295.
  dRect& operator|=(const dRect& other);
  /// Splits off the other rectangle: what lies outside it.
  ///
  ///     +-------------------+
  ///     |        r1         |   r1: the band above
  ///     +----+-------+------+   r2: the band below
  ///     | r3 | other |  r4  |   r3: the piece left of the overlap
  ///     +----+-------+------+   r4: the piece right of it
  ///     |        r2         |
  ///     +-------------------+
  ///
  /// Parts that do not exist are reset, and so is one that would begin beyond the largest position.
  /// Without an overlap r1 is this rectangle. Returns false, with all parts reset, when the other
  /// rectangle covers this one. The parts may be the rectangles themselves.
  bool SubRect(const dRect& other, dRect& r1, dRect& r2, dRect& r3, dRect& r4) const;

  std::int32_t x = 0;
  std::int32_t y = 0;
  std::uint32_t width = 0;
  std::uint32_t height = 0;
};

/// The overlap (see `dRect::operator&=`).
VORL_API dRect operator&(const dRect& a, const dRect& b);
/// The bounding rectangle (see `dRect::operator|=`).
VORL_API dRect operator|(const dRect& a, const dRect& b);

}  // namespace vorl

#endif
