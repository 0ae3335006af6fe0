#include <cli/Command.h>
#include <cli/OutputNames.h>
#include <cli/PictureFile.h>
#include <study/Pictures.h>

namespace cli {

void AddPictureOption(CLI::App& command, std::string& target, const std::string& group,
                      const std::string& kind) {
  AddText(command, "-o,--output", target, "FILE",
          "The picture, by its extension .png or .bmp, " + kind + "\n(a device or pipe gets PNG)",
          group);
}

void CheckPictureName(const std::string& option, const std::string& path) {
  CheckExtension(option, path, {".png", ".bmp"});
}

void WritePicture(const dImage& picture, const std::string& name,
                  const std::filesystem::path& path) {
  if (ExtensionOf(name) == ".bmp") {
    study::SaveBmp(picture, path);
  } else {
    study::SavePng(picture, path);
  }
}

}  // namespace cli
