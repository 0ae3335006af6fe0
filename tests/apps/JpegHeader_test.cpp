#include <gtest/gtest.h>
#include <study/dicom/JpegHeader.h>

#include <vector>

using namespace study;

namespace {

using Stream = std::vector<std::uint8_t>;

const Stream kStart{0xFF, 0xD8};
const Stream kTable{0xFF, 0xC4, 0, 4, 1, 2};
/// Lossless, 12 bits, 4 rows of 5 samples, one channel.
const Stream kFrame{0xFF, 0xC3, 0, 11, 12, 0, 4, 0, 5, 1, 1, 0x11, 0};
const Stream kScan{0xFF, 0xDA, 0, 8, 1, 1, 0, 1, 0, 0};

Stream Joined(std::initializer_list<Stream> parts) {
  Stream all;
  for (const Stream& part : parts) {
    all.insert(all.end(), part.begin(), part.end());
  }
  return all;
}

std::string Problem(const Stream& stream) {
  return JpegHeaderProblem(stream, 5, 4, 16);
}

/// The frame header with one byte changed.
Stream FrameWith(std::size_t at, std::uint8_t value) {
  Stream frame = kFrame;
  frame[at] = value;
  return frame;
}

TEST(JpegHeader, GoodHeadersPass) {
  EXPECT_EQ(Problem(Joined({kStart, kTable, kFrame, kTable, kScan})), "");
  EXPECT_EQ(Problem(Joined({kStart, {0xFF}, kFrame, kScan, {1, 2, 3}})), "") << "fill bytes";
  EXPECT_EQ(Problem(Joined({kStart, FrameWith(1, 0xF7), kScan})), "") << "JPEG-LS";
}

TEST(JpegHeader, EveryCutIsTold) {
  const Stream good = Joined({kStart, kTable, kFrame, kScan});
  for (std::size_t size = 2; size < good.size(); ++size) {
    EXPECT_EQ(Problem(Stream(good.begin(), good.begin() + static_cast<std::ptrdiff_t>(size))),
              "its header is cut short")
        << size;
  }
  EXPECT_EQ(Problem({}), "its header is damaged");
  EXPECT_EQ(Problem({0xFF}), "its header is damaged");
}

TEST(JpegHeader, ThePictureMustBeTheAnnouncedOne) {
  const auto with = [](std::size_t at, std::uint8_t value) {
    return Problem(Joined({kStart, FrameWith(at, value), kScan}));
  };
  EXPECT_EQ(with(6, 9), "it is 5 x 9 pixels instead of 5 x 4");
  EXPECT_EQ(with(7, 1), "it is 261 x 4 pixels instead of 5 x 4");
  EXPECT_EQ(with(9, 3), "it has 3 channels");
  EXPECT_EQ(with(4, 17), "it has samples of 17 bits");
  EXPECT_EQ(with(4, 1), "it has samples of 1 bits");
}

TEST(JpegHeader, BrokenOrderIsTold) {
  EXPECT_EQ(Problem(Joined({kStart, kScan})), "its header is damaged") << "no frame";
  EXPECT_EQ(Problem(Joined({kStart, kFrame, kFrame, kScan})), "its header is damaged");
  EXPECT_EQ(Problem(Joined({kStart, {0xFF, 0xD9, 0, 2}, kFrame, kScan})), "its header is damaged");
  EXPECT_EQ(Problem(Joined({kStart, {0x12, 0x34, 0, 2}, kFrame, kScan})), "its header is damaged");
  EXPECT_EQ(Problem(Joined({kFrame, kScan})), "its header is damaged");
}

TEST(JpegHeader, SegmentsTooShortForTheirFieldsAreTold) {
  EXPECT_EQ(Problem(Joined({kStart, FrameWith(3, 10), kScan})), "its header is damaged");
  EXPECT_EQ(Problem(Joined({kStart, kFrame, {0xFF, 0xDA, 0, 7, 1, 1, 0, 1, 0, 0}})),
            "its header is damaged");
  EXPECT_EQ(Problem(Joined({kStart, {0xFF, 0xF8, 0, 3, 1}, kFrame, kScan})),
            "its header is damaged");
  EXPECT_EQ(Problem(Joined({kStart, {0xFF, 0xE0, 0, 1}, kFrame, kScan})), "its header is damaged");
}

}  // namespace
