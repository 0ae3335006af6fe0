#include <vorl/IO/BinaryDataIO.h>

#include <algorithm>
#include <cstring>
#include <new>
#include <stdexcept>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dBuffer.h>
#include <vorl/Data/dString.h>
#include <vorl/IO/detail/ItemFile.h>
#include <vorl/IO/detail/ItemTags.h>
#include <vorl/IO/detail/LittleEndian.h>

inline namespace vorl {

using namespace vorl_detail;

VORL_REGISTER_CLASS(BinaryDataIn, BaseClass);

BinaryDataIn::BinaryDataIn() : m_status(-1, "uninitialized") {}

BinaryDataIn::BinaryDataIn(const char* fileName, const char* typeName) : BinaryDataIn() {
  Open(fileName, typeName);
}

BinaryDataIn::BinaryDataIn(const BinaryDataIn& source) = default;

BinaryDataIn& BinaryDataIn::operator=(const BinaryDataIn& source) = default;

BinaryDataIn::~BinaryDataIn() {
  Close();
}

bool BinaryDataIn::Open(const char* fileName, const char* typeName) {
  Close();
  if (fileName == nullptr) {
    Error(kErrorNoFileName, __LINE__);
  }
  m_file = ItemFile::OpenForReading(fileName);
  if (m_file == nullptr) {
    Error(kErrorCannotOpen, __LINE__);
  }
  char magic[sizeof kMagic];
  ReadBytes(magic, sizeof magic);
  if (std::memcmp(magic, kMagic, sizeof kMagic) != 0) {
    Error(kErrorMagic, __LINE__);
  }
  // A name that is too long stays without its zero byte, and then is no expected name.
  char storedType[kMaxTypeBytes];
  int length = 0;
  do {
    ReadBytes(&storedType[length], 1);
  } while (storedType[length++] != '\0' && length < kMaxTypeBytes);
  const bool isTerminated = storedType[length - 1] == '\0';
  if (typeName != nullptr && !(isTerminated && std::strcmp(storedType, typeName) == 0)) {
    Error(kErrorType, __LINE__);
  }
  m_status.Reset();
  return true;
}

void BinaryDataIn::Close() {
  m_file.reset();
}

const dStatus& BinaryDataIn::GetStatus() const {
  return m_status;
}

std::uint64_t BinaryDataIn::GetRemainingBytes() const {
  return m_file != nullptr ? m_file->GetRemaining() : 0;
}

bool BinaryDataIn::RequireBytes(std::uint64_t byteCount) {
  if (byteCount > GetRemainingBytes()) {
    Error(kErrorShortRead, __LINE__);
  }
  return true;
}

void BinaryDataIn::Error(long code, int line) {
  m_status.Set(code, "Error %ld in class BinaryDataIn [BinaryDataIO/line %d]", code, line);
  throw dStatus(m_status);
}

void BinaryDataIn::ReadTag(unsigned char tag) {
  if (m_file == nullptr) {
    Error(kErrorNotOpen, __LINE__);
  }
  if (m_file->GetRemaining() == 0) {
    Error(kErrorEndOfFile, __LINE__);
  }
  if (m_file->ReadByte() != tag) {
    Error(kErrorTag, __LINE__);
  }
}

void BinaryDataIn::ReadBytes(void* data, std::uint64_t size) {
  if (!m_file->Read(data, size)) {
    Error(kErrorShortRead, __LINE__);
  }
}

// False when the next item is not of this family. The low bits of the tag say how many bytes the
// count has. The end of the file, or no file at all, is no item of any family.
bool BinaryDataIn::ReadCount(unsigned char tagFamily, std::uint32_t& count) {
  const int tag = m_file != nullptr ? m_file->ReadByte() : ItemFile::kEnd;
  const int size = tag & kCountSizeMask;
  if (tag != (tagFamily | size) || (size != 1 && size != 2 && size != 4)) {
    return false;
  }
  unsigned char bytes[sizeof count] = {};
  ReadBytes(bytes, static_cast<std::uint64_t>(size));
  count = LoadLittleEndian<std::uint32_t>(bytes);
  return true;
}

// Reads an array of bytes up to its contents; returns their number, which the file does hold.
std::uint32_t BinaryDataIn::ReadByteArrayHead() {
  const auto count = static_cast<std::uint32_t>(ReadArrayLength());
  ReadTag(kTagU8);
  RequireBytes(count);
  return count;
}

template <class Number, class Element>
bool BinaryDataIn::ReadNumber(unsigned char tag, Element& value) {
  unsigned char bytes[sizeof(Number)];
  ReadTag(tag);
  ReadBytes(bytes, sizeof bytes);
  value = static_cast<Element>(LoadLittleEndian<Number>(bytes));
  return true;
}

template <class Number, class Element>
bool BinaryDataIn::ReadNumbers(unsigned char tag, Element* values, int count) {
  ReadTag(tag);
  if (count < 0 || (values == nullptr && count > 0)) {
    Error(kErrorShortRead, __LINE__);
  }
  const std::uint64_t size = sizeof(Number) * static_cast<std::uint64_t>(count);
  RequireBytes(size);
  if constexpr (kSameLayout<Number, Element>) {
    ReadBytes(values, size);
  } else {
    ReadConverted<Number>(values, count);
  }
  return true;
}

// For arrays whose elements are wider in memory than in the file, or in another byte order.
template <class Number, class Element>
void BinaryDataIn::ReadConverted(Element* values, int count) {
  unsigned char bytes[kConversionChunk * sizeof(Number)];
  for (int first = 0; first < count; first += kConversionChunk) {
    const int inChunk = std::min(kConversionChunk, count - first);
    ReadBytes(bytes, sizeof(Number) * static_cast<std::uint64_t>(inChunk));
    const unsigned char* next = bytes;
    for (Element* value = values + first; value != values + first + inChunk; ++value) {
      *value = static_cast<Element>(LoadLittleEndian<Number>(next));
      next += sizeof(Number);
    }
  }
}

bool BinaryDataIn::ReadS8(char& value) {
  return ReadNumber<char>(kTagS8, value);
}
bool BinaryDataIn::ReadU8(unsigned char& value) {
  return ReadNumber<std::uint8_t>(kTagU8, value);
}
bool BinaryDataIn::ReadS16(short& value) {
  return ReadNumber<std::int16_t>(kTagS16, value);
}
bool BinaryDataIn::ReadU16(unsigned short& value) {
  return ReadNumber<std::uint16_t>(kTagU16, value);
}
bool BinaryDataIn::ReadS32(long& value) {
  return ReadNumber<std::int32_t>(kTagS32, value);
}
bool BinaryDataIn::ReadS32(std::int32_t& value) {
  return ReadNumber<std::int32_t>(kTagS32, value);
}
bool BinaryDataIn::ReadU32(unsigned long& value) {
  return ReadNumber<std::uint32_t>(kTagU32, value);
}
bool BinaryDataIn::ReadU32(std::uint32_t& value) {
  return ReadNumber<std::uint32_t>(kTagU32, value);
}
bool BinaryDataIn::ReadF32(float& value) {
  return ReadNumber<float>(kTagF32, value);
}
bool BinaryDataIn::ReadF64(double& value) {
  return ReadNumber<double>(kTagF64, value);
}
bool BinaryDataIn::ReadBool(bool& value) {
  return ReadNumber<std::uint8_t>(kTagBool, value);
}

unsigned long BinaryDataIn::ReadArrayLength() {
  std::uint32_t length = 0;
  if (!ReadCount(kTagFamilyLength, length)) {
    Error(kErrorNoLength, __LINE__);
  }
  return length;
}

bool BinaryDataIn::ReadS8Array(char* values, int count) {
  return ReadNumbers<char>(kTagS8, values, count);
}
bool BinaryDataIn::ReadU8Array(unsigned char* values, int count) {
  return ReadNumbers<std::uint8_t>(kTagU8, values, count);
}
bool BinaryDataIn::ReadS16Array(short* values, int count) {
  return ReadNumbers<std::int16_t>(kTagS16, values, count);
}
bool BinaryDataIn::ReadU16Array(unsigned short* values, int count) {
  return ReadNumbers<std::uint16_t>(kTagU16, values, count);
}
bool BinaryDataIn::ReadS32Array(long* values, int count) {
  return ReadNumbers<std::int32_t>(kTagS32, values, count);
}
bool BinaryDataIn::ReadS32Array(std::int32_t* values, int count) {
  return ReadNumbers<std::int32_t>(kTagS32, values, count);
}
bool BinaryDataIn::ReadU32Array(unsigned long* values, int count) {
  return ReadNumbers<std::uint32_t>(kTagU32, values, count);
}
bool BinaryDataIn::ReadU32Array(std::uint32_t* values, int count) {
  return ReadNumbers<std::uint32_t>(kTagU32, values, count);
}
bool BinaryDataIn::ReadF32Array(float* values, int count) {
  return ReadNumbers<float>(kTagF32, values, count);
}
bool BinaryDataIn::ReadF64Array(double* values, int count) {
  return ReadNumbers<double>(kTagF64, values, count);
}

bool BinaryDataIn::ReadString(std::string& text) {
  const std::uint32_t size = ReadByteArrayHead();
  try {
    text.resize(size);
  } catch (const std::bad_alloc&) {
    Error(kErrorShortRead, __LINE__);
  } catch (const std::length_error&) {
    Error(kErrorShortRead, __LINE__);
  }
  ReadBytes(text.data(), size);
  return true;
}

bool BinaryDataIn::ReadString(dString& text) {
  const std::uint32_t size = ReadByteArrayHead();
  if (size == 0) {
    return text.Init();
  }
  text.Resize(size);
  if (!text || !m_file->Read(text.Get(0), size)) {
    text.Init();
    Error(kErrorShortRead, __LINE__);
  }
  const bool isTerminated = static_cast<const char*>(text.Get(0))[size - 1] == '\0';
  if (!isTerminated && !text.Resize(size + 1ul)) {  // the added byte is zero
    text.Init();
    Error(kErrorShortRead, __LINE__);
  }
  return true;
}

bool BinaryDataIn::ReadBuffer(dBuffer& buffer, bool keepSize) {
  const unsigned long size = ReadArrayLength();
  if (keepSize && size != buffer.GetSize()) {
    Error(kErrorBufferSize, __LINE__);
  }
  ReadTag(kTagU8);
  RequireBytes(size);
  if (!keepSize) {
    buffer.New(size, false);
    if (buffer.GetSize() != size) {
      Error(kErrorShortRead, __LINE__);
    }
  }
  ReadBytes(buffer.Get(0), size);
  return true;
}

bool BinaryDataIn::OpenBlock() {
  ReadTag(kTagBlock);
  return true;
}

bool BinaryDataIn::OpenBlock(unsigned long id) {
  std::uint32_t storedId = 0;
  if (!ReadCount(kTagFamilyNumberedBlock, storedId)) {
    Error(kErrorNoNumberedBlock, __LINE__);
  }
  if (storedId != id) {
    Error(kErrorBlockId, __LINE__);
  }
  return true;
}

bool BinaryDataIn::CloseBlock() {
  ReadTag(kTagBlockEnd);
  return true;
}

bool BinaryDataIn::IsEndOfBlock() {
  return m_file != nullptr && m_file->PeekByte() == kTagBlockEnd;
}

bool BinaryDataIn::Read(IBinaryDataIO* object) {
  if (object == nullptr) {
    return false;
  }
  OpenBlock();
  object->Read(*this);
  return CloseBlock();
}

bool BinaryDataIn::Read(unsigned char tag, void* data, unsigned long size) {
  ReadTag(tag);
  if (data != nullptr && size > 0) {
    ReadBytes(data, size);
  }
  return true;
}

}  // namespace vorl
