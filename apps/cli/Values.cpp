#include <cli/Command.h>
#include <cli/Values.h>
#include <study/Study.h>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <optional>

namespace cli {
namespace {

[[noreturn]] void Refuse(const std::string& option, const std::string& text,
                         const std::string& wanted) {
  throw UsageError(option + ": " + study::Quoted(text) + " is not " + wanted);
}

template <class T>
std::optional<T> Whole(const std::string& text) {
  T value{};
  const char* begin = text.data();
  const char* end = begin + text.size();
  if (text.size() > 1 && text[0] == '+' && text[1] != '-') {
    ++begin;
  }
  const auto result = std::from_chars(begin, end, value);
  if (result.ec != std::errc() || result.ptr != end) {
    return std::nullopt;
  }
  return value;
}

std::optional<double> Finite(const std::string& text) {
  const std::optional<double> value = Whole<double>(text);
  return value && std::isfinite(*value) ? value : std::nullopt;
}

std::vector<std::string> Split(const std::string& text, const char* separators) {
  std::vector<std::string> parts;
  std::size_t begin = 0;
  for (;;) {
    const std::size_t end = text.find_first_of(separators, begin);
    parts.push_back(text.substr(begin, end - begin));
    if (end == std::string::npos) {
      return parts;
    }
    begin = end + 1;
  }
}

std::optional<std::vector<int>> SplitSize(const std::string& text, std::size_t count) {
  std::vector<int> sizes;
  for (const std::string& part : Split(text, "xX")) {
    const std::optional<int> size = Whole<int>(part);
    if (!size || *size < 1 || *size > study::kLargestVolumeSide) {
      return std::nullopt;
    }
    sizes.push_back(*size);
  }
  return sizes.size() == count ? std::optional(sizes) : std::nullopt;
}

}  // namespace

double ParseNumber(const std::string& option, const std::string& text) {
  const std::optional<double> value = Finite(text);
  if (!value) {
    Refuse(option, text, "a number");
  }
  return *value;
}

double ParseNumberIn(const std::string& option, const std::string& text, double minimum,
                     double maximum) {
  const std::optional<double> value = Finite(text);
  if (!value || *value < minimum || *value > maximum) {
    Refuse(option, text, "a number from " + NumberText(minimum) + " to " + NumberText(maximum));
  }
  return *value;
}

double ParsePositive(const std::string& option, const std::string& text) {
  const std::optional<double> value = Finite(text);
  if (!value || *value <= 0) {
    Refuse(option, text, "a number greater than 0");
  }
  return *value;
}

int ParseWhole(const std::string& option, const std::string& text, int minimum, int maximum) {
  const std::optional<int> value = Whole<int>(text);
  if (!value || *value < minimum || *value > maximum) {
    Refuse(option, text,
           "a whole number from " + std::to_string(minimum) + " to " + std::to_string(maximum));
  }
  return *value;
}

study::Vec3 ParseTriple(const std::string& option, const std::string& text) {
  const std::vector<double> numbers = SplitNumbers(text);
  if (numbers.size() != 3) {
    Refuse(option, text, "X,Y,Z (three numbers with commas between them)");
  }
  return {numbers[0], numbers[1], numbers[2]};
}

std::vector<int> ParseSize(const std::string& option, const std::string& text, std::size_t count,
                           const std::string& form) {
  const std::optional<std::vector<int>> sizes = SplitSize(text, count);
  if (!sizes) {
    Refuse(option, text,
           form + " (whole numbers from 1 to " + std::to_string(study::kLargestVolumeSide) + ")");
  }
  return *sizes;
}

bool LooksLikeSize(const std::string& text, std::size_t count) {
  const std::vector<std::string> parts = Split(text, "xX");
  return parts.size() == count &&
         std::all_of(parts.begin(), parts.end(), [](const std::string& part) {
           return !part.empty() && part.find_first_not_of("0123456789") == std::string::npos;
         });
}

std::vector<double> SplitNumbers(const std::string& text) {
  std::vector<double> numbers;
  for (const std::string& part : Split(text, ",")) {
    const std::optional<double> number = Finite(part);
    if (!number) {
      return {};
    }
    numbers.push_back(*number);
  }
  return numbers;
}

std::string NumberText(double value) {
  char text[64];
  std::snprintf(text, sizeof text, "%.10g", value == 0 ? 0.0 : value);
  return text;
}

std::string PositionText(double millimetres) {
  return NumberText(std::round(millimetres * 1e4) / 1e4);
}

std::string FixedText(double value, int decimals) {
  char text[400];
  std::snprintf(text, sizeof text, "%.*f", decimals, value);
  const bool isZero = std::string(text).find_first_not_of("-0.") == std::string::npos;
  return isZero && text[0] == '-' ? text + 1 : text;
}

int DecimalsFor(double step) {
  // A hair less, so that a thousandth has three decimals even if its logarithm is rounded.
  return static_cast<int>(std::clamp(std::ceil(-std::log10(step) - 1e-6), 0.0, 9.0));
}

std::string LengthText(double value) {
  const auto single = static_cast<float>(value);
  char text[64];
  std::snprintf(text, sizeof text, "%.9g", static_cast<double>(single));
  if (std::strtod(text, nullptr) == static_cast<double>(single)) {
    return text;
  }
  const auto result = std::to_chars(text, text + sizeof text, single);
  return {text, result.ptr};
}

}  // namespace cli
