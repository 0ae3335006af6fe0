#include <vorl/Data/dVect2D.h>

#include <cmath>
#include <limits>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/detail/Single.h>
#include <vorl/Platform/Gdi.h>

inline namespace vorl {

using vorl_detail::Difference;
using vorl_detail::kNearZero;
using vorl_detail::kRadPerDegree;
using vorl_detail::NearZero;
using vorl_detail::Quotient;
using vorl_detail::ScaledAbout;
using vorl_detail::Single;
using vorl_detail::Sum;
using vorl_detail::ZeroIfNear;

VORL_REGISTER_CLASS(dVect2D, DataBase);

dVect2D::dVect2D() = default;

dVect2D::dVect2D(float newX, float newY) : x(newX), y(newY) {}

dVect2D::dVect2D(double angle) : x(Single(std::cos(angle))), y(Single(std::sin(angle))) {}

dVect2D::dVect2D(const tagPOINT& point) {
  Set(point);
}

dVect2D::dVect2D(const dVect2D& a, const dVect2D& b) {
  Diff(a, b);
}

dVect2D::dVect2D(const dVect2D& source) = default;

dVect2D& dVect2D::operator=(const dVect2D& source) = default;

dVect2D& dVect2D::operator=(const tagPOINT& point) {
  Set(point);
  return *this;
}

dVect2D::~dVect2D() = default;

void dVect2D::Reset() {
  x = 0.0F;
  y = 0.0F;
}

void dVect2D::Set(double newX, double newY) {
  x = Single(newX);
  y = Single(newY);
}

void dVect2D::Set(const tagPOINT& point) {
  Set(static_cast<double>(point.x), static_cast<double>(point.y));
}

void dVect2D::Set(const dVect2D& source) {
  *this = source;
}

float& dVect2D::operator[](int index) {
  return index <= 0 ? x : y;
}

const float& dVect2D::operator[](int index) const {
  return index <= 0 ? x : y;
}

bool dVect2D::operator==(const dVect2D& other) const {
  return NearZero(static_cast<double>(x) - other.x) && NearZero(static_cast<double>(y) - other.y);
}

bool dVect2D::operator!=(const dVect2D& other) const {
  return !(*this == other);
}

bool dVect2D::IsZero() const {
  return NearZero(x) && NearZero(y);
}

bool dVect2D::IsZero(float eps) const {
  return std::abs(x) <= eps && std::abs(y) <= eps;
}

void dVect2D::Diff(const dVect2D& a, const dVect2D& b) {
  x = Difference(b.x, a.x);
  y = Difference(b.y, a.y);
}

void dVect2D::Diff(const dVect2D& p) {
  Diff(*this, p);
}

dVect2D& dVect2D::operator+=(const dVect2D& other) {
  Add(other.x, other.y);
  return *this;
}

dVect2D& dVect2D::operator+=(const tagPOINT& point) {
  Add(static_cast<double>(point.x), static_cast<double>(point.y));
  return *this;
}

dVect2D& dVect2D::operator-=(const dVect2D& other) {
  Diff(other, *this);
  return *this;
}

dVect2D& dVect2D::operator-=(const tagPOINT& point) {
  Add(-static_cast<double>(point.x), -static_cast<double>(point.y));
  return *this;
}

void dVect2D::Add(double dx, double dy) {
  x = Sum(x, dx);
  y = Sum(y, dy);
}

void dVect2D::Add(const dVect2D& other) {
  *this += other;
}

dVect2D& dVect2D::operator*=(double factor) {
  const float rounded = Single(factor);
  Scale(rounded, rounded);
  return *this;
}

dVect2D& dVect2D::operator/=(double divisor) {
  const float rounded = Single(divisor);
  if (rounded != 0.0F) {
    x = Quotient(x, rounded);
    y = Quotient(y, rounded);
  }
  return *this;
}

void dVect2D::Scale(double factor) {
  *this *= factor;
}

void dVect2D::Scale(double factorX, double factorY) {
  x = vorl_detail::Product(x, factorX);
  y = vorl_detail::Product(y, factorY);
}

void dVect2D::Scale(double factor, const dVect2D& centre) {
  Scale(factor, factor, centre);
}

void dVect2D::Scale(double factorX, double factorY, const dVect2D& centre) {
  x = ScaledAbout(x, factorX, centre.x);
  y = ScaledAbout(y, factorY, centre.y);
}

double dVect2D::Length() const {
  return std::sqrt(Length2());
}

double dVect2D::Length2() const {
  return Product(*this);
}

double dVect2D::Distance(const dVect2D& other) const {
  return std::sqrt(Distance2(other));
}

double dVect2D::Distance2(const dVect2D& other) const {
  const double dx = static_cast<double>(other.x) - x;
  const double dy = static_cast<double>(other.y) - y;
  return dx * dx + dy * dy;
}

bool dVect2D::Normalize() {
  const float length = Single(Length());
  if (NearZero(length)) {
    return false;
  }
  *this /= length;
  return true;
}

bool dVect2D::IsNormalized() const {
  return std::abs(Length() - 1.0) < kNearZero;
}

double dVect2D::Product(const dVect2D& other) const {
  return static_cast<double>(x) * other.x + static_cast<double>(y) * other.y;
}

double dVect2D::CrossProduct(const dVect2D& other) const {
  return static_cast<double>(x) * other.y - static_cast<double>(y) * other.x;
}

double dVect2D::AngleCos() const {
  return IsZero() ? 1.0 : x / Length();
}

double dVect2D::AngleSin() const {
  return IsZero() ? 0.0 : y / Length();
}

double dVect2D::AngleTan() const {
  if (std::abs(static_cast<double>(x)) > kNearZero) {
    return static_cast<double>(y) / x;
  }
  constexpr double kLargest = std::numeric_limits<float>::max();
  return y < 0.0F ? -kLargest : kLargest;
}

double dVect2D::AngleRad() const {
  return std::atan(AngleTan());
}

double dVect2D::AngleDeg() const {
  return AngleRad() / kRadPerDegree;
}

void dVect2D::vRotate(double angle) {
  if (NearZero(angle)) {
    return;
  }
  const double cosine = std::cos(angle);
  const double sine = std::sin(angle);
  Set(x * cosine - y * sine, x * sine + y * cosine);
}

void dVect2D::pRotate(const dVect2D& centre, double angle) {
  const dVect2D about(centre);  // the centre may be this vector
  *this -= about;
  vRotate(angle);
  *this += about;
}

dVect2D operator+(const dVect2D& a, const dVect2D& b) {
  dVect2D sum(a);
  sum += b;
  return sum;
}

dVect2D operator-(const dVect2D& a, const dVect2D& b) {
  return dVect2D(b, a);
}

dVect2D operator*(const dVect2D& v, double factor) {
  dVect2D scaled(v);
  scaled *= factor;
  return scaled;
}

dVect2D operator*(const dVect2D& a, const dVect2D& b) {
  const double product = a.CrossProduct(b);
  return dVect2D(ZeroIfNear(product), ZeroIfNear(-product));
}

}  // namespace vorl
