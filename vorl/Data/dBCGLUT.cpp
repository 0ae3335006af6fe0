#include <vorl/Data/dBCGLUT.h>

#include <algorithm>
#include <cmath>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>

inline namespace vorl {

namespace {

constexpr int kEntries = 256;
constexpr double kPi = 3.141592;        // short on purpose: it decides the entries
constexpr double kSmallestCos = 0.001;  // keeps the slope finite at 90 degrees

}  // namespace

VORL_REGISTER_CLASS(dBCGLUT, dLUT);

dBCGLUT::dBCGLUT() {
  dLUT::Init(kEntries, LUTType_U8, 1, 0);
}

dBCGLUT::dBCGLUT(const dBCGLUT& source)
    : dLUT(source),
      m_brightness(source.m_brightness),
      m_contrast(source.m_contrast),
      m_gamma(source.m_gamma) {}

dBCGLUT& dBCGLUT::operator=(const dBCGLUT& source) {
  dLUT::operator=(source);
  m_brightness = source.m_brightness;
  m_contrast = source.m_contrast;
  m_gamma = source.m_gamma;
  return *this;
}

dBCGLUT::~dBCGLUT() = default;

void dBCGLUT::Reset() {
  SetBCG(0.0, 0.0, 1.0);
}

bool dBCGLUT::Init(long, LUTType, int, long) {
  m_status.Set(false,
               "Don't call 'Init' for a 'dBCGLUT' object. It has been initialized during "
               "construction");
  return false;
}

void dBCGLUT::SetValue(double& field, double value, double low, double high) {
  if (std::isnan(value)) {
    return;
  }
  const double clamped = std::clamp(value, low, high);
  if (clamped != field) {
    field = clamped;
    m_recalculate = true;
  }
}

void dBCGLUT::SetBrightness(double brightness) {
  SetValue(m_brightness, brightness, -1.0, 1.0);
}
void dBCGLUT::SetContrast(double contrast) {
  SetValue(m_contrast, contrast, -1.0, 1.0);
}
void dBCGLUT::SetGamma(double gamma) {
  SetValue(m_gamma, gamma, 0.01, 10.0);
}

void dBCGLUT::SetBCG(double brightness, double contrast, double gamma) {
  SetBrightness(brightness);
  SetContrast(contrast);
  SetGamma(gamma);
}

void dBCGLUT::SetBCGRelative(double brightness, double contrast, double gamma) {
  SetBCG(m_brightness + brightness, m_contrast + contrast, m_gamma + gamma);
}

double dBCGLUT::GetBrightness() const {
  return m_brightness;
}
double dBCGLUT::GetContrast() const {
  return m_contrast;
}
double dBCGLUT::GetGamma() const {
  return m_gamma;
}

bool dBCGLUT::CalculateLUT() {
  if (m_table.GetImageSize() < kEntries) {
    LogContext context("dBCGLUT::CalculateLUT", __FILE__, __LINE__, true);
    m_status.Set(false, "BCG LUT is not initialized");
    context.Status(__LINE__, m_status);
    return false;
  }
  auto* entries = static_cast<unsigned char*>(m_table.GetDataPtr());
  const double angle = (m_contrast + 1.0) * 45.0 / 180.0 * kPi;
  const double slope = std::sin(angle) / std::max(std::cos(angle), kSmallestCos);
  double value = 256.0 - (slope + 1.0) * (1.0 - m_brightness) * 128.0;
  double lowest = 255.0;
  double highest = 0.0;
  int lowestIndex = 0;
  int highestIndex = 0;
  for (int i = 0; i < kEntries; ++i) {
    if (value < 0.0) {
      entries[i] = 0;
    } else if (value >= 256.0) {
      entries[i] = 255;
    } else {
      if (value < lowest) {
        lowest = value;
        lowestIndex = i;
      }
      if (value > highest) {
        highest = value;
        highestIndex = i;
      }
      entries[i] = static_cast<unsigned char>(value);
    }
    value += slope;
  }
  if (m_gamma != 1.0) {
    ApplyGamma(entries, lowestIndex, highestIndex, lowest, highest);
  }
  m_recalculate = false;
  return true;
}

// The entry at `last` stays as it is.
void dBCGLUT::ApplyGamma(unsigned char* entries, int first, int last, double low,
                         double high) const {
  const double range = high - low;
  for (int i = first; i < last; ++i) {
    // A truncated entry may lie below the lowest value.
    const double base = std::max((entries[i] - low) / range, 0.0);
    entries[i] = static_cast<unsigned char>(std::pow(base, 1.0 / m_gamma) * range + low);
  }
}

}  // namespace vorl
