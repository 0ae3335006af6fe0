#include <study/Error.h>
#include <study/dicom/Codecs.h>
#include <study/dicom/DicomFile.h>

#include <cstring>
#include <fstream>

namespace study {

bool LooksLikeDicom(const std::filesystem::path& path) {
  char head[132] = {};
  std::ifstream file(path, std::ios::binary);
  file.read(head, sizeof head);
  return file.gcount() == sizeof head && std::memcmp(head + 128, "DICM", 4) == 0;
}

std::unique_ptr<DcmFileFormat> OpenDicom(const std::filesystem::path& path) {
  RegisterDicomCodecs();
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
  const DcmXfer syntax(dataset.getOriginalXfer());
  return Quoted(syntax.getXferName()) + " (" + syntax.getXferID() + ")";
}

bool CanDecode(E_TransferSyntax syntax) {
  switch (syntax) {
    case EXS_LittleEndianImplicit:
    case EXS_LittleEndianExplicit:
    case EXS_BigEndianExplicit:
    case EXS_DeflatedLittleEndianExplicit:
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

}  // namespace study
