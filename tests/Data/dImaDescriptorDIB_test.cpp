#include <vorl/Data/dImaDescriptorDIB.h>

#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "../Support/LogRecorder.h"
#if defined(__linux__)
#include "../apps/FileSizeLimit.h"
#endif

namespace {

namespace fs = std::filesystem;

class dImaDescriptorDIBFile : public testing::Test {
 protected:
  void SetUp() override {
    const auto* info = testing::UnitTest::GetInstance()->current_test_info();
    m_folder = fs::path(testing::TempDir()) / (std::string("vorl_dib_") + info->name());
    fs::remove_all(m_folder);
    fs::create_directories(m_folder);
    m_path = (m_folder / "picture.bmp").string();
  }
  void TearDown() override { fs::remove_all(m_folder); }

  std::vector<unsigned char> FileBytes() const {
    std::ifstream file(m_path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  }

  fs::path m_folder;
  std::string m_path;
};

unsigned U16At(const std::vector<unsigned char>& bytes, std::size_t offset) {
  return bytes.at(offset) | static_cast<unsigned>(bytes.at(offset + 1)) << 8;
}

unsigned U32At(const std::vector<unsigned char>& bytes, std::size_t offset) {
  return U16At(bytes, offset) | U16At(bytes, offset + 2) << 16;
}

dImage MakeImage(unsigned long width, unsigned long height, unsigned short type,
                 const char* sequence, unsigned short alignment = 4) {
  dImage image;
  EXPECT_TRUE(image.Init(width, height, type, sequence, ImageDataOrder_Pixel, alignment));
  auto* bytes = static_cast<unsigned char*>(image.GetDataPtr());
  for (unsigned long i = 0; i < image.GetImageSize(); ++i) {
    bytes[i] = static_cast<unsigned char>(i * 7 + 1);
  }
  return image;
}

TEST(dImaDescriptorDIB, DescribesAnEightBitImageByItsPaddedRows) {
  dImage image = MakeImage(3, 5, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor;
  const tagBITMAPINFO* block = descriptor.Init(image);
  ASSERT_NE(block, nullptr);
  EXPECT_EQ(block, descriptor.GetHeader());
  const BITMAPINFOHEADER& header = block->bmiHeader;
  EXPECT_EQ(header.biSize, 40U);
  EXPECT_EQ(header.biWidth, 4);
  EXPECT_EQ(header.biHeight, -5);
  EXPECT_EQ(header.biPlanes, 1);
  EXPECT_EQ(header.biBitCount, 8);
  EXPECT_EQ(header.biCompression, 0U);
  EXPECT_EQ(header.biSizeImage, 20U);
  EXPECT_EQ(header.biXPelsPerMeter, 0);
  EXPECT_EQ(header.biYPelsPerMeter, 0);
  EXPECT_EQ(header.biClrUsed, 256U);
  EXPECT_EQ(header.biClrImportant, 256U);
  EXPECT_EQ(descriptor.GetPixelData(), image.GetDataPtr());
  EXPECT_TRUE(descriptor.IsValid());
  EXPECT_EQ(descriptor.GetStatus(), 0);
}

struct Layout {
  const char* name;
  unsigned short dataType;
  const char* sequence;
  int bitCount;
  int paddedWidth;  // of an image 10 pixels wide with rows aligned to 4 bytes
  unsigned paletteSize;
};

class dImaDescriptorDIBLayout : public testing::TestWithParam<Layout> {};

TEST_P(dImaDescriptorDIBLayout, IsAcceptedWithItsBitCountAndColourTable) {
  const Layout& layout = GetParam();
  dImage image = MakeImage(10, 2, layout.dataType, layout.sequence);
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.IsValid());
  const BITMAPINFOHEADER& header = descriptor.GetHeader()->bmiHeader;
  EXPECT_EQ(header.biBitCount, layout.bitCount);
  EXPECT_EQ(header.biWidth, layout.paddedWidth);
  EXPECT_EQ(header.biClrUsed, layout.paletteSize);
  EXPECT_EQ(header.biClrImportant, layout.paletteSize);
  EXPECT_EQ(descriptor.GetPaletteSize(), layout.paletteSize);
  EXPECT_EQ(descriptor.GetPalette() != nullptr, layout.paletteSize != 0);
  EXPECT_EQ(descriptor.ResetPalette(true), layout.paletteSize != 0);
}

INSTANTIATE_TEST_SUITE_P(All, dImaDescriptorDIBLayout,
                         testing::Values(Layout{"OneBit", 1, "K", 1, 32, 2},
                                         Layout{"EightBit", 8, "G", 8, 12, 256},
                                         Layout{"ThreeChannels", 8, "BGR", 24, 10, 0},
                                         Layout{"ThreeChannelsOfAnyName", 8, "YCrCb", 24, 10, 0},
                                         Layout{"FourChannels", 8, "BGRA", 32, 10, 0}),
                         [](const auto& test) { return std::string(test.param.name); });

TEST(dImaDescriptorDIB, ColourTableIsAGreyRamp) {
  dImage image = MakeImage(4, 1, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  const tagRGBQUAD* palette = descriptor.GetPalette();
  ASSERT_NE(palette, nullptr);
  for (int i = 0; i < 256; ++i) {
    EXPECT_EQ(palette[i].rgbBlue, i);
    EXPECT_EQ(palette[i].rgbGreen, i);
    EXPECT_EQ(palette[i].rgbRed, i);
    EXPECT_EQ(palette[i].rgbReserved, 0);
  }
  descriptor.ResetPalette(false);
  for (int i = 0; i < 256; ++i) {
    EXPECT_EQ(palette[i].rgbBlue, 255 - i);
    EXPECT_EQ(palette[i].rgbGreen, 255 - i);
    EXPECT_EQ(palette[i].rgbRed, 255 - i);
    EXPECT_EQ(palette[i].rgbReserved, 0);
  }
}

TEST(dImaDescriptorDIB, OneBitColourTableIsBlackAndWhite) {
  dImage image = MakeImage(4, 1, ImageDataType_U1, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_EQ(descriptor.GetPalette()[0].rgbRed, 0);
  EXPECT_EQ(descriptor.GetPalette()[1].rgbRed, 255);
  descriptor.ResetPalette(false);
  EXPECT_EQ(descriptor.GetPalette()[0].rgbRed, 255);
  EXPECT_EQ(descriptor.GetPalette()[1].rgbRed, 0);
}

TEST(dImaDescriptorDIB, IsRegisteredUnderDataBase) {
  EXPECT_STREQ(dImaDescriptorDIB::CI().name, "dImaDescriptorDIB");
  EXPECT_EQ(dImaDescriptorDIB::CI().parents[0], &DataBase::CI());
  EXPECT_EQ(dImaDescriptorDIB::CI().parents[1], nullptr);
  BaseClass* object = dImaDescriptorDIB::CI().Create();
  ASSERT_NE(object, nullptr);
  EXPECT_STREQ(object->ClassName(), "dImaDescriptorDIB");
  object->Release();
}

TEST(dImaDescriptorDIB, LogsWhyAnImageIsRefused) {
  dImage image;
  dImaDescriptorDIB descriptor;
  LogRecorder log;
  descriptor.Init(image);
  EXPECT_EQ(log.errors,
            std::vector<std::string>{"dImaDescriptorDIB::CheckImage: uninitialized image"});
  EXPECT_EQ(log.entries,
            (std::vector<std::string>{"dImaDescriptorDIB::Init", "dImaDescriptorDIB::CheckImage"}));
}

TEST(dImaDescriptorDIB, AssignmentHasAnInformationBlockOfItsOwn) {
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB source(image);
  dImaDescriptorDIB copy;
  copy = source;
  source.Reset();
  ASSERT_TRUE(copy.IsValid());
  EXPECT_EQ(copy.GetHeader()->bmiHeader.biHeight, -2);
  EXPECT_EQ(copy.GetPixelData(), image.GetDataPtr());
  EXPECT_EQ(copy.GetStatus(), 0);
}

class DescriptorOfNothing : public dImaDescriptorDIB {
 public:
  bool CheckNull() { return CheckImage(nullptr); }
};

TEST(dImaDescriptorDIB, NoImageIsNoBitmap) {
  DescriptorOfNothing descriptor;
  EXPECT_FALSE(descriptor.CheckNull());
  EXPECT_STREQ(descriptor.GetStatus(), "uninitialized image");
}

TEST(dImaDescriptorDIB, RefusesAnImageWithoutPixels) {
  dImage image;
  dImaDescriptorDIB descriptor;
  EXPECT_EQ(descriptor.Init(image), nullptr);
  EXPECT_EQ(descriptor.GetStatus(), -1);
  EXPECT_STREQ(descriptor.GetStatus(), "uninitialized image");
  EXPECT_FALSE(descriptor.IsValid());
}

TEST(dImaDescriptorDIB, RefusesRowsThatAreNotAMultipleOfFourBytes) {
  dImage image = MakeImage(3, 2, ImageDataType_U8, "G", 1);
  dImaDescriptorDIB descriptor(image);
  EXPECT_STREQ(descriptor.GetStatus(), "image rows are not 4 byte aligned");
  EXPECT_FALSE(descriptor.IsValid());
}

TEST(dImaDescriptorDIB, RefusesOtherLayoutsByName) {
  const auto reasonFor = [](unsigned short type, const char* sequence, unsigned short order) {
    dImage image;
    EXPECT_TRUE(image.Init(4, 2, type, sequence, order, 4));
    dImaDescriptorDIB descriptor(image);
    EXPECT_FALSE(descriptor.IsValid());
    return std::string(static_cast<const char*>(descriptor.GetStatus()));
  };
  EXPECT_EQ(reasonFor(8, "BGR", 1), "not a 'Bitmap' format: 3 x 8 bit - 'BGR' - plane order");
  EXPECT_EQ(reasonFor(8, "RGBA", 0), "not a 'Bitmap' format: 4 x 8 bit - 'RGBA' - pixel order");
  EXPECT_EQ(reasonFor(8, "GA", 0), "not a 'Bitmap' format: 2 x 8 bit - 'GA' - pixel order");
  EXPECT_EQ(reasonFor(16, "G", 0), "not a 'Bitmap' format: 1 x 16 bit - 'G' - pixel order");
  EXPECT_EQ(reasonFor(0x1008, "G", 0), "not a 'Bitmap' format: 1 x 4104 bit - 'G' - pixel order");
}

TEST(dImaDescriptorDIB, FailedInitForgetsTheImageDescribedBefore) {
  dImage good = MakeImage(4, 2, ImageDataType_U8, "G");
  dImage bad;
  dImaDescriptorDIB descriptor(good);
  EXPECT_EQ(descriptor.Init(bad), nullptr);
  EXPECT_EQ(descriptor.GetHeader(), nullptr);
  EXPECT_EQ(descriptor.GetPixelData(), nullptr);
  EXPECT_EQ(descriptor.GetPalette(), nullptr);
  EXPECT_EQ(descriptor.GetPaletteSize(), 0);
}

TEST(dImaDescriptorDIB, CopyHasAnInformationBlockOfItsOwn) {
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB source(image);
  dImaDescriptorDIB copy(source);
  EXPECT_NE(copy.GetHeader(), source.GetHeader());
  EXPECT_EQ(copy.GetPixelData(), source.GetPixelData());
  source.Reset();
  EXPECT_FALSE(source.IsValid());
  ASSERT_TRUE(copy.IsValid());
  EXPECT_EQ(copy.GetHeader()->bmiHeader.biHeight, -2);
  EXPECT_EQ(copy.GetPalette()[200].rgbRed, 200);
}

TEST_F(dImaDescriptorDIBFile, SavesAnEightBitImageWithItsRealWidthBottomRowFirst) {
  dImage image = MakeImage(3, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.Save(m_path.c_str(), false)) << descriptor.GetStatus();
  EXPECT_EQ(descriptor.GetStatus(), 0);

  const auto bytes = FileBytes();
  ASSERT_EQ(bytes.size(), 1078U + 8U);
  EXPECT_EQ(bytes[0], 'B');
  EXPECT_EQ(bytes[1], 'M');
  EXPECT_EQ(U32At(bytes, 2), 4U * 2U + 1078U);
  EXPECT_EQ(U32At(bytes, 6), 0U);
  EXPECT_EQ(U32At(bytes, 10), 1078U);
  EXPECT_EQ(U32At(bytes, 14), 40U);
  EXPECT_EQ(U32At(bytes, 18), 3U);  // width
  EXPECT_EQ(U32At(bytes, 22), 2U);  // height, bottom-up
  EXPECT_EQ(U16At(bytes, 26), 1U);
  EXPECT_EQ(U16At(bytes, 28), 8U);
  EXPECT_EQ(U32At(bytes, 30), 0U);
  EXPECT_EQ(U32At(bytes, 34), 8U);  // the size in memory
  EXPECT_EQ(U32At(bytes, 46), 256U);
  EXPECT_EQ(U32At(bytes, 50), 256U);
  EXPECT_EQ(U32At(bytes, 54 + 4 * 77), 0x004D4D4DU);
  EXPECT_EQ(std::memcmp(&bytes[1078], image.GetRowPtr(1), 3), 0);
  EXPECT_EQ(std::memcmp(&bytes[1082], image.GetRowPtr(0), 3), 0);
}

TEST_F(dImaDescriptorDIBFile, SavingLeavesTheBlockAsItWas) {
  dImage image = MakeImage(3, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.Save(m_path.c_str(), false));
  EXPECT_EQ(descriptor.GetHeader()->bmiHeader.biWidth, 4);
  EXPECT_EQ(descriptor.GetHeader()->bmiHeader.biHeight, -2);
}

TEST_F(dImaDescriptorDIBFile, SavesATwentyFourBitImageWithoutColourTable) {
  dImage image = MakeImage(10, 2, ImageDataType_U8, "BGR");
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.Save(m_path.c_str(), false));
  const auto bytes = FileBytes();
  ASSERT_EQ(bytes.size(), 118U);
  EXPECT_EQ(U32At(bytes, 2), 118U);
  EXPECT_EQ(U32At(bytes, 10), 54U);
  EXPECT_EQ(U32At(bytes, 46), 0U);
  EXPECT_EQ(std::memcmp(&bytes[54], image.GetRowPtr(1), 32), 0);
  EXPECT_EQ(std::memcmp(&bytes[86], image.GetRowPtr(0), 32), 0);
}

TEST_F(dImaDescriptorDIBFile, FileRowsAreShorterThanWidelyAlignedMemoryRows) {
  dImage image = MakeImage(10, 3, ImageDataType_U8, "BGR", 32);
  ASSERT_EQ(image.GetBytesPerRow(), 32U);
  dImage wide = MakeImage(11, 3, ImageDataType_U8, "BGR", 32);
  ASSERT_EQ(wide.GetBytesPerRow(), 64U);
  dImaDescriptorDIB descriptor(wide);
  EXPECT_EQ(descriptor.GetHeader()->bmiHeader.biWidth, 21);  // 64 bytes hold 21 pixels
  ASSERT_TRUE(descriptor.Save(m_path.c_str(), false));
  const auto bytes = FileBytes();
  ASSERT_EQ(bytes.size(), 54U + 3U * 36U);
  EXPECT_EQ(U32At(bytes, 18), 11U);
  EXPECT_EQ(U32At(bytes, 34), 64U * 3U);
  for (int row = 0; row < 3; ++row) {
    const auto offset = 54U + static_cast<unsigned>(2 - row) * 36U;
    EXPECT_EQ(std::memcmp(&bytes[offset], wide.GetRowPtr(row), 33), 0) << row;
  }
}

TEST_F(dImaDescriptorDIBFile, SavesAOneBitImage) {
  dImage image = MakeImage(10, 2, ImageDataType_U1, "G");
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.Save(m_path.c_str(), false));
  const auto bytes = FileBytes();
  ASSERT_EQ(bytes.size(), 14U + 48U + 8U);
  EXPECT_EQ(U32At(bytes, 10), 62U);
  EXPECT_EQ(U32At(bytes, 18), 10U);
  EXPECT_EQ(U32At(bytes, 54), 0U);
  EXPECT_EQ(U32At(bytes, 58), 0x00FFFFFFU);
  EXPECT_EQ(std::memcmp(&bytes[62], image.GetRowPtr(1), 4), 0);
  EXPECT_EQ(std::memcmp(&bytes[66], image.GetRowPtr(0), 4), 0);
}

TEST_F(dImaDescriptorDIBFile, SavesAThirtyTwoBitImage) {
  dImage image = MakeImage(3, 2, ImageDataType_U8, "BGRA");
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.Save(m_path.c_str(), false));
  const auto bytes = FileBytes();
  ASSERT_EQ(bytes.size(), 54U + 24U);
  EXPECT_EQ(U16At(bytes, 26), 1U);   // planes
  EXPECT_EQ(U16At(bytes, 28), 32U);  // bits
  EXPECT_EQ(U32At(bytes, 30), 0U);   // uncompressed
  EXPECT_EQ(U32At(bytes, 38), 0U);   // no resolution
  EXPECT_EQ(U32At(bytes, 42), 0U);
  EXPECT_EQ(std::memcmp(&bytes[54], image.GetRowPtr(1), 12), 0);
  EXPECT_EQ(std::memcmp(&bytes[66], image.GetRowPtr(0), 12), 0);
}

TEST_F(dImaDescriptorDIBFile, ExistingFileStaysWithoutOverwrite) {
  std::ofstream(m_path) << "keep";
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_FALSE(descriptor.Save(m_path.c_str(), false));
  EXPECT_STREQ(descriptor.GetStatus(), ("file already exists:'" + m_path + "'").c_str());
  EXPECT_EQ(FileBytes().size(), 4U);
}

TEST_F(dImaDescriptorDIBFile, ExistingFileIsReplacedWithOverwrite) {
  std::ofstream(m_path) << std::string(5000, 'x');
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_TRUE(descriptor.Save(m_path.c_str(), true));
  EXPECT_EQ(FileBytes().size(), 1078U + 8U);
}

TEST_F(dImaDescriptorDIBFile, FolderInThePlaceOfTheFileIsNotRemoved) {
  fs::create_directory(m_path);
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_FALSE(descriptor.Save(m_path.c_str(), true));
  EXPECT_STREQ(descriptor.GetStatus(), ("can't remove '" + m_path + "'").c_str());
  EXPECT_TRUE(fs::is_directory(m_path));
}

TEST_F(dImaDescriptorDIBFile, FolderThatIsMissingCannotBeWrittenTo) {
  const std::string path = (m_folder / "missing" / "picture.bmp").string();
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_FALSE(descriptor.Save(path.c_str(), true));
  EXPECT_STREQ(descriptor.GetStatus(), ("unable to open file '" + path + "'").c_str());
}

TEST_F(dImaDescriptorDIBFile, PathMustBeGiven) {
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_FALSE(descriptor.Save(nullptr, true));
  EXPECT_STREQ(descriptor.GetStatus(), "NULL parameter:'FilePath'");
  LogRecorder log;
  EXPECT_FALSE(descriptor.Save("", true));
  EXPECT_STREQ(descriptor.GetStatus(), "NULL parameter:'FilePath'");
  EXPECT_EQ(log.errors,
            std::vector<std::string>{"dImaDescriptorDIB::Save: NULL parameter:'FilePath'"});
}

TEST_F(dImaDescriptorDIBFile, MissingImageIsToldBeforeAMissingPath) {
  dImaDescriptorDIB descriptor;
  EXPECT_FALSE(descriptor.Save(nullptr, true));
  EXPECT_STREQ(descriptor.GetStatus(), "dImaDescriptorDIB: not initialized");
}

TEST_F(dImaDescriptorDIBFile, WithoutAnImageNothingIsSaved) {
  dImaDescriptorDIB descriptor;
  EXPECT_FALSE(descriptor.Save(m_path.c_str(), true));
  EXPECT_STREQ(descriptor.GetStatus(), "dImaDescriptorDIB: not initialized");
  EXPECT_FALSE(fs::exists(m_path));
}

TEST_F(dImaDescriptorDIBFile, ImageThatChangedSinceIsNotSaved) {
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  image.Reset();
  EXPECT_FALSE(descriptor.Save(m_path.c_str(), true));
  EXPECT_STREQ(descriptor.GetStatus(), "dImaDescriptorDIB: not initialized");
}

TEST_F(dImaDescriptorDIBFile, BlockThatLiesAboutTheImageIsNotSaved) {
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  descriptor.GetHeader()->bmiHeader.biHeight = -2000000;
  EXPECT_FALSE(descriptor.Save(m_path.c_str(), true));
  EXPECT_STREQ(descriptor.GetStatus(), "dImaDescriptorDIB: not initialized");
}

#if defined(__linux__)
TEST_F(dImaDescriptorDIBFile, DiskThatFillsUpIsToldByThePartThatIsCutOff) {
  const struct {
    unsigned long bytes;
    const char* part;
  } kLimits[] = {{0, "file header"}, {20, "bitmap info"}, {1080, "pixel data"}};
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  for (const auto& limit : kLimits) {
    bool saved = true;
    {
      const study_test::FileSizeLimit full(limit.bytes);
      saved = descriptor.Save(m_path.c_str(), true);
    }
    EXPECT_FALSE(saved) << limit.part;
    EXPECT_EQ(std::string(static_cast<const char*>(descriptor.GetStatus())),
              std::string("error while writing ") + limit.part + " to '" + m_path + "'");
    EXPECT_FALSE(fs::exists(m_path)) << limit.part;
  }
}

TEST_F(dImaDescriptorDIBFile, FullDiskIsAFailureAndTheDeviceStays) {
  dImage image = MakeImage(4, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  EXPECT_FALSE(descriptor.Save("/dev/full", true));
  EXPECT_STREQ(descriptor.GetStatus(), "error while writing file header to '/dev/full'");
  EXPECT_TRUE(fs::is_character_file("/dev/full"));
}
#endif

}  // namespace
