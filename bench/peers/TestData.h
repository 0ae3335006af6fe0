#ifndef BENCH_PEERS_TESTDATA_H
#define BENCH_PEERS_TESTDATA_H

/// @file
/// The volume and the images that all works are done on: made up, the same in each run, and of the
/// kind that a scanner gives. Everybody reads the same memory where a library can take foreign
/// memory, and a copy elsewhere.

#include <cstddef>
#include <cstdint>
#include <new>
#include <vector>

namespace peers {

/// Memory that begins with a cache line.
template <class T>
struct LineAllocator {
  using value_type = T;
  LineAllocator() = default;
  template <class U>
  LineAllocator(const LineAllocator<U>&) {}  // NOLINT: allocators convert into each other
  T* allocate(std::size_t count) {
    return static_cast<T*>(::operator new (count * sizeof(T), std::align_val_t{kLine}));
  }
  void deallocate(T* memory, std::size_t) { ::operator delete (memory, std::align_val_t{kLine}); }
  template <class U>
  bool operator==(const LineAllocator<U>&) const {
    return true;
  }

 private:
  static constexpr std::size_t kLine = 64;
};

/// Samples row after row, slice after slice, without gaps.
template <class T>
using Samples = std::vector<T, LineAllocator<T>>;

inline constexpr int kWidth = 512;  ///< of the volume, in voxels
inline constexpr int kHeight = 512;
inline constexpr int kDepth = 300;
inline constexpr std::size_t kSliceVoxels = std::size_t{kWidth} * kHeight;
inline constexpr std::size_t kVoxels = kSliceVoxels * kDepth;
inline constexpr double kSpacing[3] = {0.7, 0.7, 1.2};  ///< of the voxels, in mm
inline constexpr int kValues = 4096;                    ///< voxels are below

inline constexpr int kImageEdge = 2048;  ///< of the images
inline constexpr std::size_t kImagePixels = std::size_t{kImageEdge} * kImageEdge;

/// A body in air inside the circle that a scanner reconstructs, 0 outside: noisy, softly varying,
/// with brighter balls in it.
const Samples<std::uint16_t>& Volume();
/// A slice of it, each voxel as 4 x 4 pixels with noise of their own.
const Samples<std::uint16_t>& Image16();
/// Images of 2048 x 2048 or 512 x 512 pixels in 256 grey levels.
const Samples<std::uint8_t>& Image8(int edge);
/// The same in colours, four bytes a pixel: blue, green, red, 255.
const Samples<std::uint32_t>& Image32(int edge);
/// That of 2048 x 2048 pixels with three bytes: blue, green, red.
const Samples<std::uint8_t>& Image24();

}  // namespace peers

#endif
