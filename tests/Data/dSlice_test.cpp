#include <vorl/Data/dSlice.h>

#include <gtest/gtest.h>

#include <cmath>
#include <memory>
#include <random>

#include "ImageTesting.h"
#include "VolumeTesting.h"

namespace {

TEST(dSlice, IsRegisteredUnderDataBase) {
  EXPECT_STREQ(dSlice::CI().name, "dSlice");
  ASSERT_NE(dSlice::CI().parents, nullptr);
  EXPECT_EQ(dSlice::CI().parents[0], &DataBase::CI());
  const std::unique_ptr<dSlice> slice(dSlice::Create());
  EXPECT_EQ(slice->GetClassInfo(), &dSlice::CI());
}

TEST(dSlice, StartsEmptyInTheIdentity) {
  dSlice slice;
  EXPECT_FALSE(slice.IsValid());
  EXPECT_EQ(slice.GetWidth(), 0);
  EXPECT_EQ(slice.GetHeight(), 0);
  EXPECT_EQ(slice.GetDataType(), 0);
  EXPECT_EQ(slice.GetDataDepth(), 0);
  ExpectSameCoordinates(slice.GetCoordinates(), dCoordSys3D());
}

TEST(dSlice, ShowsItsImage) {
  dSlice slice;
  MakeSlice(slice, 4, 3, ImageDataType_S16, 7);
  EXPECT_TRUE(slice.IsValid());
  DataBase& base = slice;
  EXPECT_TRUE(base.IsValid());
  EXPECT_EQ(slice.GetWidth(), 4);
  EXPECT_EQ(slice.GetHeight(), 3);
  EXPECT_EQ(slice.GetDataType(), ImageDataType_S16);
  EXPECT_EQ(slice.GetDataDepth(), 16);
  const dSlice& constant = slice;
  EXPECT_TRUE(constant.IsValid());
  EXPECT_EQ(&constant.GetImage(), &slice.GetImage());
}

TEST(dSlice, ResetEmptiesImageAndCoordinates) {
  dSlice slice;
  MakeSlice(slice, 4, 3, ImageDataType_S16, 7);
  slice.SetCoordinates(SampleCoordinates());
  slice.Reset();
  EXPECT_FALSE(slice.IsValid());
  ExpectReset(slice.GetImage());
  ExpectSameCoordinates(slice.GetCoordinates(), dCoordSys3D());
}

TEST(dSlice, ATypeWithoutPixelsIsZero) {
  dSlice slice;
  ASSERT_TRUE(slice.GetImage().Init(4, 0, ImageDataType_S16, "G", 0, 1));
  EXPECT_EQ(slice.GetDataType(), 0);
  EXPECT_EQ(slice.GetDataDepth(), 0);
  EXPECT_EQ(slice.GetWidth(), 4);
}

TEST(dSlice, CoordinatesAreSetAndReadWhole) {
  dSlice slice;
  const dCoordSys3D sample = SampleCoordinates();
  slice.SetCoordinates(sample);
  ExpectSameCoordinates(slice.GetCoordinates(), sample);
  dCoordSys3D copy;
  slice.GetCoordinates(copy);
  ExpectSameCoordinates(copy, sample);
  slice.GetCoordinates().axisX.x = 40;
  const dSlice& constant = slice;
  EXPECT_EQ(constant.GetCoordinates().axisX.x, 40.0F);
}

TEST(dSlice, CoordinatesAreSetAndReadByTheirVectors) {
  dSlice slice;
  const dCoordSys3D sample = SampleCoordinates();
  slice.SetCoordinates(sample.origin, sample.axisX, sample.axisY, sample.axisZ);
  ExpectSameCoordinates(slice.GetCoordinates(), sample);
  dCoordSys3D parts;
  slice.GetCoordinates(parts.origin, parts.axisX, parts.axisY, parts.axisZ);
  ExpectSameCoordinates(parts, sample);
}

TEST(dSlice, ThePositionIsTheOrigin) {
  dSlice slice;
  slice.SetCoordinates(SampleCoordinates());
  slice.SetPosition(dVect3D(-1, -2, -3));
  ExpectVector(slice.GetCoordinates().origin, -1, -2, -3);
  ExpectVector(slice.GetCoordinates().axisX, 4, 5, 6);
  dVect3D position;
  slice.GetPosition(position);
  ExpectVector(position, -1, -2, -3);
  slice.GetPosition().x = 50;
  const dSlice& constant = slice;
  ExpectVector(constant.GetPosition(), 50, -2, -3);
}

TEST(dSlice, TheThicknessIsTheLengthOfAxisZ) {
  dSlice slice;
  EXPECT_EQ(slice.GetSliceThickness(), 1.0);
  slice.GetCoordinates().axisZ.Set(0, 0, 2);
  EXPECT_EQ(slice.GetSliceThickness(), 2.0);
  slice.SetSliceThickness(5);
  ExpectVector(slice.GetCoordinates().axisZ, 0, 0, 5);
  slice.GetCoordinates().axisZ.Set(2, -3, 6);
  EXPECT_EQ(slice.GetSliceThickness(), 7.0);
  slice.GetCoordinates().axisZ.Set(1, 1, 1);
  EXPECT_EQ(slice.GetSliceThickness(), std::sqrt(3.0));  // not rounded to single precision
}

TEST(dSlice, TheThicknessIsSetByAFactorInSinglePrecision) {
  std::mt19937 random(99);
  std::uniform_real_distribution<float> component(-3, 3);
  for (int round = 0; round < 200; ++round) {
    dSlice slice;
    const dVect3D axis(component(random), component(random), component(random));
    slice.GetCoordinates().axisZ = axis;
    const double thickness = 0.1 + round;
    slice.SetSliceThickness(thickness);
    const double length =
        std::sqrt(double{axis.x} * axis.x + double{axis.y} * axis.y + double{axis.z} * axis.z);
    const auto factor = static_cast<float>(thickness / length);
    ExpectVector(slice.GetCoordinates().axisZ, axis.x * factor, axis.y * factor, axis.z * factor);
  }
}

TEST(dSlice, AnAxisOfZeroLengthBecomesNotANumber) {
  dSlice slice;
  slice.GetCoordinates().axisZ.Reset();
  slice.SetSliceThickness(5);
  EXPECT_TRUE(std::isnan(slice.GetCoordinates().axisZ.x));
  EXPECT_TRUE(std::isnan(slice.GetCoordinates().axisZ.y));
  EXPECT_TRUE(std::isnan(slice.GetCoordinates().axisZ.z));
}

TEST(dSlice, CentresOfASmallSlice) {
  dSlice slice;
  MakeSlice(slice, 4, 2, ImageDataType_U8, 0);
  slice.SetPosition(dVect3D());
  dVect3D center;
  slice.GetSliceCenter(center);
  ExpectVector(center, 2, 1, 0.5);
  center.Reset();
  slice.GetCenterPos(center);
  ExpectVector(center, 2, 1, 0.5);
  slice.SetCoordinates(SampleCoordinates());
  slice.GetSliceCenter(center);
  ExpectVector(center, 2, 1, 0.5);
  slice.GetCenterPos(center);  // (1 2 3) + (4 (4 5 6) + 2 (7 8 9) + (10 11 12)) / 2
  ExpectVector(center, 1 + 20, 2 + 23.5, 3 + 27);
}

TEST(dSlice, CentresOfAnEmptySlice) {
  const dSlice slice;
  dVect3D center(9, 9, 9);
  slice.GetSliceCenter(center);
  ExpectVector(center, 0, 0, 0.5);
  slice.GetCenterPos(center);
  ExpectVector(center, 0, 0, 0.5);
}

// Half the diagonal is 2^24 + 0.5, which single precision cannot hold; rounded only at the end the
// result would be 0.5.
TEST(dSlice, TheCentreIsRoundedBeforeTheOriginIsAdded) {
  dSlice slice;
  MakeSlice(slice, 2, 2, ImageDataType_U8, 0);
  slice.SetCoordinates(dVect3D(-16777216, 0, 0), dVect3D(16777216, 0, 0), dVect3D(0.5F, 0, 0),
                       dVect3D(0, 0, 0));
  dVect3D center;
  slice.GetCenterPos(center);
  EXPECT_EQ(center.x, 0.0F);
}

TEST(dSlice, CentresFollowThePlainModel) {
  std::mt19937 random(31415);
  std::uniform_real_distribution<float> component(-1000, 1000);
  const auto vector = [&] {
    return dVect3D(component(random), component(random), component(random));
  };
  for (int round = 0; round < 300; ++round) {
    const int width = 1 + static_cast<int>(random() % 300);
    const int height = 1 + static_cast<int>(random() % 300);
    dSlice slice;
    MakeSlice(slice, width, height, ImageDataType_U1, 0);
    slice.SetCoordinates(vector(), vector(), vector(), vector());
    dVect3D center;
    slice.GetCenterPos(center);
    ExpectSameVector(center, PlainCenter(slice.GetCoordinates(), width, height, 1));
  }
}

TEST(dSlice, CopiesHavePixelsOfTheirOwn) {
  dSlice slice;
  MakeSlice(slice, 4, 3, ImageDataType_S16, 7);
  slice.SetCoordinates(SampleCoordinates());
  const dSlice copy(slice);
  dSlice assigned;
  assigned = slice;
  for (const dSlice* other : {&copy, static_cast<const dSlice*>(&assigned)}) {
    ExpectSameCoordinates(other->GetCoordinates(), SampleCoordinates());
    ExpectSameFormat(other->GetImage(), slice.GetImage());
    EXPECT_EQ(BytesOf(other->GetImage()), Bytes(24, 7));
    EXPECT_NE(other->GetImage().GetDataPtr(), slice.GetImage().GetDataPtr());
  }
  const dSlice& same = assigned;
  assigned = same;
  EXPECT_EQ(BytesOf(assigned.GetImage()), Bytes(24, 7));
  assigned = dSlice();
  EXPECT_FALSE(assigned.IsValid());
  ExpectSameCoordinates(assigned.GetCoordinates(), dCoordSys3D());
}

}  // namespace
