#include <vorl/IO/BinaryDataIO.h>

#include <algorithm>
#include <cstring>
#include <limits>
#include <utility>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dBuffer.h>
#include <vorl/Data/dString.h>
#include <vorl/IO/detail/ItemFile.h>
#include <vorl/IO/detail/ItemTags.h>
#include <vorl/IO/detail/LittleEndian.h>

inline namespace vorl {

using namespace vorl_detail;

namespace {

void SetError(dStatus& status, long code, int line) {
  status.Set(code, "Error %ld in class BinaryDataOut [BinaryDataIO/line %d]", code, line);
}

}  // namespace

VORL_REGISTER_CLASS(BinaryDataOut, BaseClass);

BinaryDataOut::BinaryDataOut() : m_status(-1, "uninitialized") {}

BinaryDataOut::BinaryDataOut(const char* fileName, const char* typeName) : BinaryDataOut() {
  Open(fileName, typeName);
}

BinaryDataOut::BinaryDataOut(const BinaryDataOut& source) = default;

BinaryDataOut& BinaryDataOut::operator=(const BinaryDataOut& source) {
  if (this != &source) {
    Close();
    m_status = source.m_status;
    m_file = source.m_file;
  }
  return *this;
}

BinaryDataOut::~BinaryDataOut() {
  Close();
}

bool BinaryDataOut::Open(const char* fileName, const char* typeName) {
  Close();
  if (fileName == nullptr) {
    Error(kErrorNoFileName, __LINE__);
  }
  m_file = ItemFile::OpenForWriting(fileName);
  if (m_file == nullptr) {
    Error(kErrorCannotOpen, __LINE__);
  }
  if (!m_file->Write(kMagic, sizeof kMagic)) {
    Error(kErrorWrite, __LINE__);
  }
  const char* const storedType = typeName != nullptr ? typeName : kUnnamedType;
  if (!m_file->Write(storedType, std::strlen(storedType) + 1)) {
    Error(kErrorWrite, __LINE__);
  }
  m_status.Reset();
  return true;
}

void BinaryDataOut::Close() {
  Finish();
}

bool BinaryDataOut::Finish() {
  const std::shared_ptr<ItemFile> file = std::move(m_file);
  if (file == nullptr) {
    return true;
  }
  const bool complete = file.use_count() == 1 ? file->Close() : file->Flush();
  if (!complete) {
    SetError(m_status, kErrorWrite, __LINE__);
  }
  return complete;
}

const dStatus& BinaryDataOut::GetStatus() const {
  return m_status;
}

void BinaryDataOut::Error(long code, int line) {
  SetError(m_status, code, line);
  throw dStatus(m_status);
}

// The tag is written without a check of its own: a failure shows with the payload or at the end.
void BinaryDataOut::WriteItem(unsigned char tag, const void* data, std::uint64_t size) {
  if (m_file == nullptr) {
    Error(kErrorNotOpen, __LINE__);
  }
  m_file->Write(&tag, sizeof tag);
  if (data != nullptr && size > 0 && !m_file->Write(data, size)) {
    Error(kErrorWrite, __LINE__);
  }
}

// A count takes as few bytes as it needs; the low bits of its tag say how many.
void BinaryDataOut::WriteCount(unsigned char tagFamily, std::uint32_t count) {
  const unsigned char size = count <= 0xFF ? 1 : count <= 0xFFFF ? 2 : 4;
  unsigned char bytes[sizeof count];
  StoreLittleEndian(bytes, count);
  WriteItem(static_cast<unsigned char>(tagFamily | size), bytes, size);
}

template <class Number, class Element>
bool BinaryDataOut::WriteNumber(unsigned char tag, Element value) {
  if (m_file == nullptr) {
    Error(kErrorNotOpen, __LINE__);
  }
  if (!Fits<Number>(value)) {
    Error(kErrorWrite, __LINE__);
  }
  unsigned char bytes[sizeof(Number)];
  StoreLittleEndian(bytes, static_cast<Number>(value));
  WriteItem(tag, bytes, sizeof bytes);
  return true;
}

template <class Number, class Element>
bool BinaryDataOut::WriteNumbers(unsigned char tag, const Element* values, int count) {
  if (m_file == nullptr) {
    Error(kErrorNotOpen, __LINE__);
  }
  if (count < 0 || (values == nullptr && count > 0)) {
    Error(kErrorWrite, __LINE__);
  }
  if constexpr (sizeof(Element) > sizeof(Number)) {
    if (!std::all_of(values, values + count, Fits<Number, Element>)) {
      Error(kErrorWrite, __LINE__);
    }
  }
  WriteCount(kTagFamilyLength, static_cast<std::uint32_t>(count));
  if constexpr (kSameLayout<Number, Element>) {
    WriteItem(tag, values, sizeof(Number) * static_cast<std::uint64_t>(count));
  } else {
    WriteItem(tag, nullptr, 0);
    WriteConverted<Number>(values, count);
  }
  return true;
}

// For arrays whose elements are wider in memory than in the file, or in another byte order.
template <class Number, class Element>
void BinaryDataOut::WriteConverted(const Element* values, int count) {
  unsigned char bytes[kConversionChunk * sizeof(Number)];
  for (int first = 0; first < count; first += kConversionChunk) {
    const int inChunk = std::min(kConversionChunk, count - first);
    unsigned char* next = bytes;
    for (const Element* value = values + first; value != values + first + inChunk; ++value) {
      StoreLittleEndian(next, static_cast<Number>(*value));
      next += sizeof(Number);
    }
    if (!m_file->Write(bytes, sizeof(Number) * static_cast<std::uint64_t>(inChunk))) {
      Error(kErrorWrite, __LINE__);
    }
  }
}

bool BinaryDataOut::WriteS8(char value) {
  return WriteNumber<char>(kTagS8, value);
}
bool BinaryDataOut::WriteU8(unsigned char value) {
  return WriteNumber<std::uint8_t>(kTagU8, value);
}
bool BinaryDataOut::WriteS16(short value) {
  return WriteNumber<std::int16_t>(kTagS16, value);
}
bool BinaryDataOut::WriteU16(unsigned short value) {
  return WriteNumber<std::uint16_t>(kTagU16, value);
}
bool BinaryDataOut::WriteS32(long value) {
  return WriteNumber<std::int32_t>(kTagS32, value);
}
bool BinaryDataOut::WriteU32(unsigned long value) {
  return WriteNumber<std::uint32_t>(kTagU32, value);
}
bool BinaryDataOut::WriteF32(float value) {
  return WriteNumber<float>(kTagF32, value);
}
bool BinaryDataOut::WriteF64(double value) {
  return WriteNumber<double>(kTagF64, value);
}
bool BinaryDataOut::WriteBool(bool value) {
  return WriteNumber<std::uint8_t>(kTagBool, static_cast<std::uint8_t>(value));
}

bool BinaryDataOut::WriteS8Array(const char* values, int count) {
  return WriteNumbers<char>(kTagS8, values, count);
}
bool BinaryDataOut::WriteU8Array(const unsigned char* values, int count) {
  return WriteNumbers<std::uint8_t>(kTagU8, values, count);
}
bool BinaryDataOut::WriteS16Array(const short* values, int count) {
  return WriteNumbers<std::int16_t>(kTagS16, values, count);
}
bool BinaryDataOut::WriteU16Array(const unsigned short* values, int count) {
  return WriteNumbers<std::uint16_t>(kTagU16, values, count);
}
bool BinaryDataOut::WriteS32Array(const long* values, int count) {
  return WriteNumbers<std::int32_t>(kTagS32, values, count);
}
bool BinaryDataOut::WriteS32Array(const std::int32_t* values, int count) {
  return WriteNumbers<std::int32_t>(kTagS32, values, count);
}
bool BinaryDataOut::WriteU32Array(const unsigned long* values, int count) {
  return WriteNumbers<std::uint32_t>(kTagU32, values, count);
}
bool BinaryDataOut::WriteU32Array(const std::uint32_t* values, int count) {
  return WriteNumbers<std::uint32_t>(kTagU32, values, count);
}
bool BinaryDataOut::WriteF32Array(const float* values, int count) {
  return WriteNumbers<float>(kTagF32, values, count);
}
bool BinaryDataOut::WriteF64Array(const double* values, int count) {
  return WriteNumbers<double>(kTagF64, values, count);
}

bool BinaryDataOut::WriteString(const std::string& text) {
  return WriteByteArray(text.c_str(), std::uint64_t{text.size()} + 1);
}

bool BinaryDataOut::WriteString(const dString& text) {
  return WriteByteArray(text.GetText(), std::uint64_t{text.Size()} + 1);
}

bool BinaryDataOut::WriteBuffer(const dBuffer& buffer) {
  return WriteByteArray(buffer.Get(0), buffer.GetSize());
}

bool BinaryDataOut::OpenBlock() {
  WriteItem(kTagBlock, nullptr, 0);
  return true;
}

bool BinaryDataOut::OpenBlock(unsigned long id) {
  if (m_file == nullptr) {
    Error(kErrorNotOpen, __LINE__);
  }
  if (!Fits<std::uint32_t>(id)) {
    Error(kErrorWrite, __LINE__);
  }
  WriteCount(kTagFamilyNumberedBlock, static_cast<std::uint32_t>(id));
  return true;
}

bool BinaryDataOut::CloseBlock() {
  WriteItem(kTagBlockEnd, nullptr, 0);
  return true;
}

bool BinaryDataOut::Write(IBinaryDataIO* object) {
  if (object == nullptr) {
    return false;
  }
  OpenBlock();
  object->Write(*this);
  return CloseBlock();
}

bool BinaryDataOut::Write(unsigned char tag, const void* data, unsigned long size) {
  WriteItem(tag, data, size);
  return true;
}

bool BinaryDataOut::WriteArray(unsigned char tag, const void* data, unsigned long elementSize,
                               unsigned long count) {
  if (m_file == nullptr) {
    Error(kErrorNotOpen, __LINE__);
  }
  const std::uint64_t largest = std::numeric_limits<std::uint64_t>::max();
  if (!Fits<std::uint32_t>(count) || (count > 0 && elementSize > largest / count)) {
    Error(kErrorWrite, __LINE__);
  }
  WriteCount(kTagFamilyLength, static_cast<std::uint32_t>(count));
  WriteItem(tag, data, std::uint64_t{elementSize} * count);
  return true;
}

bool BinaryDataOut::WriteByteArray(const void* bytes, std::uint64_t count) {
  if (m_file == nullptr) {
    Error(kErrorNotOpen, __LINE__);
  }
  if (!Fits<std::uint32_t>(count)) {
    Error(kErrorWrite, __LINE__);
  }
  return WriteArray(kTagU8, bytes, 1, static_cast<unsigned long>(count));
}

}  // namespace vorl
