#include <cli/Command.h>
#include <cli/Selection.h>
#include <cli/Values.h>
#include <cli/Watch.h>
#include <vorl/Operators/IP/opVoxelClassification.h>

#include <algorithm>
#include <cstring>
#include <limits>
#include <optional>

namespace cli {
namespace {

/// The entries of a buffer of unsigned 32-bit numbers.
std::vector<std::uint32_t> NumbersOf(const dBuffer& buffer) {
  std::vector<std::uint32_t> numbers(buffer.GetSize() / sizeof(std::uint32_t));
  if (!numbers.empty()) {
    std::memcpy(numbers.data(), buffer.Get(0), numbers.size() * sizeof(std::uint32_t));
  }
  return numbers;
}

/// The lowest class with voxels of the highest ones that together fit under the limit; the number
/// of classes when the highest class with voxels does not fit.
std::uint32_t LowestClass(const std::vector<std::uint32_t>& counters, std::uint64_t limit) {
  std::uint64_t sum = 0;
  std::size_t lowest = counters.size();
  while (lowest > 0 && sum + counters[lowest - 1] <= limit) {
    --lowest;
    sum += counters[lowest];
  }
  while (lowest < counters.size() && counters[lowest] == 0) {
    ++lowest;
  }
  return static_cast<std::uint32_t>(lowest);
}

void CheckSize(const dVolume& volume) {
  const auto& [width, height, slices] = study::kLargestListedVolume;
  if (volume.GetSizeX() > width || volume.GetSizeY() > height || volume.GetSizeZ() > slices) {
    const auto text = [](int x, int y, int z) {
      return std::to_string(x) + " x " + std::to_string(y) + " x " + std::to_string(z);
    };
    throw study::Error(
        "a volume of " + text(volume.GetSizeX(), volume.GetSizeY(), volume.GetSizeZ()) +
        " voxels is too large for a list of voxels (at most " + text(width, height, slices) + ")");
  }
}

void SetLimit(opVoxelClassification& op, const SelectionLimit& limit) {
  const dVolume& volume = *op.volume;
  const auto voxels = static_cast<std::uint64_t>(volume.GetSizeX()) *
                      static_cast<std::uint64_t>(volume.GetSizeY()) *
                      static_cast<std::uint64_t>(volume.GetSizeZ());
  if (limit.percent > 0) {
    op.SetSelectionLimit(limit.percent);
    if (op.selectionLimit == 0) {
      throw study::Error("--limit: " + NumberText(limit.percent) + "% of " +
                         std::to_string(voxels) + " voxels are less than one voxel");
    }
  } else {
    op.SetSelectionLimit(static_cast<unsigned int>(std::min<std::uint64_t>(limit.voxels, voxels)));
  }
}

}  // namespace

SelectionLimit ParseLimit(const std::string& option, const std::string& text) {
  SelectionLimit limit;
  try {
    if (!text.empty() && text.back() == '%') {
      limit.percent = ParsePositive(option, text.substr(0, text.size() - 1));
      if (limit.percent <= 100) {
        return limit;
      }
    } else {
      limit.voxels =
          static_cast<std::uint32_t>(ParseWhole(option, text, 1, std::numeric_limits<int>::max()));
      return limit;
    }
  } catch (const UsageError&) {
    // One text for all.
  }
  throw UsageError(option + ": " + study::Quoted(text) +
                   " is neither a number of voxels (from 1 to 2147483647) nor a percentage (up to "
                   "100%)");
}

Selection SelectVoxels(study::Study& study, bool byEdge, const SelectionLimit& limit,
                       const study::Progress& progress) {
  CheckSize(study.volume);
  Selection selection;
  opVoxelClassification op;
  op.volume = &study.volume;
  op.voxelList = &selection.buffer;
  SetLimit(op, limit);
  op.SelectAlgo(byEdge ? VoxelClassificationAlgo_Edge : VoxelClassificationAlgo_Value);
  RunWatched(op, study::PartOf(progress, 0, 0.5), "counting the voxels");
  CheckStatus(op, "count the voxels");
  op.SelectAlgo(VoxelClassificationAlgo_Select);
  RunWatched(op, study::PartOf(progress, 0.5, 1), "selecting the voxels");
  CheckStatus(op, "select the voxels");
  study::Report(progress, 1, "selecting the voxels");

  selection.counters = NumbersOf(op.classCounters);
  study::VoxelList& list = selection.list;
  list.size = {static_cast<std::uint32_t>(study.volume.GetSizeX()),
               static_cast<std::uint32_t>(study.volume.GetSizeY()),
               static_cast<std::uint32_t>(study.volume.GetSizeZ())};
  list.coordinates = study.volume.GetCoordinates();
  list.scale = study.scale;
  list.offset = study.offset;
  list.unit = study.unit;
  list.criterion = byEdge ? "edge" : "value";
  list.limit = op.selectionLimit;
  list.lowestClass = LowestClass(selection.counters, op.selectionLimit);
  list.voxels = NumbersOf(selection.buffer);
  return selection;
}

}  // namespace cli
