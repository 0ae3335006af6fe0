// The loops of the pixel operators for one set of vector instructions. A variant's source includes
// this once, having defined in its anonymous namespace `Words`, the sixteen-bit lanes of a
// register, and `ByteTable`, which maps registers of bytes.
//
// The plain loops are vectorised by the compiler. They call nothing that is inline elsewhere, too:
// it might be compiled here for a machine that others do not have, and kept as the one copy for
// all.

#include <vorl/Operators/IP/kernels/WindowRamp.h>

inline namespace vorl {
namespace vorl_detail {
namespace {

// The extremes of samples, a register of each.
template <class T>
class Extremes {
 public:
  static constexpr std::size_t kStep = 256 / sizeof(T);

  explicit Extremes(const T* first) : m_smallest(Load(first)), m_largest(m_smallest) {}

  void Add(const T* samples) {
    for (std::size_t i = 0; i < kStep; i += kCount) {
      const Lanes lanes = Load(samples + i);
      m_smallest = lanes < m_smallest ? lanes : m_smallest;
      m_largest = lanes > m_largest ? lanes : m_largest;
    }
  }

  void Raise(std::int32_t& minimum, std::int32_t& maximum) const {
    T smallest[kCount];
    T largest[kCount];
    __builtin_memcpy(smallest, &m_smallest, sizeof(smallest));
    __builtin_memcpy(largest, &m_largest, sizeof(largest));
    T low = smallest[0];
    T high = largest[0];
    for (std::size_t i = 0; i < kCount; ++i) {
      low = smallest[i] < low ? smallest[i] : low;
      high = largest[i] > high ? largest[i] : high;
    }
    minimum = low < minimum ? low : minimum;
    maximum = high > maximum ? high : maximum;
  }

 private:
  typedef T Lanes __attribute__((vector_size(sizeof(Words))));
  static constexpr std::size_t kCount = sizeof(Lanes) / sizeof(T);

  static Lanes Load(const T* samples) {
    Lanes lanes;
    __builtin_memcpy(&lanes, samples, sizeof(lanes));
    return lanes;
  }

  Lanes m_smallest;
  Lanes m_largest;
};

// Images are mostly larger than the caches. One line in four is asked for 8 KB ahead; the machine
// fetches its neighbours by itself: 150 MB are read at 21.8 instead of 15.9 GB/s (with every line
// 21.8, too), 1 MB at 110 instead of 136. What lies behind the samples is not read.
template <class T>
void MinMax(const T* source, std::size_t count, std::int32_t& minimum, std::int32_t& maximum) {
  constexpr std::size_t kStep = Extremes<T>::kStep;
  constexpr std::uintptr_t kAhead = 8192;
  if (count < kStep) {
    return MinMaxRunRef(source, count, minimum, maximum);
  }
  Extremes<T> extremes(source);
  for (std::size_t i = 0; i + kStep <= count; i += kStep) {
    __builtin_prefetch(
        reinterpret_cast<const void*>(reinterpret_cast<std::uintptr_t>(source + i) + kAhead), 0, 2);
    extremes.Add(source + i);
  }
  if (count % kStep != 0) {
    extremes.Add(source + count - kStep);  // the rest, and some samples again
  }
  extremes.Raise(minimum, maximum);
}

void MapBytes(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
              const std::uint8_t* entries) {
  const std::size_t done = ByteTable(entries).MapRegisters(source, target, count);
  MapBytesRunRef(source + done, target + done, count - done, entries);
}

template <class T, Words (Words::*kScaled)(double, double) const>
void Rescale(const T* source, T* target, std::size_t count, double factor, double offset) {
  std::size_t i = 0;
  if (factor - factor == 0.0 && offset - offset == 0.0) {  // else a result may be no number
    for (; i + Words::kCount <= count; i += Words::kCount) {
      (Words::Load(source + i).*kScaled)(factor, offset).Store(target + i);
    }
  }
  RescaleRunRef(source + i, target + i, count - i, factor, offset);
}

// The two arithmetics of a ramp, each with its constants in registers. Entries are handed on in the
// byte of a lane from which they will be stored.
class FixedLine {
 public:
  explicit FixedLine(const WindowRamp& ramp)
      : m_shift(Words::All(ramp.shift)),
        m_whole(Words::All(ramp.whole)),
        m_fraction(Words::All(ramp.fraction)),
        m_base(Words::All(ramp.base)) {}

  Words At(const Words& fromFirst) const {
    const Words shifted = fromFirst + m_shift;
    return fromFirst * m_whole + (shifted.HighProductUnsigned(m_fraction) + m_base);
  }
  static Words All(std::uint8_t entry) { return Words::All(entry << 8); }
  static void Store(const Words& low, const Words& high, std::uint8_t* target) {
    Words::StoreHighBytes(low, high, target);
  }

 private:
  Words m_shift;
  Words m_whole;
  Words m_fraction;
  Words m_base;
};

class FloatLine {
 public:
  explicit FloatLine(const WindowRamp& ramp) : m_factor(ramp.factor), m_offset(ramp.offset) {}

  Words At(const Words& fromFirst) const { return fromFirst.Line(m_factor, m_offset); }
  static Words All(std::uint8_t entry) { return Words::All(entry); }
  static void Store(const Words& low, const Words& high, std::uint8_t* target) {
    Words::StoreBytes(low, high, target);
  }

 private:
  float m_factor;
  float m_offset;
};

// A ramp with its constants in registers: read from memory, they might have been written to with
// every entry that is stored.
template <class Line, int kExceptions, bool kHasEnds>
class RampWords {
 public:
  explicit RampWords(const WindowRamp& ramp)
      : m_line(ramp),
        m_flip(Words::All(ramp.flip)),
        m_first(Words::All(ramp.first)),
        m_last(Words::All(ramp.last)),
        m_below(Line::All(ramp.below)),
        m_above(Line::All(ramp.above)) {
    for (int i = 0; i < kExceptions; ++i) {
      m_indices[i] = Words::All(ramp.exceptions[i].index);
      m_entries[i] = Line::All(ramp.exceptions[i].entry);
    }
  }

  Words Entries(const Words& samples) const {
    const Words index = samples.Xor(m_flip);
    const Words fromFirst = index.SubtractSaturated(m_first);
    Words entry = m_line.At(fromFirst.Min(m_last));
    if constexpr (kHasEnds) {
      entry = entry.Replaced(m_first.SubtractSaturated(index).IsNonZero(), m_below);
      entry = entry.Replaced(fromFirst.SubtractSaturated(m_last).IsNonZero(), m_above);
    }
    for (int i = 0; i < kExceptions; ++i) {
      entry = entry.Replaced(index.Equals(m_indices[i]), m_entries[i]);
    }
    return entry;
  }

 private:
  Line m_line;
  Words m_flip;
  Words m_first;
  Words m_last;
  Words m_below;
  Words m_above;
  Words m_indices[kExceptions + 1];
  Words m_entries[kExceptions + 1];
};

template <class Line, int kExceptions, bool kHasEnds>
void WindowLoop(const std::uint16_t* source, std::uint8_t* target, std::size_t count,
                const WindowRamp& ramp) {
  const RampWords<Line, kExceptions, kHasEnds> words(ramp);
  std::size_t i = 0;
  for (; i + 2 * Words::kCount <= count; i += 2 * Words::kCount) {
    Line::Store(words.Entries(Words::Load(source + i)),
                words.Entries(Words::Load(source + i + Words::kCount)), target + i);
  }
  for (; i < count; ++i) {
    target[i] = ramp.entries[source[i] ^ ramp.flip];
  }
}

template <class Line>
void WindowAlong(const std::uint16_t* source, std::uint8_t* target, std::size_t count,
                 const WindowRamp& ramp) {
  if (ramp.hasEnds) {
    WindowLoop<Line, WindowRamp::kMostExceptions, true>(source, target, count, ramp);
  } else if (ramp.numExceptions > 1) {
    WindowLoop<Line, WindowRamp::kMostExceptions, false>(source, target, count, ramp);
  } else if (ramp.numExceptions > 0) {
    WindowLoop<Line, 1, false>(source, target, count, ramp);
  } else {
    WindowLoop<Line, 0, false>(source, target, count, ramp);
  }
}

void Window(const std::uint16_t* source, std::uint8_t* target, std::size_t count,
            const WindowRamp& ramp) {
  if (ramp.isFixed) {
    WindowAlong<FixedLine>(source, target, count, ramp);
  } else {
    WindowAlong<FloatLine>(source, target, count, ramp);
  }
}

constexpr PixelKernels kKernels = {
    &MapBytes,
    &Window,
    {&MinMax<std::uint8_t>, &MinMax<std::int8_t>, &MinMax<std::uint16_t>, &MinMax<std::int16_t>,
     &MinMax<std::int32_t>},
    {&Rescale<std::uint16_t, &Words::ScaledUnsigned>,
     &Rescale<std::int16_t, &Words::ScaledSigned>}};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl
