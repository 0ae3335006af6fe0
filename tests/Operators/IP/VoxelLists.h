#ifndef TESTS_OPERATORS_IP_VOXELLISTS_H
#define TESTS_OPERATORS_IP_VOXELLISTS_H

/// @file
/// Lists of packed voxel addresses, honest and hostile.

#include <vorl/Data/dVolume.h>

#include <array>
#include <cstring>
#include <vector>

#include "Rasters.h"

namespace voxel_lists {

/// x in bits 0 to 10, y in 11 to 21, z in 22 to 31.
inline std::uint32_t Pack(std::uint32_t x, std::uint32_t y, std::uint32_t z) {
  return x + y * 2048U + z * 4194304U;
}

inline dBuffer ListOf(const std::vector<std::uint32_t>& entries) {
  dBuffer list(static_cast<unsigned long>(entries.size() * 4));
  if (!entries.empty()) {
    std::memcpy(list.Get(0), entries.data(), entries.size() * 4);
  }
  return list;
}

inline std::vector<std::uint32_t> EntriesOf(const dBuffer& list) {
  std::vector<std::uint32_t> entries(list.GetSize() / 4);
  if (!entries.empty()) {
    std::memcpy(entries.data(), list.Get(0), entries.size() * 4);
  }
  return entries;
}

/// Up to a hundred entries at any address, some of voxels of the volume, some just outside, some
/// of any bits, and up to three bytes more that make no entry.
class HostileList {
 public:
  HostileList(const dVolume& volume, rasters::Random& random) {
    const auto offset = static_cast<std::size_t>(random.Between(0, 7));
    const auto more = static_cast<std::size_t>(random.Between(0, 3));
    const int count = random.Between(1, 100);
    for (int i = 0; i < count; ++i) {
      m_entries.push_back(Entry(volume, random));
    }
    // The bytes behind the last entry end the allocation, so that reading on is noticed.
    m_memory.resize(offset + m_entries.size() * 4 + more);
    random.Fill(m_memory.data(), m_memory.size());
    std::memcpy(m_memory.data() + offset, m_entries.data(), m_entries.size() * 4);
    m_before = m_memory;
    m_buffer.Init(m_memory.data() + offset, static_cast<unsigned long>(m_entries.size() * 4 + more),
                  DTM_Reference);
  }
  HostileList(const HostileList&) = delete;
  HostileList& operator=(const HostileList&) = delete;

  dBuffer& Buffer() { return m_buffer; }
  const std::vector<std::uint32_t>& Entries() const { return m_entries; }

  void ExpectUntouched() const { ASSERT_EQ(m_memory, m_before); }

 private:
  static std::uint32_t Entry(const dVolume& volume, rasters::Random& random) {
    if (random.Between(0, 4) == 0) {
      std::uint32_t any = 0;
      random.Fill(&any, sizeof(any));
      return any;
    }
    const int beyond = random.Between(0, 3) == 0 ? 2 : -1;
    const auto index = [&](int size) {
      return static_cast<std::uint32_t>(random.Between(0, size + beyond));
    };
    const std::uint32_t x = index(volume.GetSizeX());
    const std::uint32_t y = index(volume.GetSizeY());
    return Pack(x, y, index(volume.GetSizeZ()));
  }

  std::vector<std::uint32_t> m_entries;
  rasters::Bytes m_memory;
  rasters::Bytes m_before;
  dBuffer m_buffer;
};

}  // namespace voxel_lists

#endif
