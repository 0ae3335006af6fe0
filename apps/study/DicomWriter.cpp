#include <dcmtk/config/osconfig.h>

#include <dcmtk/dcmdata/dctk.h>
#include <dcmtk/dcmjpeg/djrplol.h>
#include <dcmtk/dcmjpls/djrparam.h>
#include <study/DicomWriter.h>
#include <study/OutputFile.h>
#include <study/dicom/Codecs.h>
#include <study/dicom/DicomFile.h>
#include <study/dicom/PixelPacking.h>

#include <cstdio>
#include <memory>
#include <system_error>

namespace study {
namespace {

namespace fs = std::filesystem;

constexpr int kLeastJpegLsPixels = 1024;

/// A number as a decimal string of at most 16 characters.
std::string Decimal(double value) {
  char text[32];
  std::snprintf(text, sizeof text, "%.10g", value);
  return text;
}

std::string Decimals(const Vec3& v) {
  return Decimal(v.x) + "\\" + Decimal(v.y) + "\\" + Decimal(v.z);
}

/// Identifiers out of content: the 64-bit FNV-1a sum of everything fed so far.
class ContentHash {
 public:
  void Add(const void* data, std::size_t size) {
    const auto* bytes = static_cast<const unsigned char*>(data);
    for (std::size_t i = 0; i < size; ++i) {
      m_sum = (m_sum ^ bytes[i]) * 1099511628211u;  // wraps
    }
  }
  void Add(const std::string& text) { Add(text.c_str(), text.size() + 1); }
  void Add(double number) { Add(Decimal(number)); }
  /// Below the root that is free for everyone's own numbers.
  std::string Uid() const { return "2.25." + std::to_string(m_sum); }

 private:
  std::uint64_t m_sum = 14695981039346656037u;
};

ContentHash StudyHash(const Study& study) {
  ContentHash hash;
  hash.Add(study.modality);
  hash.Add(study.description);
  hash.Add(study.scale);
  hash.Add(study.offset);
  hash.Add(Decimals(WorldFromVoxel(study, {0, 0, 0})));
  for (const dSlice& slice : study.volume.GetSliceList()) {
    const auto samples = SamplesOf(slice);
    hash.Add(samples.data(), samples.size_bytes());
  }
  return hash;
}

ContentHash SeriesHash(ContentHash hash, const DicomWriteOptions& options) {
  for (const double number :
       {static_cast<double>(options.encoding), double(options.bitsStored), double(options.isSigned),
        double(options.inverted), double(options.seriesNumber)}) {
    hash.Add(number);
  }
  hash.Add(options.seriesDescription);
  for (const double slope : options.sliceSlopes) {
    hash.Add(slope);
  }
  return hash;
}

/// What all files of a series share.
struct Series {
  const Study& study;
  const DicomWriteOptions& options;
  std::string studyUid;
  std::string seriesUid;
  ContentHash hash;
};

void Put(DcmItem& item, const DcmTagKey& tag, const std::string& value) {
  if (item.putAndInsertString(tag, value.c_str()).bad()) {
    throw Error("the value '" + value + "' can't be stored");
  }
}

void Put(DcmItem& item, const DcmTagKey& tag, unsigned value) {
  if (item.putAndInsertUint16(tag, static_cast<Uint16>(value)).bad()) {
    throw Error("a number can't be stored");
  }
}

void PutIdentity(DcmItem& item, const Series& series, int index) {
  ContentHash hash = series.hash;
  hash.Add(index + 1.0);
  Put(item, DCM_SpecificCharacterSet, "ISO_IR 192");
  Put(item, DCM_ImageType, "DERIVED\\SECONDARY\\AXIAL");
  Put(item, DCM_SOPClassUID, UID_CTImageStorage);
  Put(item, DCM_SOPInstanceUID, hash.Uid());
  Put(item, DCM_StudyInstanceUID, series.studyUid);
  Put(item, DCM_SeriesInstanceUID, series.seriesUid);
  Put(item, DCM_FrameOfReferenceUID, series.studyUid + ".1");
  Put(item, DCM_Modality, series.study.modality.empty() ? "CT" : series.study.modality);
  Put(item, DCM_SeriesDescription,
      series.options.seriesDescription.empty() ? series.study.description
                                               : series.options.seriesDescription);
  Put(item, DCM_SeriesNumber, std::to_string(series.options.seriesNumber));
  Put(item, DCM_InstanceNumber, std::to_string(index + 1));
  for (const DcmTagKey& empty :
       {DCM_StudyDate, DCM_StudyTime, DCM_AccessionNumber, DCM_ReferringPhysicianName,
        DCM_PatientName, DCM_PatientID, DCM_PatientBirthDate, DCM_PatientSex, DCM_StudyID,
        DCM_Manufacturer, DCM_PositionReferenceIndicator, DCM_KVP, DCM_AcquisitionNumber}) {
    Put(item, empty, std::string());
  }
}

void PutPlacement(DcmItem& item, const Study& study, int index) {
  const dCoordSys3D& c = study.volume.GetCoordinates();
  const Vec3 axisX = ToVec3(c.axisX);
  const Vec3 axisY = ToVec3(c.axisY);
  const Vec3 axisZ = ToVec3(c.axisZ);
  Put(item, DCM_ImagePositionPatient, Decimals(WorldFromVoxel(study, {0.5, 0.5, index + 0.5})));
  Put(item, DCM_ImageOrientationPatient,
      Decimals(Normalised(axisX)) + "\\" + Decimals(Normalised(axisY)));
  Put(item, DCM_PixelSpacing, Decimal(Length(axisY)) + "\\" + Decimal(Length(axisX)));
  const Vec3 normal = Normalised(Cross(axisX, axisY));
  Put(item, DCM_SliceThickness, Decimal(std::abs(Dot(axisZ, normal))));
}

void PutPixels(DcmItem& item, const Series& series, const dSlice& slice, int index) {
  const SampleFormat format = FormatOf(series.options);
  const PackedSlice packed =
      PackSlice(series.study, SamplesOf(slice), series.options, static_cast<std::size_t>(index));
  Put(item, DCM_SamplesPerPixel, 1u);
  Put(item, DCM_PhotometricInterpretation,
      std::string(format.inverted ? "MONOCHROME1" : "MONOCHROME2"));
  Put(item, DCM_Rows, static_cast<unsigned>(slice.GetHeight()));
  Put(item, DCM_Columns, static_cast<unsigned>(slice.GetWidth()));
  Put(item, DCM_BitsAllocated, format.bitsAllocated);
  Put(item, DCM_BitsStored, format.bitsStored);
  Put(item, DCM_HighBit, format.highBit);
  Put(item, DCM_PixelRepresentation, format.isSigned ? 1u : 0u);
  Put(item, DCM_RescaleIntercept, Decimal(packed.intercept));
  Put(item, DCM_RescaleSlope, Decimal(packed.slope));
  if (!series.study.unit.empty()) {
    Put(item, DCM_RescaleType, series.study.unit);
  }
  if (series.study.windowWidth > 0 && !format.inverted) {
    Put(item, DCM_WindowCenter, Decimal(series.study.windowCentre));
    Put(item, DCM_WindowWidth, Decimal(series.study.windowWidth));
  }
  // Width and height of a slice have 16 bits each.
  const auto count = static_cast<unsigned long>(packed.samples.size());
  OFCondition condition;
  if (format.bitsAllocated == 8) {
    const std::vector<Uint8> bytes(packed.samples.begin(), packed.samples.end());
    condition = item.putAndInsertUint8Array(DCM_PixelData, bytes.data(), count);
  } else {
    condition = item.putAndInsertUint16Array(DCM_PixelData, packed.samples.data(), count);
  }
  if (condition.bad()) {
    throw Error(std::string("the pixels can't be stored (") + condition.text() + ")");
  }
}

/// The toolkit's JPEG-LS encoder writes beyond its buffer, which is measured by the plain picture,
/// when that is smaller than the stream's own headers.
void CheckEncoder(const Study& study, const DicomWriteOptions& options) {
  const int pixels = study.volume.GetSizeX() * study.volume.GetSizeY();
  if (options.encoding == DicomEncoding::JpegLsLossless && pixels < kLeastJpegLsPixels) {
    throw Error("slices of less than " + std::to_string(kLeastJpegLsPixels) +
                " pixels can't be written as JPEG-LS");
  }
}

struct Syntax {
  E_TransferSyntax syntax;
  std::unique_ptr<DcmRepresentationParameter> parameter;
};

Syntax SyntaxOf(DicomEncoding encoding) {
  switch (encoding) {
    case DicomEncoding::ExplicitLittle:
      return {EXS_LittleEndianExplicit, nullptr};
    case DicomEncoding::ImplicitLittle:
      return {EXS_LittleEndianImplicit, nullptr};
    case DicomEncoding::ExplicitBig:
      return {EXS_BigEndianExplicit, nullptr};
    case DicomEncoding::Rle:
      return {EXS_RLELossless, nullptr};
    case DicomEncoding::JpegLossless:
      return {EXS_JPEGProcess14SV1, std::make_unique<DJ_RPLossless>()};
    case DicomEncoding::JpegLsLossless:
      return {EXS_JPEGLSLossless, std::make_unique<DJLSRepresentationParameter>()};
  }
  throw Error("there is no such encoding");
}

void WriteFile(const Series& series, const dSlice& slice, int index, const fs::path& path) {
  DcmFileFormat file;
  DcmDataset& dataset = *file.getDataset();
  PutIdentity(dataset, series, index);
  PutPlacement(dataset, series.study, index);
  PutPixels(dataset, series, slice, index);
  const Syntax syntax = SyntaxOf(series.options.encoding);
  OutputFile output(path);
  OFCondition condition = dataset.chooseRepresentation(syntax.syntax, syntax.parameter.get());
  if (condition.good()) {
    condition = file.saveFile(OFFilename(output.TemporaryPath().c_str()), syntax.syntax,
                              EET_ExplicitLength);
  }
  if (condition.bad()) {
    throw Error("can't write " + Quoted(path.string()) + ": " + condition.text());
  }
  // The toolkit may learn of a full disk after it has said that all is well.
  try {
    OpenDicom(output.TemporaryPath());
  } catch (const Error&) {
    throw Error("can't write " + Quoted(path.string()) + ": the disk is full");
  }
  output.Commit();
}

/// Makes the folder; true when it is new. It must hold nothing yet, unless the options allow it.
bool PrepareFolder(const fs::path& folder, const DicomWriteOptions& options) {
  std::error_code error;
  if (!fs::exists(folder, error)) {
    if (!fs::create_directories(folder, error)) {
      throw Error("can't make the folder " + Quoted(folder.string()) + ": " + error.message());
    }
    return true;
  }
  if (!fs::is_directory(folder, error)) {
    throw Error(Quoted(folder.string()) + " is no folder");
  }
  if (!options.intoExistingFolder && !fs::is_empty(folder, error)) {
    throw Error("the folder " + Quoted(folder.string()) + " is not empty");
  }
  return false;
}

/// Removes what was written when something goes wrong before `Keep`.
class WrittenFiles {
 public:
  explicit WrittenFiles(fs::path newFolder) : m_newFolder(std::move(newFolder)) {}
  ~WrittenFiles() {
    std::error_code ignored;
    for (const fs::path& file : m_files) {
      fs::remove(file, ignored);
    }
    if (!m_newFolder.empty()) {
      fs::remove(m_newFolder, ignored);
    }
  }
  WrittenFiles(const WrittenFiles&) = delete;
  WrittenFiles& operator=(const WrittenFiles&) = delete;

  void Add(const fs::path& file) { m_files.push_back(file); }
  std::vector<fs::path> Keep() {
    m_newFolder.clear();
    return std::exchange(m_files, {});
  }

 private:
  fs::path m_newFolder;
  std::vector<fs::path> m_files;
};

std::string FileName(int seriesNumber, int index) {
  char name[48];
  std::snprintf(name, sizeof name, "S%03d-%05d.dcm", seriesNumber, index + 1);
  return name;
}

void CheckWritable(const Study& study, const DicomWriteOptions& options) {
  if (!study.volume.IsValid()) {
    throw Error("the study is empty");
  }
  FormatOf(options);
  CheckEncoder(study, options);
  const auto count = static_cast<std::size_t>(study.volume.GetSliceCount());
  if (!options.sliceSlopes.empty() && options.sliceSlopes.size() != count) {
    throw Error("the number of slopes is not that of the slices");
  }
}

}  // namespace

std::vector<fs::path> WriteDicomSeries(const Study& study, const fs::path& folder,
                                       const DicomWriteOptions& options, const Progress& progress) {
  RegisterDicomCodecs();
  CheckWritable(study, options);
  const ContentHash studyHash = StudyHash(study);
  const ContentHash seriesHash = SeriesHash(studyHash, options);
  const Series series{study, options, studyHash.Uid(), seriesHash.Uid(), seriesHash};

  const bool isNew = PrepareFolder(folder, options);
  WrittenFiles files(isNew ? folder : fs::path());
  const double count = study.volume.GetSliceCount();
  int index = 0;
  for (const dSlice& slice : study.volume.GetSliceList()) {
    Report(progress, index / count, "writing");
    const fs::path path = folder / FileName(options.seriesNumber, index);
    WriteFile(series, slice, index++, path);
    files.Add(path);
  }
  Report(progress, 1, "written");
  return files.Keep();
}

}  // namespace study
