// A log target that prints what the library reports, and where it happened: the open contexts from
// the outermost to the one that reports.
#include <vorl/vorl.h>

#include <cstdio>

namespace {

class Printer : public LogTarget {
 public:
  void OnError(LogContext* context) override { Print("error", context); }
  void OnWarning(LogContext* context) override { Print("warning", context); }
  void OnInfo(LogContext* context) override { Print("info", context); }

 private:
  static void Print(const char* kind, LogContext* context) {
    std::printf("%s: %s\n", kind, context->GetMsg());
    for (const LogContext* open : context->GetLogStack()) {
      std::printf("  in %s\n", open->GetTitle());
    }
  }
};

bool LoadPicture(const char* path) {
  LogContext context("LoadPicture", __FILE__, __LINE__, true);
  context.Info("loading '%s'", path);
  dDIB picture;
  return picture.Init(path);
}

}  // namespace

int main() {
  Printer printer;
  GetLogManager().AddLogTarget(&printer, nullptr);
  const bool isLoaded = LoadPicture("no such picture.bmp");
  GetLogManager().RemoveLogTarget(&printer);
  LoadPicture("nobody listens any more.bmp");
  return isLoaded ? 1 : 0;
}

// Prints:
//   info: loading 'no such picture.bmp'
//     in LoadPicture
//   error: unable to open file 'no such picture.bmp'
//     in opDIB2Ima::Convert
//     in dDIB::Init
//     in LoadPicture
//   error: initialization error:unable to open file 'no such picture.bmp'
//     in dDIB::Init
//     in LoadPicture
