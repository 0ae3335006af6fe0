#ifndef VORL_COMMON_DSTATUS_H
#define VORL_COMMON_DSTATUS_H

/// @file
/// The status value by which every object of the library reports how its last operation went.

#include <vorl/Common/BaseClass.h>

#include <cstdarg>
#include <iosfwd>
#include <string>

inline namespace vorl {

/// A code and a message text.
///
/// Code 0 is success, a negative code an error, a positive code a warning. Booleans map to 0
/// (true) and -1 (false). Formatted texts follow the printf conventions and are cut at 1,023
/// characters; a null or empty format gives an empty text. Codes are held in 32 bits; a larger
/// value is stored as the nearest one that fits. A text that finds no memory is dropped; the code,
/// which callers act on, is always kept.
class VORL_API dStatus : public DataBase {
 public:
  /// Code -1, empty message: nothing has been reported yet.
  dStatus();
  /// `Set(code, text)`: the text is a format without arguments, so "%%" gives one percent sign. A
  /// conversion that would need an argument stays as it is written.
  dStatus(long code, const char* text);
  /// `Set(ok, text)`, with the text as above.
  dStatus(bool ok, const char* text);
  /// As with `long`.
  dStatus(int code, const char* text);
  dStatus(const dStatus& source);

  ClassInfo* GetClassInfo() override;
  ~dStatus() override;
  /// Code 0, empty message.
  void Reset() override;
  /// Always true.
  bool IsValid() override;

  static dStatus* Create();
  static ClassInfo& CI();

  dStatus& operator=(const dStatus& source);
  /// Sets the code; the message stays.
  dStatus& operator=(long code);
  dStatus& operator=(int code);
  /// True sets code 0 and empties the message; false sets code -1 and keeps the message.
  dStatus& operator=(bool ok);
  /// Replaces the message; the code stays. A null text empties it.
  dStatus& operator=(const char* text);
  dStatus& operator=(const std::string& text);
  /// Appends to the message; the code stays. A null text changes nothing.
  dStatus& operator+=(const char* text);
  dStatus& operator+=(const std::string& text);

  /// Comparisons look at the codes only, never at the messages.
  bool operator==(const dStatus& other) const;
  bool operator!=(const dStatus& other) const;
  bool operator==(long code) const;
  bool operator!=(long code) const;
  bool operator==(int code) const;
  bool operator!=(int code) const;
  /// Compares whether the code is 0 with `ok`; a warning therefore equals false.
  bool operator==(bool ok) const;
  bool operator!=(bool ok) const;

  /// The code.
  operator long() const;
  /// The message; valid until the status changes.
  operator const char*() const;
  /// True when the code is 0.
  bool IsOK() const;

  /// Takes the code of `cause`; the message is the formatted text directly followed by `cause`'s
  /// message. `cause` may be this status.
  void Set(const dStatus& cause, const char* format, ...) VORL_PRINTF_FORMAT(3, 4);
  /// Sets the code and the formatted message.
  void Set(long code, const char* format, ...) VORL_PRINTF_FORMAT(3, 4);
  void Set(int code, const char* format, ...) VORL_PRINTF_FORMAT(3, 4);
  /// Sets code 0 (true) or -1 (false) and the formatted message.
  void Set(bool ok, const char* format, ...) VORL_PRINTF_FORMAT(3, 4);
  /// Sets the formatted message and code 0: setting a message alone is a success.
  void SetMsg(const char* format, ...) VORL_PRINTF_FORMAT(2, 3);
  /// Appends the formatted text to the message; the code stays.
  void AddMsg(const char* format, ...) VORL_PRINTF_FORMAT(2, 3);

 private:
  std::int32_t m_code;
  std::string m_message;
};

/// Prints the code and the message, such as "-1: missing LUT".
VORL_API std::ostream& operator<<(std::ostream& out, const dStatus& status);

}  // namespace vorl

#endif
