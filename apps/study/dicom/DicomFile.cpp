#include <dcmtk/config/osconfig.h>

#include <dcmtk/dcmdata/dcpixseq.h>
#include <dcmtk/dcmdata/dcpxitem.h>
#include <study/Error.h>
#include <study/dicom/Codecs.h>
#include <study/dicom/DicomFile.h>
#include <study/dicom/Structure.h>

#include <cstring>
#include <fstream>

namespace study {
namespace {

std::string SyntaxText(E_TransferSyntax syntax, const std::string& uid) {
  std::string shown;
  for (const char c : uid.substr(0, 64)) {
    shown += c >= 0x20 && c < 0x7F ? c : '?';
  }
  return Quoted(syntax == EXS_Unknown ? "unknown" : DcmXfer(syntax).getXferName()) + " (" + shown +
         ")";
}

}  // namespace

bool LooksLikeDicom(const std::filesystem::path& path) {
  char head[132] = {};
  std::ifstream file(path, std::ios::binary);
  file.read(head, sizeof head);
  return file.gcount() == sizeof head && std::memcmp(head + 128, "DICM", 4) == 0;
}

std::unique_ptr<DcmFileFormat> OpenDicom(const std::filesystem::path& path) {
  RegisterDicomCodecs();
  const std::string syntax = CheckStructure(path);
  const E_TransferSyntax known = DcmXfer(syntax.c_str()).getXfer();
  // A compressed data set could hold anything: it cannot be looked through before it is parsed.
  if (!syntax.empty() && (known == EXS_Unknown || known == EXS_DeflatedLittleEndianExplicit)) {
    throw Error("its transfer syntax " + SyntaxText(known, syntax) + " is not supported");
  }
  auto file = std::make_unique<DcmFileFormat>();
  const OFCondition condition = file->loadFile(OFFilename(path.c_str()), EXS_Unknown, EGL_noChange,
                                               DCM_MaxReadLength, ERM_fileOnly);
  if (condition.bad()) {
    throw Error(std::string("the file is cut short or damaged (") + condition.text() + ")");
  }
  if (file->getDataset() == nullptr || file->getDataset()->card() == 0) {
    throw Error("the file is cut short or damaged (no data set)");
  }
  return file;
}

std::string TransferSyntaxText(DcmDataset& dataset) {
  const E_TransferSyntax syntax = dataset.getOriginalXfer();
  return SyntaxText(syntax, DcmXfer(syntax).getXferID());
}

bool CanDecode(E_TransferSyntax syntax) {
  switch (syntax) {
    case EXS_LittleEndianImplicit:
    case EXS_LittleEndianExplicit:
    case EXS_BigEndianExplicit:
    case EXS_RLELossless:
    case EXS_JPEGProcess1:
    case EXS_JPEGProcess2_4:
    case EXS_JPEGProcess6_8:
    case EXS_JPEGProcess10_12:
    case EXS_JPEGProcess14:
    case EXS_JPEGProcess14SV1:
    case EXS_JPEGLSLossless:
    case EXS_JPEGLSLossy:
      return true;
    default:
      return false;
  }
}

DcmPixelSequence* FragmentsOf(DcmDataset& dataset) {
  DcmElement* element = nullptr;
  dataset.findAndGetElement(DCM_PixelData, element);
  auto* pixels = dynamic_cast<DcmPixelData*>(element);
  if (pixels == nullptr) {
    return nullptr;
  }
  E_TransferSyntax syntax = EXS_Unknown;
  const DcmRepresentationParameter* parameter = nullptr;
  DcmPixelSequence* fragments = nullptr;
  pixels->getOriginalRepresentationKey(syntax, parameter);
  const bool found = pixels->getEncapsulatedRepresentation(syntax, parameter, fragments).good();
  return found ? fragments : nullptr;
}

std::uint64_t PixelBytesInFile(DcmDataset& dataset) {
  DcmPixelSequence* fragments = FragmentsOf(dataset);
  DcmElement* element = nullptr;
  if (fragments == nullptr) {
    dataset.findAndGetElement(DCM_PixelData, element);
    return element == nullptr ? 0 : element->getLength();
  }
  std::uint64_t total = 0;
  // The first item is a table of offsets.
  for (unsigned long i = 1; i < fragments->card(); ++i) {
    DcmPixelItem* item = nullptr;
    if (fragments->getItem(item, i).good() && item != nullptr) {
      total += item->getLength();
    }
  }
  return total;
}

}  // namespace study
