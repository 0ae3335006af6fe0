#ifndef VORL_APPS_CLI_SELECTION_H
#define VORL_APPS_CLI_SELECTION_H

/// @file
/// Selecting the highest voxels of a volume.

#include <study/Progress.h>
#include <study/Study.h>
#include <study/VoxelListFile.h>
#include <vorl/Data/dBuffer.h>

#include <cstdint>
#include <string>
#include <vector>

namespace cli {

/// How many voxels are wanted: a number, or a percentage of the volume.
struct SelectionLimit {
  std::uint32_t voxels = 0;
  double percent = 0;  ///< 0: the number counts
};

/// "1000" or "2.5%". Throws `UsageError`.
SelectionLimit ParseLimit(const std::string& option, const std::string& text);

/// What has been selected, and out of what.
struct Selection {
  study::VoxelList list;
  dBuffer buffer;                       ///< the same voxels, as the operators take them
  std::vector<std::uint32_t> counters;  ///< the voxels of each class
};

/// Counts the voxels by their stored value or, with `byEdge`, their edge strength, and lists those
/// of the highest classes that together have no more voxels than the limit. Throws `study::Error`,
/// also for a volume that is too large for a list.
Selection SelectVoxels(study::Study& study, bool byEdge, const SelectionLimit& limit,
                       const study::Progress& progress);

}  // namespace cli

#endif
