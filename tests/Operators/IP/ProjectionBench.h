#ifndef TESTS_OPERATORS_IP_PROJECTIONBENCH_H
#define TESTS_OPERATORS_IP_PROJECTIONBENCH_H

/// @file
/// What a projection into a plane works on.

#include <vorl/Operators/IP/opSliceProjection.h>

#include "Volumes.h"

namespace projection_bench {

/// An operator with everything it may need: a marked plane of 4 x 3 pixels with its depth buffer, a
/// slice of 2 x 2 pixels, a volume of 2 x 2 x 3 voxels and a list of its first voxel.
struct Workbench {
  explicit Workbench(unsigned short type = ImageDataType_U16) : list(4UL) {
    for (int i = 0; i < 3; ++i) {
      dSlice added;
      rasters::MakeSlice(added, 2, 2, type);
      EXPECT_EQ(volume.AddSlice(added), i);
    }
    rasters::MakeSlice(plane, 4, 3, type);
    rasters::MakeSlice(slice, 2, 2, type);
    list.Set(0);
    op.projectionPlane = &plane;
    op.slice = &slice;
    op.volume = &volume;
    op.voxelList = &list;
    EXPECT_TRUE(op.InitZBuffer());
  }

  dVolume volume;
  dSlice plane;
  dSlice slice;
  dBuffer list;
  opSliceProjection op;
};

/// An operator that draws into a cleared plane in identity coordinates; there is a volume of one
/// dark voxel, which every algorithm asks for.
template <class T>
struct Drawing {
  Drawing(unsigned long width, unsigned long height, unsigned short type = ImageDataType_U16) {
    rasters::AddSlice<T>(darkVolume, {.type = type}, {0});
    rasters::MakeSlice(plane, width, height, type);
    op.projectionPlane = &plane;
    op.volume = &darkVolume;
    EXPECT_TRUE(op.InitZBuffer());
    op.ClearProjectionPlane();
  }

  void DrawSlice(dSlice& slice) {
    op.SelectAlgo(301);
    op.slice = &slice;
    EXPECT_TRUE(op.Run()) << rasters::MessageOf(op);
  }

  void DrawVolume(dVolume& volume) {
    op.SelectAlgo(302);
    op.volume = &volume;
    EXPECT_TRUE(op.Run()) << rasters::MessageOf(op);
    op.volume = &darkVolume;
  }

  void DrawVoxels(dVolume& volume, dBuffer& list) {
    op.SelectAlgo(303);
    op.volume = &volume;
    op.voxelList = &list;
    EXPECT_TRUE(op.Run()) << rasters::MessageOf(op);
    op.volume = &darkVolume;
  }

  std::vector<T> Pixels() const { return rasters::SamplesOf<T>(plane.GetImage()); }
  std::vector<std::int16_t> Depths() const { return rasters::SamplesOf<std::int16_t>(op.zBuffer); }

  dVolume darkVolume;
  dSlice plane;
  opSliceProjection op;
};

/// A slice of constant value at this depth in front of a plane in identity coordinates.
template <class T>
void MakeFlat(dSlice& slice, unsigned long width, unsigned long height, T value, float depth,
              unsigned short type = ImageDataType_U16) {
  rasters::MakeOf(slice.GetImage(), {.width = width, .height = height, .type = type},
                  std::vector<T>(width * height, value));
  slice.SetPosition(dVect3D(0, 0, depth));
}

}  // namespace projection_bench

#endif
