#ifndef VORL_APPS_STUDY_DICOM_JPEGHEADER_H
#define VORL_APPS_STUDY_DICOM_JPEGHEADER_H

/// @file
/// A look into compressed pictures before a decoder works on them.

#include <cstdint>
#include <span>
#include <string>

namespace study {

/// What is wrong with the header of a JPEG or JPEG-LS stream that must hold a grey picture of
/// `columns` x `rows` samples of at most `bits` bits; empty when all is well. The decoders trust
/// the size that the DICOM attributes tell, and read a header without asking where the data ends:
/// both are checked here. The compressed samples behind the header are the decoder's own matter.
std::string JpegHeaderProblem(std::span<const std::uint8_t> stream, std::uint32_t columns,
                              std::uint32_t rows, unsigned bits);

}  // namespace study

#endif
