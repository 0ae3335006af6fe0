// Drawing one bitmap into another.
#include <vorl/Data/dDIB.h>

#include <gtest/gtest.h>

#include <string>

#include "../Support/LogRecorder.h"
#include "DibTesting.h"

namespace {

unsigned char& Byte(const dDIB& dib, int x, int y, int channel) {
  return *static_cast<unsigned char*>(dib.GetDataPtr(x, y, channel));
}

/// The operation on two bytes, for the three that are tested.
int Combined(int source, int target, DWORD operation) {
  return operation == SRCCOPY ? source : operation == SRCAND ? source & target : source ^ target;
}

TEST(dDIBCombine, DrawsTheSourceAtItsPlaceByTheOperation) {
  for (const DWORD operation : {SRCCOPY, SRCAND, SRCINVERT}) {
    for (const auto& [left, top] : {std::pair{2, 1}, {-3, -2}, {6, 4}, {0, 0}}) {
      dDIB target(8, 6, 3, 8);
      FillWithCount(target);
      const dDIB before(target);
      dDIB source(5, 3, 3, 8);
      source.Fill(0x35);
      Byte(source, 1, 0, 0) = 0xF0;
      Byte(source, 4, 2, 2) = 0x0F;
      ASSERT_TRUE(target.Combine(source, left, top, static_cast<int>(operation)));
      EXPECT_EQ(target.GetStatus(), 0);
      for (int y = 0; y < 6; ++y) {
        for (int x = 0; x < 8; ++x) {
          const bool isCovered = x >= left && x < left + 5 && y >= top && y < top + 3;
          for (int channel = 0; channel < 3; ++channel) {
            const int old = Byte(before, x, y, channel);
            const int expected =
                isCovered ? Combined(Byte(source, x - left, y - top, channel), old, operation)
                          : old;
            EXPECT_EQ(Byte(target, x, y, channel), expected) << x << ", " << y << ": " << channel;
          }
        }
      }
    }
  }
}

TEST(dDIBCombine, GreySourceIsDrawnThroughItsPalette) {
  dDIB target(2, 1, 3, 8);
  dDIB source(2, 1, 1, 8);
  Byte(source, 0, 0, 0) = 10;
  Byte(source, 1, 0, 0) = 200;
  source.ResetPalette(false);
  ASSERT_TRUE(target.Combine(source, 0, 0, static_cast<int>(SRCCOPY)));
  EXPECT_EQ(Byte(target, 0, 0, 0), 245);
  EXPECT_EQ(Byte(target, 0, 0, 2), 245);
  EXPECT_EQ(Byte(target, 1, 0, 1), 55);
}

TEST(dDIBCombine, BitmapCanBeDrawnIntoItself) {
  dDIB dib(4, 1, 1, 8);
  std::memcpy(dib.GetDataPtr(), "abcd", 4);
  ASSERT_TRUE(dib.Combine(dib, 0, 0, static_cast<int>(SRCCOPY)));
  EXPECT_EQ(std::memcmp(dib.GetDataPtr(), "abcd", 4), 0);
}

TEST(dDIBCombine, SourceMayBeSelectedElsewhere) {
  dDIB target(2, 1, 1, 8);
  dDIB source(2, 1, 1, 8);
  source.Fill(0x35);
  const SelectedBitmap elsewhere(source.GetHandle());
  ASSERT_TRUE(target.Combine(source, 0, 0, static_cast<int>(SRCCOPY)));
  EXPECT_EQ(Byte(target, 1, 0, 0), 0x35);
}

TEST(dDIBCombine, BothSectionsMustBeThere) {
  dDIB dib(4, 4, 1, 8);
  dDIB empty;
  LogRecorder log;
  EXPECT_FALSE(empty.Combine(dib, 0, 0, static_cast<int>(SRCCOPY)));
  EXPECT_EQ(StatusText(empty), "Combine: missing target bitmap handle");
  EXPECT_FALSE(dib.Combine(empty, 0, 0, static_cast<int>(SRCCOPY)));
  EXPECT_EQ(StatusText(dib), "Combine: missing source bitmap handle");
  EXPECT_TRUE(dib.Combine(dib, 0, 0, static_cast<int>(SRCCOPY)));
  EXPECT_EQ(dib.GetStatus(), 0);
  EXPECT_EQ(log.errors,
            (std::vector<std::string>{"dDIB::Combine: Combine: missing target bitmap handle",
                                      "dDIB::Combine: Combine: missing source bitmap handle"}));
}

TEST(dDIBCombine, SystemsReasonIsTold) {
  dDIB target(4, 4, 1, 8);
  dDIB source(4, 4, 1, 8);
  const SelectedBitmap elsewhere(target.GetHandle());
  EXPECT_FALSE(target.Combine(source, 0, 0, static_cast<int>(SRCCOPY)));
  const std::string text = StatusText(target);
  EXPECT_EQ(text.substr(0, 23), "Combine: BitBlt error:'") << text;
#if !defined(_WIN32)
  EXPECT_EQ(text, "Combine: BitBlt error:'the object is in use'");
#endif
  EXPECT_EQ(text.back(), '\'');
}

}  // namespace
