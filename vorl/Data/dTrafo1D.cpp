#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dTrafo.h>

inline namespace vorl {

VORL_REGISTER_CLASS(dTrafo1D, DataBase);

dTrafo1D::dTrafo1D() = default;

dTrafo1D::dTrafo1D(const dTrafo1D& source) = default;

dTrafo1D::dTrafo1D(const dCoordSys1D& s, const dCoordSys1D& t) {
  Init(s, t);
}

dTrafo1D::dTrafo1D(const dCoordSys1D& s, const dCoordSys1D& t, double ps, double pt) {
  Init(s, t, ps, pt);
}

dTrafo1D::dTrafo1D(double a, double b, double ps, double pt) {
  Init(a, b, ps, pt);
}

dTrafo1D& dTrafo1D::operator=(const dTrafo1D& source) = default;

dTrafo1D::~dTrafo1D() = default;

void dTrafo1D::Reset() {
  scaleS2T = 1.0;
  offsetS2T = 0.0;
  scaleT2S = 1.0;
  offsetT2S = 0.0;
}

bool dTrafo1D::IsValid() {
  return true;
}

bool dTrafo1D::Init(double a, double b, double ps, double pt) {
  scaleS2T = b / a;
  scaleT2S = a / b;
  SetTranslation(ps, pt);
  return true;
}

bool dTrafo1D::Init(const dCoordSys1D& s, const dCoordSys1D& t) {
  scaleS2T = t.scale / s.scale;
  scaleT2S = s.scale / t.scale;
  offsetS2T = 0.0;
  offsetT2S = 0.0;
  return true;
}

bool dTrafo1D::Init(const dCoordSys1D& s, const dCoordSys1D& t, double ps, double pt) {
  return Init(s.scale, t.scale, ps, pt);
}

void dTrafo1D::SetTranslation(double ps, double pt) {
  offsetS2T = pt - scaleS2T * ps;
  offsetT2S = ps - scaleT2S * pt;
}

double dTrafo1D::vS2T(double x) const {
  return scaleS2T * x;
}

double dTrafo1D::pS2T(double x) const {
  return scaleS2T * x + offsetS2T;
}

double dTrafo1D::vT2S(double x) const {
  return scaleT2S * x;
}

double dTrafo1D::pT2S(double x) const {
  return scaleT2S * x + offsetT2S;
}

void dTrafo1D::vS2T(double* x) const {
  if (x != nullptr) {
    *x = vS2T(*x);
  }
}

void dTrafo1D::pS2T(double* x) const {
  if (x != nullptr) {
    *x = pS2T(*x);
  }
}

void dTrafo1D::vT2S(double* x) const {
  if (x != nullptr) {
    *x = vT2S(*x);
  }
}

void dTrafo1D::pT2S(double* x) const {
  if (x != nullptr) {
    *x = pT2S(*x);
  }
}

}  // namespace vorl
