#ifndef VORL_PLATFORM_SOFT_BLIT_H
#define VORL_PLATFORM_SOFT_BLIT_H

#include <vorl/Platform/soft/AxisMap.h>
#include <vorl/Platform/soft/DeviceContext.h>
#include <vorl/Platform/soft/Surface.h>

inline namespace vorl {
namespace vorl_detail {

/// The picture that a blit takes its pixels from.
struct BlitSource {
  Surface surface;
  COLORREF background = RGB(255, 255, 255);  ///< what a monochrome destination shows white
};

/// Combines a rectangle of the source, the context's brush and a rectangle of the context's bitmap.
/// Source and destination may be the same bitmap: the source is read as it was before.
///
/// Row by row: take the source's units, stretch, convert, combine with each part of the clip
/// region.
void Blit(DeviceContext& context, const Axis& x, const Axis& y, const BlitSource& source,
          DWORD rop);

/// A blit without a source.
void FillByRop(DeviceContext& context, const Axis& x, const Axis& y, DWORD rop);

/// Is there a brush for an operation that needs one? With the null brush nothing is drawn.
bool HasPattern(const DeviceContext& context, DWORD rop);

}  // namespace vorl_detail
}  // namespace vorl

#endif
