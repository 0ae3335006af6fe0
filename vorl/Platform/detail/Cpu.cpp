#include <vorl/Platform/detail/Cpu.h>

#include <cstdlib>

inline namespace vorl {
namespace vorl_detail {

const char* NameOf(CpuVariant variant) {
  switch (variant) {
    case CpuVariant::Reference:
      return "ref";
    case CpuVariant::Avx2:
      return "avx2";
    case CpuVariant::Avx512:
      return "avx512";
  }
  return "";
}

std::optional<CpuVariant> VariantNamed(std::string_view name) {
  for (const CpuVariant variant : kCpuVariants) {
    if (name == NameOf(variant)) {
      return variant;
    }
  }
  return std::nullopt;
}

bool CanRun(CpuVariant variant) {
  switch (variant) {
    case CpuVariant::Reference:
      return true;
#if defined(VORL_X86_KERNELS)
    // The compiler's support also asks the system whether it saves the registers.
    case CpuVariant::Avx2:
      return __builtin_cpu_supports("avx2") && __builtin_cpu_supports("bmi2");
    case CpuVariant::Avx512:
      return CanRun(CpuVariant::Avx2) && __builtin_cpu_supports("avx512f") &&
             __builtin_cpu_supports("avx512bw") && __builtin_cpu_supports("avx512dq") &&
             __builtin_cpu_supports("avx512vl") && __builtin_cpu_supports("avx512vbmi");
#else
    case CpuVariant::Avx2:
    case CpuVariant::Avx512:
      return false;
#endif
  }
  return false;
}

CpuVariant ChooseVariant(const char* name) {
  const auto wanted = name != nullptr ? VariantNamed(name) : std::nullopt;
  auto chosen = CpuVariant::Reference;
  for (const CpuVariant variant : kCpuVariants) {
    if (CanRun(variant) && variant <= wanted.value_or(variant)) {
      chosen = variant;
    }
  }
  return chosen;
}

CpuVariant ActiveVariant() {
  static const CpuVariant active = ChooseVariant(std::getenv("VORL_CPU"));
  return active;
}

}  // namespace vorl_detail
}  // namespace vorl
