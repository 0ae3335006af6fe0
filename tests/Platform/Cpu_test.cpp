#include <vorl/Platform/detail/Cpu.h>

#include <gtest/gtest.h>

#include <cstdlib>

namespace {

using vorl_detail::CpuVariant;

TEST(Cpu, VariantsHaveNames) {
  EXPECT_EQ(vorl_detail::VariantNamed("ref"), CpuVariant::Reference);
  EXPECT_EQ(vorl_detail::VariantNamed("avx2"), CpuVariant::Avx2);
  EXPECT_EQ(vorl_detail::VariantNamed("avx512"), CpuVariant::Avx512);
  for (const char* text : {"", "AVX2", "avx", "avx5120", "neon"}) {
    EXPECT_FALSE(vorl_detail::VariantNamed(text)) << text;
  }
}

TEST(Cpu, EveryMachineRunsTheReference) {
  EXPECT_TRUE(vorl_detail::CanRun(CpuVariant::Reference));
  EXPECT_EQ(vorl_detail::ChooseVariant("ref"), CpuVariant::Reference);
}

TEST(Cpu, ForcedVariantIsTheOneNamedOrTheBestBelow) {
  for (const CpuVariant variant : vorl_detail::kCpuVariants) {
    const CpuVariant chosen = vorl_detail::ChooseVariant(vorl_detail::NameOf(variant));
    EXPECT_LE(chosen, variant);
    EXPECT_TRUE(vorl_detail::CanRun(chosen));
    if (vorl_detail::CanRun(variant)) {
      EXPECT_EQ(chosen, variant);
    }
  }
}

TEST(Cpu, WithoutAKnownNameTheBestIsChosen) {
  const CpuVariant best = vorl_detail::ChooseVariant(nullptr);
  EXPECT_EQ(vorl_detail::ChooseVariant("fastest"), best);
  for (const CpuVariant variant : vorl_detail::kCpuVariants) {
    EXPECT_TRUE(variant <= best || !vorl_detail::CanRun(variant));
  }
}

TEST(Cpu, ActiveVariantIsWhatTheEnvironmentAsksFor) {
  EXPECT_EQ(vorl_detail::ActiveVariant(), vorl_detail::ChooseVariant(std::getenv("VORL_CPU")));
}

}  // namespace
