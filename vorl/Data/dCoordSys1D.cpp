#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dCoordSys.h>

inline namespace vorl {

VORL_REGISTER_CLASS(dCoordSys1D, DataBase);

dCoordSys1D::dCoordSys1D() = default;

dCoordSys1D::dCoordSys1D(double newOrigin, double newScale) : origin(newOrigin), scale(newScale) {}

dCoordSys1D::dCoordSys1D(const dCoordSys1D& source) = default;

dCoordSys1D& dCoordSys1D::operator=(const dCoordSys1D& source) = default;

dCoordSys1D::~dCoordSys1D() = default;

void dCoordSys1D::Reset() {
  Set(0.0, 1.0);
}

bool dCoordSys1D::IsValid() {
  return scale != 0.0;
}

void dCoordSys1D::Set(double newOrigin, double newScale) {
  origin = newOrigin;
  scale = newScale;
}

void dCoordSys1D::Move(double distance) {
  origin += distance;
}

void dCoordSys1D::Scale(double factor) {
  scale *= factor;
}

void dCoordSys1D::Scale(double factor, double centre) {
  origin = origin + (factor - 1.0) * (centre - origin);
  Scale(factor);
}

}  // namespace vorl
