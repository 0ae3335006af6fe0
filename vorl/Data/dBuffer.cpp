#include <vorl/Data/dBuffer.h>

#include <algorithm>
#include <cstring>
#include <functional>
#include <limits>
#include <memory>
#include <utility>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/detail/Block.h>

inline namespace vorl {

namespace {

constexpr std::uint64_t kBlockUnit = 8;
constexpr std::uint64_t kCapacityLimit = (std::uint64_t{1} << 32) - 8;
constexpr std::uint64_t kSizeLimit = std::numeric_limits<std::uint32_t>::max();

/// Frees a detached block at the end of a scope.
struct DetachedBlockDeleter {
  void operator()(void* block) const { vorl_detail::FreeBlock(block); }
};
using DetachedBlock = std::unique_ptr<void, DetachedBlockDeleter>;

/// `size` rounded up to whole units; the last whole unit where 64 bits cannot hold more.
std::uint64_t RoundUp(std::uint64_t size) {
  constexpr std::uint64_t last =
      std::numeric_limits<std::uint64_t>::max() / kBlockUnit * kBlockUnit;
  return size > last ? last : (size + kBlockUnit - 1) / kBlockUnit * kBlockUnit;
}

void ReportFailure(LogContext& context, int line, std::uint64_t bytes) {
  context.Error(line, "can't allocate %llu bytes", static_cast<unsigned long long>(bytes));
}

/// Repeats the pattern over `size` bytes at any address.
void FillBytes(unsigned char* bytes, std::size_t size, std::uint32_t pattern) {
  if (pattern == (pattern & 0xFFu) * 0x01010101u) {
    std::memset(bytes, static_cast<int>(pattern & 0xFFu), size);
    return;
  }
  const std::uint32_t words[2] = {pattern, pattern};
  std::size_t i = 0;
  for (; i + sizeof words <= size; i += sizeof words) {
    std::memcpy(bytes + i, words, sizeof words);
  }
  std::memcpy(bytes + i, words, size - i);
}

}  // namespace

VORL_REGISTER_CLASS(dBuffer, DataBase);

dBuffer::dBuffer() = default;

dBuffer::dBuffer(unsigned long size) {
  New(size, false);
}

dBuffer::dBuffer(void* data, unsigned long size, DataTransferMode mode) {
  Init(data, size, mode);
}

dBuffer::dBuffer(dBuffer& source, DataTransferMode mode) {
  Init(source, mode);
}

dBuffer::dBuffer(const dBuffer& source, DataTransferMode mode) {
  Init(source, mode);
}

dBuffer::dBuffer(const dBuffer& source) : DataBase(source) {
  *this = source;
}

dBuffer& dBuffer::operator=(const dBuffer& source) {
  LogContext context("dBuffer::operator = ", __FILE__, __LINE__, true);
  if (this != &source) {
    CopyBytes(source.m_data, source.m_size);
  }
  return *this;
}

dBuffer::~dBuffer() {
  Delete();
}

void dBuffer::Reset() {
  Delete();
}

bool dBuffer::IsValid() {
  return m_data != nullptr;
}

dBuffer& dBuffer::New(unsigned long size, bool clear) {
  LogContext context("dBuffer::New", __FILE__, __LINE__, true);
  if (size > m_size && size > m_capacity) {
    Delete();
    const std::uint64_t capacity = RoundUp(size);
    if (capacity < kCapacityLimit) {
      m_data = static_cast<unsigned char*>(
          vorl_detail::AllocateBlock(static_cast<std::size_t>(capacity)));
    }
    if (m_data == nullptr) {
      ReportFailure(context, __LINE__, capacity);
      size = 0;
    } else {
      m_capacity = static_cast<std::uint32_t>(capacity);
    }
  }
  m_size = static_cast<std::uint32_t>(size);
  if (clear) {
    Set(0);
  }
  return *this;
}

dBuffer& dBuffer::Init(void* data, unsigned long size, DataTransferMode mode) {
  LogContext context("dBuffer::Init", __FILE__, __LINE__, true);
  if (data == m_data) {
    return *this;
  }
  const bool inOwnBlock = OwnsAddress(data);
  const DetachedBlock oldBlock(inOwnBlock ? Detach() : nullptr);
  Delete();
  if (data == nullptr) {
    return *this;
  }
  if (mode == DTM_Copy || mode == DTM_TakeOver || (mode == DTM_Reference && inOwnBlock)) {
    CopyBytes(data, size);
  } else if (mode == DTM_Reference && size > kSizeLimit) {
    ReportFailure(context, __LINE__, RoundUp(size));
  } else if (mode == DTM_Reference) {
    Refer(data, static_cast<std::uint32_t>(size));
  }
  return *this;
}

dBuffer& dBuffer::Init(dBuffer& source, DataTransferMode mode) {
  if (this == &source || mode != DTM_TakeOver || OwnsAddress(source.m_data)) {
    Init(static_cast<const dBuffer&>(source), mode);
    if (this != &source && mode == DTM_TakeOver) {
      source.Delete();
    }
    return *this;
  }
  LogContext context("dBuffer::Init", __FILE__, __LINE__, true);
  Delete();
  std::swap(m_data, source.m_data);
  std::swap(m_size, source.m_size);
  std::swap(m_capacity, source.m_capacity);
  return *this;
}

dBuffer& dBuffer::Init(const dBuffer& source, DataTransferMode mode) {
  LogContext context("dBuffer::Init", __FILE__, __LINE__, true);
  if (this == &source) {
    return *this;
  }
  const bool inOwnBlock = OwnsAddress(source.m_data);
  const DetachedBlock oldBlock(inOwnBlock ? Detach() : nullptr);
  Delete();
  if (mode == DTM_Copy || mode == DTM_TakeOver || (mode == DTM_Reference && inOwnBlock)) {
    *this = source;
  } else if (mode == DTM_Reference) {
    Refer(source.m_data, source.m_size);
  }
  return *this;
}

dBuffer& dBuffer::Resize(unsigned long size) {
  LogContext context("dBuffer::Resize", __FILE__, __LINE__, true);
  const std::uint32_t oldSize = m_size;
  if (size > m_capacity) {
    const unsigned char* oldData = m_data;
    const DetachedBlock oldBlock(Detach());
    New(size, false);
    if (m_data != nullptr && oldData != nullptr) {
      std::memcpy(m_data, oldData, std::min(oldSize, m_size));
    }
  } else {
    m_size = static_cast<std::uint32_t>(size);
  }
  const std::uint32_t kept = std::min(oldSize, m_size);
  if (kept < m_capacity) {
    std::memset(m_data + kept, 0, m_capacity - kept);
  }
  return *this;
}

bool dBuffer::Delete() {
  vorl_detail::FreeBlock(Detach());
  return true;
}

void dBuffer::operator<<=(dBuffer& source) {
  Init(source, DTM_TakeOver);
}

void dBuffer::operator>>=(dBuffer& destination) {
  destination.Init(*this, DTM_TakeOver);
}

void dBuffer::Set(unsigned int pattern) {
  if (m_data == nullptr) {
    return;
  }
  const std::size_t filled =
      m_capacity == 0 ? std::size_t{m_size} : static_cast<std::size_t>(RoundUp(m_size));
  FillBytes(m_data, filled, pattern);
}

void dBuffer::Set(unsigned long pattern) {
  Set(static_cast<unsigned int>(pattern & 0xFFFFFFFFu));
}

void dBuffer::Set(int pattern) {
  Set(static_cast<unsigned int>(pattern));
}

void dBuffer::Set(unsigned short value) {
  Set(value * 65537u);
}

void dBuffer::Set(unsigned char value) {
  Set(value * 16843009u);
}

unsigned long dBuffer::GetCapacity() const {
  return m_capacity;
}

bool dBuffer::IsReference() const {
  return m_size > 0 && m_capacity == 0;
}

dBuffer::operator bool() const {
  return m_data != nullptr;
}

bool dBuffer::OwnsAddress(const void* address) const {
  const std::less<const void*> before;
  return m_capacity > 0 && !before(address, m_data) && before(address, m_data + m_capacity);
}

// Empties the buffer without freeing; returns the block if it is owned, else null.
void* dBuffer::Detach() {
  void* const ownBlock = m_capacity > 0 ? m_data : nullptr;
  m_data = nullptr;
  m_size = 0;
  m_capacity = 0;
  return ownBlock;
}

// Copies bytes that may lie in the buffer's own block.
void dBuffer::CopyBytes(const void* bytes, unsigned long size) {
  const DetachedBlock oldBlock(size > m_capacity && OwnsAddress(bytes) ? Detach() : nullptr);
  New(size, false);
  if (m_size > 0) {
    std::memmove(m_data, bytes, m_size);
  }
}

void dBuffer::Refer(void* data, std::uint32_t size) {
  m_data = static_cast<unsigned char*>(data);
  m_size = size;
}

}  // namespace vorl
