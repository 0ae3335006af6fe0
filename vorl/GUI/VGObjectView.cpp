#include <vorl/GUI/VGObjectView.h>

#include <vorl/GUI/GraphicHandler.h>

inline namespace vorl {

namespace {

// Beside the operations, the enable flags say how the object came to be.
constexpr std::uint16_t kDynamicallyCreated = 0x8000;

Trafo2DBase* SharedIdentity() {
  static Translate2D identity;
  return &identity;
}

/// The handlers of one operation.
struct OperationHandlers {
  using Handler = bool (VGObjectView::*)(dVect2D&);

  short operation;
  Handler begin;
  Handler proceed;
  Handler end;
};

constexpr OperationHandlers kOperations[] = {
    {VGOperation_Move, &VGObjectView::OnBeginMove, &VGObjectView::OnMove, &VGObjectView::OnEndMove},
    {VGOperation_Resize, &VGObjectView::OnBeginResize, &VGObjectView::OnResize,
     &VGObjectView::OnEndResize},
    {VGOperation_Modify, &VGObjectView::OnBeginModify, &VGObjectView::OnModify,
     &VGObjectView::OnEndModify},
    {VGOperation_Rotate, &VGObjectView::OnBeginRotate, &VGObjectView::OnRotate,
     &VGObjectView::OnEndRotate},
};

const OperationHandlers* HandlersOf(short operation) {
  for (const OperationHandlers& handlers : kOperations) {
    if (handlers.operation == operation) {
      return &handlers;
    }
  }
  return nullptr;
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

bool VGObjectView::IsPointOnGraphic(tagPOINT& point, int tolerance) {
  dVect2D p(point);
  return IsPointOnGraphic(p, tolerance);
}

bool VGObjectView::IsPointOnGraphic(dVect2D& /*point*/, int /*tolerance*/) {
  return false;
}

short VGObjectView::GetSelectionState(int flags, tagPOINT& point) {
  dVect2D p(point);
  return GetSelectionState(flags, p);
}

short VGObjectView::GetSelectionState(int /*flags*/, dVect2D& /*point*/) {
  return VGOperation_None;
}

bool VGObjectView::ProcessMouseEvent(int event, int flags, tagPOINT& point) {
  dVect2D p(point);
  return ProcessMouseEvent(event, flags, p);
}

bool VGObjectView::ProcessMouseEvent(int event, int flags, dVect2D& point) {
  const bool isLeftClick = event == MouseEvent_ButtonDown && (flags & MK_LBUTTON) != 0;
  if (isLeftClick && m_viewState == 0 && IsEnabled(VGOperation_Create)) {
    AssignViewState(VGViewState_Visible);
    SetOpState(VGOperation_Create);
  }
  if (!IsVisible()) {
    return false;
  }
  if (isLeftClick && m_opState == VGOperation_None) {
    const short grabbed = GetSelectionState(flags, point);
    if (IsEnabled(grabbed)) {
      SetOpState(grabbed);
    } else if (IsEnabled(VGOperation_Move)) {
      SetOpState(VGOperation_Move);
    }
  }
  return Dispatch(event, flags, point);
}

bool VGObjectView::Dispatch(int event, int flags, dVect2D& point) {
  if (event != MouseEvent_ButtonDown && event != MouseEvent_Move && event != MouseEvent_ButtonUp) {
    return false;
  }
  const short operation = GetOpState();  // before a handler ends it
  if (operation == VGOperation_Create) {
    return OnCreate(event, flags, point);
  }
  const OperationHandlers* const handlers = HandlersOf(operation);
  if (handlers == nullptr) {
    return false;
  }
  // The interface is told last: its client may destroy the object.
  if (event == MouseEvent_ButtonDown) {
    const bool result = (this->*handlers->begin)(point);
    if (m_pInterface != nullptr) {
      m_pInterface->OnBeginGraphicOp(this, operation);
    }
    return result;
  }
  if (event == MouseEvent_Move) {
    const bool result = (this->*handlers->proceed)(point);
    if (m_pInterface != nullptr) {
      m_pInterface->OnGraphicChanged(this, operation);
    }
    return result;
  }
  const bool result = (this->*handlers->end)(point);
  if (m_pInterface != nullptr) {
    m_pInterface->OnEndGraphicOp(this, operation);
  }
  return result;
}

void VGObjectView::Draw(HDC dc, GraphicViewPort& viewPort) {
  if (!IsVisible()) {
    return;
  }
  DrawGraphic(dc, viewPort);
  if (IsSelected()) {
    DrawSelection(dc, viewPort);
  }
}

void VGObjectView::Draw(HDC dc) {
  if (!IsVisible()) {
    return;
  }
  DrawGraphic(dc);
  if (IsSelected()) {
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

bool VGObjectView::OnCreate(int /*event*/, int /*flags*/, dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnBeginMove(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnMove(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnEndMove(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnBeginResize(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnResize(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnEndResize(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnBeginModify(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnModify(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnEndModify(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnBeginRotate(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnRotate(dVect2D& /*point*/) {
  return false;
}

bool VGObjectView::OnEndRotate(dVect2D& /*point*/) {
  return false;
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
