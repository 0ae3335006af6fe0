#ifndef VORL_PLATFORM_SOFT_AXISMAP_H
#define VORL_PLATFORM_SOFT_AXISMAP_H

#include <cstdint>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// One dimension of a blit. A negative length runs from the start downwards, the start included,
/// and mirrors.
struct Axis {
  std::int64_t target = 0;
  int targetLength = 0;
  std::int64_t source = 0;
  int sourceLength = 0;
};

/// Which source pixels each target pixel shows.
///
/// The target is walked from its start to its end, and so is the source. With s source and d target
/// pixels, target pixel t shows source pixel ((2 t + 1) s - 1) / (2 d), rounded down, when s <= d:
/// the one under its centre, the lower of two when the centre lies between them. When s > d, source
/// pixel i falls into target pixel ((2 i + 1) d - 1) / (2 s), and several share one. What lies
/// outside source or target is left out without moving the rest.
struct AxisMap {
  int begin = 0;            ///< the first target pixel that shows anything
  int end = 0;              ///< behind the last
  bool contiguous = false;  ///< target pixel begin + k shows source pixel first[0] + k
  std::vector<int> first;   ///< for begin, begin + 1 ...: the first of its source pixels
  std::vector<int> last;    ///< and the last, in the order of the walk

  bool IsEmpty() const { return begin == end; }
};

/// Does the axis touch any of the source pixels that there are?
bool TouchesSource(const Axis& axis, int sourceSize);

/// `targetBegin` and `targetEnd` bound the target pixels that can be drawn on, `sourceSize` the
/// source pixels that there are.
AxisMap MapAxis(const Axis& axis, int targetBegin, int targetEnd, int sourceSize);

}  // namespace vorl_detail
}  // namespace vorl

#endif
