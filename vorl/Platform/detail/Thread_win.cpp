#include <windows.h>

#include <atomic>
#include <new>
#include <utility>

#include <vorl/Platform/detail/KillShield.h>
#include <vorl/Platform/detail/Thread.h>

inline namespace vorl {
namespace vorl_detail {

struct Thread::State {
  // What keeps this state, and what the body needs, alive until the thread has ended.
  std::shared_ptr<State> self;
  std::function<void()> body;

  HANDLE handle = nullptr;
  DWORD id = 0;
  HANDLE started = CreateEventA(nullptr, TRUE, FALSE, nullptr);
  const void* stackLow = nullptr;
  const void* stackHigh = nullptr;

  enum Shield { kOpen, kShielded, kKilled };
  std::atomic<Shield> shield{kOpen};
  int shieldDepth = 0;  // belongs to the thread

  ~State() {
    if (handle != nullptr) {
      CloseHandle(handle);
    }
    if (started != nullptr) {
      CloseHandle(started);
    }
  }
};

namespace {

thread_local Thread::State* currentThread = nullptr;

DWORD WINAPI ThreadMain(void* argument) {
  auto* state = static_cast<Thread::State*>(argument);
  ULONG_PTR low = 0;
  ULONG_PTR high = 0;
  GetCurrentThreadStackLimits(&low, &high);
  state->stackLow = reinterpret_cast<const void*>(low);
  state->stackHigh = reinterpret_cast<const void*>(high);
  currentThread = state;
  SetEvent(state->started);
  state->body();
  state->body = nullptr;
  currentThread = nullptr;
  state->self = nullptr;
  return 0;
}

}  // namespace

KillShield::KillShield() {
  if (currentThread == nullptr || currentThread->shieldDepth++ > 0) {
    return;
  }
  Thread::State::Shield open = Thread::State::kOpen;
  if (!currentThread->shield.compare_exchange_strong(open, Thread::State::kShielded)) {
    Sleep(INFINITE);  // `Kill` came first and is about to end this thread
  }
}

KillShield::~KillShield() {
  if (currentThread != nullptr && --currentThread->shieldDepth == 0) {
    currentThread->shield = Thread::State::kOpen;
  }
}

Thread::Thread(std::shared_ptr<State> state) : m_state(std::move(state)) {}

std::unique_ptr<Thread> Thread::Start(std::function<void()> body) try {
  auto state = std::make_shared<State>();
  state->body = std::move(body);
  std::unique_ptr<Thread> thread(new Thread(state));
  if (state->started == nullptr) {
    return nullptr;
  }
  state->self = state;
  state->handle = CreateThread(nullptr, 0, &ThreadMain, state.get(), 0, &state->id);
  if (state->handle == nullptr) {
    state->self = nullptr;
    return nullptr;
  }
  WaitForSingleObject(state->started, INFINITE);
  return thread;
} catch (const std::bad_alloc&) {
  return nullptr;
}

Thread::~Thread() = default;

std::uint32_t Thread::Id() const {
  return m_state->id;
}

bool Thread::IsCurrent() const {
  return currentThread == m_state.get();
}

bool Thread::WaitFor(std::chrono::milliseconds timeout) const {
  return WaitForSingleObject(m_state->handle, static_cast<DWORD>(timeout.count())) == WAIT_OBJECT_0;
}

void Thread::Kill() {
  constexpr std::chrono::milliseconds kPause(1);
  State::Shield open = State::kOpen;
  while (!m_state->shield.compare_exchange_strong(open, State::kKilled)) {
    open = State::kOpen;
    if (WaitFor(kPause)) {
      return;
    }
  }
  TerminateThread(m_state->handle, 0);
  WaitForSingleObject(m_state->handle, INFINITE);
}

void Thread::ExitCurrent() {
  ExitThread(0);
}

void Thread::Join() {
  WaitForSingleObject(m_state->handle, INFINITE);
  m_state->body = nullptr;  // a thread that was ended by force let go of nothing
  m_state->self = nullptr;
}

const void* Thread::StackLow() const {
  return m_state->stackLow;
}
const void* Thread::StackHigh() const {
  return m_state->stackHigh;
}

}  // namespace vorl_detail
}  // namespace vorl
