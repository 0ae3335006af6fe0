#ifndef VORL_APPS_CLI_OUTPUTNAMES_H
#define VORL_APPS_CLI_OUTPUTNAMES_H

/// @file
/// Judging the names of outputs before any work is done for them.

#include <string>
#include <vector>

namespace cli {

/// The extension in lower case, with its dot; empty when there is none.
std::string ExtensionOf(const std::string& path);

/// True for something that is there and is neither a file nor a folder: a device or a pipe, whose
/// name says nothing about the kind of data.
bool IsDevice(const std::string& path);

/// Throws `UsageError` unless the name ends in one of the extensions, or is that of a device.
void CheckExtension(const std::string& option, const std::string& path,
                    const std::vector<std::string>& extensions);

/// Throws `study::Error` when a file of this name could never be written: it is a folder, or lies
/// in one that does not exist.
void CheckPlace(const std::string& path);

}  // namespace cli

#endif
