#include "DicomEdit.h"

#include <stdexcept>

namespace study_test {
namespace {

void Require(const OFCondition& condition) {
  if (condition.bad()) {
    throw std::runtime_error(condition.text());
  }
}

}  // namespace

void EditDicom(const std::filesystem::path& file, const std::function<void(DcmDataset&)>& change) {
  DcmFileFormat dicom;
  Require(dicom.loadFile(OFFilename(file.c_str())));
  dicom.loadAllDataIntoMemory();
  change(*dicom.getDataset());
  Require(dicom.saveFile(OFFilename(file.c_str()), dicom.getDataset()->getOriginalXfer()));
}

void SetAttribute(const std::filesystem::path& file, const DcmTagKey& tag,
                  const std::string& value) {
  EditDicom(file,
            [&](DcmDataset& dataset) { Require(dataset.putAndInsertString(tag, value.c_str())); });
}

void RemoveAttribute(const std::filesystem::path& file, const DcmTagKey& tag) {
  EditDicom(file, [&](DcmDataset& dataset) { Require(dataset.findAndDeleteElement(tag)); });
}

}  // namespace study_test
