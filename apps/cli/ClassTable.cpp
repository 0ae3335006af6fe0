#include <cli/ClassTable.h>
#include <cli/Values.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdio>
#include <numeric>

namespace cli {
namespace {

constexpr std::int64_t kMostRows = 19;  // one more where the first row begins within the range
constexpr std::int64_t kHighestClass = 65535;

/// Classes from `begin` up to, but not including, `end`.
struct Range {
  std::int64_t begin = 0;
  std::int64_t end = 0;
};

Range UsedClasses(const std::vector<std::uint32_t>& counters) {
  const auto isUsed = [](std::uint32_t count) { return count > 0; };
  return {std::find_if(counters.begin(), counters.end(), isUsed) - counters.begin(),
          counters.rend() - std::find_if(counters.rbegin(), counters.rend(), isUsed)};
}

/// 1, 2, 5, 10, 20, 50 ... classes per row.
std::int64_t RowWidth(std::int64_t classes) {
  for (std::int64_t power = 1;; power *= 10) {
    for (const std::int64_t digit : {1, 2, 5}) {
      if (digit * power * kMostRows >= classes) {
        return digit * power;
      }
    }
  }
}

/// What is added to a class so that rows begin at round real values, where that can be.
std::int64_t RealShift(const Selection& selection) {
  if (selection.list.criterion == "edge") {
    return 0;
  }
  const double shift = selection.list.offset / selection.list.scale;
  return std::abs(shift) < 1e9 && shift == std::round(shift) ? std::llround(shift) : 0;
}

std::uint64_t Sum(const std::vector<std::uint32_t>& counters, const Range& range) {
  return std::accumulate(counters.begin() + range.begin,
                         counters.begin() + std::max(range.begin, range.end), std::uint64_t{0});
}

std::string RealText(const Selection& selection, std::int64_t voxelClass) {
  const double offset = selection.list.criterion == "edge" ? 0 : selection.list.offset;
  return NumberText(static_cast<double>(voxelClass) * selection.list.scale + offset);
}

double Percent(std::uint64_t part, std::uint64_t all) {
  return all > 0 ? 100.0 * static_cast<double>(part) / static_cast<double>(all) : 0;
}

std::string RowText(const std::array<std::string, 6>& cells) {
  std::array<char, 256> text{};
  std::snprintf(text.data(), text.size(), "%12s%12s%12s%10s%10s%12s\n", cells[0].c_str(),
                cells[1].c_str(), cells[2].c_str(), cells[3].c_str(), cells[4].c_str(),
                cells[5].c_str());
  return text.data();
}

std::string PercentText(double percent) {
  std::array<char, 32> text{};
  std::snprintf(text.data(), text.size(), "%.3f", percent);
  return text.data();
}

std::string Rows(const Selection& selection, std::uint64_t all) {
  const Range used = UsedClasses(selection.counters);
  const std::int64_t width = RowWidth(used.end - used.begin);
  const std::int64_t shift = RealShift(selection);
  // The highest class of all is never listed.
  const Range listed{selection.list.lowestClass, kHighestClass};
  std::string rows;
  std::uint64_t passed = 0;
  for (std::int64_t end = used.end; end > used.begin;) {
    const std::int64_t top = end - 1 + shift;
    const std::int64_t floor = top - ((top % width) + width) % width - shift;
    const Range row{std::max(floor, used.begin), end};
    const std::uint64_t count = Sum(selection.counters, row);
    passed += count;
    const std::uint64_t taken =
        Sum(selection.counters, {std::max(row.begin, listed.begin), std::min(row.end, listed.end)});
    rows += RowText({RealText(selection, row.begin), RealText(selection, row.end - 1),
                     std::to_string(count), PercentText(Percent(count, all)),
                     PercentText(Percent(passed, all)), std::to_string(taken)});
    end = row.begin;
  }
  return rows;
}

}  // namespace

std::string ClassTable(const Selection& selection) {
  const bool byEdge = selection.list.criterion == "edge";
  const std::uint64_t all =
      std::accumulate(selection.counters.begin(), selection.counters.end(), std::uint64_t{0});
  std::string text = byEdge ? "Voxels by edge strength" : "Voxels by value";
  text += selection.list.unit.empty() ? "\n" : " in " + selection.list.unit + "\n";
  text += RowText({"from", "to", "voxels", "%", "sum %", "listed"});
  if (all > 0) {
    text += Rows(selection, all);
  }
  const std::size_t listed = selection.list.voxels.size();
  text += "Listed: " + std::to_string(listed) + " of " + std::to_string(all) + " voxels (limit " +
          std::to_string(selection.list.limit) + ")";
  if (listed > 0) {
    text += ", from " + RealText(selection, selection.list.lowestClass) + " on";
  }
  return text + "\n";
}

}  // namespace cli
