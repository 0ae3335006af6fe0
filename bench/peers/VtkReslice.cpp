// VTK: cuts, slabs and projections, all by one filter.
#include <vtkImageReslice.h>
#include <vtkMatrix4x4.h>

#include <cmath>

#include "Checks.h"
#include "Contest.h"
#include "VtkData.h"
#include "Works.h"

namespace peers {
namespace {

using Reslice = vtkSmartPointer<vtkImageReslice>;

Reslice MakeReslice(int width, int height, bool isLinear) {
  auto filter = Reslice::New();
  UseOneVtkThread(*filter);
  filter->SetOutputExtent(0, width - 1, 0, height - 1, 0, 0);
  filter->SetOutputOrigin(0, 0, 0);
  filter->SetBackgroundLevel(0);
  filter->SetInterpolationMode(isLinear ? VTK_RESLICE_LINEAR : VTK_RESLICE_NEAREST);
  return filter;
}

void SetSlab(vtkImageReslice& filter, int samples, Mode mode) {
  filter.SetSlabNumberOfSlices(samples);
  filter.SetSlabSliceSpacingFraction(1);
  filter.SetSlabTrapezoidIntegration(false);
  if (mode == Mode::Maximum) {
    filter.SetSlabModeToMax();
  } else {
    filter.SetSlabModeToMean();
  }
}

/// Places the plane, all in mm: the columns are unit vectors and the position of the first pixel.
void Place(vtkImageReslice& filter, const Position& right, const Position& down,
           const Position& through, const Position& corner) {
  const auto matrix = vtkSmartPointer<vtkMatrix4x4>::New();
  const Position* const columns[] = {&right, &down, &through};
  double lengths[3];
  for (int column = 0; column < 3; ++column) {
    const Position& axis = *columns[column];
    lengths[column] = std::hypot(axis[0], axis[1], axis[2]);
    for (int row = 0; row < 3; ++row) {
      const auto i = static_cast<std::size_t>(row);
      matrix->SetElement(row, column, axis[i] / lengths[column]);
      matrix->SetElement(row, 3, corner[i]);
    }
  }
  filter.SetResliceAxes(matrix);
  filter.SetOutputSpacing(lengths);
}

Position InMm(const Position& voxels) {
  return {voxels[0] * kSpacing[0], voxels[1] * kSpacing[1], voxels[2] * kSpacing[2]};
}

bool Update(vtkImageReslice& filter) {
  filter.Modified();
  filter.Update();
  return true;
}

const std::uint16_t* PixelsOf(vtkImageReslice& filter) {
  return static_cast<const std::uint16_t*>(filter.GetOutput()->GetScalarPointer());
}

Contender Cut(const PlaneWork& work) {
  const auto volume = VtkImageOver(Volume().data(), kWidth, kHeight, kDepth);
  volume->SetSpacing(kSpacing);
  const Reslice filter = MakeReslice(work.edge, work.edge, work.isLinear);
  filter->SetInputData(volume);
  Place(*filter, InMm(work.right), InMm(work.down), InMm(work.through), InMm(work.corner));
  if (work.mode != Mode::Thin) {
    SetSlab(*filter, work.samples, work.mode);
  }
  return {[=] { return Update(*filter); }, [=] { return CheckPlane(work, PixelsOf(*filter)); }};
}

Contender Project(const DepthWork& work) {
  const DepthSize size = SizeOf(work);
  const Reslice filter = MakeReslice(size.width, size.height, false);
  filter->SetInputData(VtkImageOver(Volume().data(), kWidth, kHeight, kDepth));
  const auto unit = [](int axis) {
    Position vector{};
    vector[static_cast<std::size_t>(axis)] = 1;
    return vector;
  };
  Position corner{};
  corner[static_cast<std::size_t>(work.axis)] = 0.5 * (size.depth - 1);
  Place(*filter, unit(work.axis == 0 ? 1 : 0), unit(work.axis == 2 ? 1 : 2), unit(work.axis),
        corner);
  SetSlab(*filter, size.depth, Mode::Maximum);
  return {[=] { return Update(*filter); }, [=] { return CheckDepth(work, PixelsOf(*filter)); }};
}

}  // namespace

void EnterVtkReslice() {
  for (const PlaneWork& work : PlaneWorks()) {
    Enter(work.work, "VTK", [work] { return Cut(work); });
  }
  for (const DepthWork& work : DepthWorks()) {
    Enter(work.work, "VTK", [work] { return Project(work); });
  }
}

}  // namespace peers
