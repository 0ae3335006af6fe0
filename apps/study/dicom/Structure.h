#ifndef VORL_APPS_STUDY_DICOM_STRUCTURE_H
#define VORL_APPS_STUDY_DICOM_STRUCTURE_H

/// @file
/// A look over the structure of a DICOM file before the toolkit parses it.
///
/// The toolkit descends into sequences by recursion, without a limit: a small file of sequences
/// within sequences would exhaust the stack. This check walks through the file without recursion.

#include <filesystem>
#include <string>

namespace study {

/// Sequences within sequences beyond this depth are refused; real files stay below ten.
inline constexpr int kDeepestNesting = 64;

/// Throws `Error` when the toolkit must not be let near the file: its sequences are nested deeper
/// than `kDeepestNesting`, or its structure is broken and it has so many items that they could be.
/// Other broken files pass: the toolkit tells best what is wrong with them. Returns the identifier
/// of the transfer syntax; empty when the file does not tell it properly.
std::string CheckStructure(const std::filesystem::path& path);

}  // namespace study

#endif
