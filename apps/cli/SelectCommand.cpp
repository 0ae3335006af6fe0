#include <cli/ClassTable.h>
#include <cli/Command.h>
#include <cli/DepthView.h>
#include <cli/GreyOptions.h>
#include <cli/InputOptions.h>
#include <cli/OutputNames.h>
#include <cli/PictureFile.h>
#include <cli/PlaneOptions.h>
#include <cli/Render.h>
#include <cli/Selection.h>
#include <study/VoxelListFile.h>

#include <algorithm>

namespace cli {
namespace {

constexpr char kSelectionGroup[] = "Selection";
constexpr char kOutputGroup[] = "Output";
constexpr std::size_t kEdgeValues = 4096;
constexpr std::size_t kHighestClass = 65535;

class SelectCommand : public Command {
 public:
  explicit SelectCommand(CLI::App& application);
  void Check() override;
  void Run(Console& console) override;

 private:
  void CheckDrawing();
  void TellLimits(const study::Study& study, const Selection& selection, Console& console) const;
  void Draw(study::Study& study, Selection& selection, Console& console, dImage& picture,
            const study::Progress& progress) const;

  InputOptions m_input;
  PlaneOptions m_plane;
  GreyOptions m_grey;
  std::string m_output, m_picture, m_by = "value", m_limitText = "1%";
  SelectionLimit m_limit;
  study::PlaneRequest m_view;
};

PlaneHelp ViewHelp() {
  PlaneHelp help;
  help.group = "View (with --draw)";
  return help;
}

SelectCommand::SelectCommand(CLI::App& application)
    : Command(application,
              {"select", "List the brightest or sharpest voxels of a volume",
               "[OPTIONS] INPUT... -o LIST.bdf\n"
               "[OPTIONS] --phantom[=WxHxN] -o LIST.bdf",
               "  vorl select scans/ --limit 2% -o bones.bdf\n"
               "  vorl select scans/ --by edge --limit 100000 -o edges.bdf --draw edges.png\n"
               "  vorl select --phantom -o list.bdf --draw list.png --plane coronal\n\n"
               "Voxels are counted by class: their value, or how far they rise above the lower\n"
               "of their right and lower neighbours (of which only the lowest 12 bits count).\n"
               "Whole classes are listed from the highest on, as many as fit under the limit;\n"
               "the value 65535 as stored is never listed. The table on standard output shows\n"
               "all classes from the highest on. The list is a binary data file of the type\n"
               "vorlVoxelList with the volume's size and place, how the voxels were selected,\n"
               "and each voxel as z << 22 | y << 11 | x."}) {
  m_input.AddTo(GetApp());
  AddText("--by", m_by, "NAME", "value (default) or edge: the edge strength", kSelectionGroup);
  AddText("--limit", m_limitText, "N|P%",
          "The most voxels to list: a number, or a percentage of\nthe volume (default: 1%)",
          kSelectionGroup);
  AddText("-o,--output", m_output, "LIST.bdf", "The list of voxels", kOutputGroup);
  AddText("--draw", m_picture, "FILE",
          "A picture of the listed voxels, by its extension .png\nor .bmp, 8-bit grey",
          kOutputGroup);
  m_plane.AddTo(GetApp(), ViewHelp());
  m_grey.AddTo(GetApp(), "auto, from the listed voxels");
}

void SelectCommand::CheckDrawing() {
  m_view = m_plane.Check();
  m_grey.Check();
  if (!m_picture.empty()) {
    CheckPictureName("--draw", m_picture);
    return;
  }
  for (const std::string& option : {m_plane.FirstGiven(), m_grey.FirstGiven()}) {
    if (!option.empty()) {
      throw UsageError(option + " needs --draw");
    }
  }
}

void SelectCommand::Check() {
  m_input.Check();
  if (m_output.empty()) {
    throw UsageError("no output is named (-o LIST.bdf)");
  }
  CheckExtension("-o", m_output, {".bdf"});
  if (m_by != "value" && m_by != "edge") {
    throw UsageError("--by: " + study::Quoted(m_by) + " is not one of value, edge");
  }
  m_limit = ParseLimit("--limit", m_limitText);
  CheckDrawing();
}

void SelectCommand::TellLimits(const study::Study& study, const Selection& selection,
                               Console& console) const {
  const std::vector<std::uint32_t>& counters = selection.counters;
  if (m_by == "value" && counters.size() > kHighestClass && counters[kHighestClass] > 0) {
    console.Note("the voxels of the highest value that can be stored are not listed");
  }
  const auto isBeyond = [](std::uint16_t sample) { return sample >= kEdgeValues; };
  const auto& slices = study.volume.GetSliceList();
  if (m_by == "edge" && std::any_of(slices.begin(), slices.end(), [&](const dSlice& slice) {
        const auto samples = study::SamplesOf(slice);
        return std::any_of(samples.begin(), samples.end(), isBeyond);
      })) {
    console.Note("edges are found in the lowest 12 bits of the stored values, which go beyond");
  }
  if (selection.list.voxels.empty()) {
    console.Note("no voxel is listed: the highest class has more than the limit of " +
                 std::to_string(selection.list.limit));
  }
}

void SelectCommand::Draw(study::Study& study, Selection& selection, Console& console,
                         dImage& picture, const study::Progress& progress) const {
  DepthView view(study, m_view);
  view.DrawVoxels(selection.buffer, progress);
  const Display display =
      m_grey.WantsAuto() ? m_grey.With(DrawnWindow(view.GetPicture()).value_or(AutoWindow(study)))
                         : m_grey.Resolve(study, console);
  MakePicture(view.GetPicture(), display, picture);
}

// Both files are written when all that can fail has been done.
void SelectCommand::Run(Console& console) {
  for (const std::string& path : {m_output, m_picture}) {
    if (!path.empty()) {
      CheckPlace(path);
    }
  }
  const study::Progress progress = console.GetProgress();
  const Input input = m_input.Load(console, study::PartOf(progress, 0, 0.5));
  Selection selection =
      SelectVoxels(*input.study, m_by == "edge", m_limit, study::PartOf(progress, 0.5, 0.7));
  TellLimits(*input.study, selection, console);
  dImage picture;
  if (!m_picture.empty()) {
    Draw(*input.study, selection, console, picture, study::PartOf(progress, 0.7, 0.9));
  }
  study::WriteVoxelList(selection.list, m_output, study::PartOf(progress, 0.9, 1));
  if (!m_picture.empty()) {
    WritePicture(picture, m_picture, m_picture);
  }
  console.Print(ClassTable(selection));
}

}  // namespace

std::unique_ptr<Command> MakeSelectCommand(CLI::App& application) {
  return std::make_unique<SelectCommand>(application);
}

}  // namespace cli
