// Volumes by loops as one writes them without thinking of speed: positions in 16.16 fixed point,
// each tested against the volume; one ray after the other through slabs; projections of all depths
// and the histogram with the volume streaming by.
#include <algorithm>
#include <array>
#include <cmath>

#include "Checks.h"
#include "Plain.h"
#include "Works.h"

namespace peers {
namespace {

constexpr int kOne = 0x10000;
constexpr std::array<int, 3> kSizes{kWidth, kHeight, kDepth};
constexpr std::array<int, 3> kSteps{1, kWidth, kWidth* kHeight};

using Fixed = std::array<std::int32_t, 3>;

Fixed FixedOf(const Position& position) {
  Fixed fixed;
  std::transform(position.begin(), position.end(), fixed.begin(), [](double coordinate) {
    return static_cast<std::int32_t>(std::lround(coordinate * kOne));
  });
  return fixed;
}

void Advance(Fixed& at, const Fixed& step) {
  for (std::size_t axis = 0; axis < 3; ++axis) {
    at[axis] += step[axis];
  }
}

/// The nearest voxel, or -1 outside.
int Nearest(const std::uint16_t* volume, const Fixed& at) {
  int offset = 0;
  for (std::size_t axis = 0; axis < 3; ++axis) {
    const int voxel = (at[axis] + kOne / 2) >> 16;
    if (voxel < 0 || voxel >= kSizes[axis]) {
      return -1;
    }
    offset += voxel * kSteps[axis];
  }
  return volume[offset];
}

int Between(int from, int to, int fraction) {
  return from + ((to - from) * fraction >> 15);
}

/// Between the voxels around, or -1 outside; there is nothing beyond the last voxels' centres.
int Linear(const std::uint16_t* volume, const Fixed& at) {
  int offset = 0;
  int fraction[3];
  for (std::size_t axis = 0; axis < 3; ++axis) {
    const int voxel = at[axis] >> 16;
    if (voxel < 0 || voxel + 1 >= kSizes[axis]) {
      return -1;
    }
    offset += voxel * kSteps[axis];
    fraction[axis] = (at[axis] & (kOne - 1)) >> 1;
  }
  const auto inSlice = [&fraction](const std::uint16_t* p) {
    return Between(Between(p[0], p[1], fraction[0]),
                   Between(p[kSteps[1]], p[kSteps[1] + 1], fraction[0]), fraction[1]);
  };
  return Between(inSlice(volume + offset), inSlice(volume + offset + kSteps[2]), fraction[2]);
}

template <int (*Sample)(const std::uint16_t*, const Fixed&)>
void Cut(const PlaneWork& work, std::uint16_t* pixels) {
  const std::uint16_t* const volume = Volume().data();
  const Fixed right = FixedOf(work.right);
  const Fixed through = FixedOf(work.through);
  for (int row = 0; row < work.edge; ++row) {
    Fixed first = FixedOf(PositionOf(work, 0, row, 0));
    for (int column = 0; column < work.edge; ++column, Advance(first, right)) {
      Fixed at = first;
      int highest = 0;
      int sum = 0;
      int count = 0;
      for (int i = 0; i < work.samples; ++i, Advance(at, through)) {
        const int sample = Sample(volume, at);
        highest = std::max(highest, sample);
        sum += std::max(sample, 0);
        count += sample >= 0 ? 1 : 0;
      }
      const int mean = count == 0 ? 0 : sum / count;
      *pixels++ = static_cast<std::uint16_t>(work.mode == Mode::Mean ? mean : highest);
    }
  }
}

void EnterCut(const PlaneWork& work) {
  const auto pixels = MakeSamples<std::uint16_t>(static_cast<std::size_t>(work.edge) *
                                                 static_cast<std::size_t>(work.edge));
  EnterLoop(
      work.work,
      [=] {
        if (work.isLinear) {
          Cut<Linear>(work, pixels->data());
        } else {
          Cut<Nearest>(work, pixels->data());
        }
      },
      [=] { return CheckPlane(work, pixels->data()); });
}

/// The sagittal plane with nothing to compute: what it costs to fetch one voxel out of each row.
void EnterWalk(const PlaneWork& work) {
  const auto pixels = MakeSamples<std::uint16_t>(kSliceVoxels);
  const auto voxelOf = [](double position) { return static_cast<std::size_t>(position + 0.5); };
  Enter(work.work, "walk", [=] {
    return Contender{[=] {
                       std::uint16_t* pixel = pixels->data();
                       const std::size_t column = voxelOf(work.corner[0]);
                       for (int row = 0; row < work.edge; ++row) {
                         const std::size_t z = voxelOf(PositionOf(work, 0, row, 0)[2]);
                         const std::uint16_t* voxel = &Volume()[z * kSliceVoxels + column];
                         for (int y = 0; y < kHeight; ++y, voxel += kWidth) {
                           *pixel++ = *voxel;
                         }
                       }
                       return true;
                     },
                     [=] { return CheckPlane(work, pixels->data()); }};
  });
}

/// Each row of the volume into the pixel or the row of pixels that it lies behind.
void Project(const DepthWork& work, std::uint16_t* pixels) {
  std::fill_n(pixels, SizeOf(work).width * SizeOf(work).height, std::uint16_t{0});
  const std::uint16_t* voxels = Volume().data();
  for (int z = 0; z < kDepth; ++z) {
    for (int y = 0; y < kHeight; ++y, voxels += kWidth) {
      if (work.axis == 0) {
        pixels[z * kHeight + y] = *std::max_element(voxels, voxels + kWidth);
        continue;
      }
      std::uint16_t* const row = pixels + (work.axis == 1 ? z : y) * kWidth;
      for (int x = 0; x < kWidth; ++x) {
        row[x] = std::max(row[x], voxels[x]);
      }
    }
  }
}

void EnterProject(const DepthWork& work) {
  const DepthSize size = SizeOf(work);
  const auto pixels = MakeSamples<std::uint16_t>(static_cast<std::size_t>(size.width) *
                                                 static_cast<std::size_t>(size.height));
  EnterLoop(
      work.work, [=] { Project(work, pixels->data()); },
      [=] { return CheckDepth(work, pixels->data()); });
}

/// Four tables in turn, so that equal neighbours do not wait for each other.
void EnterHistogram() {
  constexpr std::size_t kTables = 4;
  const auto counts = MakeSamples<std::uint32_t>(kTables * kValues);
  EnterLoop(
      TheHistogram(),
      [=] {
        std::fill(counts->begin(), counts->end(), 0U);
        std::uint32_t* const tables = counts->data();
        const std::uint16_t* const voxels = Volume().data();
        for (std::size_t i = 0; i < kVoxels; i += kTables) {
          for (std::size_t table = 0; table < kTables; ++table) {
            ++tables[table * kValues + voxels[i + table]];
          }
        }
        for (std::size_t i = kValues; i < kTables * kValues; ++i) {
          tables[i % kValues] += tables[i];
        }
      },
      [=] { return CheckHistogram(counts->data()); });
}

}  // namespace

void EnterPlainVolumes() {
  for (const PlaneWork& work : PlaneWorks()) {
    EnterCut(work);
    if (work.work.name == "mpr/nearest/sagittal") {
      EnterWalk(work);
    }
  }
  for (const DepthWork& work : DepthWorks()) {
    EnterProject(work);
    EnterRead(work.work, Volume().data(), kVoxels * sizeof(std::uint16_t));
  }
  EnterHistogram();
  for (const Work& work : {TheHistogram(), TheEdges(), SelectionByValue(), SelectionByEdge()}) {
    EnterMemcpy(work, Volume().data(), kVoxels * sizeof(std::uint16_t));
  }
}

}  // namespace peers
