#include <vorl/Common/OpBase.h>

#include <new>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Common/detail/OperatorThread.h>

inline namespace vorl {

using vorl_detail::OperatorThread;

VORL_REGISTER_ABSTRACT_CLASS(OpBase, BaseClass);

OpBase::OpBase() = default;

OpBase::OpBase(const OpBase& source)
    : BaseClass(source), m_status(source.m_status), m_timer(source.m_timer) {
  CopyRun(source);
}

OpBase& OpBase::operator=(const OpBase& source) {
  if (this != &source) {
    if (m_thread != nullptr && m_thread != source.m_thread && m_thread->BelongsTo(*this)) {
      OpBase::Terminate();  // nobody else would end it
    }
    m_status = source.m_status;
    m_timer = source.m_timer;
    CopyRun(source);
  }
  return *this;
}

void OpBase::CopyRun(const OpBase& source) {
  m_thread = source.m_thread;
  m_running = source.m_running.load();
  m_launching = false;
  m_stopRequested = source.m_stopRequested.load();
  m_processingTime = source.m_processingTime.load();
  m_progress = source.m_progress.load();
}

OpBase::~OpBase() {
  OpBase::Terminate();
}

bool OpBase::Reset() {
  return true;
}

bool OpBase::Run() {
  Start();
  bool ok = false;
  try {
    ok = Prepare() && Process();
  } catch (const std::bad_alloc&) {
    ok = false;
    m_status.Set(false, "out of memory");
  }
  return Exit(ok);
}

void OpBase::Start() {
  // A run in its own thread began with `RunAsThread`: its time counts from there, and a stop
  // request that came since then is meant for it.
  if (!m_launching.exchange(false)) {
    m_stopRequested = false;
    ResetProgress();
  }
  m_status = true;
  m_running = true;
}

void OpBase::ResetProgress() {
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
  m_thread = OperatorThread::Start(*this);
  if (m_thread == nullptr) {
    return false;
  }
  // From here on the owner sees a running operator, though the thread has yet to come to `Start`.
  ResetProgress();
  m_launching = true;
  m_running = true;
  m_thread->Publish();
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
