#include <cli/SheetPlan.h>

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

// 1. Choose what stands around the pictures: all of it, or less where they would become too small.
// 2. Take header and panel away from the sheet; what is left is the block of the views.
// 3. Find the scale at which the views fit into the block, which follows from its tighter
// direction.
// 4. Give the panel what the block does not need in the other direction, and some to the pictures.

namespace cli {
namespace {

constexpr std::array<std::pair<const char*, SheetLayout>, 4> kLayouts{
    {{"2x2", SheetLayout::Grid},
     {"row", SheetLayout::Row},
     {"column", SheetLayout::Column},
     {"main", SheetLayout::Main}}};

constexpr double kPanelBeside = 0.24;  ///< of the sheet's width, at least
constexpr double kPanelBelow = 0.2;    ///< of its height, at least
constexpr double kLargestPanel = 0.36;
/// Pictures get so much more than what they show needs where there is room.
constexpr double kMostSlack = 0.4;
/// What the small views beside a large one take of their block at most.
constexpr double kSmallMain = 0.36;
/// Views are made as if they were this much of the longest one: there must be room for text.
constexpr double kLeastShare = 0.3;
/// What a picture must be for the annotations to stay, in lines of text.
constexpr int kLeastWidth = 9;
constexpr int kLeastHeight = 6;
/// The same for the panel.
constexpr int kLeastPanelWidth = 12;
constexpr int kLeastPanelHeight = 8;

struct Furniture {
  bool header, panel, rulers, titles;
};
constexpr std::array<Furniture, 5> kFurniture{{{true, true, true, true},
                                               {false, true, true, true},
                                               {false, false, true, true},
                                               {false, false, false, true},
                                               {false, false, false, false}}};

int Width(const tagRECT& rect) {
  return static_cast<int>(rect.right - rect.left);
}

int Height(const tagRECT& rect) {
  return static_cast<int>(rect.bottom - rect.top);
}

/// Views that lie in columns and rows.
struct Grid {
  struct Cell {
    std::size_t view, column, row;
  };
  std::vector<Cell> cells;

  /// The largest extents of each column, or of each row.
  std::vector<double> Tracks(const std::array<ViewExtent, kViewCount>& extents,
                             bool isColumns) const {
    std::vector<double> tracks;
    for (const Cell& cell : cells) {
      const std::size_t track = isColumns ? cell.column : cell.row;
      tracks.resize(std::max(tracks.size(), track + 1));
      const ViewExtent& extent = extents[cell.view];
      tracks[track] = std::max(tracks[track], isColumns ? extent.width : extent.height);
    }
    return tracks;
  }
};

Grid GridOf(SheetLayout layout) {
  switch (layout) {
    case SheetLayout::Grid:
      return {{{0, 0, 0}, {1, 1, 0}, {2, 0, 1}, {3, 1, 1}}};
    case SheetLayout::Row:
      return {{{0, 0, 0}, {2, 1, 0}, {3, 2, 0}, {1, 3, 0}}};
    case SheetLayout::Column:
      return {{{0, 0, 0}, {2, 0, 1}, {3, 0, 2}, {1, 0, 3}}};
    case SheetLayout::Main:
      break;
  }
  return {{{0, 0, 0}}};
}

const Grid kBesideMain{{{2, 0, 0}, {3, 0, 1}, {1, 0, 2}}};

class Planner {
 public:
  Planner(const SheetRequest& request, const Furniture& furniture)
      : m_request(request),
        m_furniture(furniture),
        m_gap(std::max(2, request.lineHeight / 2)),
        m_grid(GridOf(request.layout)) {
    double longest = 0;
    for (const ViewExtent& extent : request.extents) {
      longest = std::max({longest, extent.width, extent.height});
    }
    m_extents = request.extents;
    for (ViewExtent& extent : m_extents) {
      extent.width = std::max(extent.width, kLeastShare * longest);
      extent.height = std::max(extent.height, kLeastShare * longest);
    }
    m_plan.hasRulers = furniture.rulers;
    const int frame = request.penWidth;
    m_plan.margins = {frame, frame, frame, frame};
    if (furniture.titles) {
      m_plan.margins.top = request.lineHeight + request.lineHeight / 3;
    }
    if (furniture.rulers) {
      m_plan.margins.left = request.rulerWidth;
      m_plan.margins.bottom = request.rulerHeight;
      m_plan.margins.right = request.lineHeight / 2;
    }
  }

  /// False when the pictures or the panel become too small.
  bool Plan() {
    tagRECT block{m_gap, m_gap, m_request.width - m_gap, m_request.height - m_gap};
    if (m_furniture.header) {
      m_plan.header = {block.left, block.top, block.right,
                       block.top + m_request.lineHeight * 3 / 2};
      block.top = m_plan.header.bottom + m_gap;
    }
    if (m_furniture.panel) {
      block = TakePanel(block);
    }
    Arrange(block);
    return IsLargeEnough();
  }

  const SheetPlan& GetPlan() const { return m_plan; }

 private:
  /// The two ways to part a block: what the panel takes lies at its right or at its lower end.
  tagRECT TakePanel(const tagRECT& block) {
    tagRECT beside = block;
    beside.right -= static_cast<LONG>(std::lround(kPanelBeside * m_request.width)) + m_gap;
    tagRECT below = block;
    below.bottom -= static_cast<LONG>(std::lround(kPanelBelow * m_request.height)) + m_gap;
    Arrange(below);
    const double scaleBelow = m_plan.mmPerPixel[0];
    const tagRECT usedBelow = m_used;
    Arrange(beside);
    if (m_plan.mmPerPixel[0] <= scaleBelow) {
      beside.right = std::max<LONG>(
          std::min<LONG>(beside.right, m_used.right),
          block.right - static_cast<LONG>(std::lround(kLargestPanel * m_request.width)) - m_gap);
      m_plan.panel = {beside.right + m_gap, block.top, block.right, block.bottom};
      return beside;
    }
    below.bottom = std::max<LONG>(
        std::min<LONG>(below.bottom, usedBelow.bottom),
        block.bottom - static_cast<LONG>(std::lround(kLargestPanel * m_request.height)) - m_gap);
    m_plan.panel = {block.left, below.bottom + m_gap, block.right, block.bottom};
    return below;
  }

  void Arrange(const tagRECT& block) {
    if (m_request.layout == SheetLayout::Main) {
      ArrangeMain(block);
    } else {
      m_used = Place(m_grid, block);
    }
  }

  /// The small views fill the block's height, the large one what remains.
  void ArrangeMain(const tagRECT& block) {
    const double scale =
        Scale(kBesideMain.Tracks(m_extents, false), Height(block), VerticalMargins());
    const double widest = kBesideMain.Tracks(m_extents, true)[0];
    const int wanted = static_cast<int>(std::ceil(widest / scale)) + HorizontalMargins();
    const int most = static_cast<int>(std::lround(kSmallMain * Width(block)));
    tagRECT large = block;
    large.right -= std::min(wanted, most) + m_gap;
    const tagRECT used = Place(m_grid, large);
    const tagRECT others{large.right + m_gap, block.top, block.right, block.bottom};
    Place(kBesideMain, others);
    m_used = {block.left, block.top, block.right - (large.right - used.right),
              std::max(used.bottom, block.top)};
    if (wanted < most) {
      m_used.bottom = block.bottom;
    }
  }

  int HorizontalMargins() const { return m_plan.margins.left + m_plan.margins.right; }
  int VerticalMargins() const { return m_plan.margins.top + m_plan.margins.bottom; }

  /// Millimetres per pixel at which tracks fit into a length.
  double Scale(const std::vector<double>& tracks, int length, int margins) const {
    double extent = 0;
    for (const double track : tracks) {
      extent += track;
    }
    const int count = static_cast<int>(tracks.size());
    const int pixels = length - count * margins - (count - 1) * m_gap;
    return extent / std::max(pixels, count);
  }

  /// Where the tracks of one direction begin and end. Each gets what it needs and some of the rest;
  /// what remains of that is left on both sides.
  std::vector<std::pair<LONG, LONG>> Spans(const std::vector<double>& tracks, LONG begin,
                                           int length, int margins, double scale,
                                           LONG& used) const {
    const int count = static_cast<int>(tracks.size());
    const auto pixels = [scale](double track) { return std::ceil(track / scale - 1e-6); };
    double pictures = 0;
    for (const double track : tracks) {
      pictures += pixels(track);
    }
    const double needed = pictures + count * margins + (count - 1) * m_gap;
    used = begin + static_cast<LONG>(std::min(needed, static_cast<double>(length)));
    const double rest = std::max(0.0, length - needed);
    const double more = std::min(rest, kMostSlack * pictures);
    double at = static_cast<double>(begin) + std::floor(0.5 * (rest - more));
    std::vector<std::pair<LONG, LONG>> spans;
    for (const double track : tracks) {
      const double size = pixels(track) * (1 + more / pictures) + margins;
      spans.emplace_back(static_cast<LONG>(std::floor(at)),
                         std::min(static_cast<LONG>(std::floor(at + size)), begin + length));
      at += size + m_gap;
    }
    return spans;
  }

  /// Places the views of a grid; returns the part of the block that they need.
  tagRECT Place(const Grid& grid, const tagRECT& block) {
    const std::vector<double> columns = grid.Tracks(m_extents, true);
    const std::vector<double> rows = grid.Tracks(m_extents, false);
    const double scale = std::max(Scale(columns, Width(block), HorizontalMargins()),
                                  Scale(rows, Height(block), VerticalMargins()));
    tagRECT used = block;
    const auto x = Spans(columns, block.left, Width(block), HorizontalMargins(), scale, used.right);
    const auto y = Spans(rows, block.top, Height(block), VerticalMargins(), scale, used.bottom);
    for (const Grid::Cell& cell : grid.cells) {
      m_plan.views[cell.view] = {x[cell.column].first, y[cell.row].first, x[cell.column].second,
                                 y[cell.row].second};
      m_plan.mmPerPixel[cell.view] = scale;
    }
    return used;
  }

  bool IsLargeEnough() const {
    const int line = m_request.lineHeight;
    if (m_furniture.panel && (Width(m_plan.panel) < kLeastPanelWidth * line ||
                              Height(m_plan.panel) < kLeastPanelHeight * line)) {
      return false;
    }
    return std::all_of(m_plan.views.begin(), m_plan.views.end(), [&](const tagRECT& view) {
      return Width(view) - HorizontalMargins() >= kLeastWidth * line &&
             Height(view) - VerticalMargins() >= kLeastHeight * line;
    });
  }

  const SheetRequest& m_request;
  const Furniture& m_furniture;
  int m_gap;
  Grid m_grid;
  std::array<ViewExtent, kViewCount> m_extents;
  SheetPlan m_plan;
  tagRECT m_used{};
};

}  // namespace

std::optional<SheetLayout> FindLayout(const std::string& name) {
  for (const auto& [known, layout] : kLayouts) {
    if (name == known) {
      return layout;
    }
  }
  return std::nullopt;
}

std::string LayoutList() {
  std::string list;
  for (const auto& [name, layout] : kLayouts) {
    list += (list.empty() ? "" : ", ") + std::string(name);
  }
  return list;
}

SheetPlan PlanSheet(const SheetRequest& request) {
  for (const Furniture& furniture : kFurniture) {
    const bool isLast = &furniture == &kFurniture.back();
    if (!request.isAnnotated && !isLast) {
      continue;
    }
    Planner planner(request, furniture);
    if (planner.Plan() || isLast) {
      return planner.GetPlan();
    }
  }
  return {};
}

}  // namespace cli
