#ifndef VORL_APPS_CLI_DEPTHVIEW_H
#define VORL_APPS_CLI_DEPTHVIEW_H

/// @file
/// Slices, voxels and a volume drawn into one view.

#include <study/Planes.h>
#include <study/Progress.h>
#include <study/Study.h>
#include <vorl/Operators/IP/opSliceProjection.h>

#include <memory>

namespace cli {

/// A view of a volume into which things are drawn one after another; what lies nearer hides what
/// lies farther. Depths count the layers of voxels along the view's direction, from the middle of
/// the volume.
class DepthView {
 public:
  /// An empty view, black. `study` must outlive it. Throws `study::Error`, also when the volume
  /// reaches too far beyond the picture for the operator's fixed point.
  DepthView(study::Study& study, const study::PlaneRequest& request);

  double GetSpacing() const { return m_plane.spacing; }
  /// Draws a cut with its outline, and at its first pixel a mark of 7 x 7 pixels inside it.
  void DrawSlice(study::Study& cut, const study::Progress& progress);
  /// Draws the listed voxels, brighter ones over darker ones.
  void DrawVoxels(dBuffer& list, const study::Progress& progress);
  /// Draws the brightest voxel of each ray: where no slice is in the way or, with `beforeSlices`,
  /// also where it lies in front of a slice and is brighter.
  void DrawVolume(bool beforeSlices, const study::Progress& progress);

  /// The view as a study of one slice, which stays the view's.
  study::Study& GetPicture() { return *m_picture; }

 private:
  void Draw(const dCoordSys3D& plane, const study::Progress& progress);
  void DrawOutline(const study::Study& cut, const study::Progress& progress);
  void Splat(dSlice& slice, const study::Vec3& firstCell, const study::Progress& progress);
  dCoordSys3D MovedPlane(const study::Vec3& by) const;
  int Repeats(const study::Vec3& step, double density) const;
  bool IsAligned(const study::Vec3& step) const;

  study::Study& m_study;
  study::PlaneGeometry m_plane;
  std::unique_ptr<study::Study> m_picture;
  opSliceProjection m_op;
};

}  // namespace cli

#endif
