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

void Trafo2DBase::pA2B(double x, double y, double& xOut, double& yOut) {
  _pA2B(x, y, xOut, yOut);
}

void Trafo2DBase::pA2B(double& x, double& y) {
  _pA2B(x, y, x, y);
}

void Trafo2DBase::pA2B(long x, long y, long& xOut, long& yOut) {
  Map(&Trafo2DBase::_pA2B, x, y, xOut, yOut);
}

void Trafo2DBase::pA2B(long& x, long& y) {
  Map(&Trafo2DBase::_pA2B, x, y, x, y);
}

void Trafo2DBase::pA2B(std::int32_t x, std::int32_t y, std::int32_t& xOut, std::int32_t& yOut) {
  Map(&Trafo2DBase::_pA2B, x, y, xOut, yOut);
}

void Trafo2DBase::pA2B(std::int32_t& x, std::int32_t& y) {
  Map(&Trafo2DBase::_pA2B, x, y, x, y);
}

void Trafo2DBase::pA2B(const tagPOINT& in, tagPOINT& out) {
  Map(&Trafo2DBase::_pA2B, in, out);
}

void Trafo2DBase::pA2B(tagPOINT& point) {
  Map(&Trafo2DBase::_pA2B, point, point);
}

void Trafo2DBase::pB2A(const dVect2D& in, dVect2D& out) {
  Map(&Trafo2DBase::_pB2A, in, out);
}

void Trafo2DBase::pB2A(dVect2D& point) {
  Map(&Trafo2DBase::_pB2A, point, point);
}

void Trafo2DBase::pB2A(double x, double y, double& xOut, double& yOut) {
  _pB2A(x, y, xOut, yOut);
}

void Trafo2DBase::pB2A(double& x, double& y) {
  _pB2A(x, y, x, y);
}

void Trafo2DBase::pB2A(long x, long y, long& xOut, long& yOut) {
  Map(&Trafo2DBase::_pB2A, x, y, xOut, yOut);
}

void Trafo2DBase::pB2A(long& x, long& y) {
  Map(&Trafo2DBase::_pB2A, x, y, x, y);
}

void Trafo2DBase::pB2A(std::int32_t x, std::int32_t y, std::int32_t& xOut, std::int32_t& yOut) {
  Map(&Trafo2DBase::_pB2A, x, y, xOut, yOut);
}

void Trafo2DBase::pB2A(std::int32_t& x, std::int32_t& y) {
  Map(&Trafo2DBase::_pB2A, x, y, x, y);
}

void Trafo2DBase::pB2A(const tagPOINT& in, tagPOINT& out) {
  Map(&Trafo2DBase::_pB2A, in, out);
}

void Trafo2DBase::pB2A(tagPOINT& point) {
  Map(&Trafo2DBase::_pB2A, point, point);
}

void Trafo2DBase::vA2B(const dVect2D& in, dVect2D& out) {
  Map(&Trafo2DBase::_vA2B, in, out);
}

void Trafo2DBase::vA2B(dVect2D& vector) {
  Map(&Trafo2DBase::_vA2B, vector, vector);
}

void Trafo2DBase::vA2B(double x, double y, double& xOut, double& yOut) {
  _vA2B(x, y, xOut, yOut);
}

void Trafo2DBase::vA2B(double& x, double& y) {
  _vA2B(x, y, x, y);
}

void Trafo2DBase::vA2B(long x, long y, long& xOut, long& yOut) {
  Map(&Trafo2DBase::_vA2B, x, y, xOut, yOut);
}

void Trafo2DBase::vA2B(long& x, long& y) {
  Map(&Trafo2DBase::_vA2B, x, y, x, y);
}

void Trafo2DBase::vA2B(std::int32_t x, std::int32_t y, std::int32_t& xOut, std::int32_t& yOut) {
  Map(&Trafo2DBase::_vA2B, x, y, xOut, yOut);
}

void Trafo2DBase::vA2B(std::int32_t& x, std::int32_t& y) {
  Map(&Trafo2DBase::_vA2B, x, y, x, y);
}

void Trafo2DBase::vA2B(const tagPOINT& in, tagPOINT& out) {
  Map(&Trafo2DBase::_vA2B, in, out);
}

void Trafo2DBase::vA2B(tagPOINT& vector) {
  Map(&Trafo2DBase::_vA2B, vector, vector);
}

void Trafo2DBase::vB2A(const dVect2D& in, dVect2D& out) {
  Map(&Trafo2DBase::_vB2A, in, out);
}

void Trafo2DBase::vB2A(dVect2D& vector) {
  Map(&Trafo2DBase::_vB2A, vector, vector);
}

void Trafo2DBase::vB2A(double x, double y, double& xOut, double& yOut) {
  _vB2A(x, y, xOut, yOut);
}

void Trafo2DBase::vB2A(double& x, double& y) {
  _vB2A(x, y, x, y);
}

void Trafo2DBase::vB2A(long x, long y, long& xOut, long& yOut) {
  Map(&Trafo2DBase::_vB2A, x, y, xOut, yOut);
}

void Trafo2DBase::vB2A(long& x, long& y) {
  Map(&Trafo2DBase::_vB2A, x, y, x, y);
}

void Trafo2DBase::vB2A(std::int32_t x, std::int32_t y, std::int32_t& xOut, std::int32_t& yOut) {
  Map(&Trafo2DBase::_vB2A, x, y, xOut, yOut);
}

void Trafo2DBase::vB2A(std::int32_t& x, std::int32_t& y) {
  Map(&Trafo2DBase::_vB2A, x, y, x, y);
}

void Trafo2DBase::vB2A(const tagPOINT& in, tagPOINT& out) {
  Map(&Trafo2DBase::_vB2A, in, out);
}

void Trafo2DBase::vB2A(tagPOINT& vector) {
  Map(&Trafo2DBase::_vB2A, vector, vector);
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
