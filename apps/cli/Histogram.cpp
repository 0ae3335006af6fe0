#include <cli/Histogram.h>

namespace cli {

Histogram HistogramOf(const study::Study& study) {
  Histogram counts(kStoredValues);
  for (const dSlice& slice : study.volume.GetSliceList()) {
    for (const std::uint16_t sample : study::SamplesOf(slice)) {
      ++counts[sample];
    }
  }
  return counts;
}

// The variance between the groups is largest where that within them is least.
std::uint16_t PartingValue(const Histogram& counts) {
  double all = 0;
  double sum = 0;
  std::size_t lowest = kStoredValues;
  for (std::size_t value = 0; value < kStoredValues; ++value) {
    all += static_cast<double>(counts[value]);
    sum += static_cast<double>(counts[value]) * static_cast<double>(value);
    if (counts[value] > 0 && lowest == kStoredValues) {
      lowest = value;
    }
  }
  std::size_t best = lowest == 0 || lowest == kStoredValues ? 0 : lowest - 1;
  double largest = 0;
  double dark = 0;
  double darkSum = 0;
  for (std::size_t value = 0; value + 1 < kStoredValues; ++value) {
    dark += static_cast<double>(counts[value]);
    darkSum += static_cast<double>(counts[value]) * static_cast<double>(value);
    if (dark == 0 || dark == all) {
      continue;
    }
    const double apart = darkSum / dark - (sum - darkSum) / (all - dark);
    const double between = dark * (all - dark) * apart * apart;
    if (between > largest) {
      largest = between;
      best = value;
    }
  }
  return static_cast<std::uint16_t>(best);
}

}  // namespace cli
