#include <vorl/Platform/soft/DashPattern.h>

#include <vorl/Platform/Gdi.h>

inline namespace vorl {
namespace vorl_detail {

DashPattern::DashPattern(int penStyle) : m_lengths(LengthsOf(penStyle)) {}

const DashPattern::Lengths& DashPattern::LengthsOf(int penStyle) {
  static constexpr Lengths kSolid{{1}, 1};
  static constexpr Lengths kDash{{18, 6}, 24};
  static constexpr Lengths kDot{{3, 3}, 6};
  static constexpr Lengths kDashDot{{9, 6, 3, 6}, 24};
  static constexpr Lengths kDashDotDot{{9, 3, 3, 3, 3, 3}, 24};
  switch (penStyle) {
    case PS_DASH:
      return kDash;
    case PS_DOT:
      return kDot;
    case PS_DASHDOT:
      return kDashDot;
    case PS_DASHDOTDOT:
      return kDashDotDot;
    default:
      return kSolid;
  }
}

bool DashPattern::IsInk(std::int64_t step) const {
  auto rest = static_cast<int>(step % m_lengths.total);
  int place = 0;
  while (rest >= m_lengths.length[place]) {
    rest -= m_lengths.length[place];
    ++place;
  }
  return place % 2 == 0;
}

}  // namespace vorl_detail
}  // namespace vorl
