#ifndef VORL_APPS_STUDY_DICOM_DICOMFILE_H
#define VORL_APPS_STUDY_DICOM_DICOMFILE_H

/// @file
/// Opening DICOM files whose content nobody vouches for.

#include <dcmtk/config/osconfig.h>

#include <dcmtk/dcmdata/dctk.h>

#include <cstdint>
#include <filesystem>
#include <memory>
#include <string>

namespace study {

/// True when the file begins as a DICOM file does: "DICM" after 128 bytes. False, too, when it
/// cannot be read.
bool LooksLikeDicom(const std::filesystem::path& path);

/// Parses a DICOM file. Values of more than a few kilobytes stay on the disk until they are asked
/// for, and a length that goes beyond the end of the file is an error before anything is allocated.
/// Throws `Error` without the file's name, also for deflated data sets and unknown transfer
/// syntaxes.
std::unique_ptr<DcmFileFormat> OpenDicom(const std::filesystem::path& path);

/// The transfer syntax for messages: "'JPEG 2000 (Lossless only)' (1.2.840.10008.1.2.4.90)".
std::string TransferSyntaxText(DcmDataset& dataset);

/// True when the pixels of this transfer syntax can be read.
bool CanDecode(E_TransferSyntax syntax);

/// The fragments of compressed pixels; null when the pixels are not compressed, or are not there.
DcmPixelSequence* FragmentsOf(DcmDataset& dataset);

/// The bytes of the data set's pixels as they stand in the file, compressed or not; 0 without any.
std::uint64_t PixelBytesInFile(DcmDataset& dataset);

}  // namespace study

#endif
