#include <vorl/Data/dASCIIStream.h>

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "../Support/LogRecorder.h"
#include "TextFile.h"

namespace {

namespace fs = std::filesystem;

class dASCIIStreamFile : public TextFile {};

/// Everything that NextChar gives, and the character of its failure.
std::string ReadAll(dASCIIStreamIn& stream, char& last) {
  std::string text;
  last = '?';
  while (stream.NextChar(&last)) {
    text += last;
  }
  return text;
}

TEST_F(dASCIIStreamFile, NextCharRefillsASmallBufferUntilTheEnd) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  ASSERT_TRUE(stream.IsValid());
  char last = 0;
  EXPECT_EQ(ReadAll(stream, last), "0123456789");
  EXPECT_EQ(last, '\0');
}

class dASCIIStreamBufferSize : public dASCIIStreamFile,
                               public testing::WithParamInterface<unsigned long> {};

TEST_P(dASCIIStreamBufferSize, DoesNotShowInWhatIsRead) {
  dASCIIStreamIn stream(m_path.c_str(), GetParam());
  char last = 0;
  EXPECT_EQ(ReadAll(stream, last), "0123456789");
}

INSTANTIATE_TEST_SUITE_P(All, dASCIIStreamBufferSize, testing::Values(1, 2, 3, 5, 9, 10, 11, 1000));

TEST_F(dASCIIStreamFile, GetCharLooksWithoutAdvancing) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  char ch = '?';
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '0');
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '0');
  EXPECT_TRUE(stream.NextChar(&ch));
  EXPECT_EQ(ch, '0');
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '1');
}

TEST_F(dASCIIStreamFile, GetCharBehindTheBuffersLastCharacterIsZero) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  char ch = '?';
  for (int i = 0; i < 4; ++i) {
    stream.NextChar(&ch);
  }
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '\0');
}

TEST_F(dASCIIStreamFile, SetPosMovesInsideAndOutsideTheBuffer) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  char ch = '?';
  EXPECT_TRUE(stream.SetPos(2));
  EXPECT_TRUE(stream.NextChar(&ch));
  EXPECT_EQ(ch, '2');
  EXPECT_TRUE(stream.SetPos(7));
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '7');
  EXPECT_TRUE(stream.SetPos(1));
  char last = 0;
  EXPECT_EQ(ReadAll(stream, last), "123456789");
}

TEST_F(dASCIIStreamFile, SetPosBehindTheEndFails) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  EXPECT_FALSE(stream.SetPos(10));
  EXPECT_FALSE(stream.SetPos(~0UL));
  EXPECT_TRUE(stream.SetPos(9));
}

TEST_F(dASCIIStreamFile, GetStringServesAnyRangeAndTerminates) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  for (unsigned long position = 0; position <= 10; ++position) {
    for (unsigned long length = 0; position + length <= 10; ++length) {
      std::vector<char> out(length + 2, '#');
      EXPECT_TRUE(stream.GetString(position, length, out.data())) << position << " " << length;
      EXPECT_EQ(std::string(out.data()), std::string("0123456789").substr(position, length));
      EXPECT_EQ(out.back(), '#');
    }
  }
}

TEST_F(dASCIIStreamFile, GetStringThatEndsAtTheBuffersEndComesFromTheFile) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  Write("abcdefghij");  // the buffer still holds the digits
  char out[16];
  EXPECT_TRUE(stream.GetString(0, 3, out));
  EXPECT_STREQ(out, "012");
  EXPECT_TRUE(stream.GetString(0, 4, out));
  EXPECT_STREQ(out, "abcd");
}

TEST_F(dASCIIStreamFile, GetStringBeyondTheEndGivesWhatIsThereAndFails) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  char out[16] = "###############";
  EXPECT_FALSE(stream.GetString(8, 5, out));
  EXPECT_STREQ(out, "89");
  EXPECT_FALSE(stream.GetString(10, 3, out));
  EXPECT_STREQ(out, "");
}

TEST_F(dASCIIStreamFile, MissingFileIsNamed) {
  const std::string path = m_path + ".missing";
  LogRecorder log;
  dASCIIStreamIn stream;
  EXPECT_FALSE(stream.Init(path.c_str(), 4));
  EXPECT_EQ(static_cast<long>(stream.GetStatus()), -1);
  EXPECT_STREQ(stream.GetStatus(), ("no such file: '" + path + "'").c_str());
  EXPECT_FALSE(stream.IsValid());
  EXPECT_EQ(log.errors,
            std::vector<std::string>{"dASCIIStreamIn::CheckFile: no such file: '" + path + "'"});
}

TEST_F(dASCIIStreamFile, ParametersMustBeGiven) {
  LogRecorder log;
  dASCIIStreamIn stream;
  EXPECT_FALSE(stream.Init(nullptr, 4));
  EXPECT_STREQ(stream.GetStatus(), "invalid parameter");
  EXPECT_FALSE(stream.Init(m_path.c_str(), 0));
  EXPECT_STREQ(stream.GetStatus(), "invalid parameter");
  EXPECT_FALSE(stream.Init("", 4));
  EXPECT_STREQ(stream.GetStatus(), "given file name is 'NULL' or empty");
  EXPECT_EQ(log.errors.size(), 3U);
  EXPECT_EQ(log.errors[0], "dASCIIStreamIn::Init: invalid parameter");
}

TEST_F(dASCIIStreamFile, FolderCannotBeOpened) {
  const std::string folder = fs::path(testing::TempDir()).string();
  LogRecorder log;
  dASCIIStreamIn stream;
  EXPECT_FALSE(stream.Init(folder.c_str(), 4));
  EXPECT_STREQ(stream.GetStatus(), ("can't to open '" + folder + "'").c_str());
  EXPECT_EQ(log.errors,
            std::vector<std::string>{"dASCIIStreamIn::Init: can't to open '" + folder + "'"});
  EXPECT_FALSE(stream.IsValid());
}

TEST_F(dASCIIStreamFile, EmptyFileHasNothingToRead) {
  Write("");
  dASCIIStreamIn stream;
  EXPECT_FALSE(stream.Init(m_path.c_str(), 4));
  EXPECT_TRUE(stream.IsValid());
  char ch = '?';
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '\0');
  EXPECT_FALSE(stream.NextChar(&ch));
}

#if defined(__LP64__)
TEST_F(dASCIIStreamFile, BufferThatCannotBeHadIsAnError) {
  dASCIIStreamIn stream;
  EXPECT_FALSE(stream.Init(m_path.c_str(), 1UL << 40));
  EXPECT_STREQ(stream.GetStatus(),
               "dASCIIStreamIn::Init()  out of memory(1099511627784 bytes requested)");
  EXPECT_FALSE(stream.IsValid());
}
#endif

TEST_F(dASCIIStreamFile, CopiesShareTheFileUntilTheLastIsGone) {
  auto* first = new dASCIIStreamIn(m_path.c_str(), 4);
  dASCIIStreamIn second(*first);
  dASCIIStreamIn third;
  third = second;
  first->Reset();
  EXPECT_FALSE(first->IsValid());
  delete first;
  EXPECT_TRUE(second.IsValid());
  char last = 0;
  EXPECT_EQ(ReadAll(second, last), "0123456789");
  EXPECT_TRUE(third.SetPos(9));
}

TEST_F(dASCIIStreamFile, InitAgainForgetsTheFileBefore) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  EXPECT_TRUE(stream.Init("text"));
  EXPECT_FALSE(stream.IsValid());
  char ch = '?';
  EXPECT_FALSE(stream.GetChar(&ch));
}

TEST(dASCIIStreamIn, WithoutSourceNothingCanBeRead) {
  LogRecorder log;
  dASCIIStreamIn stream;
  EXPECT_FALSE(stream.IsValid());
  char ch = '?';
  EXPECT_FALSE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '\0');
  ch = '?';
  EXPECT_FALSE(stream.NextChar(&ch));
  EXPECT_EQ(ch, '\0');
  EXPECT_STREQ(stream.GetStatus(), "FillBuffer(): buffer not initialized");
  EXPECT_FALSE(stream.SetPos(0));
  EXPECT_EQ(log.errors, std::vector<std::string>(
                            2, "dASCIIStreamIn::FillBuffer: FillBuffer(): buffer not initialized"));
}

TEST(dASCIIStreamIn, NullStringIsRefused) {
  LogRecorder log;
  dASCIIStreamIn stream;
  EXPECT_FALSE(stream.Init(nullptr));
  EXPECT_STREQ(stream.GetStatus(), "given string is a 'NULL' pointer");
  EXPECT_EQ(log.errors,
            std::vector<std::string>{"dASCIIStreamIn::Init: given string is a 'NULL' pointer"});
}

TEST(dASCIIStreamIn, StringServesPositionedAccess) {
  dASCIIStreamIn stream("hello");
  EXPECT_FALSE(stream.IsValid());
  char out[16];
  EXPECT_TRUE(stream.GetString(1, 3, out));
  EXPECT_STREQ(out, "ell");
  EXPECT_TRUE(stream.GetString(0, 5, out));
  EXPECT_STREQ(out, "hello");
  char ch = '?';
  EXPECT_TRUE(stream.SetPos(4));
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, 'o');
  EXPECT_TRUE(stream.SetPos(5));
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '\0');
}

TEST(dASCIIStreamIn, StringRefusesPositionsOutside) {
  LogRecorder log;
  dASCIIStreamIn stream("hello");
  char out[16] = "?";
  EXPECT_FALSE(stream.GetString(2, 4, out));
  EXPECT_STREQ(out, "");
  EXPECT_STREQ(stream.GetStatus(), "GetString() invalid string pos: 2(length 4)");
  EXPECT_EQ(log.errors, std::vector<std::string>{
                            "dASCIIStreamIn::GetString: GetString() invalid string pos: 2(length "
                            "4)"});
  EXPECT_FALSE(stream.GetString(7, 0, out));
  EXPECT_FALSE(stream.GetString(1, ~0UL, out));
  EXPECT_FALSE(stream.SetPos(6));
}

TEST(dASCIIStreamIn, StringDoesNotServeReadingOn) {
  dASCIIStreamIn stream("hello");
  char ch = '?';
  EXPECT_FALSE(stream.NextChar(&ch));
  EXPECT_EQ(ch, '\0');
  EXPECT_STREQ(stream.GetStatus(), "FillBuffer(): source isn't a file");
  EXPECT_TRUE(stream.SetPos(1));
  EXPECT_FALSE(stream.NextChar(&ch));
}

TEST(dASCIIStreamIn, IsCreatedByItsRecord) {
  BaseClass* object = dASCIIStreamIn::CI().Create();
  ASSERT_NE(object, nullptr);
  EXPECT_STREQ(object->ClassName(), "dASCIIStreamIn");
  EXPECT_TRUE(object->CoversClass(BaseClass::CI().RTTID));
  EXPECT_FALSE(object->CoversClass(DataBase::CI().RTTID));
  object->Release();
}

}  // namespace
