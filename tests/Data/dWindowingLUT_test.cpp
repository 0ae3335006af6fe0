#include <vorl/Data/dWindowingLUT.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <vector>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"
#include "LUTTesting.h"

namespace {

using CountingWindow = CountingLUT<dWindowingLUT>;

TEST(dWindowingLUT, IsRegisteredUnderdLUT) {
  EXPECT_STREQ(dWindowingLUT::CI().name, "dWindowingLUT");
  ASSERT_NE(dWindowingLUT::CI().parents, nullptr);
  EXPECT_EQ(dWindowingLUT::CI().parents[0], &dLUT::CI());
  const std::unique_ptr<dWindowingLUT> table(dWindowingLUT::Create());
  EXPECT_EQ(table->GetClassInfo(), &dWindowingLUT::CI());
}

TEST(dWindowingLUT, StartsComputedWithItsDefaults) {
  CountingWindow table;
  EXPECT_TRUE(table.IsValid());
  EXPECT_EQ(table.GetWinCenter(), 32768);
  EXPECT_EQ(table.GetWinWidth(), 65536);
  EXPECT_EQ(table.GetSize(), 65536);
  EXPECT_EQ(table.GetNumChannels(), 1);
  EXPECT_EQ(table.GetType(), LUTType_U8);
  EXPECT_EQ(table.GetStartIndex(), 0);
  EXPECT_FALSE(table.IsMarked());
  ExpectStatus(table.GetStatus(), 0, "");
  const unsigned char* entries = table.GetLUT(0);
  for (int i = 0; i < 65536; ++i) {
    ASSERT_EQ(entries[i], (32768 + 255 * i) / 65536) << i;
  }
  EXPECT_EQ(entries[0], 0);
  EXPECT_EQ(entries[65535], 255);
}

// L = 99 and U = 101: 0.5 and 128.0 inside.
TEST(dWindowingLUT, TheNarrowestWindowHasTwoEntries) {
  dWindowingLUT table;
  table.SetWindow(100, 2);
  table.SetLimits(3, 200);
  const std::vector<int> entries = Entries(table);
  EXPECT_EQ(std::count(entries.begin(), entries.begin() + 99, 3), 99);
  EXPECT_EQ(entries[99], 0);
  EXPECT_EQ(entries[100], 128);
  EXPECT_EQ(std::count(entries.begin() + 101, entries.end(), 200), 65536 - 101);
}

// An odd width: L = 10 - 1 = 9, U = 12, steps of a third of 30.
TEST(dWindowingLUT, HalfOfAnOddWidthIsTruncated) {
  dWindowingLUT table;
  table.SetWindow(10, 3);
  table.SetTargetRange(100, 130);
  const std::vector<int> entries = Entries(table);
  EXPECT_EQ(entries[8], 0);
  EXPECT_EQ(entries[9], 100);
  EXPECT_EQ(entries[10], 110);
  EXPECT_EQ(entries[11], 120);
  EXPECT_EQ(entries[12], 255);
}

TEST(dWindowingLUT, TheTargetMayFall) {
  dWindowingLUT table;
  table.SetWindow(2, 4);
  table.SetTargetRange(200, 100);
  const std::vector<int> entries = Entries(table);
  EXPECT_EQ(entries[0], 200);
  EXPECT_EQ(entries[1], 175);
  EXPECT_EQ(entries[2], 150);
  EXPECT_EQ(entries[3], 125);
  EXPECT_EQ(entries[4], 255);
}

// L = -2 and U = 6: half a window lies below the samples, and its steps of 10 count.
TEST(dWindowingLUT, AWindowThatBeginsBelowTheSamplesIsEnteredOnItsWay) {
  dWindowingLUT table;
  table.SetWindow(2, 8);
  table.SetTargetRange(0, 80);
  table.SetLimits(9, 99);
  const std::vector<int> entries = Entries(table);
  EXPECT_EQ(std::vector<int>(entries.begin(), entries.begin() + 7),
            (std::vector<int>{20, 30, 40, 50, 60, 70, 99}));
}

TEST(dWindowingLUT, SignedSamplesBeginAtTheirSmallest) {
  dWindowingLUT table;
  table.SetSignedSource(true);
  table.SetWindow(-32766, 4);  // L = -32768
  table.SetTargetRange(0, 40);
  const std::vector<int> entries = Entries(table);
  EXPECT_EQ(table.GetStartIndex(), -32768);
  EXPECT_EQ(std::vector<int>(entries.begin(), entries.begin() + 5),
            (std::vector<int>{0, 10, 20, 30, 255}));
  table.SetSignedSource(false);
  EXPECT_EQ(table.GetStartIndex(), -32768);  // until it is computed
  table.GetLUT(0);
  EXPECT_EQ(table.GetStartIndex(), 0);
}

TEST(dWindowingLUT, TheNextComputationClampsCentreAndWidth) {
  struct Case {
    bool isSigned;
    int center;
    int width;
    int clampedCenter;
    int clampedWidth;
  };
  const Case cases[] = {{false, -1, 100, 0, 100},
                        {false, 65536, 100, 65536, 100},
                        {false, 65537, 100, 65536, 100},
                        {true, 40000, 100, 32767, 100},
                        {true, -32769, 100, -32768, 100},
                        {true, -32768, 100, -32768, 100},
                        {false, 5, 0, 5, 2},
                        {false, 5, 1, 5, 2},
                        {false, 5, -7, 5, 2},
                        {false, 5, 65537, 5, 65536},
                        {false, -2147483647 - 1, -2147483647 - 1, 0, 2},
                        {true, 2147483647, 2147483647, 32767, 65536}};
  for (const Case& c : cases) {
    SCOPED_TRACE(testing::Message() << c.isSigned << " " << c.center << " " << c.width);
    dWindowingLUT table;
    table.SetSignedSource(c.isSigned);
    table.SetWindow(c.center, c.width);
    EXPECT_EQ(table.GetWinCenter(), c.center);
    EXPECT_EQ(table.GetWinWidth(), c.width);
    table.GetLUT(0);
    EXPECT_EQ(table.GetWinCenter(), c.clampedCenter);
    EXPECT_EQ(table.GetWinWidth(), c.clampedWidth);
  }
}

TEST(dWindowingLUT, OnlyAChangeMarksTheTable) {
  CountingWindow table;
  const auto isMarked = [&] {
    const bool marked = table.IsMarked();
    table.GetLUT(0);
    return marked;
  };
  table.SetWindow(32768, 65536);
  table.SetWinCenter(32768);
  table.SetWinWidth(65536);
  table.SetTargetRange(0, 255);
  table.SetLimits(0, 255);
  table.SetSignedSource(false);
  EXPECT_FALSE(isMarked());
  EXPECT_EQ(table.calculations, 0);
  table.SetWinCenter(1000);
  EXPECT_TRUE(isMarked());
  table.SetWinWidth(200);
  EXPECT_TRUE(isMarked());
  table.SetWindow(1001, 200);
  EXPECT_TRUE(isMarked());
  table.SetWindow(1001, 201);
  EXPECT_TRUE(isMarked());
  table.SetWindow(1001, 201);
  EXPECT_FALSE(isMarked());
  table.SetTargetRange(1, 255);
  EXPECT_TRUE(isMarked());
  table.SetTargetRange(1, 254);
  EXPECT_TRUE(isMarked());
  table.SetLimits(1, 255);
  EXPECT_TRUE(isMarked());
  table.SetLimits(1, 254);
  EXPECT_TRUE(isMarked());
  table.SetSignedSource(true);
  EXPECT_TRUE(isMarked());
  EXPECT_EQ(table.calculations, 9);
}

TEST(dWindowingLUT, TheImageConversionComputesAgainUntilGetLUTIsCalled) {
  CountingWindow table;
  table.SetWinCenter(5);
  for (int conversions = 1; conversions <= 3; ++conversions) {
    const dImage& image = table;
    EXPECT_EQ(image.GetWidth(), 65536u);
    EXPECT_EQ(table.calculations, conversions);
    EXPECT_TRUE(table.IsMarked());
  }
  table.GetLUT(0);
  EXPECT_EQ(table.calculations, 4);
  EXPECT_FALSE(table.IsMarked());
  const dImage& image = table;
  EXPECT_TRUE(image.IsValid());
  EXPECT_EQ(table.calculations, 4);
}

TEST(dWindowingLUT, ResetLeavesZerosUntilSomethingChanges) {
  CountingWindow table;
  dBCGLUT stage;
  stage.SetBrightness(1.0);
  table.SetBCGLUT(&stage);
  table.SetWindow(100, 50);
  table.SetTargetRange(10, 20);
  table.SetLimits(30, 40);
  table.GetLUT(0);
  table.SetWinCenter(101);  // still marked when it is reset
  const unsigned char* const storage =
      static_cast<unsigned char*>(static_cast<dImage&>(table).GetDataPtr());
  const int before = table.calculations;
  table.Reset();
  EXPECT_TRUE(table.IsValid());
  EXPECT_EQ(table.GetWinCenter(), 32768);
  EXPECT_EQ(table.GetWinWidth(), 65536);
  EXPECT_EQ(table.GetLUT(0), storage);
  EXPECT_EQ(Entries(table), std::vector<int>(65536, 0));
  EXPECT_EQ(table.calculations, before);
  // All other values are the defaults, and the second stage is gone.
  dWindowingLUT fresh;
  fresh.SetWinCenter(32767);
  table.SetWinCenter(32767);
  EXPECT_EQ(Entries(table), Entries(fresh));
  table.SetWindow(32768, 2);
  EXPECT_EQ(Entries(table)[0], 0);
  EXPECT_EQ(Entries(table)[65535], 255);
}

TEST(dWindowingLUT, InitIsRefusedWithoutALogRecord) {
  dWindowingLUT table;
  dLUT& base = table;
  const LogRecorder log;
  EXPECT_FALSE(base.Init(10, LUTType_U8, 1, 0));
  ExpectStatus(table.GetStatus(), -1,
               "Don't call 'Init' for a 'dWindowingLUT' object. It has been initialized during "
               "construction");
  EXPECT_TRUE(log.errors.empty());
  EXPECT_EQ(table.GetSize(), 65536);
  EXPECT_EQ(table.GetLUT(0)[65535], 255);
}

}  // namespace
