#include <vorl/Operators/IP/kernels/Pixels.h>

inline namespace vorl {
namespace vorl_detail {

extern const PixelKernels kPixelKernelsAvx2;
extern const PixelKernels kPixelKernelsAvx512;

namespace {

constexpr PixelKernels kPixelKernelsRef = {
    &MapBytesRunRef,
    nullptr,
    {&MinMaxRunRef<std::uint8_t>, &MinMaxRunRef<std::int8_t>, &MinMaxRunRef<std::uint16_t>,
     &MinMaxRunRef<std::int16_t>, &MinMaxRunRef<std::int32_t>},
    {&RescaleRunRef<std::uint16_t>, &RescaleRunRef<std::int16_t>}};

}  // namespace

const PixelKernels& PixelKernelsOf(CpuVariant variant) {
#if defined(VORL_X86_KERNELS)
  switch (variant) {
    case CpuVariant::Avx512:
      return kPixelKernelsAvx512;
    case CpuVariant::Avx2:
      return kPixelKernelsAvx2;
    case CpuVariant::Reference:
      break;
  }
#else
  static_cast<void>(variant);
#endif
  return kPixelKernelsRef;
}

const PixelKernels& ActivePixelKernels() {
  static const PixelKernels& active = PixelKernelsOf(ActiveVariant());
  return active;
}

}  // namespace vorl_detail
}  // namespace vorl
