#include <vorl/Operators/IP/kernels/Pixels.h>

#include <algorithm>
#include <cmath>
#include <limits>

inline namespace vorl {
namespace vorl_detail {

template <class T>
void LookupRunRef(const T* source, std::uint8_t* target, std::size_t count,
                  const LookupTable& table) {
  for (std::size_t i = 0; i < count; ++i) {
    const std::int64_t index = source[i] - table.start;
    target[i] = table.entries[std::clamp<std::int64_t>(index, 0, table.size - 1)];
  }
}

template <class T>
void MinMaxRunRef(const T* source, std::size_t count, std::int32_t& minimum,
                  std::int32_t& maximum) {
  for (std::size_t i = 0; i < count; ++i) {
    const std::int32_t sample = source[i];
    if (sample > maximum) {
      maximum = sample;
    }
    if (sample < minimum) {
      minimum = sample;
    }
  }
}

template <class T>
void RescaleRunRef(const T* source, T* target, std::size_t count, double factor, double offset) {
  constexpr double kLow = std::numeric_limits<T>::min();
  constexpr double kHigh = std::numeric_limits<T>::max();
  for (std::size_t i = 0; i < count; ++i) {
    const double value = source[i] * factor + offset;
    // Saturating first gives the same result and keeps the conversion inside its range.
    target[i] = std::isnan(value) ? T{0} : static_cast<T>(std::clamp(value, kLow, kHigh));
  }
}

void MapBytesRunRef(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
                    const std::uint8_t* entries) {
  for (std::size_t i = 0; i < count; ++i) {
    target[i] = entries[source[i]];
  }
}

template void LookupRunRef(const std::uint8_t*, std::uint8_t*, std::size_t, const LookupTable&);
template void LookupRunRef(const std::int8_t*, std::uint8_t*, std::size_t, const LookupTable&);
template void LookupRunRef(const std::uint16_t*, std::uint8_t*, std::size_t, const LookupTable&);
template void LookupRunRef(const std::int16_t*, std::uint8_t*, std::size_t, const LookupTable&);

template void MinMaxRunRef(const std::uint8_t*, std::size_t, std::int32_t&, std::int32_t&);
template void MinMaxRunRef(const std::int8_t*, std::size_t, std::int32_t&, std::int32_t&);
template void MinMaxRunRef(const std::uint16_t*, std::size_t, std::int32_t&, std::int32_t&);
template void MinMaxRunRef(const std::int16_t*, std::size_t, std::int32_t&, std::int32_t&);
template void MinMaxRunRef(const std::int32_t*, std::size_t, std::int32_t&, std::int32_t&);

template void RescaleRunRef(const std::uint8_t*, std::uint8_t*, std::size_t, double, double);
template void RescaleRunRef(const std::int8_t*, std::int8_t*, std::size_t, double, double);
template void RescaleRunRef(const std::uint16_t*, std::uint16_t*, std::size_t, double, double);
template void RescaleRunRef(const std::int16_t*, std::int16_t*, std::size_t, double, double);

}  // namespace vorl_detail
}  // namespace vorl
