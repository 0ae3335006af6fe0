#ifndef VORL_GUI_DETAIL_AXISSCALE_H
#define VORL_GUI_DETAIL_AXISSCALE_H

/// @file
/// The numbers behind the ticks of an axis.

#include <vorl/Data/dVect2D.h>
#include <vorl/Platform/Gdi.h>

#include <cmath>

inline namespace vorl {
namespace vorl_detail {

/// At which values an axis has ticks.
class AxisScale {
 public:
  /// An axis from one value to another, of a length on the device, with main ticks at the multiples
  /// of a round step (1, 2 or 5 times a power of ten). Steps that are too narrow to be seen are
  /// widened. Values of an integer unit lie at whole numbers only.
  AxisScale(double start, double end, double length, double step, bool isInteger);

  /// Leaves only the values that can be seen in a rectangle, for an axis from a position along a
  /// way. False where there are none.
  bool Show(const dVect2D& pos, const dVect2D& way, const tagRECT& rect, double margin);
  double First() const { return m_first; }
  double Last() const { return m_last; }

  /// The distance of the main ticks; 0 where there can be none.
  double Step() const { return m_step; }
  /// Into how many parts the shorter ticks part it.
  int Parts() const { return m_parts; }
  /// The power of ten of the step.
  int Exponent() const { return m_exponent; }
  /// How many steps make a round number, and are together at least as long as an extent, if each is
  /// as long as a distance.
  double StrideFor(double extent, double distance) const;
  /// Where a value stands, in lengths of the axis.
  double PlaceOf(double value) const { return LengthOf(value - m_start); }
  /// How long a difference of values is, in lengths of the axis.
  double LengthOf(double difference) const { return difference / (m_end - m_start); }

  /// Calls `visit` with the number of each multiple of a step that can be seen.
  template <class Visitor>
  void ForEachStep(double step, Visitor&& visit) const {
    constexpr double kHair = 1e-6;
    const double from = std::ceil(m_first / step - kHair);
    const double to = std::floor(m_last / step + kHair);
    if (std::abs(from) > kMostSteps || std::abs(to) > kMostSteps) {
      return;
    }
    for (double number = from; number <= to; number += 1.0) {
      visit(number + 0.0);  // never the negative zero
    }
  }

 private:
  /// From here on neighbouring multiples of a step are not exact any more.
  static constexpr double kMostSteps = 1e15;

  double m_start;
  double m_end;
  double m_first;
  double m_last;
  double m_step = 0.0;
  int m_digit = 1;  ///< the step's first one
  int m_exponent = 0;
  int m_parts = 1;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
