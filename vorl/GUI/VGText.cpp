#include <vorl/GUI/VGText.h>

#include <vorl/GUI/detail/OwnedText.h>
#include <vorl/GUI/detail/ShapePen.h>
#include <vorl/GUI/detail/ShapeText.h>

inline namespace vorl {

using vorl_detail::ShapeROP;
using vorl_detail::TextBox;
using vorl_detail::TextOf;
using vorl_detail::TextStyle;

VGText::VGText() = default;

VGText::VGText(const VGText& source)
    : VGObject(source),
      m_text(TextOf(source.GetText())),
      m_pos(source.m_pos),
      m_alignment(source.m_alignment) {}

VGText& VGText::operator=(const VGText& source) {
  m_text = TextOf(source.GetText());
  m_pos = source.m_pos;
  m_alignment = source.m_alignment;
  return *this;
}

VGText& VGText::operator=(const char* text) {
  m_text = TextOf(text);  // copied first: it may be a part of the old one
  return *this;
}

VGText::~VGText() = default;

const char* VGText::GetText() const {
  return m_text.c_str();
}

void VGText::SetPos(const dVect2D& pos, short alignment) {
  m_pos = pos;
  m_alignment = alignment;
}

void VGText::SetPos(const tagPOINT& pos, short alignment) {
  SetPos(dVect2D(pos), alignment);
}

void VGText::SetPos(float x, float y, short alignment) {
  SetPos(dVect2D(x, y), alignment);
}

const dVect2D& VGText::GetPos() const {
  return m_pos;
}

void VGText::SetAlignment(short alignment) {
  m_alignment = alignment;
}

short VGText::GetAlignment() const {
  return m_alignment;
}

void VGText::Transform(Trafo2DBase* trafo, bool toGraphic) {
  if (trafo == nullptr) {
    return;
  }
  if (toGraphic) {
    trafo->pB2A(m_pos);
  } else {
    trafo->pA2B(m_pos);
  }
}

VGTextView::VGTextView() = default;

VGTextView::VGTextView(const VGText& text) : VGText(text), VGAnchorView(text.GetPos()) {}

VGTextView::VGTextView(const VGTextView& source) = default;

VGTextView& VGTextView::operator=(const VGText& text) {
  SetData(text);
  return *this;
}

VGTextView& VGTextView::operator=(const VGTextView& source) {
  if (this != &source) {
    VGAnchorView::operator=(source);
    m_font = source.m_font;
    m_isTransparent = source.m_isTransparent;
    m_bgColor = source.m_bgColor;
    SetData(source);
  }
  return *this;
}

VGTextView& VGTextView::operator=(const char* text) {
  VGText::operator=(text);
  return *this;
}

VGTextView::~VGTextView() = default;

VGType VGTextView::GetObjType() {
  return VGType_Text;
}

void VGTextView::Transform(bool toGraphic) {
  if (toGraphic) {
    SetPos(m_viewPos, GetAlignment());
    Transform(GetTransformation(), true);
    return;
  }
  m_viewPos = GetPos();
  GetTransformation()->pA2B(m_viewPos);
}

void VGTextView::DrawGraphic(HDC dc) {
  const ShapeROP rop(dc, *this);
  const TextStyle style(dc, GetPenColor(), m_isTransparent ? TRANSPARENT : OPAQUE, GetBgColor(),
                        m_font);
  tagRECT box = TextBox(dc, GetText(), m_viewPos, GetAlignment());
  DrawTextA(dc, GetText(), -1, &box, 0);
}

void VGTextView::SetData(const VGText& text) {
  VGText::operator=(text);
  Transform(false);
}

void VGTextView::SetViewPos(const dVect2D& pos) {
  m_viewPos = pos;
  Transform(true);
}

const dVect2D& VGTextView::GetViewPos() const {
  return m_viewPos;
}

void VGTextView::SetFont(HFONT font) {
  m_font = font;
}

HFONT VGTextView::GetFont() const {
  return m_font;
}

void VGTextView::SetTransparent(bool transparent) {
  m_isTransparent = transparent;
}

bool VGTextView::IsTransparent() const {
  return m_isTransparent;
}

void VGTextView::SetBgColor(long color) {
  m_bgColor = static_cast<std::uint32_t>(color);
}

long VGTextView::GetBgColor() const {
  return static_cast<long>(m_bgColor);
}

}  // namespace vorl
