#include <dcmtk/config/osconfig.h>

#include <dcmtk/dcmdata/dcpixseq.h>
#include <dcmtk/dcmdata/dcpxitem.h>
#include <study/Error.h>
#include <study/dicom/DicomFile.h>
#include <study/dicom/JpegHeader.h>
#include <study/dicom/Samples.h>
#include <study/dicom/SliceReader.h>

#include <algorithm>

namespace study {
namespace {

/// What a small file may claim to expand to. A picture of one colour packs to next to nothing, so
/// the ratio alone proves no lie; together with the size it keeps a few bytes from asking for
/// gigabytes.
constexpr std::uint64_t kHarmlessBytes = std::uint64_t{64} << 20;
constexpr std::uint64_t kLargestExpansion = 1024;

std::uint64_t FrameBytes(const SliceGrid& grid, const SampleFormat& format) {
  return std::uint64_t{grid.rows} * grid.columns * (format.bitsAllocated / 8);
}

DcmPixelData& PixelDataOf(DcmDataset& dataset) {
  DcmElement* element = nullptr;
  dataset.findAndGetElement(DCM_PixelData, element);
  auto* pixels = dynamic_cast<DcmPixelData*>(element);
  if (pixels == nullptr) {
    throw Error("it holds no pixel data");
  }
  return *pixels;
}

/// Appends the bytes of one fragment.
void AppendFragment(DcmPixelSequence& fragments, unsigned long index,
                    std::vector<std::uint8_t>& bytes) {
  DcmPixelItem* item = nullptr;
  Uint8* data = nullptr;
  if (fragments.getItem(item, index).bad() || item == nullptr || item->getUint8Array(data).bad() ||
      data == nullptr) {
    throw Error("its compressed pixel data is damaged");
  }
  bytes.insert(bytes.end(), data, data + item->getLength());
}

/// The streams of JPEG frames: each frame is a fragment, or all fragments are one frame.
void CheckJpegStreams(DcmPixelSequence& fragments, std::uint32_t frames,
                      const SliceHeader& header) {
  const unsigned long count = fragments.card();
  if (count < 2 || (frames > 1 && count != frames + 1)) {
    throw Error("its compressed pixel data is not one fragment per frame");
  }
  std::vector<std::uint8_t> stream;
  for (unsigned long i = 1; i < count; ++i) {
    AppendFragment(fragments, i, stream);
    if (frames == 1 && i + 1 < count) {
      continue;
    }
    const std::string problem = JpegHeaderProblem(stream, header.grid.columns, header.grid.rows,
                                                  header.format.bitsAllocated);
    if (!problem.empty()) {
      throw Error("its compressed pixel data is damaged (" + problem + ")");
    }
    stream.clear();
  }
}

/// Replaces compressed pixels by plain ones. Every frame is decoded.
void Decode(DcmDataset& dataset, const SliceHeader& header) {
  DcmPixelSequence* fragments = FragmentsOf(dataset);
  if (fragments == nullptr) {
    throw Error("its compressed pixel data is damaged");
  }
  Sint32 announced = 1;
  dataset.findAndGetSint32(DCM_NumberOfFrames, announced);
  const auto frames = static_cast<std::uint32_t>(std::max<Sint32>(announced, 1));
  const std::uint64_t expected = FrameBytes(header.grid, header.format) * frames;
  const std::uint64_t present = PixelBytesInFile(dataset);
  if (expected > kHarmlessBytes && expected / kLargestExpansion > present) {
    throw Error("its compressed pixel data is too short: " + std::to_string(present) +
                " bytes for an image of " + std::to_string(expected));
  }
  if (dataset.getOriginalXfer() != EXS_RLELossless) {
    CheckJpegStreams(*fragments, frames, header);
  }
  const OFCondition condition = dataset.chooseRepresentation(EXS_LittleEndianExplicit, nullptr);
  if (condition.bad()) {
    throw Error("its compressed pixel data can't be decoded (" + std::string(condition.text()) +
                ")");
  }
}

/// A decoder may say that it made other samples than the file announced.
SampleFormat DecodedFormat(DcmDataset& dataset, const SampleFormat& announced) {
  SampleFormat format = announced;
  Uint16 value = 0;
  if (dataset.findAndGetUint16(DCM_BitsAllocated, value).good()) {
    format.bitsAllocated = value;
  }
  if (dataset.findAndGetUint16(DCM_BitsStored, value).good()) {
    format.bitsStored = value;
  }
  if (dataset.findAndGetUint16(DCM_HighBit, value).good()) {
    format.highBit = value;
  }
  if (dataset.findAndGetUint16(DCM_PixelRepresentation, value).good()) {
    format.isSigned = value == 1;
  }
  if (!IsSupported(format) || format.isSigned != announced.isSigned) {
    throw Error("its compressed pixel data holds samples of another kind than announced");
  }
  return format;
}

}  // namespace

SliceReader::SliceReader() = default;
SliceReader::~SliceReader() = default;

void SliceReader::Open(const SliceHeader& header) {
  if (m_file && m_path == header.file) {
    return;
  }
  m_file.reset();
  auto file = OpenDicom(header.file);
  if (DcmXfer(file->getDataset()->getOriginalXfer()).isEncapsulated()) {
    Decode(*file->getDataset(), header);
  }
  m_file = std::move(file);
  m_path = header.file;
}

void SliceReader::CheckSize(const SliceHeader& header) {
  Open(header);
  DcmDataset& dataset = *m_file->getDataset();
  const SampleFormat format = DecodedFormat(dataset, header.format);
  const std::uint64_t needed = FrameBytes(header.grid, format) * (header.frame + std::uint64_t{1});
  const std::uint64_t present = PixelDataOf(dataset).getLength();
  if (needed > present) {
    throw Error("its pixel data is too short: " + std::to_string(present) + " bytes instead of " +
                std::to_string(needed));
  }
}

void SliceReader::Read(const SliceHeader& header, std::span<std::uint16_t> samples) {
  CheckSize(header);
  DcmDataset& dataset = *m_file->getDataset();
  const SampleFormat format = DecodedFormat(dataset, header.format);
  const std::uint64_t frameBytes = FrameBytes(header.grid, format);
  m_bytes.resize(frameBytes);
  // The sizes fit 32 bits: CheckSize compared them with a length that does.
  const OFCondition condition = PixelDataOf(dataset).getPartialValue(
      m_bytes.data(), static_cast<Uint32>(frameBytes * header.frame),
      static_cast<Uint32>(frameBytes), nullptr, EBO_LittleEndian);
  if (condition.bad()) {
    throw Error("its pixel data can't be read (" + std::string(condition.text()) + ")");
  }
  UnpackSamples(m_bytes, format, samples);
}

}  // namespace study
