#ifndef VORL_GUI_VGTEXT_H
#define VORL_GUI_VGTEXT_H

/// @file
/// Text labels and their views.

#include <vorl/GUI/VGAnchorView.h>
#include <vorl/Platform/GdiFwd.h>

#include <cstdint>
#include <string>

inline namespace vorl {

/// A text and the position where it stands, its anchor, in graphic coordinates.
///
/// The alignment says which part of the text stands at the anchor: bits 0 and 1 vertically (0 and
/// 2 its top, 1 its bottom, 3 its middle), bits 2 and 3 likewise horizontally (left, right,
/// middle). Other bits have no effect.
class VORL_API VGText : public VGObject {
 public:
  /// No text, centred (15) on (0, 0).
  VGText();
  VGText(const VGText& source);
  VGText& operator=(const VGText& source);
  /// Takes a copy of a UTF-8 text; null: none. The rest stays. The text is empty when there is no
  /// memory for it.
  VGText& operator=(const char* text);
  ~VGText() override;

  const char* GetText() const;

  /// Set the anchor and the alignment.
  void SetPos(const dVect2D& pos, short alignment);
  void SetPos(const tagPOINT& pos, short alignment);
  void SetPos(float x, float y, short alignment);
  const dVect2D& GetPos() const;
  /// The anchor stays.
  void SetAlignment(short alignment);
  short GetAlignment() const;

  /// Maps the anchor from A to B, or with true from B to A. Null changes nothing.
  void Transform(Trafo2DBase* trafo, bool toGraphic);

 private:
  std::string m_text;
  dVect2D m_pos;
  std::int16_t m_alignment = 15;
};

/// A text that is shown in the pen colour, and dragged by its anchor: see `VGAnchorView`.
///
/// The device writes it: an ampersand underlines the character that follows it, two stand for one,
/// and the text takes no notice of the raster operation.
///
/// After a change of the anchor with the functions of `VGText`, `Transform(false)` refreshes the
/// view.
class VORL_API VGTextView : public VGText, public VGAnchorView {
 public:
  /// In the device context's font, transparent.
  VGTextView();
  explicit VGTextView(const VGText& text);
  VGTextView(const VGTextView& source);
  /// As `SetData`.
  VGTextView& operator=(const VGText& text);
  /// Takes the text and the look; see `VGObjectView` for what stays.
  VGTextView& operator=(const VGTextView& source);
  /// As `VGText`.
  VGTextView& operator=(const char* text);
  ~VGTextView() override;

  VGType GetObjType() override;
  using VGText::Transform;
  void Transform(bool toGraphic) override;
  using VGObjectView::DrawGraphic;
  void DrawGraphic(HDC dc) override;

  /// Sets the text, the anchor in graphic coordinates and the alignment.
  void SetData(const VGText& text);
  /// Sets the anchor in view coordinates.
  void SetViewPos(const dVect2D& pos);
  const dVect2D& GetViewPos() const;

  /// The font stays the caller's and must live as long as it is set. Null, the default: the font of
  /// the device context.
  void SetFont(HFONT font);
  HFONT GetFont() const;
  /// False: the text's box is filled with the background colour.
  void SetTransparent(bool transparent);
  bool IsTransparent() const;
  /// 0x00bbggrr, white by default.
  void SetBgColor(long color);
  long GetBgColor() const;

 private:
  HFONT m_font = nullptr;
  bool m_isTransparent = true;
  std::uint32_t m_bgColor = 0xFFFFFF;
};

}  // namespace vorl

#endif
