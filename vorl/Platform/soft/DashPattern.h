#ifndef VORL_PLATFORM_SOFT_DASHPATTERN_H
#define VORL_PLATFORM_SOFT_DASHPATTERN_H

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// Where a pen style draws and where it leaves gaps. Lengths count pixels along the line's longer
/// axis, whatever its direction; a pattern starts anew with each LineTo and goes round the corners
/// of a polygon.
class DashPattern {
 public:
  /// The pattern of PS_DASH ... PS_DASHDOTDOT; other styles have no gaps.
  explicit DashPattern(int penStyle);

  /// Does the pen draw the pixel of this number, counted from the start of the pattern?
  bool IsInk(std::int64_t step) const;

 private:
  // A dash, then a gap, and so on; unused places are 0.
  struct Lengths {
    int length[6];
    int total;
  };
  static const Lengths& LengthsOf(int penStyle);

  const Lengths& m_lengths;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
