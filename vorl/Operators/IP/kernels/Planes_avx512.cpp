#include <vorl/Operators/IP/kernels/Lanes_avx512.h>
// Lanes first: the loops are made of them.
#include <vorl/Operators/IP/kernels/Planes_body.h>

inline namespace vorl {
namespace vorl_detail {

extern const PlaneKernels kPlaneKernelsAvx512;
const PlaneKernels kPlaneKernelsAvx512 = kKernels;

}  // namespace vorl_detail
}  // namespace vorl
