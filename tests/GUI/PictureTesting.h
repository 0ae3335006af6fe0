#ifndef VORL_TESTS_GUI_PICTURETESTING_H
#define VORL_TESTS_GUI_PICTURETESTING_H

/// @file
/// Pictures that are compared with stored ones, which were looked at.
///
/// The stored ones are the same on every system: what is drawn is, pixel for pixel. Only letters
/// are not, since fonts differ; see `HasStoredFont`.

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <string>

#include "Canvas.h"

namespace gui_testing {

inline std::string PicturePath(const std::string& name) {
  return std::string(VORL_REFERENCE_PICTURES "/") + name + ".bmp";
}

inline bool UpdatesPictures() {
  return std::getenv("VORL_UPDATE_PICTURES") != nullptr;
}

/// How many pixels of a picture differ from a stored one of its size. They become red in
/// `difference`, a copy of the picture, and the others pale.
inline int CountDifferences(const Canvas& actual, const dImage& expected, Canvas& difference) {
  int count = 0;
  for (int y = 0; y < actual.Height(); ++y) {
    auto* row = static_cast<unsigned char*>(difference.Bitmap().GetRowPtr(y));
    for (int x = 0; x < actual.Width(); ++x) {
      const unsigned colour = actual.At(x, y);
      const bool differs = colour != PixelOf(expected, x, y);
      count += differs ? 1 : 0;
      for (int channel = 0; channel < 3; ++channel) {
        const unsigned pale = 192 + (colour >> (16 - 8 * channel) & 255U) / 4;
        row[3 * x + channel] = static_cast<unsigned char>(!differs ? pale : channel == 2 ? 255 : 0);
      }
    }
  }
  return count;
}

/// Compares a picture with the stored one of a name, or with `VORL_UPDATE_PICTURES` in the
/// environment stores it. One that differs is left, with a picture of the difference, in the folder
/// for temporary files.
inline void ExpectPicture(Canvas& actual, const std::string& name) {
  const std::string path = PicturePath(name);
  if (UpdatesPictures()) {
    ASSERT_TRUE(actual.Bitmap().Save(path.c_str(), true)) << actual.Bitmap().GetStatus();
  }
  const dDIB expected(path.c_str());
  ASSERT_TRUE(expected.IsValid()) << expected.GetStatus();
  ASSERT_EQ(static_cast<int>(expected.GetWidth()), actual.Width()) << name;
  ASSERT_EQ(static_cast<int>(expected.GetHeight()), actual.Height()) << name;
  Canvas difference(actual.Width(), actual.Height());
  const int count = CountDifferences(actual, expected, difference);
  if (count == 0) {
    return;
  }
  const std::filesystem::path folder = std::filesystem::temp_directory_path();
  const std::string actualPath = (folder / (name + "-actual.bmp")).string();
  const std::string differencePath = (folder / (name + "-difference.bmp")).string();
  actual.Bitmap().Save(actualPath.c_str(), true);
  difference.Bitmap().Save(differencePath.c_str(), true);
  ADD_FAILURE() << name << ": " << count << " pixels differ, "
                << 100.0 * count / (actual.Width() * actual.Height()) << " percent\n  the picture "
                << actualPath << "\n  the difference " << differencePath;
}

/// Whether the letters here are those of the stored pictures. Where they are not, pictures with
/// texts cannot be compared.
inline bool HasStoredFont() {
  Canvas sample(160, 24);
  sample.Fill(static_cast<char>(0xFF));
  tagRECT box{2, 2, 158, 22};
  DrawTextA(sample, "0123456789.- mm Label HU", -1, &box, 0);
  const std::string path = PicturePath("Font");
  if (UpdatesPictures()) {
    EXPECT_TRUE(sample.Bitmap().Save(path.c_str(), true)) << sample.Bitmap().GetStatus();
  }
  const dDIB expected(path.c_str());
  EXPECT_TRUE(expected.IsValid()) << expected.GetStatus();
  Canvas difference(160, 24);
  return expected.IsValid() && CountDifferences(sample, expected, difference) == 0;
}

}  // namespace gui_testing

#endif
