#include <vorl/Platform/soft/LineSteps.h>

#include <algorithm>
#include <cstdlib>

inline namespace vorl {
namespace vorl_detail {

namespace {

bool IsSteep(GridPoint from, GridPoint to) {
  return std::llabs(to.y - from.y) > std::llabs(to.x - from.x);
}

}  // namespace

LineSteps::LineSteps(GridPoint from, GridPoint to, const RECT& bounds)
    : LineSteps(IsSteep(from, to) ? Axis{from.y, to.y - from.y, bounds.top, bounds.bottom}
                                  : Axis{from.x, to.x - from.x, bounds.left, bounds.right},
                IsSteep(from, to) ? Axis{from.x, to.x - from.x, bounds.left, bounds.right}
                                  : Axis{from.y, to.y - from.y, bounds.top, bounds.bottom},
                IsSteep(from, to)) {}

// The ideal minor coordinate after k of n steps is k * delta / n. Rounded with halves going down it
// is ceil(k * delta / n - 1/2) = ceil((2 * k * delta - n) / (2 * n)).
LineSteps::LineSteps(const Axis& major, const Axis& minor, bool isSteep)
    : m_isSteep(isSteep),
      m_majorStart(major.start),
      m_minorStart(minor.start),
      m_direction(major.delta < 0 ? -1 : 1),
      m_minorLow(minor.low),
      m_minorHigh(minor.high),
      m_step(std::max<std::int64_t>(
          0, m_direction > 0 ? major.low - major.start : major.start - (major.high - 1))),
      m_end(std::min<std::int64_t>(std::llabs(major.delta), m_direction > 0
                                                                ? major.high - major.start
                                                                : major.start - major.low + 1)),
      m_ramp(m_step, 2 * minor.delta, -std::llabs(major.delta),
             std::max<std::int64_t>(1, 2 * std::llabs(major.delta))) {
  SkipHidden();
}

void LineSteps::Next() {
  ++m_step;
  m_ramp.Next();
  SkipHidden();
}

void LineSteps::SkipHidden() {
  while (m_step < m_end && (Minor() < m_minorLow || Minor() >= m_minorHigh)) {
    ++m_step;
    m_ramp.Next();
  }
}

std::int32_t LineSteps::X() const {
  return static_cast<std::int32_t>(m_isSteep ? Minor() : Major());
}

std::int32_t LineSteps::Y() const {
  return static_cast<std::int32_t>(m_isSteep ? Major() : Minor());
}

std::int64_t LineSteps::Length(GridPoint from, GridPoint to) {
  return std::max(std::llabs(to.x - from.x), std::llabs(to.y - from.y));
}

}  // namespace vorl_detail
}  // namespace vorl
