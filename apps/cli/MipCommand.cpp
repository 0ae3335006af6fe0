#include <cli/Command.h>
#include <cli/FilterOption.h>
#include <cli/GreyOptions.h>
#include <cli/InputOptions.h>
#include <cli/Mip.h>
#include <cli/OutputNames.h>
#include <cli/PictureFile.h>
#include <cli/PlaneOptions.h>
#include <cli/Render.h>
#include <cli/Values.h>
#include <study/OutputFile.h>

#include <filesystem>

namespace cli {
namespace {

constexpr int kMostViews = 3600;
constexpr std::size_t kFewestDigits = 3;
constexpr char kSamplingGroup[] = "Sampling";
constexpr char kOutputGroup[] = "Output";

/// "OUT.png" as "OUT-007.png".
std::string NumberedName(const std::string& path, int number, int count) {
  namespace fs = std::filesystem;
  const std::size_t digits = std::max(kFewestDigits, std::to_string(count).size());
  std::string text = std::to_string(number);
  text.insert(0, digits - std::min(digits, text.size()), '0');
  const fs::path name =
      fs::path(path).stem().string() + "-" + text + fs::path(path).extension().string();
  return fs::path(path).replace_filename(name).string();
}

class MipCommand : public Command {
 public:
  explicit MipCommand(CLI::App& application);
  void Check() override;
  void Run(Console& console) override;

 private:
  void AddProjectionOptions();
  void CheckPlaces() const;
  std::vector<study::PlaneRequest> Views(const study::Study& study) const;
  void Draw(study::Study& study, const study::PlaneRequest& view, const Display& display,
            const std::filesystem::path& path, const study::Progress& progress);

  InputOptions m_input;
  PlaneOptions m_plane;
  FilterOption m_filter;
  GreyOptions m_grey;
  std::string m_output, m_slab, m_turntable;
  MipRequest m_request;
  int m_views = 0;  ///< of a turntable; 0: none
  bool m_met = false;
};

MipCommand::MipCommand(CLI::App& application)
    : Command(
          application,
          {"mip", "Project the brightest voxels of a volume into a picture",
           "[OPTIONS] INPUT... -o OUT.png|OUT.bmp\n"
           "[OPTIONS] --phantom[=WxHxN] -o OUT.png|OUT.bmp",
           "  vorl mip scans/ --plane coronal -o front.png\n"
           "  vorl mip scans/ --slab 20 --center 10,-25,730 -o slab.png\n"
           "  vorl mip scans/ --plane sagittal --window 400,1200 -o bones.png\n"
           "  vorl mip scans/ --turntable 36 -o film/turn.png\n\n"
           "Every pixel shows the largest value on the ray behind it. Directions and\n"
           "positions are those of 'vorl mpr'. The window 'auto' leaves what is not\n"
           "background dark up to its middle value, so that the bones of a CT are bright;\n"
           "it follows from the whole volume and is the same for all views of it. With the\n"
           "linear filter, edges that rays cross at a slant come out brighter than they are."}) {
  m_input.AddTo(GetApp());
  AddPictureOption(GetApp(), m_output, kOutputGroup);
  AddText("--turntable", m_turntable, "N",
          "N views around the body's axis from feet to head\n"
          "through the centre, named OUT-001.png, OUT-002.png\n"
          "and so on, each seen from further to the patient's\n"
          "left; all of one size and one window. The first one\n"
          "is coronal unless --plane says otherwise",
          kOutputGroup);
  m_plane.AddTo(GetApp());
  AddProjectionOptions();
  m_grey.AddTo(GetApp(), "auto");
}

void MipCommand::AddProjectionOptions() {
  AddText("--slab", m_slab, "MM",
          "Only the slab of this thickness around the plane\n(default: the whole volume)",
          kSamplingGroup);
  m_filter.AddTo(GetApp(), kSamplingGroup);
}

void MipCommand::Check() {
  m_input.Check();
  if (m_output.empty()) {
    throw UsageError("no output is named (-o OUT.png or -o OUT.bmp)");
  }
  CheckPictureName("-o", m_output);
  m_request.plane = m_plane.Check();
  if (!m_turntable.empty()) {
    m_views = ParseWhole("--turntable", m_turntable, 2, kMostViews);
    if (IsDevice(m_output)) {
      throw UsageError("--turntable makes several files, but " + study::Quoted(m_output) +
                       " is a device");
    }
    if (!m_plane.NamesPlane()) {
      m_request.plane.plane = study::Plane::Coronal;
    }
  }
  if (!m_slab.empty()) {
    m_request.plane.thickness = ParsePositive("--slab", m_slab);
  }
  m_request.linear = m_filter.CheckLinear();
  m_grey.Check();
}

void MipCommand::CheckPlaces() const {
  if (m_views == 0) {
    CheckPlace(m_output);
  }
  for (int i = 0; i < m_views; ++i) {
    CheckPlace(NumberedName(m_output, i + 1, m_views));
  }
}

std::vector<study::PlaneRequest> MipCommand::Views(const study::Study& study) const {
  if (m_views == 0) {
    return {m_request.plane};
  }
  return TurntablePlanes(study, m_request.plane, m_views);
}

void MipCommand::Draw(study::Study& study, const study::PlaneRequest& view, const Display& display,
                      const std::filesystem::path& path, const study::Progress& progress) {
  MipRequest request = m_request;
  request.plane = view;
  const auto cut = ProjectMaximum(study, request, study::PartOf(progress, 0, 0.9));
  m_met = m_met || MeetsVolume(study, *cut);
  study::Report(progress, 0.9, "making the picture");
  dImage picture;
  MakePicture(*cut, display, picture);
  study::Report(progress, 0.95, "writing the picture");
  WritePicture(picture, m_output, path);
}

// The files of a turntable appear together, when the last one is complete.
void MipCommand::Run(Console& console) {
  CheckPlaces();
  const study::Progress progress = console.GetProgress();
  const Input input = m_input.Load(console, study::PartOf(progress, 0, m_views == 0 ? 0.5 : 0.2));
  study::Study& study = *input.study;
  const Display display =
      m_grey.WantsAuto() ? m_grey.With(ProjectionWindow(study)) : m_grey.Resolve(study, console);
  const study::Progress rest = study::PartOf(progress, m_views == 0 ? 0.5 : 0.2, 1);
  const std::vector<study::PlaneRequest> views = Views(study);
  std::vector<std::unique_ptr<study::OutputFile>> files;
  for (std::size_t i = 0; i < views.size(); ++i) {
    const auto share = [&views](std::size_t done) {
      return static_cast<double>(done) / static_cast<double>(views.size());
    };
    std::filesystem::path path = m_output;
    if (m_views > 0) {
      files.push_back(std::make_unique<study::OutputFile>(
          NumberedName(m_output, static_cast<int>(i) + 1, m_views)));
      path = files.back()->TemporaryPath();
    }
    Draw(study, views[i], display, path, study::PartOf(rest, share(i), share(i + 1)));
  }
  if (!m_met) {
    console.Note("the plane does not meet the volume");
  }
  study::Report(rest, 1, "writing the pictures");
  for (const auto& file : files) {
    file->Commit();
  }
}

}  // namespace

std::unique_ptr<Command> MakeMipCommand(CLI::App& application) {
  return std::make_unique<MipCommand>(application);
}

}  // namespace cli
