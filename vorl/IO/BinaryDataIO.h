#ifndef VORL_IO_BINARYDATAIO_H
#define VORL_IO_BINARYDATAIO_H

/// @file
/// The binary data file: the streams that write and read it, and the interface of objects that
/// persist themselves in it.
///
/// All multi-byte numbers are little-endian; nothing is padded or aligned. A file begins with the
/// characters "BDF" and a zero byte, then the zero-terminated name of its type ("???" when the
/// writer was given none). Items follow to the end of the file, each one a tag byte and a payload:
///
///     tag   item                             payload
///     0x00  block end                        none
///     0x01  unsigned 8-bit                   1 byte, or the bytes of an array
///     0x02  signed 8-bit                     1 byte, or the bytes of an array
///     0x03  unsigned 16-bit                  2 bytes each
///     0x04  signed 16-bit                    2 bytes each
///     0x05  unsigned 32-bit                  4 bytes each
///     0x06  signed 32-bit                    4 bytes each
///     0x07  32-bit IEEE float                4 bytes each
///     0x08  64-bit IEEE float                8 bytes each
///     0x09  boolean                          1 byte: 1 true, 0 false
///     0xE1  array length to 255              1 byte: the number of elements
///     0xE2  array length to 65,535           2 bytes
///     0xE4  array length from 65,536         4 bytes
///     0xF0  block start                      none
///     0xF1  block start, id to 255           1 byte: the identifier
///     0xF2  block start, id to 65,535        2 bytes
///     0xF4  block start, id from 65,536      4 bytes
///
/// An array is a length item and one item that holds all elements. Strings and buffers are arrays
/// of unsigned 8-bit elements. A block is a block start, items (nested blocks among them), and a
/// block end.
///
/// Both streams report failures by throwing a `dStatus` with one of these codes and the message
/// "Error %d in class BinaryDataOut [BinaryDataIO/line %d]" (or "BinaryDataIn"); the stream keeps
/// the same status, and its file stays open until it is closed or destroyed:
///
///     code  condition
///     -2    `Open`: the file name is null
///     -3    `Open`: the file cannot be opened or created, or is of a kind that cannot serve
///     -4    an item is written or read while no file is open
///     -100  a write failed, or the value cannot be written: out of 32 bits, a negative element
///           count, a null array
///     -200  the file holds fewer bytes than asked for; or the array to fill has a negative element
///           count or is null; or memory for what the file holds is missing
///     -201  an item is read at the end of the file
///     -202  `Open`: the file's type name differs from the expected one
///     -203  `Open`: the file does not begin with "BDF" and a zero byte
///     -204  `ReadArrayLength`: the next item is no array length
///     -205  `OpenBlock(id)`: the next item is no block start with an identifier
///     -206  the next item is of another type
///     -207  `OpenBlock(id)`: the block's identifier is another one
///     -208  `ReadBuffer`: the stored length differs from the size to keep

#include <vorl/Common/dStatus.h>

#include <cstdint>
#include <memory>
#include <string>

inline namespace vorl {

class BinaryDataIn;
class BinaryDataOut;
class dBuffer;
class dString;

namespace vorl_detail {
class ItemFile;
}

/// The interface of a class that persists itself.
///
/// The class writes its fields with the typed writers and reads them back with the matching typed
/// readers in the same order:
///
///     void Marker::Write(BinaryDataOut& out) { out.WriteS32(m_x); out.WriteString(m_name); }
///     void Marker::Read(BinaryDataIn& in) { in.ReadS32(m_x); in.ReadString(m_name); }
class VORL_API IBinaryDataIO {
 public:
  /// Creates or overwrites the file and writes this object's items behind the header. Returns false
  /// when anything fails, a full disk included; the file is then incomplete. Exceptions of other
  /// types than `dStatus` that `Write` throws pass on, after the file is closed.
  virtual bool WriteFile(const char* fileName, const char* typeName);
  /// Reads this object's items from the file. Returns false when anything fails; what `Read` had
  /// stored by then stays. A null `typeName` accepts any type. Exceptions of other types than
  /// `dStatus` that `Read` throws pass on, after the file is closed.
  virtual bool ReadFile(const char* fileName, const char* typeName);
  /// Writes the object's fields.
  virtual void Write(BinaryDataOut& out) = 0;
  /// Reads the object's fields in the order in which `Write` writes them.
  virtual void Read(BinaryDataIn& in) = 0;

 protected:
  IBinaryDataIO() = default;
  IBinaryDataIO(const IBinaryDataIO&) = default;
  IBinaryDataIO& operator=(const IBinaryDataIO&) = default;
  /// Objects are destroyed through their own class.
  ~IBinaryDataIO() = default;
};

/// Writes a binary data file.
///
/// Every writer returns true or throws its status (see the table above). Data is buffered: that the
/// disk is full may be noticed only later, at the latest by `Finish` or `Close`.
///
/// Copies of a stream share its file: all write behind one another, and the file is closed with the
/// last one. A stream and its copies are used from one thread.
class VORL_API BinaryDataOut : public BaseClass {
 public:
  /// No file; status code -1, "uninitialized".
  BinaryDataOut();
  /// `Open(fileName, typeName)`.
  BinaryDataOut(const char* fileName, const char* typeName);
  /// Copies the status and shares the file.
  BinaryDataOut(const BinaryDataOut& source);
  /// Closes the file of this stream, copies the status and shares the source's file.
  BinaryDataOut& operator=(const BinaryDataOut& source);

  ClassInfo* GetClassInfo() override;
  /// `Close`.
  ~BinaryDataOut() override;

  static BinaryDataOut* Create();
  static ClassInfo& CI();

  /// Closes any open file, creates or truncates the file, and writes magic and type name ("???" for
  /// null). A reader checks at most 500 characters of a type name; a longer one can be written but
  /// never be matched. Files and character devices can be written, pipes and directories cannot
  /// (-3). Returns true, with the status at code 0 and without a message.
  bool Open(const char* fileName, const char* typeName);
  /// Closes the file, if any, or gives up this stream's share of it. When the system could not take
  /// all that was written, the status becomes error -100; nothing is thrown.
  void Close();
  /// `Close`, and whether everything written through this file has reached the system. True for a
  /// stream without a file.
  bool Finish();
  /// How the last `Open` or failure went.
  const dStatus& GetStatus() const;

  bool WriteS8(char value);
  bool WriteU8(unsigned char value);
  bool WriteS16(short value);
  bool WriteU16(unsigned short value);
  /// A value that does not fit 32 bits fails with -100.
  bool WriteS32(long value);
  /// A value that does not fit 32 bits fails with -100.
  bool WriteU32(unsigned long value);
  bool WriteF32(float value);
  bool WriteF64(double value);
  bool WriteBool(bool value);

  /// Arrays: a length item and a data item of `count` elements. A negative count, or a null array
  /// with a count above 0, fails with -100 before anything is written.
  bool WriteS8Array(const char* values, int count);
  bool WriteU8Array(const unsigned char* values, int count);
  bool WriteS16Array(const short* values, int count);
  bool WriteU16Array(const unsigned short* values, int count);
  /// 32-bit elements, whatever the size of `long`. A value that does not fit fails with -100 before
  /// anything is written.
  bool WriteS32Array(const long* values, int count);
  bool WriteS32Array(const std::int32_t* values, int count);
  bool WriteU32Array(const unsigned long* values, int count);
  bool WriteU32Array(const std::uint32_t* values, int count);
  bool WriteF32Array(const float* values, int count);
  bool WriteF64Array(const double* values, int count);

  /// The characters and a terminating zero byte. A text of 4 GiB or more fails with -100.
  bool WriteString(const std::string& text);
  /// The characters and the terminating zero byte.
  bool WriteString(const dString& text);
  /// The bytes in use.
  bool WriteBuffer(const dBuffer& buffer);

  /// Starts a block without an identifier.
  bool OpenBlock();
  /// Starts a block with an identifier. One that does not fit 32 bits fails with -100.
  bool OpenBlock(unsigned long id);
  /// Ends the block.
  bool CloseBlock();
  /// Writes the object's items as a block. False, and nothing written, for a null object.
  bool Write(IBinaryDataIO* object);

 protected:
  /// Writes an item: the tag, then `size` bytes as they stand, unless `data` is null. -4 without a
  /// file; -100 when the payload cannot be written.
  bool Write(unsigned char tag, const void* data, unsigned long size);
  /// Writes a length item and an item of `count` times `elementSize` bytes as they stand. -4
  /// without a file; -100 when that cannot be written or `count` does not fit 32 bits.
  bool WriteArray(unsigned char tag, const void* data, unsigned long elementSize,
                  unsigned long count);
  /// Sets the status to the code and its message, and throws a copy of it.
  [[noreturn]] void Error(long code, int line);

 private:
  void WriteItem(unsigned char tag, const void* data, std::uint64_t size);
  void WriteCount(unsigned char tagFamily, std::uint32_t count);
  bool WriteByteArray(const void* bytes, std::uint64_t count);
  template <class Number, class Element>
  bool WriteNumber(unsigned char tag, Element value);
  template <class Number, class Element>
  bool WriteNumbers(unsigned char tag, const Element* values, int count);
  template <class Number, class Element>
  void WriteConverted(const Element* values, int count);

  dStatus m_status;
  std::shared_ptr<vorl_detail::ItemFile> m_file;
};

/// Reads a binary data file.
///
/// Every reader returns true or throws its status (see the table above). A failed reader leaves the
/// variable, string, buffer or array that it was to fill as it was, unless memory is missing, or
/// the file itself fails or shrinks while it is read. Lengths that the file states are compared
/// with what the file still holds before anything is allocated. Only regular files can be read.
///
/// Copies of a stream share its file and its position; the file is closed with the last one. A
/// stream and its copies are used from one thread.
class VORL_API BinaryDataIn : public BaseClass {
 public:
  /// No file; status code -1, "uninitialized".
  BinaryDataIn();
  /// `Open(fileName, typeName)`.
  BinaryDataIn(const char* fileName, const char* typeName);
  /// Copies the status and shares the file.
  BinaryDataIn(const BinaryDataIn& source);
  /// Closes the file of this stream, copies the status and shares the source's file.
  BinaryDataIn& operator=(const BinaryDataIn& source);

  ClassInfo* GetClassInfo() override;
  /// `Close`.
  ~BinaryDataIn() override;

  static BinaryDataIn* Create();
  static ClassInfo& CI();

  /// Closes any open file, opens the file and checks magic and type name. A null `typeName` accepts
  /// any type. A file that ends within its header fails with -200. Returns true, with the status at
  /// code 0 and without a message.
  bool Open(const char* fileName, const char* typeName);
  /// Closes the file, if any, or gives up this stream's share of it.
  void Close();
  /// How the last `Open` or failure went.
  const dStatus& GetStatus() const;

  /// Bytes between the position and the end of the file; 0 without a file.
  std::uint64_t GetRemainingBytes() const;
  /// True when the file still holds `byteCount` bytes; else fails with -200. An object that is
  /// about to allocate what its fields ask for calls it first, so that a damaged file cannot make
  /// it allocate more than the file could fill.
  bool RequireBytes(std::uint64_t byteCount);

  bool ReadS8(char& value);
  bool ReadU8(unsigned char& value);
  bool ReadS16(short& value);
  bool ReadU16(unsigned short& value);
  bool ReadS32(long& value);
  bool ReadS32(std::int32_t& value);
  bool ReadU32(unsigned long& value);
  bool ReadU32(std::uint32_t& value);
  bool ReadF32(float& value);
  bool ReadF64(double& value);
  /// Any byte but 0 is true.
  bool ReadBool(bool& value);

  /// Reads a length item and returns the number of elements; -204 when there is none, also at the
  /// end of the file and without a file. The data item of the array follows.
  unsigned long ReadArrayLength();

  /// Arrays: reads the data item only. Call `ReadArrayLength` first and provide storage for as many
  /// elements; `count` is their number. A negative count, or a null array with a count above 0,
  /// fails with -200.
  bool ReadS8Array(char* values, int count);
  bool ReadU8Array(unsigned char* values, int count);
  bool ReadS16Array(short* values, int count);
  bool ReadU16Array(unsigned short* values, int count);
  /// 32-bit elements, whatever the size of `long`.
  bool ReadS32Array(long* values, int count);
  bool ReadS32Array(std::int32_t* values, int count);
  bool ReadU32Array(unsigned long* values, int count);
  bool ReadU32Array(std::uint32_t* values, int count);
  bool ReadF32Array(float* values, int count);
  bool ReadF64Array(double* values, int count);

  /// Reads length and bytes. The zero byte that `WriteString` wrote becomes the string's last
  /// character: a text of two letters is read as a string of size 3, so that every byte array can
  /// be read as a string. Use `c_str()` for the text.
  bool ReadString(std::string& text);
  /// Reads length and bytes; the zero byte is the string's terminator. Where the bytes lack one, it
  /// is appended; a length of 0 gives the empty string.
  bool ReadString(dString& text);
  /// Reads length and bytes. With `keepSize` the buffer must have the stored size already (else
  /// -208) and is filled in place; without, it is given the stored size by `dBuffer::New`.
  bool ReadBuffer(dBuffer& buffer, bool keepSize);

  /// Enters a block without an identifier.
  bool OpenBlock();
  /// Enters a block that has this identifier; -205 when the next item is no block start with an
  /// identifier, also at the end of the file and without a file, -207 when it is another one.
  bool OpenBlock(unsigned long id);
  /// Leaves the block.
  bool CloseBlock();
  /// True when the next item is a block end. The position stays. False at the end of the file and
  /// without a file, where the next reader fails.
  bool IsEndOfBlock();
  /// Reads the object's items from a block. False, and nothing read, for a null object.
  bool Read(IBinaryDataIO* object);

 protected:
  /// Reads an item: the tag, which must be this one, then `size` bytes as they stand, unless `data`
  /// is null. -4, -201, -206 and -200 as in the table.
  bool Read(unsigned char tag, void* data, unsigned long size);
  /// Sets the status to the code and its message, and throws a copy of it.
  [[noreturn]] void Error(long code, int line);

 private:
  void ReadTag(unsigned char tag);
  void ReadBytes(void* data, std::uint64_t size);
  bool ReadCount(unsigned char tagFamily, std::uint32_t& count);
  std::uint32_t ReadByteArrayHead();
  template <class Number, class Element>
  bool ReadNumber(unsigned char tag, Element& value);
  template <class Number, class Element>
  bool ReadNumbers(unsigned char tag, Element* values, int count);
  template <class Number, class Element>
  void ReadConverted(Element* values, int count);

  dStatus m_status;
  std::shared_ptr<vorl_detail::ItemFile> m_file;
};

}  // namespace vorl

#endif
