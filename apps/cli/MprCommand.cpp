#include <cli/Command.h>
#include <cli/InputOptions.h>
#include <cli/OutputNames.h>
#include <cli/Render.h>
#include <cli/Values.h>
#include <cli/Windows.h>
#include <study/Pictures.h>
#include <study/StudyFile.h>

namespace cli {
namespace {

constexpr int kMostSteps = 32767;  // the sum of so many samples still fits 32 bits
constexpr char kPlaneGroup[] = "Plane";
constexpr char kSamplingGroup[] = "Sampling";
constexpr char kGreyGroup[] = "Grey levels";
constexpr char kOutputGroup[] = "Output";

/// How the oblique plane is turned unless the user says it.
constexpr study::Vec3 kObliqueTurn{30, 20, 0};

/// The options as they stand on the command line.
struct MprTexts {
  std::string output, slice;
  std::string plane = "axial", centre, rotation, size, spacing;
  std::string thickness, steps, filter = "nearest";
  std::string window, brightness, contrast, gamma;
};

class MprCommand : public Command {
 public:
  explicit MprCommand(CLI::App& application);
  void Check() override;
  void Run(Console& console) override;

 private:
  void AddPlaneOptions();
  void AddSamplingOptions();
  void AddGreyOptions();
  void CheckOutputs() const;
  void CheckPlane();
  void CheckSampling();
  void CheckGrey();
  void Cut(Console& console, const Input& input, const study::Progress& progress);
  void Save(study::Study& cut, const study::Progress& progress) const;

  InputOptions m_input;
  MprTexts m_texts;
  CutRequest m_request;
  WindowChoice m_window;
  Display m_display;
};

MprCommand::MprCommand(CLI::App& application)
    : Command(
          application,
          {"mpr", "Cut a plane out of a volume and save the picture",
           "[OPTIONS] INPUT... -o OUT.png|OUT.bmp\n"
           "[OPTIONS] --phantom[=WxHxN] -o OUT.png|OUT.bmp",
           "  vorl mpr scans/ -o axial.png\n"
           "  vorl mpr scans/ --plane coronal --window bone -o coronal.png\n"
           "  vorl mpr scans/ --plane oblique --rotate 30,0,45 -o oblique.bmp\n"
           "  vorl mpr study.bdf --center 10,-25,730 --size 512x512 --spacing 0.5 -o part.png\n"
           "  vorl mpr --phantom --plane sagittal --thickness 20 --window -600,1500 -o lung.png\n"
           "  vorl mpr study.bdf --save-slice slice.bdf\n\n"
           "Positions are millimetres in patient coordinates: x grows to the patient's left,\n"
           "y to the back, z to the head. Axial pictures are seen from the feet, coronal ones\n"
           "from the front, sagittal ones from the patient's left; the head is up."}) {
  m_input.AddTo(GetApp());
  AddText("-o,--output", m_texts.output, "FILE",
          "The picture, by its extension .png or .bmp, 8-bit grey\n(a device or pipe gets PNG)",
          kOutputGroup);
  AddText("--save-slice", m_texts.slice, "FILE.bdf",
          "The 16-bit samples of the plane as they are, with\n"
          "place, scale, offset and unit: a study file of one\n"
          "slice, which all commands can read",
          kOutputGroup);
  AddPlaneOptions();
  AddSamplingOptions();
  AddGreyOptions();
}

void MprCommand::AddPlaneOptions() {
  AddText("--plane", m_texts.plane, "NAME",
          "axial (default), coronal, sagittal, or oblique: axial,\nturned by 30,20,0 unless "
          "--rotate says otherwise",
          kPlaneGroup);
  AddText("--center", m_texts.centre, "X,Y,Z",
          "A point of the plane in mm; where a size is given,\nthe middle of the picture "
          "(default: the volume's\nmiddle voxel)",
          kPlaneGroup);
  AddText("--rotate", m_texts.rotation, "X,Y,Z",
          "Turn the plane about its centre by degrees: first\nabout its direction to the right, "
          "then about its\ndirection down, then about its normal",
          kPlaneGroup);
  AddText("--size", m_texts.size, "WxH", "Pixels of the picture (default: the whole volume)",
          kPlaneGroup);
  AddText("--spacing", m_texts.spacing, "MM",
          "From pixel to pixel in both directions (default: the\nsmallest voxel spacing)",
          kPlaneGroup);
}

void MprCommand::AddSamplingOptions() {
  AddText("--thickness", m_texts.thickness, "MM",
          "The mean across a slab of this thickness (default: a\nthin plane)", kSamplingGroup);
  AddText("--steps", m_texts.steps, "N",
          "Samples across the slab, from 2 (default: one per\nvoxel crossed)", kSamplingGroup);
  AddText("--filter", m_texts.filter, "NAME",
          "nearest (default): the voxel around each point;\nlinear: interpolated between voxels",
          kSamplingGroup);
}

void MprCommand::AddGreyOptions() {
  AddText("--window", m_texts.window, "WINDOW",
          "CENTER,WIDTH in real values such as -600,1500; auto\n(from the data); or one of\n" +
              PresetList() + "\n(default: the input's own window, else auto)",
          kGreyGroup);
  AddText("--brightness", m_texts.brightness, "B", "From -1 to 1 (default: 0)", kGreyGroup);
  AddText("--contrast", m_texts.contrast, "C", "From -1 to 1 (default: 0)", kGreyGroup);
  AddText("--gamma", m_texts.gamma, "G", "From 0.01 to 10 (default: 1)", kGreyGroup);
}

void MprCommand::CheckOutputs() const {
  if (m_texts.output.empty() && m_texts.slice.empty()) {
    throw UsageError("no output is named (-o OUT.png, -o OUT.bmp or --save-slice OUT.bdf)");
  }
  if (!m_texts.output.empty()) {
    CheckExtension("-o", m_texts.output, {".png", ".bmp"});
  }
  if (!m_texts.slice.empty()) {
    CheckExtension("--save-slice", m_texts.slice, {".bdf"});
  }
}

void MprCommand::CheckPlane() {
  study::PlaneRequest& plane = m_request.plane;
  study::Vec3 turn;
  if (m_texts.plane == "coronal") {
    plane.plane = study::Plane::Coronal;
  } else if (m_texts.plane == "sagittal") {
    plane.plane = study::Plane::Sagittal;
  } else if (m_texts.plane == "oblique") {
    turn = kObliqueTurn;
  } else if (m_texts.plane != "axial") {
    throw UsageError("--plane: " + study::Quoted(m_texts.plane) +
                     " is not one of axial, coronal, sagittal, oblique");
  }
  if (!m_texts.rotation.empty()) {
    turn = ParseTriple("--rotate", m_texts.rotation);
  }
  plane.turnAboutRight = turn.x;
  plane.turnAboutDown = turn.y;
  plane.turnAboutNormal = turn.z;
  if (!m_texts.centre.empty()) {
    plane.centre = ParseTriple("--center", m_texts.centre);
  }
  if (!m_texts.size.empty()) {
    const std::vector<int> size = ParseSize("--size", m_texts.size, 2, "WIDTHxHEIGHT");
    plane.width = size[0];
    plane.height = size[1];
  }
  if (!m_texts.spacing.empty()) {
    plane.spacing = ParsePositive("--spacing", m_texts.spacing);
  }
}

void MprCommand::CheckSampling() {
  if (!m_texts.thickness.empty()) {
    m_request.plane.thickness = ParsePositive("--thickness", m_texts.thickness);
  }
  if (!m_texts.steps.empty()) {
    m_request.steps = ParseWhole("--steps", m_texts.steps, 2, kMostSteps);
    if (m_texts.thickness.empty()) {
      throw UsageError("--steps needs --thickness");
    }
  }
  if (m_texts.filter != "nearest" && m_texts.filter != "linear") {
    throw UsageError("--filter: " + study::Quoted(m_texts.filter) +
                     " is not one of nearest, linear");
  }
  m_request.linear = m_texts.filter == "linear";
}

void MprCommand::CheckGrey() {
  m_window = ParseWindow("--window", m_texts.window);
  if (!m_texts.brightness.empty()) {
    m_display.brightness = ParseNumberIn("--brightness", m_texts.brightness, -1, 1);
  }
  if (!m_texts.contrast.empty()) {
    m_display.contrast = ParseNumberIn("--contrast", m_texts.contrast, -1, 1);
  }
  if (!m_texts.gamma.empty()) {
    m_display.gamma = ParseNumberIn("--gamma", m_texts.gamma, 0.01, 10);
  }
}

void MprCommand::Check() {
  m_input.Check();
  CheckOutputs();
  CheckPlane();
  CheckSampling();
  CheckGrey();
}

void MprCommand::Cut(Console& console, const Input& input, const study::Progress& progress) {
  study::Study& study = *input.study;
  m_display.window = ResolveWindow(m_window, study);
  if (m_window.kind == WindowChoice::Kind::Preset && study.unit != "HU") {
    console.Note("the window " + study::Quoted(m_texts.window) +
                 " is meant for Hounsfield units, the values are in " +
                 (study.unit.empty() ? "no unit" : study.unit));
  }
  const auto cut = CutPlane(study, m_request, study::PartOf(progress, 0, 0.7));
  if (!MeetsVolume(study, *cut)) {
    console.Note("the plane does not meet the volume");
  }
  Save(*cut, study::PartOf(progress, 0.7, 1));
}

void MprCommand::Save(study::Study& cut, const study::Progress& progress) const {
  cut.windowCentre = m_display.window.centre;
  cut.windowWidth = m_display.window.width;
  if (!m_texts.slice.empty()) {
    study::WriteStudyFile(cut, m_texts.slice, study::PartOf(progress, 0, 0.5));
  }
  if (m_texts.output.empty()) {
    return;
  }
  study::Report(progress, 0.5, "making the picture");
  dImage picture;
  MakePicture(cut, m_display, picture);
  study::Report(progress, 0.7, "writing the picture");
  if (ExtensionOf(m_texts.output) == ".bmp") {
    study::SaveBmp(picture, m_texts.output);
  } else {
    study::SavePng(picture, m_texts.output);
  }
}

void MprCommand::Run(Console& console) {
  for (const std::string& path : {m_texts.output, m_texts.slice}) {
    if (!path.empty()) {
      CheckPlace(path);
    }
  }
  const study::Progress progress = console.GetProgress();
  const Input input = m_input.Load(console, study::PartOf(progress, 0, 0.7));
  Cut(console, input, study::PartOf(progress, 0.7, 1));
}

}  // namespace

std::unique_ptr<Command> MakeMprCommand(CLI::App& application) {
  return std::make_unique<MprCommand>(application);
}

}  // namespace cli
