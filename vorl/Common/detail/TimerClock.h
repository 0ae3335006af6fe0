#ifndef VORL_COMMON_DETAIL_TIMERCLOCK_H
#define VORL_COMMON_DETAIL_TIMERCLOCK_H

#include <vorl/Platform/detail/Clock.h>

inline namespace vorl {
namespace vorl_detail {

/// What a timer needs to know of a clock: which counter to read and what a count is worth.
struct TimerScale {
  bool supported = false;     ///< the high-resolution counter is there
  double frequency = 1000.0;  ///< counts per second
  double resolution = 0.001;  ///< seconds per count

  /// Asks `clock` for its counter.
  static TimerScale Of(const Clock& clock) {
    TimerScale scale;
    const std::int64_t frequency = clock.counterFrequency();
    scale.supported = frequency > 0;
    scale.frequency = scale.supported ? static_cast<double>(frequency) : 1000.0;
    scale.resolution = 1.0 / scale.frequency;
    return scale;
  }

  /// The time of `clock` in seconds.
  double Now(const Clock& clock) const {
    const std::int64_t count = supported ? clock.counter() : clock.milliseconds();
    return static_cast<double>(count) * resolution;
  }
};

/// The current time of the machine's clock in seconds, as `HRTimer` gives it.
double SecondsNow();

}  // namespace vorl_detail
}  // namespace vorl

#endif
