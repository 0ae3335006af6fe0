#include <cli/Histogram.h>
#include <cli/Tissue.h>

#include <algorithm>
#include <cmath>
#include <limits>

namespace cli {
namespace {

constexpr double kLineAbove = 0.2;   ///< of the body's height
constexpr double kRectWidth = 0.16;  ///< of the body's width
constexpr double kRectShape = 0.75;  ///< height by width
constexpr double kDistance = 0.02;   ///< from the lines, of the body's width
constexpr double kSmaller = 0.75;
constexpr double kEven = 0.01;    ///< deviation by contrast, from which on a rectangle is even
constexpr int kSmallestRect = 3;  ///< cells
constexpr int kMostCells = 1024;  ///< in each direction

}  // namespace

/// Sums over rectangles in four steps: of bright pixels, their samples and the squares of those.
/// All are whole numbers, which are exact up to 2^53.
class Tissue::Sums {
 public:
  explicit Sums(const Tissue& tissue)
      : m_columns(tissue.m_grid.width + 1),
        m_sums(static_cast<std::size_t>(m_columns) *
               static_cast<std::size_t>(tissue.m_grid.height + 1)) {
    for (int j = 0; j < tissue.m_grid.height; ++j) {
      Sum row;
      for (int i = 0; i < tissue.m_grid.width; ++i) {
        const std::size_t at = tissue.At(i, j);
        const double value = tissue.m_bright[at] != 0 ? tissue.m_samples[at] : 0;
        row += {static_cast<double>(tissue.m_bright[at]), value, value * value};
        m_sums[At(i + 1, j + 1)] = m_sums[At(i + 1, j)];
        m_sums[At(i + 1, j + 1)] += row;
      }
    }
  }

  /// The variance of the samples; negative unless all pixels are bright.
  double Variance(const Box& box) const {
    Sum sum = m_sums[At(box.right, box.bottom)];
    sum += m_sums[At(box.left, box.top)];
    sum -= m_sums[At(box.right, box.top)];
    sum -= m_sums[At(box.left, box.bottom)];
    const double pixels = static_cast<double>(box.right - box.left) * (box.bottom - box.top);
    if (sum.count != pixels) {
      return -1;
    }
    const double mean = sum.samples / pixels;
    return std::max(0.0, sum.squares / pixels - mean * mean);
  }

 private:
  struct Sum {
    double count = 0;
    double samples = 0;
    double squares = 0;

    void operator+=(const Sum& more) {
      count += more.count;
      samples += more.samples;
      squares += more.squares;
    }
    void operator-=(const Sum& less) {
      count -= less.count;
      samples -= less.samples;
      squares -= less.squares;
    }
  };

  std::size_t At(int i, int j) const {
    return static_cast<std::size_t>(j) * static_cast<std::size_t>(m_columns) +
           static_cast<std::size_t>(i);
  }

  int m_columns;
  std::vector<Sum> m_sums;
};

Tissue::Tissue(const study::Study& cut) : m_cut(cut), m_pixels(cut), m_grid(m_pixels) {
  TakeSamples();
  MarkBright();
  FindBody();
}

// What is left over at the right and lower edges, less than a cell, is not searched.
void Tissue::TakeSamples() {
  const auto pixelsPerCell = [](int pixels) { return (pixels + kMostCells - 1) / kMostCells; };
  m_columns = pixelsPerCell(m_pixels.width);
  m_rows = pixelsPerCell(m_pixels.height);
  m_grid.spacing *= m_columns;
  m_grid.spacingDown *= m_rows;
  m_grid.width /= m_columns;
  m_grid.height /= m_rows;
  const auto samples = study::SamplesOf(m_cut.volume.GetSliceList().front());
  m_samples.reserve(At(0, m_grid.height));
  for (int j = 0; j < m_grid.height; ++j) {
    const std::size_t row =
        static_cast<std::size_t>(MiddleRow(j)) * static_cast<std::size_t>(m_pixels.width);
    for (int i = 0; i < m_grid.width; ++i) {
      m_samples.push_back(samples[row + static_cast<std::size_t>(MiddleColumn(i))]);
    }
  }
}

void Tissue::MarkBright() {
  m_dark = PartingValue(HistogramOf(m_cut));
  double sums[2] = {0, 0};
  double counts[2] = {0, 0};
  m_bright.reserve(m_samples.size());
  for (const std::uint16_t sample : m_samples) {
    const std::uint8_t isBright = sample > m_dark ? 1 : 0;
    m_bright.push_back(isBright);
    sums[isBright] += sample;
    counts[isBright] += 1;
  }
  m_contrast = sums[1] / std::max(counts[1], 1.0) - sums[0] / std::max(counts[0], 1.0);
}

void Tissue::FindBody() {
  m_body = m_bright;
  std::vector<std::uint32_t> areas(m_body.size());  // each pixel's number, 0 for none yet
  std::vector<std::size_t> open;
  std::uint32_t count = 0;
  std::uint32_t largest = 0;
  std::size_t largestSize = 0;
  for (std::size_t seed = 0; seed < m_body.size(); ++seed) {
    if (m_body[seed] == 0 || areas[seed] != 0) {
      continue;
    }
    ++count;
    std::size_t size = 0;
    const auto visit = [&](std::size_t at) {
      if (m_body[at] != 0 && areas[at] == 0) {
        areas[at] = count;
        open.push_back(at);
        ++size;
      }
    };
    const auto width = static_cast<std::size_t>(m_grid.width);
    for (visit(seed); !open.empty();) {
      const std::size_t at = open.back();
      open.pop_back();
      const std::size_t column = at % width;
      if (column > 0) {
        visit(at - 1);
      }
      if (column + 1 < width) {
        visit(at + 1);
      }
      if (at >= width) {
        visit(at - width);
      }
      if (at + width < m_body.size()) {
        visit(at + width);
      }
    }
    if (size > largestSize) {
      largestSize = size;
      largest = count;
    }
  }
  if (largest == 0) {
    return;
  }
  m_box = {m_grid.width, m_grid.height, 0, 0};
  for (int j = 0; j < m_grid.height; ++j) {
    for (int i = 0; i < m_grid.width; ++i) {
      const bool isBody = areas[At(i, j)] == largest;
      m_body[At(i, j)] = isBody ? 1 : 0;
      if (isBody) {
        m_box = {std::min(m_box.left, i), std::min(m_box.top, j), std::max(m_box.right, i + 1),
                 std::max(m_box.bottom, j + 1)};
      }
    }
  }
}

PlaneRect Tissue::RectOf(const Box& box) const {
  const auto x = [this](int i) { return m_grid.left + i * m_grid.spacing; };
  const auto y = [this](int j) { return m_grid.top + j * m_grid.spacingDown; };
  return {x(box.left), y(box.top), x(box.right), y(box.bottom)};
}

std::optional<PlaneLine> Tissue::LineAcross(const PlanePoint& cursor) const {
  if (m_box.right <= m_box.left) {
    return std::nullopt;
  }
  const double wanted = (cursor.y - m_grid.top) / m_grid.spacingDown -
                        kLineAbove * static_cast<double>(m_box.bottom - m_box.top);
  const int row =
      static_cast<int>(std::clamp(std::floor(wanted), double(m_box.top), double(m_box.bottom - 1)));
  const auto begin = m_body.begin() + static_cast<std::ptrdiff_t>(At(0, row));
  const auto end = begin + m_grid.width;
  const auto first = std::find(begin, end, 1) - begin;
  const auto behind =
      std::find(std::make_reverse_iterator(end), std::make_reverse_iterator(begin), 1).base() -
      begin;
  // From the middles of the outermost cells on to the edges.
  const auto samples = study::SamplesOf(m_cut.volume.GetSliceList().front())
                           .subspan(static_cast<std::size_t>(MiddleRow(row)) *
                                    static_cast<std::size_t>(m_pixels.width));
  const auto isBright = [&](int column) {
    return samples[static_cast<std::size_t>(column)] > m_dark;
  };
  int left = MiddleColumn(static_cast<int>(first));
  int right = MiddleColumn(static_cast<int>(behind) - 1) + 1;
  while (left > 0 && isBright(left - 1)) {
    --left;
  }
  while (right < m_pixels.width && isBright(right)) {
    ++right;
  }
  const double y = m_pixels.CentreY(MiddleRow(row));
  return PlaneLine{{m_pixels.left + left * m_pixels.spacing, y},
                   {m_pixels.left + right * m_pixels.spacing, y}};
}

Tissue::Candidate Tissue::MostEven(const Sums& sums, int width, int height,
                                   const PlanePoint& cursor,
                                   const std::optional<PlaneLine>& line) const {
  const double distance = kDistance * (m_box.right - m_box.left) * m_grid.spacing;
  const auto isClose = [distance](double position, double low, double high) {
    return position > low - distance && position < high + distance;
  };
  Candidate best;
  for (int j = m_box.top; j + height <= m_box.bottom; ++j) {
    for (int i = m_box.left; i + width <= m_box.right; ++i) {
      const Box box{i, j, i + width, j + height};
      const double variance = sums.Variance(box);
      if (variance < 0 || variance >= best.variance) {
        continue;
      }
      const PlaneRect rect = RectOf(box);
      if (!isClose(cursor.x, rect.left, rect.right) && !isClose(cursor.y, rect.top, rect.bottom) &&
          !(line && isClose(line->start.y, rect.top, rect.bottom))) {
        best = {rect, variance};
      }
    }
  }
  return best;
}

std::optional<PlaneRect> Tissue::EvenRect(const PlanePoint& cursor,
                                          const std::optional<PlaneLine>& line) const {
  const Sums sums(*this);
  Candidate best;
  for (double width = kRectWidth * (m_box.right - m_box.left); width >= kSmallestRect;
       width *= kSmaller) {
    const int columns = static_cast<int>(std::lround(width));
    const double height = width * kRectShape * m_grid.spacing / m_grid.spacingDown;
    const int rows = std::max(1, static_cast<int>(std::lround(height)));
    const Candidate candidate = MostEven(sums, columns, rows, cursor, line);
    if (candidate.variance < best.variance) {
      best = candidate;
    }
    if (best.variance <= kEven * kEven * m_contrast * m_contrast) {
      break;
    }
  }
  return best.rect;
}

}  // namespace cli
