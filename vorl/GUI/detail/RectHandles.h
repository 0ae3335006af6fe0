#ifndef VORL_GUI_DETAIL_RECTHANDLES_H
#define VORL_GUI_DETAIL_RECTHANDLES_H

/// @file
/// The handles by which rectangles are pulled: at the corners and the middles of the edges.

#include <vorl/Data/dVect2D.h>
#include <vorl/GUI/VGObjectView.h>

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// What a handle pulls: one edge, or the two that meet in a corner.
enum RectEdge : std::uint8_t {
  RectEdge_None = 0,
  RectEdge_Left = 1,
  RectEdge_Right = 2,
  RectEdge_Top = 4,
  RectEdge_Bottom = 8
};

/// The edges (`RectEdge`) that the handle at a point pulls; none where there is no handle. Where
/// handles lie close together, the first of them wins, clockwise from the top left corner.
std::uint8_t EdgesAt(const dVect2D& point, const dVect2D& topLeft, const dVect2D& bottomRight,
                     int distance);

/// Moves the edges to the point. One that is pulled over the opposite one swaps the corners.
void PullEdges(std::uint8_t edges, const dVect2D& point, dVect2D& topLeft, dVect2D& bottomRight);

/// Draws a dot at each handle, in the look of a view.
void DrawRectHandles(HDC dc, const VGObjectView& view, const tagRECT& rect);

/// The corners without decimals.
tagRECT TruncatedRect(const dVect2D& topLeft, const dVect2D& bottomRight);

}  // namespace vorl_detail
}  // namespace vorl

#endif
