// How a thread is ended by force: the system does it, between any two of its instructions, and what
// the thread had locked stays locked. With a lock of the allocator or of the loader the whole
// process would soon stand still. So the killer halts the thread, looks where it is, and lets it
// run on for a moment as long as it is at work inside the system's libraries.

#include <windows.h>

#include <array>
#include <atomic>
#include <cstring>
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
  HANDLE ended = CreateEventA(nullptr, TRUE, FALSE, nullptr);
  const void* stackLow = nullptr;
  const void* stackHigh = nullptr;

  // Between `kOpen` and `kKilled` or `kEnded` whoever comes first decides: a thread that has left
  // its body is in the hands of the loader and is not ended by force any more.
  enum Shield { kOpen, kShielded, kKilled, kEnded };
  std::atomic<Shield> shield{kOpen};
  int shieldDepth = 0;  // belongs to the thread
  bool forced = false;  // ended by `Kill` or `ExitCurrent`

  ~State() {
    if (handle != nullptr) {
      CloseHandle(handle);
    }
    if (started != nullptr) {
      CloseHandle(started);
    }
    if (ended != nullptr) {
      CloseHandle(ended);
    }
  }
};

namespace {

constexpr DWORD kPauseMilliseconds = 1;
constexpr int kMostPauses = 200;
constexpr int kStillEnough = 5;
constexpr DWORD kLongestTidyingMilliseconds = 1000;

thread_local Thread::State* currentThread = nullptr;

/// Where the code of one module stands in memory.
class CodeRange {
 public:
  /// The module to which the address belongs; null: the program.
  explicit CodeRange(const void* address) {
    HMODULE module = nullptr;
    constexpr DWORD kByAddress =
        GET_MODULE_HANDLE_EX_FLAG_FROM_ADDRESS | GET_MODULE_HANDLE_EX_FLAG_UNCHANGED_REFCOUNT;
    if (!GetModuleHandleExA(address != nullptr ? kByAddress : 0, static_cast<const char*>(address),
                            &module)) {
      return;
    }
    const auto* base = reinterpret_cast<const char*>(module);
    IMAGE_DOS_HEADER dos;
    std::memcpy(&dos, base, sizeof(dos));
    IMAGE_NT_HEADERS headers;
    std::memcpy(&headers, base + dos.e_lfanew, sizeof(headers));
    m_begin = reinterpret_cast<DWORD64>(base);
    m_end = m_begin + headers.OptionalHeader.SizeOfImage;
  }
  bool Contains(DWORD64 address) const { return address >= m_begin && address < m_end; }

 private:
  DWORD64 m_begin = 0;
  DWORD64 m_end = 0;
};

/// The program's code and the library's: no lock of the system is held while they run.
bool IsOurCode(DWORD64 address) {
  static const char inTheLibrary = 0;
  static const std::array<CodeRange, 2> ours{CodeRange(nullptr), CodeRange(&inTheLibrary)};
  return ours[0].Contains(address) || ours[1].Contains(address);
}

/// True behind the instruction that enters the system, where a waiting thread stands.
bool IsSystemCall(DWORD64 address) {
  const auto* code = reinterpret_cast<const unsigned char*>(address);
  constexpr unsigned char kSystemCall[] = {0x0F, 0x05};
  constexpr unsigned char kCallThroughTable[] = {0xFF, 0x14, 0x25};  // with an address of 4 bytes
  return std::memcmp(code - 2, kSystemCall, sizeof(kSystemCall)) == 0 ||
         std::memcmp(code - 7, kCallThroughTable, sizeof(kCallThroughTable)) == 0;
}

/// Ends the thread while it runs our code or waits, which shows in its standing in a system call
/// for a while; when that does not come about, wherever it is.
void TerminateAtRest(HANDLE thread) {
  IsOurCode(0);  // asks the loader now, not while the thread is halted in it
  DWORD64 last = 0;
  int seen = 0;
  for (int pause = 0; pause < kMostPauses; ++pause) {
    if (SuspendThread(thread) == static_cast<DWORD>(-1)) {
      break;
    }
    CONTEXT context{};
    context.ContextFlags = CONTEXT_CONTROL;
    const DWORD64 position = GetThreadContext(thread, &context) ? context.Rip : 0;
    if (IsOurCode(position)) {
      break;
    }
    seen = position != 0 && position == last && IsSystemCall(position) ? seen + 1 : 0;
    if (seen >= kStillEnough) {
      break;
    }
    last = position;
    ResumeThread(thread);
    Sleep(kPauseMilliseconds);
  }
  TerminateThread(thread, 0);
  WaitForSingleObject(thread, INFINITE);
}

/// From here on `Kill` leaves the thread alone; when it came first, waits for the end.
void LeaveBody(Thread::State& state) {
  Thread::State::Shield expected =
      state.shieldDepth > 0 ? Thread::State::kShielded : Thread::State::kOpen;
  if (!state.shield.compare_exchange_strong(expected, Thread::State::kEnded)) {
    Sleep(INFINITE);
  }
}

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
  LeaveBody(*state);
  state->body = nullptr;
  currentThread = nullptr;
  const std::shared_ptr<Thread::State> self = std::move(state->self);
  SetEvent(state->ended);
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
  if (state->started == nullptr || state->ended == nullptr) {
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
  // The body may also end its thread behind our back.
  const std::array<HANDLE, 2> ends{m_state->ended, m_state->handle};
  return WaitForMultipleObjects(static_cast<DWORD>(ends.size()), ends.data(), FALSE,
                                static_cast<DWORD>(timeout.count())) != WAIT_TIMEOUT;
}

void Thread::Kill() {
  constexpr std::chrono::milliseconds kPause(kPauseMilliseconds);
  State::Shield open = State::kOpen;
  while (!m_state->shield.compare_exchange_strong(open, State::kKilled)) {
    open = State::kOpen;
    if (WaitFor(kPause)) {
      return;
    }
  }
  m_state->forced = true;
  TerminateAtRest(m_state->handle);
  SetEvent(m_state->ended);
}

void Thread::ExitCurrent() {
  LeaveBody(*currentThread);
  currentThread->forced = true;
  SetEvent(currentThread->ended);
  ExitThread(0);
}

void Thread::Join() {
  while (!WaitFor(std::chrono::hours(1))) {
  }
  // The system tidies up behind a thread that was ended by force with what that thread may have
  // left locked.
  WaitForSingleObject(m_state->handle, m_state->forced ? kLongestTidyingMilliseconds : INFINITE);
  if (m_state->forced) {
    m_state->body = nullptr;
    m_state->self = nullptr;
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
