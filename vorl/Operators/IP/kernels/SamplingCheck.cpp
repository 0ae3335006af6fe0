#include <vorl/Operators/IP/kernels/SamplingCheck.h>

#include <vorl/Operators/IP/kernels/ImageCheck.h>

inline namespace vorl {
namespace vorl_detail {

bool CheckSampling(const dVolume* volume, const dSlice* slice, const char* name, dStatus& status) {
  if (volume == nullptr) {
    status.Set(false, "missing input parameter 'Volume'");
  } else if (!volume->IsValid()) {
    status.Set(false, "given Volume is empty");
  } else if (slice == nullptr) {
    status.Set(false, "missing input parameter '%s'", name);
  } else if (slice->GetDataType() != volume->GetDataType()) {
    // The closing parenthesis is missing in the text itself.
    status.Set(false, "incompatible data types(Volume: 0x%x, Slice: 0x%x", volume->GetDataType(),
               slice->GetDataType());
  } else {
    return true;
  }
  return false;
}

bool CheckSampleType(const dVolume& volume, dStatus& status) {
  const unsigned short dataType = volume.GetDataType();
  if (dataType != ImageDataType_U16 && dataType != ImageDataType_S16) {
    status.Set(false, "unsupported data type: %d", dataType);
    return false;
  }
  return true;
}

bool CheckSamples(const VolumeView& view, const dSlice& slice, const char* name, dStatus& status) {
  if (!CheckPixels(view, status)) {
    return false;
  }
  if (!HoldsRows(slice.GetImage())) {
    status.Set(false, "invalid pixel data in the %s", name);
    return false;
  }
  return true;
}

}  // namespace vorl_detail
}  // namespace vorl
