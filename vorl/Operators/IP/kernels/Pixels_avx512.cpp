#include <vorl/Operators/IP/kernels/Lanes_avx512.h>
// Lanes first: the loops are made of them.
#include <vorl/Operators/IP/kernels/Pixels_body.h>

inline namespace vorl {
namespace vorl_detail {

extern const PixelKernels kPixelKernelsAvx512;
const PixelKernels kPixelKernelsAvx512 = kKernels;

}  // namespace vorl_detail
}  // namespace vorl
