#include <vorl/GUI/Trafo2D.h>

#include <algorithm>
#include <new>

inline namespace vorl {

MultiTrafo2D::MultiTrafo2D() = default;

MultiTrafo2D::MultiTrafo2D(const MultiTrafo2D& source) : Trafo2DBase(source) {
  try {
    m_members = source.m_members;
  } catch (const std::bad_alloc&) {
    m_members.clear();
  }
}

MultiTrafo2D& MultiTrafo2D::operator=(const MultiTrafo2D& source) {
  if (this != &source) {
    MultiTrafo2D copy(source);
    std::erase_if(copy.m_members, [this](Trafo2DBase* member) { return IsPartOf(member); });
    m_members.swap(copy.m_members);
  }
  return *this;
}

MultiTrafo2D::~MultiTrafo2D() = default;

bool MultiTrafo2D::AddTransformation(Trafo2DBase* trafo) {
  if (trafo == nullptr || IsPartOf(trafo)) {
    return false;
  }
  try {
    m_members.push_back(trafo);
  } catch (const std::bad_alloc&) {
    return false;
  }
  return true;
}

void MultiTrafo2D::Reset() {
  m_members.clear();
}

void MultiTrafo2D::_pA2B(double x, double y, double& xOut, double& yOut) {
  for (Trafo2DBase* member : m_members) {
    member->pA2B(x, y);
  }
  xOut = x;
  yOut = y;
}

void MultiTrafo2D::_pB2A(double x, double y, double& xOut, double& yOut) {
  for (auto member = m_members.rbegin(); member != m_members.rend(); ++member) {
    (*member)->pB2A(x, y);
  }
  xOut = x;
  yOut = y;
}

void MultiTrafo2D::_vA2B(double x, double y, double& xOut, double& yOut) {
  for (Trafo2DBase* member : m_members) {
    member->vA2B(x, y);
  }
  xOut = x;
  yOut = y;
}

void MultiTrafo2D::_vB2A(double x, double y, double& xOut, double& yOut) {
  for (auto member = m_members.rbegin(); member != m_members.rend(); ++member) {
    (*member)->vB2A(x, y);
  }
  xOut = x;
  yOut = y;
}

bool MultiTrafo2D::IsPartOf(Trafo2DBase* trafo) const {
  if (trafo == this) {
    return true;
  }
  const auto* const chain = dynamic_cast<const MultiTrafo2D*>(trafo);
  return chain != nullptr && std::any_of(chain->m_members.begin(), chain->m_members.end(),
                                         [this](Trafo2DBase* member) { return IsPartOf(member); });
}

}  // namespace vorl
