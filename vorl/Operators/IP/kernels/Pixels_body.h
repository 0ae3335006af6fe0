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

template <class T>
void MinMax(const T* source, std::size_t count, std::int32_t& minimum, std::int32_t& maximum) {
  if (count == 0) {
    return;
  }
  T smallest = source[0];
  T largest = source[0];
  for (std::size_t i = 0; i < count; ++i) {
    smallest = source[i] < smallest ? source[i] : smallest;
    largest = source[i] > largest ? source[i] : largest;
  }
  minimum = smallest < minimum ? smallest : minimum;
  maximum = largest > maximum ? largest : maximum;
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

template <int kExceptions, bool kHasEnds>
Words WindowEntries(const Words& samples, const WindowRamp& ramp) {
  const Words index = samples.Xor(Words::All(ramp.flip));
  const Words first = Words::All(ramp.first);
  const Words last = Words::All(ramp.last);
  const Words fromFirst = index.SubtractSaturated(first);
  Words entry = fromFirst.Min(last).Line(ramp.factor, ramp.offset);
  if constexpr (kHasEnds) {
    entry = entry.Replaced(first.SubtractSaturated(index).IsNonZero(), Words::All(ramp.below));
    entry = entry.Replaced(fromFirst.SubtractSaturated(last).IsNonZero(), Words::All(ramp.above));
  }
  for (int i = 0; i < kExceptions; ++i) {
    entry = entry.Replaced(index.Equals(Words::All(ramp.exceptions[i].index)),
                           Words::All(ramp.exceptions[i].entry));
  }
  return entry;
}

template <int kExceptions, bool kHasEnds>
void WindowLoop(const std::uint16_t* source, std::uint8_t* target, std::size_t count,
                const WindowRamp& ramp) {
  std::size_t i = 0;
  for (; i + 2 * Words::kCount <= count; i += 2 * Words::kCount) {
    const Words low = WindowEntries<kExceptions, kHasEnds>(Words::Load(source + i), ramp);
    const Words high =
        WindowEntries<kExceptions, kHasEnds>(Words::Load(source + i + Words::kCount), ramp);
    Words::StoreBytes(low, high, target + i);
  }
  for (; i < count; ++i) {
    target[i] = ramp.entries[source[i] ^ ramp.flip];
  }
}

void Window(const std::uint16_t* source, std::uint8_t* target, std::size_t count,
            const WindowRamp& ramp) {
  if (ramp.hasEnds) {
    WindowLoop<WindowRamp::kMostExceptions, true>(source, target, count, ramp);
  } else if (ramp.numExceptions > 1) {
    WindowLoop<WindowRamp::kMostExceptions, false>(source, target, count, ramp);
  } else if (ramp.numExceptions > 0) {
    WindowLoop<1, false>(source, target, count, ramp);
  } else {
    WindowLoop<0, false>(source, target, count, ramp);
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
