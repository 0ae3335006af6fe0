#include <cli/Command.h>
#include <cli/InputOptions.h>
#include <cli/Values.h>
#include <study/Planes.h>
#include <vorl/Operators/IP/opMinMax.h>

#include <cstdint>
#include <limits>

namespace cli {
namespace {

struct StoredRange {
  std::int32_t minimum = std::numeric_limits<std::int32_t>::max();
  std::int32_t maximum = std::numeric_limits<std::int32_t>::min();
};

StoredRange RangeOf(study::Study& study, const study::Progress& progress) {
  StoredRange range;
  opMinMax op;
  const double count = study.volume.GetSliceCount();
  double done = 0;
  for (dSlice& slice : study.volume.GetSliceList()) {
    study::Report(progress, done++ / count, "searching the range");
    if (!op.Run(&slice.GetImage(), range.minimum, range.maximum)) {
      throw study::Error("can't search the range: " +
                         std::string(static_cast<const char*>(op.GetStatus())));
    }
  }
  return range;
}

std::string Line(const std::string& label, const std::string& value) {
  return label + std::string(14 - label.size(), ' ') + value + "\n";
}

std::string WithUnit(const std::string& text, const study::Study& study) {
  return study.unit.empty() ? text : text + " " + study.unit;
}

std::string PointText(const study::Vec3& p) {
  return PositionText(p.x) + ", " + PositionText(p.y) + ", " + PositionText(p.z);
}

std::string DirectionText(const dVect3D& axis) {
  const study::Vec3 direction = study::Normalised(study::ToVec3(axis));
  return std::string(1, study::DirectionLetter(direction)) + " (" + PointText(direction) + ")";
}

/// The standard plane that the slices are nearest to.
std::string SliceKind(const study::Study& study) {
  switch (study::DirectionLetter(study::ToVec3(study.volume.GetCoordinates().axisZ))) {
    case 'H':
    case 'F':
      return "axial";
    case 'A':
    case 'P':
      return "coronal";
    default:
      return "sagittal";
  }
}

std::string SeriesLines(const study::LoadReport& report) {
  std::string text;
  for (std::size_t i = 0; i < report.series.size(); ++i) {
    text +=
        Line(i == report.chosen ? "Series:" : "Also there:",
             std::string("#") + std::to_string(i + 1) + " " + study::SeriesText(report.series[i]));
  }
  return text;
}

std::string GeometryLines(const study::Study& study) {
  const dCoordSys3D& place = study.volume.GetCoordinates();
  const double x = study::Length(study::ToVec3(place.axisX));
  const double y = study::Length(study::ToVec3(place.axisY));
  const double z = study::Length(study::ToVec3(place.axisZ));
  const dVolume& volume = study.volume;
  const std::string by = " x ";
  return Line("Matrix:", std::to_string(volume.GetSizeX()) + by +
                             std::to_string(volume.GetSizeY()) + by +
                             std::to_string(volume.GetSizeZ())) +
         Line("Spacing:", LengthText(x) + by + LengthText(y) + by + LengthText(z) + " mm") +
         Line("Size:", LengthText(x * volume.GetSizeX()) + by + LengthText(y * volume.GetSizeY()) +
                           by + LengthText(z * volume.GetSizeZ()) + " mm") +
         Line("First voxel:",
              PointText(study::WorldFromVoxel(study, {0.5, 0.5, 0.5})) + " mm (centre)") +
         Line("Centre:", PointText(study::WorldFromVoxel(
                             study, {0.5 * volume.GetSizeX(), 0.5 * volume.GetSizeY(),
                                     0.5 * volume.GetSizeZ()})) +
                             " mm") +
         Line("Orientation:", SliceKind(study)) +
         Line("", std::string("rows run to ") + DirectionText(place.axisX)) +
         Line("", std::string("columns run to ") + DirectionText(place.axisY)) +
         Line("", std::string("slices follow to ") + DirectionText(place.axisZ));
}

std::string ValueLines(const study::Study& study, const StoredRange& range) {
  std::string sampleType = dImage::DataType2Str(study.volume.GetDataType());
  sampleType += ", value = stored x " + NumberText(study.scale) +
                (study.offset < 0 ? " - " : " + ") + NumberText(std::abs(study.offset));
  std::string text =
      Line("Sample type:", sampleType) +
      Line("Stored range:",
           std::to_string(range.minimum) + " to " + std::to_string(range.maximum)) +
      Line("Value range:", WithUnit(NumberText(study.RealValue(range.minimum)) + " to " +
                                        NumberText(study.RealValue(range.maximum)),
                                    study)) +
      Line("Unit:", study.unit.empty() ? "none" : study.unit);
  if (study.windowWidth > 0) {
    text += Line("Window:", std::string("centre ") + NumberText(study.windowCentre) + ", width " +
                                NumberText(study.windowWidth));
  }
  return text;
}

class InfoCommand : public Command {
 public:
  explicit InfoCommand(CLI::App& application)
      : Command(application,
                {"info", "Tell what a volume is", "[OPTIONS] INPUT...\n[OPTIONS] --phantom[=WxHxN]",
                 "  vorl info scans/\n"
                 "  vorl info scans/ --series 4\n"
                 "  vorl info study.bdf\n"
                 "  vorl info --phantom"}) {
    m_input.AddTo(GetApp());
  }

  void Check() override { m_input.Check(); }

  void Run(Console& console) override {
    const study::Progress progress = console.GetProgress();
    const Input input = m_input.Load(console, study::PartOf(progress, 0, 0.9));
    study::Study& study = *input.study;
    const StoredRange range = RangeOf(study, study::PartOf(progress, 0.9, 1));
    std::string text = Line("Input:", input.name) + SeriesLines(input.report);
    if (!study.modality.empty()) {
      text += Line("Modality:", study.modality);
    }
    if (!study.description.empty()) {
      text += Line("Description:", study.description);
    }
    console.Print(text + GeometryLines(study) + ValueLines(study, range));
  }

 private:
  InputOptions m_input;
};

}  // namespace

std::unique_ptr<Command> MakeInfoCommand(CLI::App& application) {
  return std::make_unique<InfoCommand>(application);
}

}  // namespace cli
