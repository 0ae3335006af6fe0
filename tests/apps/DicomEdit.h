#ifndef VORL_TESTS_APPS_DICOMEDIT_H
#define VORL_TESTS_APPS_DICOMEDIT_H

/// @file
/// Changing DICOM files for tests.

#include <dcmtk/config/osconfig.h>

#include <dcmtk/dcmdata/dctk.h>

#include <filesystem>
#include <functional>
#include <string>

namespace study_test {

/// Loads the file, lets `change` work on its data set, and saves it in its own transfer syntax.
void EditDicom(const std::filesystem::path& file, const std::function<void(DcmDataset&)>& change);

/// Sets one attribute; every kind of value as text.
void SetAttribute(const std::filesystem::path& file, const DcmTagKey& tag,
                  const std::string& value);
void RemoveAttribute(const std::filesystem::path& file, const DcmTagKey& tag);

}  // namespace study_test

#endif
