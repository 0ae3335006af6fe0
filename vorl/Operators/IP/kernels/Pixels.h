#ifndef VORL_OPERATORS_IP_KERNELS_PIXELS_H
#define VORL_OPERATORS_IP_KERNELS_PIXELS_H

/// @file
/// The inner loops of the pixel operators: one run of samples each.
///
/// The functions named `...Ref` are the plain references that say what is true; faster variants
/// must equal them bit for bit.

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

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
void MinMaxRunRef(const T* source, std::size_t count, std::int32_t& minimum, std::int32_t& maximum);

/// target[i] = source[i] * factor + offset with two roundings, truncated towards zero and saturated
/// to T; a result that is not a number counts as 0. Source and target may be the same memory.
template <class T>
void RescaleRunRef(const T* source, T* target, std::size_t count, double factor, double offset);

}  // namespace vorl_detail
}  // namespace vorl

#endif
