#ifndef TESTS_OPERATORS_IP_GUARDEDVOLUME_H
#define TESTS_OPERATORS_IP_GUARDEDVOLUME_H

/// @file
/// Inputs in memory whose surroundings would change what is made of them, were they read.

#include <algorithm>
#include <array>
#include <cstring>
#include <utility>
#include <vector>

#include "Volumes.h"

namespace rasters {

/// What stands in front of an input, behind it and, where the test says so, in the padding of its
/// rows.
enum class Around {
  Nothing,  ///< it fills its allocation, so that a sanitizer sees who leaves it
  Lowest,   ///< the lowest value of the type
  Highest
};

inline constexpr std::array kSurroundings = {Around::Nothing, Around::Lowest, Around::Highest};

inline const char* NameOf(Around around) {
  return around == Around::Nothing  ? "nothing around"
         : around == Around::Lowest ? "lowest values around"
                                    : "highest values around";
}

/// The bytes of one extreme sample of an integer type of `dataType`'s size and sign.
inline Bytes ExtremeSample(unsigned short dataType, Around around) {
  const bool isSigned = (dataType & 0x1000U) != 0;
  const bool highest = around == Around::Highest;
  Bytes sample(std::max(1U, (dataType & 0xFFU) / 8U), highest ? 0xFF : 0);
  if (isSigned) {
    sample.back() = highest ? 0x7F : 0x80;  // the byte of the sign comes last
  }
  return sample;
}

/// An operator's input in watched memory. Keeps the bytes; the object that shows them stays the
/// test's.
class GuardedInput {
 public:
  /// Lays the pixels of the image into this memory, which it shows from then on.
  void PutUnder(dImage& image, Around around, bool paddingToo) {
    const Bytes extreme = ExtremeSample(image.GetDataType(), around);
    Lay(image.GetDataBuffer(), extreme, around);
    if (paddingToo && around != Around::Nothing) {
      const std::size_t rowBytes = image.GetBytesPerRow();
      const std::size_t used = image.GetDataSamplesInRow() * (image.GetChannelDepth() / 8U);
      for (std::size_t row = m_guard; row < m_memory.size() - m_guard; row += rowBytes) {
        Fill(row + used, row + rowBytes, extreme);
      }
    }
    Watch();
  }

  /// Lays the unsigned 32-bit numbers of the buffer into this memory, which it shows from then on.
  void PutUnder(dBuffer& numbers, Around around) {
    Lay(numbers, ExtremeSample(ImageDataType_U32, around), around);
    Watch();
  }

  /// From now on all bytes shall stay as they are.
  void Watch() { m_before = m_memory; }

  /// Where the input lies.
  const unsigned char* Data() const { return m_memory.data() + m_guard; }

  /// The input's own bytes may have changed, nothing else.
  void ExpectSurroundingsUntouched() const {
    for (std::size_t i = 0; i < m_guard; ++i) {
      const std::size_t behind = m_memory.size() - 1 - i;
      ASSERT_EQ(m_memory[i], m_before[i]) << i << " bytes into the guard before the input";
      ASSERT_EQ(m_memory[behind], m_before[behind]) << "in the guard behind the input";
    }
  }

  /// All bytes are as they were, and the input still shows them.
  void ExpectUntouched() const {
    ASSERT_EQ(m_buffer->Get(0), Data());
    ASSERT_TRUE(m_memory == m_before) << "the input or what lies around it was written to";
  }

 private:
  void Lay(dBuffer& buffer, const Bytes& extreme, Around around) {
    const std::size_t size = buffer.GetSize();
    const std::size_t guard = around == Around::Nothing ? 0 : kGuard;
    Bytes memory(size + 2 * guard);
    std::memcpy(memory.data() + guard, buffer.Get(0), size);
    buffer.Init(memory.data() + guard, static_cast<unsigned long>(size), DTM_Reference);
    m_buffer = &buffer;
    m_guard = guard;
    m_memory = std::move(memory);  // the bytes stay where they are
    Fill(0, guard, extreme);
    Fill(guard + size, m_memory.size(), extreme);
  }

  // Begins with a whole sample wherever samples begin.
  void Fill(std::size_t begin, std::size_t end, const Bytes& extreme) {
    for (std::size_t i = begin; i < end; ++i) {
      m_memory[i] = extreme[(i - begin) % extreme.size()];
    }
  }

  static constexpr std::size_t kGuard = 64;

  const dBuffer* m_buffer = nullptr;
  std::size_t m_guard = 0;
  Bytes m_memory;
  Bytes m_before;
};

/// A volume each of whose slices is a guarded input.
class GuardedVolume : public dVolume {
 public:
  GuardedVolume() = default;
  GuardedVolume(const GuardedVolume&) = delete;
  GuardedVolume& operator=(const GuardedVolume&) = delete;

  void Surround(Around around, bool paddingToo) {
    m_slices.resize(GetSliceList().size());
    auto input = m_slices.begin();
    for (dSlice& slice : GetSliceList()) {
      (input++)->PutUnder(slice.GetImage(), around, paddingToo);
    }
  }

  /// No byte of the slices, of their padding and of what lies around them has changed since
  /// `Surround`, and they are still where they were laid.
  void ExpectUntouched() const {
    ASSERT_FALSE(m_slices.empty());
    for (const GuardedInput& slice : m_slices) {
      ASSERT_NO_FATAL_FAILURE(slice.ExpectUntouched());
    }
  }

 private:
  std::vector<GuardedInput> m_slices;
};

}  // namespace rasters

#endif
