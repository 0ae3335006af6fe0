#include <vorl/Common/dStatus.h>

#include <gtest/gtest.h>

#include <string>

namespace {

TEST(dStatus, BuiltFromTrueHoldsCodeZeroAndTheText) {
  const dStatus status(true, "done");
  EXPECT_EQ(static_cast<long>(status), 0);
  EXPECT_STREQ(status, "done");
  EXPECT_TRUE(status == true);
}

TEST(dStatus, FalseKeepsTheMessageAndTrueEmptiesIt) {
  dStatus status;
  status = "text";
  status = false;
  EXPECT_EQ(static_cast<long>(status), -1);
  EXPECT_STREQ(status, "text");
  status = true;
  EXPECT_EQ(static_cast<long>(status), 0);
  EXPECT_STREQ(status, "");
}

}  // namespace
