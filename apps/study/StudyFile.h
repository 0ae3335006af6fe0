#ifndef VORL_APPS_STUDY_STUDYFILE_H
#define VORL_APPS_STUDY_STUDYFILE_H

/// @file
/// Studies as files of the library's own format (`.bdf`).
///
/// The type name is "vorlStudy"; after it stand, in this order:
///
///     U32           the version, 1
///     F64 F64       scale, offset
///     String x 3    unit, modality, description
///     F64 F64       window centre, window width
///     F32 array     the volume's coordinates: origin, x axis, y axis, z axis (12 numbers)
///     U32           the number of slices
///     block k ...   per slice, with its number from 0 as identifier: F32 array of 12 numbers, the
///                   slice's coordinates, and a block with the image
///     String        "end"

#include <study/Progress.h>
#include <study/Study.h>

#include <filesystem>
#include <memory>

namespace study {

/// True when the file begins as a study file does.
bool IsStudyFile(const std::filesystem::path& path);

/// Writes the study; the file appears only when it is complete and has been read back and found
/// equal bit for bit. Throws `Error` ("can't write 'name': ..."), also when the disk is full.
void WriteStudyFile(Study& study, const std::filesystem::path& path, const Progress& progress = {});

/// Reads a study. Whatever the file claims, no more memory is taken than the file has bytes. Throws
/// `Error` ("can't read 'name': ...") when anything in it is not as it must be.
std::unique_ptr<Study> ReadStudyFile(const std::filesystem::path& path,
                                     const Progress& progress = {});

}  // namespace study

#endif
