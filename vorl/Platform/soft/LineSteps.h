#ifndef VORL_PLATFORM_SOFT_LINESTEPS_H
#define VORL_PLATFORM_SOFT_LINESTEPS_H

#include <vorl/Platform/soft/ExactMath.h>
#include <vorl/Platform/soft/Spans.h>

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// The pixels of a line of one pixel's width that lie inside `bounds`, from its start to its end.
///
/// A line has one pixel in each column that it passes (each row, when it is steeper than a
/// diagonal): the one nearest to the ideal line, and where the ideal line runs midway between two
/// pixels, the one with the smaller coordinate. Its last point is left out. What is cut off does
/// not move the rest: a line that enters the bounds shows the same pixels there as it does uncut.
class LineSteps {
 public:
  LineSteps(GridPoint from, GridPoint to, const RECT& bounds);

  /// False when there are no more pixels inside the bounds.
  bool IsValid() const { return m_step < m_end; }
  /// Goes on to the next pixel inside the bounds.
  void Next();

  std::int32_t X() const;
  std::int32_t Y() const;
  /// The number of the pixel on the whole line, counted from 0 at its start.
  std::int64_t Step() const { return m_step; }

  /// The pixels of a whole line, the hidden ones included.
  static std::int64_t Length(GridPoint from, GridPoint to);

 private:
  // The line steps along its major axis by one; the minor coordinate follows a ramp.
  struct Axis {
    std::int64_t start;
    std::int64_t delta;
    std::int64_t low;   // of the bounds
    std::int64_t high;  // of the bounds, one behind
  };
  LineSteps(const Axis& major, const Axis& minor, bool isSteep);

  std::int64_t Major() const { return m_majorStart + m_direction * m_step; }
  std::int64_t Minor() const { return m_minorStart + m_ramp.Value(); }
  void SkipHidden();

  bool m_isSteep;
  std::int64_t m_majorStart;
  std::int64_t m_minorStart;
  std::int64_t m_direction;
  std::int64_t m_minorLow;
  std::int64_t m_minorHigh;
  std::int64_t m_step;
  std::int64_t m_end;
  CeilingRamp m_ramp;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
