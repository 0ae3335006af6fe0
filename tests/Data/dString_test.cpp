#include <vorl/Data/dString.h>

#include <gtest/gtest.h>

#include <cstring>
#include <memory>
#include <string>

#include "../Support/LogRecorder.h"

namespace {

/// Opens what derived classes may call.
class OpenString : public dString {
 public:
  using dString::Append;
  using dString::dString;
  using dString::New;
};

/// A string that refers to the shared empty text, of which not a byte has changed.
void ExpectSharedEmpty(dString& text) {
  EXPECT_EQ(text.Size(), 0u);
  EXPECT_EQ(text.GetSize(), 1u);
  EXPECT_TRUE(text.IsEmpty());
  EXPECT_TRUE(text.IsReference());
  EXPECT_TRUE(text.IsValid());
  EXPECT_EQ(text.Get(0), dString().Get(0));
  EXPECT_EQ(*static_cast<const char*>(text.Get(0)), '\0');
}

void ExpectOwns(dString& text, const std::string& expected) {
  EXPECT_EQ(text.Size(), expected.size());
  EXPECT_EQ(text.GetSize(), expected.size() + 1);
  EXPECT_FALSE(text.IsReference());
  ASSERT_EQ(std::memcmp(text.Get(0), expected.c_str(), expected.size() + 1), 0);
}

TEST(dString, IsRegisteredUnderItsNameBelowdBuffer) {
  EXPECT_STREQ(dString::CI().name, "dString");
  EXPECT_EQ(dString::CI().parents[0], &dBuffer::CI());
  const std::unique_ptr<dString> created(dString::Create());
  EXPECT_EQ(created->GetClassInfo(), &dString::CI());
  ExpectSharedEmpty(*created);
}

TEST(dString, StartsAsTheSharedEmptyString) {
  dString text;
  ExpectSharedEmpty(text);
}

TEST(dString, RoomForCharactersIsNoLength) {
  dString text(10);
  EXPECT_EQ(text.Size(), 0u);
  EXPECT_EQ(text.GetSize(), 1u);
  EXPECT_EQ(text.GetCapacity(), 16u);
  EXPECT_TRUE(text.IsEmpty());
  EXPECT_FALSE(text.IsReference());
  EXPECT_EQ(dString(7u).GetCapacity(), 8u);
  EXPECT_EQ(dString(8u).GetCapacity(), 16u);
}

TEST(dString, RoomForNothingIsTheSharedEmptyString) {
  dString none(0u);
  ExpectSharedEmpty(none);
  dString zero(0);
  ExpectSharedEmpty(zero);
  dString negative(-1);
  ExpectSharedEmpty(negative);
}

TEST(dString, InitForgetsTheText) {
  dString text("abc");
  EXPECT_TRUE(text.Init(20));
  EXPECT_EQ(text.GetCapacity(), 24u);
  EXPECT_TRUE(text.IsEmpty());
  text = "abc";
  EXPECT_TRUE(text.Init());
  ExpectSharedEmpty(text);
  text = "abc";
  EXPECT_TRUE(text.Init(0));
  ExpectSharedEmpty(text);
  text = "abc";
  text.Reset();
  ExpectSharedEmpty(text);
}

TEST(dString, InitOfTheLargestCapacityFailsAsAnAllocation) {
  dString text("abc");
  LogRecorder log;
  EXPECT_TRUE(text.Init(0xFFFFFFFFu));
  ExpectSharedEmpty(text);
  EXPECT_EQ(log.errors.size(), 1u);
  EXPECT_EQ(log.errors[0], "dBuffer::New: can't allocate 4294967296 bytes");
}

TEST(dString, CopiesTexts) {
  const char* constant = "abc";
  dString fromConstant(constant);
  ExpectOwns(fromConstant, "abc");
  char variable[] = "de";
  dString fromVariable(variable);
  ExpectOwns(fromVariable, "de");
  variable[0] = 'x';
  EXPECT_TRUE(fromVariable == "de");
  dString fromString(fromConstant);
  ExpectOwns(fromString, "abc");
  EXPECT_NE(fromString.Get(0), fromConstant.Get(0));
}

TEST(dString, NullAndEmptyTextsGiveTheSharedEmptyString) {
  dString fromNull(nullptr);
  ExpectSharedEmpty(fromNull);
  dString fromNothing("");
  ExpectSharedEmpty(fromNothing);
  dString text("abc");
  text = static_cast<const char*>(nullptr);
  ExpectSharedEmpty(text);
  text = "abc";
  text = dString();
  ExpectSharedEmpty(text);
}

TEST(dString, AssignmentReplacesTheText) {
  dString text("abc");
  text = "a longer text than before";
  ExpectOwns(text, "a longer text than before");
  text = dString("xy");
  ExpectOwns(text, "xy");
  const dString& same = text;
  text = same;
  ExpectOwns(text, "xy");
}

TEST(dString, AssignmentFromWithinItselfKeepsThatPart) {
  dString text("abcdefgh");
  text = text.GetText() + 5;
  ExpectOwns(text, "fgh");
}

TEST(dString, AssignmentOfACharacter) {
  dString text("abc");
  text = 'q';
  ExpectOwns(text, "q");
  text = '\0';
  ExpectSharedEmpty(text);
}

TEST(dString, AppendingToAnEmptyStringOwnsABlock) {
  dString text;
  text += "ab";
  ExpectOwns(text, "ab");
  EXPECT_EQ(*static_cast<const char*>(dString().Get(0)), '\0');
  text += dString("cd");
  ExpectOwns(text, "abcd");
  text += 'e';
  ExpectOwns(text, "abcde");
}

TEST(dString, AppendingNothingChangesNothing) {
  dString text("ab");
  text += static_cast<const char*>(nullptr);
  text += "";
  text += dString();
  ExpectOwns(text, "ab");
  dString empty;
  empty += dString();
  ExpectSharedEmpty(empty);
}

TEST(dString, AppendsItself) {
  dString text("0123456");
  text += text;
  ExpectOwns(text, "01234560123456");
  text += text.GetText() + 10;
  ExpectOwns(text, "012345601234563456");
}

TEST(dString, TenReservedCharactersGoInPlace) {
  dString text(10);
  void* const block = text.Get(0);
  for (char c = '0'; c <= '9'; ++c) {
    text += c;
    EXPECT_EQ(text.Get(0), block);
  }
  ExpectOwns(text, "0123456789");
  EXPECT_EQ(text.GetCapacity(), 16u);
}

TEST(dString, CharactersBeyondTheRoomGoToALargerBlock) {
  dString text;
  std::string expected;
  for (int i = 0; i < 40; ++i) {
    text += static_cast<char>('a' + i % 26);
    expected += static_cast<char>('a' + i % 26);
    ExpectOwns(text, expected);
  }
}

TEST(dString, AppendOfTooMuchGivesTheEmptyString) {
  OpenString text("abc");
  LogRecorder log;
  text.Append("x", 0xFFFFFFF0ul);  // fails before the text is read
  ExpectSharedEmpty(text);
  EXPECT_EQ(log.errors.size(), 1u);
}

TEST(dString, AppendTakesTheGivenCount) {
  OpenString text("abc");
  text.Append("defg", 2);
  ExpectOwns(text, "abcde");
  text.Append("x", 0);
  text.Append(nullptr, 3);
  ExpectOwns(text, "abcde");
}

TEST(dString, NewGivesAFreshBlockOrTheSharedEmptyString) {
  OpenString text("abc");
  const char* const characters = text.New(12ul);
  EXPECT_EQ(characters, text.Get(0));
  EXPECT_EQ(text.GetSize(), 13u);
  EXPECT_EQ(characters[0], '\0');
  EXPECT_EQ(text.New(0ul), dString().Get(0));
  EXPECT_EQ(text.New(~0ul), dString().Get(0));
  EXPECT_STREQ(text.New("xyz"), "xyz");
  EXPECT_STREQ(text.New(dString("uv")), "uv");
}

TEST(dString, IndexGivesCharactersAndTheTerminator) {
  dString text("abc");
  EXPECT_EQ(text[0], 'a');
  EXPECT_EQ(text[2], 'c');
  EXPECT_EQ(text[3], '\0');
  EXPECT_EQ(&text[3], static_cast<char*>(text.Get(3)));
  text[1] = 'x';
  EXPECT_TRUE(text == "axc");
  const dString& constant = text;
  EXPECT_EQ(constant[1], 'x');
}

TEST(dString, IndexOutOfRangeGivesAZeroByteThatIsNobodys) {
  dString text("abc");
  dString empty;
  EXPECT_EQ(text[-1], '\0');
  EXPECT_EQ(text[4], '\0');
  EXPECT_EQ(&text[4], &empty[0]);
  text[4] = 'x';
  empty[0] = 'y';
  EXPECT_EQ(text[-1], '\0');
  EXPECT_EQ(empty[0], '\0');
  EXPECT_TRUE(text == "abc");
  ExpectSharedEmpty(empty);
  const dString& constant = text;
  EXPECT_EQ(constant[-1], '\0');
  EXPECT_EQ(constant[4], '\0');
}

TEST(dString, AStringThatBeginsWithZeroIsEmpty) {
  dString text("abc");
  EXPECT_FALSE(text.IsEmpty());
  text[0] = '\0';
  EXPECT_TRUE(text.IsEmpty());
  EXPECT_EQ(text.Size(), 3u);
}

TEST(dString, CaseConversionKnowsAsciiLettersOnly) {
  dString text("@AMZ[`amz{\xC4\xE4 9");
  text.ToLowerCase();
  EXPECT_STREQ(text.GetText(), "@amz[`amz{\xC4\xE4 9");
  text.ToUpperCase();
  EXPECT_STREQ(text.GetText(), "@AMZ[`AMZ{\xC4\xE4 9");
}

TEST(dString, CaseConversionStopsAtTheFirstZeroByte) {
  dString text("ab.cd");
  text[2] = '\0';
  text.ToUpperCase();
  EXPECT_EQ(std::memcmp(text.Get(0), "AB\0cd", 6), 0);
  dString empty;
  empty.ToLowerCase();
  ExpectSharedEmpty(empty);
}

/// All six comparisons of `a` with the text `b`, in both forms, against their order (-1, 0, 1).
void ExpectOrder(const char* a, const char* b, int order) {
  const dString left(a);
  const dString right(b);
  EXPECT_EQ(left == right, order == 0) << a << " " << b;
  EXPECT_EQ(left != right, order != 0) << a << " " << b;
  EXPECT_EQ(left < right, order < 0) << a << " " << b;
  EXPECT_EQ(left <= right, order <= 0) << a << " " << b;
  EXPECT_EQ(left > right, order > 0) << a << " " << b;
  EXPECT_EQ(left >= right, order >= 0) << a << " " << b;
  EXPECT_EQ(left == b, order == 0) << a << " " << b;
  EXPECT_EQ(left != b, order != 0) << a << " " << b;
  EXPECT_EQ(left < b, order < 0) << a << " " << b;
  EXPECT_EQ(left <= b, order <= 0) << a << " " << b;
  EXPECT_EQ(left > b, order > 0) << a << " " << b;
  EXPECT_EQ(left >= b, order >= 0) << a << " " << b;
}

TEST(dString, ComparesBytesAsUnsignedCharacters) {
  ExpectOrder("abc", "abc", 0);
  ExpectOrder("", "", 0);
  ExpectOrder("abc", "abd", -1);
  ExpectOrder("b", "abc", 1);
  ExpectOrder("ab", "abc", -1);
  ExpectOrder("abc", "ab", 1);
  ExpectOrder("", "a", -1);
  ExpectOrder("a", "", 1);
  ExpectOrder("\xC4", "z", 1);  // 0xC4 counts as 196
  ExpectOrder("\x01", "", 1);
}

TEST(dString, NullComparesAsTheEmptyString) {
  const char* const null = nullptr;
  const dString empty;
  EXPECT_TRUE(empty == null);
  EXPECT_FALSE(empty != null);
  EXPECT_FALSE(empty < null);
  EXPECT_TRUE(empty <= null);
  EXPECT_FALSE(empty > null);
  EXPECT_TRUE(empty >= null);
  const dString text("a");
  EXPECT_FALSE(text == null);
  EXPECT_TRUE(text != null);
  EXPECT_FALSE(text < null);
  EXPECT_FALSE(text <= null);
  EXPECT_TRUE(text > null);
  EXPECT_TRUE(text >= null);
}

TEST(dString, ComparisonsEndAtAZeroByteInside) {
  dString text("ab.cd");
  text[2] = '\0';
  EXPECT_TRUE(text == "ab");
  EXPECT_TRUE(text == dString("ab"));
}

TEST(dString, BufferFunctionsCannotMakeAStringUnsafe) {
  dString text("abc");
  text.Delete();
  EXPECT_EQ(text.Size(), 0u);
  EXPECT_STREQ(text.GetText(), "");
  EXPECT_TRUE(text.IsEmpty());
  EXPECT_FALSE(text.IsValid());
  EXPECT_EQ(text[0], '\0');
  EXPECT_TRUE(text == "");
  text.ToUpperCase();
  dString copy(text);
  ExpectSharedEmpty(copy);
  text += 'x';
  ExpectOwns(text, "x");

  text.Resize(0);
  EXPECT_EQ(text.Size(), 0u);
  EXPECT_TRUE(text.IsEmpty());
  text += "yz";
  ExpectOwns(text, "yz");
}

TEST(dString, ComparisonsOfATextWithoutTerminatorStayInside) {
  dString text("1234567");
  dBuffer& bytes = text;
  bytes.Set(static_cast<unsigned char>('a'));  // the block of eight bytes holds no zero any more
  EXPECT_TRUE(text == "aaaaaaaa");
  EXPECT_FALSE(text.IsEmpty());
  text.ToUpperCase();
  EXPECT_TRUE(text == "AAAAAAAA");
}

}  // namespace
