#include <vorl/Data/dString.h>

#include <algorithm>
#include <cstddef>
#include <cstring>
#include <limits>
#include <string_view>

#include <vorl/Common/detail/ClassRegistration.h>

inline namespace vorl {

namespace {

constexpr unsigned long kMaxLength = std::numeric_limits<unsigned long>::max();

// Every empty string refers to this byte; a constant lies in memory that cannot be written.
constexpr char kEmptyText[1] = {'\0'};

unsigned long LengthOf(const char* text) {
  const std::size_t length = text != nullptr ? std::strlen(text) : 0;
  return static_cast<unsigned long>(std::min<unsigned long long>(length, kMaxLength));
}

// The sum, or the largest number, which no allocation can meet.
unsigned long CappedSum(unsigned long a, unsigned long b) {
  return b > kMaxLength - a ? kMaxLength : a + b;
}

// The text as comparisons see it. The bound matters for a string whose terminator was overwritten
// through the buffer's own functions.
std::string_view Comparable(const dString& text) {
  const char* const characters = text.GetText();
  const void* const end = std::memchr(characters, '\0', text.GetSize());
  const std::size_t length =
      end != nullptr ? static_cast<std::size_t>(static_cast<const char*>(end) - characters)
                     : text.GetSize();
  return {characters, length};
}

std::string_view Comparable(const char* text) {
  return text != nullptr ? std::string_view(text) : std::string_view();
}

int Compare(std::string_view a, std::string_view b) {
  return a.compare(b);  // as unsigned characters; a text comes before its continuations
}

// Adds `offset` to the characters from `first` to `last`, up to the first zero byte.
void ConvertLetters(dString& text, char first, char last, int offset) {
  char* const characters = static_cast<char*>(text.Get(0));
  const std::size_t length = Comparable(text).size();
  for (std::size_t i = 0; i < length; ++i) {
    if (characters[i] >= first && characters[i] <= last) {
      characters[i] = static_cast<char>(characters[i] + offset);
    }
  }
}

}  // namespace

VORL_REGISTER_CLASS(dString, dBuffer);

dString::dString() {
  Init();
}

dString::dString(unsigned int capacity) {
  Init(capacity);
}

dString::dString(int capacity) : dString(static_cast<unsigned int>(std::max(capacity, 0))) {}

dString::dString(const char* text) {
  New(text);
}

dString::dString(const dString& source) : dBuffer() {
  New(source);
}

dString& dString::operator=(const dString& source) {
  if (this != &source) {
    New(source);
  }
  return *this;
}

dString& dString::operator=(const char* text) {
  New(text);
  return *this;
}

dString& dString::operator=(char c) {
  const char text[2] = {c, '\0'};
  New(text);
  return *this;
}

dString::~dString() = default;

void dString::Reset() {
  Init();
}

bool dString::IsValid() {
  return Get(0) != nullptr;
}

bool dString::Init(unsigned int capacity) {
  New(static_cast<unsigned long>(capacity));
  if (!IsReference()) {
    dBuffer::New(1, false);
  }
  return IsValid();
}

bool dString::Init() {
  Delete();
  dBuffer::Init(const_cast<char*>(kEmptyText), sizeof kEmptyText, DTM_Reference);
  return true;
}

bool dString::IsEmpty() {
  return Comparable(*this).empty();
}

dString& dString::operator+=(const dString& other) {
  Append(other.GetText(), other.Size());
  return *this;
}

dString& dString::operator+=(const char* text) {
  Append(text, LengthOf(text));
  return *this;
}

dString& dString::operator+=(char c) {
  const unsigned long size = GetSize();
  if (size == 0 || size >= GetCapacity()) {
    Append(&c, 1);
    return *this;
  }
  dBuffer::New(size + 1, false);
  char* const characters = Characters();
  characters[size - 1] = c;
  characters[size] = '\0';
  return *this;
}

char& dString::operator[](int i) {
  char* const characters = Characters();
  if (i >= 0 && static_cast<unsigned long>(i) < GetSize() && characters != kEmptyText) {
    return characters[i];
  }
  // Stands in for the shared byte, so that a careless write cannot reach other strings.
  thread_local char nobodysByte;
  nobodysByte = '\0';
  return nobodysByte;
}

const char& dString::operator[](int i) const {
  return i >= 0 && static_cast<unsigned long>(i) < GetSize() ? Characters()[i] : kEmptyText[0];
}

unsigned int dString::Size() const {
  const unsigned long size = GetSize();
  return static_cast<unsigned int>(size > 0 ? size - 1 : 0);
}

const char* dString::GetText() const {
  const char* const characters = Characters();
  return characters != nullptr ? characters : kEmptyText;
}

void dString::ToLowerCase() {
  ConvertLetters(*this, 'A', 'Z', 'a' - 'A');
}

void dString::ToUpperCase() {
  ConvertLetters(*this, 'a', 'z', 'A' - 'a');
}

bool dString::operator==(const dString& other) const {
  return Compare(Comparable(*this), Comparable(other)) == 0;
}
bool dString::operator==(const char* text) const {
  return Compare(Comparable(*this), Comparable(text)) == 0;
}
bool dString::operator!=(const dString& other) const {
  return Compare(Comparable(*this), Comparable(other)) != 0;
}
bool dString::operator!=(const char* text) const {
  return Compare(Comparable(*this), Comparable(text)) != 0;
}
bool dString::operator<(const dString& other) const {
  return Compare(Comparable(*this), Comparable(other)) < 0;
}
bool dString::operator<(const char* text) const {
  return Compare(Comparable(*this), Comparable(text)) < 0;
}
bool dString::operator<=(const dString& other) const {
  return Compare(Comparable(*this), Comparable(other)) <= 0;
}
bool dString::operator<=(const char* text) const {
  return Compare(Comparable(*this), Comparable(text)) <= 0;
}
bool dString::operator>(const dString& other) const {
  return Compare(Comparable(*this), Comparable(other)) > 0;
}
bool dString::operator>(const char* text) const {
  return Compare(Comparable(*this), Comparable(text)) > 0;
}
bool dString::operator>=(const dString& other) const {
  return Compare(Comparable(*this), Comparable(other)) >= 0;
}
bool dString::operator>=(const char* text) const {
  return Compare(Comparable(*this), Comparable(text)) >= 0;
}

char* dString::New(unsigned long length) {
  Delete();
  if (length > 0) {
    dBuffer::New(CappedSum(length, 1), false);
  }
  if (Characters() == nullptr) {
    Init();
  } else {
    *Characters() = '\0';
  }
  return Characters();
}

char* dString::New(const char* text) {
  return CopyText(text, LengthOf(text));
}

char* dString::New(const dString& source) {
  return CopyText(source.GetText(), source.Size());
}

void dString::Append(const char* text, unsigned long count) {
  if (text == nullptr || count == 0) {
    return;
  }
  if (GetSize() == 0) {
    Init();
  }
  const unsigned long size = GetSize();
  const bool isOwnText = OwnsAddress(text);
  const std::ptrdiff_t ownOffset = isOwnText ? text - Characters() : 0;
  Resize(CappedSum(size, count));
  if (Characters() == nullptr) {
    Init();
    return;
  }
  std::memmove(Characters() + size - 1, isOwnText ? Characters() + ownOffset : text, count);
}

char* dString::Characters() const {
  return static_cast<char*>(Get(0));
}

// Copies the text, which may lie in the string's own block, and terminates it.
char* dString::CopyText(const char* text, unsigned long length) {
  dBuffer oldBlock;
  oldBlock <<= *this;
  char* const characters = New(length);
  if (!IsReference()) {
    std::memcpy(characters, text, length);
    characters[length] = '\0';
  }
  return characters;
}

}  // namespace vorl
