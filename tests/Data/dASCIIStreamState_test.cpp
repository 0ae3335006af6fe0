// What a text stream keeps from one call to the next, and what it does with impossible parameters.

#include <vorl/Data/dASCIIStream.h>

#include <gtest/gtest.h>

#include <string>
#include <vector>

#if !defined(_WIN32)
#include <sys/stat.h>
#include <unistd.h>
#endif

#include "../Support/LogRecorder.h"
#include "TextFile.h"

namespace {

class dASCIIStreamState : public TextFile {};

/// Opens what is protected.
class OpenStream : public dASCIIStreamIn {
 public:
  using dASCIIStreamIn::CheckFile;
  using dASCIIStreamIn::dASCIIStreamIn;
  using dASCIIStreamIn::FillBuffer;
};

TEST_F(dASCIIStreamState, StringAfterAFileServesNoCharacters) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  ASSERT_TRUE(stream.Init("text"));
  char ch = '?';
  EXPECT_FALSE(stream.NextChar(&ch));
  EXPECT_EQ(ch, '\0');
  EXPECT_STREQ(stream.GetStatus(), "FillBuffer(): source isn't a file");
}

TEST_F(dASCIIStreamState, StringAfterAFileBeginsAtItsFirstCharacter) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  ASSERT_TRUE(stream.SetPos(7));
  ASSERT_TRUE(stream.Init("text"));
  char out[8];
  EXPECT_TRUE(stream.GetString(0, 4, out));
  EXPECT_STREQ(out, "text");
}

TEST_F(dASCIIStreamState, ResetLeavesNoPositionToMoveTo) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  stream.Reset();
  EXPECT_FALSE(stream.SetPos(0));
  EXPECT_STREQ(stream.GetStatus(), "FillBuffer(): buffer not initialized");
}

TEST_F(dASCIIStreamState, FailedInitForgetsTheFileBefore) {
  const std::string missing = m_path + ".missing";
  dASCIIStreamIn stream;
  const auto expectEmpty = [&stream] {
    char ch = '?';
    EXPECT_FALSE(stream.IsValid());
    EXPECT_FALSE(stream.GetChar(&ch));
    EXPECT_FALSE(stream.SetPos(0));
  };
  ASSERT_TRUE(stream.Init(m_path.c_str(), 4));
  EXPECT_FALSE(stream.Init(nullptr));
  expectEmpty();
  ASSERT_TRUE(stream.Init(m_path.c_str(), 4));
  EXPECT_FALSE(stream.Init(m_path.c_str(), 0));
  expectEmpty();
  ASSERT_TRUE(stream.Init(m_path.c_str(), 4));
  EXPECT_FALSE(stream.Init(missing.c_str(), 4));
  expectEmpty();
}

TEST_F(dASCIIStreamState, CopiesCarryTheStatusAndResetKeepsIt) {
  dASCIIStreamIn stream;
  ASSERT_FALSE(stream.Init(nullptr));
  dASCIIStreamIn copy(stream);
  dASCIIStreamIn assigned(m_path.c_str(), 4);
  assigned = stream;
  for (dASCIIStreamIn* other : {&copy, &assigned, &stream}) {
    other->Reset();
    EXPECT_EQ(static_cast<long>(other->GetStatus()), -1);
    EXPECT_STREQ(other->GetStatus(), "given string is a 'NULL' pointer");
  }
}

TEST_F(dASCIIStreamState, GetCharWhereNothingCouldBeReadIsZero) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  ASSERT_FALSE(stream.SetPos(20));
  char ch = '?';
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '\0');
}

// The file has grown since.
TEST_F(dASCIIStreamState, ReadingGoesOnFromWhereNothingCouldBeRead) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  ASSERT_FALSE(stream.SetPos(150));
  char ch = '?';
  EXPECT_FALSE(stream.NextChar(&ch));
  std::string content(150, '-');
  Write(content.append("abcdef"));
  std::string text;
  for (int i = 0; i < 10 && stream.NextChar(&ch); ++i) {
    text += ch;
  }
  EXPECT_EQ(text, "abcdef");
}

TEST_F(dASCIIStreamState, GetStringKeepsTheCurrentPosition) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  char ch = '?';
  char out[8];
  std::string text;
  for (int i = 0; i < 10; ++i) {
    ASSERT_TRUE(stream.GetString(6, 2, out));
    ASSERT_TRUE(stream.GetString(1, 2, out));
    ASSERT_TRUE(stream.NextChar(&ch));
    text += ch;
  }
  EXPECT_EQ(text, "0123456789");
}

TEST_F(dASCIIStreamState, SetPosInsideTheBufferDoesNotReadTheFileAgain) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  Write("abcdefghij");
  char ch = '?';
  EXPECT_TRUE(stream.SetPos(3));
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '3');
  EXPECT_TRUE(stream.SetPos(4));
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, 'e');
}

TEST_F(dASCIIStreamState, NextCharReadsTheFileAtEveryEndOfTheBuffer) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  std::string text;
  for (const char* content : {"abcdefghij", "ABCDEFGHIJ", "klmnopqrst"}) {
    Write(content);
    char ch = '?';
    for (int i = 0; i < 4 && stream.NextChar(&ch); ++i) {
      text += ch;
    }
  }
  EXPECT_EQ(text, "0123EFGHst");
}

TEST_F(dASCIIStreamState, SuccessfulInitClearsTheStatus) {
  dASCIIStreamIn stream;
  ASSERT_FALSE(stream.Init(nullptr));
  EXPECT_TRUE(stream.Init("text"));
  EXPECT_EQ(static_cast<long>(stream.GetStatus()), 0);
  ASSERT_FALSE(stream.Init(nullptr));
  EXPECT_TRUE(stream.Init(m_path.c_str(), 4));
  EXPECT_EQ(static_cast<long>(stream.GetStatus()), 0);
}

TEST_F(dASCIIStreamState, EveryFailureIsLogged) {
  LogRecorder log;
  dASCIIStreamIn stream("text");
  char ch = '?';
  stream.NextChar(&ch);
  EXPECT_EQ(log.errors, std::vector<std::string>{
                            "dASCIIStreamIn::FillBuffer: FillBuffer(): source isn't a file"});
#if defined(__LP64__)
  log.errors.clear();
  stream.Init(m_path.c_str(), 1UL << 40);
  EXPECT_EQ(log.errors,
            std::vector<std::string>{"dASCIIStreamIn::Init: dASCIIStreamIn::Init()  out of "
                                     "memory(1099511627784 bytes requested)"});
#endif
}

TEST_F(dASCIIStreamState, NullPointersAreRefusedAndTakeNothing) {
  dASCIIStreamIn stream(m_path.c_str(), 4);
  LogRecorder log;
  EXPECT_FALSE(stream.NextChar(nullptr));
  EXPECT_STREQ(stream.GetStatus(), "invalid parameter");
  EXPECT_FALSE(stream.GetString(0, 2, nullptr));
  EXPECT_FALSE(stream.GetChar(nullptr));
  EXPECT_EQ(log.errors, (std::vector<std::string>{"dASCIIStreamIn::NextChar: invalid parameter",
                                                  "dASCIIStreamIn::GetString: invalid parameter"}));
  char ch = '?';
  EXPECT_TRUE(stream.NextChar(&ch));
  EXPECT_EQ(ch, '0');
}

TEST_F(dASCIIStreamState, DerivedStreamsCheckAndFillForThemselves) {
  LogRecorder log;
  OpenStream stream(m_path.c_str(), 4);
  EXPECT_TRUE(stream.CheckFile(m_path.c_str()));
  EXPECT_FALSE(stream.CheckFile(nullptr));
  EXPECT_STREQ(stream.GetStatus(), "given file name is 'NULL' or empty");
  EXPECT_EQ(log.errors, std::vector<std::string>{
                            "dASCIIStreamIn::CheckFile: given file name is 'NULL' or empty"});
  char ch = '?';
  EXPECT_TRUE(stream.FillBuffer(8));
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '8');
  EXPECT_TRUE(stream.FillBuffer(5, &ch));
  EXPECT_EQ(ch, '5');
  EXPECT_TRUE(stream.GetChar(&ch));
  EXPECT_EQ(ch, '6');
  EXPECT_FALSE(stream.FillBuffer(10, &ch));
  EXPECT_EQ(ch, '\0');
  EXPECT_TRUE(stream.FillBuffer(5, nullptr));
  EXPECT_FALSE(stream.FillBuffer(10, nullptr));
}

#if !defined(_WIN32)
// Opening a pipe would wait for somebody to write into it.
TEST_F(dASCIIStreamState, PipesAreNotWaitedFor) {
  const std::string pipe = m_path + ".pipe";
  ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
  dASCIIStreamIn stream;
  EXPECT_FALSE(stream.Init(pipe.c_str(), 4));
  EXPECT_STREQ(stream.GetStatus(), ("can't to open '" + pipe + "'").c_str());
  std::filesystem::remove(pipe);
}

/// The superuser may read every file; for as long as this lives, it is a user who may not.
class PlainUser {
 public:
  PlainUser() : m_wasRoot(getuid() == 0) {
    if (m_wasRoot) {
      constexpr uid_t kNobody = 65534;
      EXPECT_EQ(setresuid(kNobody, kNobody, 0), 0);
    }
  }
  ~PlainUser() {
    if (m_wasRoot) {
      EXPECT_EQ(setresuid(0, 0, 0), 0);
    }
  }

 private:
  bool m_wasRoot;
};

TEST_F(dASCIIStreamState, FileWithoutReadPermissionIsNamed) {
  std::filesystem::permissions(m_path, std::filesystem::perms::none);
  LogRecorder log;
  dASCIIStreamIn stream;
  {
    const PlainUser user;
    EXPECT_FALSE(stream.Init(m_path.c_str(), 4));
  }
  EXPECT_STREQ(stream.GetStatus(), ("no read permission for '" + m_path + "'").c_str());
  EXPECT_EQ(log.errors, std::vector<std::string>{"dASCIIStreamIn::CheckFile: no read permission "
                                                 "for '" +
                                                 m_path + "'"});
}
#endif

}  // namespace
