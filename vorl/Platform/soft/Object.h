#ifndef VORL_PLATFORM_SOFT_OBJECT_H
#define VORL_PLATFORM_SOFT_OBJECT_H

#include <vorl/Platform/Gdi.h>
#include <vorl/Platform/soft/Region.h>
#include <vorl/Platform/soft/Surface.h>

#include <cstdint>
#include <memory>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

enum class ObjectKind { kDeviceContext, kBitmap, kBrush, kPen, kFont, kRegion };

/// What a handle names. Created with `std::make_shared`, entered into the `HandleTable`, and
/// unchanged from then on, so that several contexts in several threads may use it.
struct Object {
  explicit Object(ObjectKind objectKind) : kind(objectKind) {}
  Object(const Object&) = delete;
  Object& operator=(const Object&) = delete;
  virtual ~Object() = default;

  const ObjectKind kind;
  void* handle = nullptr;       ///< set by the table
  bool stock = false;           ///< never deleted
  int selections = 0;           ///< how often it is selected; the table's lock guards it
  const void* owner = nullptr;  ///< of a selected bitmap: its context; the table's lock guards it
};

struct Brush : Object {
  static constexpr ObjectKind kKind = ObjectKind::kBrush;
  Brush(UINT brushStyle, COLORREF brushColour)
      : Object(kKind), style(brushStyle), colour(brushColour) {}
  const UINT style;  ///< BS_SOLID or BS_NULL
  const COLORREF colour;
};

struct Pen : Object {
  static constexpr ObjectKind kKind = ObjectKind::kPen;
  Pen(int penStyle, int penWidth, COLORREF penColour)
      : Object(kKind), style(penStyle), width(penWidth), colour(penColour) {}
  const int style;  ///< PS_SOLID ... PS_INSIDEFRAME
  const int width;  ///< never negative; 0 and 1 are one pixel
  const COLORREF colour;
};

struct Font : Object {
  static constexpr ObjectKind kKind = ObjectKind::kFont;
  explicit Font(const LOGFONTA& fontDescription) : Object(kKind), description(fontDescription) {}
  const LOGFONTA description;
};

struct RegionObject : Object {
  static constexpr ObjectKind kKind = ObjectKind::kRegion;
  explicit RegionObject(Region objectRegion) : Object(kKind), region(std::move(objectRegion)) {}
  const Region region;
};

/// Gives the pixels of a bitmap back.
struct FreePixels {
  void operator()(std::uint8_t* pixels) const;
};

/// A bitmap section or a device bitmap; it owns its pixels. The pixels change while contexts draw.
struct Bitmap : Object {
  static constexpr ObjectKind kKind = ObjectKind::kBitmap;
  Bitmap() : Object(kKind) {}
  Surface surface;
  bool section = false;       ///< the application sees the pixels
  bool bottomUp = false;      ///< the first row in memory is the bottom one
  BITMAPINFOHEADER header{};  ///< of a section
  int rowBytes = 0;           ///< as GetObjectA reports them
  std::unique_ptr<std::uint8_t, FreePixels> pixels;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
