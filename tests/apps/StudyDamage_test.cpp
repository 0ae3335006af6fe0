#include "TestFolder.h"
#include "TestStudies.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <study/StudyFile.h>

#include <cstring>
#include <functional>

using namespace study;
using namespace study_test;
using testing::StartsWith;

namespace {

/// A good study file in memory, and damaged copies of it.
class StudyDamage : public testing::Test {
 protected:
  StudyDamage() {
    WriteStudyFile(*MakePatternStudy(3, 2, 2), m_folder / "good.bdf");
    m_good = ReadBytes(m_folder / "good.bdf");
  }

  /// What reading these bytes says after the file's name; "no error" when they are read.
  std::string ReadingSays(const std::string& bytes) {
    const fs::path path = m_folder / "bad.bdf";
    WriteBytes(path, bytes);
    const std::string text = ErrorOf([&] { ReadStudyFile(path); });
    const std::string prefix = "can't read '" + path.string() + "': ";
    return text.rfind(prefix, 0) == 0 ? text.substr(prefix.size()) : text;
  }

  /// The good file written anew from a study that `change` has worked on.
  std::string Changed(const std::function<void(std::string&)>& change) {
    std::string bytes = m_good;
    change(bytes);
    return bytes;
  }

  TestFolder m_folder;
  std::string m_good;
};

/// Replaces `count` bytes at the first place where `what` stands, `offset` bytes behind its start.
void Poke(std::string& bytes, const std::string& what, std::size_t offset,
          const std::string& value) {
  const std::size_t at = bytes.find(what);
  ASSERT_NE(at, std::string::npos);
  bytes.replace(at + offset, value.size(), value);
}

TEST_F(StudyDamage, TheGoodFileIsRead) {
  EXPECT_EQ(ReadingSays(m_good), "no error");
}

TEST_F(StudyDamage, CutAtEveryByteIsAnError) {
  for (std::size_t size = 0; size < m_good.size(); ++size) {
    const std::string text = ReadingSays(m_good.substr(0, size));
    ASSERT_TRUE(text == "the file ends too early or is damaged" ||
                text.rfind("the file is damaged (Error -2", 0) == 0)
        << size << ": " << text;
  }
}

TEST_F(StudyDamage, SomethingBehindTheEndIsAnError) {
  EXPECT_EQ(ReadingSays(m_good + '\0'), "something follows its end mark");
}

TEST_F(StudyDamage, EveryByteSetToEveryExtremeIsReadOrRefused) {
  // Values of pixels and numbers may change unseen; what must not happen is a crash, a hang or an
  // exception of another kind.
  int refused = 0;
  for (std::size_t at = 0; at < m_good.size(); ++at) {
    for (const int value : {0x00, 0x01, 0x7F, 0x80, 0xE4, 0xF4, 0xFF}) {
      std::string bytes = m_good;
      bytes[at] = static_cast<char>(value);
      refused += ReadingSays(bytes) != "no error" ? 1 : 0;
    }
  }
  EXPECT_GT(refused, 500);
}

TEST_F(StudyDamage, HugeLengthsAreRefusedWithoutMemory) {
  // Every length item in turn becomes 0xFFFFFFFF in the long form.
  int lengths = 0;
  for (std::size_t at = 0; at + 2 < m_good.size(); ++at) {
    if (static_cast<unsigned char>(m_good[at]) != 0xE1) {
      continue;
    }
    ++lengths;
    const std::string bytes = m_good.substr(0, at) + "\xE4\xFF\xFF\xFF\xFF" + m_good.substr(at + 2);
    EXPECT_NE(ReadingSays(bytes), "no error") << at;
  }
  // Three texts, coordinates of volume and slices, two images (name and pixels), the end mark.
  EXPECT_GE(lengths, 3 + 3 + 4 + 1);
}

TEST_F(StudyDamage, HugeImageIsRefusedWithoutMemory) {
  // The width of the first image: U32 items after the two S32 of the position.
  const std::string position("\6\0\0\0\0\6\0\0\0\0\5\3\0\0\0", 15);
  EXPECT_EQ(ReadingSays(Changed([&](std::string& bytes) {
              Poke(bytes, position, 11, std::string("\xFF\xFF\xFF\x7F", 4));
            })),
            "the file ends too early or is damaged");
}

TEST_F(StudyDamage, OtherFilesAreTold) {
  EXPECT_EQ(ReadingSays("hello, this is a text"), "it is no binary data file");
  EXPECT_EQ(ReadingSays(std::string("BDF\0Other\0", 10)),
            "it is a binary data file, but holds no study");
}

TEST_F(StudyDamage, UnknownVersionIsTold) {
  EXPECT_EQ(ReadingSays(Changed(
                [](std::string& bytes) { Poke(bytes, std::string("\5\1\0\0\0", 5), 1, "\2"); })),
            "its version 2 is not known");
}

TEST_F(StudyDamage, ImpossibleScalesAreRefused) {
  const std::string one("\x8\0\0\0\0\0\0\xF0\x3F", 9);
  const auto scaled = [&](const std::string& number) {
    return ReadingSays(Changed([&](std::string& bytes) { Poke(bytes, one, 1, number); }));
  };
  EXPECT_EQ(scaled(std::string("\0\0\0\0\0\0\0\0", 8)), "its scale is not greater than 0");
  EXPECT_EQ(scaled(std::string("\0\0\0\0\0\0\xF0\xBF", 8)), "its scale is not greater than 0");
  EXPECT_EQ(scaled(std::string("\0\0\0\0\0\0\xF8\x7F", 8)), "a number in it is not finite");
  EXPECT_EQ(scaled(std::string("\0\0\0\0\0\0\xF0\x7F", 8)), "a number in it is not finite");
}

TEST_F(StudyDamage, ImpossibleTextsAreRefused) {
  // "HU" is stored as length 3, tag 1, and three bytes.
  const std::string unit("\xE1\3\1HU\0", 6);
  const auto with = [&](std::size_t offset, const std::string& value) {
    return ReadingSays(Changed([&](std::string& bytes) { Poke(bytes, unit, offset, value); }));
  };
  EXPECT_EQ(with(5, "X"), "a text in it is not ended by a zero byte");
  EXPECT_EQ(with(3, std::string("\0", 1)), "a text in it is not ended by a zero byte");
  EXPECT_EQ(with(1, std::string("\0", 1)), "a text in it has an impossible length");
}

TEST_F(StudyDamage, FlatVoxelsAreRefused) {
  // The volume's x axis is (2, 0, 0): floats behind the origin (9, 18.5, 27.5).
  const std::string axis("\0\0\0\x40\0\0\0\0\0\0\0\0", 12);
  EXPECT_EQ(
      ReadingSays(Changed([&](std::string& bytes) { Poke(bytes, axis, 0, std::string(4, '\0')); })),
      "the voxels are too small or flat (more than 0.000001 cubic millimetres are needed)");
}

TEST_F(StudyDamage, ImpossibleNumbersOfSlicesAreRefused) {
  // The number of slices stands right before the first block (identifier 0).
  const std::string count("\5\2\0\0\0\xF1\0", 7);
  const auto with = [&](const std::string& value) {
    return ReadingSays(Changed([&](std::string& bytes) { Poke(bytes, count, 1, value); }));
  };
  EXPECT_EQ(with(std::string(4, '\0')), "it has an impossible number of slices");
  EXPECT_EQ(with("\xFF\xFF\xFF\xFF"), "it has an impossible number of slices");
  EXPECT_THAT(with(std::string("\3\0\0\0", 4)), StartsWith("the file is damaged"));
}

}  // namespace
