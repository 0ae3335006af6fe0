#include <cli/Command.h>
#include <cli/FilterOption.h>
#include <study/Error.h>

namespace cli {

void FilterOption::AddTo(CLI::App& command, const std::string& group) {
  AddText(command, "--filter", m_filter, "NAME",
          "nearest (default): the voxel around each point;\nlinear: interpolated between voxels",
          group);
}

bool FilterOption::CheckLinear() const {
  if (m_filter != "nearest" && m_filter != "linear") {
    throw UsageError("--filter: " + study::Quoted(m_filter) + " is not one of nearest, linear");
  }
  return m_filter == "linear";
}

}  // namespace cli
