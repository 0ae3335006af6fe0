#ifndef VORL_COMMON_OPBASE_H
#define VORL_COMMON_OPBASE_H

/// @file
/// How every operator runs: start, prepare, process, exit; in the caller's thread or its own.

#include <vorl/Common/HRTimer.h>
#include <vorl/Common/dStatus.h>

#include <atomic>
#include <memory>

inline namespace vorl {

namespace vorl_detail {
class OperatorThread;
}

/// The base of all operators.
///
/// The application sets an operator's inputs and outputs, which stay its own, and calls `Run` or
/// `RunAsThread`. A derived operator overrides `Prepare` (checks the inputs), `Process` (does the
/// work, polls `m_stopRequested`, raises `m_progress`) and `Reset`.
///
/// While the operator's own thread runs, the owner may ask `IsRunning`, `GetProgress` and
/// `GetProcessingTime`, and call `Stop` or `Terminate`; it must not touch the inputs, read the
/// status or start another run. A derived class whose thread may still run when it is destroyed
/// calls `Terminate` first thing in its destructor: the base's own call comes after the derived
/// part is gone. An exception that leaves a run ends the process when the run has its own thread.
class VORL_API OpBase : public BaseClass {
 public:
  OpBase();
  /// Copies every field. A copy shares the thread of its source: its `Terminate`, which its
  /// destructor calls too, ends that thread. An assignment first ends a thread that this operator
  /// started.
  OpBase(const OpBase& source);
  OpBase& operator=(const OpBase& source);

  ClassInfo* GetClassInfo() override;
  /// Ends the operator's own thread (see `Terminate`).
  ~OpBase() override;
  /// Drops inputs and results; returns true.
  virtual bool Reset();
  /// `Start`, `Prepare`, `Process` only if that succeeded, and `Exit`, whose result is returned.
  /// When the two find no memory the run fails with "out of memory".
  virtual bool Run();
  /// Asks the operator's own thread to end early, within one output row of a picture. Without a
  /// running thread it only clears the request.
  virtual void Stop();
  /// Ends the operator's own thread, if there is one, and returns when it is gone: the thread is
  /// asked to stop, and after 100 ms ended by force. Whatever it held then stays locked or
  /// allocated. Called twice, or from a copy, it is harmless.
  virtual void Terminate();
  /// The part of the work that is done, 0 to 1.
  virtual double GetProgress();

 protected:
  /// Checks the parameters and sets up; false, with a status, refuses the run.
  virtual bool Prepare() = 0;
  /// Does the work; false, with a status, on failure.
  virtual bool Process() = 0;
  /// Begins a run: running, no stop request, status cleared, progress and time 0.
  virtual void Start();
  /// Ends a run: stores the processing time, sets the status to "success" when `ok`; returns `ok`.
  virtual bool Exit(bool ok);

 public:
  static ClassInfo& CI();

  /// `Run`.
  bool operator()();
  /// Starts `Run` in a thread of the operator's own. Returns true when the thread was started or is
  /// still running, false when the system has none to give. The argument is not used.
  bool RunAsThread(int priority);
  /// True from the beginning of a run to its end.
  bool IsRunning() const;
  /// Seconds since the start of the current run, or the duration of the last one.
  double GetProcessingTime() const;
  /// The outcome of the last run.
  const dStatus& GetStatus() const;

 protected:
  /// Ends a loop that found `m_stopRequested` set: sets the status "stopped"; returns false.
  bool Stopped();
  /// True from `RunAsThread` until that run has succeeded or was terminated: only then does `Stop`
  /// ask for anything.
  bool HasThread() const;

  dStatus m_status;
  std::atomic<bool> m_stopRequested{false};
  std::atomic<double> m_progress{0.0};

 private:
  friend class vorl_detail::OperatorThread;

  void CopyRun(const OpBase& source);
  void ResetProgress();

  mutable HRTimer m_timer;
  std::shared_ptr<vorl_detail::OperatorThread> m_thread;
  std::atomic<bool> m_running{false};
  std::atomic<bool> m_launching{false};  ///< between `RunAsThread` and the thread's `Start`
  std::atomic<double> m_processingTime{0.0};
};

}  // namespace vorl

#endif
