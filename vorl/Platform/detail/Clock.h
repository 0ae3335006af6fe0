#ifndef VORL_PLATFORM_DETAIL_CLOCK_H
#define VORL_PLATFORM_DETAIL_CLOCK_H

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// A source of time: a high-resolution counter, or the process clock in milliseconds.
struct Clock {
  /// Counts per second; not positive when the counter is not available.
  std::int64_t (*counterFrequency)();
  /// The counter's current value.
  std::int64_t (*counter)();
  /// The process clock in milliseconds, for machines without the counter.
  std::int64_t (*milliseconds)();
};

/// The machine's clock.
const Clock& SystemClock();

}  // namespace vorl_detail
}  // namespace vorl

#endif
