#ifndef VORL_COMMON_LOGCONTEXT_H
#define VORL_COMMON_LOGCONTEXT_H

/// @file
/// The scope object through which a method reports what happens in it.

#include <vorl/Common/dStatus.h>

#include <cstdint>
#include <list>
#include <string>

inline namespace vorl {

class LogThread;

/// States where the work is and reports records from there.
///
/// A method creates a context on its stack with its qualified name as title, its source file and
/// line. Each report overwrites the context's record (message, code, line, time) and hands the
/// context at once, in the calling thread, to the process's log session, which passes it to every
/// target whose level mask admits the kind. A context that logs its entry also stands on the log
/// stack and logs its exit when it is destroyed innermost first. Reporting never fails: a text that
/// finds no memory is dropped. Formatted messages follow the printf conventions and are cut at
/// 1,023 characters.
class VORL_API LogContext {
 public:
  /// No title, no file, line 0, no entry record.
  LogContext();
  /// `title` is copied; `filePath` is kept by pointer and must outlive the context. Null pointers
  /// are taken as empty texts. `logEntry` asks for the entry and exit records and for a place on
  /// the log stack.
  LogContext(const char* title, const char* filePath, int line, bool logEntry);
  /// Copies every field; a copy does not stand on the log stack.
  LogContext(const LogContext& source);
  LogContext& operator=(const LogContext& source);
  virtual ~LogContext();

  /// Reports an information: code 0, line 0. A null format keeps message and line.
  void Info(const char* format, ...) VORL_PRINTF_FORMAT(2, 3);
  /// Reports an error found at `line`: code -1. A null format keeps the message.
  void Error(int line, const char* format, ...) VORL_PRINTF_FORMAT(3, 4);
  /// Reports a warning found at `line`: code 1. A null format keeps the message.
  void Warning(int line, const char* format, ...) VORL_PRINTF_FORMAT(3, 4);
  /// Reports a status with its message and code: an error, a warning or an information by the sign
  /// of the code.
  void Status(int line, const dStatus& status);
  /// Reports the current local time, formatted by the strftime conventions into at most 255
  /// characters, as an information. A null format reports nothing; a longer result is empty.
  void LogDateTime(const char* format);
  /// Reports the current local date as "%d-%b-%Y".
  void LogDate();
  /// Reports the current local time as "%H:%M:%S".
  void LogTime();
  /// Does nothing: tracing is compiled out.
  void Trace(const char* format, ...) VORL_PRINTF_FORMAT(2, 3);

  /// The qualified name of the method.
  const char* GetTitle() const;
  const char* GetFilePath() const;
  /// The part of the file path behind its last slash or backslash.
  const char* GetFileName() const;
  /// The line of the current record; 0 for an information.
  unsigned int GetLineNo() const;
  /// The line given at construction.
  unsigned int GetInitLineNo() const;
  void SetLineNo(unsigned int line);
  /// The text of the current record.
  const char* GetMsg() const;
  /// The code of the current record: 0 information, 1 warning, -1 error, or a status's own.
  long GetCode() const;
  /// When the current record was made, in seconds (see `HRTimer`).
  double GetLogTime() const;
  /// The identifier of the log thread record, which is that of the process.
  unsigned long GetThreadID() const;
  /// The open contexts, innermost first. All threads of a process share one stack: it may only be
  /// walked while no other thread logs.
  std::list<LogContext*>& GetLogStack() const;
  /// The number of open contexts.
  unsigned long GetLogDepth() const;

 private:
  enum class Kind { Error, Warning, Info };

  void Init(const char* title, const char* filePath, int line, bool logEntry);
  void Report(Kind kind, std::int32_t code);

  std::string m_message;
  std::int32_t m_code = 0;
  std::string m_title;
  const char* m_filePath = "";
  std::uint32_t m_line = 0;
  std::uint32_t m_initLine = 0;
  double m_logTime = 0.0;
  LogThread* m_logThread = nullptr;
};

}  // namespace vorl

#endif
