#include <study/Error.h>
#include <study/OutputFile.h>
#include <study/Pictures.h>
#include <vorl/Data/dImaDescriptorDIB.h>

#include <algorithm>
#include <cctype>
#include <cstring>
#include <string>

namespace study {
namespace {

/// A copy whose rows are as long as bitmap files want them.
void CopyAligned(const dImage& image, dImage& copy) {
  if (!copy.Init(image.GetWidth(), image.GetHeight(), image.GetDataType(),
                 image.GetChannelSequence(), image.GetDataOrder(), 4) ||
      !copy.Fill(0)) {
    throw Error("no memory for the picture");
  }
  const unsigned long bytes = std::min(image.GetBytesPerRow(), copy.GetBytesPerRow());
  for (int y = 0; y < static_cast<int>(image.GetHeight()); ++y) {
    std::memcpy(copy.GetRowPtr(y), image.GetRowPtr(y), bytes);
  }
}

}  // namespace

void SaveBmp(const dImage& image, const std::filesystem::path& path) {
  if (!image.IsValid() || image.GetDataType() != ImageDataType_U8) {
    throw Error("only images of 8 bits can be written as BMP");
  }
  OutputFile output(path);
  dImage aligned;
  CopyAligned(image, aligned);
  dImaDescriptorDIB descriptor;
  const bool written = descriptor.Init(aligned) != nullptr &&
                       descriptor.Save(output.TemporaryPath().string().c_str(), true);
  if (!written) {
    throw Error("can't write " + Quoted(path.string()) + ": " +
                static_cast<const char*>(descriptor.GetStatus()));
  }
  output.Commit();
}

void SavePicture(const dImage& image, const std::filesystem::path& path) {
  std::string extension = path.extension().string();
  std::transform(extension.begin(), extension.end(), extension.begin(),
                 [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
  if (extension == ".png") {
    SavePng(image, path);
  } else if (extension == ".bmp") {
    SaveBmp(image, path);
  } else {
    throw Error("the name " + Quoted(path.string()) + " must end in .png or .bmp");
  }
}

}  // namespace study
