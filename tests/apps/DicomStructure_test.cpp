#include "DicomEdit.h"
#include "TestFolder.h"
#include "TestStudies.h"

#include <gtest/gtest.h>
#include <study/DicomLoader.h>
#include <study/DicomWriter.h>

using namespace study;
using namespace study_test;

namespace {

constexpr char kTooDeep[] = "the file is damaged (sequences within sequences without end)";
constexpr char kBroken[] = "the file is damaged (its structure is broken)";

std::string Bytes32(std::uint32_t number) {
  std::string bytes;
  for (int i = 0; i < 4; ++i) {
    bytes += static_cast<char>(number >> (8 * i) & 0xFF);
  }
  return bytes;
}

/// The headers of one level: a sequence element and its item, of undefined length.
struct LevelBytes {
  std::string open;
  std::string close;
};

const std::string kUndefined(4, '\xFF');
const std::string kItem("\xFE\xFF\x00\xE0", 4);
const std::string kItemEnd("\xFE\xFF\x0D\xE0\0\0\0\0", 8);
const std::string kSequenceEnd("\xFE\xFF\xDD\xE0\0\0\0\0", 8);
const std::string kReferenced("\x08\x00\x40\x11", 4);  // ReferencedImageSequence

LevelBytes ExplicitLevel(const char* vr) {
  return {kReferenced + vr + std::string(2, '\0') + kUndefined + kItem + kUndefined,
          kItemEnd + kSequenceEnd};
}

LevelBytes ImplicitLevel() {
  return {kReferenced + kUndefined + kItem + kUndefined, kItemEnd + kSequenceEnd};
}

LevelBytes BigEndianLevel() {
  return {std::string("\x00\x08\x11\x40SQ\0\0", 8) + kUndefined +
              std::string("\xFF\xFE\xE0\x00", 4) + kUndefined,
          std::string("\xFF\xFE\xE0\x0D\0\0\0\0\xFF\xFE\xE0\xDD\0\0\0\0", 16)};
}

std::string Repeated(const std::string& text, int count) {
  std::string result;
  for (int i = 0; i < count; ++i) {
    result += text;
  }
  return result;
}

std::string Nested(const LevelBytes& level, int depth) {
  return Repeated(level.open, depth) + Repeated(level.close, depth);
}

/// The same with a defined length at every level.
std::string NestedWithLengths(int depth) {
  std::string inner;
  for (int i = 0; i < depth; ++i) {
    const std::string item = kItem + Bytes32(static_cast<std::uint32_t>(inner.size()));
    const auto length = static_cast<std::uint32_t>(item.size() + inner.size());
    inner = kReferenced + std::string("SQ\0\0", 4) + Bytes32(length) + item + inner;
  }
  return inner;
}

/// A small file, and what loading it with a piece put in says.
class DicomStructure : public testing::Test {
 protected:
  /// Puts `piece` in front of the image's group 0028.
  std::string LoadingSays(DicomEncoding encoding, const std::string& piece) {
    DicomWriteOptions options;
    options.encoding = encoding;
    options.intoExistingFolder = true;
    const fs::path file = WriteDicomSeries(*MakePatternStudy(4, 4, 1), m_folder / "in", options)[0];
    std::string bytes = ReadBytes(file);
    const std::string samples("\x28\0\2\0", 4);
    const std::string turned("\0\x28\0\2", 4);
    bytes.insert(bytes.find(encoding == DicomEncoding::ExplicitBig ? turned : samples), piece);
    WriteBytes(file, bytes);
    LoadReport report;
    const std::string text = ErrorOf([&] { LoadDicom({file}, "", report); });
    const std::string prefix = "'" + file.string() + "': ";
    return text.rfind(prefix, 0) == 0 ? text.substr(prefix.size()) : text;
  }

  TestFolder m_folder;
};

TEST_F(DicomStructure, OrdinaryNestingIsRead) {
  const DicomEncoding explicitLittle = DicomEncoding::ExplicitLittle;
  EXPECT_EQ(LoadingSays(explicitLittle, Nested(ExplicitLevel("SQ"), 20)), "no error");
  EXPECT_EQ(LoadingSays(explicitLittle, NestedWithLengths(20)), "no error");
  EXPECT_EQ(LoadingSays(DicomEncoding::ImplicitLittle, Nested(ImplicitLevel(), 20)), "no error");
  EXPECT_EQ(LoadingSays(DicomEncoding::ExplicitBig, Nested(BigEndianLevel(), 20)), "no error");
}

TEST_F(DicomStructure, ManyItemsSideBySideAreRead) {
  const std::string item = kItem + Bytes32(0);
  const std::string items = Repeated(item, 5000);
  EXPECT_EQ(LoadingSays(DicomEncoding::ExplicitLittle,
                        kReferenced + std::string("SQ\0\0", 4) +
                            Bytes32(static_cast<std::uint32_t>(items.size())) + items),
            "no error");
}

TEST_F(DicomStructure, EndlessNestingIsRefused) {
  for (const int depth : {65, 100000}) {
    EXPECT_EQ(LoadingSays(DicomEncoding::ExplicitLittle, Nested(ExplicitLevel("SQ"), depth)),
              kTooDeep);
    EXPECT_EQ(LoadingSays(DicomEncoding::ImplicitLittle, Nested(ImplicitLevel(), depth)), kTooDeep);
    EXPECT_EQ(LoadingSays(DicomEncoding::ExplicitBig, Nested(BigEndianLevel(), depth)), kTooDeep);
  }
}

TEST_F(DicomStructure, EndlessNestingWithLengthsIsRefused) {
  EXPECT_EQ(LoadingSays(DicomEncoding::ExplicitLittle, NestedWithLengths(2000)), kTooDeep);
}

TEST_F(DicomStructure, EndlessNestingInAnUnknownValueIsRefused) {
  const LevelBytes outer = ExplicitLevel("UN");
  EXPECT_EQ(LoadingSays(DicomEncoding::ExplicitLittle,
                        outer.open + Nested(ImplicitLevel(), 100000) + outer.close),
            kTooDeep);
}

TEST_F(DicomStructure, EndlessNestingThatIsNeverClosedIsRefused) {
  EXPECT_EQ(LoadingSays(DicomEncoding::ExplicitLittle, Repeated(ExplicitLevel("SQ").open, 100000)),
            kTooDeep);
}

TEST_F(DicomStructure, BrokenStructureWithManyItemsIsRefused) {
  // An element of a kind that does not exist hides the nesting from a walk by the rules.
  const std::string odd = std::string("\x08\x00\x01\x00ZZ\2\0..", 10);
  EXPECT_EQ(LoadingSays(DicomEncoding::ExplicitLittle, odd + Nested(ExplicitLevel("SQ"), 100000)),
            kBroken);
}

TEST_F(DicomStructure, NestingBehindAWrongHeaderLengthIsRefused) {
  const fs::path file = WriteDicomSeries(*MakePatternStudy(4, 4, 1), m_folder / "in")[0];
  std::string bytes = ReadBytes(file);
  bytes.insert(bytes.size(), Nested(ExplicitLevel("SQ"), 100000));
  bytes[140] = static_cast<char>(bytes[140] + 2);  // the length of the meta header
  WriteBytes(file, bytes);
  LoadReport report;
  EXPECT_EQ(ErrorOf([&] { LoadDicom({file}, "", report); }), "'" + file.string() + "': " + kBroken);
}

}  // namespace
