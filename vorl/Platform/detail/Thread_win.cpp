#include <windows.h>

#include <utility>

#include <vorl/Platform/detail/Thread.h>

inline namespace vorl {
namespace vorl_detail {

struct Thread::State {
  std::function<void()> body;
  HANDLE handle = nullptr;
  DWORD id = 0;
  HANDLE started = CreateEventA(nullptr, TRUE, FALSE, nullptr);
  const void* stackLow = nullptr;
  const void* stackHigh = nullptr;

  ~State() {
    if (handle != nullptr) {
      CloseHandle(handle);
    }
    CloseHandle(started);
  }
};

namespace {

DWORD WINAPI ThreadMain(void* argument) {
  const std::unique_ptr<std::shared_ptr<Thread::State>> state(
      static_cast<std::shared_ptr<Thread::State>*>(argument));
  ULONG_PTR low = 0;
  ULONG_PTR high = 0;
  GetCurrentThreadStackLimits(&low, &high);
  (*state)->stackLow = reinterpret_cast<const void*>(low);
  (*state)->stackHigh = reinterpret_cast<const void*>(high);
  SetEvent((*state)->started);
  (*state)->body();
  (*state)->body = nullptr;  // lets go of what the body kept alive
  return 0;
}

}  // namespace

Thread::Thread(std::shared_ptr<State> state) : m_state(std::move(state)) {}

std::unique_ptr<Thread> Thread::Start(std::function<void()> body) {
  auto state = std::make_shared<State>();
  state->body = std::move(body);
  auto argument = std::make_unique<std::shared_ptr<State>>(state);
  state->handle = CreateThread(nullptr, 0, &ThreadMain, argument.get(), 0, &state->id);
  if (state->handle == nullptr) {
    return nullptr;
  }
  static_cast<void>(argument.release());  // the thread owns it now
  WaitForSingleObject(state->started, INFINITE);
  return std::unique_ptr<Thread>(new Thread(std::move(state)));
}

Thread::~Thread() = default;

std::uint32_t Thread::Id() const {
  return m_state->id;
}

bool Thread::IsCurrent() const {
  return m_state->id == GetCurrentThreadId();
}

bool Thread::WaitFor(std::chrono::milliseconds timeout) const {
  return WaitForSingleObject(m_state->handle, static_cast<DWORD>(timeout.count())) == WAIT_OBJECT_0;
}

void Thread::Kill() {
  TerminateThread(m_state->handle, 0);
  Join();
}

void Thread::ExitCurrent() {
  ExitThread(0);
}

void Thread::Join() {
  WaitForSingleObject(m_state->handle, INFINITE);
}

const void* Thread::StackLow() const {
  return m_state->stackLow;
}
const void* Thread::StackHigh() const {
  return m_state->stackHigh;
}

}  // namespace vorl_detail
}  // namespace vorl
