#include <vorl/Common/OpBase.h>

#include <chrono>

#include <vorl/Common/LogManager.h>
#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Common/detail/OperatorThread.h>

inline namespace vorl {

namespace {

constexpr std::chrono::milliseconds kStopGrace(100);

}  // namespace

std::shared_ptr<OperatorThread> OperatorThread::Start(OpBase& owner) {
  std::shared_ptr<OperatorThread> self(new OperatorThread(owner));
  self->m_thread = vorl_detail::Thread::Start([self] { self->Body(); });
  return self->m_thread != nullptr ? self : nullptr;
}

void OperatorThread::Body() {
  m_published.wait(false);
  const bool ok = m_owner.Run();
  m_owner.m_running = false;  // an overridden `Run` need not have ended the run
  if (ok) {
    m_released = true;
  }
}

void OperatorThread::End() {
  if (m_thread->IsCurrent()) {
    m_owner.m_running = false;
    m_released = true;
    DropLogContexts();
    vorl_detail::Thread::ExitCurrent();
  }
  // Only an owner that lives has a thread that has not ended.
  if (!m_thread->WaitFor(std::chrono::milliseconds(0))) {
    m_owner.m_stopRequested = true;
    if (!m_thread->WaitFor(kStopGrace)) {
      m_thread->Kill();
      DropLogContexts();
    }
    m_owner.m_running = false;
    m_owner.m_stopRequested = false;
  }
  m_thread->Join();
  m_released = true;
}

// Contexts on the stack of a thread that never unwound would stay on the log stack for good.
void OperatorThread::DropLogContexts() {
  GetLogManager().GetLogThread()->DropWithin(m_thread->StackLow(), m_thread->StackHigh());
}

VORL_REGISTER_ABSTRACT_CLASS(OpBase, BaseClass);

OpBase::OpBase() = default;

OpBase::OpBase(const OpBase& source) : BaseClass(source) {
  *this = source;
}

OpBase& OpBase::operator=(const OpBase& source) {
  if (this != &source) {
    if (m_thread != source.m_thread) {
      OpBase::Terminate();  // nobody else would end it
    }
    m_status = source.m_status;
    m_timer = source.m_timer;
    m_thread = source.m_thread;
    m_running = source.m_running.load();
    m_launching = false;
    m_stopRequested = source.m_stopRequested.load();
    m_processingTime = source.m_processingTime.load();
    m_progress = source.m_progress.load();
  }
  return *this;
}

OpBase::~OpBase() {
  OpBase::Terminate();
}

bool OpBase::Reset() {
  return true;
}

bool OpBase::Run() {
  Start();
  bool ok = Prepare();
  if (ok) {
    ok = Process();
  }
  return Exit(ok);
}

void OpBase::Start() {
  m_running = true;
  // A stop request that came between `RunAsThread` and now is meant for this run.
  if (!m_launching.exchange(false)) {
    m_stopRequested = false;
  }
  m_status = true;
  m_progress = 0.0;
  m_processingTime = 0.0;
  m_timer.Reset();
}

bool OpBase::Exit(bool ok) {
  m_stopRequested = false;
  m_processingTime = m_timer.GetDiffTime(false);
  if (ok) {
    m_status = true;
    m_status = "success";
  }
  m_running = false;  // last: whoever sees it may read the results
  return ok;
}

bool OpBase::HasThread() const {
  return m_thread != nullptr && m_thread->IsOpen();
}

void OpBase::Stop() {
  m_stopRequested = HasThread() && m_running;
}

void OpBase::Terminate() {
  if (m_thread != nullptr) {
    m_thread->End();
    m_thread.reset();
    m_running = false;
  }
}

bool OpBase::RunAsThread(int) {
  if (HasThread() && m_running) {
    return true;
  }
  OpBase::Terminate();  // an earlier thread has ended its run and is at most about to return
  m_stopRequested = false;
  m_launching = true;
  m_running = true;
  m_thread = OperatorThread::Start(*this);
  if (m_thread == nullptr) {
    m_launching = false;
    m_running = false;
    return false;
  }
  m_thread->m_published = true;
  m_thread->m_published.notify_one();
  return true;
}

double OpBase::GetProgress() {
  return m_progress;
}

bool OpBase::operator()() {
  return Run();
}

bool OpBase::IsRunning() const {
  return m_running;
}

double OpBase::GetProcessingTime() const {
  return m_running ? m_timer.GetDiffTime(false) : m_processingTime.load();
}

const dStatus& OpBase::GetStatus() const {
  return m_status;
}

bool OpBase::Stopped() {
  m_status.Set(-1, "stopped");
  return false;
}

}  // namespace vorl
