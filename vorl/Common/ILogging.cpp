#include <vorl/Common/ILogging.h>

inline namespace vorl {

ILogging::ILogging() : m_levelMask(LogLevel_Error | LogLevel_Warning | LogLevel_Info) {}
ILogging::ILogging(const ILogging& source) = default;
ILogging& ILogging::operator=(const ILogging& source) = default;
ILogging::~ILogging() = default;

void ILogging::OnEntry(LogContext*) {}
void ILogging::OnExit(LogContext*) {}
void ILogging::OnError(LogContext*) {}
void ILogging::OnWarning(LogContext*) {}
void ILogging::OnInfo(LogContext*) {}

void ILogging::SetLevelMask(unsigned short mask) {
  m_levelMask = mask;
}
unsigned short ILogging::GetLevelMask() const {
  return m_levelMask;
}

LogTarget::LogTarget() = default;
LogTarget::LogTarget(const LogTarget& source) = default;
LogTarget& LogTarget::operator=(const LogTarget& source) = default;
LogTarget::~LogTarget() = default;

void LogTarget::OnEntry(LogContext*) {}
void LogTarget::OnExit(LogContext*) {}
void LogTarget::OnError(LogContext*) {}
void LogTarget::OnWarning(LogContext*) {}
void LogTarget::OnInfo(LogContext*) {}

void LogTarget::PrintLogStack(LogContext*) {}

}  // namespace vorl
