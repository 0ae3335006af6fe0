// Operators in threads of their own: stopped, ended, watched, side by side.

#include <vorl/Data/dBCGLUT.h>
#include <vorl/Operators/IP/kernels/RowLoop.h>
#include <vorl/Operators/IP/opLookup.h>
#include <vorl/Operators/IP/opMPR.h>
#include <vorl/Operators/IP/opMinMax.h>
#include <vorl/Operators/IP/opPixelRescale.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <chrono>
#include <thread>

#include "Volumes.h"
#include "Waiting.h"

namespace {

using rasters::CodeOf;
using rasters::Format;
using rasters::MessageOf;
using rasters::Random;
using rasters::SamplesOf;
using waiting::kPatience;
using waiting::WaitForEnd;
using waiting::WaitForProgress;
using Samples = std::vector<std::uint16_t>;

constexpr std::uint16_t kVoxel = 7;
constexpr std::uint16_t kUnwritten = 0x5A5A;

/// A volume of one voxel's value everywhere and a slice inside it; each row of the slice costs
/// `depthSteps` samples per pixel.
struct SlowRun {
  SlowRun(unsigned long width, unsigned long height, int depthSteps) {
    for (int z = 0; z < 4; ++z) {
      rasters::AddSlice(volume, {.width = 64, .height = 64, .type = ImageDataType_U16},
                        Samples(64 * 64, kVoxel));
    }
    rasters::MakeSlice(slice, width, height);
    const auto pixel = [](unsigned long count) { return 63.0F / static_cast<float>(count); };
    slice.SetCoordinates(dVect3D(0.5F, 0.5F, 2), dVect3D(pixel(width), 0, 0),
                         dVect3D(0, pixel(height), 0), dVect3D(0, 0, 2));
    Prepare(op, depthSteps);
  }

  void Prepare(opMPR& other, int depthSteps) {
    other.volume = &volume;
    other.mprSlice = &slice;
    other.SelectAlgo(MPRAlgo_Trilinear);
    other.SetDepthSteps(depthSteps);
  }

  Samples Pixels() const { return SamplesOf<std::uint16_t>(slice.GetImage()); }

  dVolume volume;
  dSlice slice;
  opMPR op;
};

TEST(OperatorThread, AStoppedReconstructionEndsBetweenTwoRows) {
  SlowRun run(256, 2048, 100);
  ASSERT_TRUE(run.op.RunAsThread(0));
  ASSERT_TRUE(WaitForProgress(run.op));
  run.op.Stop();
  ASSERT_TRUE(WaitForEnd(run.op));
  EXPECT_EQ(CodeOf(run.op), -1);
  EXPECT_EQ(MessageOf(run.op), "stopped");

  const Samples pixels = run.Pixels();
  const auto firstUnwritten = std::find(pixels.begin(), pixels.end(), kUnwritten);
  const auto written = firstUnwritten - pixels.begin();
  EXPECT_GT(written, 0);
  EXPECT_LT(written, 256 * 2048) << "the run went on to its end";
  EXPECT_EQ(written % 256, 0) << "a row was left half written";
  EXPECT_EQ(static_cast<double>(written) / (256 * 2048), run.op.GetProgress());
  EXPECT_EQ(std::count(pixels.begin(), firstUnwritten, kVoxel), written);
  EXPECT_EQ(std::count(firstUnwritten, pixels.end(), kUnwritten), pixels.end() - firstUnwritten);
}

TEST(OperatorThread, ProgressRisesFromZeroToOne) {
  SlowRun run(128, 512, 60);
  EXPECT_EQ(run.op.GetProgress(), 0.0);
  ASSERT_TRUE(run.op.RunAsThread(0));
  double last = 0.0;
  int between = 0;
  const auto limit = std::chrono::steady_clock::now() + kPatience;
  while (run.op.IsRunning() && std::chrono::steady_clock::now() < limit) {
    const double progress = run.op.GetProgress();
    ASSERT_GE(progress, last);
    ASSERT_LE(progress, 1.0);
    between += progress > 0.0 && progress < 1.0 ? 1 : 0;
    last = progress;
  }
  ASSERT_FALSE(run.op.IsRunning());
  EXPECT_GT(between, 0) << "nobody saw the run on its way";
  EXPECT_EQ(run.op.GetProgress(), 1.0);
  EXPECT_EQ(MessageOf(run.op), "success");
  EXPECT_EQ(run.Pixels(), Samples(128 * 512, kVoxel));
}

TEST(OperatorThread, EndedAtAnyMomentTheOperatorRunsAgain) {
  Random random(11);
  SlowRun run(64, 256, 20);
  for (int i = 0; i < 40; ++i) {
    run.slice.GetImage().Fill(0x5A);
    ASSERT_TRUE(run.op.RunAsThread(0));
    std::this_thread::sleep_for(std::chrono::microseconds(random.Between(0, 3000)));
    run.op.Terminate();
    ASSERT_FALSE(run.op.IsRunning());
    if (i % 4 == 0) {
      ASSERT_TRUE(run.op.Run());
      ASSERT_EQ(MessageOf(run.op), "success");
      ASSERT_EQ(run.Pixels(), Samples(64 * 256, kVoxel));
    }
  }
}

TEST(OperatorThread, DestroyedWhileItRunsAnOperatorEndsFirst) {
  SlowRun run(64, 1024, 50);
  for (int i = 0; i < 10; ++i) {
    opMPR op;
    run.Prepare(op, 50);
    ASSERT_TRUE(op.RunAsThread(0));
  }
  run.slice.GetImage().Fill(0x5A);
  EXPECT_EQ(run.Pixels(), Samples(64 * 1024, kUnwritten)) << "somebody still writes";
}

TEST(OperatorThread, TwoReconstructionsShareAVolume) {
  SlowRun run(64, 256, 10);
  dSlice second(run.slice);
  opMPR other;
  run.Prepare(other, 10);
  other.mprSlice = &second;
  ASSERT_TRUE(run.op.RunAsThread(0));
  ASSERT_TRUE(other.RunAsThread(0));
  ASSERT_TRUE(WaitForEnd(run.op));
  ASSERT_TRUE(WaitForEnd(other));
  EXPECT_EQ(MessageOf(run.op), "success");
  EXPECT_EQ(MessageOf(other), "success");
  EXPECT_EQ(run.Pixels(), Samples(64 * 256, kVoxel));
  EXPECT_EQ(SamplesOf<std::uint16_t>(second.GetImage()), run.Pixels());
}

TEST(OperatorThread, PixelOperatorsRunInTheirThreads) {
  Random random(5);
  dImage image;
  rasters::MakeRandom(image, {.width = 300, .height = 200}, random);
  const rasters::Bytes pixels = rasters::BytesOf(image);
  dBCGLUT lut;
  dImage mapped;
  dImage rescaled;
  opLookup lookup;
  lookup.m_pSource = &image;
  lookup.m_pTarget = &mapped;
  lookup.m_pLUT = &lut;
  opMinMax minMax;
  minMax.m_pSource = &image;
  opPixelRescale rescale;
  rescale.m_pSource = &image;
  rescale.m_pTarget = &rescaled;
  rescale.m_factor = 0.5;
  for (OpBase* op : {static_cast<OpBase*>(&lookup), static_cast<OpBase*>(&minMax),
                     static_cast<OpBase*>(&rescale)}) {
    ASSERT_TRUE(op->RunAsThread(0));
  }
  for (OpBase* op : {static_cast<OpBase*>(&lookup), static_cast<OpBase*>(&minMax),
                     static_cast<OpBase*>(&rescale)}) {
    ASSERT_TRUE(WaitForEnd(*op));
    EXPECT_EQ(MessageOf(*op), "success");
    EXPECT_EQ(op->GetProgress(), 1.0);
  }
  EXPECT_EQ(minMax.m_minimum, *std::min_element(pixels.begin(), pixels.end()));
  EXPECT_EQ(minMax.m_maximum, *std::max_element(pixels.begin(), pixels.end()));
  const rasters::Bytes mappedPixels = rasters::BytesOf(mapped);
  const rasters::Bytes rescaledPixels = rasters::BytesOf(rescaled);
  for (std::size_t i = 0; i < pixels.size(); ++i) {
    ASSERT_EQ(mappedPixels[i], lut.GetLUT(0)[pixels[i]]);
    ASSERT_EQ(rescaledPixels[i], pixels[i] / 2);
  }
}

// Every result is a new image, whose memory may have been another's a moment ago.
TEST(OperatorThread, LookupsSideBySideKeepTheirPixels) {
  constexpr std::size_t kPixels = std::size_t{400} * 400;
  dImage sources[2];
  dImage targets[2];
  dBCGLUT luts[2];
  opLookup ops[2];
  for (int i = 0; i < 2; ++i) {
    rasters::MakeOf<std::uint16_t>(
        sources[i], {.width = 400, .height = 400, .type = ImageDataType_U16, .alignment = 2},
        Samples(kPixels, static_cast<std::uint16_t>(20 + i)));
    ops[i].m_pSource = &sources[i];
    ops[i].m_pTarget = &targets[i];
    ops[i].m_pLUT = &luts[i];
  }
  for (int round = 0; round < 20; ++round) {
    for (opLookup& op : ops) {
      ASSERT_TRUE(op.RunAsThread(0));
    }
    for (int i = 0; i < 2; ++i) {
      ASSERT_TRUE(WaitForEnd(ops[i]));
      ASSERT_EQ(SamplesOf<std::uint8_t>(targets[i]),
                std::vector<std::uint8_t>(kPixels, static_cast<std::uint8_t>(20 + i)));
    }
  }
}

TEST(OperatorThread, PixelOperatorsEndedAtAnyMomentRunAgain) {
  Random random(6);
  dImage image;
  rasters::MakeRandom(image, {.width = 512, .height = 512, .type = ImageDataType_U16}, random);
  dImage rescaled;
  opPixelRescale op;
  for (int i = 0; i < 40; ++i) {
    op.m_pSource = &image;
    op.m_pTarget = &rescaled;
    op.m_factor = 1.0;
    op.m_offset = 1.0;
    ASSERT_TRUE(op.RunAsThread(0));
    std::this_thread::sleep_for(std::chrono::microseconds(random.Between(0, 1500)));
    op.Terminate();
    ASSERT_FALSE(op.IsRunning());
  }
  ASSERT_TRUE(op.Run());
  EXPECT_EQ(MessageOf(op), "success");
}

TEST(OperatorThread, ALoopOverRowsEndsBeforeTheNextOne) {
  for (const bool canBeAsked : {false, true}) {
    std::atomic<bool> stop{false};
    std::atomic<double> progress{0.0};
    std::vector<std::size_t> rows;
    const auto row = [&](std::size_t index) {
      rows.push_back(index);
      stop = index == 2;
    };
    EXPECT_FALSE(vorl_detail::ForEachRow({stop, progress, canBeAsked}, 8, row));
    EXPECT_EQ(rows, (std::vector<std::size_t>{0, 1, 2}));
    EXPECT_EQ(progress, 3.0 / 8.0);
  }
}

}  // namespace
