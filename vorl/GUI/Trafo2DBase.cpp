#include <vorl/GUI/Trafo2D.h>

#include <vorl/GUI/detail/Truncated.h>
#include <vorl/Platform/Gdi.h>

inline namespace vorl {

using vorl_detail::Truncated;

Trafo2DBase::Trafo2DBase() = default;

Trafo2DBase::Trafo2DBase(const Trafo2DBase& source) = default;

Trafo2DBase& Trafo2DBase::operator=(const Trafo2DBase& source) = default;

Trafo2DBase::~Trafo2DBase() = default;

void Trafo2DBase::Map(Mapping mapping, const dVect2D& in, dVect2D& out) {
  double x = in.x;
  double y = in.y;
  (this->*mapping)(x, y, x, y);
  out.Set(x, y);
}

template <typename Integer>
void Trafo2DBase::Map(Mapping mapping, Integer x, Integer y, Integer& xOut, Integer& yOut) {
  double mappedX = static_cast<double>(x) + 0.5;
  double mappedY = static_cast<double>(y) + 0.5;
  (this->*mapping)(mappedX, mappedY, mappedX, mappedY);
  xOut = Truncated<Integer>(mappedX);
  yOut = Truncated<Integer>(mappedY);
}

void Trafo2DBase::Map(Mapping mapping, const tagPOINT& in, tagPOINT& out) {
  Map(mapping, in.x, in.y, out.x, out.y);
}

void Trafo2DBase::Map(Mapping mapping, const tagRECT& in, tagRECT& out) {
  Map(mapping, in.left, in.top, out.left, out.top);
  Map(mapping, in.right, in.bottom, out.right, out.bottom);
}

// The forms that the four families share: name, and the mapping that they all go through.
#define VORL_FORMS_OF(family)                                                  \
  void Trafo2DBase::family(double x, double y, double& xOut, double& yOut) {   \
    _##family(x, y, xOut, yOut);                                               \
  }                                                                            \
  void Trafo2DBase::family(double& x, double& y) {                             \
    _##family(x, y, x, y);                                                     \
  }                                                                            \
  void Trafo2DBase::family(long x, long y, long& xOut, long& yOut) {           \
    Map(&Trafo2DBase::_##family, x, y, xOut, yOut);                            \
  }                                                                            \
  void Trafo2DBase::family(long& x, long& y) {                                 \
    Map(&Trafo2DBase::_##family, x, y, x, y);                                  \
  }                                                                            \
  void Trafo2DBase::family(std::int32_t x, std::int32_t y, std::int32_t& xOut, \
                           std::int32_t& yOut) {                               \
    Map(&Trafo2DBase::_##family, x, y, xOut, yOut);                            \
  }                                                                            \
  void Trafo2DBase::family(std::int32_t& x, std::int32_t& y) {                 \
    Map(&Trafo2DBase::_##family, x, y, x, y);                                  \
  }                                                                            \
  void Trafo2DBase::family(const tagPOINT& in, tagPOINT& out) {                \
    Map(&Trafo2DBase::_##family, in, out);                                     \
  }                                                                            \
  void Trafo2DBase::family(tagPOINT& point) {                                  \
    Map(&Trafo2DBase::_##family, point, point);                                \
  }

// The forms for vectors of those families that have no virtual one.
#define VORL_VECTOR_FORMS_OF(family)                          \
  void Trafo2DBase::family(const dVect2D& in, dVect2D& out) { \
    Map(&Trafo2DBase::_##family, in, out);                    \
  }                                                           \
  void Trafo2DBase::family(dVect2D& vector) {                 \
    Map(&Trafo2DBase::_##family, vector, vector);             \
  }

VORL_FORMS_OF(pA2B)
VORL_FORMS_OF(pB2A)
VORL_FORMS_OF(vA2B)
VORL_FORMS_OF(vB2A)
VORL_VECTOR_FORMS_OF(pB2A)
VORL_VECTOR_FORMS_OF(vA2B)
VORL_VECTOR_FORMS_OF(vB2A)

#undef VORL_FORMS_OF
#undef VORL_VECTOR_FORMS_OF

void Trafo2DBase::pA2B(dVect2D& in, dVect2D& out) {
  Map(&Trafo2DBase::_pA2B, in, out);
}

void Trafo2DBase::pA2B(const dVect2D& in, dVect2D& out) {
  dVect2D point(in);  // for the virtual form, which an application may have changed
  pA2B(point, out);
}

void Trafo2DBase::pA2B(dVect2D& point) {
  pA2B(point, point);
}

void Trafo2DBase::rA2B(Rect2D& in, Rect2D& out) {
  dVect2D topLeft = in.GetTL();
  dVect2D bottomRight = in.GetBR();
  pA2B(topLeft);
  pA2B(bottomRight);
  out.Set(topLeft, bottomRight);
}

void Trafo2DBase::rB2A(Rect2D& in, Rect2D& out) {
  dVect2D topLeft = in.GetTL();
  dVect2D bottomRight = in.GetBR();
  pB2A(topLeft);
  pB2A(bottomRight);
  out.Set(topLeft, bottomRight);
}

void Trafo2DBase::rA2B(const Rect2D& in, Rect2D& out) {
  Rect2D rect(in);  // for the virtual form, which an application may have changed
  rA2B(rect, out);
}

void Trafo2DBase::rA2B(Rect2D& rect) {
  rA2B(rect, rect);
}

void Trafo2DBase::rA2B(const tagRECT& in, tagRECT& out) {
  Map(&Trafo2DBase::_pA2B, in, out);
}

void Trafo2DBase::rA2B(tagRECT& rect) {
  Map(&Trafo2DBase::_pA2B, rect, rect);
}

void Trafo2DBase::rB2A(const Rect2D& in, Rect2D& out) {
  Rect2D rect(in);  // for the virtual form, which an application may have changed
  rB2A(rect, out);
}

void Trafo2DBase::rB2A(Rect2D& rect) {
  rB2A(rect, rect);
}

void Trafo2DBase::rB2A(const tagRECT& in, tagRECT& out) {
  Map(&Trafo2DBase::_pB2A, in, out);
}

void Trafo2DBase::rB2A(tagRECT& rect) {
  Map(&Trafo2DBase::_pB2A, rect, rect);
}

}  // namespace vorl
