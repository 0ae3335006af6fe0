#include <vorl/Common/LogContext.h>

#include <array>
#include <ctime>

#include <vorl/Common/LogManager.h>
#include <vorl/Common/detail/FormatText.h>
#include <vorl/Common/detail/TimerClock.h>

inline namespace vorl {

using vorl_detail::SecondsNow;
using vorl_detail::StoreText;

namespace {

const char* FileNameOf(const char* path) {
  const char* name = path;
  for (const char* c = path; *c != '\0'; ++c) {
    if (*c == '\\' || *c == '/') {
      name = c + 1;
    }
  }
  return name;
}

bool LocalTime(std::time_t time, std::tm& result) {
#if defined(_WIN32)
  return localtime_s(&result, &time) == 0;
#else
  return localtime_r(&time, &result) != nullptr;
#endif
}

}  // namespace

LogContext::LogContext() {
  Init("", "", 0, false);
}

LogContext::LogContext(const char* title, const char* filePath, int line, bool logEntry) {
  Init(title, filePath, line, logEntry);
}

LogContext::LogContext(const LogContext& source) = default;

LogContext& LogContext::operator=(const LogContext& source) = default;

LogContext::~LogContext() {
  if (m_logThread->Remove(this)) {
    m_logThread->GetLogSession()->LogExit(this);
  }
}

void LogContext::Init(const char* title, const char* filePath, int line, bool logEntry) {
  m_line = static_cast<std::uint32_t>(line);
  m_initLine = m_line;
  StoreText(m_title, title != nullptr ? title : "");
  m_filePath = filePath != nullptr ? filePath : "";
  m_code = 0;
  m_logTime = SecondsNow();
  m_logThread = GetLogManager().GetLogThread();
  if (logEntry) {
    m_logThread->GetLogSession()->LogEntry(this);
    m_logThread->Push(this);
  }
}

void LogContext::Report(Kind kind, std::int32_t code) {
  m_code = code;
  m_logTime = SecondsNow();
  LogSession* session = m_logThread->GetLogSession();
  switch (kind) {
    case Kind::Error:
      session->LogError(this);
      break;
    case Kind::Warning:
      session->LogWarning(this);
      break;
    case Kind::Info:
      session->LogInfo(this);
      break;
  }
}

// Formats the variable arguments behind `format` into the message, unless `format` is null.
#define VORL_FORMAT_MESSAGE(format)                   \
  if (format != nullptr) {                            \
    vorl_detail::FormatBuffer text;                   \
    std::va_list arguments;                           \
    va_start(arguments, format);                      \
    vorl_detail::FormatText(text, format, arguments); \
    va_end(arguments);                                \
    StoreText(m_message, text.data());                \
  }                                                   \
  static_assert(true)

void LogContext::Info(const char* format, ...) {
  VORL_FORMAT_MESSAGE(format);
  if (format != nullptr) {
    m_line = 0;
  }
  Report(Kind::Info, 0);
}

void LogContext::Error(int line, const char* format, ...) {
  VORL_FORMAT_MESSAGE(format);
  m_line = static_cast<std::uint32_t>(line);
  Report(Kind::Error, -1);
}

void LogContext::Warning(int line, const char* format, ...) {
  VORL_FORMAT_MESSAGE(format);
  m_line = static_cast<std::uint32_t>(line);
  Report(Kind::Warning, 1);
}

void LogContext::Status(int line, const dStatus& status) {
  StoreText(m_message, static_cast<const char*>(status));
  m_line = static_cast<std::uint32_t>(line);
  const auto code = static_cast<std::int32_t>(static_cast<long>(status));
  Report(code < 0 ? Kind::Error : code > 0 ? Kind::Warning : Kind::Info, code);
}

void LogContext::LogDateTime(const char* format) {
  if (format == nullptr) {
    return;
  }
  std::array<char, 256> text{};
  std::tm now{};
  if (!LocalTime(std::time(nullptr), now) ||
      std::strftime(text.data(), text.size(), format, &now) == 0) {
    text[0] = '\0';
  }
  StoreText(m_message, text.data());
  m_line = 0;
  Report(Kind::Info, 0);
}

void LogContext::LogDate() {
  LogDateTime("%d-%b-%Y");
}

void LogContext::LogTime() {
  LogDateTime("%H:%M:%S");
}

void LogContext::Trace(const char*, ...) {}

const char* LogContext::GetTitle() const {
  return m_title.c_str();
}
const char* LogContext::GetFilePath() const {
  return m_filePath;
}
const char* LogContext::GetFileName() const {
  return FileNameOf(m_filePath);  // seldom asked, unlike a context made
}
unsigned int LogContext::GetLineNo() const {
  return m_line;
}
unsigned int LogContext::GetInitLineNo() const {
  return m_initLine;
}
void LogContext::SetLineNo(unsigned int line) {
  m_line = line;
}
const char* LogContext::GetMsg() const {
  return m_message.c_str();
}
long LogContext::GetCode() const {
  return m_code;
}
double LogContext::GetLogTime() const {
  return m_logTime;
}
unsigned long LogContext::GetThreadID() const {
  return m_logThread->GetThreadId();
}
std::list<LogContext*>& LogContext::GetLogStack() const {
  return m_logThread->m_stack;
}
unsigned long LogContext::GetLogDepth() const {
  return m_logThread->GetLogDepth();
}

}  // namespace vorl
