#include <vorl/GUI/VGObjectView.h>

#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/detail/ObjectWatch.h>

inline namespace vorl {

namespace {

// Beside the operations, the enable flags say how the object came to be.
constexpr std::uint16_t kDynamicallyCreated = 0x8000;

Trafo2DBase* SharedIdentity() {
  static Translate2D identity;
  return &identity;
}

std::uint16_t Bits(short bits) {
  return static_cast<std::uint16_t>(bits);
}

void SetBits(std::uint16_t& flags, std::uint16_t bits) {
  flags = static_cast<std::uint16_t>(flags | bits);
}

void ClearBits(std::uint16_t& flags, std::uint16_t bits) {
  flags = static_cast<std::uint16_t>(flags & ~bits);
}

}  // namespace

VGObject::VGObject() = default;

VGObject::VGObject(const VGObject& source) = default;

VGObject& VGObject::operator=(const VGObject& source) = default;

VGObject::~VGObject() = default;

IVGObjectView::IVGObjectView() = default;

IVGObjectView::IVGObjectView(const IVGObjectView& source) = default;

IVGObjectView& IVGObjectView::operator=(const IVGObjectView& source) = default;

IVGObjectView::~IVGObjectView() = default;

void IVGObjectView::OnBeginGraphicOp(VGObjectView* /*object*/, short /*operation*/) {}

void IVGObjectView::OnGraphicChanged(VGObjectView* /*object*/, short /*operation*/) {}

void IVGObjectView::OnEndGraphicOp(VGObjectView* /*object*/, short /*operation*/) {}

VGObjectView::VGObjectView() : m_objID(DefaultID()), m_pTrafo(SharedIdentity()) {}

VGObjectView::VGObjectView(const VGObjectView& source)
    : m_objID(DefaultID()), m_pTrafo(source.m_pTrafo) {
  CopyLook(source);
}

VGObjectView& VGObjectView::operator=(const VGObjectView& source) {
  if (this != &source) {
    CopyLook(source);
  }
  return *this;
}

VGObjectView::~VGObjectView() {
  Watch::End(m_watch);
  for (GraphicHandler* const handler : m_handlers) {
    handler->Forget(this);
  }
}

long VGObjectView::DefaultID() const {
  // Where a long is shorter than an address, its lower bits still tell objects apart.
  return static_cast<long>(reinterpret_cast<std::uintptr_t>(this));
}

void VGObjectView::CopyLook(const VGObjectView& source) {
  const bool isDynamic = IsDynamicCreated();
  m_enableFlags = source.m_enableFlags;
  ClearBits(m_enableFlags, kDynamicallyCreated);
  SetBits(m_enableFlags, isDynamic ? kDynamicallyCreated : 0);
  m_opState = source.m_opState;
  m_viewState = source.m_viewState;
  if (source.m_objID != source.DefaultID()) {
    m_objID = source.m_objID;
  }
  m_userData = source.m_userData;
  m_pInterface = source.m_pInterface;
  m_penStyle = source.m_penStyle;
  m_penThickness = source.m_penThickness;
  m_penColor = source.m_penColor;
  m_ropMode = source.m_ropMode;
  m_lineDistance = source.m_lineDistance;
  m_handleDistance = source.m_handleDistance;
}

void VGObjectView::SetTransformation(Trafo2DBase* trafo) {
  m_pTrafo = trafo != nullptr ? trafo : SharedIdentity();
  Transform(false);
}

void VGObjectView::Draw(HDC dc, GraphicViewPort& viewPort) {
  if (!IsVisible()) {
    return;
  }
  const Watch watch(*this);
  DrawGraphic(dc, viewPort);
  if (!watch.IsGone() && IsSelected()) {
    DrawSelection(dc, viewPort);
  }
}

void VGObjectView::Draw(HDC dc) {
  if (!IsVisible()) {
    return;
  }
  const Watch watch(*this);
  DrawGraphic(dc);
  if (!watch.IsGone() && IsSelected()) {
    DrawSelection(dc);
  }
}

void VGObjectView::DrawGraphic(HDC dc, GraphicViewPort& /*viewPort*/) {
  DrawGraphic(dc);
}

void VGObjectView::DrawGraphic(HDC /*dc*/) {}

void VGObjectView::DrawSelection(HDC dc, GraphicViewPort& /*viewPort*/) {
  DrawSelection(dc);
}

void VGObjectView::DrawSelection(HDC /*dc*/) {}

void VGObjectView::SetDrawParams(int style, int thickness, int color, int rop) {
  m_penStyle = style;
  m_penThickness = thickness;
  m_penColor = color;
  m_ropMode = rop;
}

void VGObjectView::SetPenStyle(int style) {
  m_penStyle = style;
}

void VGObjectView::SetPenThickness(int thickness) {
  m_penThickness = thickness;
}

void VGObjectView::SetPenColor(int color) {
  m_penColor = color;
}

void VGObjectView::SetROPMode(int rop) {
  m_ropMode = rop;
}

void VGObjectView::ViewDataChanged() {
  Transform(true);
}

void VGObjectView::SetInterface(IVGObjectView* client) {
  m_pInterface = client;
}

IVGObjectView* VGObjectView::GetInterface() const {
  return m_pInterface;
}

Trafo2DBase* VGObjectView::GetTransformation() const {
  return m_pTrafo;
}

void VGObjectView::SetObjID(long id) {
  m_objID = id;
}

long VGObjectView::GetObjID() const {
  return m_objID;
}

void VGObjectView::SetUserData(long data) {
  m_userData = data;
}

long VGObjectView::GetUserData() const {
  return m_userData;
}

void VGObjectView::SetViewState(short bits) {
  SetBits(m_viewState, Bits(bits));
}

void VGObjectView::ResetViewState(short bits) {
  ClearBits(m_viewState, Bits(bits));
}

void VGObjectView::AssignViewState(short bits) {
  m_viewState = Bits(bits);
}

void VGObjectView::Select(bool select) {
  if (select) {
    SetViewState(VGViewState_Selected);
  } else {
    ResetViewState(VGViewState_Selected);
  }
}

bool VGObjectView::IsSelected() const {
  return (m_viewState & VGViewState_Selected) != 0;
}

bool VGObjectView::IsVisible() const {
  return (m_viewState & VGViewState_Visible) != 0;
}

void VGObjectView::Enable(short bits) {
  SetBits(m_enableFlags, Bits(bits));
}

void VGObjectView::Disable(short bits) {
  ClearBits(m_enableFlags, Bits(bits));
}

bool VGObjectView::IsEnabled(short bits) const {
  return (m_enableFlags & Bits(bits)) == Bits(bits);
}

short VGObjectView::GetOpState() const {
  return static_cast<short>(m_opState);
}

void VGObjectView::SetOpState(short operation) {
  m_opState = Bits(operation);
}

int VGObjectView::GetPenStyle() const {
  return m_penStyle;
}

int VGObjectView::GetPenThickness() const {
  return m_penThickness;
}

int VGObjectView::GetPenColor() const {
  return m_penColor;
}

int VGObjectView::GetROPMode() const {
  return m_ropMode;
}

void VGObjectView::SetSelectionDistances(unsigned char line, unsigned char handle) {
  m_lineDistance = line;
  m_handleDistance = handle;
}

int VGObjectView::GetLineDistance() const {
  return m_lineDistance;
}

int VGObjectView::GetHandleDistance() const {
  return m_handleDistance;
}

void VGObjectView::SetDynamicCreationFlag() {
  SetBits(m_enableFlags, kDynamicallyCreated);
}

bool VGObjectView::IsDynamicCreated() const {
  return (m_enableFlags & kDynamicallyCreated) != 0;
}

void VGObjectView::UpdateBoundingBox(const dVect2D& point, dVect2D& min, dVect2D& max) {
  for (int i = 0; i < 2; ++i) {
    if (point[i] < min[i]) {
      min[i] = point[i];
    }
    if (point[i] > max[i]) {
      max[i] = point[i];
    }
  }
}

}  // namespace vorl
