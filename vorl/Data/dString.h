#ifndef VORL_DATA_DSTRING_H
#define VORL_DATA_DSTRING_H

/// @file
/// The character string of the library.

#include <vorl/Data/dBuffer.h>

inline namespace vorl {

/// Characters and a terminating zero byte in a buffer: a string of length n has the buffer size
/// n + 1. An empty string owns nothing; it refers to one zero byte that all empty strings of the
/// process share and that cannot be written.
///
/// Comparisons are byte by byte, as unsigned characters, up to the first difference or zero byte;
/// case conversion knows ASCII only. Only allocation can fail: it is reported through the log (see
/// `dBuffer`) and leaves the empty string. Arguments may point into the string itself.
class VORL_API dString : public dBuffer {
 public:
  /// The empty string.
  dString();
  /// `Init(capacity)`: an empty string with room for so many characters.
  explicit dString(unsigned int capacity);
  /// As above; a negative number counts as 0.
  explicit dString(int capacity);
  /// A copy of the text; null gives the empty string.
  dString(const char* text);
  dString(const dString& source);
  dString& operator=(const dString& source);
  /// Replaces the text with a copy; null gives the empty string.
  dString& operator=(const char* text);
  /// The string of one character; the empty string when `c` is zero.
  dString& operator=(char c);

  ClassInfo* GetClassInfo() override;
  ~dString() override;
  /// Becomes the empty string.
  void Reset() override;
  /// True when the string has data, which it always has unless a `dBuffer` function took it away.
  bool IsValid() override;
  /// Becomes an empty string with room for `capacity` characters; for 0 the shared empty string.
  /// Returns whether the string has data.
  virtual bool Init(unsigned int capacity);
  /// Becomes the shared empty string; returns true.
  virtual bool Init();
  /// True when the first character is zero.
  virtual bool IsEmpty();

  static dString* Create();
  static ClassInfo& CI();

  /// Appends the other string's characters.
  dString& operator+=(const dString& other);
  /// Appends the text; null changes nothing.
  dString& operator+=(const char* text);
  /// Appends one character; without allocation while the string's own block has room.
  dString& operator+=(char c);

  /// The character at `i`; the length itself gives the terminator. Any other index, and the
  /// terminator of an empty string, give a zero byte that is nobody's: what is written to it is
  /// lost.
  char& operator[](int i);
  const char& operator[](int i) const;
  /// The length: the buffer size without the terminator.
  unsigned int Size() const;
  /// The text, never null; valid until the string changes.
  const char* GetText() const;

  /// Converts A to Z to lower case, up to the first zero byte; other bytes stay.
  void ToLowerCase();
  /// Converts a to z to upper case, up to the first zero byte; other bytes stay.
  void ToUpperCase();

  /// Comparisons; a null text compares as the empty string.
  bool operator==(const dString& other) const;
  bool operator==(const char* text) const;
  bool operator!=(const dString& other) const;
  bool operator!=(const char* text) const;
  bool operator<(const dString& other) const;
  bool operator<(const char* text) const;
  bool operator<=(const dString& other) const;
  bool operator<=(const char* text) const;
  bool operator>(const dString& other) const;
  bool operator>(const char* text) const;
  bool operator>=(const dString& other) const;
  bool operator>=(const char* text) const;

 protected:
  /// Takes a fresh block for `length` characters, its first byte zero, the others not initialised.
  /// Length 0 or a failed allocation gives the shared empty string. Returns the characters, which
  /// may be written only when they are not shared (`IsReference`).
  char* New(unsigned long length);
  /// Replaces the text with a copy; returns the characters.
  char* New(const char* text);
  char* New(const dString& source);
  /// Appends `count` characters; nothing when `text` is null. A failed allocation gives the empty
  /// string.
  void Append(const char* text, unsigned long count);

 private:
  char* Characters() const;
  char* CopyText(const char* text, unsigned long length);

  // A fill of raw bytes would destroy the terminator.
  using dBuffer::Set;
};

}  // namespace vorl

#endif
