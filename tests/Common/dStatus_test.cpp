#include <vorl/Common/dStatus.h>

#include <gtest/gtest.h>
#include <tests/Support/VirtualSlot.h>

#include <climits>
#include <cstdint>
#include <limits>
#include <memory>
#include <sstream>
#include <string>
#include <type_traits>

namespace {

long CodeOf(const dStatus& status) {
  return status;
}

std::string TextOf(const dStatus& status) {
  return static_cast<const char*>(status);
}

TEST(dStatus, StartsAsFailureWithoutText) {
  const dStatus status;
  EXPECT_EQ(CodeOf(status), -1);
  EXPECT_EQ(TextOf(status), "");
}

TEST(dStatus, BuiltFromTrueHoldsCodeZeroAndTheText) {
  const dStatus status(true, "done");
  EXPECT_EQ(CodeOf(status), 0);
  EXPECT_STREQ(status, "done");
  EXPECT_TRUE(status == true);
}

TEST(dStatus, BuiltFromFalseHoldsCodeMinusOneAndTheText) {
  const dStatus status(false, "uninitialized");
  EXPECT_EQ(CodeOf(status), -1);
  EXPECT_STREQ(status, "uninitialized");
}

TEST(dStatus, BuiltFromACodeHoldsItAndTheText) {
  EXPECT_EQ(CodeOf(dStatus(-208L, "short")), -208);
  EXPECT_EQ(CodeOf(dStatus(5, "warned")), 5);
  EXPECT_EQ(TextOf(dStatus(-208L, "short")), "short");
  EXPECT_EQ(TextOf(dStatus(5, "warned")), "warned");
}

TEST(dStatus, CopyTakesCodeAndText) {
  const dStatus source(-3L, "inner");
  const dStatus copy(source);
  EXPECT_EQ(CodeOf(copy), -3);
  EXPECT_STREQ(copy, "inner");
}

TEST(dStatus, ResetGivesSuccessWithoutText) {
  dStatus status(-3L, "inner");
  status.Reset();
  EXPECT_EQ(CodeOf(status), 0);
  EXPECT_STREQ(status, "");
}

TEST(dStatus, IsAlwaysValid) {
  dStatus failed(-3L, "inner");
  dStatus fine(true, "");
  EXPECT_TRUE(failed.IsValid());
  EXPECT_TRUE(fine.IsValid());
}

TEST(dStatus, AssignedStatusTakesCodeAndText) {
  const dStatus source(-3L, "inner");
  dStatus target(5, "old");
  dStatus& result = target = source;
  EXPECT_EQ(&result, &target);
  EXPECT_EQ(CodeOf(target), -3);
  EXPECT_STREQ(target, "inner");
}

TEST(dStatus, SelfAssignmentChangesNothing) {
  dStatus status(-3L, "inner");
  const dStatus& same = status;
  status = same;
  EXPECT_EQ(CodeOf(status), -3);
  EXPECT_STREQ(status, "inner");
}

TEST(dStatus, CopiesTextsWithEmbeddedZerosWhole) {
  dStatus source;
  source = std::string("a\0b", 3);
  dStatus target;
  target = source;
  target += "c";
  dStatus expected;
  expected = std::string("a\0bc", 4);
  // What stands behind the zero shows when only the end of the text is compared.
  EXPECT_EQ(std::string(static_cast<const char*>(target), 4),
            std::string(static_cast<const char*>(expected), 4));
}

TEST(dStatus, AssignedCodeKeepsTheText) {
  dStatus status(-3L, "inner");
  dStatus& fromLong = status = 7L;
  EXPECT_EQ(&fromLong, &status);
  EXPECT_EQ(CodeOf(status), 7);
  EXPECT_STREQ(status, "inner");

  dStatus& fromInt = status = 0;
  EXPECT_EQ(&fromInt, &status);
  EXPECT_EQ(CodeOf(status), 0);
  EXPECT_STREQ(status, "inner") << "code 0 as a number does not empty the text";
}

TEST(dStatus, FalseKeepsTheMessageAndTrueEmptiesIt) {
  dStatus status;
  status = "text";
  dStatus& result = status = false;
  EXPECT_EQ(&result, &status);
  EXPECT_EQ(CodeOf(status), -1);
  EXPECT_STREQ(status, "text");
  status = true;
  EXPECT_EQ(CodeOf(status), 0);
  EXPECT_STREQ(status, "");
}

TEST(dStatus, AssignedTextKeepsTheCode) {
  dStatus status(-3L, "inner");
  dStatus& fromChars = status = "other";
  EXPECT_EQ(&fromChars, &status);
  EXPECT_EQ(CodeOf(status), -3);
  EXPECT_STREQ(status, "other");

  const std::string text = "third";
  dStatus& fromString = status = text;
  EXPECT_EQ(&fromString, &status);
  EXPECT_EQ(CodeOf(status), -3);
  EXPECT_STREQ(status, "third");
}

TEST(dStatus, AssignedTextIsNotAFormat) {
  dStatus status;
  status = "50%% of %s";
  EXPECT_STREQ(status, "50%% of %s");
}

TEST(dStatus, AssignedNullTextEmptiesTheText) {
  dStatus status(-3L, "inner");
  status = static_cast<const char*>(nullptr);
  EXPECT_EQ(CodeOf(status), -3);
  EXPECT_STREQ(status, "");
}

TEST(dStatus, AppendedTextKeepsTheCode) {
  dStatus status(-3L, "inner");
  dStatus& fromChars = status += "+a";
  EXPECT_EQ(&fromChars, &status);
  const std::string text = "+b";
  dStatus& fromString = status += text;
  EXPECT_EQ(&fromString, &status);
  status += static_cast<const char*>(nullptr);
  EXPECT_EQ(CodeOf(status), -3);
  EXPECT_STREQ(status, "inner+a+b");
}

TEST(dStatus, TakesItsOwnTextAsArgument) {
  dStatus status(-3L, "ab");
  status += static_cast<const char*>(status);
  EXPECT_STREQ(status, "abab");
  status = static_cast<const char*>(status) + 1;
  EXPECT_STREQ(status, "bab");
  status.Set(-1, "<%s>", static_cast<const char*>(status));
  EXPECT_STREQ(status, "<bab>");
}

TEST(dStatus, ComparisonOfStatusesLooksAtCodesOnly) {
  const dStatus a(-3L, "one text");
  const dStatus b(-3L, "another");
  const dStatus c(-4L, "one text");
  EXPECT_TRUE(a == b);
  EXPECT_FALSE(a != b);
  EXPECT_FALSE(a == c);
  EXPECT_TRUE(a != c);
}

TEST(dStatus, ComparesWithACode) {
  const dStatus status(-3L, "");
  EXPECT_TRUE(status == -3L);
  EXPECT_FALSE(status != -3L);
  EXPECT_FALSE(status == 3L);
  EXPECT_TRUE(status != 3L);
  EXPECT_TRUE(status == -3);
  EXPECT_FALSE(status != -3);
  EXPECT_FALSE(status == 0);
  EXPECT_TRUE(status != 0);
}

TEST(dStatus, ComparesWithABoolByWhetherTheCodeIsZero) {
  const dStatus success(0, "");
  const dStatus warning(5, "");
  const dStatus error(-5, "");
  EXPECT_TRUE(success == true);
  EXPECT_FALSE(success == false);
  EXPECT_FALSE(success != true);
  EXPECT_TRUE(success != false);
  EXPECT_TRUE(warning == false) << "a warning equals false";
  EXPECT_FALSE(warning == true);
  EXPECT_TRUE(warning != true);
  EXPECT_FALSE(warning != false);
  EXPECT_TRUE(error == false);
  EXPECT_FALSE(error == true);
}

TEST(dStatus, IsOKOnlyAtCodeZero) {
  EXPECT_TRUE(dStatus(0, "").IsOK());
  EXPECT_FALSE(dStatus(1, "").IsOK());
  EXPECT_FALSE(dStatus(-1, "").IsOK());
}

#if LONG_MAX > 0x7FFFFFFF  // elsewhere no code is beyond 32 bits
TEST(dStatus, CodesBeyond32BitsAreStoredAsTheNearest) {
  constexpr long kMax = std::numeric_limits<std::int32_t>::max();
  constexpr long kMin = std::numeric_limits<std::int32_t>::min();
  const dStatus built(kMax + 1, "");
  EXPECT_EQ(CodeOf(built), kMax);
  EXPECT_FALSE(built == kMax + 1);
  dStatus status;
  status = kMin - 1;
  EXPECT_EQ(CodeOf(status), kMin);
  status.Set(kMax * 2, "");
  EXPECT_EQ(CodeOf(status), kMax);
  status = kMin;
  EXPECT_EQ(CodeOf(status), kMin);
  status = kMax;
  EXPECT_EQ(CodeOf(status), kMax);
}
#endif

TEST(dStatus, CreateGivesANewStatus) {
  const std::unique_ptr<dStatus> status(dStatus::Create());
  ASSERT_NE(status, nullptr);
  EXPECT_STREQ(status->ClassName(), "dStatus");
  EXPECT_EQ(status->GetClassInfo(), &dStatus::CI());
}

TEST(dStatus, VirtualFunctionsAreThoseOfDataBase) {
  EXPECT_EQ(VirtualSlot(&dStatus::GetClassInfo), 0u);
  EXPECT_EQ(VirtualSlot(&dStatus::Reset), 4u);
  EXPECT_EQ(VirtualSlot(&dStatus::IsValid), 5u);
  EXPECT_TRUE(std::has_virtual_destructor_v<dStatus>);
}

TEST(dStatus, PrintsCodeAndText) {
  std::ostringstream out;
  out << dStatus(-1, "missing LUT") << '|' << dStatus(true, "");
  EXPECT_EQ(out.str(), "-1: missing LUT|0: ");
}

// The binary streams throw their status.
TEST(dStatus, CanBeThrownAndCaught) {
  const dStatus source(-200L, "short read");
  try {
    throw source;  // NOLINT: a copy is thrown on purpose
  } catch (const dStatus& caught) {
    EXPECT_EQ(CodeOf(caught), -200);
    EXPECT_STREQ(caught, "short read");
  }
}

}  // namespace
