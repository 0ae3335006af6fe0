#ifndef VORL_OPERATORS_IP_KERNELS_PLANEALONGROW_BODY_H
#define VORL_OPERATORS_IP_KERNELS_PLANEALONGROW_BODY_H

// Interpolation at points along a row of voxels, one voxel apart: a part of Planes_body.h.
//
// The points share their fractions, so that a register's neighbours are loaded as they lie. Where a
// fraction is 0 the neighbours in that direction are not looked at.
//
// 1. As many whole registers as have right neighbours are done where they lie, in stretches: in 16
//    bits first; a stretch whose samples left no room for that is done again in 32 bits, and so is
//    the rest of the row.
// 2. What is left goes the same ways from a copy, which has a right neighbour for the last column:
//    the column itself.

#include <vorl/Operators/IP/kernels/PlaneLinear_body.h>
#include <vorl/Operators/IP/kernels/PlaneRows.h>
#include <vorl/Operators/IP/kernels/PlaneSinks_body.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

/// The fractions of a row's points, and of what there is to do for each of them.
struct Fraction {
  explicit Fraction(std::int32_t fixed)
      : value(fixed & 0xFFFF), isZero(value == 0), isHigh(value >= 0x8000) {}
  std::int32_t value;
  bool isZero;
  bool isHigh;  ///< 16 bits with a sign hold it less 1
};

struct Fractions {
  explicit Fractions(const FixedVector& point) : x(point.x), y(point.y), z(point.z) {}
  bool AreZero() const { return x.isZero && y.isZero && z.isZero; }
  Fraction x, y, z;
};

/// The four rows of voxels that a row of sampling points runs between.
template <class T>
struct RowsAround {
  const T* upper[2];  ///< of the slice and of the next one
  const T* lower[2];

  RowsAround() = default;
  RowsAround(const VolumeGrid& grid, const FixedVector& point) {
    const std::int32_t x = point.x >> 16;
    const std::int32_t y = point.y >> 16;
    const std::int32_t z = point.z >> 16;
    const std::int32_t next = y + 1 < grid.Height() ? grid.Pitch() : 0;
    for (int k = 0; k < 2; ++k) {
      upper[k] = static_cast<const T*>(grid.Origin()) + grid.Slices()[z + k] +
                 static_cast<std::ptrdiff_t>(y) * grid.Pitch() + x;
      lower[k] = upper[k] + next;
    }
  }

  Square At(int k, std::size_t i) const {
    return {Numbers::LoadSamples(upper[k] + i), Numbers::LoadSamples(upper[k] + i + 1),
            Numbers::LoadSamples(lower[k] + i), Numbers::LoadSamples(lower[k] + i + 1)};
  }
};

/// Up to a register of voxels of each of the four rows, with their right neighbours.
template <class T>
class RowEnds {
 public:
  /// Copies voxels `begin` to `end`; from `beyond` on there are none.
  RowEnds(const RowsAround<T>& rows, std::size_t begin, std::size_t end, std::size_t beyond) {
    const T* const sources[4] = {rows.upper[0], rows.lower[0], rows.upper[1], rows.lower[1]};
    for (int k = 0; k < 4; ++k) {
      T* const copy = m_voxels[k];
      if (end - begin == Words::kCount) {
        Words::Load(sources[k] + begin).Store(copy);
      } else {
        Words::All(0).Store(copy);
        for (std::size_t i = begin; i < end; ++i) {
          copy[i - begin] = sources[k][i];
        }
        copy[Words::kCount] = 0;
      }
      copy[end - begin] = sources[k][end < beyond ? end : end - 1];
    }
  }

  RowsAround<T> Rows() const {
    RowsAround<T> rows;
    for (int k = 0; k < 2; ++k) {
      rows.upper[k] = m_voxels[2 * k];
      rows.lower[k] = m_voxels[2 * k + 1];
    }
    return rows;
  }

 private:
  T m_voxels[4][Words::kCount + 1];
};

/// Interpolates samples in 32 bits.
template <class T>
class WideRow {
 public:
  WideRow(const RowsAround<T>& rows, const Fractions& fractions)
      : m_rows(rows),
        m_x(Numbers::All(fractions.x.value)),
        m_y(Numbers::All(fractions.y.value)),
        m_z(Numbers::All(fractions.z.value)) {}

  Numbers At(std::size_t i) const {
    const Numbers below = m_rows.At(0, i).At(m_x, m_y);
    const Numbers above = m_rows.At(1, i).At(m_x, m_y);
    return Interpolate(below, above, below, m_z).Max(Numbers::All(0));
  }

 private:
  const RowsAround<T>& m_rows;
  Numbers m_x, m_y, m_z;
};

/// Interpolates samples in 16 bits and notes whether they leave room for that: samples of 13 bits
/// do, as no difference on the way is larger than three times their range.
template <class T>
class NarrowRow {
 public:
  NarrowRow(const RowsAround<T>& rows, const Fractions& fractions)
      : m_rows(rows),
        m_fractions(fractions),
        m_x(Words::All(fractions.x.value)),
        m_y(Words::All(fractions.y.value)),
        m_z(Words::All(fractions.z.value)) {}

  Words At(std::size_t i) {
    Words sample = InSlice(0, i);
    if (!m_fractions.z.isZero) {
      sample = Between(sample, InSlice(1, i), m_fractions.z, m_z);
    } else if (!kIsSigned && m_fractions.AreZero()) {
      return sample;  // of any size
    }
    return sample.MaxSigned(Words::All(0));
  }

  /// Whether all samples up to, but not including, `end` had.
  bool HadRoom(std::size_t end) const {
    if (m_fractions.AreZero()) {
      return true;
    }
    // The right neighbours of a register are left ones of the next; the last one's are seen here.
    const int last = m_fractions.x.isZero
                         ? 0
                         : Bits(m_rows.upper[0][end]) | Bits(m_rows.lower[0][end]) |
                               Bits(m_rows.upper[1][end]) | Bits(m_rows.lower[1][end]);
    return (last & kNoRoom) == 0 && (m_seen & Words::All(kNoRoom)).IsZero();
  }

 private:
  static constexpr bool kIsSigned = static_cast<T>(-1) < 0;
  static constexpr int kNoRoom = 0xE000;
  static constexpr int kLowest = kIsSigned ? 4096 : 0;  ///< moves the low end of the range to 0

  static int Bits(T voxel) { return voxel + kLowest; }

  Words Load(const T* voxels) {
    const Words loaded = Words::Load(voxels);
    m_seen = m_seen | (kIsSigned ? loaded + Words::All(kLowest) : loaded);
    return loaded;
  }

  Words InSlice(int k, std::size_t i) {
    Words upper = Load(m_rows.upper[k] + i);
    if (!m_fractions.x.isZero) {
      upper = Between(upper, Words::Load(m_rows.upper[k] + i + 1), m_fractions.x, m_x);
    }
    if (m_fractions.y.isZero) {
      return upper;
    }
    Words lower = Load(m_rows.lower[k] + i);
    if (!m_fractions.x.isZero) {
      // The difference runs the other way round than in the upper row: kept so on purpose.
      const Words difference = lower - Words::Load(m_rows.lower[k] + i + 1);
      const Words base = m_fractions.x.isHigh ? lower + difference : lower;
      lower = base + difference.HighProduct(m_x);
    }
    return Between(upper, lower, m_fractions.y, m_y);
  }

  // start + ((end - start) * fraction >> 16). The product of signed numbers lacks the difference
  // once where the fraction is high: start + difference is end.
  static Words Between(const Words& start, const Words& end, const Fraction& fraction,
                       const Words& bits) {
    return (fraction.isHigh ? end : start) + (end - start).HighProduct(bits);
  }

  const RowsAround<T>& m_rows;
  const Fractions& m_fractions;
  Words m_x, m_y, m_z;
  Words m_seen = Words::All(0);
};

/// Points `begin` to `end` of a row in stretches, all of whole registers and with right neighbours.
template <class T, class Sink>
void LinearStretches(const RowsAround<T>& rows, const Fractions& fractions, std::size_t end,
                     const Sink& sink) {
  constexpr std::size_t kStretch = 8 * Words::kCount;
  bool isNarrow = true;
  for (std::size_t begin = 0; begin < end;) {
    const std::size_t stop = end - begin < kStretch ? end : begin + kStretch;
    Words narrow[kStretch / Words::kCount];
    if (isNarrow) {
      NarrowRow<T> row(rows, fractions);
      for (std::size_t i = begin; i < stop; i += Words::kCount) {
        narrow[(i - begin) / Words::kCount] = row.At(i);
      }
      isNarrow = row.HadRoom(stop);
    }
    if (isNarrow) {
      for (std::size_t i = begin; i < stop; i += Words::kCount) {
        sink.Put(i, narrow[(i - begin) / Words::kCount]);
      }
    } else {
      const WideRow<T> row(rows, fractions);
      for (std::size_t i = begin; i < stop; i += Numbers::kCount) {
        sink.Put(i, row.At(i));
      }
    }
    begin = stop;
  }
}

/// Up to a register of points, one of which may have no right neighbour.
template <class T, class Sink>
void LinearRowEnd(const RowEnds<T>& ends, const Fractions& fractions, std::size_t count,
                  const Sink& sink) {
  const RowsAround<T> rows = ends.Rows();
  std::int32_t samples[Words::kCount];
  const SpareSink<T> spare{samples};
  NarrowRow<T> row(rows, fractions);
  const Words narrow = row.At(0);
  if (row.HadRoom(count)) {
    if (count == Words::kCount) {
      return sink.Put(0, narrow);
    }
    spare.Put(0, narrow);
  } else {
    const WideRow<T> wide(rows, fractions);
    for (std::size_t i = 0; i < Words::kCount; i += Numbers::kCount) {
      spare.Put(i, wide.At(i));
    }
  }
  for (std::size_t i = 0; i < count; ++i) {
    sink.Put(i, samples[i]);
  }
}

template <class T, class Sink>
void LinearAlongRow(const VolumeGrid& grid, const FixedVector& point, std::size_t count,
                    const Sink& sink) {
  const RowsAround<T> rows(grid, point);
  const Fractions fractions(point);
  const std::size_t beyond =
      static_cast<std::size_t>(grid.Width()) - static_cast<std::size_t>(point.x >> 16);
  const std::size_t direct = (count < beyond ? count : beyond - 1) / Words::kCount * Words::kCount;
  LinearStretches(rows, fractions, direct, sink);
  for (std::size_t i = direct; i < count; i += Words::kCount) {
    const std::size_t end = count - i < Words::kCount ? count : i + Words::kCount;
    LinearRowEnd(RowEnds<T>(rows, i, end, beyond), fractions, end - i, From(sink, i));
  }
}

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#endif
