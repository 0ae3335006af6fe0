#ifndef VORL_OPERATORS_IP_KERNELS_PLANELINEAR_BODY_H
#define VORL_OPERATORS_IP_KERNELS_PLANELINEAR_BODY_H

// Interpolation at points anywhere inside the volume: a part of Planes_body.h.

#include <vorl/Operators/IP/kernels/PlaneRows.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

/// start + ((to - from) * fraction >> 16), the product wrapping at 32 bits.
Numbers Interpolate(const Numbers& start, const Numbers& to, const Numbers& from,
                    const Numbers& fraction) {
  return start + ((to - from) * fraction).ShiftedRight();
}

/// The four voxels of a slice around a point: its own row and the next one.
struct Square {
  Numbers upperLeft, upperRight, lowerLeft, lowerRight;

  Numbers At(const Numbers& fractionX, const Numbers& fractionY) const {
    const Numbers upper = Interpolate(upperLeft, upperRight, upperLeft, fractionX);
    // The difference runs the other way round than in the upper row: kept so on purpose.
    const Numbers lower = Interpolate(lowerLeft, lowerLeft, lowerRight, fractionX);
    return Interpolate(upper, lower, upper, fractionY);
  }
};

/// Registers of points anywhere inside the volume. A voxel and its right neighbour are gathered
/// together; in the last column, where there is none, the pair to the left is.
template <class T>
class LinearGatherer {
 public:
  explicit LinearGatherer(const VolumeGrid& grid)
      : m_grid(grid),
        m_lastColumn(Numbers::All(grid.Width() - 1)),
        m_lastPair(Numbers::All(grid.Width() - 2)),
        m_lastRow(Numbers::All(grid.Height() - 1)),
        m_pitch(Numbers::All(grid.Pitch())) {}

  Numbers At(const Numbers& x, const Numbers& y, const Numbers& z) const {
    const Numbers fraction = Numbers::All(0xFFFF);
    const Numbers column = x.ShiftedRight();
    const Numbers row = y.ShiftedRight();
    const Numbers slice = z.ShiftedRight();
    const Numbers place = row * m_pitch + column.Min(m_lastPair);
    const Numbers next = m_pitch.Where(row.IsBelow(m_lastRow));
    const auto isLast = column.Equals(m_lastColumn);
    const Numbers fractionX = x & fraction;
    const Numbers fractionY = y & fraction;
    const Numbers below = SquareAt(Numbers::Gather(m_grid.Slices(), slice) + place, next, isLast)
                              .At(fractionX, fractionY);
    const Numbers above =
        SquareAt(Numbers::Gather(m_grid.Slices() + 1, slice) + place, next, isLast)
            .At(fractionX, fractionY);
    return Interpolate(below, above, below, z & fraction).Max(Numbers::All(0));
  }

 private:
  Square SquareAt(const Numbers& place, const Numbers& next,
                  const typename Numbers::Mask& isLast) const {
    const Numbers upper = Numbers::GatherPairs(m_grid.Origin(), place);
    const Numbers lower = Numbers::GatherPairs(m_grid.Origin(), place + next);
    const Numbers upperRight = upper.template HighSample<T>();
    const Numbers lowerRight = lower.template HighSample<T>();
    return {upper.template LowSample<T>().Replaced(isLast, upperRight), upperRight,
            lower.template LowSample<T>().Replaced(isLast, lowerRight), lowerRight};
  }

  const VolumeGrid& m_grid;
  Numbers m_lastColumn, m_lastPair, m_lastRow, m_pitch;
};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#endif
