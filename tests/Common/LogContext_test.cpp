#include <vorl/Common/LogContext.h>

#include <gtest/gtest.h>
#include <tests/Support/RecordingTarget.h>
#include <vorl/Common/HRTimer.h>
#include <vorl/Common/LogManager.h>

#include <memory>
#include <string>
#include <type_traits>
#include <vector>

namespace {

using Trail = std::vector<std::string>;

TEST(LogContext, StartsWithItsPlaceAndNoRecord) {
  const double before = HRTimer().GetTime();
  const LogContext context("dImage::Init", "vorl/Data/dImage.cpp", 77, false);
  const double after = HRTimer().GetTime();
  EXPECT_STREQ(context.GetTitle(), "dImage::Init");
  EXPECT_STREQ(context.GetFilePath(), "vorl/Data/dImage.cpp");
  EXPECT_STREQ(context.GetFileName(), "dImage.cpp");
  EXPECT_EQ(context.GetLineNo(), 77u);
  EXPECT_EQ(context.GetInitLineNo(), 77u);
  EXPECT_STREQ(context.GetMsg(), "");
  EXPECT_EQ(context.GetCode(), 0);
  EXPECT_GE(context.GetLogTime(), before);
  EXPECT_LE(context.GetLogTime(), after);
}

TEST(LogContext, DefaultContextIsEmptyAndSilent) {
  const RecordingTarget target;
  {
    const LogContext context;
    EXPECT_STREQ(context.GetTitle(), "");
    EXPECT_STREQ(context.GetFilePath(), "");
    EXPECT_STREQ(context.GetFileName(), "");
    EXPECT_EQ(context.GetLineNo(), 0u);
    EXPECT_EQ(context.GetInitLineNo(), 0u);
    EXPECT_EQ(context.GetLogDepth(), 0u);
  }
  EXPECT_TRUE(target.records.empty());
}

TEST(LogContext, TakesNullTextsAsEmpty) {
  const LogContext context(nullptr, nullptr, 3, false);
  EXPECT_STREQ(context.GetTitle(), "");
  EXPECT_STREQ(context.GetFilePath(), "");
  EXPECT_STREQ(context.GetFileName(), "");
}

TEST(LogContext, CopiesTheTitleAndRefersToThePath) {
  std::string title = "title";
  const std::string path = "dir/file.cpp";
  const LogContext context(title.c_str(), path.c_str(), 1, false);
  title[0] = 'X';
  EXPECT_STREQ(context.GetTitle(), "title");
  EXPECT_EQ(context.GetFilePath(), path.c_str());
  EXPECT_EQ(context.GetFileName(), path.c_str() + 4);
}

TEST(LogContext, FileNameIsCutBehindTheLastSeparatorOfEitherKind) {
  struct {
    const char* path;
    const char* name;
  } const cases[] = {
      {"C:\\src\\Data\\dImage.cpp", "dImage.cpp"},
      {"/src/Data/dImage.cpp", "dImage.cpp"},
      {"C:\\src/Data\\dImage.cpp", "dImage.cpp"},
      {"C:\\src\\Data/dImage.cpp", "dImage.cpp"},
      {"dImage.cpp", "dImage.cpp"},
      {"src/", ""},
      {"\\", ""},
      {"", ""},
  };
  for (const auto& expected : cases) {
    SCOPED_TRACE(expected.path);
    EXPECT_STREQ(LogContext("t", expected.path, 1, false).GetFileName(), expected.name);
  }
}

TEST(LogContext, InfoHasCodeZeroAndLineZero) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Info("%d images", 3);
  ASSERT_EQ(target.records.size(), 1u);
  EXPECT_EQ(target.records[0].kind, "info");
  EXPECT_EQ(target.records[0].title, "t");
  EXPECT_EQ(target.records[0].message, "3 images");
  EXPECT_EQ(target.records[0].code, 0);
  EXPECT_EQ(target.records[0].line, 0u);
  EXPECT_EQ(context.GetInitLineNo(), 12u);
}

TEST(LogContext, InfoWithoutFormatKeepsMessageAndLine) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Error(34, "bad %d", 1);
  context.Info(nullptr);
  ASSERT_EQ(target.records.size(), 2u);
  EXPECT_EQ(target.records[1].kind, "info");
  EXPECT_EQ(target.records[1].message, "bad 1");
  EXPECT_EQ(target.records[1].code, 0);
  EXPECT_EQ(target.records[1].line, 34u);
}

TEST(LogContext, InfoWithEmptyFormatEmptiesTheMessage) {
  LogContext context("t", "f", 12, false);
  context.Error(34, "bad");
  context.Info("");
  EXPECT_STREQ(context.GetMsg(), "");
  EXPECT_EQ(context.GetLineNo(), 0u);
}

TEST(LogContext, ErrorHasCodeMinusOneAndItsLine) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Error(34, "can't to open '%s'", "a.bdf");
  ASSERT_EQ(target.records.size(), 1u);
  EXPECT_EQ(target.records[0].kind, "error");
  EXPECT_EQ(target.records[0].message, "can't to open 'a.bdf'");
  EXPECT_EQ(target.records[0].code, -1);
  EXPECT_EQ(target.records[0].line, 34u);
  EXPECT_EQ(context.GetInitLineNo(), 12u);
}

TEST(LogContext, WarningHasCodeOneAndItsLine) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Warning(35, "slice %d of %d", 1, 9);
  ASSERT_EQ(target.records.size(), 1u);
  EXPECT_EQ(target.records[0].kind, "warning");
  EXPECT_EQ(target.records[0].message, "slice 1 of 9");
  EXPECT_EQ(target.records[0].code, 1);
  EXPECT_EQ(target.records[0].line, 35u);
}

TEST(LogContext, ErrorAndWarningWithoutFormatKeepTheMessageOnly) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Info("first");
  context.Error(34, nullptr);
  context.Warning(35, nullptr);
  ASSERT_EQ(target.records.size(), 3u);
  EXPECT_EQ(target.records[1].message, "first");
  EXPECT_EQ(target.records[1].code, -1);
  EXPECT_EQ(target.records[1].line, 34u);
  EXPECT_EQ(target.records[2].message, "first");
  EXPECT_EQ(target.records[2].code, 1);
  EXPECT_EQ(target.records[2].line, 35u);
}

TEST(LogContext, StatusIsReportedByTheSignOfItsCode) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Status(40, dStatus(5, "late"));
  context.Status(41, dStatus(-208, "short read"));
  context.Status(42, dStatus(0, "fine"));
  ASSERT_EQ(target.records.size(), 3u);
  EXPECT_EQ(target.records[0].kind, "warning");
  EXPECT_EQ(target.records[0].code, 5);
  EXPECT_EQ(target.records[0].message, "late");
  EXPECT_EQ(target.records[0].line, 40u);
  EXPECT_EQ(target.records[1].kind, "error");
  EXPECT_EQ(target.records[1].code, -208);
  EXPECT_EQ(target.records[1].message, "short read");
  EXPECT_EQ(target.records[1].line, 41u);
  EXPECT_EQ(target.records[2].kind, "info");
  EXPECT_EQ(target.records[2].code, 0);
  EXPECT_EQ(target.records[2].message, "fine");
  EXPECT_EQ(target.records[2].line, 42u) << "a status keeps its line also as an information";
}

TEST(LogContext, StatusTextIsNotAFormatAndIsNotCut) {
  LogContext context("t", "f", 12, false);
  dStatus status;
  status = "100%d " + std::string(2000, 'x');
  context.Status(1, status);
  EXPECT_STREQ(context.GetMsg(), static_cast<const char*>(status));
}

TEST(LogContext, FormattedMessagesAreCutAt1023Characters) {
  const std::string longer(3000, 'x');
  LogContext context("t", "f", 12, false);
  context.Info("%s", longer.c_str());
  EXPECT_EQ(context.GetMsg(), std::string(1023, 'x'));
  context.Error(1, "%s", longer.c_str());
  EXPECT_EQ(context.GetMsg(), std::string(1023, 'x'));
  context.Warning(1, "%s", longer.c_str());
  EXPECT_EQ(context.GetMsg(), std::string(1023, 'x'));
}

TEST(LogContext, EachRecordHasItsOwnTime) {
  LogContext context("t", "f", 12, false);
  double last = context.GetLogTime();
  const auto expectLater = [&](const char* what) {
    EXPECT_GT(context.GetLogTime(), last) << what;
    last = context.GetLogTime();
  };
  context.Info("i");
  expectLater("info");
  context.Error(1, "e");
  expectLater("error");
  context.Warning(1, "w");
  expectLater("warning");
  context.Status(1, dStatus(0, ""));
  expectLater("status");
  context.LogDate();
  expectLater("date");
}

TEST(LogContext, TraceIsCompiledOut) {
  const RecordingTarget target;
  LogContext context("t", "f", 12, false);
  context.Trace("%d", 1);
  EXPECT_TRUE(target.records.empty());
  EXPECT_STREQ(context.GetMsg(), "");
  EXPECT_EQ(context.GetLineNo(), 12u);
}

TEST(LogContext, LineCanBeSet) {
  LogContext context("t", "f", 12, false);
  context.SetLineNo(99);
  EXPECT_EQ(context.GetLineNo(), 99u);
  EXPECT_EQ(context.GetInitLineNo(), 12u);
}

TEST(LogContext, CopiesTakeEveryField) {
  LogContext source("t", "dir/file.cpp", 12, false);
  source.Error(34, "bad");
  const LogContext copy(source);
  LogContext assigned;
  assigned = source;
  for (const LogContext* context : {&copy, static_cast<const LogContext*>(&assigned)}) {
    EXPECT_STREQ(context->GetTitle(), "t");
    EXPECT_EQ(context->GetFilePath(), source.GetFilePath());
    EXPECT_STREQ(context->GetFileName(), "file.cpp");
    EXPECT_EQ(context->GetLineNo(), 34u);
    EXPECT_EQ(context->GetInitLineNo(), 12u);
    EXPECT_STREQ(context->GetMsg(), "bad");
    EXPECT_EQ(context->GetCode(), -1);
    EXPECT_EQ(context->GetLogTime(), source.GetLogTime());
    EXPECT_EQ(context->GetThreadID(), source.GetThreadID());
    EXPECT_EQ(&context->GetLogStack(), &source.GetLogStack());
  }
}

TEST(LogContext, OnlyTheDestructorIsVirtual) {
  EXPECT_TRUE(std::has_virtual_destructor_v<LogContext>);
}

TEST(LogContext, ReportingToNobodyIsHarmless) {
  LogContext context("t", "f", 12, true);
  context.Info("i");
  context.Error(1, "e");
  context.Warning(2, "w");
  context.Status(3, dStatus(-7, "s"));
  EXPECT_STREQ(context.GetMsg(), "s");
  EXPECT_EQ(context.GetCode(), -7);
}

}  // namespace
