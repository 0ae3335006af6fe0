#include <cli/Command.h>
#include <cli/FilterOption.h>
#include <cli/GreyOptions.h>
#include <cli/InputOptions.h>
#include <cli/OutputNames.h>
#include <cli/PictureFile.h>
#include <cli/PlaneOptions.h>
#include <cli/Render.h>
#include <cli/Values.h>
#include <study/StudyFile.h>

namespace cli {
namespace {

constexpr int kMostSteps = 32767;  // the sum of so many samples still fits 32 bits
constexpr char kSamplingGroup[] = "Sampling";
constexpr char kOutputGroup[] = "Output";

class MprCommand : public Command {
 public:
  explicit MprCommand(CLI::App& application);
  void Check() override;
  void Run(Console& console) override;

 private:
  void AddOutputOptions();
  void AddSamplingOptions();
  void CheckOutputs() const;
  void CheckSampling();
  void Cut(Console& console, const Input& input, const study::Progress& progress);
  void Save(study::Study& cut, const Display& display, const study::Progress& progress) const;

  InputOptions m_input;
  PlaneOptions m_plane;
  FilterOption m_filter;
  GreyOptions m_grey;
  std::string m_output, m_slice, m_thickness, m_steps;
  CutRequest m_request;
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
  AddOutputOptions();
  m_plane.AddTo(GetApp());
  AddSamplingOptions();
  m_grey.AddTo(GetApp());
}

void MprCommand::AddOutputOptions() {
  AddPictureOption(GetApp(), m_output, kOutputGroup);
  AddText("--save-slice", m_slice, "FILE.bdf",
          "The 16-bit samples of the plane as they are, with\n"
          "place, scale, offset and unit: a study file of one\n"
          "slice, which all commands can read",
          kOutputGroup);
}

void MprCommand::AddSamplingOptions() {
  AddText("--thickness", m_thickness, "MM",
          "The mean across a slab of this thickness (default: a\nthin plane)", kSamplingGroup);
  AddText("--steps", m_steps, "N",
          "Samples across the slab, from 2 (default: one per\nvoxel crossed)", kSamplingGroup);
  m_filter.AddTo(GetApp(), kSamplingGroup);
}

void MprCommand::CheckOutputs() const {
  if (m_output.empty() && m_slice.empty()) {
    throw UsageError("no output is named (-o OUT.png, -o OUT.bmp or --save-slice OUT.bdf)");
  }
  if (!m_output.empty()) {
    CheckPictureName("-o", m_output);
  }
  if (!m_slice.empty()) {
    CheckExtension("--save-slice", m_slice, {".bdf"});
  }
}

void MprCommand::CheckSampling() {
  if (!m_thickness.empty()) {
    m_request.plane.thickness = ParsePositive("--thickness", m_thickness);
  }
  if (!m_steps.empty()) {
    m_request.steps = ParseWhole("--steps", m_steps, 2, kMostSteps);
    if (m_thickness.empty()) {
      throw UsageError("--steps needs --thickness");
    }
  }
  m_request.linear = m_filter.CheckLinear();
}

void MprCommand::Check() {
  m_input.Check();
  CheckOutputs();
  m_request.plane = m_plane.Check();
  CheckSampling();
  m_grey.Check();
}

void MprCommand::Cut(Console& console, const Input& input, const study::Progress& progress) {
  study::Study& study = *input.study;
  const Display display = m_grey.Resolve(study, console);
  const auto cut = CutPlane(study, m_request, study::PartOf(progress, 0, 0.7));
  if (!MeetsVolume(study, *cut)) {
    console.Note("the plane does not meet the volume");
  }
  Save(*cut, display, study::PartOf(progress, 0.7, 1));
}

void MprCommand::Save(study::Study& cut, const Display& display,
                      const study::Progress& progress) const {
  cut.windowCentre = display.window.centre;
  cut.windowWidth = display.window.width;
  if (!m_slice.empty()) {
    study::WriteStudyFile(cut, m_slice, study::PartOf(progress, 0, 0.5));
  }
  if (m_output.empty()) {
    return;
  }
  study::Report(progress, 0.5, "making the picture");
  dImage picture;
  MakePicture(cut, display, picture);
  study::Report(progress, 0.7, "writing the picture");
  WritePicture(picture, m_output, m_output);
}

void MprCommand::Run(Console& console) {
  for (const std::string& path : {m_output, m_slice}) {
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
