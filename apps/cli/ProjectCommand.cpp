#include <cli/Command.h>
#include <cli/DepthView.h>
#include <cli/FilterOption.h>
#include <cli/GreyOptions.h>
#include <cli/InputOptions.h>
#include <cli/OutputNames.h>
#include <cli/PictureFile.h>
#include <cli/PlaneOptions.h>
#include <cli/Render.h>

#include <algorithm>
#include <sstream>
#include <vector>

namespace cli {
namespace {

constexpr char kSliceGroup[] = "Slices and volume";
constexpr char kOutputGroup[] = "Output";

/// The view unless the user says it: from the front, a little from above and the patient's left.
constexpr double kFromAbove = -25;
constexpr double kFromLeft = 30;

/// Pixels of a slice in either direction.
constexpr double kLargestSlice = 4096;

class ProjectCommand : public Command {
 public:
  explicit ProjectCommand(CLI::App& application);
  void Check() override;
  void Run(Console& console) override;

 private:
  void CheckSlices();
  void DrawSlices(study::Study& study, DepthView& view, const study::Progress& progress) const;

  InputOptions m_input;
  PlaneOptions m_plane;
  FilterOption m_filter;
  GreyOptions m_grey;
  std::string m_output, m_sliceText = "axial,coronal,sagittal", m_volume = "behind";
  std::vector<study::Plane> m_slices;
  study::PlaneRequest m_view;
  bool m_linear = false;
};

PlaneHelp ViewHelp() {
  PlaneHelp help;
  help.group = "View";
  help.plane =
      "Look along axial, coronal, sagittal or oblique as\n'vorl mpr' does (default: coronal, from "
      "25 degrees\nabove and 30 degrees to the patient's left)";
  help.centre =
      "The point that all slices go through, in mm; where a\nsize is given, the middle of the "
      "picture (default:\nthe volume's middle voxel)";
  help.rotation =
      "Turn the view by degrees: first about its direction\nto the right, then about its direction "
      "down, then\nabout its normal (without --plane: from coronal)";
  return help;
}

ProjectCommand::ProjectCommand(CLI::App& application)
    : Command(application,
              {"project", "Draw slices with their outlines and the volume into one view",
               "[OPTIONS] INPUT... -o OUT.png|OUT.bmp\n"
               "[OPTIONS] --phantom[=WxHxN] -o OUT.png|OUT.bmp",
               "  vorl project scans/ -o view.png\n"
               "  vorl project scans/ --slices axial,sagittal --rotate -40,20,0 -o view.png\n"
               "  vorl project --phantom --center 40,0,60 --volume none -o slices.bmp\n\n"
               "Nearer slices hide farther ones. Each has a white outline, and a white square at\n"
               "its first pixel: right and front of an axial slice, right and head of a coronal\n"
               "one, front and head of a sagittal one. Of the volume, the brightest voxel on\n"
               "each ray is shown."}) {
  m_input.AddTo(GetApp());
  AddPictureOption(GetApp(), m_output, kOutputGroup);
  m_plane.AddTo(GetApp(), ViewHelp());
  AddText("--slices", m_sliceText, "LIST",
          "Any of axial, coronal and sagittal, with commas\nbetween them (default: all three)",
          kSliceGroup);
  AddText("--volume", m_volume, "NAME",
          "behind (default): where no slice is in the way;\nall: also brighter voxels before the "
          "slices;\nnone: slices only",
          kSliceGroup);
  m_filter.AddTo(GetApp(), kSliceGroup);
  m_grey.AddTo(GetApp(), "auto");
}

void ProjectCommand::CheckSlices() {
  std::istringstream names(m_sliceText + ",");
  for (std::string name; std::getline(names, name, ',');) {
    study::Plane plane{};
    if (!FindPlane(name, plane)) {
      throw UsageError("--slices: " + study::Quoted(name) +
                       " is not one of axial, coronal, sagittal");
    }
    if (std::find(m_slices.begin(), m_slices.end(), plane) != m_slices.end()) {
      throw UsageError("--slices: " + study::Quoted(name) + " is named twice");
    }
    m_slices.push_back(plane);
  }
}

void ProjectCommand::Check() {
  m_input.Check();
  if (m_output.empty()) {
    throw UsageError("no output is named (-o OUT.png or -o OUT.bmp)");
  }
  CheckPictureName("-o", m_output);
  m_view = m_plane.Check();
  if (!m_plane.NamesPlane()) {
    m_view.plane = study::Plane::Coronal;
  }
  if (!m_plane.NamesDirection()) {
    m_view.turnAboutRight = kFromAbove;
    m_view.turnAboutBodyAxis = kFromLeft;
  }
  CheckSlices();
  if (m_volume != "behind" && m_volume != "all" && m_volume != "none") {
    throw UsageError("--volume: " + study::Quoted(m_volume) + " is not one of behind, all, none");
  }
  m_linear = m_filter.CheckLinear();
  m_grey.Check();
}

/// The spacing of a slice's pixels: that of the view, unless it shows a small part of a slice much
/// enlarged.
double SliceSpacing(const study::Study& study, const DepthView& view) {
  double longest = 0;
  for (const study::Vec3& direction :
       {study::Vec3{1, 0, 0}, study::Vec3{0, 1, 0}, study::Vec3{0, 0, 1}}) {
    const study::Extent extent = study::ExtentAlong(study, direction);
    longest = std::max(longest, extent.maximum - extent.minimum);
  }
  return std::max(view.GetSpacing(), longest / kLargestSlice);
}

void ProjectCommand::DrawSlices(study::Study& study, DepthView& view,
                                const study::Progress& progress) const {
  for (std::size_t i = 0; i < m_slices.size(); ++i) {
    const double share = 1.0 / static_cast<double>(m_slices.size());
    const study::Progress part =
        study::PartOf(progress, static_cast<double>(i) * share, static_cast<double>(i + 1) * share);
    CutRequest request;
    request.plane.plane = m_slices[i];
    request.plane.centre = m_view.centre;
    request.plane.spacing = SliceSpacing(study, view);
    request.linear = m_linear;
    const auto cut = CutPlane(study, request, study::PartOf(part, 0, 0.5));
    view.DrawSlice(*cut, study::PartOf(part, 0.5, 1));
  }
}

void ProjectCommand::Run(Console& console) {
  CheckPlace(m_output);
  const study::Progress progress = console.GetProgress();
  const Input input = m_input.Load(console, study::PartOf(progress, 0, 0.5));
  study::Study& study = *input.study;
  const Display display =
      m_grey.WantsAuto() ? m_grey.With(AutoWindow(study)) : m_grey.Resolve(study, console);
  DepthView view(study, m_view);
  DrawSlices(study, view, study::PartOf(progress, 0.5, 0.7));
  if (m_volume != "none") {
    view.DrawVolume(m_volume == "all", study::PartOf(progress, 0.7, 0.95));
  }
  study::Report(progress, 0.95, "writing the picture");
  dImage picture;
  MakePicture(view.GetPicture(), display, picture);
  WritePicture(picture, m_output, m_output);
}

}  // namespace

std::unique_ptr<Command> MakeProjectCommand(CLI::App& application) {
  return std::make_unique<ProjectCommand>(application);
}

}  // namespace cli
