#include <cli/Command.h>
#include <cli/PlaneOptions.h>
#include <cli/Values.h>

#include <CLI/CLI.hpp>
#include <array>
#include <utility>

namespace cli {
namespace {

/// How the oblique plane is turned unless the user says it.
constexpr study::Vec3 kObliqueTurn{30, 20, 0};

constexpr std::array<std::pair<const char*, study::Plane>, 3> kPlanes{
    {{"axial", study::Plane::Axial},
     {"coronal", study::Plane::Coronal},
     {"sagittal", study::Plane::Sagittal}}};

}  // namespace

bool FindPlane(const std::string& name, study::Plane& plane) {
  for (const auto& [known, value] : kPlanes) {
    if (name == known) {
      plane = value;
      return true;
    }
  }
  return false;
}

void PlaneOptions::AddTo(CLI::App& command, const PlaneHelp& help) {
  m_planeOption = AddText(command, "--plane", m_plane, "NAME", help.plane, help.group);
  AddText(command, "--center", m_centre, "X,Y,Z", help.centre, help.group);
  AddText(command, "--rotate", m_rotation, "X,Y,Z", help.rotation, help.group);
  AddText(command, "--size", m_size, "WxH", help.size, help.group);
  AddText(command, "--spacing", m_spacing, "MM", help.spacing, help.group);
}

bool PlaneOptions::NamesPlane() const {
  return m_planeOption->count() > 0;
}

std::string PlaneOptions::FirstGiven() const {
  if (NamesPlane()) {
    return "--plane";
  }
  return cli::FirstGiven({{"--center", &m_centre},
                          {"--rotate", &m_rotation},
                          {"--size", &m_size},
                          {"--spacing", &m_spacing}});
}

study::PlaneRequest PlaneOptions::Check() const {
  study::PlaneRequest plane;
  study::Vec3 turn;
  if (m_plane == "oblique") {
    turn = kObliqueTurn;
  } else if (!FindPlane(m_plane, plane.plane)) {
    throw UsageError("--plane: " + study::Quoted(m_plane) +
                     " is not one of axial, coronal, sagittal, oblique");
  }
  if (!m_rotation.empty()) {
    turn = ParseTriple("--rotate", m_rotation);
  }
  plane.turnAboutRight = turn.x;
  plane.turnAboutDown = turn.y;
  plane.turnAboutNormal = turn.z;
  if (!m_centre.empty()) {
    plane.centre = ParseTriple("--center", m_centre);
  }
  if (!m_size.empty()) {
    const std::vector<int> size = ParseSize("--size", m_size, 2, "WIDTHxHEIGHT");
    plane.width = size[0];
    plane.height = size[1];
  }
  if (!m_spacing.empty()) {
    plane.spacing = ParsePositive("--spacing", m_spacing);
  }
  return plane;
}

}  // namespace cli
