#ifndef VORL_TESTS_SUPPORT_VARIANTTEST_H
#define VORL_TESTS_SUPPORT_VARIANTTEST_H

#include <vorl/Platform/detail/Cpu.h>

#include <gtest/gtest.h>

#include <string>

/// A test of one variant of the kernels. A machine that lacks the variant's instructions cannot run
/// it and says so; the reference runs everywhere.
class VariantTest : public testing::TestWithParam<vorl::vorl_detail::CpuVariant> {
 protected:
  void SetUp() override {
    if (!vorl::vorl_detail::CanRun(GetParam())) {
      GTEST_SKIP() << "this machine has no " << vorl::vorl_detail::NameOf(GetParam());
    }
  }
};

/// Names such tests.
inline std::string VariantName(const testing::TestParamInfo<vorl::vorl_detail::CpuVariant>& test) {
  return vorl::vorl_detail::NameOf(test.param);
}

#endif
