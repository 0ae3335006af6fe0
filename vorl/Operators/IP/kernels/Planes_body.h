// The loops over rows of sampling points for one set of vector instructions. A variant's source
// includes this once, behind `Words` and `Numbers`, lanes of 16 and 32 bits.
//
// 1. Points along a row of voxels, one voxel apart, share their fractions: whole registers of
//    neighbours are loaded, and interpolated in 16 bits where the samples leave room for it.
// 2. Elsewhere the interpolation gathers pairs of neighbours.
// 3. The nearest voxel is fetched one by one: gathering is no faster.
//
// Nothing that is inline elsewhere, too, is called here: it might be compiled for a machine that
// others do not have, and kept as the one copy for all.

#include <vorl/Operators/IP/kernels/PlaneRows.h>

inline namespace vorl {
namespace vorl_detail {
namespace {

/// Where a row's samples go: one by one, or a register at a time.
template <class T>
struct StoreSink {
  T* row;

  void Put(std::size_t i, std::int32_t sample) const { row[i] = static_cast<T>(sample); }
  void Put(std::size_t i, const Numbers& samples) const { samples.StoreLow(row + i); }
  void Put(std::size_t i, const Words& samples) const { samples.Store(row + i); }
};

template <class T>
struct MaximumSink {
  std::int32_t* row;

  void Put(std::size_t i, std::int32_t sample) const { row[i] = sample > row[i] ? sample : row[i]; }
  void Put(std::size_t i, const Numbers& samples) const {
    Numbers::Load(row + i).Max(samples).Store(row + i);
  }
  void Put(std::size_t i, const Words& samples) const {
    Put(i, samples.template LowNumbers<T>());
    Put(i + Numbers::kCount, samples.template HighNumbers<T>());
  }
};

template <class T>
struct SumSink {
  std::int32_t* row;

  void Put(std::size_t i, std::int32_t sample) const {
    row[i] = static_cast<std::int32_t>(static_cast<std::uint32_t>(row[i]) +
                                       static_cast<std::uint32_t>(sample));
  }
  void Put(std::size_t i, const Numbers& samples) const {
    (Numbers::Load(row + i) + samples).Store(row + i);
  }
  void Put(std::size_t i, const Words& samples) const {
    Put(i, samples.template LowNumbers<T>());
    Put(i + Numbers::kCount, samples.template HighNumbers<T>());
  }
};

/// A position and its step as they are walked: wrapping at 32 bits.
struct Walk {
  std::uint32_t x, y, z;

  explicit Walk(const FixedVector& vector)
      : x(static_cast<std::uint32_t>(vector.x)),
        y(static_cast<std::uint32_t>(vector.y)),
        z(static_cast<std::uint32_t>(vector.z)) {}
  void Add(const Walk& step) {
    x += step.x;
    y += step.y;
    z += step.z;
  }
};

constexpr std::int32_t kOneVoxel = 65536;

bool IsAlongRow(const FixedVector& step) {
  return step.x == kOneVoxel && step.y == 0 && step.z == 0;
}

// ---- The nearest voxel -----------------------------------------------------------------------

template <class T>
const T* SliceOf(const VolumeGrid& grid, std::uint32_t z) {
  return static_cast<const T*>(grid.Origin()) + grid.Slices()[z >> 16];
}

/// Inside points have no sign, so the shifts may be logical.
template <class T, class Sink>
void NearestRow(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
                std::size_t count, const Sink& sink) {
  Walk place(point);
  const Walk stride(step);
  const auto width = static_cast<std::size_t>(grid.Width());
  if (IsAlongRow(step)) {
    const T* const row = SliceOf<T>(grid, place.z) + (place.y >> 16) * width + (place.x >> 16);
    std::size_t i = 0;
    for (; i + Words::kCount <= count; i += Words::kCount) {
      sink.Put(i, Words::Load(row + i));
    }
    for (; i < count; ++i) {
      sink.Put(i, row[i]);
    }
  } else if (step.z == 0) {
    const T* const slice = SliceOf<T>(grid, place.z);
    for (std::size_t i = 0; i < count; ++i) {
      sink.Put(i, slice[(place.y >> 16) * width + (place.x >> 16)]);
      place.Add(stride);
    }
  } else {
    for (std::size_t i = 0; i < count; ++i) {
      sink.Put(i, SliceOf<T>(grid, place.z)[(place.y >> 16) * width + (place.x >> 16)]);
      place.Add(stride);
    }
  }
}

// ---- Interpolation ---------------------------------------------------------------------------

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

/// The four rows of voxels that a row of sampling points runs between.
template <class T>
struct RowsAround {
  const T* upper[2];  ///< of the slice and of the next one
  const T* lower[2];

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

/// Interpolates samples in 16 bits and notes whether they leave room for that: samples of 13 bits
/// do, as no difference on the way is larger than three times their range.
template <class T>
class NarrowRow {
 public:
  NarrowRow(const RowsAround<T>& rows, const FixedVector& point)
      : m_rows(rows), m_x(point.x), m_y(point.y), m_z(point.z) {}

  Words At(std::size_t i) {
    const Words below = InSlice(0, i);
    const Words above = InSlice(1, i);
    return Interpolate(below, above, below, m_z).MaxSigned(Words::All(0));
  }
  bool HadRoom() const { return (m_seen & Words::All(0xE000)).IsZero(); }

 private:
  /// A fraction of 16 bits, for a product that takes it as signed.
  struct Fraction {
    explicit Fraction(std::int32_t fixed)
        : bits(Words::All(fixed)), isHigh(Words::All((fixed & 0x8000) != 0 ? -1 : 0)) {}
    Words bits;
    Words isHigh;  ///< all bits where the product lacks the factor once
  };

  Words InSlice(int k, std::size_t i) {
    const Words upperLeft = Words::Load(m_rows.upper[k] + i);
    const Words upperRight = Words::Load(m_rows.upper[k] + i + 1);
    const Words lowerLeft = Words::Load(m_rows.lower[k] + i);
    const Words lowerRight = Words::Load(m_rows.lower[k] + i + 1);
    // The low ends of signed ranges are moved to 0; the right neighbours of a register are left
    // ones of the next, and the last one is seen by itself.
    const Words lowest = Words::All(static_cast<T>(-1) < 0 ? 4096 : 0);
    m_seen = m_seen | (upperLeft + lowest) | (upperRight + lowest) | (lowerLeft + lowest) |
             (lowerRight + lowest);
    const Words upper = Interpolate(upperLeft, upperRight, upperLeft, m_x);
    const Words lower = Interpolate(lowerLeft, lowerLeft, lowerRight, m_x);
    return Interpolate(upper, lower, upper, m_y);
  }

  static Words Interpolate(const Words& start, const Words& to, const Words& from,
                           const Fraction& fraction) {
    const Words difference = to - from;
    return start + difference.HighProduct(fraction.bits) + (difference & fraction.isHigh);
  }

  const RowsAround<T>& m_rows;
  Fraction m_x, m_y, m_z;
  Words m_seen = Words::All(0);
};

/// Points along a row of voxels, all of which have a right neighbour. Returns how many it did.
template <class T, class Sink>
std::size_t LinearAlongRow(const VolumeGrid& grid, const FixedVector& point, std::size_t count,
                           const Sink& sink) {
  const RowsAround<T> rows(grid, point);
  constexpr std::size_t kStretch = 16;  // registers between two looks at the samples' room
  const Numbers fractionX = Numbers::All(point.x & 0xFFFF);
  const Numbers fractionY = Numbers::All(point.y & 0xFFFF);
  const Numbers fractionZ = Numbers::All(point.z & 0xFFFF);
  const auto wide = [&](std::size_t at) {
    const Numbers below = rows.At(0, at).At(fractionX, fractionY);
    const Numbers above = rows.At(1, at).At(fractionX, fractionY);
    return Interpolate(below, above, below, fractionZ).Max(Numbers::All(0));
  };
  std::size_t i = 0;
  while (i + Words::kCount <= count) {
    Words narrow[kStretch];
    NarrowRow<T> row(rows, point);
    std::size_t registers = 0;
    for (; registers < kStretch && i + (registers + 1) * Words::kCount <= count; ++registers) {
      narrow[registers] = row.At(i + registers * Words::kCount);
    }
    const std::size_t end = i + registers * Words::kCount;
    if (row.HadRoom()) {
      for (std::size_t k = 0; k < registers; ++k) {
        sink.Put(i + k * Words::kCount, narrow[k]);
      }
      i = end;
      continue;
    }
    for (; i < end; i += Numbers::kCount) {
      sink.Put(i, wide(i));
    }
  }
  for (; i + Numbers::kCount <= count; i += Numbers::kCount) {
    sink.Put(i, wide(i));
  }
  return i;
}

/// Registers of points anywhere inside the volume. A voxel and its right neighbour are gathered
/// together; in the last column, where there is none, the pair to the left is.
template <class T>
class Gatherer {
 public:
  explicit Gatherer(const VolumeGrid& grid)
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

template <class T, class Sink>
void LinearAnywhere(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
                    std::size_t count, const Sink& sink) {
  const Gatherer<T> gatherer(grid);
  const Numbers lane = Numbers::Lanes();
  const auto at = [&](std::int32_t start, std::int32_t stride) {
    return Numbers::All(start) + lane * Numbers::All(stride);
  };
  Numbers x = at(point.x, step.x);
  Numbers y = at(point.y, step.y);
  Numbers z = at(point.z, step.z);
  const Numbers lanes = Numbers::All(static_cast<int>(Numbers::kCount));
  const Numbers strideX = Numbers::All(step.x) * lanes;
  const Numbers strideY = Numbers::All(step.y) * lanes;
  const Numbers strideZ = Numbers::All(step.z) * lanes;
  std::size_t i = 0;
  for (; i + Numbers::kCount <= count; i += Numbers::kCount) {
    sink.Put(i, gatherer.At(x, y, z));
    x = x + strideX;
    y = y + strideY;
    z = z + strideZ;
  }
  if (i < count) {  // lanes beyond the row repeat its first point, and are not used
    const auto isUsed = lane.IsBelow(Numbers::All(static_cast<int>(count - i)));
    std::int32_t samples[Numbers::kCount];
    gatherer
        .At(Numbers::All(point.x).Replaced(isUsed, x), Numbers::All(point.y).Replaced(isUsed, y),
            Numbers::All(point.z).Replaced(isUsed, z))
        .Store(samples);
    for (std::size_t k = 0; i + k < count; ++k) {
      sink.Put(i + k, samples[k]);
    }
  }
}

/// The part of a sink's row from a place on.
template <class Sink>
Sink From(const Sink& sink, std::size_t start) {
  return {sink.row + start};
}

template <class T, class Sink>
void LinearRow(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
               std::size_t count, const Sink& sink) {
  std::size_t done = 0;
  FixedVector rest = point;
  if (IsAlongRow(step)) {
    const auto column = static_cast<std::size_t>(point.x >> 16);
    const std::size_t beforeLast = static_cast<std::size_t>(grid.Width() - 1) - column;
    done = LinearAlongRow<T>(grid, point, count < beforeLast ? count : beforeLast, sink);
    rest.x += static_cast<std::int32_t>(done) * kOneVoxel;  // inside, so no wrapping
  }
  if (done < count) {
    LinearAnywhere<T>(grid, rest, step, count - done, From(sink, done));
  }
}

// ---- The table -------------------------------------------------------------------------------

template <class T>
void Nearest(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
             std::size_t count, RowSink sink, void* row) {
  switch (sink) {
    case RowSink::Store:
      return NearestRow<T>(grid, point, step, count, StoreSink<T>{static_cast<T*>(row)});
    case RowSink::Maximum:
      return NearestRow<T>(grid, point, step, count,
                           MaximumSink<T>{static_cast<std::int32_t*>(row)});
    case RowSink::Sum:
      return NearestRow<T>(grid, point, step, count, SumSink<T>{static_cast<std::int32_t*>(row)});
  }
}

template <class T>
void Linear(const VolumeGrid& grid, const FixedVector& point, const FixedVector& step,
            std::size_t count, RowSink sink, void* row) {
  switch (sink) {
    case RowSink::Store:
      return LinearRow<T>(grid, point, step, count, StoreSink<T>{static_cast<T*>(row)});
    case RowSink::Maximum:
      return LinearRow<T>(grid, point, step, count,
                          MaximumSink<T>{static_cast<std::int32_t*>(row)});
    case RowSink::Sum:
      return LinearRow<T>(grid, point, step, count, SumSink<T>{static_cast<std::int32_t*>(row)});
  }
}

constexpr PlaneKernels kKernels = {{&Nearest<std::uint16_t>, &Nearest<std::int16_t>},
                                   {&Linear<std::uint16_t>, &Linear<std::int16_t>}};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl
