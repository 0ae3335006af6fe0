#ifndef VORL_APPS_CLI_PICTUREFILE_H
#define VORL_APPS_CLI_PICTUREFILE_H

/// @file
/// Pictures under the names that the user gives.

#include <vorl/Data/dImage.h>

#include <filesystem>
#include <string>

namespace CLI {
class App;
}  // namespace CLI

namespace cli {

/// Declares -o, the picture to write; its name is kept in `target`. `kind` tells its pixels.
void AddPictureOption(CLI::App& command, std::string& target, const std::string& group,
                      const std::string& kind = "8-bit grey");

/// Throws `UsageError` unless the name ends in .png or .bmp, or is that of a device.
void CheckPictureName(const std::string& option, const std::string& path);

/// Writes the picture as the kind that `name` stands for: BMP when it ends in .bmp, else PNG. The
/// file is `path`. Throws `study::Error`.
void WritePicture(const dImage& picture, const std::string& name,
                  const std::filesystem::path& path);

}  // namespace cli

#endif
