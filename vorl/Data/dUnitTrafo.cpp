#include <new>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dTrafo.h>

inline namespace vorl {

namespace {

// A text that finds no memory is dropped: the numbers are what matters.
void CopyText(std::string& target, const char* text) noexcept {
  try {
    target.assign(text != nullptr ? text : "");
  } catch (const std::bad_alloc&) {
    target.clear();
  }
}

}  // namespace

VORL_REGISTER_CLASS(dUnitTrafo, dTrafo1D);

dUnitTrafo::dUnitTrafo() = default;

dUnitTrafo::dUnitTrafo(const dUnitTrafo& source) : dTrafo1D(source) {
  CopyText(m_shortUnitText, source.GetShortUnitText());
  CopyText(m_longUnitText, source.GetLongUnitText());
}

dUnitTrafo::dUnitTrafo(const dCoordSys1D& s, const dCoordSys1D& t) : dTrafo1D(s, t) {}

dUnitTrafo::dUnitTrafo(const dCoordSys1D& s, const dCoordSys1D& t, double ps, double pt)
    : dTrafo1D(s, t, ps, pt) {}

dUnitTrafo::dUnitTrafo(double a, double b, double ps, double pt) : dTrafo1D(a, b, ps, pt) {}

dUnitTrafo& dUnitTrafo::operator=(const dUnitTrafo& source) {
  if (this != &source) {
    dTrafo1D::operator=(source);
    CopyText(m_shortUnitText, source.GetShortUnitText());
    CopyText(m_longUnitText, source.GetLongUnitText());
  }
  return *this;
}

dUnitTrafo::~dUnitTrafo() = default;

void dUnitTrafo::Reset() {
  dTrafo1D::Reset();
  m_shortUnitText.clear();
  m_longUnitText.clear();
}

void dUnitTrafo::SetShortUnitText(const char* text) {
  CopyText(m_shortUnitText, text);
}

void dUnitTrafo::SetLongUnitText(const char* text) {
  CopyText(m_longUnitText, text);
}

const char* dUnitTrafo::GetShortUnitText() const {
  return m_shortUnitText.c_str();
}

const char* dUnitTrafo::GetLongUnitText() const {
  return m_longUnitText.c_str();
}

}  // namespace vorl
