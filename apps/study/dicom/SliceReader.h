#ifndef VORL_APPS_STUDY_DICOM_SLICEREADER_H
#define VORL_APPS_STUDY_DICOM_SLICEREADER_H

/// @file
/// Reading the slices of DICOM files: first their headers, then their pixels.

#include <study/dicom/SliceHeader.h>

#include <cstdint>
#include <filesystem>
#include <memory>
#include <span>
#include <string>
#include <vector>

class DcmFileFormat;

namespace study {

/// The series of a file, told even when the file holds no slice.
struct FileIdentity {
  std::string seriesUid;
};

/// Reads the header of every slice in the file: one, or one per frame of a multi-frame file whose
/// frames have positions of their own. Everything that does not need the pixels is checked here.
/// `identity` is filled as soon as it is known. Throws `Error` with the reason, which does not name
/// the file, when the file holds no slice that a volume can use.
std::vector<SliceHeader> ReadSliceHeaders(const std::filesystem::path& path,
                                          FileIdentity& identity);

/// Reads pixels; keeps the last file open, so that reading the frames of one file in turn parses
/// and decodes it once.
class SliceReader {
 public:
  SliceReader();
  ~SliceReader();
  SliceReader(const SliceReader&) = delete;
  SliceReader& operator=(const SliceReader&) = delete;

  /// Makes sure that the file really holds the pixels that the header announces, before memory is
  /// taken for them. Throws as `Read` does.
  void CheckSize(const SliceHeader& header);
  /// Fills `samples` (rows * columns of the header) as `UnpackSamples` leaves them. Throws `Error`
  /// with the reason, which does not name the file.
  void Read(const SliceHeader& header, std::span<std::uint16_t> samples);

 private:
  void Open(const SliceHeader& header);

  std::filesystem::path m_path;
  std::unique_ptr<DcmFileFormat> m_file;
  std::vector<std::uint8_t> m_bytes;
};

}  // namespace study

#endif
