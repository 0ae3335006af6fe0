#ifndef VORL_TESTS_APPS_CLI_RENDERFIXTURE_H
#define VORL_TESTS_APPS_CLI_RENDERFIXTURE_H

/// @file
/// Drawing sheets with the tool and finding the parts of them.

#include "CutFixture.h"

#include <array>
#include <map>
#include <string>

namespace cli_test {

/// What a sheet is drawn with.
inline constexpr unsigned kAxialColour = 0xDC6464;
inline constexpr unsigned kCoronalColour = 0x5FB978;
inline constexpr unsigned kSagittalColour = 0x5A9BE6;
inline constexpr unsigned kProjectionColour = 0x82878C;
inline constexpr unsigned kTextColour = 0xAFB4B9;
inline constexpr unsigned kBarColour = 0x52575F;
inline constexpr unsigned kSheetColour = 0x1A1B1E;

/// A picture's pixels: from (left, top) up to, not including, (right, bottom). Its outline of one
/// pixel stands around it.
struct Frame {
  int left = 0;
  int top = 0;
  int right = 0;
  int bottom = 0;

  int Width() const { return right - left; }
  int Height() const { return bottom - top; }
};

/// The frames of a sheet.
struct Frames {
  Frame axial, projection, coronal, sagittal;
};

/// The only complete outline of at least 12 x 12 pixels in this colour; fails the test when there
/// is none, or another one.
Frame FindFrame(const ColourPicture& sheet, unsigned colour);
Frames FindFrames(const ColourPicture& sheet);

/// The column, or the row, most of whose pixels inside the frame have this colour; fails the test
/// when it is less than half of them.
int FindColumn(const ColourPicture& sheet, const Frame& frame, unsigned colour);
int FindRow(const ColourPicture& sheet, const Frame& frame, unsigned colour);

inline bool IsGrey(unsigned colour) {
  return (colour & 0xFF) == (colour >> 8 & 0xFF) && (colour & 0xFF) == (colour >> 16 & 0xFF);
}

/// A volume of 120 x 100 x 120 mm around the origin with a box in it: from (-30, -30, -30) to
/// (30, 20, 15), whose value is 1000 HU; air around it. Voxels are 2 x 2 x 3 mm large, and the
/// middle between both values is 0 HU.
class Render : public CutFixture {
 protected:
  void SetUp() override;
  /// `vorl render` of a study file into "sheet.png"; a failure or a note fails the test.
  ColourPicture Sheet(const std::string& volume, Arguments more = {});
  /// The same of the box, whose upper half of values is lighter than level 127.
  ColourPicture BoxSheet(Arguments more = {});

  std::map<std::string, std::string> m_results;  ///< what the last sheet told, by name
};

}  // namespace cli_test

#endif
