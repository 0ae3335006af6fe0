#include <cli/Cuts.h>
#include <cli/DepthView.h>
#include <cli/Watch.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <numbers>
#include <string>

// Slices and voxel lists are carried forward: each pixel or voxel is drawn as one point into the
// pixel of the view that holds it. Where they lie less dense than the view's pixels, they would
// leave holes; so they are drawn several times, moved by a part of their own step.

namespace cli {
namespace {

using study::ToVec3;
using study::ToVect;
using study::Vec3;

constexpr double kRounding = 1e-3;
constexpr std::int16_t kFarthest = std::numeric_limits<std::int16_t>::max();
constexpr std::int16_t kNearest = std::numeric_limits<std::int16_t>::min();

/// How many layers an outline is drawn nearer than its slice, so that the slice's own pixels next
/// to it do not cover it.
constexpr double kOutlineLift = 2;

/// Pixels of the outline and the mark inside it.
constexpr int kMark = 8;

/// What is drawn forward must stay within the range of 16.16 fixed point.
void CheckForwardReach(const study::Study& study, const dCoordSys3D& plane) {
  const Vec3 right = ToVec3(plane.axisX);
  const Vec3 down = ToVec3(plane.axisY);
  for (int corner = 0; corner < 8; ++corner) {
    const dVolume& volume = study.volume;
    const Vec3 from = study::WorldFromVoxel(study, {(corner & 1) * 1.0 * volume.GetSizeX(),
                                                    (corner >> 1 & 1) * 1.0 * volume.GetSizeY(),
                                                    (corner >> 2) * 1.0 * volume.GetSizeZ()}) -
                      ToVec3(plane.origin);
    const double x = Dot(from, right) / Dot(right, right);
    const double y = Dot(from, down) / Dot(down, down);
    if (std::max(std::abs(x), std::abs(y)) > study::kLargestVolumeSide) {
      throw study::Error("the volume reaches more than " +
                         std::to_string(study::kLargestVolumeSide) +
                         " pixels away from the picture's first one");
    }
  }
}

}  // namespace

DepthView::DepthView(study::Study& study, const study::PlaneRequest& request) : m_study(study) {
  m_plane = study::MakePlane(study, request);
  dCoordSys3D& place = m_plane.coordinates;
  const Vec3 normal = study::Normalised(ToVec3(place.axisZ));
  const study::Extent extent = study::ExtentAlong(study, normal);
  const Vec3 origin = ToVec3(place.origin);
  const double middle = 0.5 * (extent.minimum + extent.maximum);
  place.origin = ToVect(origin + normal * (middle - Dot(origin, normal)));
  place.axisZ = ToVect(normal * (1 / VoxelsPerMillimetre(study, normal)));
  CheckReach(study, m_plane, extent.maximum - extent.minimum);
  CheckForwardReach(study, place);
  m_picture = MakeCut(study, m_plane.width, m_plane.height);
  PlaceCut(*m_picture, place);
  m_op.volume = &study.volume;
  m_op.projectionPlane = m_picture->volume.GetSlice(0);
  m_op.ClearProjectionPlane();
  if (!m_op.InitZBuffer()) {
    CheckStatus(m_op, "make the view");
  }
}

dCoordSys3D DepthView::MovedPlane(const Vec3& by) const {
  const dCoordSys3D& place = m_plane.coordinates;
  // A point belongs to the pixel whose centre it lies nearest to.
  const Vec3 pixel = 0.5 * (ToVec3(place.axisX) + ToVec3(place.axisY));
  dCoordSys3D moved = place;
  moved.origin = ToVect(ToVec3(place.origin) - pixel + by);
  return moved;
}

/// True when a step of things drawn runs along the picture's rows or columns, or its normal.
bool DepthView::IsAligned(const Vec3& step) const {
  const double across = std::abs(Dot(step, ToVec3(m_plane.coordinates.axisX)));
  const double along = std::abs(Dot(step, ToVec3(m_plane.coordinates.axisY)));
  const double small = 1e-5 * Length(step) * m_plane.spacing;
  return across < small || along < small;
}

/// How often a step is divided so that no pixel is left out: any point of the plane is within half
/// a pixel of a lattice whose two steps are at most 1 / sqrt(2) pixels long (`density` sqrt(2)).
int DepthView::Repeats(const Vec3& step, double density) const {
  const Vec3 normal = study::Normalised(ToVec3(m_plane.coordinates.axisZ));
  const double pixels = Length(step - normal * Dot(step, normal)) / m_plane.spacing;
  return std::max(1, static_cast<int>(std::ceil(pixels * density - kRounding)));
}

void DepthView::Draw(const dCoordSys3D& plane, const study::Progress& progress) {
  m_op.projectionPlane->SetCoordinates(plane);
  RunWatched(m_op, progress, "drawing the view");
  CheckStatus(m_op, "draw the view");
  m_op.projectionPlane->SetCoordinates(m_plane.coordinates);
}

/// Draws a slice whose pixel (0, 0) begins at `firstCell`.
void DepthView::Splat(dSlice& slice, const Vec3& firstCell, const study::Progress& progress) {
  const Vec3 right = ToVec3(slice.GetCoordinates().axisX);
  const Vec3 down = ToVec3(slice.GetCoordinates().axisY);
  const double density = IsAligned(right) && IsAligned(down) ? 1 : std::numbers::sqrt2;
  const int columns = Repeats(right, density);
  const int rows = Repeats(down, density);
  m_op.SelectAlgo(SliceProjectionAlgo_Slice);
  m_op.slice = &slice;
  m_op.SetBorderValue(std::numeric_limits<std::uint16_t>::max());
  for (int i = 0; i < columns * rows; ++i) {
    slice.SetPosition(ToVect(firstCell + right * ((i % columns + 0.5) / columns) +
                             down * ((i / columns + 0.5) / rows)));
    const double share = 1.0 / (columns * rows);
    Draw(MovedPlane({}), study::PartOf(progress, i * share, (i + 1) * share));
  }
}

void DepthView::DrawSlice(study::Study& cut, const study::Progress& progress) {
  dSlice& slice = *cut.volume.GetSlice(0);
  const dCoordSys3D place = slice.GetCoordinates();
  Splat(slice, ToVec3(place.origin) + 0.5 * ToVec3(place.axisZ), study::PartOf(progress, 0, 0.8));
  slice.SetCoordinates(place);
  DrawOutline(cut, study::PartOf(progress, 0.8, 1));
}

// Slices so narrow that the operator takes all of their pixels for outline.
void DepthView::DrawOutline(const study::Study& cut, const study::Progress& progress) {
  const dCoordSys3D& place = cut.volume.GetSlice(0)->GetCoordinates();
  const int width = cut.volume.GetSizeX();
  const int height = cut.volume.GetSizeY();
  const Vec3 lift = ToVec3(m_plane.coordinates.axisZ) * kOutlineLift;
  const Vec3 corner = ToVec3(place.origin) + 0.5 * ToVec3(place.axisZ) - lift;
  struct Strip {
    int x, y, width, height;
  };
  const std::array<Strip, 5> strips{{{0, 0, 1, height},
                                     {width - 1, 0, 1, height},
                                     {0, 0, width, 1},
                                     {0, height - 1, width, 1},
                                     {0, 0, std::min(kMark, width), std::min(kMark, height)}}};
  for (std::size_t i = 0; i < strips.size(); ++i) {
    const Strip& strip = strips[i];
    const auto band = MakeCut(m_study, strip.width, strip.height);
    dSlice& slice = *band->volume.GetSlice(0);
    slice.SetCoordinates(place);
    const double share = 1.0 / static_cast<double>(strips.size());
    const double begin = static_cast<double>(i) * share;
    Splat(slice, corner + ToVec3(place.axisX) * strip.x + ToVec3(place.axisY) * strip.y,
          study::PartOf(progress, begin, begin + share));
  }
}

void DepthView::DrawVoxels(dBuffer& list, const study::Progress& progress) {
  const dCoordSys3D& volume = m_study.volume.GetCoordinates();
  const std::array<Vec3, 3> axes{ToVec3(volume.axisX), ToVec3(volume.axisY), ToVec3(volume.axisZ)};
  const bool aligned =
      std::all_of(axes.begin(), axes.end(), [this](const Vec3& axis) { return IsAligned(axis); });
  std::array<int, 3> repeats{};
  std::transform(axes.begin(), axes.end(), repeats.begin(), [&](const Vec3& axis) {
    return Repeats(axis, aligned ? 1 : std::numbers::sqrt2);
  });
  m_op.SelectAlgo(SliceProjectionAlgo_VoxelList);
  m_op.voxelList = &list;
  const int count = repeats[0] * repeats[1] * repeats[2];
  for (int i = 0; i < count; ++i) {
    const std::array<int, 3> part{i % repeats[0], i / repeats[0] % repeats[1],
                                  i / (repeats[0] * repeats[1])};
    Vec3 inside;
    for (std::size_t n = 0; n < axes.size(); ++n) {
      inside = inside + axes[n] * ((part[n] + 0.5) / repeats[n]);
    }
    const double share = 1.0 / count;
    Draw(MovedPlane(inside * -1), study::PartOf(progress, i * share, (i + 1) * share));
  }
}

void DepthView::DrawVolume(bool beforeSlices, const study::Progress& progress) {
  dImage& depths = m_op.zBuffer;
  auto* depth = static_cast<std::int16_t*>(depths.GetDataPtr());
  if (!beforeSlices) {
    // Nothing lies before the nearest depth.
    std::replace_if(
        depth, depth + depths.GetNumDataSamples(),
        [](std::int16_t drawn) { return drawn != kFarthest; }, kNearest);
  }
  m_op.SelectAlgo(SliceProjectionAlgo_Volume);
  Draw(m_plane.coordinates, progress);
}

}  // namespace cli
