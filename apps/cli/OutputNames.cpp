#include <cli/Command.h>
#include <cli/OutputNames.h>
#include <study/OutputFile.h>

#include <algorithm>
#include <cctype>
#include <filesystem>
#include <system_error>

namespace cli {

namespace fs = std::filesystem;

std::string ExtensionOf(const std::string& path) {
  std::string extension = fs::path(path).extension().string();
  std::transform(extension.begin(), extension.end(), extension.begin(),
                 [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
  return extension;
}

bool IsDevice(const std::string& path) {
  std::error_code ignored;
  const fs::file_status status = fs::status(path, ignored);
  return fs::exists(status) && !fs::is_regular_file(status) && !fs::is_directory(status);
}

void CheckExtension(const std::string& option, const std::string& path,
                    const std::vector<std::string>& extensions) {
  const std::string extension = ExtensionOf(path);
  if (IsDevice(path) ||
      std::find(extensions.begin(), extensions.end(), extension) != extensions.end()) {
    return;
  }
  std::string wanted;
  for (const std::string& one : extensions) {
    wanted += (wanted.empty() ? "" : " or ") + one;
  }
  throw UsageError(option + ": the name " + study::Quoted(path) + " does not end in " + wanted);
}

void CheckPlace(const std::string& path) {
  const study::OutputFile probe(path);
}

}  // namespace cli
