#ifndef VORL_APPS_CLI_TISSUE_H
#define VORL_APPS_CLI_TISSUE_H

/// @file
/// Finding the body on a cut, and places where there is something to measure.

#include <cli/Statistics.h>
#include <study/Study.h>

#include <cstdint>
#include <optional>
#include <vector>

namespace cli {

/// The body: the largest connected area of bright pixels, as `PartingValue` parts them from the
/// dark ones.
class Tissue {
 public:
  /// Looks for it on a cut, which must outlive this.
  explicit Tissue(const study::Study& cut);

  /// From the body's left to its right edge, a fifth of its height above `cursor` (or as near to
  /// that as it reaches). Empty where there is no body.
  std::optional<PlaneLine> LineAcross(const PlanePoint& cursor) const;
  /// The most even rectangle that lies in the body, about a sixth of it wide, smaller ones where
  /// there is no room; its edges are those of pixels. Neither the horizontal and the vertical line
  /// through `cursor` nor `line` come near it. Empty where there is no room at all.
  std::optional<PlaneRect> EvenRect(const PlanePoint& cursor,
                                    const std::optional<PlaneLine>& line) const;

 private:
  /// Pixels, the last column and row excluded.
  struct Box {
    int left, top, right, bottom;
  };
  class Sums;

  void MarkBright();
  void KeepLargestArea();
  std::size_t At(int i, int j) const {
    return static_cast<std::size_t>(j) * static_cast<std::size_t>(m_grid.width) +
           static_cast<std::size_t>(i);
  }
  std::optional<PlaneRect> EvenRect(const Sums& sums, int width, int height,
                                    const PlanePoint& cursor,
                                    const std::optional<PlaneLine>& line) const;
  PlaneRect RectOf(const Box& box) const;

  const study::Study& m_cut;
  PixelGrid m_grid;
  std::vector<std::uint8_t> m_body;  ///< 1 for its pixels
  Box m_box{0, 0, 0, 0};             ///< around it; empty without one
};

}  // namespace cli

#endif
