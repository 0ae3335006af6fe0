#include <study/dicom/StackGeometry.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <limits>
#include <tuple>

namespace study {
namespace {

constexpr double kDirectionTolerance = 1e-3;
constexpr double kSpacingTolerance = 1e-3;
constexpr std::size_t kNotesShown = 10;

bool SameDirection(const Vec3& a, const Vec3& b) {
  const Vec3 d = a - b;
  return std::max({std::abs(d.x), std::abs(d.y), std::abs(d.z)}) <= kDirectionTolerance;
}

bool SameSpacing(double a, double b) {
  return std::abs(a - b) <= kSpacingTolerance * b;
}

std::string SizeText(const SliceGrid& grid) {
  return std::to_string(grid.columns) + " x " + std::to_string(grid.rows);
}

std::string SpacingText(const SliceGrid& grid) {
  return Millimetres(grid.columnSpacing) + " x " + Millimetres(grid.rowSpacing) + " mm";
}

/// The step of a stack whose positions do not tell it.
Vec3 AnnouncedStep(const SliceHeader& header) {
  double length = header.sliceSpacing > 0 ? header.sliceSpacing : header.thickness;
  if (!(length > 0)) {
    length = 1;
  }
  return header.grid.Normal() * length;
}

/// The lower one of two middle values: a gap makes distances longer, never shorter.
double Median(std::vector<double> values) {
  const auto middle = values.begin() + static_cast<std::ptrdiff_t>((values.size() - 1) / 2);
  std::nth_element(values.begin(), middle, values.end());
  return *middle;
}

/// One line on the distance between two neighbours, or nothing when it is the typical one.
std::string GapText(double from, double to, double typical) {
  const double distance = to - from;
  if (std::abs(distance - typical) <= std::max(0.005, 0.01 * typical)) {
    return {};
  }
  const std::string where = "between " + Millimetres(from) + " and " + Millimetres(to) + " mm";
  const double missing = std::round(distance / typical) - 1;
  if (missing >= 1 && std::abs(distance / typical - missing - 1) <= 0.1 && missing < 1e6) {
    const long count = std::lround(missing);
    return std::to_string(count) + (count == 1 ? " slice is" : " slices are") + " missing " + where;
  }
  return "the slices " + where + " are " + Millimetres(distance) + " mm apart instead of " +
         Millimetres(typical) + " mm";
}

void NoteGaps(const std::vector<double>& positions, std::vector<std::string>& notes) {
  std::vector<double> distances;
  for (std::size_t k = 1; k < positions.size(); ++k) {
    distances.push_back(positions[k] - positions[k - 1]);
  }
  const double typical = Median(distances);
  std::size_t found = 0;
  for (std::size_t k = 1; k < positions.size(); ++k) {
    const std::string text = GapText(positions[k - 1], positions[k], typical);
    if (!text.empty() && ++found <= kNotesShown) {
      notes.push_back(text);
    }
  }
  if (found > kNotesShown) {
    notes.push_back("and " + std::to_string(found - kNotesShown) + " more irregular distances");
  }
  if (found == 0) {
    return;
  }
  const double mean =
      (positions.back() - positions.front()) / static_cast<double>(positions.size() - 1);
  notes.push_back("the mean distance of " + Millimetres(mean) + " mm is used for all slices");
}

/// The largest distance of a slice from where the line from first to last puts it, in the plane.
double LargestDrift(const std::vector<SliceHeader>& sorted, const Vec3& step) {
  const Vec3 normal = sorted.front().grid.Normal();
  const double rise = Dot(step, normal);
  double largest = 0;
  for (const SliceHeader& header : sorted) {
    const Vec3 from = *header.position - *sorted.front().position;
    const Vec3 off = from - step * (Dot(from, normal) / rise);
    largest = std::max(largest, Length(off));
  }
  return largest;
}

}  // namespace

std::string Millimetres(double value) {
  char text[64];
  std::snprintf(text, sizeof text, "%.3f", value);
  std::string result = text;
  result.erase(result.find_last_not_of('0') + 1);
  if (result.back() == '.') {
    result.pop_back();
  }
  return result == "-0" ? "0" : result;
}

std::string MisfitOf(const SliceGrid& slice, const SliceGrid& stack) {
  if (slice.columns != stack.columns || slice.rows != stack.rows) {
    return "is " + SizeText(slice) + " pixels, the series is " + SizeText(stack);
  }
  if (!SameDirection(slice.rowDirection, stack.rowDirection) ||
      !SameDirection(slice.columnDirection, stack.columnDirection)) {
    return "has another orientation than the series";
  }
  if (!SameSpacing(slice.columnSpacing, stack.columnSpacing) ||
      !SameSpacing(slice.rowSpacing, stack.rowSpacing)) {
    return "has a pixel spacing of " + SpacingText(slice) + ", the series has " +
           SpacingText(stack);
  }
  return {};
}

std::size_t TypicalSlice(const std::vector<SliceHeader>& headers) {
  struct Kind {
    std::size_t representative;
    std::size_t count;
  };
  std::vector<Kind> kinds;
  for (std::size_t i = 0; i < headers.size(); ++i) {
    const auto known = std::find_if(kinds.begin(), kinds.end(), [&](const Kind& kind) {
      return MisfitOf(headers[i].grid, headers[kind.representative].grid).empty();
    });
    if (known == kinds.end()) {
      kinds.push_back({i, 1});
    } else {
      ++known->count;
    }
  }
  const auto largest = std::max_element(
      kinds.begin(), kinds.end(), [](const Kind& a, const Kind& b) { return a.count < b.count; });
  return largest == kinds.end() ? 0 : largest->representative;
}

void SortSlices(std::vector<SliceHeader>& headers, const Vec3& normal) {
  const auto key = [&normal](const SliceHeader& header) {
    const double along = header.position ? Dot(*header.position, normal) : 0.0;
    const long instance = header.instanceNumber.value_or(std::numeric_limits<long>::max());
    return std::make_tuple(along, instance, header.file);
  };
  std::sort(headers.begin(), headers.end(),
            [&key](const SliceHeader& a, const SliceHeader& b) { return key(a) < key(b); });
}

StackPlacement PlaceStack(const std::vector<SliceHeader>& sorted) {
  const SliceHeader& front = sorted.front();
  StackPlacement placement;
  placement.first = front.position.value_or(Vec3{});
  placement.step = AnnouncedStep(front);
  if (sorted.size() < 2 || !front.position) {
    return placement;
  }

  placement.step =
      (*sorted.back().position - *front.position) * (1.0 / static_cast<double>(sorted.size() - 1));
  const Vec3 normal = front.grid.Normal();
  std::vector<double> positions;
  for (const SliceHeader& header : sorted) {
    positions.push_back(Dot(*header.position, normal));
  }
  NoteGaps(positions, placement.notes);

  const double drift = LargestDrift(sorted, placement.step);
  if (drift > 0.5 * std::min(front.grid.columnSpacing, front.grid.rowSpacing)) {
    placement.notes.push_back("the slices do not lie on a line: up to " + Millimetres(drift) +
                              " mm beside it");
  }
  return placement;
}

}  // namespace study
