// The loops over rows of sampling points for one set of vector instructions. A variant's source
// includes this once, behind `Words` and `Numbers`, lanes of 16 and 32 bits.
//
// 1. Points along a row of voxels, one voxel apart, share their fractions: whole registers of
//    neighbours are loaded, and interpolated in 16 bits where the samples leave room for it
//    (PlaneAlongRow_body.h).
// 2. Elsewhere the interpolation gathers pairs of neighbours (PlaneLinear_body.h).
// 3. The nearest voxels of points within a row of voxels are chosen in registers; elsewhere those
//    of slabs are gathered, those of planes fetched one by one (PlaneNearest_body.h).
// 4. The largest voxel of a slab along the grid is found in 16 bits (PlaneMaximum_body.h).
//
// Nothing that is inline elsewhere, too, is called here: it might be compiled for a machine that
// others do not have, and kept as the one copy for all.

#include <vorl/Operators/IP/kernels/PlaneAlongRow_body.h>
#include <vorl/Operators/IP/kernels/PlaneGather_body.h>
#include <vorl/Operators/IP/kernels/PlaneLinear_body.h>
#include <vorl/Operators/IP/kernels/PlaneMaximum_body.h>
#include <vorl/Operators/IP/kernels/PlaneNearest_body.h>
#include <vorl/Operators/IP/kernels/PlaneRows.h>
#include <vorl/Operators/IP/kernels/PlaneSinks_body.h>

inline namespace vorl {
namespace vorl_detail {
namespace {

template <class T, class Sink>
void LinearRow(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
               std::size_t count, const Sink& sink) {
  if (IsAlongRow(step)) {
    LinearAlongRow<T>(grid, point, count, sink);
  } else {
    GatherRow(LinearGatherer<T>(grid), point, step, count, sink);
  }
}

template <class T>
void Nearest(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
             std::size_t count, RowSink sink, void* row) {
  switch (sink) {
    case RowSink::Store:
      return NearestRow<T>(grid, point, step, count, StoreSink<T>{static_cast<T*>(row)});
    case RowSink::Maximum:
      return NearestRow<T>(grid, point, step, count,
                           MaximumSink<T>{static_cast<std::int32_t*>(row)});
    case RowSink::Sum:
      return NearestRow<T>(grid, point, step, count, SumSink<T>{static_cast<std::int32_t*>(row)});
  }
}

template <class T>
void Linear(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
            std::size_t count, RowSink sink, void* row) {
  switch (sink) {
    case RowSink::Store:
      return LinearRow<T>(grid, point, step, count, StoreSink<T>{static_cast<T*>(row)});
    case RowSink::Maximum:
      return LinearRow<T>(grid, point, step, count,
                          MaximumSink<T>{static_cast<std::int32_t*>(row)});
    case RowSink::Sum:
      return LinearRow<T>(grid, point, step, count, SumSink<T>{static_cast<std::int32_t*>(row)});
  }
}

constexpr PlaneKernels kKernels = {{&Nearest<std::uint16_t>, &Nearest<std::int16_t>},
                                   {&Linear<std::uint16_t>, &Linear<std::int16_t>},
                                   {&RaiseRow<std::uint16_t>, &RaiseRow<std::int16_t>},
                                   {&LargestInRows<std::uint16_t>, &LargestInRows<std::int16_t>}};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl
