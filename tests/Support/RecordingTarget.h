#ifndef VORL_TESTS_SUPPORT_RECORDINGTARGET_H
#define VORL_TESTS_SUPPORT_RECORDINGTARGET_H

#include <vorl/Common/ILogging.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>

#include <string>
#include <utility>
#include <vector>

/// Keeps what it receives. While one lives it listens to the session of the given name.
class RecordingTarget : public LogTarget {
 public:
  struct Record {
    std::string kind;  // "entry", "exit", "error", "warning" or "info"
    std::string title;
    std::string message;
    long code;
    unsigned int line;
    double time;
    unsigned long depth;
  };

  explicit RecordingTarget(unsigned short mask = 31, const char* session = nullptr) {
    SetLevelMask(mask);
    GetLogManager().AddLogTarget(this, session);
  }
  RecordingTarget(const RecordingTarget&) = delete;
  RecordingTarget& operator=(const RecordingTarget&) = delete;
  ~RecordingTarget() override { GetLogManager().RemoveLogTarget(this); }

  void OnEntry(LogContext* context) override { Keep("entry", context); }
  void OnExit(LogContext* context) override { Keep("exit", context); }
  void OnError(LogContext* context) override { Keep("error", context); }
  void OnWarning(LogContext* context) override { Keep("warning", context); }
  void OnInfo(LogContext* context) override { Keep("info", context); }

  /// "kind title" of each record, in the order of arrival.
  std::vector<std::string> Trail() const {
    std::vector<std::string> trail;
    for (const Record& record : records) {
      trail.push_back(record.kind + " " + record.title);
    }
    return trail;
  }

  std::vector<Record> records;

 private:
  void Keep(std::string kind, const LogContext* context) {
    records.push_back({std::move(kind), context->GetTitle(), context->GetMsg(), context->GetCode(),
                       context->GetLineNo(), context->GetLogTime(), context->GetLogDepth()});
  }
};

#endif
