// How a thread is ended by force: the killer sends it a real-time signal that nothing else uses,
// and the handler jumps back to the frame in which the thread started, which then returns as at a
// normal end. pthread_cancel does not serve: its deferred form never ends a loop without
// cancellation points, and its asynchronous form unwinds through code that cannot be unwound at
// any instruction, which ends the whole process.

#include <pthread.h>
#include <setjmp.h>
#include <signal.h>
#include <time.h>

#include <atomic>
#include <condition_variable>
#include <mutex>
#include <new>
#include <utility>

#include <vorl/Platform/detail/KillShield.h>
#include <vorl/Platform/detail/Process.h>
#include <vorl/Platform/detail/Thread.h>

inline namespace vorl {
namespace vorl_detail {

struct Thread::State {
  // What keeps this state, and what the body needs, alive until the thread has ended.
  std::shared_ptr<State> self;
  std::function<void()> body;

  pthread_t handle{};
  bool joinable = false;
  std::uint32_t id = 0;
  const void* stackLow = nullptr;
  const void* stackHigh = nullptr;

  std::mutex mutex;
  std::condition_variable changed;
  bool started = false;
  bool ended = false;
  bool forced = false;  // ended by `Kill` or `ExitCurrent`

  void Announce(bool State::*flag) {
    const std::lock_guard lock(mutex);
    this->*flag = true;
    changed.notify_all();
  }
};

namespace {

// What the signal handler needs to know of the thread in which it runs.
struct KillTarget {
  const Thread::State* thread = nullptr;
  sigjmp_buf start{};                  // where it jumps to
  volatile sig_atomic_t armed = 0;     // 1 while the body runs: a late signal finds nothing to do
  volatile sig_atomic_t shielded = 0;  // the number of shields
  volatile sig_atomic_t pending = 0;   // 1 when a shield put the end off
};

// Placed when the library is loaded: a signal handler must not be the first to ask for it, and
// every log context asks several times.
#if defined(__GNUC__)
[[gnu::tls_model("initial-exec")]]
#endif
thread_local KillTarget killTarget;

int KillSignal() {
  return SIGRTMAX - 3;
}

[[noreturn]] void EndBody() {
  killTarget.armed = 0;
  siglongjmp(killTarget.start, 1);
}

void OnKillSignal(int) {
  if (killTarget.shielded != 0) {
    killTarget.pending = 1;
  } else if (killTarget.armed != 0) {
    EndBody();
  }
}

void InstallKillHandler() {
  static const bool installed = [] {
    struct sigaction action {};
    action.sa_handler = &OnKillSignal;
    action.sa_flags = SA_RESTART;  // a signal that finds nothing to do disturbs nothing
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
  killTarget.thread = &state;
  UnblockKillSignal();
  state.Announce(&Thread::State::started);
  if (sigsetjmp(killTarget.start, 1) == 0) {
    killTarget.armed = 1;
    state.body();
    killTarget.armed = 0;
    state.body = nullptr;
  } else {
    state.forced = true;
  }
}

// A thread that ends by itself lets go of its state. One that is ended by force may have been
// inside the allocator and must not free anything: whoever joins it does it.
void* ThreadMain(void* argument) {
  auto* state = static_cast<Thread::State*>(argument);
  RunBody(*state);
  const std::shared_ptr<Thread::State> self = state->forced ? nullptr : std::move(state->self);
  state->Announce(&Thread::State::ended);
  return nullptr;
}

// For the same reason a thread that was ended by force may wait for ever when the system tidies up
// behind it. It runs nothing of ours any more, so after a while it is left to the system.
void JoinOrAbandon(pthread_t handle) {
#if defined(__linux__)
  timespec deadline{};
  clock_gettime(CLOCK_REALTIME, &deadline);
  deadline.tv_sec += 1;
  if (pthread_timedjoin_np(handle, nullptr, &deadline) != 0) {
    pthread_detach(handle);
  }
#else
  pthread_detach(handle);
#endif
}

}  // namespace

// The fences keep the compiler from moving what is shielded out of the shield.
KillShield::KillShield() {
  killTarget.shielded = killTarget.shielded + 1;
  std::atomic_signal_fence(std::memory_order_seq_cst);
}

KillShield::~KillShield() {
  std::atomic_signal_fence(std::memory_order_seq_cst);
  killTarget.shielded = killTarget.shielded - 1;
  if (killTarget.pending != 0 && killTarget.shielded == 0 && killTarget.armed != 0) {
    EndBody();
  }
}

Thread::Thread(std::shared_ptr<State> state) : m_state(std::move(state)) {}

std::unique_ptr<Thread> Thread::Start(std::function<void()> body) try {
  InstallKillHandler();
  auto state = std::make_shared<State>();
  state->body = std::move(body);
  std::unique_ptr<Thread> thread(new Thread(state));
  state->self = state;
  if (pthread_create(&state->handle, nullptr, &ThreadMain, state.get()) != 0) {
    state->self = nullptr;
    return nullptr;
  }
  state->joinable = true;
  std::unique_lock lock(state->mutex);
  state->changed.wait(lock, [&] { return state->started; });
  return thread;
} catch (const std::bad_alloc&) {
  return nullptr;
}

Thread::~Thread() {
  if (m_state->joinable) {
    pthread_detach(m_state->handle);
  }
}

std::uint32_t Thread::Id() const {
  return m_state->id;
}

bool Thread::IsCurrent() const {
  return killTarget.thread == m_state.get();
}

bool Thread::WaitFor(std::chrono::milliseconds timeout) const {
  std::unique_lock lock(m_state->mutex);
  return m_state->changed.wait_for(lock, timeout, [&] { return m_state->ended; });
}

void Thread::Kill() {
  // Repeated: a signal that comes before the body has begun ends nothing.
  constexpr std::chrono::milliseconds kPause(10);
  for (bool ended = WaitFor(std::chrono::milliseconds(0)); !ended; ended = WaitFor(kPause)) {
    pthread_kill(m_state->handle, KillSignal());
  }
}

void Thread::ExitCurrent() {
  EndBody();
}

void Thread::Join() {
  if (!m_state->joinable) {
    return;
  }
  m_state->joinable = false;
  {
    std::unique_lock lock(m_state->mutex);
    m_state->changed.wait(lock, [&] { return m_state->ended; });
  }
  if (m_state->forced) {
    JoinOrAbandon(m_state->handle);
    m_state->body = nullptr;
    m_state->self = nullptr;
  } else {
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
