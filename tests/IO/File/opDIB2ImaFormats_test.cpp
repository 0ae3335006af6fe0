// Bitmaps brought into images whose own Init decides about their format.
#include <vorl/IO/File/opDIB2Ima.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <functional>
#include <string>
#include <vector>

#include "../../Support/LogRecorder.h"
#include "../BinaryFileTest.h"
#include "BitmapBytes.h"

namespace {

using bitmap_test::Bitmap;
using bitmap_test::ColourAt;
using bitmap_test::FileOf;
using bitmap_test::Ramp;

/// What `Init` is asked for, to be changed.
struct Wanted {
  unsigned long width;
  unsigned long height;
  unsigned short dataType;
  std::string sequence;
  unsigned short dataOrder;
  unsigned short rowAlignment;
};

/// An image that changes what it is asked for, and whose pixels lie between guards.
class OwnImage : public dImage {
 public:
  explicit OwnImage(std::function<void(Wanted&)> change) : m_change(std::move(change)) {}

  using dImage::Init;
  bool Init(unsigned long width, unsigned long height, unsigned short dataType,
            const char* channelSequence, unsigned short dataOrder,
            unsigned short rowAlignment) override {
    Wanted wanted{width, height, dataType, channelSequence, dataOrder, rowAlignment};
    m_change(wanted);
    if (!dImage::Init(wanted.width, wanted.height, wanted.dataType, wanted.sequence.c_str(),
                      wanted.dataOrder, wanted.rowAlignment)) {
      return false;
    }
    m_bytes.assign(GetImageSize() + 2 * kGuard, 0xAB);
    return m_buffer.Init(m_bytes.data() + kGuard, GetImageSize() - missing, DTM_Reference);
  }

  bool GuardsStand() const {
    const auto isGuard = [](unsigned char byte) { return byte == 0xAB; };
    return std::all_of(m_bytes.begin(), m_bytes.begin() + kGuard, isGuard) &&
           std::all_of(m_bytes.end() - kGuard, m_bytes.end(), isGuard);
  }

  unsigned long missing = 0;  ///< bytes that the pixels have too few

 private:
  static constexpr long kGuard = 64;
  std::function<void(Wanted&)> m_change;
  std::vector<unsigned char> m_bytes;
};

Bitmap Make(int width, int bits, bool grey) {
  Bitmap bitmap;
  bitmap.width = width;
  bitmap.height = 3;
  bitmap.bits = bits;
  bitmap.palette = Ramp(bits <= 8 ? 1 << bits : 0, grey);
  return bitmap;
}

class opDIB2ImaFormat : public BinaryFileTest {
 protected:
  /// The status after a conversion into an image of another format.
  std::string Refusal(const std::function<void(Wanted&)>& change, unsigned long missing = 0) {
    MakeFile(FileOf(Make(5, 24, false)));
    OwnImage image(change);
    image.missing = missing;
    opDIB2Ima op;
    LogRecorder log;
    EXPECT_FALSE(op.Convert(FileName(), image));
    EXPECT_TRUE(image.GuardsStand());
    EXPECT_FALSE(static_cast<const dImage&>(image).IsValid());
    const std::string text = static_cast<const char*>(op.GetStatus());
    EXPECT_EQ(log.errors.back(), "opDIB2Ima::InitOutputImage: " + text);
    return text;
  }
};

TEST_F(opDIB2ImaFormat, RowsMayHaveAnyAlignment) {
  for (const int alignment : {1, 2, 8, 32}) {
    for (const int bits : {1, 2, 4, 8, 16, 24, 32}) {
      for (const bool grey : {true, false}) {
        for (const int width : {1, 2, 3, 4, 5, 9, 33}) {
          const Bitmap bitmap = Make(width, bits, grey);
          MakeFile(FileOf(bitmap));
          OwnImage image([&](Wanted& wanted) {
            wanted.rowAlignment = static_cast<unsigned short>(alignment);
          });
          opDIB2Ima op;
          SCOPED_TRACE(testing::Message() << alignment << ", " << bits << ", " << width);
          ASSERT_TRUE(op.Convert(FileName(), image)) << op.GetStatus();
          EXPECT_EQ(image.GetRowAlignment(), alignment);
          EXPECT_TRUE(image.GuardsStand());
          for (int y = 0; y < 3; ++y) {
            const auto* row = static_cast<const unsigned char*>(image.GetRowPtr(y));
            for (int x = 0; x < width; ++x) {
              if (bits == 1) {
                EXPECT_EQ(row[x / 8] >> (7 - x % 8) & 1, IndexAt(bitmap, x, y)) << x << ", " << y;
              } else {
                EXPECT_EQ(ColourAt(image, x, y), ColourAt(bitmap, x, y)) << x << ", " << y;
              }
              if (bits == 32) {
                EXPECT_EQ(row[4 * x + 3], ByteAt(bitmap, x, y, 3)) << x << ", " << y;
              }
            }
          }
        }
      }
    }
  }
}

TEST_F(opDIB2ImaFormat, PlainRampIsCopiedIntoTightRows) {
  Bitmap bitmap = Make(5, 8, true);
  std::reverse(bitmap.palette.begin(), bitmap.palette.end());  // ascending
  MakeFile(FileOf(bitmap));
  OwnImage image([](Wanted& wanted) { wanted.rowAlignment = 1; });
  opDIB2Ima op;
  ASSERT_TRUE(op.Convert(FileName(), image)) << op.GetStatus();
  EXPECT_TRUE(image.GuardsStand());
  for (int y = 0; y < 3; ++y) {
    for (int x = 0; x < 5; ++x) {
      EXPECT_EQ(ColourAt(image, x, y)[0], IndexAt(bitmap, x, y));
    }
  }
}

TEST_F(opDIB2ImaFormat, ChannelsMayHaveOtherNames) {
  const Bitmap bitmap = Make(5, 24, false);
  MakeFile(FileOf(bitmap));
  OwnImage image([](Wanted& wanted) { wanted.sequence = "RGB"; });
  opDIB2Ima op;
  ASSERT_TRUE(op.Convert(FileName(), image)) << op.GetStatus();
  EXPECT_EQ(ColourAt(image, 4, 2), ColourAt(bitmap, 4, 2));
}

TEST_F(opDIB2ImaFormat, ImageWithOtherPixelsThanAskedForIsRefused) {
  const std::string text = "can't initialize the output image: it has another format";
  EXPECT_EQ(Refusal([](Wanted& wanted) { --wanted.width; }), text);
  EXPECT_EQ(Refusal([](Wanted& wanted) { ++wanted.width; }), text);
  EXPECT_EQ(Refusal([](Wanted& wanted) { --wanted.height; }), text);
  EXPECT_EQ(Refusal([](Wanted& wanted) { ++wanted.height; }), text);
  EXPECT_EQ(Refusal([](Wanted& wanted) { wanted.sequence = "G"; }), text);
  EXPECT_EQ(Refusal([](Wanted& wanted) { wanted.dataType = ImageDataType_U16; }), text);
  EXPECT_EQ(Refusal([](Wanted& wanted) { wanted.dataOrder = ImageDataOrder_Plane; }), text);
  EXPECT_EQ(Refusal([](Wanted&) {}, 1), text);
}

/// An image that says yes to all, and does nothing.
class IdleImage : public dImage {
 public:
  using dImage::Init;
  bool Init(unsigned long, unsigned long, unsigned short, const char*, unsigned short,
            unsigned short) override {
    return true;
  }
};

TEST_F(opDIB2ImaFormat, ImageThatIsNotFormattedAtAllIsRefused) {
  MakeFile(FileOf(Make(5, 24, false)));
  IdleImage image;
  opDIB2Ima op;
  EXPECT_FALSE(op.Convert(FileName(), image));
  EXPECT_STREQ(op.GetStatus(), "can't initialize the output image: it has another format");
}

}  // namespace
