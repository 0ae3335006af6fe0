#include <vorl/Data/dVect3D.h>

#include <cmath>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/detail/Single.h>

inline namespace vorl {

using vorl_detail::Difference;
using vorl_detail::kNearZero;
using vorl_detail::NearZero;
using vorl_detail::Quotient;
using vorl_detail::ScaledAbout;
using vorl_detail::Single;
using vorl_detail::Sum;
using vorl_detail::ZeroIfNear;

namespace {

/// The cross product before rounding.
struct CrossOf {
  CrossOf(const dVect3D& a, const dVect3D& b)
      : x(static_cast<double>(a.y) * b.z - static_cast<double>(a.z) * b.y),
        y(static_cast<double>(a.z) * b.x - static_cast<double>(a.x) * b.z),
        z(static_cast<double>(a.x) * b.y - static_cast<double>(a.y) * b.x) {}

  double x;
  double y;
  double z;
};

}  // namespace

VORL_REGISTER_CLASS(dVect3D, DataBase);

dVect3D::dVect3D() = default;

dVect3D::dVect3D(float newX, float newY, float newZ) : x(newX), y(newY), z(newZ) {}

dVect3D::dVect3D(const dVect3D& a, const dVect3D& b) {
  Diff(a, b);
}

dVect3D::dVect3D(const dVect3D& source) = default;

dVect3D& dVect3D::operator=(const dVect3D& source) = default;

dVect3D::~dVect3D() = default;

void dVect3D::Reset() {
  x = 0.0F;
  y = 0.0F;
  z = 0.0F;
}

void dVect3D::Set(double newX, double newY, double newZ) {
  x = Single(newX);
  y = Single(newY);
  z = Single(newZ);
}

void dVect3D::Set(const dVect3D& source) {
  *this = source;
}

float& dVect3D::operator[](int index) {
  return index <= 0 ? x : index == 1 ? y : z;
}

const float& dVect3D::operator[](int index) const {
  return index <= 0 ? x : index == 1 ? y : z;
}

bool dVect3D::operator==(const dVect3D& other) const {
  return NearZero(static_cast<double>(x) - other.x) && NearZero(static_cast<double>(y) - other.y) &&
         NearZero(static_cast<double>(z) - other.z);
}

bool dVect3D::operator!=(const dVect3D& other) const {
  return !(*this == other);
}

bool dVect3D::IsZero() const {
  return NearZero(x) && NearZero(y) && NearZero(z);
}

bool dVect3D::IsZero(float eps) const {
  return std::abs(x) <= eps && std::abs(y) <= eps && std::abs(z) <= eps;
}

void dVect3D::Diff(const dVect3D& a, const dVect3D& b) {
  x = Difference(b.x, a.x);
  y = Difference(b.y, a.y);
  z = Difference(b.z, a.z);
}

void dVect3D::Diff(const dVect3D& p) {
  Diff(*this, p);
}

dVect3D& dVect3D::operator+=(const dVect3D& other) {
  Move(other.x, other.y, other.z);
  return *this;
}

dVect3D& dVect3D::operator-=(const dVect3D& other) {
  Diff(other, *this);
  return *this;
}

void dVect3D::Move(double dx, double dy, double dz) {
  x = Sum(x, dx);
  y = Sum(y, dy);
  z = Sum(z, dz);
}

void dVect3D::Move(const dVect3D& way) {
  *this += way;
}

dVect3D& dVect3D::operator*=(double factor) {
  const float rounded = Single(factor);
  Scale(rounded, rounded, rounded);
  return *this;
}

dVect3D& dVect3D::operator/=(double divisor) {
  const float rounded = Single(divisor);
  if (rounded != 0.0F) {
    x = Quotient(x, rounded);
    y = Quotient(y, rounded);
    z = Quotient(z, rounded);
  }
  return *this;
}

void dVect3D::Scale(double factor) {
  *this *= factor;
}

void dVect3D::Scale(double factorX, double factorY, double factorZ) {
  x = vorl_detail::Product(x, factorX);
  y = vorl_detail::Product(y, factorY);
  z = vorl_detail::Product(z, factorZ);
}

void dVect3D::Scale(double factor, const dVect3D& centre) {
  Scale(factor, factor, factor, centre);
}

void dVect3D::Scale(double factorX, double factorY, double factorZ, const dVect3D& centre) {
  x = ScaledAbout(x, factorX, centre.x);
  y = ScaledAbout(y, factorY, centre.y);
  z = ScaledAbout(z, factorZ, centre.z);
}

double dVect3D::Length() const {
  return std::sqrt(Length2());
}

double dVect3D::Length2() const {
  return Product(*this);
}

double dVect3D::Distance(const dVect3D& other) const {
  return std::sqrt(Distance2(other));
}

double dVect3D::Distance2(const dVect3D& other) const {
  const double dx = static_cast<double>(other.x) - x;
  const double dy = static_cast<double>(other.y) - y;
  const double dz = static_cast<double>(other.z) - z;
  return dx * dx + dy * dy + dz * dz;
}

bool dVect3D::Normalize() {
  const float length = Single(Length());
  if (NearZero(length)) {
    return false;
  }
  *this /= length;
  return true;
}

bool dVect3D::IsNormalized() const {
  return std::abs(Length2() - 1.0) < kNearZero;
}

double dVect3D::Product(const dVect3D& other) const {
  return static_cast<double>(x) * other.x + static_cast<double>(y) * other.y +
         static_cast<double>(z) * other.z;
}

double dVect3D::CrossProduct(const dVect3D& other) const {
  const CrossOf cross(*this, other);
  return cross.x + cross.y + cross.z;
}

void dVect3D::vRotate(const dVect3D& axis, double angle) {
  if (axis.IsZero() || NearZero(angle)) {
    return;
  }
  dVect3D n(axis);
  n.Normalize();
  const dVect3D along = n * Product(n);  // the multiplication rounds the dot product
  dVect3D across = *this - along;
  dVect3D turned = n * across;
  across *= std::cos(angle);
  turned *= std::sin(angle);
  *this = along + across + turned;
}

void dVect3D::pRotate(const dVect3D& centre, const dVect3D& axis, double angle) {
  const dVect3D about(centre);  // centre and axis may be this vector
  const dVect3D direction(axis);
  *this -= about;
  vRotate(direction, angle);
  *this += about;
}

dVect3D operator+(const dVect3D& a, const dVect3D& b) {
  dVect3D sum(a);
  sum += b;
  return sum;
}

dVect3D operator-(const dVect3D& a, const dVect3D& b) {
  return dVect3D(b, a);
}

dVect3D operator*(const dVect3D& v, double factor) {
  dVect3D scaled(v);
  scaled *= factor;
  return scaled;
}

dVect3D operator*(const dVect3D& a, const dVect3D& b) {
  const CrossOf cross(a, b);
  return dVect3D(ZeroIfNear(cross.x), ZeroIfNear(cross.y), ZeroIfNear(cross.z));
}

}  // namespace vorl
