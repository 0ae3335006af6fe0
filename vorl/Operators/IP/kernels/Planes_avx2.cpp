#include <vorl/Operators/IP/kernels/Lanes_avx2.h>
// Lanes first: the loops are made of them.
#include <vorl/Operators/IP/kernels/Planes_body.h>

inline namespace vorl {
namespace vorl_detail {

extern const PlaneKernels kPlaneKernelsAvx2;
const PlaneKernels kPlaneKernelsAvx2 = kKernels;

}  // namespace vorl_detail
}  // namespace vorl
