#include <vorl/Data/dPoint.h>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Platform/Gdi.h>

inline namespace vorl {

namespace {

// Unsigned arithmetic wraps around by definition, and so does the conversion back.
std::int32_t WrappedSum(std::int32_t a, std::int32_t b) {
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(a) + static_cast<std::uint32_t>(b));
}

std::int32_t WrappedDifference(std::int32_t a, std::int32_t b) {
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(a) - static_cast<std::uint32_t>(b));
}

}  // namespace

VORL_REGISTER_CLASS(dPoint, DataBase);

dPoint::dPoint() = default;

dPoint::dPoint(const tagPOINT& point) : x(point.x), y(point.y) {}

dPoint::dPoint(const dPoint& source) = default;

dPoint& dPoint::operator=(const dPoint& source) = default;

dPoint& dPoint::operator=(const tagPOINT& point) {
  Init(point.x, point.y);
  return *this;
}

dPoint::~dPoint() = default;

void dPoint::Reset() {
  Init();
}

void dPoint::Init() {
  Init(0, 0);
}

void dPoint::Init(int newX, int newY) {
  x = newX;
  y = newY;
}

bool dPoint::operator==(const dPoint& other) const {
  return x == other.x && y == other.y;
}

bool dPoint::operator!=(const dPoint& other) const {
  return !(*this == other);
}

bool dPoint::IsEmpty() const {
  return x == 0 && y == 0;
}

dPoint& dPoint::operator+=(const dPoint& other) {
  x = WrappedSum(x, other.x);
  y = WrappedSum(y, other.y);
  return *this;
}

dPoint& dPoint::operator-=(const dPoint& other) {
  x = WrappedDifference(x, other.x);
  y = WrappedDifference(y, other.y);
  return *this;
}

dPoint& dPoint::operator-() {
  x = WrappedDifference(0, x);
  y = WrappedDifference(0, y);
  return *this;
}

dPoint operator+(const dPoint& a, const dPoint& b) {
  dPoint sum(a);
  sum += b;
  return sum;
}

dPoint operator-(const dPoint& a, const dPoint& b) {
  dPoint difference(a);
  difference -= b;
  return difference;
}

}  // namespace vorl
