#ifndef VORL_APPS_STUDY_PHANTOM_SHAPES_H
#define VORL_APPS_STUDY_PHANTOM_SHAPES_H

/// @file
/// The solids that the phantom is made of.

#include <study/Vec3.h>

#include <cstdint>
#include <limits>
#include <vector>

namespace study {

/// The value of spongy bone, which the phantom gives a grain.
inline constexpr std::int16_t kSpongyBone = 230;

/// A solid of one value. Lengths are millimetres.
struct Shape {
  enum class Kind {
    Ellipsoid,  ///< `a` the centre, `b` the radii
    Column,     ///< `a` the centre, `b.x` and `b.y` the radii, `b.z` half the height
    Box,        ///< `a` the centre, `b` half the edges
    Capsule     ///< all points within `radius` of the line from `a` to `b`
  };

  Kind kind = Kind::Ellipsoid;
  Vec3 a;
  Vec3 b;
  double radius = 0;
  std::int16_t value = 0;
  /// Only voxels that hold at most this value so far are filled.
  std::int16_t onlyUpTo = std::numeric_limits<std::int16_t>::max();

  bool Contains(const Vec3& p) const;
  /// The smallest box around the solid.
  Vec3 Lower() const;
  Vec3 Upper() const;
};

/// The solids of the torso; later ones cover earlier ones.
std::vector<Shape> TorsoShapes();

}  // namespace study

#endif
