#include <study/dicom/DicomFile.h>
#include <study/dicom/SeriesList.h>
#include <study/dicom/SliceReader.h>
#include <study/dicom/StackGeometry.h>

#include <algorithm>
#include <charconv>
#include <limits>
#include <map>
#include <set>
#include <system_error>
#include <tuple>

namespace study {
namespace {

namespace fs = std::filesystem;

std::vector<fs::path> FilesBelow(const fs::path& folder) {
  std::vector<fs::path> files;
  std::error_code error;
  fs::recursive_directory_iterator entry(folder, fs::directory_options::skip_permission_denied,
                                         error);
  for (; !error && entry != fs::recursive_directory_iterator(); entry.increment(error)) {
    std::error_code ignored;
    if (entry->is_regular_file(ignored)) {
      files.push_back(entry->path());
    }
  }
  if (error) {
    throw Error("can't read the folder " + Quoted(folder.string()) + ": " + error.message());
  }
  std::sort(files.begin(), files.end());
  return files;
}

/// The whole of `text` as a number of at least `least`; -1 when it is none.
long WholeNumber(const std::string& text, std::size_t begin) {
  long value = -1;
  const char* first = text.data() + begin;
  const char* last = text.data() + text.size();
  const auto result = std::from_chars(first, last, value);
  return result.ec == std::errc() && result.ptr == last ? value : -1;
}

bool IsPlace(long place, const std::vector<SeriesInfo>& series) {
  return place >= 1 && static_cast<unsigned long>(place) <= series.size();
}

[[noreturn]] void ThrowChoice(const std::string& problem, const std::vector<SeriesInfo>& series) {
  std::string text = problem + "; there are:";
  for (std::size_t i = 0; i < series.size(); ++i) {
    text += "\n  #" + std::to_string(i + 1) + " " + SeriesText(series[i]);
  }
  throw Error(text);
}

void AddHeaders(const InputFile& file, std::vector<SliceHeader>& headers, LoadReport& report) {
  if (!LooksLikeDicom(file.path)) {
    if (file.named) {
      report.refused.push_back({file.path, "it is no DICOM file", {}});
    } else {
      ++report.notDicom;
    }
    return;
  }
  FileIdentity identity;
  try {
    for (SliceHeader& header : ReadSliceHeaders(file.path, identity)) {
      headers.push_back(std::move(header));
    }
  } catch (const Error& error) {
    report.refused.push_back({file.path, error.what(), identity.seriesUid});
  }
}

}  // namespace

std::vector<InputFile> CollectFiles(const std::vector<fs::path>& paths) {
  std::vector<InputFile> files;
  std::set<fs::path> known;
  const auto add = [&](const fs::path& path, bool named) {
    std::error_code ignored;
    const fs::path real = fs::weakly_canonical(path, ignored);
    if (known.insert(real.empty() ? path : real).second) {
      files.push_back({path, named});
    }
  };
  for (const fs::path& path : paths) {
    std::error_code ignored;
    const fs::file_status status = fs::status(path, ignored);
    if (!fs::exists(status)) {
      throw Error(Quoted(path.string()) + " does not exist");
    }
    if (!fs::is_directory(status)) {
      add(path, true);
      continue;
    }
    for (const fs::path& file : FilesBelow(path)) {
      add(file, false);
    }
  }
  return files;
}

std::vector<SliceHeader> ReadAllHeaders(const std::vector<InputFile>& files, LoadReport& report,
                                        const Progress& progress) {
  std::vector<SliceHeader> headers;
  for (std::size_t i = 0; i < files.size(); ++i) {
    Report(progress, static_cast<double>(i) / static_cast<double>(files.size()), "reading headers");
    AddHeaders(files[i], headers, report);
  }
  return headers;
}

std::vector<SeriesInfo> ListSeries(const std::vector<SliceHeader>& headers) {
  std::map<std::string, std::vector<SliceHeader>> groups;
  for (const SliceHeader& header : headers) {
    groups[header.seriesUid].push_back(header);
  }
  std::vector<SeriesInfo> series;
  for (const auto& [uid, members] : groups) {
    const SliceHeader& typical = members[TypicalSlice(members)];
    series.push_back({uid, typical.seriesNumber, typical.modality, typical.description,
                      members.size(), typical.grid.columns, typical.grid.rows});
  }
  const auto key = [](const SeriesInfo& info) {
    return std::make_tuple(std::numeric_limits<std::size_t>::max() - info.slices,
                           info.number.value_or(std::numeric_limits<long>::max()), info.uid);
  };
  std::sort(series.begin(), series.end(),
            [&key](const SeriesInfo& a, const SeriesInfo& b) { return key(a) < key(b); });
  return series;
}

std::size_t ChooseSeries(const std::vector<SeriesInfo>& series, const std::string& choice) {
  if (choice.empty()) {
    return 0;
  }
  for (std::size_t i = 0; i < series.size(); ++i) {
    if (series[i].uid == choice) {
      return i;
    }
  }
  if (choice[0] == '#') {
    const long place = WholeNumber(choice, 1);
    if (!IsPlace(place, series)) {
      ThrowChoice("there is no series " + Quoted(choice), series);
    }
    return static_cast<std::size_t>(place) - 1;
  }
  const long number = WholeNumber(choice, 0);
  const auto hasNumber = [number](const SeriesInfo& info) {
    return info.number && *info.number == number;
  };
  const auto count = std::count_if(series.begin(), series.end(), hasNumber);
  if (number >= 0 && count > 1) {
    ThrowChoice("several series have the number " + Quoted(choice) + ", choose by UID or #place",
                series);
  }
  if (number >= 0 && count == 1) {
    return static_cast<std::size_t>(std::find_if(series.begin(), series.end(), hasNumber) -
                                    series.begin());
  }
  if (!IsPlace(number, series)) {
    ThrowChoice("there is no series " + Quoted(choice), series);
  }
  return static_cast<std::size_t>(number) - 1;
}

}  // namespace study
