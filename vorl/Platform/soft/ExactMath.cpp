#include <vorl/Platform/soft/ExactMath.h>

#include <cmath>

inline namespace vorl {
namespace vorl_detail {

namespace {

__extension__ using Wide = __int128;
__extension__ using UnsignedWide = unsigned __int128;

struct Division {
  std::int64_t floor;
  std::int64_t rest;  // 0 <= rest < divisor
};

Division Divide(Wide value, std::int64_t divisor) {
  Wide floor = value / divisor;
  Wide rest = value % divisor;
  if (rest < 0) {
    rest += divisor;
    --floor;
  }
  return {static_cast<std::int64_t>(floor), static_cast<std::int64_t>(rest)};
}

}  // namespace

std::uint64_t SquareRootFloor(std::uint64_t value) {
  // The double is off by a few units at most; the loops make it exact.
  auto root = static_cast<std::uint64_t>(std::sqrt(static_cast<double>(value)));
  while (UnsignedWide{root} * root > value) {
    --root;
  }
  while (UnsignedWide{root + 1} * (root + 1) <= value) {
    ++root;
  }
  return root;
}

std::int64_t ShareOfDiagonal(std::uint64_t factor, std::uint64_t side, std::uint64_t other) {
  const UnsignedWide product = UnsignedWide{factor} * side;
  const UnsignedWide diagonalSquared = UnsignedWide{side} * side + UnsignedWide{other} * other;
  // floor(sqrt(a / b)) = floor(sqrt(floor(a / b))): an integer is not above the root exactly when
  // its square, an integer too, is not above the quotient. The quotient is at most factor squared.
  const UnsignedWide quotient = product * product / diagonalSquared;
  return static_cast<std::int64_t>(SquareRootFloor(static_cast<std::uint64_t>(quotient)));
}

CeilingRamp::CeilingRamp(std::int64_t first, std::int64_t slope, std::int64_t shift,
                         std::int64_t divisor)
    : m_divisor(divisor) {
  const Division step = Divide(slope, divisor);
  m_floorStep = step.floor;
  m_restStep = step.rest;
  const Division start = Divide(Wide{first} * slope + shift, divisor);
  m_floor = start.floor;
  m_rest = start.rest;
}

void CeilingRamp::Next() {
  m_floor += m_floorStep;
  m_rest += m_restStep;
  if (m_rest >= m_divisor) {
    m_rest -= m_divisor;
    ++m_floor;
  }
}

}  // namespace vorl_detail
}  // namespace vorl
