#ifndef VORL_OPERATORS_IP_KERNELS_PLANESINKS_BODY_H
#define VORL_OPERATORS_IP_KERNELS_PLANESINKS_BODY_H

// Where the samples of a row go: a part of Planes_body.h.

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

/// Where a row's samples go: one by one, or a register at a time.
template <class T>
struct StoreSink {
  static constexpr bool kCollects = false;
  T* row;

  void Put(std::size_t i, std::int32_t sample) const { row[i] = static_cast<T>(sample); }
  void Put(std::size_t i, const Numbers& samples) const { samples.StoreLow(row + i); }
  void Put(std::size_t i, const Words& samples) const { samples.Store(row + i); }
};

template <class T>
struct MaximumSink {
  static constexpr bool kCollects = true;  ///< samples of layer after layer
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
  static constexpr bool kCollects = true;  ///< samples of layer after layer
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

/// Room for samples of which not all are used.
template <class T>
struct SpareSink {
  std::int32_t* row;

  void Put(std::size_t i, const Numbers& samples) const { samples.Store(row + i); }
  void Put(std::size_t i, const Words& samples) const {
    Put(i, samples.template LowNumbers<T>());
    Put(i + Numbers::kCount, samples.template HighNumbers<T>());
  }
};

/// The part of a sink's row from a place on.
template <class Sink>
Sink From(const Sink& sink, std::size_t start) {
  return {sink.row + start};
}

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#endif
