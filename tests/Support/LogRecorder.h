#ifndef VORL_TESTS_SUPPORT_LOGRECORDER_H
#define VORL_TESTS_SUPPORT_LOGRECORDER_H

#include <vorl/Common/ILogging.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>

#include <string>
#include <vector>

/// Collects the errors and entries that are logged while it lives, as "title: message".
class LogRecorder : public LogTarget {
 public:
  LogRecorder() {
    SetLevelMask(LogLevel_Error | LogLevel_Entry);
    GetLogManager().AddLogTarget(this, nullptr);
  }
  ~LogRecorder() override { GetLogManager().RemoveLogTarget(this); }

  void OnError(LogContext* context) override {
    errors.push_back(std::string(context->GetTitle()) + ": " + context->GetMsg());
    errorCodes.push_back(context->GetCode());
  }
  void OnEntry(LogContext* context) override { entries.push_back(context->GetTitle()); }

  std::vector<std::string> errors;
  std::vector<long> errorCodes;
  std::vector<std::string> entries;
};

#endif
