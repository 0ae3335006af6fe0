#ifndef VORL_OPERATORS_IP_KERNELS_ROWLOOP_H
#define VORL_OPERATORS_IP_KERNELS_ROWLOOP_H

/// @file
/// What every operator's loop over rows shares: it can be stopped, and it tells how far it is.

#include <atomic>
#include <cstddef>
#include <type_traits>

#include <vorl/Data/dImage.h>

inline namespace vorl {
namespace vorl_detail {

/// The two fields of an operator that its owner's thread shares.
struct RunControl {
  const std::atomic<bool>& stopRequested;
  std::atomic<double>& progress;
  bool canBeAsked;  ///< whether another thread may ask to stop (see `OpBase::HasThread`)

  void SetProgress(double value) const {
    if (canBeAsked) {
      progress.store(value, std::memory_order_seq_cst);
    } else {
      progress.store(value, std::memory_order_relaxed);
    }
  }
};

/// Calls `row(arguments)`. False when it returns false; a row that returns nothing is done.
template <class Row, class... Arguments>
bool DoRow(Row& row, Arguments&&... arguments) {
  if constexpr (std::is_same_v<std::invoke_result_t<Row&, Arguments...>, bool>) {
    return row(arguments...);
  } else {
    row(arguments...);
    return true;
  }
}

/// Calls `row(i)` for i = 0 .. count - 1. A stop request is honoured before each row, progress
/// stored once after each; where there are no rows, all is done at once. A row that returns false
/// was itself stopped on the way, and does not count. Returns false when stopped.
///
/// Progress is seen before the next request is looked for: whoever asks to stop and then for the
/// progress sees at most one more row done, however short rows are. That waits for the row's own
/// stores, 33 ns for 512 pixels of 16 bits (as long as their nearest voxels take), and is left out
/// where nobody can ask.
template <class Row>
bool ForEachRow(const RunControl& control, std::size_t count, Row&& row) {
  if (count == 0) {
    control.SetProgress(1.0);
  }
  for (std::size_t i = 0; i < count; ++i) {
    if (control.stopRequested.load(std::memory_order_seq_cst)) {
      return false;
    }
    if (!DoRow(row, i)) {
      return false;
    }
    control.SetProgress(static_cast<double>(i + 1) / static_cast<double>(count));
  }
  return true;
}

/// Row `index` of an image, counted over all planes.
template <class T>
T* RowOf(const dImage& image, std::size_t index) {
  return reinterpret_cast<T*>(static_cast<unsigned char*>(image.GetDataPtr()) +
                              index * image.GetBytesPerRow());
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
