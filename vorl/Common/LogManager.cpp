#include <vorl/Common/LogManager.h>

#include <algorithm>
#include <functional>
#include <new>
#include <vector>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/TimerClock.h>
#include <vorl/Platform/detail/KillShield.h>
#include <vorl/Platform/detail/Process.h>

inline namespace vorl {

using vorl_detail::KillShield;
using vorl_detail::SecondsNow;

namespace {

constexpr char kDefaultSession[] = "DEFAULT";

std::uint32_t NextSessionId() {
  static std::atomic<std::uint32_t> nextId{0};
  return nextId.fetch_add(1, std::memory_order_relaxed);
}

// Without memory for the copy the record goes nowhere.
std::list<ILogging*> CopyOf(const std::list<ILogging*>& targets) {
  try {
    return targets;
  } catch (const std::bad_alloc&) {
    return {};
  }
}

// The manager exists from library load on, also when nothing asks for it.
[[maybe_unused]] const LogManager& managerAtLoad = GetLogManager();

}  // namespace

// The manager comes first, so that its "DEFAULT" session has identifier 0.
LogSession::LogSession() : LogSession((static_cast<void>(GetLogManager()), "")) {}

LogSession::LogSession(const char* name) : m_name(name), m_id(NextSessionId()) {}

LogSession::LogSession(const LogSession& source) = default;
LogSession& LogSession::operator=(const LogSession& source) = default;
LogSession::~LogSession() = default;

void LogSession::AddLogTarget(ILogging* target) {
  if (target == nullptr) {
    return;
  }
  try {
    m_targets.push_back(target);
  } catch (const std::bad_alloc&) {
    return;  // as a target that nobody added
  }
}

void LogSession::RemoveLogTarget(ILogging* target) {
  if (target != nullptr) {
    m_targets.remove(target);
  }
}

void LogSession::RemoveAllLogTargets() {
  m_targets.clear();
}

unsigned long LogSession::GetID() const {
  return m_id;
}

void LogSession::Dispatch(LogLevel level, void (ILogging::*call)(LogContext*),
                          LogContext* context) {
  if (m_targets.empty() || context == nullptr) {
    return;
  }
  // A target may remove itself and others during its call.
  const std::list<ILogging*> targets = CopyOf(m_targets);
  for (ILogging* target : targets) {
    const bool present = std::find(m_targets.begin(), m_targets.end(), target) != m_targets.end();
    if (present && (target->GetLevelMask() & level) != 0) {
      (target->*call)(context);
    }
  }
}

void LogSession::LogInfo(LogContext* context) {
  Dispatch(LogLevel_Info, &ILogging::OnInfo, context);
}
void LogSession::LogError(LogContext* context) {
  Dispatch(LogLevel_Error, &ILogging::OnError, context);
}
void LogSession::LogWarning(LogContext* context) {
  Dispatch(LogLevel_Warning, &ILogging::OnWarning, context);
}
void LogSession::LogEntry(LogContext* context) {
  Dispatch(LogLevel_Entry, &ILogging::OnEntry, context);
}
void LogSession::LogExit(LogContext* context) {
  Dispatch(LogLevel_Exit, &ILogging::OnExit, context);
}

LogThread::LogThread() : LogThread(GetLogManager().GetSession(0)) {}

LogThread::LogThread(LogSession* session)
    : m_id(vorl_detail::CurrentProcessId()), m_baseTime(SecondsNow()), m_session(session) {}

LogThread::LogThread(const LogThread& source)
    : m_id(source.m_id), m_baseTime(source.m_baseTime), m_session(source.m_session) {
  const std::lock_guard lock(source.m_stackMutex);
  m_stack = source.m_stack;
}

LogThread& LogThread::operator=(const LogThread& source) {
  if (this != &source) {
    const std::scoped_lock lock(m_stackMutex, source.m_stackMutex);
    m_id = source.m_id;
    m_baseTime = source.m_baseTime;
    m_stack = source.m_stack;
    m_session = source.m_session;
  }
  return *this;
}

LogThread::~LogThread() = default;

unsigned long LogThread::GetThreadId() const {
  return m_id;
}

double LogThread::GetBaseTime() const {
  return m_baseTime;
}

LogSession* LogThread::GetLogSession() const {
  return m_session;
}

// The shields: a thread ended by force while it holds the lock would stop all logging for good.

unsigned long LogThread::GetLogDepth() const {
  const KillShield shield;
  const std::lock_guard lock(m_stackMutex);
  return static_cast<unsigned long>(m_stack.size());
}

void LogThread::Push(LogContext* context) {
  const KillShield shield;
  const std::lock_guard lock(m_stackMutex);
  try {
    m_stack.push_front(context);
  } catch (const std::bad_alloc&) {
    return;  // the context will log no exit
  }
}

bool LogThread::Remove(LogContext* context) {
  const KillShield shield;
  const std::lock_guard lock(m_stackMutex);
  if (m_stack.empty() || m_stack.front() != context) {
    m_stack.remove(context);  // ended out of order: it must not stay behind as a dangling pointer
    return false;
  }
  m_stack.pop_front();
  return true;
}

void LogThread::DropWithin(const void* low, const void* high) {
  const KillShield shield;
  const std::lock_guard lock(m_stackMutex);
  const std::less<const void*> before;
  m_stack.remove_if(
      [&](const LogContext* context) { return !before(context, low) && before(context, high); });
}

// Never destroyed: in a static build an application's objects may outlive every destructor that the
// library could run at exit, and still log from their own.
LogManager& GetLogManager() {
  static LogManager& manager = *new LogManager();
  return manager;
}

LogManager::LogManager()
    : m_startTime(SecondsNow()),
      m_creator(static_cast<std::int32_t>(vorl_detail::CurrentThreadId())) {
  RegisterSession(kDefaultSession);
  GetLogThread();
}

LogManager::LogManager(const LogManager& source)
    : m_startTime(source.m_startTime),
      m_creator(source.m_creator),
      m_sessions(source.m_sessions),
      m_logThreads(source.m_logThreads),
      m_currentLogThread(source.m_currentLogThread.load()) {}

LogManager& LogManager::operator=(const LogManager& source) {
  if (this != &source) {
    m_startTime = source.m_startTime;
    m_creator = source.m_creator;
    m_sessions = source.m_sessions;
    m_logThreads = source.m_logThreads;
    m_currentLogThread = source.m_currentLogThread.load();
  }
  return *this;
}

LogManager::~LogManager() {
  m_logThreads.clear();  // the records refer to the sessions
  m_sessions.clear();
}

LogSession* LogManager::GetSession(const char* name) const {
  const char* wanted = name != nullptr ? name : kDefaultSession;
  for (const auto& session : m_sessions) {
    if (session->m_name == wanted) {
      return session.get();
    }
  }
  return nullptr;
}

LogSession* LogManager::GetSession(int id) const {
  const std::uint32_t wanted = id < 0 ? 0 : static_cast<std::uint32_t>(id);
  for (const auto& session : m_sessions) {
    if (session->m_id == wanted) {
      return session.get();
    }
  }
  return nullptr;
}

LogSession* LogManager::RegisterSession(const char* name) {
  if (LogSession* known = GetSession(name)) {
    return known;
  }
  try {
    m_sessions.emplace_back(new LogSession(name != nullptr ? name : kDefaultSession));
  } catch (const std::bad_alloc&) {
    return nullptr;
  }
  return m_sessions.back().get();
}

void LogManager::AddLogTarget(ILogging* target, const char* sessionName) {
  if (LogSession* session = RegisterSession(sessionName)) {
    session->AddLogTarget(target);
  }
}

void LogManager::RemoveLogTarget(ILogging* target) {
  for (const auto& session : m_sessions) {
    session->RemoveLogTarget(target);
  }
}

LogThread* LogManager::GetLogThread() {
  const std::uint32_t process = vorl_detail::CurrentProcessId();
  LogThread* current = m_currentLogThread;
  if (current != nullptr && current->m_id == process) {
    return current;
  }
  const KillShield shield;
  const std::lock_guard lock(m_logThreadsMutex);
  for (const auto& record : m_logThreads) {
    if (record->m_id == process) {
      m_currentLogThread = record.get();
      return record.get();
    }
  }
  // Only the process's own manager has the session 0; it finds it here while it is being built.
  LogSession* session = GetSession(0);
  m_logThreads.emplace_back(
      new LogThread(session != nullptr ? session : GetLogManager().GetSession(0)));
  m_currentLogThread = m_logThreads.back().get();
  return m_logThreads.back().get();
}

long LogManager::GetPID() const {
  return m_creator;
}

}  // namespace vorl
