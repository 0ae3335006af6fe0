#ifndef VORL_DATA_DVOI_H
#define VORL_DATA_DVOI_H

/// @file
/// A box of voxels.

#include <cstdint>

inline namespace vorl {

/// A volume of interest: its first voxel and its sizes, in voxels.
struct dVOI {
  std::uint32_t firstX = 0;
  std::uint32_t firstY = 0;
  std::uint32_t firstZ = 0;
  std::uint32_t sizeX = 0;
  std::uint32_t sizeY = 0;
  std::uint32_t sizeZ = 0;
};

}  // namespace vorl

#endif
