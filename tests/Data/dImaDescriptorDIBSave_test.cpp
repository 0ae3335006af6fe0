// Bitmap files, byte by byte, and what can go wrong while they are written.
#include <vorl/Data/dImaDescriptorDIB.h>

#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include "../Support/LogRecorder.h"
#include "../Support/TestFolder.h"
#include "BitmapTesting.h"
#if defined(__linux__)
#include "../apps/FileSizeLimit.h"
#endif

namespace {

namespace fs = std::filesystem;

class dImaDescriptorDIBFile : public testing::Test {
 protected:
  std::vector<unsigned char> FileBytes() const {
    std::ifstream file(m_path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  }

  const TestFolder m_folder;
  const std::string m_path = (m_folder / "picture.bmp").string();
};

unsigned U16At(const std::vector<unsigned char>& bytes, std::size_t offset) {
  return bytes.at(offset) | static_cast<unsigned>(bytes.at(offset + 1)) << 8;
}

unsigned U32At(const std::vector<unsigned char>& bytes, std::size_t offset) {
  return U16At(bytes, offset) | U16At(bytes, offset + 2) << 16;
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

TEST_F(dImaDescriptorDIBFile, CopySavesTheSameFile) {
  dImage image = MakeImage(3, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.Save(m_path.c_str(), false));
  const auto bytes = FileBytes();
  dImaDescriptorDIB copy(descriptor);
  ASSERT_TRUE(copy.Save(m_path.c_str(), true)) << copy.GetStatus();
  EXPECT_EQ(FileBytes(), bytes);
}

TEST_F(dImaDescriptorDIBFile, SuccessClearsAnOldFailure) {
  dImage image = MakeImage(3, 2, ImageDataType_U8, "G");
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.Save(m_path.c_str(), false));
  EXPECT_FALSE(descriptor.Save(m_path.c_str(), false));
  EXPECT_EQ(descriptor.GetStatus(), -1);
  EXPECT_TRUE(descriptor.Save(m_path.c_str(), true));
  EXPECT_EQ(descriptor.GetStatus(), 0);
}

TEST_F(dImaDescriptorDIBFile, MoreBytesThanAFileHeaderCanStateAreNotWritten) {
  ClaimingImage image(0x7FFFFFF0, 2, ImageDataType_U8);
  dImaDescriptorDIB descriptor(image);
  ASSERT_TRUE(descriptor.IsValid()) << descriptor.GetStatus();
  EXPECT_FALSE(descriptor.Save(m_path.c_str(), false));
  EXPECT_STREQ(descriptor.GetStatus(),
               ("error while writing file header to '" + m_path + "'").c_str());
  EXPECT_FALSE(fs::exists(m_path));
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
