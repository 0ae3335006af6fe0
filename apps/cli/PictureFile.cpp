#include <cli/OutputNames.h>
#include <cli/PictureFile.h>
#include <study/Pictures.h>

namespace cli {

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
