#ifndef TESTS_OPERATORS_IP_VOLUMES_H
#define TESTS_OPERATORS_IP_VOLUMES_H

/// @file
/// Volumes to reconstruct from.

#include <vorl/Data/dVolume.h>

#include "Rasters.h"

namespace rasters {

/// Appends an unpadded slice with these samples.
template <class T>
void AddSlice(dVolume& volume, const Format& format, const std::vector<T>& samples) {
  dSlice slice;
  MakeOf(slice.GetImage(), format, samples);
  ASSERT_GE(volume.AddSlice(slice), 0);
}

/// Appends `count` slices in which every byte is random, padding included.
inline void AddRandomSlices(dVolume& volume, const Format& format, int count, Random& random) {
  for (int i = 0; i < count; ++i) {
    dSlice slice;
    MakeRandom(slice.GetImage(), format, random);
    ASSERT_GE(volume.AddSlice(slice), 0);
  }
}

/// A volume of unsigned 16-bit voxels that counts: voxel (x, y, z) is 1 + x + 10 y + 100 z.
inline void MakeCounting(dVolume& volume, int width, int height, int count) {
  for (int z = 0; z < count; ++z) {
    std::vector<std::uint16_t> samples;
    for (int i = 0; i < width * height; ++i) {
      samples.push_back(static_cast<std::uint16_t>(1 + i % width + 10 * (i / width) + 100 * z));
    }
    AddSlice(volume,
             {.width = static_cast<unsigned long>(width),
              .height = static_cast<unsigned long>(height),
              .type = ImageDataType_U16},
             samples);
  }
}

/// All bytes of all slices, padding included.
inline Bytes BytesOf(const dVolume& volume) {
  Bytes bytes;
  for (const dSlice& slice : volume.GetSliceList()) {
    const Bytes more = BytesOf(slice.GetImage());
    bytes.insert(bytes.end(), more.begin(), more.end());
  }
  return bytes;
}

/// A slice of `width` x `height` pixels, unpadded, every byte of it marked.
inline void MakeSlice(dSlice& slice, unsigned long width, unsigned long height,
                      unsigned short type = ImageDataType_U16) {
  Make(slice.GetImage(), {.width = width, .height = height, .type = type});
  slice.GetImage().Fill(0x5A);
}

}  // namespace rasters

#endif
