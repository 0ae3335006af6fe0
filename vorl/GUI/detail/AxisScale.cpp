#include <vorl/GUI/detail/AxisScale.h>

#include <vorl/GUI/detail/Truncated.h>

#include <algorithm>
#include <utility>

inline namespace vorl {
namespace vorl_detail {

namespace {

/// Ticks that are closer than this, in device units, cannot be told apart.
constexpr double kLeastDistance = 4.0;

}  // namespace

AxisScale::AxisScale(double start, double end, double length, double step, bool isInteger)
    : m_start(start), m_end(end), m_first(std::min(start, end)), m_last(std::max(start, end)) {
  const double perValue = length / std::abs(end - start);
  if (!(step > 0.0) || !std::isfinite(perValue) || !(perValue > 0.0)) {
    return;
  }
  m_step = isInteger ? std::max(step, 1.0) : step;
  while (m_step * perValue < kLeastDistance) {
    m_step *= 10.0;
  }
  const double exponent = std::floor(std::log10(m_step * 1.001));
  m_exponent = Truncated<int>(exponent);
  m_digit = Truncated<int>(m_step / std::pow(10.0, exponent) + 0.5);
  int parts = m_digit == 2 ? 4 : 5;
  while (isInteger && std::fmod(m_step, parts) != 0.0) {
    --parts;
  }
  m_parts = m_step * perValue / parts >= kLeastDistance ? parts : 1;
}

bool AxisScale::Show(const dVect2D& pos, const dVect2D& way, const tagRECT& rect, double margin) {
  const bool alongX = std::abs(way.x) >= std::abs(way.y);
  const double low = (alongX ? rect.left : rect.top) - margin;
  const double high = (alongX ? rect.right : rect.bottom) + margin;
  double from = (low - (alongX ? pos.x : pos.y)) / (alongX ? way.x : way.y);
  double to = (high - (alongX ? pos.x : pos.y)) / (alongX ? way.x : way.y);
  if (from > to) {
    std::swap(from, to);
  }
  from = std::max(from, 0.0);
  to = std::min(to, 1.0);
  m_first = m_start + from * (m_end - m_start);
  m_last = m_start + to * (m_end - m_start);
  if (m_first > m_last) {
    std::swap(m_first, m_last);
  }
  return from <= to;
}

double AxisScale::StrideFor(double extent, double distance) const {
  for (double power = 1.0; power < kMostSteps; power *= 10.0) {
    for (const int digit : {1, 2, 5}) {
      const double stride = digit * power / m_digit;
      if (stride == std::floor(stride) && stride * distance >= extent) {
        return stride;
      }
    }
  }
  return 1.0;
}

}  // namespace vorl_detail
}  // namespace vorl
