#include <vorl/Common/detail/OperatorThread.h>

#include <chrono>
#include <new>

#include <vorl/Common/LogManager.h>

inline namespace vorl {
namespace vorl_detail {

namespace {

constexpr std::chrono::milliseconds kStopGrace(100);

}  // namespace

std::shared_ptr<OperatorThread> OperatorThread::Start(OpBase& owner) {
  try {
    std::shared_ptr<OperatorThread> self(new OperatorThread(owner));
    self->m_thread = Thread::Start([self] { self->Body(); });
    return self->m_thread != nullptr ? self : nullptr;
  } catch (const std::bad_alloc&) {
    return nullptr;
  }
}

void OperatorThread::Publish() {
  const std::lock_guard lock(m_mutex);
  m_published = true;
  m_changed.notify_one();
}

void OperatorThread::Body() {
  {
    std::unique_lock lock(m_mutex);
    m_changed.wait(lock, [this] { return m_published; });
  }
  const bool ok = m_owner.Run();
  // After a run that came to `Start` the owner may already be in its next one.
  if (m_owner.m_launching.exchange(false)) {
    m_owner.m_running = false;
  }
  if (ok) {
    m_released = true;
  }
}

void OperatorThread::End() {
  if (m_thread->IsCurrent()) {
    m_owner.m_running = false;
    m_released = true;
    DropLogContexts();
    Thread::ExitCurrent();
  }
  // Only an owner that lives has a thread that has not ended.
  if (!m_thread->WaitFor(std::chrono::milliseconds(0))) {
    m_owner.m_stopRequested = true;
    if (!m_thread->WaitFor(kStopGrace)) {
      m_thread->Kill();
      DropLogContexts();
    }
    m_owner.m_launching = false;
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

}  // namespace vorl_detail
}  // namespace vorl
