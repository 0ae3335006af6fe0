#include <vorl/Common/dStatus.h>

#include <gtest/gtest.h>

#include <string>

namespace {

constexpr const char* kNoFormat = nullptr;

long CodeOf(const dStatus& status) {
  return status;
}

TEST(dStatusSet, TakesACodeAndFormatsTheText) {
  dStatus status;
  status.Set(-12L, "can't allocate %d bytes", 4711);
  EXPECT_EQ(CodeOf(status), -12);
  EXPECT_STREQ(status, "can't allocate 4711 bytes");

  status.Set(3, "%s: 0x%x", "type", 0x1010);
  EXPECT_EQ(CodeOf(status), 3);
  EXPECT_STREQ(status, "type: 0x1010");
}

TEST(dStatusSet, MapsABool) {
  dStatus status(7, "old");
  status.Set(true, "read %d", 1);
  EXPECT_EQ(CodeOf(status), 0);
  EXPECT_STREQ(status, "read 1");
  status.Set(false, "read %d", 2);
  EXPECT_EQ(CodeOf(status), -1);
  EXPECT_STREQ(status, "read 2");
}

TEST(dStatusSet, WrapsACauseWithoutSeparatorAndKeepsItsCode) {
  const dStatus inner(-3L, "no memory");
  dStatus outer(true, "");
  outer.Set(inner, "initialization error:");
  EXPECT_EQ(CodeOf(outer), -3);
  EXPECT_STREQ(outer, "initialization error:no memory");
}

TEST(dStatusSet, FormatsThePrefixOfACause) {
  const dStatus inner(4, "late");
  dStatus outer;
  outer.Set(inner, "slice %d of '%s': ", 12, "head");
  EXPECT_EQ(CodeOf(outer), 4);
  EXPECT_STREQ(outer, "slice 12 of 'head': late");
}

TEST(dStatusSet, ACauseWithoutFormatIsCopiedWhole) {
  const dStatus inner(-3L, "no memory");
  dStatus outer(5, "old");
  outer.Set(inner, kNoFormat);
  EXPECT_EQ(CodeOf(outer), -3);
  EXPECT_STREQ(outer, "no memory");
  outer = "old";
  outer.Set(inner, "");
  EXPECT_STREQ(outer, "no memory");
}

TEST(dStatusSet, AStatusCanWrapItself) {
  dStatus status(-3L, "no memory");
  status.Set(status, "LUT initialization error:");
  EXPECT_EQ(CodeOf(status), -3);
  EXPECT_STREQ(status, "LUT initialization error:no memory");
}

TEST(dStatusSet, ConversionsInTheTextOfACauseStayAsTheyAre) {
  dStatus inner;
  inner = "100%d %s %%";
  dStatus outer;
  outer.Set(inner, "x:");
  EXPECT_STREQ(outer, "x:100%d %s %%");
}

TEST(dStatusSet, NullAndEmptyFormatsEmptyTheText) {
  dStatus status(0, "old");
  status.Set(-1L, "");
  EXPECT_EQ(CodeOf(status), -1);
  EXPECT_STREQ(status, "");
  status = "old";
  status.Set(-2, kNoFormat);
  EXPECT_EQ(CodeOf(status), -2);
  EXPECT_STREQ(status, "");
  status = "old";
  status.Set(true, kNoFormat);
  EXPECT_STREQ(status, "");
  status = "old";
  status.SetMsg(kNoFormat);
  EXPECT_STREQ(status, "");
}

TEST(dStatusSetMsg, FormatsTheTextAndIsASuccess) {
  dStatus status(-3L, "failed");
  status.SetMsg("%d images", 17);
  EXPECT_EQ(CodeOf(status), 0);
  EXPECT_STREQ(status, "17 images");
}

TEST(dStatusAddMsg, AppendsTheFormattedTextAndKeepsTheCode) {
  dStatus status(-3L, "failed");
  status.AddMsg(" in line %d", 42);
  EXPECT_EQ(CodeOf(status), -3);
  EXPECT_STREQ(status, "failed in line 42");
}

TEST(dStatusAddMsg, NullAndEmptyFormatsAddNothing) {
  dStatus status(-3L, "failed");
  status.AddMsg(kNoFormat);
  status.AddMsg("");
  EXPECT_EQ(CodeOf(status), -3);
  EXPECT_STREQ(status, "failed");
}

TEST(dStatusFormat, EveryFormattedTextIsCutAt1023Characters) {
  const std::string fits(1023, 'x');
  const std::string longer(5000, 'x');
  dStatus status;
  for (const std::string& given : {fits, fits + "x", longer}) {
    SCOPED_TRACE(given.size());
    status.Set(-1L, "%s", given.c_str());
    EXPECT_EQ(static_cast<const char*>(status), fits);
    status.Set(-1, "%s", given.c_str());
    EXPECT_EQ(static_cast<const char*>(status), fits);
    status.Set(true, "%s", given.c_str());
    EXPECT_EQ(static_cast<const char*>(status), fits);
    status.SetMsg("%s", given.c_str());
    EXPECT_EQ(static_cast<const char*>(status), fits);
    EXPECT_EQ(static_cast<const char*>(dStatus(-1L, given.c_str())), fits);
    EXPECT_EQ(static_cast<const char*>(dStatus(true, given.c_str())), fits);
  }
}

TEST(dStatusFormat, OnlyTheFormattedPartIsCut) {
  const std::string fits(1023, 'x');
  const std::string longer(2000, 'x');
  dStatus status;
  status = "start:";
  status.AddMsg("%s", longer.c_str());
  EXPECT_EQ(static_cast<const char*>(status), "start:" + fits);

  dStatus inner(-3L, "inner");
  status.Set(inner, "%s", longer.c_str());
  EXPECT_EQ(static_cast<const char*>(status), fits + "inner");

  status = longer;
  EXPECT_EQ(static_cast<const char*>(status), longer) << "assigned texts are not formatted";
}

TEST(dStatusFormat, ConstructorTextIsAFormatWithoutArguments) {
  EXPECT_STREQ(dStatus(-1L, "100%% done"), "100% done");
  EXPECT_STREQ(dStatus(false, "100%% done"), "100% done");
  EXPECT_STREQ(dStatus(-1, "%%d"), "%d");
}

// A conversion has no argument that it could take: it must not read one from anywhere.
TEST(dStatusFormat, ConversionsInAConstructorTextStayAsWritten) {
  EXPECT_STREQ(dStatus(-1L, "%s %n %d"), "%s %n %d");
  EXPECT_STREQ(dStatus(true, "100%"), "100%");
}

TEST(dStatusFormat, ConstructorsTakeNullAsEmpty) {
  EXPECT_STREQ(dStatus(-1L, nullptr), "");
  EXPECT_STREQ(dStatus(-1, nullptr), "");
  EXPECT_STREQ(dStatus(true, nullptr), "");
}

}  // namespace
