// Copying and moving bitmaps, among themselves and from and to plain images.
#include <vorl/Data/dDIB.h>

#include <gtest/gtest.h>

#include <cstring>
#include <utility>

#include "../Support/LogRecorder.h"
#include "DibTesting.h"

namespace {

dImage PlainImage(unsigned short alignment, unsigned short type = ImageDataType_U8,
                  const char* sequence = "BGR") {
  dImage image;
  EXPECT_TRUE(image.Init(5, 3, type, sequence, ImageDataOrder_Pixel, alignment));
  FillWithCount(image);
  return image;
}

TEST(dDIBTransfer, CopyHasASectionOfItsOwn) {
  dDIB source(5, 3, 4, 8);
  FillWithCount(source);
  dDIB copy(source);
  EXPECT_TRUE(SamePixels(copy, source));
  EXPECT_NE(copy.GetHandle(), source.GetHandle());
  EXPECT_TRUE(ShowsItsSection(copy));
  dDIB assigned(1, 1, 1, 1);
  assigned = copy;
  EXPECT_TRUE(SamePixels(assigned, copy));
  EXPECT_TRUE(ShowsItsSection(assigned));
  assigned = *&assigned;
  EXPECT_TRUE(assigned.IsValid());
  assigned = dDIB();
  EXPECT_FALSE(assigned.IsValid());
  EXPECT_EQ(assigned.GetHandle(), nullptr);
}

TEST(dDIBTransfer, AssignedImageMayHaveRowsOfAnyAlignment) {
  for (const unsigned alignment : {1U, 2U, 4U, 8U, 16U, 32U}) {
    const dImage image = PlainImage(static_cast<unsigned short>(alignment));
    dDIB dib;
    dib = image;
    EXPECT_TRUE(SamePixels(dib, image)) << alignment;
    EXPECT_EQ(dib.GetBytesPerRow(), 16U);
    EXPECT_EQ(dib.GetImageSize(), 48U);
    EXPECT_TRUE(ShowsItsSection(dib));
    dDIB throughBase;
    static_cast<dImage&>(throughBase) = image;
    EXPECT_TRUE(SamePixels(throughBase, image)) << alignment;
    EXPECT_TRUE(ShowsItsSection(throughBase));
  }
}

TEST(dDIBTransfer, AssignedImageMayReferToItsOwnSection) {
  dDIB dib(5, 3, 3, 8);
  FillWithCount(dib);
  const dImage expected(dib);
  dImage part;
  ASSERT_TRUE(part.Init(DTM_Reference, dib));
  ASSERT_EQ(part.GetDataPtr(), dib.GetDataPtr());
  dib = part;
  EXPECT_TRUE(SamePixels(dib, expected));
  for (const DataTransferMode mode : {DTM_Copy, DTM_Reference, DTM_TakeOver}) {
    ASSERT_TRUE(part.Init(DTM_Reference, dib));
    EXPECT_TRUE(dib.Init(mode, part));
    EXPECT_TRUE(SamePixels(dib, expected)) << mode;
    EXPECT_TRUE(dib.GetHandle() != nullptr);
  }
}

// A name for each way in which a bitmap takes an image as if it were a plain one.
struct WayThroughBase {
  const char* name;
  void (*take)(dImage& bitmap, dImage& image);
  bool resetsImage;
};

constexpr WayThroughBase kWaysThroughBase[] = {
    {"=", [](dImage& bitmap, dImage& image) { bitmap = image; }, false},
    {"<<=", [](dImage& bitmap, dImage& image) { bitmap <<= image; }, true},
    {">>=", [](dImage& bitmap, dImage& image) { image >>= bitmap; }, true},
};

TEST(dDIBTransfer, PlainImageTakenThroughTheBaseClassGetsASection) {
  for (const WayThroughBase& way : kWaysThroughBase) {
    dImage image = PlainImage(1);
    const dImage expected(image);
    dDIB dib(5, 3, 3, 8);
    way.take(dib, image);
    EXPECT_TRUE(SamePixels(dib, expected)) << way.name;
    EXPECT_TRUE(ShowsItsSection(dib)) << way.name;
    EXPECT_EQ(image.IsValid(), !way.resetsImage) << way.name;
  }
}

TEST(dDIBTransfer, ImageThatRefersToTheSectionCanBeTakenThroughTheBaseClass) {
  for (const WayThroughBase& way : kWaysThroughBase) {
    for (const bool partly : {false, true}) {
      dDIB dib(5, 3, 3, 8);
      FillWithCount(dib);
      dImage part;
      ASSERT_TRUE(part.Init(DTM_Reference, dib));
      if (partly) {
        ASSERT_TRUE(part.Init(5, 2, ImageDataType_U8, "BGR", ImageDataOrder_Pixel, 4));
        part.GetDataBuffer().Init(dib.GetRowPtr(1), part.GetImageSize(), DTM_Reference);
      }
      const dImage expected(part);
      way.take(dib, part);
      EXPECT_TRUE(SamePixels(dib, expected)) << way.name << partly;
      EXPECT_TRUE(ShowsItsSection(dib)) << way.name << partly;
      EXPECT_EQ(part.IsValid(), !way.resetsImage) << way.name << partly;
    }
  }
}

TEST(dDIBTransfer, BitmapTakenThroughTheBaseClassMovesItsSection) {
  for (const WayThroughBase& way : kWaysThroughBase) {
    dDIB source(5, 3, 3, 8);
    FillWithCount(source);
    const dImage expected(source);
    const HBITMAP handle = source.GetHandle();
    dDIB dib(2, 2, 1, 8);
    way.take(dib, source);
    EXPECT_TRUE(SamePixels(dib, expected)) << way.name;
    EXPECT_TRUE(ShowsItsSection(dib)) << way.name;
    EXPECT_EQ(dib.GetHandle() == handle, way.resetsImage) << way.name;
    EXPECT_EQ(source.GetHandle() == nullptr, way.resetsImage) << way.name;
  }
}

TEST(dDIBTransfer, ImageThatIsNoBitmapIsRefusedAndStays) {
  dImage image = PlainImage(4, ImageDataType_U16, "G");
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    dDIB dib(4, 4, 1, 8);
    EXPECT_FALSE(dib.Init(mode, image));
    EXPECT_EQ(StatusText(dib),
              "initialization error:not a 'Bitmap' format: 1 x 16 bit - 'G' - pixel order");
    EXPECT_FALSE(dib.IsValid());
    EXPECT_TRUE(image.IsValid());
  }
  dDIB dib(4, 4, 1, 8);
  dib <<= image;
  EXPECT_FALSE(dib.IsValid());
  EXPECT_TRUE(image.IsValid());
}

TEST(dDIBTransfer, PlainImageIsCopiedIntoASectionInEveryMode) {
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    dImage image = PlainImage(1);
    const dImage expected(image);
    dDIB dib;
    ASSERT_TRUE(dib.Init(mode, image));
    EXPECT_TRUE(SamePixels(dib, expected));
    EXPECT_NE(dib.GetDataPtr(), image.GetDataPtr());
    EXPECT_TRUE(ShowsItsSection(dib));
    EXPECT_EQ(image.IsValid(), mode != DTM_TakeOver);
  }
}

TEST(dDIBTransfer, SameObjectStaysAsItIs) {
  dDIB dib(5, 3, 3, 8);
  const HBITMAP handle = dib.GetHandle();
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    EXPECT_TRUE(dib.Init(mode, dib));
  }
  dib <<= dib;
  dib >>= dib;
  EXPECT_TRUE(dib.IsValid());
  EXPECT_EQ(dib.GetHandle(), handle);
  dDIB empty;
  EXPECT_TRUE(empty.Init(DTM_Copy, empty));
}

TEST(dDIBTransfer, CopyModeCopiesThePixelsWithoutASection) {
  dDIB source(5, 3, 3, 8);
  FillWithCount(source);
  dDIB copy(1, 1, 1, 1);
  ASSERT_TRUE(copy.Init(DTM_Copy, source));
  EXPECT_TRUE(SamePixels(copy, source));
  EXPECT_EQ(copy.GetHandle(), nullptr);
  EXPECT_EQ(copy.GetBitsPerPixel(), 24);
  source.Reset();
  EXPECT_TRUE(copy.IsValid());
}

TEST(dDIBTransfer, TakeOverMovesTheSection) {
  dDIB source(5, 3, 3, 8);
  FillWithCount(source);
  const dImage expected(source);
  const HBITMAP handle = source.GetHandle();
  const void* const pixels = source.GetDataPtr();
  dDIB target(1, 1, 1, 1);
  ASSERT_TRUE(target.Init(DTM_TakeOver, source));
  EXPECT_EQ(target.GetHandle(), handle);
  EXPECT_EQ(target.GetDataPtr(), pixels);
  EXPECT_TRUE(SamePixels(target, expected));
  EXPECT_EQ(target.GetHeader()->bmiHeader.biBitCount, 24);
  EXPECT_FALSE(source.IsValid());
  EXPECT_EQ(source.GetHandle(), nullptr);
  EXPECT_EQ(source.GetHeader(), nullptr);
  EXPECT_TRUE(ShowsItsSection(target));
}

TEST(dDIBTransfer, BothMovesMoveTheSection) {
  dDIB first(5, 3, 1, 8);
  const HBITMAP handle = first.GetHandle();
  dDIB second;
  second <<= first;
  EXPECT_EQ(second.GetHandle(), handle);
  EXPECT_FALSE(first.IsValid());
  dDIB third(2, 2, 3, 8);
  second >>= third;
  EXPECT_EQ(third.GetHandle(), handle);
  EXPECT_FALSE(second.IsValid());
  EXPECT_TRUE(ShowsItsSection(third));
}

TEST(dDIBTransfer, TakeOverOfPlainMemoryMovesIt) {
  dDIB source(5, 3, 3, 8);
  FillWithCount(source);
  dDIB plain;
  ASSERT_TRUE(plain.Init(DTM_Copy, source));
  const void* const pixels = plain.GetDataPtr();
  dDIB target;
  ASSERT_TRUE(target.Init(DTM_TakeOver, plain));
  EXPECT_EQ(target.GetDataPtr(), pixels);
  EXPECT_EQ(target.GetHandle(), nullptr);
  EXPECT_FALSE(plain.IsValid());
  EXPECT_TRUE(SamePixels(target, source));
}

TEST(dDIBTransfer, ReferenceShowsTheSourcesSectionAndLeavesIt) {
  dDIB source(5, 3, 3, 8);
  FillWithCount(source);
  const HBITMAP handle = source.GetHandle();
  {
    dDIB reference;
    ASSERT_TRUE(reference.Init(DTM_Reference, source));
    EXPECT_EQ(reference.GetHandle(), handle);
    EXPECT_EQ(reference.GetDataPtr(), source.GetDataPtr());
    EXPECT_TRUE(ShowsItsSection(reference));
    dDIB moved;
    moved <<= reference;  // still nobody's but the source's
    EXPECT_EQ(moved.GetHandle(), handle);
    EXPECT_FALSE(reference.IsValid());
  }
  EXPECT_EQ(source.GetHandle(), handle);
  EXPECT_TRUE(ShowsItsSection(source));
}

TEST(dDIBTransfer, InvalidSourceIsRefused) {
  for (const DataTransferMode mode : {DTM_Copy, DTM_TakeOver, DTM_Reference}) {
    dDIB empty;
    dDIB dib(4, 4, 1, 8);
    LogRecorder log;
    EXPECT_FALSE(dib.Init(mode, empty));
    EXPECT_FALSE(dib.IsValid());
    EXPECT_EQ(dib.GetHandle(), nullptr);
    EXPECT_EQ(StatusText(dib), "initialization error:uninitialized image") << mode;
    EXPECT_EQ(log.errors.back(), "dDIB::OnInit: initialization error:uninitialized image") << mode;
  }
}

TEST(dDIBTransfer, UnknownModeTakesNoPixels) {
  dDIB source(4, 4, 1, 8);
  dDIB dib(4, 4, 1, 8);
  EXPECT_FALSE(dib.Init(static_cast<DataTransferMode>(7), source));
  EXPECT_FALSE(dib.IsValid());
  EXPECT_TRUE(source.IsValid());
  EXPECT_TRUE(ShowsItsSection(source));
}

TEST(dDIBTransfer, PlainImageThatTakesABitmapOverGetsPixelsOfItsOwn) {
  for (int way = 0; way < 3; ++way) {
    dDIB source(5, 3, 3, 8);
    FillWithCount(source);
    const dImage expected(source);
    dImage image;
    if (way == 0) {
      image <<= source;
    } else if (way == 1) {
      source >>= image;
    } else {
      EXPECT_TRUE(image.Init(DTM_TakeOver, source));
    }
    EXPECT_FALSE(source.IsValid());
    EXPECT_EQ(source.GetHandle(), nullptr);
    EXPECT_TRUE(SamePixels(image, expected)) << way;
    EXPECT_FALSE(image.GetDataBuffer().IsReference()) << way;
  }
}

TEST(dDIBTransfer, PlainImageCanReferToABitmap) {
  dDIB source(5, 3, 3, 8);
  dImage image;
  ASSERT_TRUE(image.Init(DTM_Reference, source));
  EXPECT_EQ(image.GetDataPtr(), source.GetDataPtr());
  image.Reset();
  EXPECT_TRUE(ShowsItsSection(source));
}

}  // namespace
