// What a program of somebody else does first: make an object through its class record, derive a
// class of its own, receive a log record. All of it needs what the library sets up while it is
// loaded, which a static library could lose.
#include <vorl/vorl.h>

#include <cstdio>
#include <cstring>
#include <memory>
#include <string>

namespace {

class Listener : public LogTarget {
 public:
  void OnError(LogContext* context) override { heard = context->GetMsg(); }

  std::string heard;
};

// Its constructor runs before main, as those of the library's own records do.
const bool recordIsThereBeforeMain = std::strcmp(dStatus::CI().name, "dStatus") == 0;

int Fail(const char* what) {
  std::fprintf(stderr, "consumer: %s\n", what);
  return 1;
}

}  // namespace

int main() {
  if (!recordIsThereBeforeMain) {
    return Fail("dStatus has no class record before main");
  }
  const std::unique_ptr<BaseClass> object(dStatus::CI().Create());
  if (!object || !object->CoversClass(DataBase::CI().RTTID)) {
    return Fail("dStatus cannot be created through its class record");
  }
  if (dynamic_cast<dStatus*>(object.get()) == nullptr) {
    return Fail("the type information of dStatus differs inside and outside the library");
  }
  Listener listener;
  GetLogManager().AddLogTarget(&listener, nullptr);
  LogContext("consumer", __FILE__, __LINE__, false).Error(__LINE__, "%d of %d", 1, 2);
  GetLogManager().RemoveLogTarget(&listener);
  if (listener.heard != "1 of 2") {
    return Fail("the log record did not arrive");
  }
  std::puts("consumer: ok");
  return 0;
}
