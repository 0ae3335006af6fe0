#include <vorl/Data/dLUT.h>

#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"
#include "LUTTesting.h"

namespace {

/// A plain table whose computation neither clears nor lowers the mark.
class RampLUT : public dLUT {
 public:
  void Mark() { m_recalculate = true; }
  bool IsMarked() const { return m_recalculate; }
  void Reset() override {
    ++resets;
    dLUT::Reset();
  }

  int calculations = 0;
  int resets = 0;

 protected:
  bool CalculateLUT() override {
    ++calculations;
    auto* entries = static_cast<unsigned char*>(m_table.GetDataPtr());
    for (unsigned long i = 0; i < m_table.GetImageSize(); ++i) {
      entries[i] = static_cast<unsigned char>(calculations);
    }
    return true;
  }
};

void ExpectNoTable(dLUT& table) {
  EXPECT_FALSE(table.IsValid());
  EXPECT_EQ(table.GetType(), 8);
  EXPECT_EQ(table.GetStartIndex(), 0);
  EXPECT_EQ(table.GetSize(), 0);
  EXPECT_EQ(table.GetNumChannels(), 0);
  EXPECT_EQ(table.GetDataDepth(), 8);
  EXPECT_EQ(table.GetLUT(0), nullptr);
}

TEST(dLUT, IsRegisteredUnderDataBase) {
  EXPECT_STREQ(dLUT::CI().name, "dLUT");
  ASSERT_NE(dLUT::CI().parents, nullptr);
  EXPECT_EQ(dLUT::CI().parents[0], &DataBase::CI());
  const std::unique_ptr<dLUT> table(dLUT::Create());
  EXPECT_EQ(table->GetClassInfo(), &dLUT::CI());
}

TEST(dLUT, StartsWithoutATable) {
  dLUT table;
  ExpectNoTable(table);
}

TEST(dLUT, InitMakesOneRowOfZerosPerChannel) {
  dLUT table;
  EXPECT_TRUE(table.Init(10, LUTType_U8, 3, -5));
  EXPECT_TRUE(table.IsValid());
  EXPECT_EQ(table.GetType(), LUTType_U8);
  EXPECT_EQ(table.GetSize(), 10);
  EXPECT_EQ(table.GetNumChannels(), 3);
  EXPECT_EQ(table.GetStartIndex(), -5);
  EXPECT_EQ(table.GetDataDepth(), 8);
  ExpectStatus(table.GetStatus(), 0, "");
  const dImage& image = table;
  EXPECT_EQ(image.GetWidth(), 10u);
  EXPECT_EQ(image.GetHeight(), 3u);
  EXPECT_STREQ(image.GetChannelSequence(), "G");
  EXPECT_EQ(image.GetDataOrder(), 0);
  EXPECT_EQ(image.GetRowAlignment(), 4);
  EXPECT_EQ(BytesOf(image), Bytes(36, 0));
  for (int channel = 0; channel < 3; ++channel) {
    EXPECT_EQ(table.GetLUT(channel), image.GetRowPtr(channel));
    EXPECT_EQ(table.GetLUT(channel), table.GetLUT(0) + 12 * channel);
  }
}

TEST(dLUT, InitTakesEveryImageDataType) {
  dLUT table;
  EXPECT_TRUE(table.Init(4, static_cast<LUTType>(ImageDataType_S16), 1, 0));
  EXPECT_EQ(table.GetType(), 0x1010);
  EXPECT_EQ(table.GetDataDepth(), 16);
  EXPECT_EQ(static_cast<dImage&>(table).GetDataType(), ImageDataType_S16);
}

TEST(dLUT, InitResetsAndComputesThroughTheVirtualFunctions) {
  RampLUT table;
  EXPECT_TRUE(table.Init(4, LUTType_U8, 1, 0));
  EXPECT_EQ(table.resets, 1);
  EXPECT_EQ(table.calculations, 1);
  EXPECT_EQ(table.GetLUT(0)[3], 1);
  EXPECT_FALSE(table.Init(4, static_cast<LUTType>(12), 1, 0));
  EXPECT_EQ(table.resets, 2);
  EXPECT_EQ(table.calculations, 1);
}

TEST(dLUT, InitFailsWithTheTableImagesMessage) {
  struct Case {
    long size;
    int type;
    int channels;
    const char* message;
  };
  const Case cases[] = {{4, 12, 1, "invalid 'DataType': 12"},
                        {4, 0, 1, "invalid 'DataType': 0"},
                        {4, 0x10008, 1, "invalid 'DataType': 0"},
                        {4, -8, 1, "invalid 'DataType': 0"},
                        {65536, 8, 65536, "no memory(4294967296 bytes required)"}};
  for (const Case& c : cases) {
    SCOPED_TRACE(c.message);
    dLUT table;
    ASSERT_TRUE(table.Init(10, LUTType_U8, 3, -5));
    const LogRecorder log;
    EXPECT_FALSE(table.Init(c.size, static_cast<LUTType>(c.type), c.channels, 7));
    ExpectNoTable(table);
    const std::string message = std::string("LUT initialization error: ") + c.message;
    ExpectStatus(table.GetStatus(), -1, message);
    ASSERT_EQ(log.errors.size(), 2u);
    EXPECT_EQ(log.errors[0], std::string("dImage::Init: ") + c.message);
    EXPECT_EQ(log.errors[1], "dLUT::Init: " + message);
  }
}

TEST(dLUT, InitRefusesNegativeCountsAndIndicesBeyond32Bits) {
  dLUT table;
  EXPECT_FALSE(table.Init(-1, LUTType_U8, 1, 0));
  ExpectNoTable(table);
  EXPECT_FALSE(table.Init(1, LUTType_U8, -1, 0));
  ExpectNoTable(table);
  EXPECT_TRUE(table.Init(1, LUTType_U8, 1, 0x7FFFFFFFL));
  EXPECT_EQ(table.GetStartIndex(), 0x7FFFFFFFL);
  if (sizeof(long) > 4) {
    EXPECT_FALSE(table.Init(5, LUTType_U8, 1, static_cast<long>(0x80000000LL)));
    ExpectNoTable(table);
    ExpectStatus(table.GetStatus(), -1, "LUT initialization error: no memory(8 bytes required)");
  }
}

TEST(dLUT, InitWithoutEntriesGivesNoTable) {
  dLUT table;
  EXPECT_FALSE(table.Init(0, LUTType_U8, 1, 3));
  EXPECT_FALSE(table.IsValid());
  EXPECT_EQ(table.GetLUT(0), nullptr);
}

TEST(dLUT, ResetDropsTheTable) {
  RampLUT table;
  ASSERT_TRUE(table.Init(10, static_cast<LUTType>(16), 3, -5));
  table.Mark();
  table.Reset();
  EXPECT_FALSE(table.IsMarked());
  ExpectNoTable(table);
}

TEST(dLUT, GetLUTComputesAMarkedTableOnce) {
  RampLUT table;
  ASSERT_TRUE(table.Init(4, LUTType_U8, 2, 0));
  EXPECT_EQ(table.GetLUT(1)[0], 1);
  table.Mark();
  EXPECT_EQ(table.GetLUT(1)[0], 2);
  EXPECT_EQ(table.GetLUT(0)[0], 2);
  EXPECT_EQ(table.calculations, 2);
}

TEST(dLUT, TheImageConversionComputesAgainUntilGetLUTIsCalled) {
  RampLUT table;
  ASSERT_TRUE(table.Init(4, LUTType_U8, 1, 0));
  const auto first = [&] {
    const dImage& image = table;
    return *static_cast<const unsigned char*>(image.GetDataPtr());
  };
  EXPECT_EQ(first(), 1);
  table.Mark();
  EXPECT_EQ(first(), 2);
  EXPECT_EQ(first(), 3);
  EXPECT_EQ(table.GetLUT(0)[0], 4);
  EXPECT_EQ(first(), 4);
}

TEST(dLUT, TheBaseComputationZeroesAndLowersTheMark) {
  CountingLUT<dLUT> table;
  ASSERT_TRUE(table.Init(4, LUTType_U8, 1, 0));
  EXPECT_EQ(table.calculations, 1);
  table.GetLUT(0)[2] = 9;
  table.Mark();
  EXPECT_TRUE(table.Calculate());
  EXPECT_FALSE(table.IsMarked());
  EXPECT_EQ(Entries(table), std::vector<int>(4, 0));
  table.Reset();
  EXPECT_FALSE(table.Calculate());
}

TEST(dLUT, CopiesTakeTableTypeStartIndexAndMark) {
  CountingLUT<dLUT> table;
  ASSERT_TRUE(table.Init(4, static_cast<LUTType>(16), 2, -3));
  table.GetLUT(1)[5] = 9;
  const auto expectCopy = [&](CountingLUT<dLUT>& copy) {
    EXPECT_EQ(copy.IsMarked(), table.IsMarked());
    EXPECT_EQ(copy.GetType(), 16);
    EXPECT_EQ(copy.GetStartIndex(), -3);
    EXPECT_EQ(copy.GetSize(), 4);
    EXPECT_EQ(copy.GetNumChannels(), 2);
  };
  CountingLUT<dLUT> copy(table);
  expectCopy(copy);
  EXPECT_EQ(copy.GetLUT(1)[5], 9);
  EXPECT_NE(copy.GetLUT(0), table.GetLUT(0));

  table.Mark();
  CountingLUT<dLUT> assigned;
  assigned = table;
  expectCopy(assigned);
  EXPECT_TRUE(assigned.IsMarked());
  EXPECT_EQ(assigned.GetLUT(1)[5], 0);  // computed

  const CountingLUT<dLUT>& same = assigned;
  assigned = same;
  EXPECT_TRUE(assigned.IsValid());
  EXPECT_EQ(assigned.GetStartIndex(), -3);
}

}  // namespace
