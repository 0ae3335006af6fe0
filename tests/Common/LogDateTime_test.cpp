#include <gtest/gtest.h>
#include <tests/Support/RecordingTarget.h>
#include <vorl/Common/LogContext.h>

#include <ctime>
#include <string>

namespace {

std::string LocalTimeText(const char* format) {
  const std::time_t now = std::time(nullptr);
  char text[256] = "";
  std::strftime(text, sizeof text, format, std::localtime(&now));
  return text;
}

// Reports through `report` and expects the local time as `format` gives it. The clock may move on
// in between, so the report must equal the time before or after it.
template <typename Report>
void ExpectLocalTime(Report report, const char* format) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Error(34, "before");
  const std::string before = LocalTimeText(format);
  report(context);
  const std::string after = LocalTimeText(format);
  ASSERT_EQ(target.records.size(), 2u);
  const RecordingTarget::Record& record = target.records[1];
  EXPECT_EQ(record.kind, "info");
  EXPECT_EQ(record.code, 0);
  EXPECT_EQ(record.line, 0u);
  EXPECT_TRUE(record.message == before || record.message == after)
      << record.message << " is neither " << before << " nor " << after;
}

TEST(LogDateTime, ReportsTheLocalTimeInTheGivenFormat) {
  ExpectLocalTime([](LogContext& context) { context.LogDateTime("%Y/%m/%d at %H:%M"); },
                  "%Y/%m/%d at %H:%M");
}

TEST(LogDateTime, LogDateReportsDayMonthYear) {
  ExpectLocalTime([](LogContext& context) { context.LogDate(); }, "%d-%b-%Y");
}

TEST(LogDateTime, LogTimeReportsHoursMinutesSeconds) {
  ExpectLocalTime([](LogContext& context) { context.LogTime(); }, "%H:%M:%S");
}

TEST(LogDateTime, NullFormatReportsNothing) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Error(34, "before");
  context.LogDateTime(nullptr);
  EXPECT_EQ(target.records.size(), 1u);
  EXPECT_STREQ(context.GetMsg(), "before");
  EXPECT_EQ(context.GetLineNo(), 34u);
  EXPECT_EQ(context.GetCode(), -1);
}

TEST(LogDateTime, HoldsAtMost255Characters) {
  LogContext context("t", "f", 12, false);
  context.LogDateTime(std::string(255, 'x').c_str());
  EXPECT_EQ(context.GetMsg(), std::string(255, 'x'));
  context.LogDateTime(std::string(256, 'x').c_str());
  EXPECT_STREQ(context.GetMsg(), "");
}

TEST(LogDateTime, EmptyFormatReportsAnEmptyText) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Error(34, "before");
  context.LogDateTime("");
  ASSERT_EQ(target.records.size(), 2u);
  EXPECT_EQ(target.records[1].message, "");
}

}  // namespace
