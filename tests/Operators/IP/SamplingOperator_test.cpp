// What the operators that sample a volume into a slice have in common: what they are, what they
// refuse, and with which words.

#include <gtest/gtest.h>

#include "SamplingBench.h"

namespace {

using rasters::CodeOf;
using rasters::Format;
using rasters::Make;
using rasters::MakeSlice;
using rasters::MessageOf;
using sampling_bench::ExpectFailure;
using sampling_bench::Workbench;

template <class Traits>
class SamplingOperator : public testing::Test {
 protected:
  using Op = typename Traits::Op;
  using Bench = Workbench<Traits>;

  static void ExpectDefaults(const Op& op) {
    EXPECT_EQ(op.*Traits::kSlice, nullptr);
    EXPECT_EQ(op.volume, nullptr);
    EXPECT_EQ(op.algoID, Traits::kDefaultAlgorithm);
    EXPECT_EQ(op.depthSteps, Traits::kDefaultSteps);
    if constexpr (requires { op.voxelList; }) {
      EXPECT_EQ(op.voxelList, nullptr);
    }
  }

  static std::string InvalidSlice() {
    return std::string("invalid pixel data in the ") + Traits::kSliceName;
  }
};

struct NameOf {
  template <class Traits>
  static std::string GetName(int) {
    return Traits::kName;
  }
};

using Operators = testing::Types<sampling_bench::Mpr, sampling_bench::Mip>;
TYPED_TEST_SUITE(SamplingOperator, Operators, NameOf);

TYPED_TEST(SamplingOperator, IsRegisteredBelowTheOperatorBase) {
  rasters::ExpectRegistered<typename TypeParam::Op>(TypeParam::kName);
}

TYPED_TEST(SamplingOperator, StartsWithItsDefaults) {
  TestFixture::ExpectDefaults(typename TypeParam::Op());
}

TYPED_TEST(SamplingOperator, StoresAlgorithmAndDepthStepsUnchecked) {
  typename TypeParam::Op op;
  op.SelectAlgo(-5);
  op.SetDepthSteps(-9);
  EXPECT_EQ(op.algoID, -5);
  EXPECT_EQ(op.depthSteps, -9);
}

TYPED_TEST(SamplingOperator, ResetRestoresTheDefaults) {
  typename TestFixture::Bench bench;
  bench.op.SelectAlgo(7);
  bench.op.SetDepthSteps(4);
  EXPECT_TRUE(bench.op.Reset());
  TestFixture::ExpectDefaults(bench.op);
}

TYPED_TEST(SamplingOperator, CopiesCarryEveryField) {
  using Operator = typename TypeParam::Op;
  typename TestFixture::Bench bench;
  bench.op.SelectAlgo(TypeParam::kNotDefault);
  bench.op.SetDepthSteps(4);
  ASSERT_TRUE(bench.op());
  const Operator copy(bench.op);
  Operator assigned;
  assigned = bench.op;
  for (const Operator* other : {&copy, static_cast<const Operator*>(&assigned)}) {
    EXPECT_EQ(other->*TypeParam::kSlice, &bench.slice);
    EXPECT_EQ(other->volume, &bench.volume);
    EXPECT_EQ(other->algoID, TypeParam::kNotDefault);
    EXPECT_EQ(other->depthSteps, 4);
    EXPECT_EQ(MessageOf(*other), "success");
    if constexpr (requires { other->voxelList; }) {
      EXPECT_EQ(other->voxelList, &bench.list);
    }
  }
}

TYPED_TEST(SamplingOperator, SucceedsWithEveryAlgorithmTypeAndThickness) {
  for (const unsigned short type : {ImageDataType_U16, ImageDataType_S16}) {
    for (const int algo : TypeParam::kAlgorithms) {
      for (const int steps : {0, 1, -1}) {
        typename TestFixture::Bench bench(type);
        bench.op.SelectAlgo(algo);
        bench.op.SetDepthSteps(steps);
        EXPECT_TRUE(bench.op.Run());
        EXPECT_EQ(CodeOf(bench.op), 0);
        EXPECT_EQ(MessageOf(bench.op), "success");
        EXPECT_EQ(bench.op.GetProgress(), 1.0);
      }
    }
  }
}

TYPED_TEST(SamplingOperator, NamesWhatIsMissingVolumeFirst) {
  typename TypeParam::Op op;
  op.SelectAlgo(TypeParam::kNoAlgorithms.front());  // found only later
  ExpectFailure(op, "missing input parameter 'Volume'");
  dVolume volume;
  op.volume = &volume;
  ExpectFailure(op, "given Volume is empty");
  rasters::MakeCounting(volume, 2, 2, 1);
  ExpectFailure(op, std::string("missing input parameter '") + TypeParam::kSliceName + "'");
}

TYPED_TEST(SamplingOperator, RefusesASliceOfAnotherTypeBeforeTheAlgorithm) {
  typename TestFixture::Bench bench;
  bench.op.SelectAlgo(TypeParam::kNoAlgorithms.front());
  MakeSlice(bench.slice, 2, 2, ImageDataType_S16);
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x10, Slice: 0x1010");
  MakeSlice(bench.slice, 2, 2, ImageDataType_U8);
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x10, Slice: 0x8");
  bench.slice.Reset();
  ExpectFailure(bench.op, "incompatible data types(Volume: 0x10, Slice: 0x0");
  typename TestFixture::Bench isSigned(ImageDataType_S16);
  MakeSlice(isSigned.slice, 2, 2, ImageDataType_U8);
  ExpectFailure(isSigned.op, "incompatible data types(Volume: 0x1010, Slice: 0x8");
}

TYPED_TEST(SamplingOperator, RefusesAnUnknownAlgorithmBeforeTheDataType) {
  for (const unsigned short type : {ImageDataType_U16, ImageDataType_U8}) {
    for (const int algo : TypeParam::kNoAlgorithms) {
      typename TestFixture::Bench bench(type);
      bench.op.SelectAlgo(algo);
      ExpectFailure(bench.op, std::string(TypeParam::kRefusal) + std::to_string(algo));
      bench.ExpectSliceUnwritten();
    }
  }
}

TYPED_TEST(SamplingOperator, UnknownAlgorithmsPassThePreparation) {
  for (const int algo : TypeParam::kNoAlgorithms) {
    Workbench<TypeParam, rasters::Preparing<typename TypeParam::Op>> bench;
    bench.op.SelectAlgo(algo);
    EXPECT_TRUE(bench.op.Prepare());
    EXPECT_EQ(CodeOf(bench.op), 0);
  }
}

TYPED_TEST(SamplingOperator, RefusesEveryOtherDataType) {
  const std::pair<unsigned short, const char*> cases[] = {
      {ImageDataType_U1, "unsupported data type: 1"},
      {ImageDataType_U8, "unsupported data type: 8"},
      {ImageDataType_S8, "unsupported data type: 4104"},
      {ImageDataType_U32, "unsupported data type: 32"},
      {ImageDataType_S32, "unsupported data type: 4128"},
      {ImageDataType_F32, "unsupported data type: 8224"},
      {ImageDataType_F64, "unsupported data type: 8256"}};
  for (const auto& [type, message] : cases) {
    for (const int algo : TypeParam::kAlgorithms) {
      typename TestFixture::Bench bench(type);
      bench.op.SelectAlgo(algo);
      ExpectFailure(bench.op, message);
      bench.ExpectSliceUnwritten();
    }
  }
}

TYPED_TEST(SamplingOperator, VolumeAndSliceWithoutPixelsHaveNoSupportedType) {
  typename TestFixture::Bench bench;
  bench.volume.Reset();
  dSlice empty;
  ASSERT_EQ(bench.volume.AddSlice(empty), 0);
  bench.slice.Reset();
  ExpectFailure(bench.op, "unsupported data type: 0");
}

TYPED_TEST(SamplingOperator, RefusesAVolumeWhoseSlicesLostTheirPixels) {
  for (const int algo : TypeParam::kAlgorithms) {
    typename TestFixture::Bench bench;
    bench.op.SelectAlgo(algo);
    bench.volume.GetSlice(2)->GetImage().Reset();
    ExpectFailure(bench.op, "invalid pixel data in slice 2 of the Volume");
    bench.volume.GetSlice(1)->GetImage().Reset();
    ExpectFailure(bench.op, "invalid pixel data in slice 1 of the Volume");
    bench.volume.GetSlice(0)->GetImage().Reset();
    ExpectFailure(bench.op, "incompatible data types(Volume: 0x0, Slice: 0x10");
  }
}

TYPED_TEST(SamplingOperator, RefusesAVolumeWhoseSlicesWereFormattedAnew) {
  const Format others[] = {{.width = 2, .height = 1, .type = ImageDataType_U16},
                           {.width = 1, .height = 2, .type = ImageDataType_U16},
                           {.width = 3, .height = 3, .type = ImageDataType_U16},
                           {.width = 2, .height = 2, .type = ImageDataType_U8, .alignment = 32},
                           {.width = 2, .height = 2, .type = ImageDataType_U16, .channels = "GA"}};
  for (const Format& other : others) {
    typename TestFixture::Bench bench;
    Make(bench.volume.GetSlice(1)->GetImage(), other);
    ExpectFailure(bench.op, "invalid pixel data in slice 1 of the Volume");
  }
}

TYPED_TEST(SamplingOperator, RefusesASliceWithShorterRowsThanTheFirst) {
  typename TestFixture::Bench bench;
  bench.volume.Reset();
  for (const unsigned short alignment : std::to_array<unsigned short>({32, 2})) {
    dSlice slice;
    Make(slice.GetImage(),
         {.width = 2, .height = 2, .type = ImageDataType_U16, .alignment = alignment});
    ASSERT_GE(bench.volume.AddSlice(slice), 0);
  }
  ExpectFailure(bench.op, "invalid pixel data in slice 1 of the Volume");
}

TYPED_TEST(SamplingOperator, RefusesBuffersThatDoNotHoldTheRows) {
  alignas(2) unsigned char memory[16] = {};
  typename TestFixture::Bench bench;
  dBuffer& pixels = bench.volume.GetSlice(0)->GetImage().GetDataBuffer();
  pixels.Init(memory, 7, DTM_Reference);
  ExpectFailure(bench.op, "invalid pixel data in slice 0 of the Volume");
  pixels.Init(memory + 1, 8, DTM_Reference);
  ExpectFailure(bench.op, "invalid pixel data in slice 0 of the Volume");
  pixels.Init(memory, 8, DTM_Reference);
  EXPECT_TRUE(bench.op.Run());

  dBuffer& output = bench.slice.GetImage().GetDataBuffer();
  output.Init(memory + 8, 7, DTM_Reference);
  ExpectFailure(bench.op, TestFixture::InvalidSlice());
  output.Init(memory + 7, 8, DTM_Reference);
  ExpectFailure(bench.op, TestFixture::InvalidSlice());
  output.Init(memory + 8, 8, DTM_Reference);
  EXPECT_TRUE(bench.op.Run());
}

TYPED_TEST(SamplingOperator, StoppedBeforeItsWorkWritesNothing) {
  for (const int algo : TypeParam::kAlgorithms) {
    Workbench<TypeParam, rasters::StoppedBeforeWork<typename TypeParam::Op>> bench;
    bench.op.SelectAlgo(algo);
    ExpectFailure(bench.op, "stopped");
    bench.ExpectSliceUnwritten();
    EXPECT_EQ(bench.op.GetProgress(), 0.0);
  }
}

TYPED_TEST(SamplingOperator, StoppedBeforeItsPreparationSaysSo) {
  Workbench<TypeParam, rasters::StoppedAtStart<typename TypeParam::Op>> bench;
  bench.op.Reset();
  ExpectFailure(bench.op, "missing input parameter 'Volume'");
  bench.Connect();
  ExpectFailure(bench.op, "stopped");
}

}  // namespace
