#ifndef VORL_COMMON_HRTIMER_H
#define VORL_COMMON_HRTIMER_H

/// @file
/// Time in seconds from the platform's high-resolution counter.

#include <vorl/Common/BaseClass.h>

#include <atomic>

inline namespace vorl {

/// A stop watch in seconds.
///
/// Times come from the high-resolution performance counter, or, on a machine without one, from the
/// process clock in milliseconds. Their origin is arbitrary: only differences mean something. One
/// thread may read a timer while another restarts it.
class VORL_API HRTimer : public BaseClass {
 public:
  /// Starts now.
  HRTimer();
  HRTimer(const HRTimer& source);
  HRTimer& operator=(const HRTimer& source);

  ClassInfo* GetClassInfo() override;
  ~HRTimer() override;

  static HRTimer* Create();
  static ClassInfo& CI();

  /// Asks for the performance counter and sets the process-wide frequency and resolution: the
  /// counter's own, or 1000 counts a second when there is none. Returns whether there is one. Runs
  /// once when the library is loaded.
  static bool IsHRSupported();

  /// The current time in seconds.
  double GetTime() const;
  /// Restarts the timer at the current time.
  void Reset();
  /// Seconds since the start; with `restart` the start moves to now.
  double GetDiffTime(bool restart);
  /// Counts per second of the clock in use.
  double GetFrequency() const;
  /// Seconds per count of the clock in use.
  double GetResolution() const;

 private:
  std::atomic<double> m_startTime;
};

}  // namespace vorl

#endif
