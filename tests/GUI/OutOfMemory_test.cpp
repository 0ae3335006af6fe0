// What becomes of layers of graphic objects when there is no memory left.
#include <gtest/gtest.h>
#include <tests/Support/Allocation.h>
#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/VGCurve.h>
#include <vorl/GUI/VGPoint.h>
#include <vorl/GUI/VGText.h>

namespace {

/// Counts the points there are.
class CountedPoint : public VGPointView {
 public:
  CountedPoint() { ++living; }
  CountedPoint(const CountedPoint&) = delete;
  CountedPoint& operator=(const CountedPoint&) = delete;
  ~CountedPoint() override { --living; }

  static int living;
};

int CountedPoint::living = 0;

TEST(GraphicsOutOfMemory, ObjectCannotBeAdded) {
  auto* const object = new CountedPoint();
  object->SetDynamicCreationFlag();
  {
    GraphicHandler handler;
    {
      const AllocationFailure failure;
      EXPECT_FALSE(handler.AddObject(object));
    }
    EXPECT_FALSE(handler.DeleteObject(object)) << "the list is empty";
  }
  EXPECT_EQ(CountedPoint::living, 1) << "it does not belong to the handler";
  delete object;
}

TEST(GraphicsOutOfMemory, CopyIsEmpty) {
  GraphicHandler handler;
  VGPointView object;
  ASSERT_TRUE(handler.AddObject(&object));
  object.SetObjID(5);
  GraphicHandler target;
  {
    const AllocationFailure failure;
    GraphicHandler copy(handler);
    EXPECT_EQ(copy.GetObject(5), nullptr);
    target = handler;
  }
  EXPECT_EQ(target.GetObject(5), nullptr);
  EXPECT_EQ(handler.GetObject(5), &object);
  target = handler;
  EXPECT_EQ(target.GetObject(5), &object);
}

TEST(GraphicsOutOfMemory, LayerCannotBeShown) {
  GraphicHandler handler;
  GraphicViewPort viewPort;
  {
    const AllocationFailure failure;
    EXPECT_FALSE(viewPort.AddGraphic(&handler));
  }
  EXPECT_TRUE(viewPort.AddGraphic(&handler));
  {
    const AllocationFailure failure;
    EXPECT_TRUE(viewPort.AddGraphic(&handler)) << "it is moved only";
  }
}

/// Creates its object beforehand.
class ReadyHandler : public GraphicHandler {
 public:
  VGObjectView* CreateObject(VGType /*type*/) override { return ready; }
  VGObjectView* ready = nullptr;
};

TEST(GraphicsOutOfMemory, CreatedObjectThatCannotBeListedIsDestroyed) {
  ReadyHandler handler;
  handler.ready = new CountedPoint();
  handler.ready->SetDynamicCreationFlag();
  handler.SetCreateMode(VGType_Point, -1);
  dVect2D p;
  {
    const AllocationFailure failure;
    EXPECT_FALSE(handler.ProcessMouseEvent(MouseEvent_ButtonDown, MK_LBUTTON, p));
  }
  EXPECT_EQ(CountedPoint::living, 0);
  EXPECT_EQ(handler.GetActiveObject(), nullptr);
}

TEST(GraphicsOutOfMemory, TextIsEmpty) {
  const char* const words = "a text that is too long to be kept without any memory of its own";
  VGText text;
  text.SetPos(3.0F, 4.0F, 5);
  text = words;
  VGText assigned;
  {
    const AllocationFailure failure;
    const VGText copy(text);
    EXPECT_STREQ(copy.GetText(), "");
    EXPECT_EQ(copy.GetPos().x, 3.0F);
    EXPECT_EQ(copy.GetAlignment(), 5);
    assigned = text;
    text = words;
  }
  EXPECT_STREQ(assigned.GetText(), "");
  EXPECT_EQ(assigned.GetPos().y, 4.0F);
  EXPECT_STREQ(text.GetText(), "");
}

TEST(GraphicsOutOfMemory, CurveIsEmpty) {
  float values[] = {1, 2, 3};
  VGCurve curve;
  ASSERT_TRUE(curve.SetData(1, 1, 3, values, CurveStorageMode_Copy));
  {
    const AllocationFailure failure;
    const VGCurve copy(curve);
    EXPECT_EQ(copy.GetSize(), 0);
    EXPECT_FALSE(curve.SetData(1, 1, 3, values, CurveStorageMode_Copy));
  }
  EXPECT_EQ(curve.GetSize(), 0);
  EXPECT_EQ(curve.GetData(), nullptr);
  EXPECT_EQ(curve.GetDeltaX(), 0.0F);
}

}  // namespace
