#ifndef VORL_APPS_STUDY_VOXELLISTFILE_H
#define VORL_APPS_STUDY_VOXELLISTFILE_H

/// @file
/// Lists of selected voxels as files of the library's own format (`.bdf`).
///
/// The type name is "vorlVoxelList"; after it stand, in this order:
///
///     U32           the version, 1
///     U32 x 3       the volume's size: columns, rows, slices
///     F32 array     the volume's coordinates: origin, x axis, y axis, z axis (12 numbers)
///     F64 F64       scale and offset of the values: real = stored * scale + offset
///     String        their unit
///     String        what the voxels were selected by: "value" or "edge"
///     U32           how many voxels were allowed at most
///     U32           the lowest class that is listed: a stored value, or an edge strength (a
///                   difference of stored values)
///     U32 array     the voxels: z << 22 | y << 11 | x each, in the order z, y, x
///     String        "end"

#include <study/Progress.h>
#include <study/Study.h>

#include <array>
#include <cstdint>
#include <filesystem>
#include <string>
#include <vector>

namespace study {

/// The largest volume whose voxels a list can name so that they can be drawn.
inline constexpr std::array<int, 3> kLargestListedVolume{2048, 2048, 512};

/// Voxels of one volume.
struct VoxelList {
  std::array<std::uint32_t, 3> size{};  ///< of the volume: columns, rows, slices
  dCoordSys3D coordinates;              ///< of the volume
  double scale = 1;
  double offset = 0;
  std::string unit;
  std::string criterion;          ///< "value" or "edge"
  std::uint32_t limit = 0;        ///< how many voxels were allowed
  std::uint32_t lowestClass = 0;  ///< that is listed
  std::vector<std::uint32_t> voxels;
};

/// Writes the list; the file appears only when it is complete and has been read back and found
/// equal. Throws `Error` ("can't write 'name': ...").
void WriteVoxelList(const VoxelList& list, const std::filesystem::path& path,
                    const Progress& progress = {});

/// Reads a list. Throws `Error` ("can't read 'name': ...") when anything in it is not as it must
/// be: a voxel outside the volume, for instance.
VoxelList ReadVoxelList(const std::filesystem::path& path);

}  // namespace study

#endif
