#ifndef VORL_TESTS_COMMON_TESTOPERATORS_H
#define VORL_TESTS_COMMON_TESTOPERATORS_H

#include <vorl/Common/OpBase.h>

#include <chrono>
#include <functional>
#include <string>
#include <thread>
#include <vector>

/// Notes its steps and does in them what a test gives it to do.
class RecordingOp : public OpBase {
 public:
  RecordingOp() = default;
  RecordingOp(const RecordingOp& source) : OpBase(source) {}
  RecordingOp& operator=(const RecordingOp& source) {
    OpBase::operator=(source);
    return *this;
  }
  ~RecordingOp() override { OpBase::Terminate(); }

  using OpBase::HasThread;
  using OpBase::m_progress;
  using OpBase::m_status;
  using OpBase::m_stopRequested;
  using OpBase::Stopped;

  std::function<bool()> prepare;
  std::function<bool()> process;
  bool exitResult = true;
  std::vector<std::string> trail;

  bool Prepare() override {
    trail.push_back("prepare");
    return prepare ? prepare() : true;
  }
  bool Process() override {
    trail.push_back("process");
    return process ? process() : true;
  }
  void Start() override {
    trail.push_back("start");
    OpBase::Start();
  }
  bool Exit(bool ok) override {
    trail.push_back(ok ? "exit true" : "exit false");
    return OpBase::Exit(ok) && exitResult;
  }
};

/// Waits until the condition holds, at most so many seconds; returns whether it holds.
template <typename Condition>
bool WaitUntil(Condition condition, int seconds = 30) {
  const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(seconds);
  while (!condition()) {
    if (std::chrono::steady_clock::now() > deadline) {
      return false;
    }
    std::this_thread::sleep_for(std::chrono::microseconds(100));
  }
  return true;
}

#endif
