#include <cli/Command.h>
#include <cli/InputOptions.h>
#include <cli/OutputNames.h>
#include <cli/Values.h>
#include <study/DicomWriter.h>
#include <study/Phantom.h>
#include <study/StudyFile.h>

#include <CLI/CLI.hpp>
#include <array>
#include <filesystem>
#include <utility>

namespace cli {
namespace {

using study::DicomEncoding;

constexpr std::array<std::pair<const char*, DicomEncoding>, 6> kEncodings{
    {{"explicit", DicomEncoding::ExplicitLittle},
     {"implicit", DicomEncoding::ImplicitLittle},
     {"big-endian", DicomEncoding::ExplicitBig},
     {"rle", DicomEncoding::Rle},
     {"jpeg", DicomEncoding::JpegLossless},
     {"jpeg-ls", DicomEncoding::JpegLsLossless}}};

DicomEncoding ParseEncoding(const std::string& text) {
  std::string names;
  for (const auto& [name, encoding] : kEncodings) {
    if (text == name) {
      return encoding;
    }
    names += std::string(names.empty() ? "" : ", ") + name;
  }
  throw UsageError("--encoding: " + study::Quoted(text) + " is not one of " + names);
}

class PhantomCommand : public Command {
 public:
  explicit PhantomCommand(CLI::App& application)
      : Command(application,
                {"phantom", "Write the built-in phantom as a file or a DICOM series",
                 "[OPTIONS] OUT.bdf\n[OPTIONS] FOLDER",
                 "  vorl phantom torso.bdf\n"
                 "  vorl phantom --size 128x128x80 torso-dicom/\n\n"
                 "The phantom is a made-up torso of 400 x 400 x 320 mm in Hounsfield units, the\n"
                 "same in every run. A name that ends in .bdf gives a study file; any other name\n"
                 "without an extension is a folder for one DICOM file per slice, which must be\n"
                 "new or empty."}) {
    GetApp().add_option("OUT", m_output)->type_name("PATH");
    AddText("--size", m_sizeText, "WxHxN",
            std::string("Voxels in each direction (default: ") + kPhantomSize + ")", "Phantom");
    AddText("--encoding", m_encodingText, "NAME",
            "How the DICOM files are coded: explicit (default),\nimplicit, big-endian, rle,"
            " jpeg, jpeg-ls;\nall keep every value",
            "Phantom");
  }

  void Check() override {
    if (m_output.empty()) {
      throw UsageError("no output is named (a file OUT.bdf, or a folder)");
    }
    m_isFile = ExtensionOf(m_output) == ".bdf" || IsDevice(m_output);
    if (!m_isFile && !std::filesystem::is_directory(m_output) && !ExtensionOf(m_output).empty()) {
      throw UsageError("the output: the name " + study::Quoted(m_output) +
                       " does not end in .bdf, and is not that of a folder either");
    }
    m_size = ParseSize("--size", m_sizeText, 3, "WIDTHxHEIGHTxSLICES");
    if (m_isFile && !m_encodingText.empty()) {
      throw UsageError("--encoding is for DICOM series only");
    }
    if (!m_encodingText.empty()) {
      m_options.encoding = ParseEncoding(m_encodingText);
    }
  }

  void Run(Console& console) override {
    if (m_isFile) {
      CheckPlace(m_output);
    }
    const study::Progress progress = console.GetProgress();
    const auto phantom =
        study::MakePhantom(m_size[0], m_size[1], m_size[2], study::PartOf(progress, 0, 0.5));
    const study::Progress rest = study::PartOf(progress, 0.5, 1);
    if (m_isFile) {
      study::WriteStudyFile(*phantom, m_output, rest);
    } else {
      study::WriteDicomSeries(*phantom, m_output, m_options, rest);
    }
  }

 private:
  std::string m_output;
  std::string m_sizeText = kPhantomSize;
  std::string m_encodingText;
  bool m_isFile = false;
  std::vector<int> m_size;
  study::DicomWriteOptions m_options;
};

}  // namespace

std::unique_ptr<Command> MakePhantomCommand(CLI::App& application) {
  return std::make_unique<PhantomCommand>(application);
}

}  // namespace cli
