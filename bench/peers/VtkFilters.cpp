// VTK: windowing and counting. Each run updates the filter anew, into the output of the run before.
#include <vtkIdTypeArray.h>
#include <vtkImageHistogram.h>
#include <vtkImageMapToWindowLevelColors.h>

#include <vector>

#include "Checks.h"
#include "Contest.h"
#include "VtkData.h"
#include "Works.h"

namespace peers {
namespace {

Contender MapToLevels() {
  const WindowWork& work = TheWindow();
  const auto filter = vtkSmartPointer<vtkImageMapToWindowLevelColors>::New();
  UseOneVtkThread(*filter);
  filter->SetInputData(VtkImageOver(Image16().data(), kImageEdge, kImageEdge));
  filter->SetWindow(work.width);
  filter->SetLevel(work.centre);
  filter->SetOutputFormatToLuminance();
  return {[=] {
            filter->Modified();
            filter->Update();
            return true;
          },
          [=] {
            return CheckWindow(
                static_cast<const std::uint8_t*>(filter->GetOutput()->GetScalarPointer()));
          }};
}

Contender Count() {
  const auto filter = vtkSmartPointer<vtkImageHistogram>::New();
  UseOneVtkThread(*filter);
  filter->SetInputData(VtkImageOver(Volume().data(), kWidth, kHeight, kDepth));
  filter->AutomaticBinningOff();
  filter->SetNumberOfBins(kValues);
  filter->SetBinOrigin(0);
  filter->SetBinSpacing(1);
  filter->GenerateHistogramImageOff();
  return {[=] {
            filter->Modified();
            filter->Update();
            return true;
          },
          [=] {
            std::vector<std::uint32_t> counts;
            for (vtkIdType i = 0; i < kValues; ++i) {
              counts.push_back(static_cast<std::uint32_t>(filter->GetHistogram()->GetValue(i)));
            }
            return CheckHistogram(counts.data());
          }};
}

}  // namespace

void EnterVtkFilters() {
  UseOneVtkThread();
  Enter(TheWindow().work, "VTK", MapToLevels);
  Enter(TheHistogram(), "VTK", Count);
}

}  // namespace peers
