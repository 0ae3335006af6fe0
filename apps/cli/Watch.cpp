#include <cli/Watch.h>

#include <chrono>
#include <thread>

namespace cli {
namespace {

constexpr std::chrono::milliseconds kPoll(2);

void WaitForEnd(const OpBase& op) {
  while (op.IsRunning()) {
    std::this_thread::sleep_for(kPoll);
  }
}

}  // namespace

void CheckStatus(const OpBase& op, const std::string& what) {
  const dStatus& status = op.GetStatus();
  if (static_cast<long>(status) != 0) {
    throw study::Error("can't " + what + ": " + static_cast<const char*>(status));
  }
}

void RunWatched(OpBase& op, const study::Progress& progress, const std::string& doing) {
  study::Report(progress, 0, doing);  // also where the operator is faster than the first look
  if (!op.RunAsThread(0)) {
    op.Run();
    return;
  }
  try {
    while (op.IsRunning()) {
      study::Report(progress, op.GetProgress(), doing);
      std::this_thread::sleep_for(kPoll);
    }
  } catch (...) {
    op.Stop();
    WaitForEnd(op);
    throw;
  }
}

}  // namespace cli
