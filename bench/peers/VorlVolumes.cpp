// vorl: cuts, projections, counting and selecting.
#include <vorl/Data/dVolume.h>
#include <vorl/Operators/IP/opMIP.h>
#include <vorl/Operators/IP/opMPR.h>
#include <vorl/Operators/IP/opVoxelClassification.h>

#include <cstring>
#include <memory>

#include "Checks.h"
#include "Contest.h"
#include "Works.h"

namespace peers {
namespace {

constexpr char kName[] = "vorl";

void Format(dSlice& slice, int width, int height) {
  slice.GetImage().Init(static_cast<unsigned long>(width), static_cast<unsigned long>(height),
                        ImageDataType_U16, "G", ImageDataOrder_Pixel, 2);
}

/// The test data in slices of vorl's own, made once.
dVolume& TheVolume() {
  static dVolume* const volume = [] {
    static dVolume made;
    for (std::size_t z = 0; z < kDepth; ++z) {
      dSlice slice;
      Format(slice, kWidth, kHeight);
      std::memcpy(slice.GetImage().GetDataPtr(), &Volume()[z * kSliceVoxels],
                  kSliceVoxels * sizeof(std::uint16_t));
      made.AddSlice(slice);
    }
    return &made;
  }();
  return *volume;
}

dVect3D VectorOf(const Position& position, double factor = 1) {
  return {static_cast<float>(position[0] * factor), static_cast<float>(position[1] * factor),
          static_cast<float>(position[2] * factor)};
}

const std::uint16_t* PixelsOf(dSlice& slice) {
  return static_cast<const std::uint16_t*>(slice.GetImage().GetDataPtr());
}

// The nearest voxel is that whose cell a point lies in, and cells begin at whole numbers; linear
// filters have the voxels at whole numbers themselves.
void Place(dSlice& slice, const PlaneWork& work) {
  Position corner = work.corner;
  for (double& coordinate : corner) {
    coordinate += work.isLinear ? 0 : 0.5;
  }
  Format(slice, work.edge, work.edge);
  slice.SetCoordinates(VectorOf(corner), VectorOf(work.right), VectorOf(work.down),
                       VectorOf(work.through, work.samples > 1 ? work.samples - 1 : 1));
}

Contender Cut(const PlaneWork& work) {
  struct Operation {
    dSlice slice;
    opMPR op;
  };
  const auto operation = std::make_shared<Operation>();
  Place(operation->slice, work);
  operation->op.volume = &TheVolume();
  operation->op.mprSlice = &operation->slice;
  operation->op.SelectAlgo(work.isLinear ? MPRAlgo_Trilinear : MPRAlgo_Nearest);
  operation->op.SetDepthSteps(work.mode == Mode::Mean ? work.samples : 0);
  return {[=] { return operation->op.Run(); },
          [=] { return CheckPlane(work, PixelsOf(operation->slice), LinearRule::Vorl); }};
}

struct Projection {
  dSlice slice;
  opMIP op;
};

std::shared_ptr<Projection> MakeProjection(bool isLinear, int samples) {
  auto projection = std::make_shared<Projection>();
  projection->op.volume = &TheVolume();
  projection->op.mipSlice = &projection->slice;
  projection->op.SelectAlgo(isLinear ? MIPAlgo_Trilinear : MIPAlgo_Nearest);
  projection->op.SetDepthSteps(samples);
  return projection;
}

Contender ProjectSlab(const PlaneWork& work) {
  const auto projection = MakeProjection(work.isLinear, work.samples);
  Place(projection->slice, work);
  return {[=] { return projection->op.Run(); },
          [=] { return CheckPlane(work, PixelsOf(projection->slice), LinearRule::Vorl); }};
}

Contender ProjectDepth(const DepthWork& work) {
  const DepthSize size = SizeOf(work);
  const auto projection = MakeProjection(false, size.depth);
  const auto unit = [](int axis, float length) {
    return dVect3D(axis == 0 ? length : 0, axis == 1 ? length : 0, axis == 2 ? length : 0);
  };
  Format(projection->slice, size.width, size.height);
  const auto deepest = static_cast<float>(size.depth - 1);
  projection->slice.SetCoordinates(dVect3D(0.5F, 0.5F, 0.5F) + unit(work.axis, deepest / 2),
                                   unit(work.axis == 0 ? 1 : 0, 1), unit(work.axis == 2 ? 1 : 2, 1),
                                   unit(work.axis, deepest));
  return {[=] { return projection->op.Run(); },
          [=] { return CheckDepth(work, PixelsOf(projection->slice)); }};
}

const std::uint32_t* NumbersOf(const dBuffer& buffer) {
  return static_cast<const std::uint32_t*>(buffer.Get(0UL));
}

Contender Classify(short algo) {
  const auto op = std::make_shared<opVoxelClassification>();
  op->volume = &TheVolume();
  op->SelectAlgo(algo);
  return {[=] { return op->Run(); },
          [=] {
            const std::uint32_t* const counts = NumbersOf(op->classCounters);
            return algo == VoxelClassificationAlgo_Edge ? CheckEdges(counts)
                                                        : CheckHistogram(counts);
          }};
}

Contender Select(short algo) {
  struct Selection {
    dBuffer places;
    opVoxelClassification op;
  };
  const auto selection = std::make_shared<Selection>();
  opVoxelClassification& op = selection->op;
  op.volume = &TheVolume();
  op.voxelList = &selection->places;
  op.SelectAlgo(algo);
  op.Run();
  op.SetSelectionLimit(SelectionLimit());
  op.SelectAlgo(VoxelClassificationAlgo_Select);
  return {[=] { return selection->op.Run(); },
          [=] {
            return CheckSelection(algo == VoxelClassificationAlgo_Edge,
                                  NumbersOf(selection->places),
                                  selection->places.GetSize() / sizeof(std::uint32_t));
          }};
}

}  // namespace

void EnterVorlVolumes() {
  for (const PlaneWork& work : PlaneWorks()) {
    Enter(work.work, kName,
          [work] { return work.mode == Mode::Maximum ? ProjectSlab(work) : Cut(work); });
  }
  for (const DepthWork& work : DepthWorks()) {
    Enter(work.work, kName, [work] { return ProjectDepth(work); });
  }
  Enter(TheHistogram(), kName, [] { return Classify(VoxelClassificationAlgo_Value); });
  Enter(TheEdges(), kName, [] { return Classify(VoxelClassificationAlgo_Edge); });
  Enter(SelectionByValue(), kName, [] { return Select(VoxelClassificationAlgo_Value); });
  Enter(SelectionByEdge(), kName, [] { return Select(VoxelClassificationAlgo_Edge); });
}

}  // namespace peers
