#include <vorl/Data/dVolume.h>

#include <gtest/gtest.h>

#include <memory>
#include <random>

#include "../Support/LogRecorder.h"
#include "ImageTesting.h"
#include "VolumeTesting.h"

namespace {

TEST(dVolume, IsRegisteredUnderDataBase) {
  EXPECT_STREQ(dVolume::CI().name, "dVolume");
  ASSERT_NE(dVolume::CI().parents, nullptr);
  EXPECT_EQ(dVolume::CI().parents[0], &DataBase::CI());
  const std::unique_ptr<dVolume> volume(dVolume::Create());
  EXPECT_EQ(volume->GetClassInfo(), &dVolume::CI());
}

void ExpectEmpty(dVolume& volume) {
  EXPECT_FALSE(volume.IsValid());
  EXPECT_EQ(volume.GetSliceCount(), 0);
  EXPECT_EQ(volume.GetSizeX(), 0);
  EXPECT_EQ(volume.GetSizeY(), 0);
  EXPECT_EQ(volume.GetSizeZ(), 0);
  EXPECT_EQ(volume.GetDataType(), 0);
  EXPECT_EQ(volume.GetDataDepth(), 0);
  EXPECT_EQ(volume.GetSlice(0), nullptr);
  EXPECT_TRUE(volume.GetSliceList().empty());
  EXPECT_EQ(volume.GetSliceDataArray(), nullptr);
  ExpectSameCoordinates(volume.GetCoordinates(), dCoordSys3D());
  dVect3D center(9, 9, 9);
  volume.GetVolCenter(center);
  ExpectVector(center, 0, 0, 0);
}

TEST(dVolume, StartsEmpty) {
  dVolume volume;
  ExpectEmpty(volume);
}

TEST(dVolume, ResetDestroysTheSlicesAndTheArray) {
  dVolume volume;
  AddSlices(volume, 3);
  volume.SetCoordinates(SampleCoordinates());
  ASSERT_NE(volume.GetSliceDataArray(), nullptr);
  volume.Reset();
  ExpectEmpty(volume);
}

TEST(dVolume, ShowsTheSizeAndTypeOfItsFirstSlice) {
  dVolume volume;
  AddSlices(volume, 5);
  EXPECT_TRUE(volume.IsValid());
  DataBase& base = volume;
  EXPECT_TRUE(base.IsValid());
  const dVolume& constant = volume;
  EXPECT_TRUE(constant.IsValid());
  EXPECT_EQ(volume.GetSliceCount(), 5);
  EXPECT_EQ(volume.GetSizeX(), 4);
  EXPECT_EQ(volume.GetSizeY(), 3);
  EXPECT_EQ(volume.GetSizeZ(), 5);
  EXPECT_EQ(volume.GetDataType(), ImageDataType_U16);
  EXPECT_EQ(volume.GetDataDepth(), 16);
}

TEST(dVolume, GivesSlicesByIndex) {
  dVolume volume;
  AddSlices(volume, 3);
  int k = 0;
  for (dSlice& slice : volume.GetSliceList()) {
    EXPECT_EQ(volume.GetSlice(k), &slice);
    EXPECT_EQ(BytesOf(slice.GetImage()), Bytes(24, static_cast<unsigned char>(k + 1)));
    ++k;
  }
  const dVolume& constant = volume;
  EXPECT_EQ(constant.GetSlice(1), volume.GetSlice(1));
  EXPECT_EQ(constant.GetSliceList().size(), 3u);
  EXPECT_EQ(volume.GetSlice(-1), nullptr);
  EXPECT_EQ(volume.GetSlice(3), nullptr);
  EXPECT_EQ(volume.GetSlice(-2147483647 - 1), nullptr);
}

TEST(dVolume, AddSliceTakesOverPixelsAndCoordinates) {
  dVolume volume;
  volume.SetCoordinates(SampleCoordinates());
  dSlice slice;
  MakeSlice(slice, 4, 3, ImageDataType_U16, 7);
  const dCoordSys3D place(dVect3D(-1, 2, -3), dVect3D(4, -5, 6), dVect3D(-7, 8, -9),
                          dVect3D(10, -11, 12));
  slice.SetCoordinates(place);
  const void* const pixels = slice.GetImage().GetDataPtr();
  EXPECT_EQ(volume.AddSlice(slice), 0);
  EXPECT_EQ(volume.GetSlice(0)->GetImage().GetDataPtr(), pixels);
  ExpectSameCoordinates(volume.GetSlice(0)->GetCoordinates(), place);
  EXPECT_FALSE(slice.IsValid());
  ExpectReset(slice.GetImage());
  ExpectSameCoordinates(slice.GetCoordinates(), place);
  ExpectSameCoordinates(volume.GetCoordinates(), SampleCoordinates());
}

TEST(dVolume, AddSliceRefusesAnotherSizeOrFormat) {
  struct Case {
    const char* name;
    unsigned long width;
    unsigned long height;
    unsigned short type;
    const char* sequence;
    unsigned short order;
  };
  const Case cases[] = {{"width", 256, 512, ImageDataType_U16, "G", 0},
                        {"height", 512, 256, ImageDataType_U16, "G", 0},
                        {"depth", 512, 512, ImageDataType_U8, "G", 0},
                        {"channels", 512, 512, ImageDataType_U16, "RGB", 0},
                        {"order", 512, 512, ImageDataType_U16, "RGB", 1}};
  dVolume volume;
  dSlice first;
  MakeSlice(first, 512, 512, ImageDataType_U16, 1);
  ASSERT_EQ(volume.AddSlice(first), 0);
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    dSlice slice;
    ASSERT_TRUE(slice.GetImage().Init(c.width, c.height, c.type, c.sequence, c.order, 1));
    slice.GetImage().Fill(5);
    const void* const pixels = slice.GetImage().GetDataPtr();
    const LogRecorder log;
    EXPECT_EQ(volume.AddSlice(slice), -1);
    EXPECT_TRUE(log.errors.empty());
    EXPECT_EQ(volume.GetSliceCount(), 1);
    EXPECT_EQ(slice.GetImage().GetDataPtr(), pixels);
    EXPECT_EQ(slice.GetImage().GetWidth(), c.width);
    EXPECT_EQ(*static_cast<const char*>(pixels), 5);
    ExpectStatus(slice.GetImage().GetStatus(), 0, "");
  }
  dSlice empty;
  EXPECT_EQ(volume.AddSlice(empty), -1);
}

// The format identifier does not tell signed from unsigned samples.
TEST(dVolume, AddSliceTakesAnotherSign) {
  dVolume volume;
  AddSlices(volume, 1);
  dSlice slice;
  MakeSlice(slice, 4, 3, ImageDataType_S16, 2);
  EXPECT_EQ(volume.AddSlice(slice), 1);
  EXPECT_EQ(volume.GetDataType(), ImageDataType_U16);
}

TEST(dVolume, AddSliceRefusesASliceThatIsItsOwn) {
  dVolume volume;
  AddSlices(volume, 2);
  for (int k = 0; k < 2; ++k) {
    EXPECT_EQ(volume.AddSlice(*volume.GetSlice(k)), -1);
    EXPECT_TRUE(volume.GetSlice(k)->IsValid());
  }
  EXPECT_EQ(volume.GetSliceCount(), 2);
}

TEST(dVolume, SlicesKeepTheirAddressesWhileOthersAreAdded) {
  dVolume volume;
  AddSlices(volume, 1);
  const dSlice* const slice = volume.GetSlice(0);
  const void* const pixels = slice->GetImage().GetDataPtr();
  AddSlices(volume, 100);
  EXPECT_EQ(volume.GetSlice(0), slice);
  EXPECT_EQ(slice->GetImage().GetDataPtr(), pixels);
}

TEST(dVolume, CoordinatesAndPositionAreItsOwn) {
  dVolume volume;
  AddSlices(volume, 1);
  const dCoordSys3D sample = SampleCoordinates();
  volume.SetCoordinates(sample);
  ExpectSameCoordinates(volume.GetCoordinates(), sample);
  dCoordSys3D copy;
  volume.GetCoordinates(copy);
  ExpectSameCoordinates(copy, sample);
  volume.SetCoordinates(dVect3D(), sample.axisZ, sample.axisY, sample.axisX);
  dCoordSys3D parts;
  volume.GetCoordinates(parts.origin, parts.axisX, parts.axisY, parts.axisZ);
  ExpectSameCoordinates(parts, dCoordSys3D(dVect3D(), sample.axisZ, sample.axisY, sample.axisX));
  volume.SetPosition(dVect3D(-1, -2, -3));
  dVect3D position;
  volume.GetPosition(position);
  ExpectVector(position, -1, -2, -3);
  volume.GetPosition().y = 8;
  const dVolume& constant = volume;
  ExpectVector(constant.GetPosition(), -1, 8, -3);
  ExpectVector(constant.GetCoordinates().origin, -1, 8, -3);
  ExpectVector(volume.GetSlice(0)->GetPosition(), 1, 2, 1);
}

TEST(dVolume, CentresByHand) {
  dVolume volume;
  AddSlices(volume, 5);
  dVect3D center;
  volume.GetVolCenter(center);
  ExpectVector(center, 2, 1.5, 2.5);
  volume.GetCenterPos(center);
  ExpectVector(center, 2, 1.5, 2.5);
  volume.SetCoordinates(SampleCoordinates());
  volume.GetCenterPos(center);  // (1 2 3) + (4 (4 5 6) + 3 (7 8 9) + 5 (10 11 12)) / 2
  ExpectVector(center, 1 + 43.5, 2 + 49.5, 3 + 55.5);
  volume.GetVolCenter(center);
  ExpectVector(center, 2, 1.5, 2.5);
}

TEST(dVolume, CentresFollowThePlainModel) {
  std::mt19937 random(2718);
  std::uniform_real_distribution<float> component(-1000, 1000);
  const auto vector = [&] {
    return dVect3D(component(random), component(random), component(random));
  };
  dVolume volume;
  for (int count = 1; count <= 100; ++count) {
    AddSlices(volume, 1);
    volume.SetCoordinates(vector(), vector(), vector(), vector());
    dVect3D center;
    volume.GetCenterPos(center);
    ExpectSameVector(center, PlainCenter(volume.GetCoordinates(), 4, 3, count));
  }
}

TEST(dVolume, TheCentreOfAnEmptyVolumeIsItsOrigin) {
  dVolume volume;
  volume.SetCoordinates(SampleCoordinates());
  dVect3D center;
  volume.GetCenterPos(center);
  ExpectVector(center, 1, 2, 3);
}

}  // namespace
