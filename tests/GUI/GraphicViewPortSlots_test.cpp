// The places of the virtual functions of the viewport, which applications compiled against the
// library rely on.

#include <vorl/GUI/GraphicViewPort.h>

#include <gtest/gtest.h>

#include "../Support/VirtualSlot.h"

namespace {

class Extended : public GraphicViewPort {
 public:
  virtual void Next() {}
};

TEST(GraphicViewPortSlots, StandInOrder) {
  // The destructor takes the first two.
  using V = GraphicViewPort;
  using Init = void (V::*)(Rect2D&, Rect2D&, Rect2D&);
  EXPECT_EQ(VirtualSlot(&V::Reset), 2u);
  EXPECT_EQ(VirtualSlot(static_cast<Init>(&V::Init)), 3u);
  EXPECT_EQ(VirtualSlot(&V::SetScaleFactors), 4u);
  EXPECT_EQ(VirtualSlot(&V::SetScaleSizes), 5u);
  using Action = void (V::*)();
  const Action actions[] = {&V::FitWidth,   &V::FitHeight, &V::FitSize,   &V::OrigWidth,
                            &V::OrigHeight, &V::OrigSize,  &V::MaxWidth,  &V::MaxHeight,
                            &V::MaxSize,    &V::MinWidth,  &V::MinHeight, &V::MinSize};
  std::size_t slot = 6;
  for (const Action action : actions) {
    EXPECT_EQ(VirtualSlot(action), slot++);
  }
  EXPECT_EQ(VirtualSlot(&V::SetAlignment), 18u);
  EXPECT_EQ(VirtualSlot(&V::IsVisible), 19u);
  EXPECT_EQ(VirtualSlot(&V::SetInterface), 20u);
  EXPECT_EQ(VirtualSlot(&V::DoScale), 21u);
  EXPECT_EQ(VirtualSlot(&V::DoPan), 22u);
  EXPECT_EQ(VirtualSlot(&V::DoMove), 23u);
  EXPECT_EQ(VirtualSlot(&Extended::Next), 24u);
}

TEST(GraphicViewPortSlots, TheNotificationComesFirstInTheInterface) {
  EXPECT_EQ(VirtualSlot(&IGraphicViewPort::OnTrafoChanged), 0u);
}

}  // namespace
