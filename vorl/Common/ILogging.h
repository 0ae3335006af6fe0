#ifndef VORL_COMMON_ILOGGING_H
#define VORL_COMMON_ILOGGING_H

/// @file
/// The interface through which an application receives log records.

#include <vorl/export.h>

inline namespace vorl {

class LogContext;

/// Bits of a level mask: which kinds of records a target wants.
enum LogLevel : unsigned short {
  LogLevel_Error = 1,
  LogLevel_Warning = 2,
  LogLevel_Info = 4,
  LogLevel_Entry = 8,
  LogLevel_Exit = 16
};

/// Receives log records once it is added to a session (see `LogManager::AddLogTarget`).
///
/// The calls arrive in the thread that reports. The context passed in holds the record (message,
/// code, line, time); it is valid, and unchanged, only during the call.
class VORL_API ILogging {
 public:
  /// A mask of 7: errors, warnings and infos, no entries and exits.
  ILogging();
  ILogging(const ILogging& source);
  ILogging& operator=(const ILogging& source);

  virtual ~ILogging();
  virtual void OnEntry(LogContext* context);
  virtual void OnExit(LogContext* context);
  virtual void OnError(LogContext* context);
  virtual void OnWarning(LogContext* context);
  virtual void OnInfo(LogContext* context);

  /// Chooses the kinds of records that arrive: a sum of `LogLevel` bits.
  void SetLevelMask(unsigned short mask);
  unsigned short GetLevelMask() const;

 private:
  unsigned short m_levelMask;
};

/// The target that does nothing; applications derive from it and override what they want.
class VORL_API LogTarget : public ILogging {
 public:
  LogTarget();
  LogTarget(const LogTarget& source);
  LogTarget& operator=(const LogTarget& source);

  ~LogTarget() override;
  void OnEntry(LogContext* context) override;
  void OnExit(LogContext* context) override;
  void OnError(LogContext* context) override;
  void OnWarning(LogContext* context) override;
  void OnInfo(LogContext* context) override;

 protected:
  /// Does nothing: the place for an application's own print-out of the open contexts.
  void PrintLogStack(LogContext* context);
};

}  // namespace vorl

#endif
