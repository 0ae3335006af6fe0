#include <vorl/Platform/soft/Blit.h>

#include <vorl/Platform/soft/Rop3.h>
#include <vorl/Platform/soft/RowConverter.h>
#include <vorl/Platform/soft/StretchKernels.h>

#include <algorithm>
#include <bit>
#include <cstring>
#include <memory>
#include <optional>
#include <utility>

inline namespace vorl {
namespace vorl_detail {
namespace {

MonoColours ColoursFor(const DeviceContext& context, const BlitSource& source) {
  const PixelFormat& target = context.Target().format;
  return MonoColours{NearestPixel(target, context.state.textColour),
                     NearestPixel(target, context.state.backgroundColour),
                     NearestPixel(source.surface.format, source.background)};
}

// Delivers the rows of a blit's source, stretched and converted to the units of the destination.
class RowSource {
 public:
  RowSource(const DeviceContext& context, const BlitSource& source, const AxisMap& x,
            const AxisMap& y)
      : m_surface(source.surface),
        m_x(x),
        m_y(y),
        m_mode(context.state.stretchMode),
        m_targetBytes(context.Target().format.BytesPerUnit()),
        m_converter(source.surface.format, context.Target().format, ColoursFor(context, source)) {
    const auto [low, high] =
        std::minmax({x.first.front(), x.first.back(), x.last.front(), x.last.back()});
    m_left = low;
    m_sourceCount = high - low + 1;
    m_columns = x.last;
    for (int& column : m_columns) {
      column -= m_left;
    }
    m_repeats = m_sourceCount < static_cast<int>(m_columns.size());
    if (!x.contiguous) {
      m_plan.emplace(m_columns, m_sourceCount,
                     m_repeats ? m_targetBytes : source.surface.format.BytesPerUnit(),
                     ActiveStretchKernels());
    }
    const std::uint64_t columns = m_columns.size();
    m_isLarge = columns * static_cast<unsigned>(m_targetBytes) * y.first.size() >= kLargeTarget;
    m_combines = (m_mode == BLACKONWHITE || m_mode == WHITEONBLACK) &&
                 (x.first != x.last || y.first != y.last);
  }

  RowSource(const RowSource&) = delete;
  RowSource& operator=(const RowSource&) = delete;
  ~RowSource() {
    if (m_hasStreamed) {
      ActiveStretchKernels().endStream();
    }
  }

  /// The units for the columns from x.begin to x.end of a target row; valid until the next call.
  /// They may be made in a place of the caller's, which then must keep them that long.
  const std::uint8_t* Row(int targetRow, std::uint8_t* place = nullptr) {
    const auto k = static_cast<std::size_t>(targetRow - m_y.begin);
    const int first = m_y.first[k];
    const int last = m_y.last[k];
    if (m_current == nullptr || first != m_firstRow || last != m_lastRow) {
      m_firstRow = first;
      m_lastRow = last;
      m_isShownOnce = m_isLarge && k + 1 < m_y.first.size() && m_y.first[k + 1] != first;
      m_current = m_combines ? Combined(first, last) : Single(first, place);
    }
    return m_current;
  }

  /// Writes those units to where they will be seen.
  void Write(int targetRow, std::uint8_t* target) {
    const std::uint8_t* const units = Row(targetRow, target);
    if (units != target) {
      std::memcpy(target, units, m_columns.size() * static_cast<std::size_t>(m_targetBytes));
    }
  }

 private:
  // What is larger than most caches is written past them: otherwise the memory is read before it is
  // written. 2048 x 2048 pixels of 32 bits to 3840 x 2160: 4820 instead of 4084 million a second.
  static constexpr std::uint64_t kLargeTarget = std::uint64_t{1} << 24;

  const std::uint8_t* SourceUnits(int row) {
    const std::uint8_t* pixels = m_surface.Row(row);
    const int depth = m_surface.format.depth;
    if (depth >= 8) {
      return pixels + static_cast<std::ptrdiff_t>(m_left) * (depth / 8);
    }
    m_unpacked.resize(static_cast<std::size_t>(m_sourceCount));
    UnpackRow(pixels, depth, m_left, m_sourceCount, m_unpacked.data());
    return m_unpacked.data();
  }

  // Each of the two steps works in the given place, or in memory of its own where there is none.
  const std::uint8_t* Converted(const std::uint8_t* units, int count, std::uint8_t* place) {
    if (m_converter.IsCopy()) {
      return units;
    }
    if (place == nullptr) {
      m_converted.resize(static_cast<std::size_t>(count) * static_cast<std::size_t>(m_targetBytes));
      place = m_converted.data();
    }
    m_converter.Convert(units, place, count);
    return place;
  }

  const std::uint8_t* Stretched(const std::uint8_t* units, int bytes, std::uint8_t* place) {
    if (!m_plan) {
      return units;
    }
    if (place != nullptr && m_isShownOnce && m_plan->Stream(units, place)) {
      m_hasStreamed = true;
      return place;
    }
    if (place == nullptr) {
      m_stretched.resize(m_columns.size() * static_cast<std::size_t>(bytes));
      place = m_stretched.data();
    }
    m_plan->Gather(units, place);
    return place;
  }

  // Pixels are converted before they are repeated and after they are left out. The place is the
  // last step's.
  const std::uint8_t* Single(int row, std::uint8_t* place) {
    const std::uint8_t* units = SourceUnits(row);
    const int count = static_cast<int>(m_columns.size());
    if (m_repeats) {
      return Stretched(Converted(units, m_sourceCount, nullptr), m_targetBytes, place);
    }
    std::uint8_t* const between = m_converter.IsCopy() ? place : nullptr;
    return Converted(Stretched(units, m_surface.format.BytesPerUnit(), between), count, place);
  }

  // Pixels that share a place are combined as the destination would show them.
  const std::uint8_t* Combined(int first, int last) {
    const std::uint8_t neutral = m_mode == BLACKONWHITE ? 0xFF : 0;
    const auto bytes = static_cast<std::size_t>(m_targetBytes);
    m_combined.assign(m_columns.size() * bytes, neutral);
    const int step = first <= last ? 1 : -1;
    for (int row = first; row != last + step; row += step) {
      const std::uint8_t* units = Converted(SourceUnits(row), m_sourceCount, nullptr);
      for (std::size_t k = 0; k < m_columns.size(); ++k) {
        const auto [low, high] = std::minmax(m_x.first[k], m_x.last[k]);
        AddColumns(units, low - m_left, high - m_left, &m_combined[k * bytes]);
      }
    }
    return m_combined.data();
  }

  void AddColumns(const std::uint8_t* units, int low, int high, std::uint8_t* target) const {
    for (int column = low; column <= high; ++column) {
      for (int i = 0; i < m_targetBytes; ++i) {
        const std::uint8_t unit = units[static_cast<std::ptrdiff_t>(column) * m_targetBytes + i];
        target[i] =
            static_cast<std::uint8_t>(m_mode == BLACKONWHITE ? target[i] & unit : target[i] | unit);
      }
    }
  }

  const Surface& m_surface;
  const AxisMap& m_x;
  const AxisMap& m_y;
  const int m_mode;
  const int m_targetBytes;
  RowConverter m_converter;
  int m_left = 0;              // the leftmost source column that is needed
  int m_sourceCount = 0;       // the source columns from there to the rightmost
  std::vector<int> m_columns;  // for each target column its source column, counted from m_left
  bool m_repeats = false;      // fewer source than target columns
  std::optional<GatherPlan> m_plan;
  bool m_combines = false;
  bool m_isLarge = false;      // the target
  bool m_isShownOnce = false;  // the current row of a large target is not copied to the next one
  bool m_hasStreamed = false;
  int m_firstRow = 0;
  int m_lastRow = 0;
  const std::uint8_t* m_current = nullptr;
  std::vector<std::uint8_t> m_unpacked;
  std::vector<std::uint8_t> m_converted;
  std::vector<std::uint8_t> m_stretched;
  std::vector<std::uint8_t> m_combined;
};

// The bytes from the first to behind the last row in memory.
std::pair<std::uintptr_t, std::uintptr_t> BytesOf(const Surface& surface) {
  const auto top = std::bit_cast<std::uintptr_t>(surface.Row(0));
  const auto bottom = std::bit_cast<std::uintptr_t>(surface.Row(surface.height - 1));
  const auto [low, high] = std::minmax(top, bottom);
  return {low, high + RowBytes(surface.width, surface.format.depth, 8)};
}

bool ShareMemory(const Surface& a, const Surface& b) {
  const auto [beginA, endA] = BytesOf(a);
  const auto [beginB, endB] = BytesOf(b);
  return beginA < endB && beginB < endA;
}

// Keeps the rows that a blit needs as they are now, for blits that change what they read.
std::unique_ptr<std::uint8_t[]> Freeze(Surface* surface, const AxisMap& y) {
  const auto rowBytes =
      static_cast<std::ptrdiff_t>(RowBytes(surface->width, surface->format.depth, 8));
  std::unique_ptr<std::uint8_t[]> copy(
      new std::uint8_t[static_cast<std::size_t>(rowBytes * surface->height)]);
  const auto [low, high] =
      std::minmax({y.first.front(), y.first.back(), y.last.front(), y.last.back()});
  for (int row = low; row <= high; ++row) {
    std::memcpy(copy.get() + row * rowBytes, surface->Row(row), static_cast<std::size_t>(rowBytes));
  }
  surface->top = copy.get();
  surface->pitch = rowBytes;
  return copy;
}

std::uint32_t PatternOf(const DeviceContext& context) {
  return context.PixelOf(context.state.brush->colour);
}

}  // namespace

bool HasPattern(const DeviceContext& context, DWORD rop) {
  return context.state.brush->style != BS_NULL || !UsesPattern(rop);
}

void Blit(DeviceContext& context, const Axis& xAxis, const Axis& yAxis, const BlitSource& source,
          DWORD rop) {
  const RECT bounds = context.Visible().Extents();
  const AxisMap x = MapAxis(xAxis, bounds.left, bounds.right, source.surface.width);
  const AxisMap y = MapAxis(yAxis, bounds.top, bounds.bottom, source.surface.height);
  if (x.IsEmpty() || y.IsEmpty() || !HasPattern(context, rop)) {
    return;
  }
  const Surface& target = context.Target();
  BlitSource frozen = source;
  std::unique_ptr<std::uint8_t[]> copy;
  if (ShareMemory(source.surface, target)) {
    copy = Freeze(&frozen.surface, y);
  }
  RowSource rows(context, frozen, x, y);
  Rop3 operation(rop, PatternOf(context));
  const std::ptrdiff_t bytes = target.format.BytesPerUnit();
  const auto boxes = context.Visible().Boxes();
  for (std::size_t band = 0; band < boxes.size();) {
    const pixman_box32_t& head = boxes[band];
    std::size_t next = band;
    while (next < boxes.size() && boxes[next].y1 == head.y1) {
      ++next;
    }
    // Where all of a row is replaced, it is made where it will be seen.
    const bool isWhole = operation.IsCopy() && target.format.depth >= 8 && next - band == 1 &&
                         head.x1 <= x.begin && head.x2 >= x.end;
    for (int row = std::max(head.y1, y.begin); row < std::min(head.y2, y.end); ++row) {
      if (isWhole) {
        rows.Write(row, target.Row(row) + x.begin * bytes);
        continue;
      }
      const std::uint8_t* units = rows.Row(row);
      for (std::size_t i = band; i < next; ++i) {
        const int begin = std::max(boxes[i].x1, x.begin);
        const int end = std::min(boxes[i].x2, x.end);
        if (begin < end) {
          operation.CombineRow(target.Row(row), target.format.depth, begin, end - begin,
                               units + (begin - x.begin) * bytes);
        }
      }
    }
    band = next;
  }
}

void FillByRop(DeviceContext& context, const Axis& x, const Axis& y, DWORD rop) {
  if (!HasPattern(context, rop)) {
    return;
  }
  // A negative length runs downwards from the start, the start included.
  const auto side = [](std::int64_t start, int length) {
    const std::int64_t offset = length < 0 ? 1 : 0;
    return std::pair{start + offset, start + length + offset};
  };
  const auto [left, right] = side(x.target, x.targetLength);
  const auto [top, bottom] = side(y.target, y.targetLength);
  const Rop3 operation(rop, PatternOf(context));
  Painter(context, operation.WithoutSource()).Fill(Ordered(left, top, right, bottom));
}

}  // namespace vorl_detail
}  // namespace vorl
