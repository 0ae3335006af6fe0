#ifndef VORL_APPS_CLI_HISTOGRAM_H
#define VORL_APPS_CLI_HISTOGRAM_H

/// @file
/// How often each stored value occurs.

#include <study/Study.h>

#include <cstddef>
#include <cstdint>
#include <vector>

namespace cli {

/// The values that a sample can have.
inline constexpr std::size_t kStoredValues = 65536;

/// A count for each of the stored values, 0 to 65535.
using Histogram = std::vector<std::uint64_t>;

/// Counts all voxels of a study, or all pixels of a cut.
Histogram HistogramOf(const study::Study& study);

/// The value that parts the dark from the bright samples best: the one that leaves the least
/// variance within the two groups (N. Otsu, 1979). Samples above it are bright. Where all are equal
/// it is the value below theirs, so that all are bright; 0 at least.
std::uint16_t PartingValue(const Histogram& counts);

}  // namespace cli

#endif
