#include <study/DicomLoader.h>
#include <study/dicom/Samples.h>
#include <study/dicom/SeriesList.h>
#include <study/dicom/SliceReader.h>
#include <study/dicom/StackGeometry.h>

#include <algorithm>
#include <cmath>
#include <cstdio>

// How a series becomes a study:
// 1. Read all headers, group them by series, choose one.
// 2. Keep the slices that share the grid most of them have, sort them, drop repeated positions.
// 3. Read the pixels as they are, slice by slice, straight into the volume.
// 4. Place the slices that could be read; tell what is irregular.
// 5. Find one scale and offset for all slices and convert the pixels in place.

namespace study {
namespace {

using Headers = std::vector<SliceHeader>;

/// Positions closer than this along the normal are one position.
constexpr double kSamePositionMm = 1e-4;

void Refuse(LoadReport& report, const SliceHeader& header, const std::string& reason) {
  report.refused.push_back({header.file, reason, header.seriesUid});
}

/// Nothing is left of the series with this UID, or, when there was none, of all files.
[[noreturn]] void ThrowNothingUsable(const std::vector<InputFile>& files, const LoadReport& report,
                                     const std::optional<std::string>& uid) {
  const auto& refused = report.refused;
  const auto first = std::find_if(refused.begin(), refused.end(), [&uid](const RefusedFile& file) {
    return !uid || file.seriesUid == *uid;
  });
  if (first == refused.end()) {
    throw Error("there is no DICOM file among " + std::to_string(files.size()) +
                (files.size() == 1 ? " file" : " files"));
  }
  std::string text = RefusalText(*first);
  if (refused.size() > 1) {
    text += " (and " + std::to_string(refused.size() - 1) + " more can't be used)";
  }
  throw Error(text);
}

Headers MembersOf(const Headers& headers, const std::string& uid) {
  Headers members;
  std::copy_if(headers.begin(), headers.end(), std::back_inserter(members),
               [&uid](const SliceHeader& header) { return header.seriesUid == uid; });
  return members;
}

/// Keeps the slices that share the typical grid and say where they lie as the typical one does.
Headers KeepFitting(const Headers& members, LoadReport& report) {
  const SliceHeader& typical = members[TypicalSlice(members)];
  Headers fitting;
  for (const SliceHeader& header : members) {
    std::string misfit = MisfitOf(header.grid, typical.grid);
    if (misfit.empty() && header.position.has_value() != typical.position.has_value()) {
      misfit = header.position ? "has a position, the other slices have none"
                               : "has no position, the other slices have one";
    }
    if (misfit.empty()) {
      fitting.push_back(header);
    } else {
      Refuse(report, header, "it " + misfit);
    }
  }
  return fitting;
}

/// Keeps the first of the slices at each position of a sorted stack.
Headers DropRepeats(const Headers& sorted, LoadReport& report) {
  const Vec3 normal = sorted.front().grid.Normal();
  Headers kept;
  for (const SliceHeader& header : sorted) {
    const bool repeats = header.position && !kept.empty() &&
                         Dot(*header.position - *kept.back().position, normal) <= kSamePositionMm;
    if (repeats) {
      Refuse(report, header,
             "it repeats the position " + Millimetres(Dot(*header.position, normal)) + " mm of " +
                 Quoted(kept.back().file.filename().string()));
    } else {
      kept.push_back(header);
    }
  }
  return kept;
}

/// The slices that made it into the volume, with what their values need.
struct LoadedSlices {
  Headers headers;
  std::vector<SliceValues> values;
};

LoadedSlices ReadPixels(const Headers& sorted, Study& study, LoadReport& report,
                        const Progress& progress) {
  LoadedSlices loaded;
  SliceReader reader;
  std::vector<std::uint16_t> samples;
  for (std::size_t i = 0; i < sorted.size(); ++i) {
    Report(progress, static_cast<double>(i) / static_cast<double>(sorted.size()), "reading slices");
    const SliceHeader& header = sorted[i];
    const SliceGrid& grid = header.grid;
    try {
      reader.CheckSize(header);
      samples.resize(std::size_t{grid.columns} * grid.rows);
      reader.Read(header, samples);
    } catch (const Error& error) {
      Refuse(report, header, error.what());
      continue;
    }
    const auto target =
        AppendSlice(study, static_cast<int>(grid.columns), static_cast<int>(grid.rows));
    std::copy(samples.begin(), samples.end(), target.begin());
    loaded.headers.push_back(header);
    loaded.values.push_back({header.format.isSigned,
                             RangeOfSamples(samples, header.format.isSigned), header.slope,
                             header.intercept});
  }
  return loaded;
}

std::string ShortNumber(double value) {
  char text[64];
  std::snprintf(text, sizeof text, "%.3g", value);
  return text;
}

void ConvertValues(const LoadedSlices& loaded, Study& study, LoadReport& report) {
  const ValueMapping mapping = ChooseMapping(loaded.values);
  study.scale = mapping.scale;
  study.offset = mapping.offset;
  auto values = loaded.values.begin();
  for (dSlice& slice : study.volume.GetSliceList()) {
    ApplyMapping(mapping, *values++, SamplesOf(slice));
  }
  if (mapping.maximumError > 0) {
    report.notes.push_back(
        "the slices are scaled differently: values were brought to one scale, "
        "with an error of at most " +
        ShortNumber(mapping.maximumError) + (study.unit.empty() ? "" : " " + study.unit));
  }
}

void Describe(const SliceHeader& header, Study& study) {
  study.unit = header.unit;
  study.modality = header.modality;
  study.description = header.description;
  if (header.windowCentre && header.windowWidth) {
    study.windowCentre = *header.windowCentre;
    study.windowWidth = *header.windowWidth;
  }
}

void NoteAssumptions(const SliceHeader& header, LoadReport& report) {
  if (!header.hasSpacing) {
    report.notes.push_back("the files tell no pixel spacing; 1 mm is assumed");
  }
  if (!header.position) {
    report.notes.push_back(
        "the files tell no positions; the order is that of the instance numbers");
  }
  if (header.hasLookupTable) {
    report.notes.push_back("the files hold a modality lookup table, which is not applied");
  }
}

void Place(const Headers& headers, Study& study, LoadReport& report) {
  const SliceGrid& grid = headers.front().grid;
  const StackPlacement placement = PlaceStack(headers);
  report.notes.insert(report.notes.end(), placement.notes.begin(), placement.notes.end());
  PlaceVolume(study, placement.first, grid.rowDirection * grid.columnSpacing,
              grid.columnDirection * grid.rowSpacing, placement.step);
}

}  // namespace

std::unique_ptr<Study> LoadDicom(const std::vector<std::filesystem::path>& paths,
                                 const std::string& series, LoadReport& report,
                                 const Progress& progress) {
  report = {};
  const std::vector<InputFile> files = CollectFiles(paths);
  const Headers headers = ReadAllHeaders(files, report, PartOf(progress, 0, 0.3));
  if (headers.empty()) {
    ThrowNothingUsable(files, report, std::nullopt);
  }
  report.series = ListSeries(headers);
  report.chosen = ChooseSeries(report.series, series);

  Headers slices = KeepFitting(MembersOf(headers, report.series[report.chosen].uid), report);
  SortSlices(slices, slices.front().grid.Normal());
  slices = DropRepeats(slices, report);
  if (slices.size() > static_cast<std::size_t>(kLargestVolumeSide)) {
    throw Error("the series has " + std::to_string(slices.size()) + " slices; at most " +
                std::to_string(kLargestVolumeSide) + " can be loaded");
  }

  auto study = std::make_unique<Study>();
  const LoadedSlices loaded = ReadPixels(slices, *study, report, PartOf(progress, 0.3, 0.95));
  if (loaded.headers.empty()) {
    ThrowNothingUsable(files, report, report.series[report.chosen].uid);
  }
  Describe(loaded.headers.front(), *study);
  NoteAssumptions(loaded.headers.front(), report);
  Place(loaded.headers, *study, report);
  Report(progress, 0.95, "converting values");
  ConvertValues(loaded, *study, report);
  Report(progress, 1, "loaded");
  return study;
}

}  // namespace study
