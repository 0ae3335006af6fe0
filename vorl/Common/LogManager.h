#ifndef VORL_COMMON_LOGMANAGER_H
#define VORL_COMMON_LOGMANAGER_H

/// @file
/// Where log records go: named sessions of targets, and the process-wide manager that keeps them.

#include <vorl/Common/ILogging.h>

#include <atomic>
#include <cstdint>
#include <list>
#include <memory>
#include <mutex>
#include <string>

inline namespace vorl {

class LogContext;
class LogManager;

namespace vorl_detail {
class OperatorThread;
}

/// A named list of log targets.
///
/// Records are dispatched in the reporting thread, to the targets in the order in which they were
/// added. The session does not own its targets: an application removes a target before destroying
/// it. A target may remove targets during its call: a removed one gets no more records. Adding and
/// removing targets is not guarded against reports from other threads.
class VORL_API LogSession {
 public:
  /// Takes the next session identifier of the process.
  LogSession();
  LogSession(const LogSession& source);
  LogSession& operator=(const LogSession& source);
  virtual ~LogSession();

  /// Appends a target; null is ignored. A target added twice receives each record twice.
  void AddLogTarget(ILogging* target);
  /// Removes every entry of the target; null is ignored.
  void RemoveLogTarget(ILogging* target);
  void RemoveAllLogTargets();
  /// The session's identifier; the "DEFAULT" session has 0.
  unsigned long GetID() const;

 protected:
  /// Each passes the context to the targets whose mask has the kind's bit.
  void LogInfo(LogContext* context);
  void LogError(LogContext* context);
  void LogWarning(LogContext* context);
  void LogEntry(LogContext* context);
  void LogExit(LogContext* context);

 private:
  friend class LogContext;
  friend class LogManager;

  explicit LogSession(const char* name);
  void Dispatch(LogLevel level, void (ILogging::*call)(LogContext*), LogContext* context);

  std::string m_name;
  std::uint32_t m_levelMask = 31;
  std::uint32_t m_id;
  std::list<ILogging*> m_targets;
};

/// The log record of a process: the stack of its open contexts and the session they report to.
///
/// Not a worker thread. All threads of a process share one record, so their contexts stand on one
/// stack.
class VORL_API LogThread {
 public:
  /// The record of the current process, reporting to the "DEFAULT" session.
  LogThread();
  LogThread(const LogThread& source);
  LogThread& operator=(const LogThread& source);
  virtual ~LogThread();

  /// The identifier of the process that was current at construction.
  unsigned long GetThreadId() const;
  /// When the record was made, in seconds (see `HRTimer`).
  double GetBaseTime() const;
  LogSession* GetLogSession() const;
  /// The number of open contexts.
  unsigned long GetLogDepth() const;

 private:
  friend class LogContext;
  friend class LogManager;
  friend class vorl_detail::OperatorThread;

  explicit LogThread(LogSession* session);
  void Push(LogContext* context);
  /// Takes the context off the stack; true when it was the innermost one.
  bool Remove(LogContext* context);
  /// Takes the contexts off the stack whose objects lie in [low, high).
  void DropWithin(const void* low, const void* high);

  std::uint32_t m_id;
  double m_baseTime;
  std::list<LogContext*> m_stack;
  LogSession* m_session;
  mutable std::mutex m_stackMutex;  // operators log from their own threads
};

/// Keeps the log sessions and the log records of the process.
class VORL_API LogManager {
 public:
  /// Registers "DEFAULT" and makes the log record of the current process.
  LogManager();
  /// A copy shares the sessions and records of its source.
  LogManager(const LogManager& source);
  LogManager& operator=(const LogManager& source);
  /// Destroys the records and sessions that no copy shares; targets stay with their owners.
  virtual ~LogManager();

  /// The session of this name, created when there is none. Null stands for "DEFAULT". Null when
  /// memory is exhausted.
  LogSession* RegisterSession(const char* name);
  /// The session of exactly this name; null when there is none. Null stands for "DEFAULT".
  LogSession* GetSession(const char* name) const;
  /// The session with this identifier (a negative one is taken as 0); null when there is none.
  LogSession* GetSession(int id) const;
  /// Adds the target to the session of this name, which is created when there is none.
  void AddLogTarget(ILogging* target, const char* sessionName);
  /// Removes the target from every session; null is ignored.
  void RemoveLogTarget(ILogging* target);
  /// The log record of the current process, made on first use.
  LogThread* GetLogThread();
  /// The identifier of the thread that constructed the manager.
  long GetPID() const;

 private:
  double m_startTime;
  std::int32_t m_creator;
  std::list<std::shared_ptr<LogSession>> m_sessions;
  std::list<std::shared_ptr<LogThread>> m_logThreads;
  std::atomic<LogThread*> m_currentLogThread{nullptr};
  std::mutex m_logThreadsMutex;
};

/// The one manager of the process. It exists from the loading of the library on and outlives every
/// static object, so destructors that run at exit may log.
VORL_API LogManager& GetLogManager();

}  // namespace vorl

#endif
