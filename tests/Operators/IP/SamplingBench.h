#ifndef TESTS_OPERATORS_IP_SAMPLINGBENCH_H
#define TESTS_OPERATORS_IP_SAMPLINGBENCH_H

/// @file
/// What the operators that sample a volume into a slice work on, and how they differ.

#include <vorl/Operators/IP/opMIP.h>
#include <vorl/Operators/IP/opMPR.h>

#include <array>

#include "Volumes.h"

namespace sampling_bench {

struct Mpr {
  using Op = opMPR;
  static constexpr const char* kName = "opMPR";
  static constexpr const char* kSliceName = "MPR Slice";
  static constexpr const char* kRefusal = "invalid MPR Algo ID: ";
  static constexpr int kDefaultAlgorithm = 102;
  static constexpr int kNotDefault = 101;
  static constexpr int kDefaultSteps = 0;
  static constexpr std::array kAlgorithms = {101, 102};
  static constexpr std::array kNoAlgorithms = {100, 103, 201, 0, -1};
  static constexpr auto kSlice = &Op::mprSlice;
};

struct Mip {
  using Op = opMIP;
  static constexpr const char* kName = "opMIP";
  static constexpr const char* kSliceName = "MIP Slice";
  static constexpr const char* kRefusal = "invalid MIP Algo ID: ";
  static constexpr int kDefaultAlgorithm = 201;
  static constexpr int kNotDefault = 205;
  static constexpr int kDefaultSteps = -1;
  static constexpr std::array kAlgorithms = {201, 202, 205};
  static constexpr std::array kNoAlgorithms = {200, 203, 204, 206, 101, 0, -1};
  static constexpr auto kSlice = &Op::mipSlice;
};

inline void ExpectFailure(OpBase& op, const std::string& message) {
  EXPECT_FALSE(op.Run());
  EXPECT_EQ(rasters::CodeOf(op), -1);
  EXPECT_EQ(rasters::MessageOf(op), message);
}

/// An operator with a volume of 2 x 2 x 3 voxels, a marked slice that fits it and, where it takes
/// one, a list of the first voxel.
template <class Traits, class Op = typename Traits::Op>
struct Workbench {
  explicit Workbench(unsigned short type = ImageDataType_U16) : list(4UL) {
    for (int i = 0; i < 3; ++i) {
      dSlice added;
      rasters::MakeSlice(added, 2, 2, type);
      EXPECT_EQ(volume.AddSlice(added), i);
    }
    rasters::MakeSlice(slice, 2, 2, type);
    list.Set(0);
    Connect();
  }

  void Connect() {
    op.volume = &volume;
    op.*Traits::kSlice = &slice;
    if constexpr (requires { op.voxelList; }) {
      op.voxelList = &list;
    }
  }

  void ExpectSliceUnwritten() const {
    const dImage& image = slice.GetImage();
    EXPECT_EQ(rasters::BytesOf(image), rasters::Bytes(image.GetImageSize(), 0x5A));
  }

  dVolume volume;
  dSlice slice;
  dBuffer list;
  Op op;
};

}  // namespace sampling_bench

#endif
