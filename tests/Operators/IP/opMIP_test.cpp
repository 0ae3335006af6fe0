// What only a projection asks for: the list of voxels. The rest is in SamplingOperator_test.cpp.

#include <vorl/Operators/IP/opMIP.h>

#include <gtest/gtest.h>

#include "SamplingBench.h"

namespace {

using sampling_bench::ExpectFailure;
using Workbench = sampling_bench::Workbench<sampling_bench::Mip>;

TEST(opMIP, NeedsAListWithEntriesForTheVoxelListOnly) {
  Workbench bench;
  bench.op.SelectAlgo(205);
  bench.op.voxelList = nullptr;
  ExpectFailure(bench.op, "missing input parameter 'Voxel List'");
  dBuffer empty;
  bench.op.voxelList = &empty;
  ExpectFailure(bench.op, "'Voxel List' is empty");
  for (const int algo : {201, 202}) {
    bench.op.SelectAlgo(algo);
    EXPECT_TRUE(bench.op.Run());
    bench.op.voxelList = nullptr;
    EXPECT_TRUE(bench.op.Run());
  }
}

TEST(opMIP, LooksAtTheListLast) {
  Workbench bench;
  bench.op.SelectAlgo(205);
  bench.op.voxelList = nullptr;
  rasters::MakeSlice(bench.slice, 2, 2, ImageDataType_S16);
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x10, Slice: 0x1010");
  bench.op.mipSlice = nullptr;
  ExpectFailure(bench.op, "missing input parameter 'MIP Slice'");
}

}  // namespace
