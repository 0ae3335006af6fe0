// How a thread is ended by force: the killer sends it a real-time signal that nothing else uses,
// and the handler jumps back to the frame in which the thread started, which then returns as at a
// normal end. pthread_cancel does not serve: its deferred form never ends a loop without
// cancellation points, and its asynchronous form unwinds through code that cannot be unwound at
// any instruction, which ends the whole process.

#include <pthread.h>
#include <setjmp.h>
#include <signal.h>

#include <condition_variable>
#include <mutex>
#include <utility>

#include <vorl/Platform/detail/Process.h>
#include <vorl/Platform/detail/Thread.h>

inline namespace vorl {
namespace vorl_detail {

struct Thread::State {
  std::function<void()> body;
  pthread_t handle{};
  std::uint32_t id = 0;
  const void* stackLow = nullptr;
  const void* stackHigh = nullptr;
  bool joined = false;

  std::mutex mutex;
  std::condition_variable changed;
  bool started = false;
  bool ended = false;

  void Announce(bool State::*flag) {
    const std::lock_guard lock(mutex);
    this->*flag = true;
    changed.notify_all();
  }
};

namespace {

// Where the handler jumps to; set while the body runs, so that a late signal finds nothing to do.
struct KillTarget {
  sigjmp_buf start;
  volatile sig_atomic_t armed = 0;
};

thread_local KillTarget killTarget;

int KillSignal() {
  return SIGRTMAX - 3;
}

void OnKillSignal(int) {
  if (killTarget.armed != 0) {
    killTarget.armed = 0;
    siglongjmp(killTarget.start, 1);
  }
}

void InstallKillHandler() {
  static const bool installed = [] {
    struct sigaction action {};
    action.sa_handler = &OnKillSignal;
    sigemptyset(&action.sa_mask);
    return sigaction(KillSignal(), &action, nullptr) == 0;
  }();
  static_cast<void>(installed);
}

void UnblockKillSignal() {
  sigset_t signals;
  sigemptyset(&signals);
  sigaddset(&signals, KillSignal());
  pthread_sigmask(SIG_UNBLOCK, &signals, nullptr);
}

void FindStack(Thread::State& state) {
#if defined(__linux__)
  pthread_attr_t attributes;
  if (pthread_getattr_np(pthread_self(), &attributes) != 0) {
    return;
  }
  void* low = nullptr;
  std::size_t size = 0;
  if (pthread_attr_getstack(&attributes, &low, &size) == 0) {
    state.stackLow = low;
    state.stackHigh = static_cast<char*>(low) + size;
  }
  pthread_attr_destroy(&attributes);
#else
  static_cast<void>(state);
#endif
}

void RunBody(Thread::State& state) {
  state.id = CurrentThreadId();
  FindStack(state);
  UnblockKillSignal();
  state.Announce(&Thread::State::started);
  if (sigsetjmp(killTarget.start, 1) == 0) {
    killTarget.armed = 1;
    state.body();
  }
  killTarget.armed = 0;
  state.body = nullptr;  // lets go of what the body kept alive
}

void* ThreadMain(void* argument) {
  const std::unique_ptr<std::shared_ptr<Thread::State>> state(
      static_cast<std::shared_ptr<Thread::State>*>(argument));
  RunBody(**state);
  (*state)->Announce(&Thread::State::ended);
  return nullptr;
}

}  // namespace

Thread::Thread(std::shared_ptr<State> state) : m_state(std::move(state)) {}

std::unique_ptr<Thread> Thread::Start(std::function<void()> body) {
  InstallKillHandler();
  auto state = std::make_shared<State>();
  state->body = std::move(body);
  auto argument = std::make_unique<std::shared_ptr<State>>(state);
  if (pthread_create(&state->handle, nullptr, &ThreadMain, argument.get()) != 0) {
    return nullptr;
  }
  static_cast<void>(argument.release());  // the thread owns it now
  {
    std::unique_lock lock(state->mutex);
    state->changed.wait(lock, [&] { return state->started; });
  }
  return std::unique_ptr<Thread>(new Thread(std::move(state)));
}

Thread::~Thread() {
  if (!m_state->joined) {
    pthread_detach(m_state->handle);
  }
}

std::uint32_t Thread::Id() const {
  return m_state->id;
}

bool Thread::IsCurrent() const {
  return pthread_equal(m_state->handle, pthread_self()) != 0;
}

bool Thread::WaitFor(std::chrono::milliseconds timeout) const {
  std::unique_lock lock(m_state->mutex);
  return m_state->changed.wait_for(lock, timeout, [&] { return m_state->ended; });
}

void Thread::Kill() {
  // Repeated: a signal that arrives before the body has begun finds nothing to end.
  constexpr std::chrono::milliseconds kPause(10);
  for (bool ended = WaitFor(std::chrono::milliseconds(0)); !ended; ended = WaitFor(kPause)) {
    pthread_kill(m_state->handle, KillSignal());
  }
  Join();
}

void Thread::ExitCurrent() {
  killTarget.armed = 0;
  siglongjmp(killTarget.start, 1);
}

void Thread::Join() {
  if (!m_state->joined) {
    m_state->joined = true;
    pthread_join(m_state->handle, nullptr);
  }
}

const void* Thread::StackLow() const {
  return m_state->stackLow;
}
const void* Thread::StackHigh() const {
  return m_state->stackHigh;
}

}  // namespace vorl_detail
}  // namespace vorl
