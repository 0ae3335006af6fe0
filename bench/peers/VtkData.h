#ifndef BENCH_PEERS_VTKDATA_H
#define BENCH_PEERS_VTKDATA_H

/// @file
/// What the contenders of VTK share.

#include <vtkImageData.h>
#include <vtkMultiThreader.h>
#include <vtkPointData.h>
#include <vtkSMPTools.h>
#include <vtkSmartPointer.h>
#include <vtkThreadedImageAlgorithm.h>
#include <vtkUnsignedShortArray.h>

namespace peers {

/// An image over 16-bit samples that are only read.
inline vtkSmartPointer<vtkImageData> VtkImageOver(const std::uint16_t* samples, int width,
                                                  int height, int depth = 1) {
  const auto array = vtkSmartPointer<vtkUnsignedShortArray>::New();
  array->SetArray(const_cast<std::uint16_t*>(samples), vtkIdType{width} * height * depth, 1);
  auto image = vtkSmartPointer<vtkImageData>::New();
  image->SetDimensions(width, height, depth);
  image->GetPointData()->SetScalars(array);
  return image;
}

/// One thread, wherever VTK has a number of them.
inline void UseOneVtkThread() {
  vtkSMPTools::SetBackend("Sequential");
  vtkSMPTools::Initialize(1);
  vtkMultiThreader::SetGlobalMaximumNumberOfThreads(1);
  vtkMultiThreader::SetGlobalDefaultNumberOfThreads(1);
}

inline void UseOneVtkThread(vtkThreadedImageAlgorithm& filter) {
  filter.SetEnableSMP(false);
  filter.SetNumberOfThreads(1);
}

}  // namespace peers

#endif
