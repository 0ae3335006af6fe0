#ifndef VORL_APPS_CLI_WINDOWS_H
#define VORL_APPS_CLI_WINDOWS_H

/// @file
/// Display windows: by name, by numbers, and from the data.

#include <study/Study.h>

#include <optional>
#include <string>

namespace cli {

/// A window in real values; black below, white above.
struct RealWindow {
  double centre = 0;
  double width = 1;
};

/// What the user asked for.
struct WindowChoice {
  enum class Kind { Input, Auto, Preset, Numbers };
  Kind kind = Kind::Input;
  RealWindow window;  ///< of a preset or of numbers
};

/// Empty text: the window that the input brings along. Else "auto", a preset's name, or
/// "CENTER,WIDTH". Throws `UsageError`.
WindowChoice ParseWindow(const std::string& option, const std::string& text);

/// "bone 500,2000, lung -600,1500, ...", in lines for the help.
std::string PresetList();

/// The window to show `study` with. An input that brings none is shown as with "auto".
RealWindow ResolveWindow(const WindowChoice& choice, study::Study& study);

/// From the value that half a percent of all voxels lie below to the one that half a percent lie
/// above; a volume of one value gets a window around it.
RealWindow AutoWindow(study::Study& study);

/// The same for pictures of the brightest voxels, in which nearly every ray meets soft tissue:
/// black up to the middle value of all that is not background, white a tenth above the value that
/// one voxel in 10,000 lies above. What is bright in a few places only, such as bones, stands out;
/// a few specks of metal do not make the rest dark. Where most of what is bright is the brightest
/// there is, all of it would be black: that is shown with `AutoWindow`.
RealWindow ProjectionWindow(study::Study& study);

/// For a picture of single things on black (samples of 0): what is drawn reaches from dark grey to
/// white, half a percent at both ends aside. Empty when nothing is drawn.
std::optional<RealWindow> DrawnWindow(const study::Study& picture);

/// How a window in real values is shown through the library's table of stored values.
///
/// The table holds the centre within 0 to 65536 and the width within 2 to 65536. A window that fits
/// is taken as it is (`factor` 1, `shift` 0); for any other the samples are first brought to
/// stored * factor + shift, which the table's window is then meant for.
struct TableWindow {
  double factor = 1;
  double shift = 0;
  int centre = 0;
  int width = 0;
};

TableWindow PlaceWindow(const RealWindow& window, const study::Study& study);

}  // namespace cli

#endif
