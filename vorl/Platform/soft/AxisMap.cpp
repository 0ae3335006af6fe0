#include <vorl/Platform/soft/AxisMap.h>

#include <algorithm>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

// A walk over `length` pixels from `start` up or down.
struct Walk {
  std::int64_t start;
  std::int64_t step;
  std::int64_t length;

  Walk(std::int64_t first, int signedLength)
      : start(first), step(signedLength < 0 ? -1 : 1), length(step * std::int64_t{signedLength}) {}
  std::int64_t At(std::int64_t index) const { return start + step * index; }
  std::int64_t IndexOf(std::int64_t position) const { return step * (position - start); }
};

// ((2 index + 1) * to - 1) / (2 * from): below 2^63 for lengths up to 2^31.
std::int64_t Scale(std::int64_t index, std::int64_t from, std::int64_t to) {
  return ((2 * index + 1) * to - 1) / (2 * from);
}

void MapEnlarged(const Walk& target, const Walk& source, int sourceSize, int targetEnd,
                 AxisMap* map) {
  for (int x = map->begin; x < targetEnd; ++x) {
    const std::int64_t p = source.At(Scale(target.IndexOf(x), target.length, source.length));
    if (p >= 0 && p < sourceSize) {
      map->first.push_back(static_cast<int>(p));
      map->end = x + 1;
    } else if (map->first.empty()) {
      map->begin = x + 1;
    }
  }
  map->last = map->first;
}

void MapReduced(const Walk& target, const Walk& source, int sourceSize, int targetEnd,
                AxisMap* map) {
  const auto count = static_cast<std::size_t>(targetEnd - map->begin);
  map->first.assign(count, -1);
  map->last.assign(count, -1);
  const std::int64_t low = std::min(source.IndexOf(0), source.IndexOf(sourceSize - 1));
  const std::int64_t high = std::max(source.IndexOf(0), source.IndexOf(sourceSize - 1));
  for (auto i = std::max<std::int64_t>(low, 0); i <= std::min(high, source.length - 1); ++i) {
    const std::int64_t x = target.At(Scale(i, source.length, target.length));
    if (x >= map->begin && x < targetEnd) {
      const auto k = static_cast<std::size_t>(x - map->begin);
      map->last[k] = static_cast<int>(source.At(i));
      if (map->first[k] < 0) {
        map->first[k] = map->last[k];
      }
    }
  }
  // Only pixels at the two ends can be without a source.
  const auto used = [](int p) { return p >= 0; };
  const auto from = std::find_if(map->first.begin(), map->first.end(), used);
  const auto to = std::find_if_not(from, map->first.end(), used);
  const auto skipped = from - map->first.begin();
  const auto kept = to - from;
  map->begin += static_cast<int>(skipped);
  map->end = map->begin + static_cast<int>(kept);
  map->first = std::vector<int>(from, to);
  map->last = std::vector<int>(map->last.begin() + skipped, map->last.begin() + skipped + kept);
}

}  // namespace

bool TouchesSource(const Axis& axis, int sourceSize) {
  const Walk source(axis.source, axis.sourceLength);
  if (source.length == 0) {
    return false;
  }
  const std::int64_t end = source.At(source.length - 1);
  return std::min(source.start, end) < sourceSize && std::max(source.start, end) >= 0;
}

AxisMap MapAxis(const Axis& axis, int targetBegin, int targetEnd, int sourceSize) {
  AxisMap map;
  const Walk target(axis.target, axis.targetLength);
  const Walk source(axis.source, axis.sourceLength);
  if (target.length == 0 || source.length == 0 || sourceSize <= 0) {
    return map;
  }
  const std::int64_t low = std::min(target.At(0), target.At(target.length - 1));
  const std::int64_t high = std::max(target.At(0), target.At(target.length - 1));
  const std::int64_t begin = std::max<std::int64_t>(low, targetBegin);
  const std::int64_t end = std::min<std::int64_t>(high + 1, targetEnd);
  if (begin >= end) {
    return map;
  }
  map.begin = map.end = static_cast<int>(begin);
  if (source.length <= target.length) {
    MapEnlarged(target, source, sourceSize, static_cast<int>(end), &map);
  } else {
    MapReduced(target, source, sourceSize, static_cast<int>(end), &map);
  }
  if (map.first.empty()) {
    map.begin = map.end;
  }
  map.contiguous = source.length == target.length && source.step == target.step;
  return map;
}

}  // namespace vorl_detail
}  // namespace vorl
