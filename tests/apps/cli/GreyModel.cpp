#include "GreyModel.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

namespace cli_test {

std::vector<int> WindowLevels(long centre, long width, int count) {
  const long low = centre - width / 2;
  const double step = 255.0 / static_cast<double>(width);
  double level = 0.5 + (low < 0 ? static_cast<double>(-low) * step : 0.0);
  std::vector<int> levels;
  for (long stored = 0; stored < count; ++stored) {
    if (stored < low) {
      levels.push_back(0);
    } else if (stored >= low + width) {
      levels.push_back(255);
    } else {
      levels.push_back(static_cast<int>(level));
      level += step;
    }
  }
  return levels;
}

std::vector<int> SecondStage(double brightness, double contrast, double gamma) {
  const double angle = (contrast + 1.0) * 45.0 / 180.0 * 3.141592;
  const double slope = std::sin(angle) / std::max(std::cos(angle), 0.001);
  double value = 256.0 - (slope + 1.0) * (1.0 - brightness) * 128.0;
  std::vector<int> table;
  double low = 255;
  double high = 0;
  std::size_t first = 0;
  std::size_t last = 0;
  for (std::size_t i = 0; i < 256; ++i, value += slope) {
    table.push_back(value < 0 ? 0 : value >= 256 ? 255 : static_cast<int>(value));
    if (value >= 0 && value < 256 && value < low) {
      low = value;
      first = i;
    }
    if (value >= 0 && value < 256 && value > high) {
      high = value;
      last = i;
    }
  }
  for (std::size_t i = first; gamma != 1 && i < last; ++i) {
    const double part = std::max(0.0, (table[i] - low) / (high - low));
    table[i] = static_cast<int>(std::pow(part, 1 / gamma) * (high - low) + low);
  }
  return table;
}

}  // namespace cli_test
