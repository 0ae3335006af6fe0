#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include <cstddef>
#include <iterator>
#include <random>
#include <string>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"

namespace {

/// A format and the layout that it asks for, counted bit by bit and byte by byte.
struct PlainLayout {
  unsigned long width;
  unsigned long height;
  unsigned short dataType;
  std::string sequence;
  unsigned long channels;
  bool planes;
  unsigned long alignment;

  unsigned long Bits() const { return dataType % 256UL; }
  unsigned long PixelBits() const { return planes ? Bits() : Bits() * channels; }
  unsigned long Alignment() const {
    unsigned long raised = alignment;
    while (raised * 8 < Bits()) {
      raised *= 2;
    }
    return raised;
  }
  unsigned long RowBytes() const {
    unsigned long bytes = 0;
    while (bytes * 8 < PixelBits() * width || bytes % Alignment() != 0) {
      ++bytes;
    }
    return bytes;
  }
  unsigned long PlaneBytes() const { return RowBytes() * height; }
  unsigned long TotalBytes() const { return planes ? PlaneBytes() * channels : PlaneBytes(); }
  unsigned long ChannelOffset() const { return planes ? PlaneBytes() * 8 : Bits(); }
};

constexpr unsigned short kTypes[] = {0x01,   0x08,   0x10,   0x20,   0x40,  0x1008,
                                     0x1010, 0x1020, 0x1040, 0x2020, 0x2040};

PlainLayout RandomLayout(std::mt19937& random) {
  const auto below = [&](unsigned limit) { return random() % limit; };
  PlainLayout layout;
  layout.width = 1 + below(40);
  layout.height = 1 + below(12);
  layout.dataType = kTypes[below(std::size(kTypes))];
  layout.channels = 1 + below(5);
  for (unsigned long i = 0; i < layout.channels; ++i) {
    layout.sequence += static_cast<char>('A' + below(26));
    layout.sequence.append(below(3), 'x');
  }
  layout.planes = layout.channels > 1 && below(2) == 1;
  layout.alignment = 1UL << below(6);
  return layout;
}

void ExpectPointers(const dImage& image, const PlainLayout& layout, std::mt19937& random) {
  const auto* start = static_cast<const char*>(image.GetDataPtr());
  const auto offset = [&](const void* p) {
    return static_cast<unsigned long>(static_cast<const char*>(p) - start);
  };
  const unsigned long x = random() % layout.width;
  const unsigned long y = random() % layout.height;
  const unsigned long c = random() % layout.channels;
  const unsigned long pixel = x * (layout.PixelBits() / 8) + y * layout.RowBytes();
  const int ix = static_cast<int>(x);
  const int iy = static_cast<int>(y);
  EXPECT_EQ(offset(image.GetDataPtr(ix, iy)), pixel);
  EXPECT_EQ(offset(image.GetDataPtr(ix, iy, static_cast<int>(c))),
            pixel + c * (layout.ChannelOffset() / 8));
  EXPECT_EQ(offset(image.GetRowPtr(iy)), y * layout.RowBytes());
}

TEST(dImageLayout, FollowsThePlainModelForRandomFormats) {
  std::mt19937 random(20240917);
  dImage image;
  for (int round = 0; round < 3000; ++round) {
    const PlainLayout layout = RandomLayout(random);
    SCOPED_TRACE(testing::Message()
                 << "round " << round << ": " << layout.width << " x " << layout.height << " '"
                 << layout.sequence << "' type " << layout.dataType << " planes " << layout.planes
                 << " alignment " << layout.alignment);
    ASSERT_TRUE(image.Init(layout.width, layout.height, layout.dataType, layout.sequence.c_str(),
                           layout.planes ? 1 : 0, static_cast<unsigned short>(layout.alignment)));
    ASSERT_TRUE(image.IsValid());
    EXPECT_EQ(image.GetWidth(), layout.width);
    EXPECT_EQ(image.GetHeight(), layout.height);
    EXPECT_EQ(image.GetNumChannels(), layout.channels);
    EXPECT_EQ(image.GetDataType(), layout.dataType);
    EXPECT_EQ(image.GetDataOrder(), layout.planes ? 1 : 0);
    EXPECT_EQ(image.GetRowAlignment(), layout.Alignment());
    EXPECT_EQ(image.GetChannelDepth(), layout.Bits());
    EXPECT_EQ(image.GetColumnOffset(), layout.PixelBits());
    EXPECT_EQ(image.GetChannelOffset(), layout.ChannelOffset());
    EXPECT_EQ(image.GetBytesPerRow(), layout.RowBytes());
    EXPECT_EQ(image.GetRowOffset(), layout.RowBytes() * 8);
    ASSERT_EQ(image.GetImageSize(), layout.TotalBytes());
    EXPECT_EQ(image.GetNumDataSamples(), layout.TotalBytes() * 8 / layout.Bits());
    EXPECT_EQ(image.GetDataSamplesPerRow(), layout.RowBytes() * 8 / layout.Bits());
    EXPECT_EQ(image.GetDataSamplesInRow(), layout.width * (layout.planes ? 1 : layout.channels));
    EXPECT_EQ(image.GetNumPlanes(), layout.planes ? layout.channels : 1);
    EXPECT_EQ(image.GetNumRows(), layout.height * (layout.planes ? layout.channels : 1));
    EXPECT_EQ(image.GetFormatID(),
              layout.channels * 256 + layout.Bits() + (layout.planes ? 0x10000 : 0));
    EXPECT_EQ(image.GetChannelSequence(), layout.sequence);
    ExpectPointers(image, layout, random);
  }
}

struct TooLarge {
  const char* name;
  unsigned long width;
  unsigned long height;
  unsigned short dataType;
  const char* sequence;
  unsigned short dataOrder;
  const char* bytes;
};

// Sizes by hand, with rows of whole four bytes. What 64 bits cannot count stays at their largest
// number.
const TooLarge kTooLarge[] = {
    {"one byte too many", 65536, 65536, 8, "G", 0, "4294967296"},
    {"channels overflow", 32768, 65536, 8, "RG", 0, "4294967296"},
    {"planes overflow", 32768, 65536, 8, "RG", 1, "4294967296"},
    {"plane offset in bits overflows", 32768, 16384, 8, "RG", 1, "1073741824"},
    {"row overflows", 4294967295, 1, 16, "G", 0, "8589934592"},
    {"padding overflows", 4294967295, 1, 8, "G", 0, "4294967296"},
    {"more than 64 bits", 4294967295, 4294967295, 64, "RGBA", 0, "18446744073709551615"},
};

TEST(dImageLayout, RefusesSizesBeyond32BitsWithoutAllocating) {
  for (const TooLarge& format : kTooLarge) {
    SCOPED_TRACE(format.name);
    HookedImage image;
    ASSERT_TRUE(image.Init(3, 2, 8, "RGB", 0, 4));
    image.trail.clear();
    const LogRecorder log;
    EXPECT_FALSE(image.Init(format.width, format.height, format.dataType, format.sequence,
                            format.dataOrder, 4));
    ExpectReset(image);
    EXPECT_EQ(image.trail, "R");
    const std::string message = std::string("no memory(") + format.bytes + " bytes required)";
    ExpectStatus(image.GetStatus(), -1, message);
    ASSERT_EQ(log.errors.size(), 1u);
    EXPECT_EQ(log.errors[0], "dImage::Init: " + message);
    for (const std::string& entry : log.entries) {
      EXPECT_NE(entry, "dBuffer::New");
    }
  }
}

TEST(dImageLayout, RefusesWidthsHeightsAndChannelCountsThatDoNotFitTheirFields) {
  if (sizeof(unsigned long) > 4) {
    const auto large = static_cast<unsigned long>(1ULL << 32);
    dImage image;
    EXPECT_FALSE(image.Init(large, 1, 8, "G", 0, 1));
    ExpectStatus(image.GetStatus(), -1, "no memory(4294967296 bytes required)");
    EXPECT_FALSE(image.Init(1, large + 1, 8, "G", 0, 1));
    ExpectStatus(image.GetStatus(), -1, "no memory(4294967297 bytes required)");
    EXPECT_FALSE(image.Init(large, 0, 8, "G", 0, 1));
    ExpectReset(image);
  }
  dImage image;
  EXPECT_FALSE(image.Init(1, 1, 8, std::string(65536, 'C').c_str(), 0, 1));
  ExpectStatus(image.GetStatus(), -1, "no memory(65536 bytes required)");
  ExpectReset(image);
  EXPECT_TRUE(image.Init(1, 1, 8, std::string(65535, 'C').c_str(), 0, 1));
  EXPECT_EQ(image.GetNumChannels(), 65535);
}

// 65537 x 65535 bytes are 2^32 - 1, which the buffer cannot round up to whole words.
TEST(dImageLayout, ReportsMemoryThatTheBufferCannotGive) {
  HookedImage image;
  ASSERT_TRUE(image.Init(3, 2, 8, "RGB", 0, 4));
  image.trail.clear();
  const LogRecorder log;
  EXPECT_FALSE(image.Init(65537, 65535, 8, "G", 0, 1));
  ExpectReset(image);
  EXPECT_EQ(image.trail, "R");
  ExpectStatus(image.GetStatus(), -1, "no memory(4294967295 bytes required)");
  ASSERT_EQ(log.errors.size(), 2u);
  EXPECT_EQ(log.errors[0], "dBuffer::New: can't allocate 4294967296 bytes");
  EXPECT_EQ(log.errors[1], "dImage::AllocateDataBuffer: no memory(4294967295 bytes required)");
}

TEST(dImageLayout, AllocateDataBufferGivesABlockOrSaysWhyNot) {
  HookedImage image;
  {
    const LogRecorder log;
    EXPECT_EQ(image.AllocateDataBuffer(0), nullptr);
    EXPECT_TRUE(log.errors.empty());
    ExpectStatus(image.GetStatus(), -1, "not initialized");
  }
  void* const block = image.AllocateDataBuffer(5);
  ASSERT_NE(block, nullptr);
  EXPECT_EQ(block, image.GetDataPtr());
  EXPECT_EQ(image.GetImageSize(), 5u);
  EXPECT_EQ(image.AllocateDataBuffer(0xFFFFFFFFUL), nullptr);
  ExpectStatus(image.GetStatus(), -1, "no memory(4294967295 bytes required)");
}

}  // namespace
