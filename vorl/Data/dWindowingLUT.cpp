#include <vorl/Data/dWindowingLUT.h>

#include <algorithm>

#include <vorl/Common/detail/ClassRegistration.h>

inline namespace vorl {

namespace {

constexpr int kEntries = 65536;
constexpr unsigned long kSecondStageEntries = 256;

}  // namespace

VORL_REGISTER_CLASS(dWindowingLUT, dLUT);

dWindowingLUT::dWindowingLUT() {
  dLUT::Init(kEntries, LUTType_U8, 1, 0);
}

dWindowingLUT::dWindowingLUT(const dWindowingLUT& source) : dLUT(source) {
  *this = source;
}

dWindowingLUT& dWindowingLUT::operator=(const dWindowingLUT& source) {
  dLUT::operator=(source);
  m_center = source.m_center;
  m_width = source.m_width;
  m_signedSource = source.m_signedSource;
  m_targetLow = source.m_targetLow;
  m_targetHigh = source.m_targetHigh;
  m_lowerLimit = source.m_lowerLimit;
  m_upperLimit = source.m_upperLimit;
  m_pBCGLUT = source.m_pBCGLUT;
  return *this;
}

dWindowingLUT::~dWindowingLUT() = default;

void dWindowingLUT::Reset() {
  m_center = 32768;
  m_width = 65536;
  m_signedSource = false;
  m_targetLow = 0;
  m_targetHigh = 255;
  m_lowerLimit = 0;
  m_upperLimit = 255;
  m_pBCGLUT = nullptr;
  m_table.Fill(0);
  m_recalculate = false;
}

bool dWindowingLUT::Init(long, LUTType, int, long) {
  m_status.Set(false,
               "Don't call 'Init' for a 'dWindowingLUT' object. It has been initialized during "
               "construction");
  return false;
}

template <class T>
void dWindowingLUT::SetValue(T& field, T value) {
  if (field != value) {
    field = value;
    m_recalculate = true;
  }
}

void dWindowingLUT::SetWinCenter(int center) {
  SetValue(m_center, center);
}
void dWindowingLUT::SetWinWidth(int width) {
  SetValue(m_width, width);
}

void dWindowingLUT::SetWindow(int center, int width) {
  SetWinCenter(center);
  SetWinWidth(width);
}

void dWindowingLUT::SetTargetRange(unsigned char low, unsigned char high) {
  SetValue(m_targetLow, low);
  SetValue(m_targetHigh, high);
}

void dWindowingLUT::SetLimits(unsigned char lower, unsigned char upper) {
  SetValue(m_lowerLimit, lower);
  SetValue(m_upperLimit, upper);
}

void dWindowingLUT::SetSignedSource(bool isSigned) {
  SetValue(m_signedSource, isSigned);
}

void dWindowingLUT::SetBCGLUT(dBCGLUT* lut) {
  m_pBCGLUT = lut;
  m_recalculate = true;
}

int dWindowingLUT::GetWinCenter() const {
  return m_center;
}
int dWindowingLUT::GetWinWidth() const {
  return m_width;
}

void dWindowingLUT::GetTargetRange(unsigned char& low, unsigned char& high) const {
  low = m_targetLow;
  high = m_targetHigh;
}

void dWindowingLUT::GetLimits(unsigned char& lower, unsigned char& upper) const {
  lower = m_lowerLimit;
  upper = m_upperLimit;
}

// Null when there is none, or when its table was taken away.
const unsigned char* dWindowingLUT::FetchSecondStage() const {
  if (m_pBCGLUT == nullptr) {
    return nullptr;
  }
  const unsigned char* entries = m_pBCGLUT->GetLUT(0);
  const dImage& table = *m_pBCGLUT;
  return table.GetImageSize() < kSecondStageEntries ? nullptr : entries;
}

bool dWindowingLUT::CalculateLUT() {
  if (m_table.GetImageSize() < kEntries) {
    return false;  // taken away from outside
  }
  auto* entries = static_cast<unsigned char*>(m_table.GetDataPtr());
  const int base = m_signedSource ? -32768 : 0;
  m_center = m_signedSource ? std::clamp(m_center, -32768, 32767) : std::clamp(m_center, 0, 65536);
  m_width = std::clamp(m_width, 2, 65536);
  const int lowerEdge = m_center - m_width / 2;
  const int upperEdge = lowerEdge + m_width;
  const unsigned char* secondStage = FetchSecondStage();

  const double step = static_cast<double>(m_targetHigh - m_targetLow) / m_width;
  double value = m_targetLow + 0.5;
  if (lowerEdge < base) {
    value += (base - lowerEdge) * step;
  }
  const auto indexOf = [&](int sample) { return std::clamp(sample - base, 0, kEntries); };
  const int inside = indexOf(lowerEdge);
  const int above = indexOf(upperEdge);
  std::fill(entries, entries + inside, m_lowerLimit);
  for (int i = inside; i < above; ++i) {
    const auto level = static_cast<unsigned char>(static_cast<int>(value));
    entries[i] = secondStage != nullptr ? secondStage[level] : level;
    value += step;  // repeated addition: its rounding decides the entries
  }
  std::fill(entries + above, entries + kEntries, m_upperLimit);
  m_startIndex = base;
  return true;
}

}  // namespace vorl
