// Every device object that the bitmap classes create is deleted again.
#include <vorl/Data/dDIB.h>
#include <vorl/GUI/vIma2Device.h>
#include <vorl/Platform/soft/HandleTable.h>

#include <gtest/gtest.h>

namespace {

class DeviceObjects : public testing::Test {
 protected:
  static std::size_t Count() { return vorl_detail::HandleTable::Instance().LiveCount(); }
  void TearDown() override { EXPECT_EQ(Count(), m_before); }

 private:
  std::size_t m_before = Count();
};

TEST_F(DeviceObjects, BitmapHasOneSectionAndNothingElse) {
  const std::size_t before = Count();
  dDIB dib(4, 4, 1, 8);
  EXPECT_EQ(Count(), before + 1);
  ASSERT_TRUE(dib.Init(9, 9, 3, 8));
  EXPECT_EQ(Count(), before + 1);
  EXPECT_FALSE(dib.Init(9, 9, 2, 8));
  EXPECT_EQ(Count(), before);
}

TEST_F(DeviceObjects, TransfersNeitherLoseNorShareASection) {
  const std::size_t before = Count();
  dDIB first(4, 4, 1, 8);
  dDIB second(first);
  EXPECT_EQ(Count(), before + 2);
  second <<= first;
  EXPECT_EQ(Count(), before + 1);
  {
    dDIB reference;
    ASSERT_TRUE(reference.Init(DTM_Reference, second));
    dDIB another;
    ASSERT_TRUE(another.Init(DTM_TakeOver, reference));
    EXPECT_EQ(Count(), before + 1);
  }
  EXPECT_EQ(Count(), before + 1);
  ASSERT_TRUE(first.Init(DTM_Copy, second));
  EXPECT_EQ(Count(), before + 1);
  dImage image;
  image <<= second;
  EXPECT_EQ(Count(), before);
}

TEST_F(DeviceObjects, CombiningLeavesNoContextBehind) {
  dDIB target(4, 4, 3, 8);
  const dDIB source(4, 4, 3, 8);
  const std::size_t before = Count();
  EXPECT_TRUE(target.Combine(source, 0, 0, static_cast<int>(SRCCOPY)));
  EXPECT_FALSE(target.Combine(dDIB(), 0, 0, static_cast<int>(SRCCOPY)));
  EXPECT_EQ(Count(), before);
}

TEST_F(DeviceObjects, TransparentDrawingKeepsTwoBitmapsUntilItEnds) {
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U8, "BGR", 0, 4));
  image.Fill(5);
  dDIB screen(8, 8, 3, 8);
  const HDC dc = CreateCompatibleDC(nullptr);
  const HGDIOBJ old = SelectObject(dc, screen.GetHandle());
  {
    const tagRECT region{0, 0, 8, 8};
    vIma2Device renderer;
    ASSERT_TRUE(renderer.Init(&image, nullptr, &region, false, false));
    const std::size_t before = Count();
    EXPECT_TRUE(renderer.Draw(dc));
    EXPECT_EQ(Count(), before);
    renderer.EnableTransparency(0UL);
    EXPECT_EQ(Count(), before);
    EXPECT_TRUE(renderer.Draw(dc));
    EXPECT_TRUE(renderer.Draw(dc));
    EXPECT_EQ(Count(), before + 2);
    const vIma2Device copy(renderer);
    EXPECT_EQ(Count(), before + 2);
    renderer.EnableTransparency(1, 1);
    EXPECT_EQ(Count(), before);
    EXPECT_TRUE(renderer.Draw(dc));
    EXPECT_EQ(Count(), before + 2);
    EXPECT_TRUE(renderer.EraseBackground(dc, &region, 0xFFFFFFUL, true));
    EXPECT_EQ(Count(), before + 2);
    ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, false, true));
    EXPECT_EQ(Count(), before);
    EXPECT_TRUE(renderer.Draw(dc));
    EXPECT_EQ(Count(), before + 2);
  }
  SelectObject(dc, old);
  DeleteDC(dc);
}

class OpenRenderer : public vIma2Device {
 public:
  using vIma2Device::CreateMask;
};

TEST_F(DeviceObjects, MaskThatIsMadeAnewReplacesTheOldOne) {
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U8, "BGR", 0, 4));
  dDIB screen(8, 8, 3, 8);
  const HDC dc = CreateCompatibleDC(nullptr);
  const HGDIOBJ old = SelectObject(dc, screen.GetHandle());
  {
    OpenRenderer renderer;
    ASSERT_TRUE(renderer.Init(&image, nullptr, nullptr, false, false));
    renderer.EnableTransparency(0UL);
    const std::size_t before = Count();
    EXPECT_TRUE(renderer.CreateMask(dc));
    EXPECT_TRUE(renderer.CreateMask(dc));
    EXPECT_EQ(Count(), before + 2);
  }
  SelectObject(dc, old);
  DeleteDC(dc);
}

}  // namespace
