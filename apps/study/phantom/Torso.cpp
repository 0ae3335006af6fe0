#include <study/Phantom.h>
#include <study/phantom/Shapes.h>

#include <algorithm>
#include <array>

// The torso, from the outside to the inside and from the soft to the hard. x grows to the left of
// the body, y to its back, z to its head; left and right differ, and so do front and back, top and
// bottom.

namespace study {
namespace {

constexpr double kAllHeights = kPhantomHeightMm;  // more than half the height: cut by the field

constexpr std::int16_t kFat = -100;
constexpr std::int16_t kMuscle = 55;
constexpr std::int16_t kCompactBone = 850;
constexpr std::int16_t kContrast = 340;
constexpr std::int16_t kUpToLung = -700;

using Shapes = std::vector<Shape>;

void AddEllipsoid(Shapes& shapes, Vec3 centre, Vec3 radii, std::int16_t value) {
  shapes.push_back({Shape::Kind::Ellipsoid, centre, radii, 0, value});
}

void AddColumn(Shapes& shapes, Vec3 centre, Vec3 radii, std::int16_t value) {
  shapes.push_back({Shape::Kind::Column, centre, radii, 0, value});
}

void AddBox(Shapes& shapes, Vec3 lower, Vec3 upper, std::int16_t value) {
  shapes.push_back({Shape::Kind::Box, 0.5 * (lower + upper), 0.5 * (upper - lower), 0, value});
}

void AddCapsule(Shapes& shapes, Vec3 from, Vec3 to, double radius, std::int16_t value) {
  shapes.push_back({Shape::Kind::Capsule, from, to, radius, value});
}

void AddHull(Shapes& shapes) {
  AddColumn(shapes, {0, 0, 0}, {165, 115, kAllHeights}, 30);
  AddColumn(shapes, {0, 0, 0}, {162, 112, kAllHeights}, kFat);
  AddColumn(shapes, {0, 0, 0}, {146, 99, kAllHeights}, kMuscle);
  AddColumn(shapes, {0, -4, 0}, {128, 82, kAllHeights}, kFat);
}

void AddLungs(Shapes& shapes) {
  AddEllipsoid(shapes, {-65, -3, 70}, {54, 70, 110}, -860);
  AddEllipsoid(shapes, {64, 0, 76}, {47, 66, 98}, -850);
  AddCapsule(shapes, {0, 5, 170}, {0, 12, 96}, 8.5, -990);
  AddCapsule(shapes, {0, 12, 96}, {-44, 10, 62}, 6, -990);
  AddCapsule(shapes, {0, 12, 96}, {42, 10, 70}, 5, -990);
  AddEllipsoid(shapes, {-82, -22, 92}, {5, 5, 5}, 130);
}

/// A small generator of numbers from -1 to 1, the same everywhere.
class Directions {
 public:
  explicit Directions(std::uint32_t seed) : m_state(seed) {}
  double Next() {
    m_state = m_state * 1664525u + 1013904223u;  // wraps
    return static_cast<double>(m_state >> 8) / 8388608.0 - 1;
  }

 private:
  std::uint32_t m_state;
};

/// A vessel that divides in two until it is thin. It fills lung only.
void AddVessels(Shapes& shapes, Directions& directions, const Vec3& from, const Vec3& direction,
                double length, double radius, int generations) {
  const Vec3 to = from + direction * length;
  shapes.push_back({Shape::Kind::Capsule, from, to, radius, 40, kUpToLung});
  if (generations == 0) {
    return;
  }
  for (int branch = 0; branch < 2; ++branch) {
    const Vec3 bend{directions.Next(), directions.Next(), directions.Next()};
    AddVessels(shapes, directions, to, Normalised(direction + bend), length * 0.8, radius * 0.75,
               generations - 1);
  }
}

void AddLungVessels(Shapes& shapes) {
  Directions right(20011);
  AddVessels(shapes, right, {-22, 5, 62}, Normalised({-1, 0.1, 0.5}), 26, 6, 6);
  AddVessels(shapes, right, {-22, 8, 55}, Normalised({-0.8, 0.4, -0.6}), 24, 6, 6);
  Directions left(4093);
  AddVessels(shapes, left, {24, 5, 70}, Normalised({1, 0.2, 0.6}), 24, 5.5, 6);
  AddVessels(shapes, left, {24, 8, 60}, Normalised({0.9, 0.5, -0.5}), 22, 5.5, 6);
}

void AddOrgans(Shapes& shapes) {
  AddEllipsoid(shapes, {-52, -8, -62}, {72, 68, 56}, 105);  // liver
  AddEllipsoid(shapes, {-75, -30, -58}, {12, 12, 12}, 60);
  AddCapsule(shapes, {-20, 5, -75}, {-70, 5, -50}, 5, 170);
  AddCapsule(shapes, {-50, 5, -60}, {-75, -25, -85}, 4, 170);
  AddEllipsoid(shapes, {62, -26, -58}, {42, 38, 38}, 35);  // stomach
  AddEllipsoid(shapes, {62, -46, -54}, {27, 16, 24}, -960);
  AddEllipsoid(shapes, {96, 34, -52}, {24, 30, 42}, 115);  // spleen
  AddEllipsoid(shapes, {-58, 52, -112}, {25, 22, 40}, 180);
  AddEllipsoid(shapes, {-50, 52, -112}, {10, 10, 16}, 280);
  AddEllipsoid(shapes, {60, 52, -98}, {25, 22, 42}, 185);
  AddEllipsoid(shapes, {52, 52, -98}, {10, 10, 18}, 280);
}

void AddHeartAndVessels(Shapes& shapes) {
  AddEllipsoid(shapes, {24, -30, 8}, {50, 42, 46}, 48);
  AddEllipsoid(shapes, {34, -28, 2}, {24, 20, 28}, 320);
  AddEllipsoid(shapes, {2, -36, 14}, {20, 18, 24}, 190);
  AddCapsule(shapes, {12, -22, 30}, {-10, -16, 84}, 13, kContrast);
  AddCapsule(shapes, {-10, -16, 84}, {0, 8, 118}, 12.5, kContrast);
  AddCapsule(shapes, {0, 8, 118}, {22, 36, 104}, 12, kContrast);
  AddCapsule(shapes, {22, 36, 104}, {16, 40, -170}, 10.5, kContrast);
  AddCapsule(shapes, {16, 40, -100}, {52, 48, -98}, 3.5, kContrast);
  AddCapsule(shapes, {16, 40, -110}, {-50, 48, -112}, 3.5, kContrast);
  AddCapsule(shapes, {-22, 24, -170}, {-18, 10, 30}, 11, 130);
}

void AddVertebra(Shapes& shapes, double z) {
  AddColumn(shapes, {0, 62, z}, {22, 18, 10}, kCompactBone);
  AddColumn(shapes, {0, 62, z}, {19.5, 15.5, 8}, kSpongyBone);
  AddColumn(shapes, {0, 86, z}, {15, 13, 9}, 700);
  AddCapsule(shapes, {0, 96, z}, {0, 104, z - 10}, 4, 700);
  for (const double side : {-1.0, 1.0}) {
    AddCapsule(shapes, {14 * side, 82, z}, {36 * side, 86, z + 2}, 4.5, 600);
  }
}

/// The way of one rib as fractions of a half turn from the back to the front.
void AddRib(Shapes& shapes, double side, double z) {
  constexpr int kPieces = 18;
  Vec3 from;
  for (int i = 0; i <= kPieces; ++i) {
    const double u = 0.15 + 2.6 * i / kPieces;  // the tangent of half the angle
    const double sine = 2 * u / (1 + u * u);
    const double cosine = (1 - u * u) / (1 + u * u);
    const Vec3 to{137 * side * sine, -3 + 91 * cosine, z - 24 * (1 - cosine)};
    if (i > 0) {
      AddCapsule(shapes, from, to, 5.5, kCompactBone);
    }
    from = to;
  }
}

void AddSkeleton(Shapes& shapes) {
  AddColumn(shapes, {0, 62, 0}, {21, 17, kAllHeights}, 95);  // discs, seen between the vertebrae
  for (int n = 0; n < 13; ++n) {
    AddVertebra(shapes, -156 + 26.0 * n);
  }
  AddColumn(shapes, {0, 86, 0}, {9, 8, kAllHeights}, 15);
  for (int n = 0; n < 7; ++n) {
    AddRib(shapes, -1, 0 + 26.0 * n);
    AddRib(shapes, 1, 0 + 26.0 * n);
  }
  AddEllipsoid(shapes, {0, -88, 66}, {19, 7, 62}, 700);
  AddEllipsoid(shapes, {0, -88, 66}, {15, 4, 58}, kSpongyBone);
  for (const double side : {-1.0, 1.0}) {
    AddEllipsoid(shapes, {78 * side, 30, -168}, {42, 34, 36}, kCompactBone);
    AddEllipsoid(shapes, {78 * side, 28, -170}, {38, 30, 32}, kSpongyBone);
  }
}

/// Line pairs of 6 to 1 mm across the body, and of 6 to 2 mm along it.
void AddLinePairs(Shapes& shapes) {
  AddBox(shapes, {88, -172, -125}, {168, -108, 115}, 120);
  const std::array<double, 6> widths{6, 4, 3, 2, 1.5, 1};
  double z = -115;
  for (const double width : widths) {
    for (int bar = 0; bar < 5; ++bar) {
      const double x = 94 + 2 * width * bar;
      AddBox(shapes, {x, -165, z}, {x + width, -118, z + 28}, 1200);
    }
    z += 30;
  }
  for (const double width : {6.0, 4.0, 2.0}) {
    for (int bar = 0; bar < 3; ++bar) {
      AddBox(shapes, {155, -165, z}, {165, -118, z + width}, 1200);
      z += 2 * width;
    }
  }
}

}  // namespace

std::vector<Shape> TorsoShapes() {
  Shapes shapes;
  AddHull(shapes);
  AddLungs(shapes);
  AddLungVessels(shapes);
  AddOrgans(shapes);
  AddHeartAndVessels(shapes);
  AddSkeleton(shapes);
  AddBox(shapes, {-150, 118, -kAllHeights}, {150, 134, kAllHeights}, 80);  // table
  AddBox(shapes, {-147, 120, -kAllHeights}, {147, 132, kAllHeights}, -930);
  AddLinePairs(shapes);
  AddEllipsoid(shapes, {-130, -120, 105}, {6, 6, 6}, 3000);
  return shapes;
}

}  // namespace study
