#ifndef VORL_APPS_CLI_TISSUE_H
#define VORL_APPS_CLI_TISSUE_H

/// @file
/// Finding the body on a cut, and places where there is something to measure.

#include <cli/Statistics.h>
#include <study/Study.h>

#include <cstdint>
#include <limits>
#include <optional>
#include <vector>

namespace cli {

/// The body: the largest connected area of bright pixels, as `PartingValue` parts them from the
/// dark ones.
///
/// *Memory.* Cuts of more than 1024 pixels in a direction are searched at every second, third ...
/// one, so that what is kept here stays below 50 MB.
class Tissue {
 public:
  /// Looks for it on a cut, which must outlive this.
  explicit Tissue(const study::Study& cut);

  /// From the body's left to its right edge, to the pixel, a fifth of its height above `cursor` (or
  /// as near to that as it reaches). Empty where there is no body.
  std::optional<PlaneLine> LineAcross(const PlanePoint& cursor) const;
  /// An even rectangle of bright pixels within the body's bounds: the most even one about a sixth
  /// of the body wide, a smaller one where that is not even enough. Its edges are those of pixels.
  /// Neither the horizontal and the vertical line through `cursor` nor `line` come near it. Empty
  /// where there is no room at all.
  std::optional<PlaneRect> EvenRect(const PlanePoint& cursor,
                                    const std::optional<PlaneLine>& line) const;

 private:
  /// Cells, the last column and row excluded.
  struct Box {
    int left, top, right, bottom;
  };
  struct Candidate {
    std::optional<PlaneRect> rect;
    double variance = std::numeric_limits<double>::infinity();
  };
  class Sums;

  void TakeSamples();
  void MarkBright();
  void FindBody();
  std::size_t At(int i, int j) const {
    return static_cast<std::size_t>(j) * static_cast<std::size_t>(m_grid.width) +
           static_cast<std::size_t>(i);
  }
  /// The pixel that counts.
  int MiddleColumn(int i) const { return i * m_columns + m_columns / 2; }
  int MiddleRow(int j) const { return j * m_rows + m_rows / 2; }
  Candidate MostEven(const Sums& sums, int width, int height, const PlanePoint& cursor,
                     const std::optional<PlaneLine>& line) const;
  PlaneRect RectOf(const Box& box) const;

  const study::Study& m_cut;
  PixelGrid m_pixels;
  /// Cells of `m_columns` x `m_rows` pixels, of which the one in the middle counts.
  PixelGrid m_grid;
  int m_columns = 1;
  int m_rows = 1;
  std::vector<std::uint16_t> m_samples;
  std::vector<std::uint8_t> m_bright;  ///< 1 for bright cells
  std::vector<std::uint8_t> m_body;    ///< 1 for those of the body
  std::uint16_t m_dark = 0;            ///< the largest sample that is not bright
  double m_contrast = 0;               ///< between the means of bright and dark cells
  Box m_box{0, 0, 0, 0};               ///< around the body; empty without one
};

}  // namespace cli

#endif
