#ifndef VORL_DATA_DASCIISTREAM_H
#define VORL_DATA_DASCIISTREAM_H

/// @file
/// Buffered reading of text files.

#include <vorl/Common/dStatus.h>

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <memory>

inline namespace vorl {

/// Reads a text file character by character, or takes pieces out of it by position.
///
/// A stretch of the file stands in a read buffer of the size that the caller chooses; it is filled
/// anew when reading runs past its end or a position outside it is asked for. Over a caller's
/// string the stream serves positioned access only.
///
/// Copies share the file and the read buffer, which are closed and freed with the last of them:
/// once one copy has filled the buffer anew, the others position themselves before they read on.
///
/// *Errors.* A failing method sets and logs the status, code -1.
class VORL_API dASCIIStreamIn : public BaseClass {
 public:
  /// Nothing to read.
  dASCIIStreamIn();
  /// `Init(text)`.
  explicit dASCIIStreamIn(const char* text);
  /// `Init(fileName, bufferSize)`.
  dASCIIStreamIn(const char* fileName, unsigned long bufferSize);
  dASCIIStreamIn(const dASCIIStreamIn& source);
  dASCIIStreamIn& operator=(const dASCIIStreamIn& source);

  ClassInfo* GetClassInfo() override;
  ~dASCIIStreamIn() override;
  /// Closes the file; nothing to read.
  virtual void Reset();
  /// True when a file is open.
  virtual bool IsValid();

  static dASCIIStreamIn* Create();
  static ClassInfo& CI();

  /// Serves a zero-terminated string, which the caller keeps alive. Fails with "given string is a
  /// 'NULL' pointer".
  bool Init(const char* text);
  /// Opens a file and fills the read buffer of `bufferSize` bytes. Fails with "invalid parameter"
  /// (no name, or a size of 0), "no such file: '%s'", "no read permission for '%s'", "can't to open
  /// '%s'", "dASCIIStreamIn::Init()  out of memory(%d bytes requested)", and, without a message,
  /// for an empty file.
  bool Init(const char* fileName, unsigned long bufferSize);

  /// Takes the next character. False, with a zero character, at the end of the file, over a string
  /// ("FillBuffer(): source isn't a file") and with nothing to read ("FillBuffer(): buffer not
  /// initialized"); false for a null pointer ("invalid parameter").
  bool NextChar(char* ch);
  /// Looks at the character at the current position. False, with a zero character, when there is no
  /// position yet; false for a null pointer.
  ///
  /// The read buffer is not filled anew: once the last character in it has been taken, this is a
  /// zero character, until `NextChar` or `SetPos` reads on.
  bool GetChar(char* ch) const;
  /// Moves to a position in the file, or in the string. A position outside the read buffer fills it
  /// from there; false when nothing is there. Over a string: "FillBuffer(): source isn't a file";
  /// with nothing to read: "FillBuffer(): buffer not initialized".
  bool SetPos(unsigned long position);
  /// Copies `length` characters from a position on and terminates them: `out` has room for one more
  /// than `length`. False when there are fewer, which a file then gives as far as they go; a string
  /// gives none and sets "GetString() invalid string pos: %d(length %d)". False for a null pointer
  /// ("invalid parameter"). The current position stays.
  bool GetString(unsigned long position, unsigned long length, char* out);

  const dStatus& GetStatus() const;

 protected:
  /// Fills the read buffer from a position of the file on; false when nothing is there. Fails with
  /// "FillBuffer(): buffer not initialized" or "FillBuffer(): source isn't a file".
  bool FillBuffer(unsigned long position);
  /// The same, and takes the first character; a zero character when it fails. A null pointer takes
  /// the character without handing it out.
  bool FillBuffer(unsigned long position, char* ch);
  /// Fails with "given file name is 'NULL' or empty", "no such file: '%s'" or
  /// "no read permission for '%s'".
  bool CheckFile(const char* fileName);

 private:
  bool Holds(unsigned long position) const;
  bool FillFrom(std::uint64_t position);
  bool Take(char* ch);
  bool TakeNothing(char* ch);

  dStatus m_status;
  std::shared_ptr<std::FILE> m_file;
  std::uint64_t m_bufferOffset = 0;       ///< file position of the buffer's first byte
  std::size_t m_bufferCapacity = 0;       ///< bytes that the buffer can hold
  std::size_t m_bufferFill = 0;           ///< bytes that are valid in it
  std::shared_ptr<char[]> m_ownedBuffer;  ///< of a file
  const char* m_buffer = nullptr;         ///< the owned buffer or the caller's string
  const char* m_bufferEnd = nullptr;      ///< one past the last valid byte; null for a string
  const char* m_current = nullptr;        ///< the next character
};

}  // namespace vorl

#endif
