#ifndef VORL_APPS_STUDY_PHANTOM_H
#define VORL_APPS_STUDY_PHANTOM_H

/// @file
/// A body that is made up, for trying everything without anybody's data.

#include <study/Progress.h>
#include <study/Study.h>

#include <memory>

namespace study {

/// The part of space that the phantom fills, whatever its size in voxels, in millimetres; the
/// centre is the world's origin.
inline constexpr double kPhantomWidthMm = 400;
inline constexpr double kPhantomDepthMm = 400;
inline constexpr double kPhantomHeightMm = 320;

/// A CT of a torso on a table: skin, fat and muscle; spine, ribs, sternum and pelvis of compact and
/// spongy bone; lungs with airways and vessel trees; heart, aorta and kidneys with contrast medium;
/// liver on the right, stomach with its air and spleen on the left; beside the body a block of line
/// pairs from 6 to 1 mm on the left and a metal bead on the right. It looks different from each of
/// the six sides. Values are Hounsfield units from -1024 (outside the round field of view) to 3000.
///
/// Every voxel takes the value at its centre, plus noise of a few units. Only additions,
/// multiplications, divisions and square roots are used, so equal sizes give equal bits everywhere.
///
/// Throws `Error` when a side is less than 1 or greater than 32,767, when there would be more than
/// 2,147,483,648 voxels, or when there is no memory.
std::unique_ptr<Study> MakePhantom(int width, int height, int slices,
                                   const Progress& progress = {});

}  // namespace study

#endif
