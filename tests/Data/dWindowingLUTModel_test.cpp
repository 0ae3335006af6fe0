// Windowing tables against a plain model, and their second stage.

#include <vorl/Data/dWindowingLUT.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <vector>

#include "ImageTesting.h"
#include "LUTTesting.h"

namespace {

using CountingWindow = CountingLUT<dWindowingLUT>;

struct Window {
  int center;
  int width;
  bool isSigned;
  unsigned char low;
  unsigned char high;
  unsigned char lower;
  unsigned char upper;
};

/// The entries by definition, one sample after another.
std::vector<int> PlainEntries(const Window& w, const std::vector<int>& secondStage) {
  const int base = w.isSigned ? -32768 : 0;
  int center = std::min(w.center, w.isSigned ? 32767 : 65536);
  center = std::max(center, base);
  const int width = std::max(2, std::min(w.width, 65536));
  const double lowerEdge = center - width / 2;
  const double upperEdge = lowerEdge + width;
  double v = w.low + 0.5;
  const double s = (w.high - w.low) / (upperEdge - lowerEdge);
  if (lowerEdge < base) {
    v = v + (base - lowerEdge) * s;
  }
  std::vector<int> entries;
  for (int x = base; x < base + 65536; ++x) {
    if (x < lowerEdge) {
      entries.push_back(w.lower);
    } else if (x >= upperEdge) {
      entries.push_back(w.upper);
    } else {
      const int level = static_cast<int>(v) & 255;
      entries.push_back(secondStage.empty() ? level : secondStage[static_cast<std::size_t>(level)]);
      v = v + s;
    }
  }
  return entries;
}

Window RandomWindow(std::mt19937& random) {
  const auto between = [&](int low, int high) {
    return std::uniform_int_distribution<int>(low, high)(random);
  };
  const int widths[] = {between(-10, 10), between(0, 300), between(0, 70000), 65536};
  Window w;
  w.isSigned = between(0, 1) == 1;
  w.center = between(-70000, 70000);
  w.width = widths[between(0, 3)];
  w.low = static_cast<unsigned char>(between(0, 255));
  w.high = static_cast<unsigned char>(between(0, 255));
  w.lower = static_cast<unsigned char>(between(0, 255));
  w.upper = static_cast<unsigned char>(between(0, 255));
  return w;
}

void Apply(const Window& w, dWindowingLUT& table) {
  table.SetSignedSource(w.isSigned);
  table.SetWindow(w.center, w.width);
  table.SetTargetRange(w.low, w.high);
  table.SetLimits(w.lower, w.upper);
}

TEST(dWindowingLUTModel, IsFollowedWithAndWithoutASecondStage) {
  std::mt19937 random(1895);
  dWindowingLUT table;
  dBCGLUT stage;
  for (int round = 0; round < 250; ++round) {
    const Window w = RandomWindow(random);
    Apply(w, table);
    std::vector<int> stageEntries;
    if (round % 2 == 0) {
      stage.SetBCG(0.3, 0.2, 0.5 + round % 5);
      table.SetBCGLUT(&stage);
      stageEntries = Entries(stage);
    } else {
      table.SetBCGLUT(nullptr);
    }
    ASSERT_EQ(Entries(table), PlainEntries(w, stageEntries))
        << "round " << round << ": centre " << w.center << " width " << w.width << " signed "
        << w.isSigned << " target " << int{w.low} << " to " << int{w.high};
    EXPECT_EQ(table.GetStartIndex(), w.isSigned ? -32768 : 0);
  }
}

TEST(dWindowingLUTModel, TheSecondStageActsInsideTheWindowOnly) {
  dWindowingLUT table;
  dBCGLUT stage;
  stage.SetBrightness(1.0);  // 255 throughout
  table.SetWindow(100, 2);
  table.SetLimits(3, 200);
  table.SetBCGLUT(&stage);
  const std::vector<int> entries = Entries(table);
  EXPECT_EQ(entries[98], 3);
  EXPECT_EQ(entries[99], 255);
  EXPECT_EQ(entries[100], 255);
  EXPECT_EQ(entries[101], 200);
}

TEST(dWindowingLUTModel, AttachingAlwaysMarks) {
  CountingWindow table;
  dBCGLUT stage;
  for (dBCGLUT* attached :
       {&stage, &stage, static_cast<dBCGLUT*>(nullptr), static_cast<dBCGLUT*>(nullptr)}) {
    table.SetBCGLUT(attached);
    EXPECT_TRUE(table.IsMarked());
    table.GetLUT(0);
    EXPECT_FALSE(table.IsMarked());
  }
}

TEST(dWindowingLUTModel, ComputesAMarkedSecondStageAndLowersItsMark) {
  CountingWindow table;
  CountingLUT<dBCGLUT> stage;
  table.SetBCGLUT(&stage);
  table.GetLUT(0);
  EXPECT_EQ(stage.calculations, 0);
  stage.SetBrightness(1.0);
  EXPECT_FALSE(table.IsMarked());
  EXPECT_EQ(table.GetLUT(0)[0], 0);  // not seen before this table is computed again
  table.SetLimits(1, 255);
  EXPECT_EQ(table.GetLUT(0)[0], 255);
  EXPECT_EQ(stage.calculations, 1);
  EXPECT_FALSE(stage.IsMarked());
  table.SetLimits(2, 255);
  table.GetLUT(0);
  EXPECT_EQ(stage.calculations, 1);
}

TEST(dWindowingLUTModel, CopiesShareTheSecondStage) {
  CountingWindow table;
  dBCGLUT stage;
  const Window w = {-100, 300, true, 20, 240, 1, 2};
  Apply(w, table);
  table.SetBCGLUT(&stage);
  CountingWindow copy(table);
  CountingWindow assigned;
  assigned = table;
  stage.SetContrast(0.7);
  const std::vector<int> expected = PlainEntries(w, Entries(stage));
  for (CountingWindow* other : {&copy, &assigned}) {
    EXPECT_TRUE(other->IsMarked());
    EXPECT_EQ(other->GetWinCenter(), -100);
    EXPECT_EQ(other->GetWinWidth(), 300);
    EXPECT_EQ(Entries(*other), expected);
    EXPECT_EQ(other->GetStartIndex(), -32768);
    EXPECT_NE(other->GetLUT(0), table.GetLUT(0));
  }
}

TEST(dWindowingLUTModel, CopiesTakeAComputedTableAsItIs) {
  CountingWindow table;
  table.SetWindow(50, 10);
  const std::vector<int> entries = Entries(table);
  CountingWindow copy(table);
  copy.calculations = 0;
  EXPECT_EQ(Entries(copy), entries);
  EXPECT_EQ(copy.calculations, 0);
}

TEST(dWindowingLUTModel, ALostTableIsNotWrittenAndALostSecondStageNotRead) {
  CountingWindow table;
  dImage& image = table;
  image.Reset();
  table.SetWinCenter(5);
  EXPECT_FALSE(table.Calculate());
  EXPECT_EQ(table.GetLUT(0), nullptr);
  ASSERT_TRUE(image.Init(65535, 1, 8, "G", 0, 1));
  image.Fill(7);
  EXPECT_FALSE(table.Calculate());
  EXPECT_EQ(BytesOf(image), Bytes(65535, 7));

  for (const unsigned long width : {0UL, 255UL}) {
    dBCGLUT stage;
    static_cast<dImage&>(stage).Reset();
    ASSERT_TRUE(static_cast<dImage&>(stage).Init(width, 1, 8, "G", 0, 1));
    dWindowingLUT window;
    window.SetWindow(100, 2);
    window.SetBCGLUT(&stage);
    EXPECT_EQ(window.GetLUT(0)[100], 128);
  }
}

}  // namespace
