// Image files that lie. Whatever they hold, a failed read leaves the image reset.

#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include <random>
#include <string>

#include "../Support/LogRecorder.h"
#include "ImageFile.h"
#include "ImageTesting.h"

namespace {

class dImageHostile : public ImageFile {
 protected:
  // Reads into an image with pixels of the very size that the unchanged items ask for.
  void ExpectRefused(const Bytes& file, long code) {
    Store(file);
    HookedImage image;
    ASSERT_TRUE(image.Init(48, 1, 8, "G", 0, 1));
    EXPECT_FALSE(image.ReadFile(m_path.c_str(), "dImage"));
    ExpectReset(image);
    EXPECT_EQ(image.trail.back(), 'R');
    if (code != 0) {
      EXPECT_EQ(static_cast<long>(image.GetStatus()), code);
    } else {
      EXPECT_FALSE(image.GetStatus().IsOK());
    }
  }
  // The same, before the image has allocated anything.
  void ExpectRefusedWithoutAllocation(const Bytes& file, long code) {
    const LogRecorder log;
    Store(file);
    HookedImage image;
    EXPECT_FALSE(image.ReadFile(m_path.c_str(), "dImage"));
    ExpectReset(image);
    EXPECT_EQ(static_cast<long>(image.GetStatus()), code);
    for (const std::string& entry : log.entries) {
      EXPECT_NE(entry, "dBuffer::New");
      EXPECT_NE(entry, "dImage::AllocateDataBuffer");
    }
  }
};

TEST_F(dImageHostile, TheUnchangedFileIsRead) {
  Store(ImageItems().File());
  dImage image;
  EXPECT_TRUE(image.ReadFile(m_path.c_str(), "dImage"));
  EXPECT_EQ(BytesOf(image), Bytes(48, 0x5A));
}

TEST_F(dImageHostile, RefusesAFileCutAtAnyByte) {
  const Bytes whole = ImageItems().File();
  for (std::size_t size = 0; size < whole.size(); ++size) {
    SCOPED_TRACE(size);
    const Bytes cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(size));
    if (size >= ImageItems::kHeaderSize) {
      ExpectRefused(cut, 0);
      continue;
    }
    Store(cut);  // no image file at all: nothing is read
    dImage image;
    ASSERT_TRUE(image.Init(1, 1, 8, "G", 0, 1));
    EXPECT_FALSE(image.ReadFile(m_path.c_str(), "dImage"));
    EXPECT_TRUE(image.IsValid());
  }
}

TEST_F(dImageHostile, RefusesEveryOtherTag) {
  const ImageItems items;
  const Bytes whole = items.File();
  for (const std::size_t offset : items.TagOffsets()) {
    for (const int tag : {0x00, 0x01, 0x02, 0x03, 0x04, 0x05, 0x06, 0x07, 0x08, 0x09, 0x0A, 0x80,
                          0xE0, 0xE1, 0xE2, 0xE3, 0xE4, 0xE5, 0xF0, 0xF1, 0xF2, 0xF4, 0xFF}) {
      if (tag == whole[offset]) {
        continue;
      }
      SCOPED_TRACE(testing::Message() << "offset " << offset << " tag " << tag);
      Bytes changed = whole;
      changed[offset] = static_cast<unsigned char>(tag);
      ExpectRefused(changed, 0);
    }
  }
}

TEST_F(dImageHostile, RefusesSequenceLengthsThatTheFileDoesNotHold) {
  for (const std::uint32_t length :
       {std::uint32_t{1000}, 0x10000u, 0x7FFFFFFFu, 0x80000000u, 0xFFFFFFFEu, 0xFFFFFFFFu}) {
    SCOPED_TRACE(length);
    ImageItems items;
    items.sequenceLength = length;
    ExpectRefused(items.File(), -200);
    ExpectRefusedWithoutAllocation(items.File(), -200);
  }
}

TEST_F(dImageHostile, RefusesPixelLengthsOtherThanTheFormats) {
  for (const std::uint32_t length :
       {std::uint32_t{0}, 1u, 47u, 49u, 0xFFu, 0x10000u, 0x7FFFFFFFu, 0x80000000u, 0xFFFFFFFFu}) {
    SCOPED_TRACE(length);
    ImageItems items;
    items.pixelLength = length;
    ExpectRefused(items.File(), -208);
    items.hasLongLengths = true;
    ExpectRefused(items.File(), -208);
  }
}

TEST_F(dImageHostile, ReadsLengthsInMoreBytesThanTheyNeed) {
  ImageItems items;
  items.hasLongLengths = true;
  Store(items.File());
  dImage image;
  EXPECT_TRUE(image.ReadFile(m_path.c_str(), "dImage"));
  EXPECT_EQ(BytesOf(image), Bytes(48, 0x5A));
}

TEST_F(dImageHostile, ReadsASequenceUpToItsFirstZeroByteOrItsEnd) {
  for (const std::string& sequence :
       {std::string("RGB"), std::string("RGB\0\0\0", 6), std::string("RGB\0ABC", 7)}) {
    ImageItems items;
    items.sequence = sequence;
    items.sequenceLength = static_cast<std::uint32_t>(sequence.size());
    Store(items.File());
    dImage image;
    EXPECT_TRUE(image.ReadFile(m_path.c_str(), "dImage"));
    EXPECT_STREQ(image.GetChannelSequence(), "RGB");
    EXPECT_EQ(image.GetNumChannels(), 3);
  }
}

TEST_F(dImageHostile, RefusesAFormatLargerThanTheFileBeforeAllocating) {
  struct Case {
    const char* name;
    std::uint32_t width;
    std::uint32_t height;
    std::uint32_t dataType;
  };
  const Case cases[] = {{"more than the file holds", 3000, 2, 0x1010},
                        {"gigabytes", 30000, 20000, 0x1010},
                        {"just below 32 bits", 26754, 26754, 0x1010},
                        {"32 bits overflow to 0", 0x8000, 0x20000, 0x1010},
                        {"a row of 2^32 bytes and eight", 0x80000003, 2, 0x1010},
                        {"all bits", 0xFFFFFFFF, 0xFFFFFFFF, 0x1040}};
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    ImageItems items;
    items.width = c.width;
    items.height = c.height;
    items.dataType = c.dataType;
    ExpectRefused(items.File(), -200);
    ExpectRefusedWithoutAllocation(items.File(), -200);
    items.dataOrder = 0;
    ExpectRefusedWithoutAllocation(items.File(), -200);
  }
}

TEST_F(dImageHostile, RefusesARowThatDoesNotFitEvenWithoutRows) {
  ImageItems items;
  items.width = 0xFFFFFFFF;
  items.height = 0;
  ExpectRefusedWithoutAllocation(items.File(), -1);
}

TEST_F(dImageHostile, RefusesAFormatThatCannotBe) {
  struct Case {
    std::uint32_t dataType;
    std::uint32_t dataOrder;
    std::uint32_t rowAlignment;
    const char* sequence;
    const char* message;
  };
  const Case cases[] = {{12, 1, 8, "RGB", "invalid 'DataType': 12"},
                        {0xFFFF, 1, 8, "RGB", "invalid 'DataType': 65535"},
                        {8, 2, 8, "RGB", "invalid 'DataOrder': 2"},
                        {8, 1, 3, "RGB", "invalid 'RowAlignment': 3"},
                        {8, 1, 0, "RGB", "invalid 'RowAlignment': 0"},
                        {8, 1, 8, "rgb", "invalid 'ChannelSequence':'rgb'"},
                        {8, 1, 8, "", "invalid 'ChannelSequence':''"}};
  for (const Case& c : cases) {
    for (const std::uint32_t pixelLength : {48u, 0u}) {
      SCOPED_TRACE(c.message);
      ImageItems items;
      items.dataType = c.dataType;
      items.dataOrder = c.dataOrder;
      items.rowAlignment = c.rowAlignment;
      items.sequence = c.sequence;
      items.sequence += '\0';
      items.sequenceLength = static_cast<std::uint32_t>(items.sequence.size());
      items.pixelLength = pixelLength;
      items.pixels.resize(pixelLength);
      Store(items.File());
      HookedImage image;
      ASSERT_TRUE(image.Init(48, 1, 8, "G", 0, 1));
      const LogRecorder log;
      EXPECT_FALSE(image.ReadFile(m_path.c_str(), "dImage"));
      ExpectReset(image);
      ExpectStatus(image.GetStatus(), -1, c.message);
      ASSERT_EQ(log.errors.size(), 1u);
      EXPECT_EQ(log.errors[0], std::string("dImage::Init: ") + c.message);
    }
  }
}

// Either the file is read and the image is what it says it is, or the image is reset.
TEST_F(dImageHostile, SurvivesRandomDamage) {
  std::mt19937 random(711);
  const Bytes whole = ImageItems().File();
  for (int round = 0; round < 500; ++round) {
    SCOPED_TRACE(round);
    Bytes damaged = whole;
    for (unsigned changes = 1 + random() % 4; changes > 0; --changes) {
      damaged[ImageItems::kHeaderSize + random() % (damaged.size() - ImageItems::kHeaderSize)] =
          static_cast<unsigned char>(random());
    }
    Store(damaged);
    dImage image;
    if (!image.ReadFile(m_path.c_str(), "dImage")) {
      ExpectReset(image);
      continue;
    }
    EXPECT_EQ(image.GetImageSize(), image.GetBytesPerRow() * image.GetNumRows());
    EXPECT_LE(image.GetImageSize(), whole.size());
  }
}

}  // namespace
