// The places of the virtual functions of handlers, objects and their interfaces, which applications
// compiled against the library rely on.

#include <vorl/GUI/GraphicHandler.h>

#include <gtest/gtest.h>

#include "../Support/VirtualSlot.h"

namespace {

class OpenHandler : public GraphicHandler {
 public:
  using Mouse = bool (OpenHandler::*)(int, dVect2D&);
  static std::size_t SlotOfOnMouseMove() { return VirtualSlot<Mouse>(&OpenHandler::OnMouseMove); }
  static std::size_t SlotOfOnMouseDownL() { return VirtualSlot<Mouse>(&OpenHandler::OnMouseDownL); }
  static std::size_t SlotOfOnMouseDownR() { return VirtualSlot<Mouse>(&OpenHandler::OnMouseDownR); }
  static std::size_t SlotOfOnMouseUpR() { return VirtualSlot<Mouse>(&OpenHandler::OnMouseUpR); }
  static std::size_t SlotOfSelectObject() { return VirtualSlot<Mouse>(&OpenHandler::SelectObject); }
  virtual void Next() {}
};

TEST(GraphicHandlerSlots, EventsComeFirst) {
  using H = GraphicHandler;
  EXPECT_EQ(VirtualSlot<bool (H::*)(int, int, dVect2D&)>(&H::ProcessMouseEvent), 2u);
  EXPECT_EQ(VirtualSlot<bool (H::*)(int, int, tagPOINT&)>(&H::ProcessMouseEvent), 3u);
  EXPECT_EQ(VirtualSlot<bool (H::*)(int, int, int)>(&H::ProcessKeyEvent), 4u);
  EXPECT_EQ(OpenHandler::SlotOfOnMouseMove(), 5u);
  EXPECT_EQ(OpenHandler::SlotOfOnMouseDownL(), 9u);
  EXPECT_EQ(OpenHandler::SlotOfOnMouseDownR(), 11u);
  EXPECT_EQ(OpenHandler::SlotOfOnMouseUpR(), 14u);
}

TEST(GraphicHandlerSlots, HandlerOperationsFollow) {
  using H = GraphicHandler;
  EXPECT_EQ(VirtualSlot<void (H::*)(HDC, GraphicViewPort&)>(&H::Draw), 15u);
  EXPECT_EQ(VirtualSlot<void (H::*)(HDC)>(&H::Draw), 16u);
  EXPECT_EQ(VirtualSlot<void (H::*)(HDC, GraphicViewPort&)>(&H::DrawActiveObject), 17u);
  EXPECT_EQ(VirtualSlot<void (H::*)(HDC)>(&H::DrawActiveObject), 18u);
  EXPECT_EQ(VirtualSlot<VGObjectView* (H::*)(VGType, long)>(&H::GetObject), 19u);
  EXPECT_EQ(VirtualSlot<VGObjectView* (H::*)(long)>(&H::GetObject), 20u);
  EXPECT_EQ(VirtualSlot(&H::GetObjectByUserData), 21u);
  EXPECT_EQ(VirtualSlot(&H::GetActiveObject), 22u);
  EXPECT_EQ(VirtualSlot(&H::HitTest), 23u);
  EXPECT_EQ(VirtualSlot<bool (H::*)(long)>(&H::DeleteObject), 24u);
  EXPECT_EQ(VirtualSlot<bool (H::*)(VGObjectView*)>(&H::DeleteObject), 25u);
  EXPECT_EQ(VirtualSlot(&H::DeleteObjects), 26u);
  EXPECT_EQ(VirtualSlot(&H::DeleteAll), 27u);
  EXPECT_EQ(VirtualSlot(&H::DeleteSelected), 28u);
  EXPECT_EQ(VirtualSlot(&H::DeleteActive), 29u);
  EXPECT_EQ(VirtualSlot(&H::CalcBoundingBox), 30u);
  EXPECT_EQ(VirtualSlot(&H::CreateObject), 31u);
  EXPECT_EQ(VirtualSlot(&H::AddObject), 32u);
  EXPECT_EQ(OpenHandler::SlotOfSelectObject(), 33u);
  EXPECT_EQ(VirtualSlot(&OpenHandler::Next), 34u);
}

TEST(GraphicHandlerSlots, InterfaceHasItsCallsInOrder) {
  EXPECT_EQ(VirtualSlot(&IGraphicHandler::OnCreateObject), 0u);
  EXPECT_EQ(VirtualSlot(&IGraphicHandler::OnDeleteObject), 1u);
  EXPECT_EQ(VirtualSlot(&IGraphicHandler::OnSelectObject), 2u);
  EXPECT_EQ(VirtualSlot(&IGraphicHandler::OnModifyObject), 3u);
  EXPECT_EQ(VirtualSlot(&IGraphicHandler::OnObjectModified), 4u);
  EXPECT_EQ(VirtualSlot(&IGraphicHandler::GHEvent), 5u);
}

TEST(VGObjectViewSlots, InterfaceHasItsCallsInOrder) {
  EXPECT_EQ(VirtualSlot(&IVGObjectView::OnBeginGraphicOp), 0u);
  EXPECT_EQ(VirtualSlot(&IVGObjectView::OnGraphicChanged), 1u);
  EXPECT_EQ(VirtualSlot(&IVGObjectView::OnEndGraphicOp), 2u);
}

TEST(VGObjectViewSlots, QuestionsAndEventsComeFirst) {
  using V = VGObjectView;
  EXPECT_EQ(VirtualSlot(&V::GetObjType), 2u);
  EXPECT_EQ(VirtualSlot(&V::SetTransformation), 3u);
  EXPECT_EQ(VirtualSlot(&V::Transform), 4u);
  EXPECT_EQ(VirtualSlot<bool (V::*)(tagPOINT&, int)>(&V::IsPointOnGraphic), 5u);
  EXPECT_EQ(VirtualSlot<bool (V::*)(dVect2D&, int)>(&V::IsPointOnGraphic), 6u);
  EXPECT_EQ(VirtualSlot<short (V::*)(int, tagPOINT&)>(&V::GetSelectionState), 7u);
  EXPECT_EQ(VirtualSlot<short (V::*)(int, dVect2D&)>(&V::GetSelectionState), 8u);
  EXPECT_EQ(VirtualSlot<bool (V::*)(int, int, tagPOINT&)>(&V::ProcessMouseEvent), 9u);
  EXPECT_EQ(VirtualSlot<bool (V::*)(int, int, dVect2D&)>(&V::ProcessMouseEvent), 10u);
}

TEST(VGObjectViewSlots, DrawingFollows) {
  using V = VGObjectView;
  EXPECT_EQ(VirtualSlot<void (V::*)(HDC, GraphicViewPort&)>(&V::Draw), 11u);
  EXPECT_EQ(VirtualSlot<void (V::*)(HDC)>(&V::Draw), 12u);
  EXPECT_EQ(VirtualSlot<void (V::*)(HDC, GraphicViewPort&)>(&V::DrawGraphic), 13u);
  EXPECT_EQ(VirtualSlot<void (V::*)(HDC)>(&V::DrawGraphic), 14u);
  EXPECT_EQ(VirtualSlot<void (V::*)(HDC, GraphicViewPort&)>(&V::DrawSelection), 15u);
  EXPECT_EQ(VirtualSlot<void (V::*)(HDC)>(&V::DrawSelection), 16u);
  EXPECT_EQ(VirtualSlot(&V::SetDrawParams), 17u);
  EXPECT_EQ(VirtualSlot(&V::SetPenStyle), 18u);
  EXPECT_EQ(VirtualSlot(&V::SetPenThickness), 19u);
  EXPECT_EQ(VirtualSlot(&V::SetPenColor), 20u);
  EXPECT_EQ(VirtualSlot(&V::SetROPMode), 21u);
  EXPECT_EQ(VirtualSlot(&V::CalcBoundingBox), 22u);
}

TEST(VGObjectViewSlots, OperationsComeLast) {
  using V = VGObjectView;
  EXPECT_EQ(VirtualSlot(&V::OnCreate), 23u);
  EXPECT_EQ(VirtualSlot(&V::OnBeginMove), 24u);
  EXPECT_EQ(VirtualSlot(&V::OnMove), 25u);
  EXPECT_EQ(VirtualSlot(&V::OnEndMove), 26u);
  EXPECT_EQ(VirtualSlot(&V::OnBeginResize), 27u);
  EXPECT_EQ(VirtualSlot(&V::OnResize), 28u);
  EXPECT_EQ(VirtualSlot(&V::OnEndResize), 29u);
  EXPECT_EQ(VirtualSlot(&V::OnBeginModify), 30u);
  EXPECT_EQ(VirtualSlot(&V::OnModify), 31u);
  EXPECT_EQ(VirtualSlot(&V::OnEndModify), 32u);
  EXPECT_EQ(VirtualSlot(&V::OnBeginRotate), 33u);
  EXPECT_EQ(VirtualSlot(&V::OnRotate), 34u);
  EXPECT_EQ(VirtualSlot(&V::OnEndRotate), 35u);
  EXPECT_EQ(VirtualSlot(&V::ViewDataChanged), 36u);
}

}  // namespace
