#include <cli/Command.h>
#include <cli/GreyOptions.h>
#include <cli/InputOptions.h>
#include <cli/OutputNames.h>
#include <cli/PictureFile.h>
#include <cli/Sheet.h>
#include <cli/Values.h>

#include <CLI/CLI.hpp>
#include <algorithm>
#include <cmath>
#include <optional>

namespace cli {
namespace {

constexpr char kSheetGroup[] = "Sheet";
constexpr char kMeasureGroup[] = "Measuring";
constexpr int kSmallestWidth = 160;
constexpr int kSmallestHeight = 120;
constexpr int kLargestSide = 8192;
constexpr double kFarthestMm = 1e6;

class RenderCommand : public Command {
 public:
  explicit RenderCommand(CLI::App& application);
  void Check() override;
  void Run(Console& console) override;

 private:
  void CheckSheet();
  void CheckMeasuring();
  std::vector<double> Corners(const std::string& option, const std::string& text) const;

  InputOptions m_input;
  GreyOptions m_grey;
  std::string m_output, m_size, m_layout, m_centre, m_line, m_region;
  bool m_plain = false;
  SheetContent m_sheet;
  MeasureRequest m_measure;
  std::optional<study::Vec3> m_cursor;
};

RenderCommand::RenderCommand(CLI::App& application)
    : Command(application,
              {"render", "Draw a study on one sheet, for a report",
               "[OPTIONS] INPUT... -o SHEET.png|SHEET.bmp\n"
               "[OPTIONS] --phantom[=WxHxN] -o SHEET.png|SHEET.bmp",
               "  vorl render scans/ -o sheet.png\n"
               "  vorl render scans/ --window bone --center 10,-25,730 --layout main -o sheet.png\n"
               "  vorl render --phantom --size 1920x1080 --region 60,-20,90,10 -o sheet.png\n\n"
               "The sheet shows an axial, a coronal and a sagittal plane through one point, a\n"
               "projection of the brightest voxels from the front, and the histogram. Rulers\n"
               "show the patient's coordinates in mm, the cross of each picture where the other\n"
               "planes are, and each picture its window as center (C) and width (W). On the axial\n"
               "plane a line is measured, and the voxels in a rectangle: what is measured stands\n"
               "on standard output, too. On small sheets, what finds no room is left out."}) {
  m_input.AddTo(GetApp());
  AddPictureOption(GetApp(), m_output, kSheetGroup, "24-bit colour");
  AddText("--size", m_size, "WxH", "Pixels of the sheet (default: 1600x1200)", kSheetGroup);
  AddText("--layout", m_layout, "NAME",
          "2x2 (default); row: side by side; column: one below\nthe other; main: a large axial "
          "plane, the others\nbeside it",
          kSheetGroup);
  AddText("--center", m_centre, "X,Y,Z",
          "The point in mm that the planes go through (default:\nthe volume's middle voxel)",
          kSheetGroup);
  GetApp()
      .add_flag("--no-annotations", m_plain, "Only the pictures and their borders")
      ->group(kSheetGroup);
  AddText("--line", m_line, "X,Y,X,Y",
          "The ends of the measured line in mm (default: across\nthe body)", kMeasureGroup);
  AddText("--region", m_region, "X,Y,X,Y",
          "Two corners of the rectangle in mm (default: an even\npart of the body)", kMeasureGroup);
  m_grey.AddTo(GetApp(), "the input's own window, else auto;\nthe projection's is then auto");
}

std::vector<double> RenderCommand::Corners(const std::string& option,
                                           const std::string& text) const {
  const std::vector<double> numbers = SplitNumbers(text);
  if (numbers.size() != 4) {
    throw UsageError(option + ": " + study::Quoted(text) +
                     " is not X,Y,X,Y (four numbers with commas between them)");
  }
  if (std::any_of(numbers.begin(), numbers.end(),
                  [](double number) { return std::abs(number) > kFarthestMm; })) {
    throw UsageError(option + ": " + study::Quoted(text) + " is not within a kilometre");
  }
  if (m_plain) {
    throw UsageError(option + " and --no-annotations exclude each other");
  }
  return numbers;
}

void RenderCommand::CheckSheet() {
  if (!m_size.empty()) {
    const std::vector<int> size = ParseSize("--size", m_size, 2, "WIDTHxHEIGHT");
    if (size[0] < kSmallestWidth || size[1] < kSmallestHeight || size[0] > kLargestSide ||
        size[1] > kLargestSide) {
      throw UsageError("--size: " + study::Quoted(m_size) + " is not from " +
                       std::to_string(kSmallestWidth) + "x" + std::to_string(kSmallestHeight) +
                       " to " + std::to_string(kLargestSide) + "x" + std::to_string(kLargestSide));
    }
    m_sheet.width = size[0];
    m_sheet.height = size[1];
  }
  if (!m_layout.empty()) {
    const std::optional<SheetLayout> layout = FindLayout(m_layout);
    if (!layout) {
      throw UsageError("--layout: " + study::Quoted(m_layout) + " is not one of " + LayoutList());
    }
    m_sheet.layout = *layout;
  }
  if (!m_centre.empty()) {
    m_cursor = ParseTriple("--center", m_centre);
  }
  m_sheet.isAnnotated = !m_plain;
}

void RenderCommand::CheckMeasuring() {
  if (!m_line.empty()) {
    const std::vector<double> ends = Corners("--line", m_line);
    m_measure.line = PlaneLine{{ends[0], ends[1]}, {ends[2], ends[3]}};
  }
  if (!m_region.empty()) {
    const std::vector<double> corners = Corners("--region", m_region);
    const auto [left, right] = std::minmax(corners[0], corners[2]);
    const auto [top, bottom] = std::minmax(corners[1], corners[3]);
    if (left == right || top == bottom) {
      throw UsageError("--region: " + study::Quoted(m_region) + " has no area");
    }
    m_measure.region = PlaneRect{left, top, right, bottom};
  }
}

void RenderCommand::Check() {
  m_input.Check();
  if (m_output.empty()) {
    throw UsageError("no output is named (-o SHEET.png or -o SHEET.bmp)");
  }
  CheckPictureName("-o", m_output);
  CheckSheet();
  CheckMeasuring();
  m_grey.Check();
}

/// The centre of the volume's middle voxel, where planes go unless they are told otherwise.
study::Vec3 MiddleOf(const study::Study& study) {
  study::PlaneRequest pixel;
  pixel.width = pixel.height = 1;
  return study::ToVec3(MakePlane(study, pixel).coordinates.origin);
}

/// Tells which planes show nothing.
void TellMissed(const study::Study& study, const study::Vec3& centre, Console& console) {
  const auto tell = [&](const char* name, const study::Vec3& normal) {
    const study::Extent extent = study::ExtentAlong(study, normal);
    if (Dot(centre, normal) < extent.minimum || Dot(centre, normal) > extent.maximum) {
      console.Note(std::string("the ") + name + " plane does not meet the volume");
    }
  };
  tell("axial", {0, 0, 1});
  tell("coronal", {0, 1, 0});
  tell("sagittal", {1, 0, 0});
}

std::string TextOf(const ResultTable& results) {
  constexpr std::size_t kColumn = 14;
  std::string text;
  for (const auto& [name, value] : results) {
    std::string line = name + ":";
    line.resize(std::max(line.size() + 1, kColumn), ' ');
    text += line + value + "\n";
  }
  return text;
}

void RenderCommand::Run(Console& console) {
  CheckPlace(m_output);
  const study::Progress progress = console.GetProgress();
  const Input input = m_input.Load(console, study::PartOf(progress, 0, 0.5));
  study::Study& study = *input.study;
  m_sheet.cursor = m_measure.cursor = m_cursor.value_or(MiddleOf(study));
  TellMissed(study, m_sheet.cursor, console);
  m_sheet.display = m_grey.Resolve(study, console);
  m_sheet.projectionWindow = m_grey.WantsAuto() ? ProjectionWindow(study) : m_sheet.display.window;
  if (m_sheet.isAnnotated) {
    const study::Vec3& cross = m_sheet.cursor;
    m_sheet.results.emplace_back("Planes", FixedText(cross.x, 1) + ", " + FixedText(cross.y, 1) +
                                               ", " + FixedText(cross.z, 1) + " mm");
    m_sheet.measured =
        Measure(study, m_measure, m_sheet.results, study::PartOf(progress, 0.5, 0.6));
  }
  const SheetCanvas canvas(m_sheet.width, m_sheet.height);
  DrawSheet(study, m_sheet, canvas, study::PartOf(progress, 0.6, 0.95));
  study::Report(progress, 0.95, "writing the sheet");
  WritePicture(canvas.GetPicture(), m_output, m_output);
  if (!IsDevice(m_output)) {
    console.Print(TextOf(m_sheet.results));
  }
}

}  // namespace

std::unique_ptr<Command> MakeRenderCommand(CLI::App& application) {
  return std::make_unique<RenderCommand>(application);
}

}  // namespace cli
