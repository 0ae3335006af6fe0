#include <study/Error.h>
#include <study/dicom/Attributes.h>
#include <study/dicom/DicomFile.h>
#include <study/dicom/Samples.h>
#include <study/dicom/SliceReader.h>

#include <cmath>

// How a header is read:
// 1. The file must hold one grey channel of 8 or 16 bits in a known encoding.
// 2. A multi-frame file must say where each frame lies; its values are looked up in the frame's own
//    groups, then in the shared ones, then in the data set.
// 3. Every number that the geometry or the values depend on must be there and plausible, because a
//    picture in the wrong place or at the wrong size is worse than none.

namespace study {
namespace {

constexpr unsigned kLargestSide = 32767;  // the volume operators step through cells in 16.16
constexpr long kMostFrames = 32767;
constexpr double kFarthestMm = 1e6;
constexpr double kLargestFactor = 1e12;

void CheckGrey(const Attributes& data) {
  const auto samples = data.Integer(DCM_SamplesPerPixel).value_or(1);
  const std::string colours = data.Text(DCM_PhotometricInterpretation);
  if (samples != 1 || (colours != "MONOCHROME1" && colours != "MONOCHROME2" && !colours.empty())) {
    throw Error("a colour image (" + (colours.empty() ? "no colour model" : colours) +
                "); only grey images make a volume");
  }
}

SampleFormat ReadFormat(const Attributes& data) {
  SampleFormat format;
  format.bitsAllocated = data.RequiredUnsigned(DCM_BitsAllocated);
  format.bitsStored = data.RequiredUnsigned(DCM_BitsStored);
  format.highBit = static_cast<unsigned>(
      data.Integer(DCM_HighBit).value_or(static_cast<long>(format.bitsStored) - 1));
  format.isSigned = data.Integer(DCM_PixelRepresentation).value_or(0) == 1;
  format.inverted = data.Text(DCM_PhotometricInterpretation) == "MONOCHROME1";
  if (!IsSupported(format)) {
    throw Error("unsupported samples: " + std::to_string(format.bitsAllocated) +
                " bits allocated, " + std::to_string(format.bitsStored) + " stored, high bit " +
                std::to_string(format.highBit));
  }
  return format;
}

bool IsPlausible(const Vec3& position) {
  return std::abs(position.x) <= kFarthestMm && std::abs(position.y) <= kFarthestMm &&
         std::abs(position.z) <= kFarthestMm;
}

void ReadSpacing(const Attributes& data, SliceHeader& header) {
  for (const DcmTagKey& tag :
       {DCM_PixelSpacing, DCM_ImagerPixelSpacing, DCM_NominalScannedPixelSpacing}) {
    const auto rowSpacing = data.Number(tag, 0);
    if (!rowSpacing) {
      continue;
    }
    const auto columnSpacing = data.Number(tag, 1);
    if (!columnSpacing || !(*rowSpacing > 0) || !(*columnSpacing > 0) ||
        *rowSpacing > kFarthestMm || *columnSpacing > kFarthestMm) {
      throw Error("the value of " + AttributeName(tag) + " is not valid");
    }
    header.grid.rowSpacing = *rowSpacing;
    header.grid.columnSpacing = *columnSpacing;
    header.hasSpacing = true;
    return;
  }
}

void ReadOrientation(const Attributes& data, SliceHeader& header) {
  if (!data.Has(DCM_ImageOrientationPatient)) {
    return;
  }
  const auto row = data.Vector(DCM_ImageOrientationPatient, 0);
  const auto column = data.Vector(DCM_ImageOrientationPatient, 3);
  const auto isUnit = [](const Vec3& v) { return std::abs(Length(v) - 1) <= 0.01; };
  if (!row || !column || !isUnit(*row) || !isUnit(*column) || std::abs(Dot(*row, *column)) > 0.01) {
    throw Error("the value of " + AttributeName(DCM_ImageOrientationPatient) +
                " is not a pair of perpendicular directions");
  }
  header.grid.rowDirection = Normalised(*row);
  header.grid.columnDirection = Normalised(*column);
  header.hasOrientation = true;
}

void ReadPlacement(const Attributes& data, SliceHeader& header) {
  ReadSpacing(data, header);
  ReadOrientation(data, header);
  header.position = data.Vector(DCM_ImagePositionPatient);
  const bool broken = data.Has(DCM_ImagePositionPatient) && !header.position;
  if (broken || (header.position && !IsPlausible(*header.position))) {
    throw Error("the value of " + AttributeName(DCM_ImagePositionPatient) + " is not valid");
  }
  if (header.position && !header.hasOrientation) {
    throw Error("it has a position but no " + AttributeName(DCM_ImageOrientationPatient));
  }
  const auto length = [&data](const DcmTagKey& tag) {
    const double value = std::abs(data.Number(tag).value_or(0));
    return value <= kFarthestMm ? value : 0.0;
  };
  header.thickness = length(DCM_SliceThickness);
  header.sliceSpacing = length(DCM_SpacingBetweenSlices);
}

std::string UnitOf(const Attributes& data, const std::string& modality) {
  const std::string type = data.Text(DCM_RescaleType);
  if (!type.empty() && type != "US") {
    return type;
  }
  if (modality == "CT") {
    return "HU";
  }
  return modality == "PT" ? data.Text(DCM_Units) : std::string();
}

void ReadWindow(const Attributes& data, SliceHeader& header) {
  const auto centre = data.Number(DCM_WindowCenter);
  const auto width = data.Number(DCM_WindowWidth);
  if (!centre || !width || !(*width > 0) || std::abs(*centre) > kLargestFactor ||
      *width > kLargestFactor) {
    return;
  }
  header.windowWidth = width;
  header.windowCentre = centre;
  if (header.format.inverted) {
    const SampleRange range = RangeOfFormat(header.format);
    header.windowCentre =
        (range.minimum + range.maximum) * header.slope + 2 * header.intercept - *centre;
  }
}

void ReadMeaning(const Attributes& data, SliceHeader& header) {
  header.slope = data.Number(DCM_RescaleSlope).value_or(1);
  header.intercept = data.Number(DCM_RescaleIntercept).value_or(0);
  const double size = std::abs(header.slope);
  if (!(size >= 1 / kLargestFactor) || size > kLargestFactor) {
    throw Error("the value of " + AttributeName(DCM_RescaleSlope) + " is not valid");
  }
  if (std::abs(header.intercept) > kLargestFactor) {
    throw Error("the value of " + AttributeName(DCM_RescaleIntercept) + " is not valid");
  }
  header.hasLookupTable = data.Has(DCM_ModalityLUTSequence);
  header.unit = UnitOf(data, header.modality);
  ReadWindow(data, header);
}

SliceHeader ReadOne(const Attributes& data) {
  SliceHeader header;
  header.seriesUid = data.Text(DCM_SeriesInstanceUID);
  header.seriesNumber = data.Integer(DCM_SeriesNumber);
  header.instanceNumber = data.Integer(DCM_InstanceNumber);
  header.modality = data.Text(DCM_Modality);
  header.description = data.Text(DCM_SeriesDescription);
  header.grid.columns = data.RequiredUnsigned(DCM_Columns);
  header.grid.rows = data.RequiredUnsigned(DCM_Rows);
  if (header.grid.columns < 1 || header.grid.rows < 1 || header.grid.columns > kLargestSide ||
      header.grid.rows > kLargestSide) {
    throw Error("an image of " + std::to_string(header.grid.columns) + " x " +
                std::to_string(header.grid.rows) + " pixels");
  }
  header.format = ReadFormat(data);
  ReadPlacement(data, header);
  ReadMeaning(data, header);
  return header;
}

/// Appends the items in which a frame's values may stand.
void AddGroups(DcmItem* groups, std::vector<DcmItem*>& scopes) {
  if (groups == nullptr) {
    return;
  }
  for (const DcmTagKey& tag :
       {DCM_PlanePositionSequence, DCM_PlaneOrientationSequence, DCM_PixelMeasuresSequence,
        DCM_PixelValueTransformationSequence, DCM_FrameVOILUTSequence}) {
    DcmItem* item = nullptr;
    if (groups->findAndGetSequenceItem(tag, item, 0).good() && item != nullptr) {
      scopes.push_back(item);
    }
  }
}

std::vector<SliceHeader> ReadFrames(DcmDataset& dataset, long count) {
  DcmSequenceOfItems* perFrame = nullptr;
  dataset.findAndGetSequence(DCM_PerFrameFunctionalGroupsSequence, perFrame);
  if (perFrame == nullptr || perFrame->card() != static_cast<unsigned long>(count)) {
    throw Error(std::to_string(count) + " frames in one file that does not say where each lies");
  }
  DcmItem* shared = nullptr;
  dataset.findAndGetSequenceItem(DCM_SharedFunctionalGroupsSequence, shared, 0);

  std::vector<SliceHeader> headers;
  for (long frame = 0; frame < count; ++frame) {
    std::vector<DcmItem*> scopes;
    AddGroups(perFrame->getItem(static_cast<unsigned long>(frame)), scopes);
    AddGroups(shared, scopes);
    scopes.push_back(&dataset);
    headers.push_back(ReadOne(Attributes(scopes)));
    headers.back().frame = static_cast<std::uint32_t>(frame);
    headers.back().instanceNumber = frame + 1;
  }
  return headers;
}

}  // namespace

std::vector<SliceHeader> ReadSliceHeaders(const std::filesystem::path& path,
                                          FileIdentity& identity) {
  const auto file = OpenDicom(path);
  DcmDataset& dataset = *file->getDataset();
  const Attributes data({&dataset});
  identity.seriesUid = data.Text(DCM_SeriesInstanceUID);
  if (PixelBytesInFile(dataset) == 0) {
    throw Error("it holds no pixel data");
  }
  CheckGrey(data);
  if (!CanDecode(dataset.getOriginalXfer())) {
    throw Error("its transfer syntax " + TransferSyntaxText(dataset) + " is not supported");
  }
  const long frames = data.Integer(DCM_NumberOfFrames).value_or(1);
  if (frames < 1 || frames > kMostFrames) {
    throw Error("it announces " + std::to_string(frames) + " frames");
  }
  std::vector<SliceHeader> headers;
  if (frames == 1 && !data.Has(DCM_PerFrameFunctionalGroupsSequence)) {
    headers.push_back(ReadOne(data));
  } else {
    headers = ReadFrames(dataset, frames);
  }
  for (SliceHeader& header : headers) {
    header.file = path;
  }
  return headers;
}

}  // namespace study
