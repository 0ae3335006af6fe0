#include <cli/Cuts.h>
#include <cli/Render.h>
#include <cli/Watch.h>
#include <vorl/Data/dBCGLUT.h>
#include <vorl/Data/dWindowingLUT.h>
#include <vorl/Operators/IP/opLookup.h>
#include <vorl/Operators/IP/opMPR.h>
#include <vorl/Operators/IP/opPixelRescale.h>

#include <algorithm>
#include <cmath>
#include <string>

// 1. Place the plane in the world (study::MakePlane) and reconstruct the volume on it (opMPR).
// 2. Bring the samples under a window that the table can hold, where it could not (opPixelRescale).
// 3. Map them to grey levels (opLookup through dWindowingLUT, and dBCGLUT behind it).

namespace cli {
namespace {

bool Overlap(const study::Extent& a, const study::Extent& b) {
  return a.minimum < b.maximum && b.minimum < a.maximum;
}

}  // namespace

std::unique_ptr<study::Study> CutPlane(study::Study& study, const CutRequest& request,
                                       const study::Progress& progress) {
  const study::PlaneGeometry plane = study::MakePlane(study, request.plane);
  CheckReach(study, plane, request.plane.thickness);
  auto cut = MakeCut(study, plane.width, plane.height);
  dSlice& slice = *cut->volume.GetSlice(0);
  slice.SetCoordinates(request.linear ? study::ForTrilinear(study, plane.coordinates)
                                      : plane.coordinates);
  opMPR op;
  op.volume = &study.volume;
  op.mprSlice = &slice;
  op.SelectAlgo(request.linear ? MPRAlgo_Trilinear : MPRAlgo_Nearest);
  if (request.plane.thickness > 0) {
    op.SetDepthSteps(request.steps > 0 ? request.steps : -1);
  }
  RunWatched(op, progress, "cutting the plane");
  CheckStatus(op, "cut the plane");

  PlaceCut(*cut, plane.coordinates);
  study::Report(progress, 1, "cutting the plane");
  return cut;
}

bool MeetsVolume(const study::Study& study, const study::Study& cut) {
  const dCoordSys3D& place = cut.volume.GetCoordinates();
  for (const dVect3D& axis : {place.axisX, place.axisY, place.axisZ}) {
    const study::Vec3 direction = study::Normalised(study::ToVec3(axis));
    if (!Overlap(study::ExtentAlong(study, direction), study::ExtentAlong(cut, direction))) {
      return false;
    }
  }
  return true;
}

void MakePicture(study::Study& cut, const Display& display, dImage& picture) {
  const TableWindow window = PlaceWindow(display.window, cut);
  dImage* samples = &cut.volume.GetSlice(0)->GetImage();
  dImage moved;
  if (window.factor != 1 || window.shift != 0) {
    const opPixelRescale rescale(samples, &moved, window.factor, window.shift);
    CheckStatus(rescale, "move the window");
    samples = &moved;
  }
  dBCGLUT levels;
  levels.SetBCG(display.brightness, display.contrast, display.gamma);
  dWindowingLUT table;
  table.SetWindow(window.centre, window.width);
  // The neutral second stage is not quite the identity; without one the levels are exact.
  if (display.brightness != 0 || display.contrast != 0 || display.gamma != 1) {
    table.SetBCGLUT(&levels);
  }
  const opLookup lookup(samples, &picture, &table);
  CheckStatus(lookup, "make the picture");
}

}  // namespace cli
