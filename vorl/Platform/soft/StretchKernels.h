#ifndef VORL_PLATFORM_SOFT_STRETCHKERNELS_H
#define VORL_PLATFORM_SOFT_STRETCHKERNELS_H

/// @file
/// The inner loops of stretching: one row of units each.
///
/// The functions named `...Ref` are the plain references that say what is true; the variants behind
/// `StretchKernels` equal them bit for bit.

#include <vorl/Platform/detail/Cpu.h>

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// Which source unit each target unit shows, prepared for registers: a block of target units that
/// are neighbours shows units of one register full of the source.
struct GatherBlocks {
  const int* columns = nullptr;           ///< for each target unit its source unit
  std::size_t count = 0;                  ///< of target units
  std::size_t blocks = 0;                 ///< which are prepared, from the first target unit on
  const int* firsts = nullptr;            ///< for each block the first unit of its register
  const std::uint8_t* offsets = nullptr;  ///< for each of its target units the unit's place there
};

/// target[i] = units[columns[i]], for units of a size. They do not overlap.
using GatherRun = void(const std::uint8_t* units, const GatherBlocks& plan, std::uint8_t* target);
template <int kBytes>
void GatherRunRef(const std::uint8_t* units, const GatherBlocks& plan, std::uint8_t* target);

/// A table of 256 pixels of 32 bits, and its bytes in planes, the lowest first.
struct PixelTable {
  PixelTable() = default;
  explicit PixelTable(const std::array<std::uint32_t, 256>& pixels);

  std::uint32_t pixels[256] = {};
  std::uint8_t planes[4][256] = {};
  bool topIsZero = true;  ///< plane 3 is
  bool isGrey = true;     ///< planes 0 to 2 are equal, and plane 3 is 0
};

/// target[i] = pixels[source[i]], the lowest byte first. They do not overlap.
using MapTo32Run = void(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
                        const PixelTable& table);
void MapTo32RunRef(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
                   const PixelTable& table);

/// One variant of each loop.
struct StretchKernels {
  GatherRun* gather1;  ///< units of 1 byte
  std::size_t block1;  ///< its units in a register
  GatherRun* gather4;  ///< units of 4 bytes
  std::size_t block4;  ///< its units in a register
  MapTo32Run* mapTo32;
  GatherRun* stream4;   ///< `gather4` past the caches, to targets at a cache line; may be null
  void (*endStream)();  ///< to be called before anyone else looks at what was streamed
};

/// The loops of a variant that can run here (see `CanRun`).
const StretchKernels& StretchKernelsOf(CpuVariant variant);

/// The loops of the active variant.
const StretchKernels& ActiveStretchKernels();

/// A stretch along a row, prepared once for all rows.
class GatherPlan {
 public:
  /// Target unit i shows source unit columns[i], one of `sourceCount`. Units are of 1 to 4 bytes.
  /// Keeps `columns`, which stay the caller's.
  GatherPlan(const std::vector<int>& columns, int sourceCount, int bytes,
             const StretchKernels& kernels);

  /// `units` are all the source units; they do not overlap with the target.
  void Gather(const std::uint8_t* units, std::uint8_t* target) const;
  /// The same past the caches, for a target that they would not keep. False, and nothing is done,
  /// where there is no way. `StretchKernels::endStream` must follow.
  bool Stream(const std::uint8_t* units, std::uint8_t* target) const;

 private:
  void Prepare(std::size_t sourceCount, std::size_t block);

  GatherRun* m_gather;
  GatherRun* m_stream;
  std::vector<int> m_firsts;
  std::vector<std::uint8_t> m_offsets;
  GatherBlocks m_blocks;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
