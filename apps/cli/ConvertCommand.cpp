#include <cli/Command.h>
#include <cli/InputOptions.h>
#include <cli/OutputNames.h>
#include <study/StudyFile.h>

namespace cli {
namespace {

class ConvertCommand : public Command {
 public:
  explicit ConvertCommand(CLI::App& application)
      : Command(application,
                {"convert", "Save a volume as a study file (.bdf)",
                 "[OPTIONS] INPUT... OUT.bdf\n[OPTIONS] --phantom[=WxHxN] OUT.bdf",
                 "  vorl convert scans/ study.bdf\n"
                 "  vorl convert scans/ --series '#2' study.bdf\n\n"
                 "The file holds every slice with its place in space, and scale, offset and unit\n"
                 "of the values. It appears only after it has been read back and found equal bit\n"
                 "for bit; until then an earlier file of that name stays."}) {
    m_input.AddTo(GetApp());
  }

  void Check() override {
    m_output = m_input.TakeLastPath("output file");
    CheckExtension("the output", m_output, {".bdf"});
    m_input.Check();
  }

  void Run(Console& console) override {
    CheckPlace(m_output);
    const study::Progress progress = console.GetProgress();
    const Input input = m_input.Load(console, study::PartOf(progress, 0, 0.6));
    study::WriteStudyFile(*input.study, m_output, study::PartOf(progress, 0.6, 1));
  }

 private:
  InputOptions m_input;
  std::string m_output;
};

}  // namespace

std::unique_ptr<Command> MakeConvertCommand(CLI::App& application) {
  return std::make_unique<ConvertCommand>(application);
}

}  // namespace cli
