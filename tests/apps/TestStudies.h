#ifndef VORL_TESTS_APPS_TESTSTUDIES_H
#define VORL_TESTS_APPS_TESTSTUDIES_H

/// @file
/// Small studies with known content.

#include <study/LoadReport.h>
#include <study/Study.h>

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace study_test {

/// The value that a test study stores at a voxel: different for neighbours in every direction.
std::uint16_t PatternValue(int i, int j, int k);

/// A study of HU values from -1024 on (stored = real + 1024) in 2 x 3 x 5 mm voxels, the centre of
/// the first at (10, 20, 30), filled with `PatternValue`.
std::unique_ptr<study::Study> MakePatternStudy(int width, int height, int slices);

/// All real values, slice after slice.
std::vector<double> RealValues(const study::Study& study);

/// All stored values, slice after slice.
std::vector<std::uint16_t> StoredValues(const study::Study& study);

/// The message of the `study::Error` that `action` throws; "no error" when it throws none.
std::string ErrorOf(const std::function<void()>& action);

/// Loads everything in the folder; `series` as for `LoadDicom`.
std::unique_ptr<study::Study> Load(const std::filesystem::path& folder, study::LoadReport& report,
                                   const std::string& series = {});
std::unique_ptr<study::Study> Load(const std::filesystem::path& folder);

/// "name: reason" of each refused file, without folders.
std::vector<std::string> Refusals(const study::LoadReport& report);

}  // namespace study_test

#endif
