#include <vorl/Common/HRTimer.h>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Common/detail/TimerClock.h>

inline namespace vorl {

using vorl_detail::SystemClock;
using vorl_detail::TimerScale;

namespace {

// The counter's frequency is fixed while the system runs, so one query serves the process.
const TimerScale& ProcessScale() {
  static const TimerScale scale = TimerScale::Of(SystemClock());
  return scale;
}

[[maybe_unused]] const bool supportedAtLoad = HRTimer::IsHRSupported();

}  // namespace

double vorl_detail::SecondsNow() {
  return ProcessScale().Now(SystemClock());
}

VORL_REGISTER_CLASS(HRTimer, BaseClass);

HRTimer::HRTimer() : m_startTime(GetTime()) {}

HRTimer::HRTimer(const HRTimer& source)
    : BaseClass(source), m_startTime(source.m_startTime.load()) {}

HRTimer& HRTimer::operator=(const HRTimer& source) {
  m_startTime = source.m_startTime.load();
  return *this;
}

HRTimer::~HRTimer() = default;

bool HRTimer::IsHRSupported() {
  return ProcessScale().supported;
}

double HRTimer::GetTime() const {
  return vorl_detail::SecondsNow();
}

void HRTimer::Reset() {
  m_startTime = GetTime();
}

double HRTimer::GetDiffTime(bool restart) {
  const double start = m_startTime;
  const double difference = GetTime() - start;
  if (restart) {
    m_startTime = start + difference;
  }
  return difference;
}

double HRTimer::GetFrequency() const {
  return ProcessScale().frequency;
}

double HRTimer::GetResolution() const {
  return ProcessScale().resolution;
}

}  // namespace vorl
