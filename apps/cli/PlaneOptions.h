#ifndef VORL_APPS_CLI_PLANEOPTIONS_H
#define VORL_APPS_CLI_PLANEOPTIONS_H

/// @file
/// The options that place a plane or a view.

#include <study/Planes.h>

#include <string>

namespace CLI {
class App;
class Option;
}  // namespace CLI

namespace cli {

/// What the options of one command are called in its help.
struct PlaneHelp {
  std::string plane =
      "axial (default), coronal, sagittal, or oblique: axial,\nturned by 30,20,0 unless "
      "--rotate says otherwise";
  std::string centre =
      "A point of the plane in mm; where a size is given,\nthe middle of the picture "
      "(default: the volume's\nmiddle voxel)";
  std::string rotation =
      "Turn the plane about its centre by degrees: first\nabout its direction to the right, "
      "then about its\ndirection down, then about its normal";
  std::string size = "Pixels of the picture (default: the whole volume)";
  std::string spacing =
      "From pixel to pixel in both directions (default: the\nsmallest voxel spacing)";
  std::string group = "Plane";
};

/// --plane, --center, --rotate, --size and --spacing; the same for all commands that make pictures.
class PlaneOptions {
 public:
  /// Declares the options. Their texts are kept here, so this must live as long as `command`.
  void AddTo(CLI::App& command, const PlaneHelp& help = {});
  /// True when --plane or --rotate stands on the command line.
  bool NamesDirection() const { return NamesPlane() || !m_rotation.empty(); }
  /// True when --plane does.
  bool NamesPlane() const;
  /// The first of the options that stands on the command line, such as "--size"; else empty.
  std::string FirstGiven() const;
  /// The texts as values; what is not given is as in a new request. Throws `UsageError`.
  study::PlaneRequest Check() const;

 private:
  CLI::Option* m_planeOption = nullptr;
  std::string m_plane = "axial";
  std::string m_centre, m_rotation, m_size, m_spacing;
};

/// The plane of a name, "axial", "coronal" or "sagittal"; false for any other name.
bool FindPlane(const std::string& name, study::Plane& plane);

}  // namespace cli

#endif
