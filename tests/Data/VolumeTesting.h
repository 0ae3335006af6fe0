#ifndef VORL_TESTS_DATA_VOLUMETESTING_H
#define VORL_TESTS_DATA_VOLUMETESTING_H

#include <vorl/Data/dVolume.h>

#include <gtest/gtest.h>

/// Formats the slice's image, fills it with the value and places the slice at z = value.
inline void MakeSlice(dSlice& slice, int width, int height, unsigned short dataType, char value) {
  ASSERT_TRUE(slice.GetImage().Init(static_cast<unsigned long>(width),
                                    static_cast<unsigned long>(height), dataType, "G",
                                    ImageDataOrder_Pixel, 1));
  slice.GetImage().Fill(value);
  slice.SetPosition(dVect3D(1.0F, 2.0F, static_cast<float>(value)));
}

/// Appends slices of 4 x 3 voxels of 16 bits, filled with 1, 2, 3 and so on.
inline void AddSlices(dVolume& volume, int count) {
  for (int k = 0; k < count; ++k) {
    const int countBefore = volume.GetSliceCount();
    dSlice slice;
    MakeSlice(slice, 4, 3, ImageDataType_U16, static_cast<char>(k + 1));
    ASSERT_EQ(volume.AddSlice(slice), countBefore);
    ASSERT_EQ(volume.GetSliceCount(), countBefore + 1);
  }
}

/// Compares exactly, where the vectors' own comparison is tolerant.
inline void ExpectVector(const dVect3D& v, double x, double y, double z) {
  EXPECT_EQ(v.x, static_cast<float>(x));
  EXPECT_EQ(v.y, static_cast<float>(y));
  EXPECT_EQ(v.z, static_cast<float>(z));
}

inline void ExpectSameVector(const dVect3D& v, const dVect3D& expected) {
  ExpectVector(v, expected.x, expected.y, expected.z);
}

inline void ExpectSameCoordinates(const dCoordSys3D& coordinates, const dCoordSys3D& expected) {
  ExpectSameVector(coordinates.origin, expected.origin);
  ExpectSameVector(coordinates.axisX, expected.axisX);
  ExpectSameVector(coordinates.axisY, expected.axisY);
  ExpectSameVector(coordinates.axisZ, expected.axisZ);
}

/// Twelve different components.
inline dCoordSys3D SampleCoordinates() {
  return dCoordSys3D(dVect3D(1, 2, 3), dVect3D(4, 5, 6), dVect3D(7, 8, 9), dVect3D(10, 11, 12));
}

/// The middle of a grid by definition, component by component: the halved sum is rounded to single
/// precision, then the origin is added and the result rounded again.
inline dVect3D PlainCenter(const dCoordSys3D& c, double nx, double ny, double nz) {
  const auto component = [&](int i) {
    const double sum = nx * c.axisX[i] + ny * c.axisY[i] + nz * c.axisZ[i];
    const float half = static_cast<float>(0.5 * sum);
    return static_cast<float>(static_cast<double>(c.origin[i]) + static_cast<double>(half));
  };
  return dVect3D(component(0), component(1), component(2));
}

#endif
