#include <study/Error.h>
#include <study/OutputFile.h>
#include <study/Pictures.h>
#include <vorl/Data/dDIB.h>
#include <vorl/IO/File/opDIB2Ima.h>

#include <algorithm>
#include <cctype>
#include <string>

namespace study {

void SaveBmp(const dImage& image, const std::filesystem::path& path, bool ascending) {
  const bool hasLayout =
      image.GetDataType() == ImageDataType_U8 || image.GetDataType() == ImageDataType_U1;
  if (!image.IsValid() || !hasLayout) {
    throw Error("only images of 1 or 8 bits can be written as BMP");
  }
  OutputFile output(path);
  dDIB bitmap;
  bitmap = image;
  bitmap.ResetPalette(ascending);
  if (!bitmap.IsValid() || !bitmap.Save(output.TemporaryPath().string().c_str(), true)) {
    throw Error("can't write " + Quoted(path.string()) + ": " +
                static_cast<const char*>(bitmap.GetStatus()));
  }
  output.Commit();
}

void LoadBmp(const std::filesystem::path& path, dImage& image) {
  opDIB2Ima reader;
  if (!reader.Convert(path.string().c_str(), image)) {
    throw Error("can't read " + Quoted(path.string()) + ": " +
                static_cast<const char*>(reader.GetStatus()));
  }
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
