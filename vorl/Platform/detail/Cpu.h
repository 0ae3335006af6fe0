#ifndef VORL_PLATFORM_DETAIL_CPU_H
#define VORL_PLATFORM_DETAIL_CPU_H

/// @file
/// Which of its forms a kernel runs in.

#include <optional>
#include <string_view>

inline namespace vorl {
namespace vorl_detail {

/// The instructions that a form of a kernel uses, from the fewest to the most. Every form gives the
/// same bits.
enum class CpuVariant {
  Reference,  ///< what every machine has
  Avx2,       ///< AVX2, BMI2
  Avx512      ///< AVX-512 F, BW, DQ, VL and VBMI besides
};

inline constexpr CpuVariant kCpuVariants[] = {CpuVariant::Reference, CpuVariant::Avx2,
                                              CpuVariant::Avx512};

/// "ref", "avx2" or "avx512".
const char* NameOf(CpuVariant variant);

/// The variant of that name; none for any other text.
std::optional<CpuVariant> VariantNamed(std::string_view name);

/// True when this build has the variant and this machine its instructions.
bool CanRun(CpuVariant variant);

/// The variant to run in a process whose environment asks for the one of that name: that one, or
/// the best below it that can run. Without a name, or with one that means nothing, the best that
/// can run.
CpuVariant ChooseVariant(const char* name);

/// What `ChooseVariant` says to the environment variable VORL_CPU; asked once.
CpuVariant ActiveVariant();

}  // namespace vorl_detail
}  // namespace vorl

#endif
