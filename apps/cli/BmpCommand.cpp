#include <cli/Command.h>
#include <cli/OutputNames.h>
#include <study/Error.h>
#include <study/OutputFile.h>
#include <study/Pictures.h>
#include <vorl/Data/dDIB.h>
#include <vorl/IO/File/opDIB2Ima.h>

#include <CLI/CLI.hpp>
#include <cstdlib>
#include <cstring>
#include <fstream>

namespace cli {
namespace {

constexpr char kBitmapType[] = "dDIB";

std::string Line(const std::string& label, const std::string& value) {
  return label + std::string(14 - label.size(), ' ') + value + "\n";
}

std::string TextOf(const dStatus& status) {
  return static_cast<const char*>(status);
}

std::string LayoutText(const dImage& image) {
  const int channels = image.GetNumChannels();
  return std::to_string(channels) + (channels == 1 ? " channel of " : " channels of ") +
         std::to_string(image.GetChannelDepth()) + " bit" + " ('" + image.GetChannelSequence() +
         "')";
}

/// The lines of a header of the usual kind; none for another.
std::string HeaderLines(const std::string& path) {
  BITMAPINFOHEADER header{};
  std::ifstream file(path, std::ios::binary);
  file.seekg(sizeof(BITMAPFILEHEADER));
  char bytes[sizeof(header)] = {};
  file.read(bytes, sizeof(bytes));
  std::memcpy(&header, bytes, sizeof(header));
  if (!file || header.biSize != sizeof(header)) {
    return {};
  }
  std::string depth = std::to_string(header.biBitCount) +
                      (header.biBitCount == 1 ? " bit" : " bits") + " per pixel";
  if (header.biClrUsed != 0) {
    depth += ", " + std::to_string(header.biClrUsed) + " colours";
  }
  return Line("Stored:", depth) +
         Line("Rows:", header.biHeight < 0 ? "top row first" : "bottom row first");
}

std::string Describe(const std::string& path) {
  int width = 0;
  int height = 0;
  if (!dDIB::IsBitmapFile(path.c_str(), width, height)) {
    throw study::Error(study::Quoted(path) + " is not a bitmap file, or can't be read");
  }
  dImage image;
  opDIB2Ima reader;
  const bool isRead = reader.Convert(path.c_str(), image);
  return Line("File:", path) +
         Line("Size:", std::to_string(width) + " x " + std::to_string(height) + " pixels") +
         HeaderLines(path) +
         Line("Image:", isRead ? LayoutText(image) : "none: " + TextOf(reader.GetStatus()));
}

void LoadBitmapData(const std::string& path, dImage& image) {
  try {
    BinaryDataIn in;
    in.Open(path.c_str(), kBitmapType);
    image.Read(in);
  } catch (const dStatus& status) {
    throw study::Error("can't read " + study::Quoted(path) + ": " + TextOf(status));
  }
}

void Load(const std::string& path, dImage& image) {
  const std::string extension = ExtensionOf(path);
  if (extension == ".bmp") {
    study::LoadBmp(path, image);
  } else if (extension == ".png") {
    study::LoadPng(path, image);
  } else {
    LoadBitmapData(path, image);
  }
  if (!image.IsValid()) {
    throw study::Error(study::Quoted(path) + " holds no picture");
  }
}

void SaveBitmapData(const dImage& image, const std::string& path) {
  study::OutputFile output(path);
  dDIB bitmap;
  bitmap = image;
  if (!bitmap.IsValid()) {
    throw study::Error("can't write " + study::Quoted(path) + ": " + TextOf(bitmap.GetStatus()));
  }
  if (!bitmap.WriteFile(output.TemporaryPath().string().c_str(), kBitmapType)) {
    throw study::Error("can't write " + study::Quoted(path) + ": the writing failed");
  }
  output.Commit();
}

/// What a PNG can hold: one bit becomes black and white, a fourth byte, which bitmaps fill as they
/// like, is left out.
void ForPng(const dImage& image, dImage& picture) {
  const bool isBit = image.GetDataType() == ImageDataType_U1;
  if (!isBit && image.GetNumChannels() != 4) {
    picture = image;
    return;
  }
  if (!picture.Init(image.GetWidth(), image.GetHeight(), ImageDataType_U8, isBit ? "G" : "BGR",
                    ImageDataOrder_Pixel, 4)) {
    throw study::Error("no memory for the picture");
  }
  for (int y = 0; y < static_cast<int>(image.GetHeight()); ++y) {
    const auto* from = static_cast<const unsigned char*>(image.GetRowPtr(y));
    auto* to = static_cast<unsigned char*>(picture.GetRowPtr(y));
    for (unsigned long x = 0; x < image.GetWidth(); ++x) {
      if (isBit) {
        to[x] = (from[x / 8] >> (7 - x % 8) & 1) != 0 ? 255 : 0;
      } else {
        std::memcpy(to + 3 * x, from + 4 * x, 3);
      }
    }
  }
}

class BmpCommand : public Command {
 public:
  explicit BmpCommand(CLI::App& application)
      : Command(application,
                {"bmp", "Tell what bitmap files hold, and convert pictures",
                 "info FILE...\nconvert [OPTIONS] IN OUT",
                 "  vorl bmp info picture.bmp\n"
                 "  vorl bmp convert picture.bmp picture.png\n"
                 "  vorl bmp convert picture.bdf picture.bmp\n\n"
                 "Pictures are bitmap files (.bmp), binary data files of bitmaps (.bdf) or PNG\n"
                 "(.png). In a PNG the fourth byte of 32-bit pixels is left out. The output\n"
                 "appears only when it is complete."}) {
    GetApp().add_option("ARGUMENTS", m_arguments)->type_name("PATH");
    AddText("--palette", m_palette, "ORDER",
            "The colour table of a grey .bmp: 'ascending' from\nblack to white (default), or "
            "'descending'",
            "Output");
  }

  void Check() override {
    m_action = m_arguments.empty() ? "" : m_arguments.front();
    if (m_action != "info" && m_action != "convert") {
      throw UsageError(m_action.empty() ? "say what to do: 'info' or 'convert'"
                                        : study::Quoted(m_action) + " is not 'info' or 'convert'");
    }
    m_paths.assign(m_arguments.begin() + 1, m_arguments.end());
    if (m_action == "info") {
      CheckInfo();
    } else {
      CheckConvert();
    }
  }

  void Run(Console& console) override {
    if (m_action == "info") {
      std::string text;
      for (const std::string& path : m_paths) {
        text += (text.empty() ? "" : "\n") + Describe(path);
      }
      console.Print(text);
    } else {
      Convert();
    }
  }

 private:
  void CheckInfo() const {
    if (m_paths.empty()) {
      throw UsageError("no file is named");
    }
    if (!m_palette.empty()) {
      throw UsageError("--palette is for the output of 'convert'");
    }
  }

  void CheckConvert() const {
    if (m_paths.size() != 2) {
      throw UsageError("'convert' wants two names: the picture and the output file");
    }
    CheckExtension("the input", m_paths[0], {".bmp", ".bdf", ".png"});
    CheckExtension("the output", m_paths[1], {".bmp", ".bdf", ".png"});
    if (m_palette.empty()) {
      return;
    }
    if (m_palette != "ascending" && m_palette != "descending") {
      throw UsageError("--palette: " + study::Quoted(m_palette) +
                       " is not 'ascending' or 'descending'");
    }
    if (ExtensionOf(m_paths[1]) != ".bmp") {
      throw UsageError("--palette is for an output that ends in .bmp");
    }
  }

  void Convert() const {
    CheckPlace(m_paths[1]);
    dImage image;
    Load(m_paths[0], image);
    const std::string extension = ExtensionOf(m_paths[1]);
    if (extension == ".bdf") {
      SaveBitmapData(image, m_paths[1]);
    } else if (extension == ".png") {
      dImage picture;
      ForPng(image, picture);
      study::SavePng(picture, m_paths[1]);
    } else {
      study::SaveBmp(image, m_paths[1], m_palette != "descending");
    }
  }

  std::vector<std::string> m_arguments;
  std::string m_palette;
  std::string m_action;
  std::vector<std::string> m_paths;
};

}  // namespace

std::unique_ptr<Command> MakeBmpCommand(CLI::App& application) {
  return std::make_unique<BmpCommand>(application);
}

}  // namespace cli
