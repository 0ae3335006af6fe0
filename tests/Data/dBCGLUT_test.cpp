#include <vorl/Data/dBCGLUT.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <random>
#include <vector>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"
#include "LUTTesting.h"

namespace {

/// The entries by definition: the line, value by value, then the part between its ends bent.
std::vector<int> PlainEntries(double b, double c, double g) {
  const double a = (c + 1.0) * 45.0 / 180.0 * 3.141592;
  const double k = std::cos(a) < 0.001 ? 0.001 : std::cos(a);
  const double m = std::sin(a) / k;
  std::vector<double> line;
  for (double v = 256.0 - (m + 1.0) * (1.0 - b) * 128.0; line.size() < 256; v += m) {
    line.push_back(v);
  }
  std::vector<int> entries;
  double vmin = 255.0;
  double vmax = 0.0;
  std::size_t first = 0;
  std::size_t last = 0;
  for (std::size_t i = 0; i < line.size(); ++i) {
    const double v = line[i];
    entries.push_back(v < 0 ? 0 : v >= 256 ? 255 : static_cast<int>(std::floor(v)));
    if (v >= 0 && v < 256 && v < vmin) {
      vmin = v;
      first = i;
    }
    if (v >= 0 && v < 256 && v > vmax) {
      vmax = v;
      last = i;
    }
  }
  for (std::size_t i = first; g != 1.0 && i < last; ++i) {
    const double above = entries[i] < vmin ? 0.0 : (entries[i] - vmin) / (vmax - vmin);
    entries[i] = static_cast<int>(std::floor(std::pow(above, 1.0 / g) * (vmax - vmin) + vmin));
  }
  return entries;
}

TEST(dBCGLUT, IsRegisteredUnderdLUT) {
  EXPECT_STREQ(dBCGLUT::CI().name, "dBCGLUT");
  ASSERT_NE(dBCGLUT::CI().parents, nullptr);
  EXPECT_EQ(dBCGLUT::CI().parents[0], &dLUT::CI());
  const std::unique_ptr<dBCGLUT> table(dBCGLUT::Create());
  EXPECT_EQ(table->GetClassInfo(), &dBCGLUT::CI());
}

TEST(dBCGLUT, StartsComputedWithItsDefaults) {
  CountingLUT<dBCGLUT> table;
  EXPECT_TRUE(table.IsValid());
  EXPECT_EQ(table.GetBrightness(), 0.0);
  EXPECT_EQ(table.GetContrast(), 0.0);
  EXPECT_EQ(table.GetGamma(), 1.0);
  EXPECT_EQ(table.GetSize(), 256);
  EXPECT_EQ(table.GetNumChannels(), 1);
  EXPECT_EQ(table.GetType(), LUTType_U8);
  EXPECT_EQ(table.GetStartIndex(), 0);
  EXPECT_FALSE(table.IsMarked());
  ExpectStatus(table.GetStatus(), 0, "");
}

// The slope is 0.99999967 about entry 128, where rounding decides.
TEST(dBCGLUT, TheDefaultsAreNotTheIdentity) {
  dBCGLUT table;
  const std::vector<int> entries = Entries(table);
  for (int i = 0; i < 256; ++i) {
    if (i != 128) {
      EXPECT_EQ(entries[static_cast<std::size_t>(i)], i < 128 ? i : i - 1) << i;
    }
  }
  EXPECT_EQ(entries[255], 254);
  EXPECT_EQ(entries, PlainEntries(0, 0, 1));
}

TEST(dBCGLUT, FollowsThePlainModel) {
  std::mt19937 random(4711);
  const auto between = [&](double low, double high) {
    return std::uniform_real_distribution<double>(low, high)(random);
  };
  dBCGLUT table;
  for (int round = 0; round < 3000; ++round) {
    // Every tenth value lies at an end of its range or at its default.
    const auto pick = [&](double low, double middle, double high) {
      const double special[] = {low, middle, high};
      return random() % 10 == 0 ? special[random() % 3] : between(low, high);
    };
    const double b = pick(-1, 0, 1);
    const double c = pick(-1, 0, 1);
    const double g = pick(0.01, 1, 10);
    table.SetBCG(b, c, g);
    ASSERT_EQ(Entries(table), PlainEntries(b, c, g)) << b << " " << c << " " << g;
  }
}

TEST(dBCGLUT, FullContrastIsAStep) {
  dBCGLUT table;
  table.SetContrast(1.0);
  // 256 - 1001 * 128 + 1000 * i is negative up to 127, about 128 at 128, and above 255 from 129.
  std::vector<int> entries = Entries(table);
  for (std::size_t i = 0; i < 256; ++i) {
    if (i != 128) {
      EXPECT_EQ(entries[i], i < 128 ? 0 : 255) << i;
    }
  }
  EXPECT_NEAR(entries[128], 128, 1);
  table.SetBrightness(0.5);  // 256 - 1001 * 64 + 1000 * i
  entries = Entries(table);
  for (std::size_t i = 0; i < 256; ++i) {
    if (i != 64) {
      EXPECT_EQ(entries[i], i < 64 ? 0 : 255) << i;
    }
  }
  EXPECT_NEAR(entries[64], 192, 1);
}

TEST(dBCGLUT, TheEndsOfBrightnessAndContrastGiveConstants) {
  dBCGLUT table;
  table.SetBrightness(1.0);
  EXPECT_EQ(Entries(table), std::vector<int>(256, 255));
  table.SetBCG(1.0, 1.0, 3.0);
  EXPECT_EQ(Entries(table), std::vector<int>(256, 255));
  table.SetBCG(-1.0, 0.0, 1.0);
  EXPECT_EQ(Entries(table), std::vector<int>(256, 0));
  table.SetBCG(0.0, -1.0, 1.0);  // slope 0
  EXPECT_EQ(Entries(table), std::vector<int>(256, 128));
  table.SetBCG(0.5, -1.0, 5.0);
  EXPECT_EQ(Entries(table), std::vector<int>(256, 192));
}

TEST(dBCGLUT, GammaBendsAllButTheLastEntry) {
  dBCGLUT table;
  table.SetGamma(2.0);
  std::vector<int> entries = Entries(table);
  EXPECT_EQ(entries[0], 0);
  EXPECT_EQ(entries[16], 63);    // sqrt(16 * 255) = 63.9
  EXPECT_EQ(entries[64], 127);   // sqrt(64 * 255) = 127.7
  EXPECT_EQ(entries[201], 225);  // sqrt(200 * 255) = 225.8
  EXPECT_EQ(entries[255], 254);  // as it was
  table.SetGamma(0.5);
  entries = Entries(table);
  EXPECT_EQ(entries[100], 39);   // 100 * 100 / 255 = 39.2
  EXPECT_EQ(entries[201], 156);  // 200 * 200 / 255 = 156.9
  EXPECT_EQ(entries[255], 254);
}

TEST(dBCGLUT, ValuesAreClamped) {
  dBCGLUT table;
  table.SetBCG(7, 8, 9.5);
  EXPECT_EQ(table.GetBrightness(), 1.0);
  EXPECT_EQ(table.GetContrast(), 1.0);
  EXPECT_EQ(table.GetGamma(), 9.5);
  table.SetBCG(-7, -8, 11);
  EXPECT_EQ(table.GetBrightness(), -1.0);
  EXPECT_EQ(table.GetContrast(), -1.0);
  EXPECT_EQ(table.GetGamma(), 10.0);
  table.SetGamma(-std::numeric_limits<double>::infinity());
  EXPECT_EQ(table.GetGamma(), 0.01);
}

TEST(dBCGLUT, WhatIsNotANumberIsIgnored) {
  CountingLUT<dBCGLUT> table;
  const double nan = std::numeric_limits<double>::quiet_NaN();
  table.SetBCG(nan, nan, nan);
  table.SetBCGRelative(nan, nan, nan);
  EXPECT_EQ(table.GetBrightness(), 0.0);
  EXPECT_EQ(table.GetContrast(), 0.0);
  EXPECT_EQ(table.GetGamma(), 1.0);
  EXPECT_FALSE(table.IsMarked());
}

TEST(dBCGLUT, RelativeStepsSaturate) {
  dBCGLUT table;
  table.SetBCGRelative(0.6, -0.6, 5.0);
  EXPECT_EQ(table.GetBrightness(), 0.6);
  EXPECT_EQ(table.GetContrast(), -0.6);
  EXPECT_EQ(table.GetGamma(), 6.0);
  table.SetBCGRelative(0.6, -0.6, 5.0);
  EXPECT_EQ(table.GetBrightness(), 1.0);
  EXPECT_EQ(table.GetContrast(), -1.0);
  EXPECT_EQ(table.GetGamma(), 10.0);
  table.SetBCGRelative(-0.25, 0.0, -20.0);
  EXPECT_EQ(table.GetBrightness(), 0.75);
  EXPECT_EQ(table.GetGamma(), 0.01);
}

TEST(dBCGLUT, OnlyAChangeMarksTheTable) {
  CountingLUT<dBCGLUT> table;
  const auto isMarked = [&] {
    const bool marked = table.IsMarked();
    table.GetLUT(0);
    return marked;
  };
  table.SetBCG(0.0, 0.0, 1.0);
  table.SetBCGRelative(0.0, 0.0, 0.0);
  EXPECT_FALSE(isMarked());
  EXPECT_EQ(table.calculations, 0);
  table.SetBrightness(5.0);
  EXPECT_TRUE(isMarked());
  table.SetBrightness(2.0);  // clamped to what it is
  EXPECT_FALSE(isMarked());
  table.SetContrast(0.1);
  EXPECT_TRUE(isMarked());
  table.SetContrast(0.1);
  EXPECT_FALSE(isMarked());
  table.SetGamma(20.0);
  EXPECT_TRUE(isMarked());
  table.SetGamma(10.0);
  EXPECT_FALSE(isMarked());
  EXPECT_EQ(table.calculations, 3);
}

TEST(dBCGLUT, ItsComputationLowersTheMark) {
  CountingLUT<dBCGLUT> table;
  table.SetContrast(0.5);
  EXPECT_EQ(table.calculations, 0);
  EXPECT_EQ(BytesOf(table)[255], 255);
  EXPECT_EQ(BytesOf(table)[255], 255);
  EXPECT_EQ(table.calculations, 1);
  table.Mark();
  EXPECT_TRUE(table.Calculate());
  EXPECT_FALSE(table.IsMarked());
}

TEST(dBCGLUT, ResetRestoresTheValuesAndKeepsTheStorage) {
  CountingLUT<dBCGLUT> table;
  const std::vector<int> defaults = Entries(table);
  const unsigned char* const storage = table.GetLUT(0);
  table.Reset();
  EXPECT_FALSE(table.IsMarked());
  table.SetBCG(0.5, 0.25, 2.0);
  EXPECT_NE(Entries(table), defaults);
  table.Reset();
  EXPECT_TRUE(table.IsValid());
  EXPECT_EQ(table.GetBrightness(), 0.0);
  EXPECT_EQ(table.GetContrast(), 0.0);
  EXPECT_EQ(table.GetGamma(), 1.0);
  EXPECT_TRUE(table.IsMarked());
  EXPECT_EQ(Entries(table), defaults);
  EXPECT_EQ(table.GetLUT(0), storage);
}

TEST(dBCGLUT, InitIsRefusedWithoutALogRecord) {
  dBCGLUT table;
  dLUT& base = table;
  const LogRecorder log;
  EXPECT_FALSE(base.Init(10, LUTType_U8, 1, 0));
  ExpectStatus(table.GetStatus(), -1,
               "Don't call 'Init' for a 'dBCGLUT' object. It has been initialized during "
               "construction");
  EXPECT_TRUE(log.errors.empty());
  EXPECT_EQ(table.GetSize(), 256);
  EXPECT_EQ(Entries(table)[200], 199);
}

TEST(dBCGLUT, CopiesTakeTableValuesAndMark) {
  CountingLUT<dBCGLUT> table;
  table.SetBCG(0.5, 0.25, 2.0);
  CountingLUT<dBCGLUT> copy(table);
  CountingLUT<dBCGLUT> assigned;
  assigned = table;
  for (CountingLUT<dBCGLUT>* other : {&copy, &assigned}) {
    EXPECT_TRUE(other->IsMarked());
    EXPECT_EQ(other->GetBrightness(), 0.5);
    EXPECT_EQ(other->GetContrast(), 0.25);
    EXPECT_EQ(other->GetGamma(), 2.0);
    EXPECT_EQ(Entries(*other), PlainEntries(0.5, 0.25, 2.0));
    EXPECT_NE(other->GetLUT(0), table.GetLUT(0));
  }
}

TEST(dBCGLUT, ALostOrSmallerTableIsNotWritten) {
  for (const unsigned long width : {0UL, 255UL}) {
    CountingLUT<dBCGLUT> table;
    dImage& image = table;
    image.Reset();
    ASSERT_TRUE(image.Init(width, 1, 8, "G", 0, 1));
    image.Fill(7);
    table.SetContrast(0.5);
    const LogRecorder log;
    EXPECT_FALSE(table.Calculate());
    ExpectStatus(table.GetStatus(), -1, "BCG LUT is not initialized");
    ASSERT_EQ(log.errors.size(), 1u);
    EXPECT_EQ(log.errors[0], "dBCGLUT::CalculateLUT: BCG LUT is not initialized");
    EXPECT_EQ(BytesOf(image), Bytes(width, 7));
  }
}

}  // namespace
