#ifndef VORL_OPERATORS_IP_KERNELS_PIXELS_H
#define VORL_OPERATORS_IP_KERNELS_PIXELS_H

/// @file
/// The inner loops of the pixel operators: one run of samples each.
///
/// The functions named `...Ref` are the plain references that say what is true; the variants behind
/// `PixelKernels` equal them bit for bit.

#include <vorl/Platform/detail/Cpu.h>

#include <cstddef>
#include <cstdint>
#include <tuple>

inline namespace vorl {
namespace vorl_detail {

struct WindowRamp;

/// A table of 8-bit entries whose first stands for the sample value `start`.
struct LookupTable {
  const std::uint8_t* entries;
  std::int64_t start;
  std::int64_t size;
};

/// target[i] = the entry of source[i]; a sample outside the table takes its nearest entry. Source
/// and target may be the same memory.
template <class T>
void LookupRunRef(const T* source, std::uint8_t* target, std::size_t count,
                  const LookupTable& table);

/// Extends `minimum` and `maximum` over the samples.
template <class T>
using MinMaxRun = void(const T* source, std::size_t count, std::int32_t& minimum,
                       std::int32_t& maximum);
template <class T>
void MinMaxRunRef(const T* source, std::size_t count, std::int32_t& minimum, std::int32_t& maximum);

/// target[i] = source[i] * factor + offset with two roundings, truncated towards zero and saturated
/// to T; a result that is not a number counts as 0. Source and target may be the same memory.
template <class T>
using RescaleRun = void(const T* source, T* target, std::size_t count, double factor,
                        double offset);
template <class T>
void RescaleRunRef(const T* source, T* target, std::size_t count, double factor, double offset);

/// target[i] = entries[source[i]], of 256 entries. Source and target may be the same memory.
using MapBytesRun = void(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
                         const std::uint8_t* entries);
void MapBytesRunRef(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
                    const std::uint8_t* entries);

/// target[i] = the entry of source[i] of the table that the ramp was made for (see `WindowRamp`).
using WindowRun = void(const std::uint16_t* source, std::uint8_t* target, std::size_t count,
                       const WindowRamp& ramp);

/// One variant of each loop.
struct PixelKernels {
  MapBytesRun* mapBytes;
  WindowRun* window;  ///< null where a table is as fast
  std::tuple<MinMaxRun<std::uint8_t>*, MinMaxRun<std::int8_t>*, MinMaxRun<std::uint16_t>*,
             MinMaxRun<std::int16_t>*, MinMaxRun<std::int32_t>*>
      minMax;
  std::tuple<RescaleRun<std::uint16_t>*, RescaleRun<std::int16_t>*> rescale;
};

/// The loops of a variant that can run here (see `CanRun`).
const PixelKernels& PixelKernelsOf(CpuVariant variant);

/// The loops of the active variant.
const PixelKernels& ActivePixelKernels();

}  // namespace vorl_detail
}  // namespace vorl

#endif
