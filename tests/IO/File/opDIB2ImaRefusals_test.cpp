// Bitmaps that are refused, each with its message: nothing large is allocated for them, and the
// image that they were meant for is left reset.
#include <vorl/IO/File/opDIB2Ima.h>

#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>
#include <limits>
#include <string>

#if !defined(_WIN32)
#include <sys/stat.h>
#endif

#include "../../Support/LogRecorder.h"
#include "../BinaryFileTest.h"
#include "BitmapBytes.h"

namespace {

namespace fs = std::filesystem;

using bitmap_test::Bitmap;
using bitmap_test::FileOf;
using bitmap_test::Ramp;

constexpr std::int32_t kLowest = std::numeric_limits<std::int32_t>::min();
constexpr std::int32_t kHighest = std::numeric_limits<std::int32_t>::max();

/// Which context logs a refusal.
std::string Title(const std::string& text) {
  const bool isOfOutput = text.rfind("opDIB2Ima: unsupported pixel depth", 0) == 0 ||
                          text.rfind("can't initialize the output image", 0) == 0;
  return isOfOutput ? "opDIB2Ima::InitOutputImage: " : "opDIB2Ima::Convert: ";
}

class opDIB2ImaRefusal : public BinaryFileTest {
 protected:
  /// The status after a conversion that must fail; '@' stands for the file's name.
  std::string Refusal(const char* path) {
    dImage image;
    EXPECT_TRUE(image.Init(4, 4, ImageDataType_U8, "G", 0, 4));
    opDIB2Ima op;
    LogRecorder log;
    EXPECT_FALSE(op.Convert(path, image));
    EXPECT_FALSE(image.IsValid());
    EXPECT_EQ(image.GetWidth(), 0U);
    EXPECT_TRUE(op.GetStatus() == -1);
    std::string text = static_cast<const char*>(op.GetStatus());
    EXPECT_EQ(log.errors, std::vector<std::string>{Title(text) + text});
    if (path != nullptr && *path != '\0' && text.find(path) != std::string::npos) {
      text.replace(text.find(path), std::strlen(path), "@");
    }
    return text;
  }

  std::string RefusalOf(const bitmap_test::Bytes& bytes) {
    MakeFile(bytes);
    return Refusal(FileName());
  }

  std::string RefusalOf(const Bitmap& bitmap) { return RefusalOf(FileOf(bitmap)); }
};

Bitmap Good(int bits = 24) {
  Bitmap bitmap;
  bitmap.width = 5;
  bitmap.height = 3;
  bitmap.bits = bits;
  bitmap.palette = Ramp(bits <= 8 ? 1 << bits : 0, true);
  return bitmap;
}

TEST_F(opDIB2ImaRefusal, FileMustBeNamed) {
  EXPECT_EQ(Refusal(nullptr), "no name for bitmap file specified");
}

TEST_F(opDIB2ImaRefusal, FileMustBeThere) {
  EXPECT_EQ(Refusal(FileName()), "unable to open file '@'");
  EXPECT_EQ(Refusal(""), "unable to open file ''");
}

TEST_F(opDIB2ImaRefusal, FolderIsNoFile) {
  fs::create_directory(FileName());
  EXPECT_EQ(Refusal(FileName()), "unable to open file '@'");
}

#if !defined(_WIN32)
TEST_F(opDIB2ImaRefusal, PipeIsNotWaitedFor) {
  ASSERT_EQ(mkfifo(FileName(), 0600), 0);
  EXPECT_EQ(Refusal(FileName()), "unable to open file '@'");
}

TEST_F(opDIB2ImaRefusal, DeviceIsNoFile) {
  EXPECT_EQ(Refusal("/dev/zero"), "unable to open file '@'");
}
#endif

TEST_F(opDIB2ImaRefusal, FileMustBeginAsABitmapFile) {
  EXPECT_EQ(RefusalOf(bitmap_test::Bytes{}), "file '@' is not a bitmap file");
  EXPECT_EQ(RefusalOf(bitmap_test::Bytes{'B', 'M'}), "file '@' is not a bitmap file");
  auto bytes = FileOf(Good());
  bytes[1] = 'A';
  EXPECT_EQ(RefusalOf(bytes), "file '@' is not a bitmap file");
}

TEST_F(opDIB2ImaRefusal, FileMayBeCutOffAnywhere) {
  for (const int bits : {1, 2, 4, 16, 24, 32}) {
    const auto whole = FileOf(Good(bits));
    MakeFile(whole);
    for (std::size_t length = whole.size(); length-- > 0;) {
      fs::resize_file(FileName(), length);
      const char* const expected = length < 14   ? "file '@' is not a bitmap file"
                                   : length < 54 ? "file '@' ends within its header"
                                                 : "file '@' has sizes that cannot be true";
      EXPECT_EQ(Refusal(FileName()), expected) << bits << " bits, " << length << " bytes";
    }
  }
}

TEST_F(opDIB2ImaRefusal, SizesInTheFileHeaderMustBeTrue) {
  const std::uint32_t trueSize = 14 + 40 + 3 * 16;
  const struct {
    std::uint32_t fileSize;
    std::uint32_t offset;
  } kLies[] = {{trueSize + 1, 54},
               {0x7FFFFFFF, 54},
               {0x80000000, 54},
               {0xFFFFFFFF, 54},
               {0, 54},
               {53, 54},
               {trueSize, 0},
               {trueSize, 14},
               {trueSize, 53},
               {trueSize, trueSize + 1},
               {trueSize, 0x7FFFFFFF},
               {trueSize, 0xFFFFFFFF},
               {0xFFFFFFFF, 0xFFFFFFFF}};
  for (const auto& lie : kLies) {
    Bitmap bitmap = Good();
    bitmap.fileSize = lie.fileSize;
    bitmap.offset = lie.offset;
    EXPECT_EQ(RefusalOf(bitmap), "file '@' has sizes that cannot be true")
        << lie.fileSize << " " << lie.offset;
  }
}

TEST_F(opDIB2ImaRefusal, PixelsMustBeThereToTheLastRow) {
  Bitmap bitmap = Good();
  bitmap.fileSize = 14 + 40 + 3 * 16 - 1;
  EXPECT_EQ(RefusalOf(bitmap), "file '@' ends within its pixel data");
  bitmap.fileSize = 54;
  EXPECT_EQ(RefusalOf(bitmap), "file '@' ends within its pixel data");
  bitmap = Good();
  bitmap.offset = 55;
  EXPECT_EQ(RefusalOf(bitmap), "file '@' ends within its pixel data");
}

TEST_F(opDIB2ImaRefusal, SmallFileThatClaimsAHugePictureIsCutOff) {
  const struct {
    std::int32_t width;
    std::int32_t height;
  } kSizes[] = {{20000, 35000},       {kHighest, 1},         {1, kHighest},
                {kHighest, kHighest}, {1, -kHighest},        {-kHighest, 1},
                {65536, 65536},       {kHighest, -kHighest}, {0x40000000, 4}};
  for (const auto& size : kSizes) {
    for (const int bits : {1, 2, 4, 8, 16, 24, 32}) {
      Bitmap bitmap = Good(bits);
      bitmap.rows = {1, 2, 3, 4, 5, 6};
      bitmap.width = size.width;
      bitmap.height = size.height;
      EXPECT_EQ(RefusalOf(bitmap), "file '@' ends within its pixel data")
          << size.width << " x " << size.height << ", " << bits;
    }
  }
}

TEST_F(opDIB2ImaRefusal, SizeMustBeOneOfAPicture) {
  const struct {
    std::int32_t width;
    std::int32_t height;
  } kSizes[] = {{0, 3}, {5, 0}, {0, 0}, {kLowest, 1}, {1, kLowest}, {kLowest, kLowest}};
  for (const auto& size : kSizes) {
    Bitmap bitmap = Good();
    bitmap.rows = {0};
    bitmap.width = size.width;
    bitmap.height = size.height;
    EXPECT_EQ(RefusalOf(bitmap), "opDIB2Ima: invalid bitmap size: " + std::to_string(size.width) +
                                     " x " + std::to_string(size.height));
  }
}

TEST_F(opDIB2ImaRefusal, HeaderMustHaveAKnownSize) {
  for (const std::uint32_t size : {0U, 12U, 39U, 41U, 53U, 64U, 107U, 125U, 0xFFFFFFFFU}) {
    Bitmap bitmap = Good();
    bitmap.infoSize = size;
    EXPECT_EQ(RefusalOf(bitmap), "opDIB2Ima: unsupported header size: " + std::to_string(size));
  }
}

TEST_F(opDIB2ImaRefusal, MasksOfALongerHeaderMustBeThoseOfPlainPixels) {
  Bitmap bitmap = Good();
  bitmap.bits = 32;
  bitmap.palette.clear();
  bitmap.infoSize = 56;
  bitmap.infoRest.assign(16, 0xF0);
  bitmap.compression = 3;
  EXPECT_EQ(RefusalOf(bitmap), "opDIB2Ima: unsupported compression: bit fields");
}

TEST_F(opDIB2ImaRefusal, ThereMustBeOnePlane) {
  for (const int planes : {0, 2, 65535}) {
    Bitmap bitmap = Good();
    bitmap.planes = planes;
    EXPECT_EQ(RefusalOf(bitmap), "opDIB2Ima: invalid number of planes: " + std::to_string(planes));
  }
}

TEST_F(opDIB2ImaRefusal, CompressedPixelsAreNotDecoded) {
  const struct {
    int bits;
    std::uint32_t compression;
    const char* name;
  } kKinds[] = {{8, 1, "RLE8"},        {24, 1, "RLE8"},
                {4, 2, "RLE4"},        {8, 3, "bit fields"},
                {24, 3, "bit fields"}, {0, 4, "JPEG"},
                {24, 4, "JPEG"},       {0, 5, "PNG"},
                {32, 6, "6"},          {32, 0xFFFFFFFF, "4294967295"}};
  for (const auto& kind : kKinds) {
    Bitmap bitmap = Good();
    bitmap.bits = kind.bits;
    bitmap.rows.assign(100, 0);
    bitmap.compression = kind.compression;
    EXPECT_EQ(RefusalOf(bitmap), std::string("opDIB2Ima: unsupported compression: ") + kind.name);
  }
}

TEST_F(opDIB2ImaRefusal, ThirtyTwoBitMasksOfAnotherOrderAreNotDecoded) {
  Bitmap bitmap = Good(32);
  bitmap.compression = 3;
  bitmap.gap = {0xFF, 0, 0, 0, 0, 0xFF, 0, 0, 0, 0, 0xFF, 0};
  EXPECT_EQ(RefusalOf(bitmap), "opDIB2Ima: unsupported compression: bit fields");
  bitmap.gap = {0, 0, 0xFF, 0, 0, 0xFF, 0, 0};  // the third mask is cut off
  EXPECT_EQ(RefusalOf(bitmap), "opDIB2Ima: unsupported compression: bit fields");
}

TEST_F(opDIB2ImaRefusal, DepthMustBeOneOfTheTable) {
  for (const int bits : {0, 3, 5, 6, 7, 9, 12, 15, 17, 23, 31, 33, 48, 64, 65535}) {
    Bitmap bitmap = Good();
    bitmap.rows.assign(200, 0);
    bitmap.bits = bits;
    EXPECT_EQ(RefusalOf(bitmap), "opDIB2Ima: unsupported pixel depth: " + std::to_string(bits));
  }
}

TEST_F(opDIB2ImaRefusal, EveryByteOfTheHeadersMayBeWrong) {
  for (const int bits : {1, 8, 16, 24}) {
    const auto whole = FileOf(Good(bits));
    MakeFile(whole);
    for (std::size_t position = 0; position < 54; ++position) {
      for (const unsigned value : {0U, 1U, 0x7FU, 0x80U, 0xFFU}) {
        PatchFile(position, static_cast<unsigned char>(value));
        dImage image;
        opDIB2Ima op;
        const bool done = op.Convert(FileName(), image);
        EXPECT_EQ(done, image.IsValid()) << position;
        EXPECT_EQ(done, op.GetStatus() == 0) << position;
        EXPECT_LE(image.GetImageSize(), 24 * whole.size()) << position;
      }
      PatchFile(position, whole[position]);
    }
  }
}

class opDIB2ImaMemory : public testing::Test {
 protected:
  std::string Refusal(const tagBITMAPINFO* info, const void* bits) {
    dImage image;
    EXPECT_TRUE(image.Init(4, 4, ImageDataType_U8, "G", 0, 4));
    opDIB2Ima op;
    LogRecorder log;
    EXPECT_FALSE(op.Convert(info, bits, image));
    EXPECT_FALSE(image.IsValid());
    const std::string text = static_cast<const char*>(op.GetStatus());
    EXPECT_EQ(log.errors.back(), Title(text) + text);
    return text;
  }

  tagBITMAPINFO m_info{{40, 4, 4, 1, 24, 0, 0, 0, 0, 0, 0}, {}};
  unsigned char m_bits[48] = {};
};

TEST_F(opDIB2ImaMemory, BlockAndBitsMustBeGiven) {
  EXPECT_EQ(Refusal(nullptr, m_bits), "no bitmap information block specified");
  EXPECT_EQ(Refusal(&m_info, nullptr), "no pixel bits specified");
  EXPECT_EQ(Refusal(nullptr, nullptr), "no bitmap information block specified");
}

TEST_F(opDIB2ImaMemory, HeaderIsCheckedLikeThatOfAFile) {
  m_info.bmiHeader.biSize = 12;
  EXPECT_EQ(Refusal(&m_info, m_bits), "opDIB2Ima: unsupported header size: 12");
  m_info.bmiHeader.biSize = 40;
  m_info.bmiHeader.biHeight = kLowest;
  EXPECT_EQ(Refusal(&m_info, m_bits), "opDIB2Ima: invalid bitmap size: 4 x -2147483648");
  m_info.bmiHeader.biHeight = 4;
  m_info.bmiHeader.biBitCount = 5;
  EXPECT_EQ(Refusal(&m_info, m_bits), "opDIB2Ima: unsupported pixel depth: 5");
}

TEST_F(opDIB2ImaMemory, ImageWhoseOwnBitsAreRefusedIsResetToo) {
  dImage image;
  ASSERT_TRUE(image.Init(4, 4, ImageDataType_U8, "BGR", 0, 4));
  m_info.bmiHeader.biBitCount = 5;
  opDIB2Ima op;
  EXPECT_FALSE(op.Convert(&m_info, image.GetDataPtr(), image));
  EXPECT_STREQ(op.GetStatus(), "opDIB2Ima: unsupported pixel depth: 5");
  EXPECT_FALSE(image.IsValid());
}

TEST_F(opDIB2ImaMemory, ImageThatCannotBeHadTellsWhy) {
  m_info.bmiHeader.biWidth = kHighest;
  m_info.bmiHeader.biHeight = -kHighest;
  EXPECT_EQ(Refusal(&m_info, m_bits),
            "can't initialize the output image: no memory(13835058048839712768 bytes required)");
}

}  // namespace
