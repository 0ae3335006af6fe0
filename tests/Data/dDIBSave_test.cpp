// Bitmaps in files: saving, and recognising them.
#include <vorl/Data/dDIB.h>

#include <gtest/gtest.h>

#include <cstddef>
#include <filesystem>
#include <iterator>
#include <limits>
#include <string>
#include <utility>

#if !defined(_WIN32)
#include <sys/stat.h>
#endif

#include "../IO/BinaryFileTest.h"
#include "../IO/File/BitmapBytes.h"
#include "../Support/LogRecorder.h"
#include "DibTesting.h"

namespace {

namespace fs = std::filesystem;

/// Runs in a folder of its own, which is the current one meanwhile.
class dDIBSave : public BinaryFileTest {
 protected:
  void SetUp() override {
    m_before = fs::current_path();
    fs::create_directory(FileName());
    fs::current_path(FileName());
  }
  void TearDown() override { fs::current_path(m_before); }

  fs::path m_before;
};

class NamedBitmap : public dDIB {
 public:
  using dDIB::dDIB;
  using dDIB::SetFileName;
};

TEST_F(dDIBSave, WritesWhatIsReadBack) {
  for (const auto& depth : {std::pair<short, short>{1, 1}, {1, 8}, {3, 8}, {4, 8}}) {
    dDIB dib(37, 5, depth.first, depth.second);
    FillWithCount(dib);
    ASSERT_TRUE(dib.Save("a.bmp", true)) << dib.GetStatus();
    EXPECT_EQ(dib.GetStatus(), 0);
    dDIB copy("a.bmp");
    EXPECT_EQ(copy.GetBitsPerPixel(), dib.GetBitsPerPixel());
    EXPECT_TRUE(SamePixels(copy, dib)) << dib.GetBitsPerPixel();
  }
}

TEST_F(dDIBSave, EightBitFileHasTheRealWidth) {
  dDIB dib(3, 2, 1, 8);
  ASSERT_TRUE(dib.Save("a.bmp", false));
  EXPECT_EQ(fs::file_size("a.bmp"), 1078U + 8U);
  int width = -1;
  int height = -1;
  EXPECT_TRUE(dDIB::IsBitmapFile("a.bmp", width, height));
  EXPECT_EQ(width, 3);
  EXPECT_EQ(height, 2);
  EXPECT_EQ(dib.GetHeader()->bmiHeader.biWidth, 4);
}

TEST_F(dDIBSave, BitmapWithoutPixelsIsNotSaved) {
  dDIB dib;
  LogRecorder log;
  EXPECT_FALSE(dib.Save("a.bmp", true));
  EXPECT_EQ(StatusText(dib), "dDIB::Save: image is not initialized");
  EXPECT_EQ(log.errors,
            std::vector<std::string>{"dDIB::Save: dDIB::Save: image is not initialized"});
  EXPECT_FALSE(fs::exists("a.bmp"));
}

TEST_F(dDIBSave, FailureOfTheDescriptorIsTold) {
  dDIB dib(3, 2, 1, 8);
  ASSERT_TRUE(dib.Save("a.bmp", false));
  LogRecorder log;
  EXPECT_FALSE(dib.Save("a.bmp", false));
  EXPECT_EQ(StatusText(dib), "dDIB::Save: error:file already exists:'a.bmp'");
  EXPECT_FALSE(dib.Save("", false));
  EXPECT_EQ(StatusText(dib), "dDIB::Save: error:NULL parameter:'FilePath'");
  EXPECT_TRUE(dib.IsValid());
  EXPECT_EQ(log.errors.back(), "dDIB::Save: dDIB::Save: error:NULL parameter:'FilePath'");
  EXPECT_TRUE(dib.Save("a.bmp", true));
  EXPECT_EQ(dib.GetStatus(), 0);
}

/// Saves a bitmap without a name. Every such call of this program is made here, in whatever order
/// the tests run: so the number of the file is known, and the first one is 1.
void ExpectNumberedSave(dDIB& dib) {
  static int count = 0;
  const std::string name = std::string("DIBImage") + std::to_string(++count) + ".bmp";
  ASSERT_FALSE(fs::exists(name));
  EXPECT_TRUE(dib.Save(nullptr, false)) << dib.GetStatus();
  EXPECT_TRUE(fs::exists(name)) << name;
}

TEST_F(dDIBSave, UnnamedBitmapsAreNumberedFromOneThroughTheProcess) {
  dDIB dib(3, 2, 1, 8);
  dDIB other(3, 2, 1, 8);
  ExpectNumberedSave(dib);
  ExpectNumberedSave(other);
  ExpectNumberedSave(dib);
  EXPECT_EQ(std::distance(fs::directory_iterator("."), fs::directory_iterator()), 3);
}

TEST_F(dDIBSave, FormattingAnewForgetsTheName) {
  dDIB dib(3, 2, 1, 8);
  ASSERT_TRUE(dib.Save("a.bmp", false));
  dDIB read("a.bmp");
  fs::remove("a.bmp");
  const tagBITMAPINFO info{{40, 4, 4, 1, 24, 0, 0, 0, 0, 0, 0}, {}};
  const unsigned char bits[48] = {};
  ASSERT_TRUE(read.Init(&info, bits));
  ExpectNumberedSave(read);
  ASSERT_TRUE(dib.Save("a.bmp", false));
  ASSERT_TRUE(read.Init("a.bmp"));
  fs::remove("a.bmp");
  read.Reset();
  ASSERT_TRUE(read.Init(3, 2, 3, 8));
  ExpectNumberedSave(read);
  EXPECT_FALSE(fs::exists("a.bmp"));
}

TEST_F(dDIBSave, BitmapFromAFileIsSavedUnderItsName) {
  dDIB dib(3, 2, 1, 8);
  ASSERT_TRUE(dib.Save("a.bmp", false));
  dDIB read("a.bmp");
  read.Fill(0x33);
  EXPECT_FALSE(read.Save(nullptr, false));
  EXPECT_EQ(StatusText(read), "dDIB::Save: error:file already exists:'a.bmp'");
  ASSERT_TRUE(read.Save(nullptr, true));
  EXPECT_TRUE(SamePixels(dDIB("a.bmp"), read));
}

TEST_F(dDIBSave, NameMovesWithTheSection) {
  NamedBitmap source(3, 2, 1, 8);
  source.SetFileName("named.bmp");
  dDIB reference;
  ASSERT_TRUE(reference.Init(DTM_Reference, source));
  ASSERT_TRUE(reference.Save(nullptr, false));
  EXPECT_TRUE(fs::exists("named.bmp"));
  fs::remove("named.bmp");
  dDIB target;
  target <<= source;
  ASSERT_TRUE(target.Save(nullptr, false));
  EXPECT_TRUE(fs::exists("named.bmp"));
  NamedBitmap unnamed(3, 2, 1, 8);
  unnamed.SetFileName("other.bmp");
  unnamed.SetFileName(nullptr);
  ExpectNumberedSave(unnamed);
  EXPECT_FALSE(fs::exists("other.bmp"));
}

TEST_F(dDIBSave, DescendingPaletteIsSaved) {
  dDIB dib(4, 1, 1, 8);
  std::memcpy(dib.GetDataPtr(), "\x00\x01\xFE\xFF", 4);
  ASSERT_TRUE(dib.ResetPalette(false));
  ASSERT_TRUE(dib.Save("a.bmp", false));
  const dDIB read("a.bmp");
  EXPECT_EQ(std::memcmp(read.GetDataPtr(), "\xFF\xFE\x01\x00", 4), 0);
}

class IsBitmapFile : public BinaryFileTest {
 protected:
  bool Ask(const char* path) {
    m_width = -1;
    m_height = -1;
    return dDIB::IsBitmapFile(path, m_width, m_height);
  }
  void ExpectNot(const char* path) {
    EXPECT_FALSE(Ask(path));
    EXPECT_EQ(m_width, 0);
    EXPECT_EQ(m_height, 0);
  }

  int m_width;
  int m_height;
};

TEST_F(IsBitmapFile, TellsTheSizeWithoutSigns) {
  bitmap_test::Bitmap bitmap;
  bitmap.width = -7;
  bitmap.height = -5;
  bitmap.bits = 24;
  MakeFile(bitmap_test::FileOf(bitmap));
  EXPECT_TRUE(Ask(FileName()));
  EXPECT_EQ(m_width, 7);
  EXPECT_EQ(m_height, 5);
}

// Four bytes more than the header are asked for; that they are there is not.
TEST_F(IsBitmapFile, FileMayEndRightBehindItsHeader) {
  bitmap_test::Bitmap bitmap;
  bitmap.width = 7;
  bitmap.height = 5;
  bitmap.bits = 24;
  const auto whole = bitmap_test::FileOf(bitmap);
  for (const long bytes : {40, 41, 42, 43, 44}) {
    MakeFile({whole.begin(), whole.begin() + 14 + bytes});
    EXPECT_TRUE(Ask(FileName())) << bytes;
    EXPECT_EQ(m_width, 7) << bytes;
    EXPECT_EQ(m_height, 5) << bytes;
  }
}

TEST_F(IsBitmapFile, HeadersOfAllKindsTellTheirSize) {
  bitmap_test::Bitmap bitmap;
  bitmap.width = 7;
  bitmap.height = 5;
  bitmap.bits = 24;
  bitmap.infoSize = 124;
  MakeFile(bitmap_test::FileOf(bitmap));
  EXPECT_TRUE(Ask(FileName()));
  EXPECT_EQ(m_width, 7);
  EXPECT_EQ(m_height, 5);
  MakeFile(
      Bytes{'B', 'M', 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 12, 0, 0, 0, 9, 1, 6, 0, 1, 0, 8, 0});
  EXPECT_TRUE(Ask(FileName()));
  EXPECT_EQ(m_width, 265);
  EXPECT_EQ(m_height, 6);
}

TEST_F(IsBitmapFile, OldHeaderMustBeThereToo) {
  const Bytes whole{'B', 'M', 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0,
                    0,   12,  0, 0, 0, 9, 1, 6, 0, 1, 0, 8, 0};
  MakeFile({whole.begin(), whole.end() - 1});
  ExpectNot(FileName());
}

/// The number of files that the process has open; 0 where that cannot be asked.
std::ptrdiff_t OpenFiles() {
#if defined(__linux__)
  return std::distance(fs::directory_iterator("/proc/self/fd"), fs::directory_iterator());
#else
  return 0;
#endif
}

TEST_F(IsBitmapFile, FileIsClosedAgain) {
  bitmap_test::Bitmap bitmap;
  bitmap.width = 7;
  bitmap.height = 5;
  bitmap.bits = 24;
  const auto good = bitmap_test::FileOf(bitmap);
  for (const Bytes& bytes : {Bytes{good.begin(), good.end()}, Bytes{'B', 'M'}}) {
    MakeFile(bytes);
    const auto before = OpenFiles();
    Ask(FileName());
    EXPECT_EQ(OpenFiles(), before);
    EXPECT_TRUE(fs::remove(FileName()));  // not every system removes what is open
  }
}

TEST_F(IsBitmapFile, NameMustBeGiven) {
  LogRecorder log;
  ExpectNot(nullptr);
  EXPECT_EQ(log.errors, std::vector<std::string>{"dDIB::IsBitmapFile: missing filename(NULL)"});
}

TEST_F(IsBitmapFile, FileMustBeOneThatOpens) {
  LogRecorder log;
  ExpectNot(FileName());
  fs::create_directory(FileName());
  ExpectNot(FileName());
  const std::string text = std::string("dDIB::IsBitmapFile: can't open '") + FileName() + "'";
  EXPECT_EQ(log.errors, (std::vector<std::string>{text, text}));
}

#if !defined(_WIN32)
TEST_F(IsBitmapFile, PipeIsNotWaitedFor) {
  ASSERT_EQ(mkfifo(FileName(), 0600), 0);
  ExpectNot(FileName());
}
#endif

class InfoRecorder : public LogTarget {
 public:
  InfoRecorder() { GetLogManager().AddLogTarget(this, nullptr); }
  ~InfoRecorder() override { GetLogManager().RemoveLogTarget(this); }
  void OnInfo(LogContext* context) override { infos.push_back(context->GetMsg()); }
  void OnError(LogContext* context) override { errors.push_back(context->GetMsg()); }

  std::vector<std::string> infos;
  std::vector<std::string> errors;
};

TEST_F(IsBitmapFile, OtherFilesAreToldAsInformation) {
  bitmap_test::Bitmap bitmap;
  bitmap.width = 7;
  bitmap.height = 5;
  bitmap.bits = 24;
  const auto whole = bitmap_test::FileOf(bitmap);
  bitmap.width = std::numeric_limits<std::int32_t>::min();
  bitmap.rows = {0};
  std::vector<Bytes> files{
      {}, {'B', 'M'}, {whole.begin(), whole.begin() + 53}, bitmap_test::FileOf(bitmap)};
  std::swap(bitmap.width, bitmap.height);
  files.push_back(bitmap_test::FileOf(bitmap));
  files.push_back(whole);
  files.back()[0] = 'A';
  for (const Bytes& bytes : files) {
    MakeFile(bytes);
    InfoRecorder log;
    ExpectNot(FileName());
    EXPECT_EQ(log.infos,
              std::vector<std::string>{std::string("'") + FileName() + "' is not a bitmap file"});
    EXPECT_EQ(log.errors, std::vector<std::string>());
  }
}

}  // namespace
