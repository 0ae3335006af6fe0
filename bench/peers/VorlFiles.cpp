// vorl: bitmap files and binary data files.
#include <vorl/Data/dDIB.h>
#include <vorl/IO/BinaryDataIO.h>

#include <cstring>
#include <memory>
#include <vector>

#include "../ImageStudy.h"
#include "../ScratchFile.h"
#include "Checks.h"
#include "Contest.h"
#include "Works.h"

namespace peers {
namespace {

constexpr char kName[] = "vorl";

std::shared_ptr<dDIB> MakeBitmap() {
  auto bitmap = std::make_shared<dDIB>(kImageEdge, kImageEdge, short{3}, short{8});
  std::memcpy(bitmap->GetDataPtr(), Image24().data(), Image24().size());
  return bitmap;
}

Contender SaveBitmap() {
  const auto file = std::make_shared<bench::ScratchFile>(".bmp");
  const auto bitmap = MakeBitmap();
  return {[=] { return bitmap->Save(file->Name(), true); },
          [=] { return CheckBitmapFile(file->Name()); }};
}

Contender LoadBitmap() {
  const auto file = std::make_shared<bench::ScratchFile>(".bmp");
  const auto bitmap = MakeBitmap();
  bitmap->Save(file->Name(), true);
  return {[=] { return bitmap->Init(file->Name()); },
          [=] { return CheckBitmap(static_cast<const std::uint8_t*>(bitmap->GetDataPtr())); }};
}

/// The slices of the volume as images.
class Study : public bench::ImageStudy {
 public:
  Study() : ImageStudy(kDepth) {}

  void TakeVolume() {
    const std::uint16_t* slice = Volume().data();
    for (dImage& image : Images()) {
      image.Init(kWidth, kHeight, ImageDataType_U16, "G", ImageDataOrder_Pixel, 2);
      std::memcpy(image.GetDataPtr(), slice, image.GetImageSize());
      slice += kSliceVoxels;
    }
  }
  std::string Check() const {
    const std::uint16_t* slice = Volume().data();
    for (const dImage& image : Images()) {
      if (image.GetNumDataSamples() != kSliceVoxels ||
          std::memcmp(image.GetDataPtr(), slice, image.GetImageSize()) != 0) {
        return "wrong: other pixels";
      }
      slice += kSliceVoxels;
    }
    return "";
  }
};

Contender WriteStudy() {
  const auto file = std::make_shared<bench::ScratchFile>(".bdf");
  const auto study = std::make_shared<Study>();
  study->TakeVolume();
  return {[=] { return study->WriteFile(file->Name(), "Study"); },
          [=] {
            Study written;
            return written.ReadFile(file->Name(), "Study") ? written.Check() : "wrong: no study";
          }};
}

Contender ReadStudy() {
  const auto file = std::make_shared<bench::ScratchFile>(".bdf");
  const auto study = std::make_shared<Study>();
  study->TakeVolume();
  study->WriteFile(file->Name(), "Study");
  return {[=] { return study->ReadFile(file->Name(), "Study"); }, [=] { return study->Check(); }};
}

}  // namespace

void EnterVorlFiles() {
  Enter(BitmapSaving(), kName, SaveBitmap);
  Enter(BitmapLoading(), kName, LoadBitmap);
  Enter(StudyWriting(), kName, WriteStudy);
  Enter(StudyReading(), kName, ReadStudy);
}

}  // namespace peers
