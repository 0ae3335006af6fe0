#include <vorl/GUI/Trafo1D.h>

inline namespace vorl {

Trafo1D::Trafo1D() = default;

Trafo1D::Trafo1D(double scale, double offset) : m_scale(scale), m_offset(offset) {}

Trafo1D::Trafo1D(const Trafo1D& source) = default;

Trafo1D& Trafo1D::operator=(const Trafo1D& source) = default;

Trafo1D::~Trafo1D() = default;

void Trafo1D::Set(double scale, double offset) {
  m_scale = scale;
  m_offset = offset;
}

double Trafo1D::GetScale() const {
  return m_scale;
}

double Trafo1D::GetOffset() const {
  return m_offset;
}

double Trafo1D::A2B(double x) const {
  return m_scale * x + m_offset;
}

double Trafo1D::B2A(double x) const {
  return (x - m_offset) / m_scale;
}

void Trafo1D::A2B(double* x) const {
  if (x != nullptr) {
    *x = A2B(*x);
  }
}

void Trafo1D::B2A(double* x) const {
  if (x != nullptr) {
    *x = B2A(*x);
  }
}

}  // namespace vorl
