#ifndef VORL_OPERATORS_IP_KERNELS_SAMPLINGCHECK_H
#define VORL_OPERATORS_IP_KERNELS_SAMPLINGCHECK_H

/// @file
/// What the operators that sample a volume into a slice ask of the two before they run. `name` is
/// what the messages call the slice.

#include <vorl/Operators/IP/kernels/VolumeView.h>

inline namespace vorl {
namespace vorl_detail {

/// False, with a status, unless there is a volume with slices and a slice of its data type.
bool CheckSampling(const dVolume* volume, const dSlice* slice, const char* name, dStatus& status);

/// False, with a status, unless the volume's samples have 16 bits.
bool CheckSampleType(const dVolume& volume, dStatus& status);

/// False, with a status, unless all pixels are where they should be.
bool CheckSamples(const VolumeView& view, const dSlice& slice, const char* name, dStatus& status);

}  // namespace vorl_detail
}  // namespace vorl

#endif
