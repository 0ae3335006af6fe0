#ifndef VORL_APPS_CLI_TEXTLAYER_H
#define VORL_APPS_CLI_TEXTLAYER_H

/// @file
/// Texts that keep clear of each other.

#include <cli/SheetCanvas.h>
#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>

#include <string>
#include <vector>

namespace cli {

/// How a text looks.
struct TextLook {
  COLORREF colour = colour::kText;
  bool isBold = false;
  bool isBacked = false;  ///< on a dark background, as a text in a picture needs it
};

/// Texts inside a rectangle of a sheet, placed in pixels. A text that would leave the rectangle, or
/// meet another one or what else is taken, is left out.
class TextLayer {
 public:
  /// `canvas` must outlive this.
  TextLayer(const SheetCanvas& canvas, const tagRECT& bounds);

  /// Writes a text whose upper left corner is (x, y). False when there is no room for it.
  bool Write(const std::string& text, int x, int y, const TextLook& look);
  /// The same for a text whose right end is at `right`.
  bool WriteBefore(const std::string& text, int right, int y, const TextLook& look);
  /// Keeps texts away from a rectangle.
  void Take(const tagRECT& rect) { m_taken.push_back(rect); }
  const tagRECT& GetBounds() const { return m_bounds; }
  void Draw();

 private:
  bool IsFree(const tagRECT& box) const;

  const SheetCanvas& m_canvas;
  tagRECT m_bounds;
  GraphicHandler m_layer;
  GraphicViewPort m_viewPort;
  std::vector<tagRECT> m_taken;
};

}  // namespace cli

#endif
