#ifndef VORL_OPERATORS_IP_KERNELS_VOXELLIST_H
#define VORL_OPERATORS_IP_KERNELS_VOXELLIST_H

/// @file
/// Lists of voxel addresses, packed into 32 bits each: x in bits 0 to 10, y in 11 to 21, z in 22 to
/// 31.

#include <vorl/Data/dBuffer.h>

#include <cstddef>
#include <cstdint>
#include <cstring>

inline namespace vorl {
namespace vorl_detail {

struct VoxelAddress {
  std::int32_t x = 0;
  std::int32_t y = 0;
  std::int32_t z = 0;

  /// The slice index is taken as signed: from 512 on it reads as negative.
  static VoxelAddress Of(std::uint32_t entry) {
    return {static_cast<std::int32_t>(entry & 0x7FFU),
            static_cast<std::int32_t>((entry >> 11) & 0x7FFU),
            static_cast<std::int32_t>(entry) >> 22};
  }
};

/// The entry of a voxel; indices beyond their bits run into the next ones.
inline std::uint32_t PackVoxel(std::uint32_t x, std::uint32_t y, std::uint32_t z) {
  return (z << 22) | (y << 11) | x;
}

/// The whole entries of a buffer, wherever in memory it lies.
class VoxelListView {
 public:
  explicit VoxelListView(const dBuffer& list)
      : m_bytes(static_cast<const unsigned char*>(list.Get(0))),
        m_count(list.GetSize() / sizeof(std::uint32_t)) {}

  std::size_t Count() const { return m_count; }

  VoxelAddress operator[](std::size_t index) const {
    std::uint32_t entry = 0;
    std::memcpy(&entry, m_bytes + index * sizeof(entry), sizeof(entry));
    return VoxelAddress::Of(entry);
  }

 private:
  const unsigned char* m_bytes;
  std::size_t m_count;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
