// The loops of stretching for one set of vector instructions. A variant's source includes this
// once, having defined in its anonymous namespace `Register1` and `Register4`: registers full of
// units of 1 and of 4 bytes, of which one takes units from the other; and `EndStream`, which ends
// what `Register4` streams.
//
// They call nothing that is inline elsewhere: it might be compiled here for a machine that others
// do not have, and kept as the one copy for all.

#include <vorl/Platform/soft/StretchKernels.h>

inline namespace vorl {
namespace vorl_detail {
namespace {

template <class Register, int kBytes, void (*kStore)(typename Register::Units, std::uint8_t*)>
void GatherBlockwise(const std::uint8_t* units, const GatherBlocks& plan, std::uint8_t* target) {
  constexpr std::size_t kCount = Register::kCount;
  const std::uint8_t* offsets = plan.offsets;
  for (std::size_t b = 0; b < plan.blocks; ++b, offsets += kCount, target += kCount * kBytes) {
    kStore(Register::Chosen(units + static_cast<std::ptrdiff_t>(plan.firsts[b]) * kBytes, offsets),
           target);
  }
  GatherBlocks rest;
  rest.columns = plan.columns + plan.blocks * kCount;
  rest.count = plan.count - plan.blocks * kCount;
  GatherRunRef<kBytes>(units, rest, target);
}

constexpr StretchKernels kKernels = {&GatherBlockwise<Register1, 1, &Register1::Store>,
                                     Register1::kCount,
                                     &GatherBlockwise<Register4, 4, &Register4::Store>,
                                     Register4::kCount,
                                     &MapTo32,
                                     &GatherBlockwise<Register4, 4, &Register4::Stream>,
                                     &EndStream};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl
