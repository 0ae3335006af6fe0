#ifndef VORL_OPERATORS_IP_KERNELS_WINDOWRAMP_H
#define VORL_OPERATORS_IP_KERNELS_WINDOWRAMP_H

/// @file
/// A windowing table in a form that needs no memory: two constant ends and a straight line between
/// them.

#include <vorl/Operators/IP/kernels/Pixels.h>

#include <cstdint>
#include <optional>

inline namespace vorl {

class dWindowingLUT;

namespace vorl_detail {

/// The arithmetic that gives the entries of one table of 65536 entries. With x the index of an
/// entry (a sample, less the table's start):
///
/// 1. k = x - first, held to 0 and `last`;
/// 2. y is the line's value at k, in one of two ways, both cut to whole numbers:
///    - `isFixed`: y = (k * whole + ((k + shift) * fraction >> 16) + base) / 256 in 16 bits that
///      wrap: a line of 24 fractional bits, which does for most windows and is the faster way;
///    - y = k * factor + offset in single precision with two roundings;
/// 3. y is replaced by `below` where x < first and by `above` where x > first + last;
/// 4. y is replaced for the samples in `exceptions`.
///
/// The exceptions are there for entries that lie exactly between two grey values: the table is
/// computed by repeated addition, whose rounding errors put some of them on either side of any
/// line.
struct WindowRamp {
  static constexpr int kMostExceptions = 4;

  struct Exception {
    std::uint16_t index;
    std::uint8_t entry;
  };

  /// The ramp of a table whose entries are up to date, for samples of 16 bits that are signed or
  /// not. Every one of its 65536 entries has been compared with what `run` gives. None when the
  /// table has no such form: with a second stage, with entries changed by hand, or with more
  /// exceptions.
  static std::optional<WindowRamp> Of(dWindowingLUT& lut, bool signedSamples, WindowRun* run);

  std::uint16_t flip;   ///< turns a sample into an index by exclusive or
  std::uint16_t first;  ///< the first index on the line
  std::uint16_t last;   ///< indices on the line, less one
  std::uint8_t below;
  std::uint8_t above;
  bool hasEnds;  ///< false where the line's ends give `below` and `above` anyway
  int numExceptions;
  bool isFixed;
  std::uint16_t shift;     ///< as far as it takes no k beyond 65535
  std::uint16_t whole;     ///< of 256 times the line's step
  std::uint16_t fraction;  ///< of the same, times 65536
  std::uint16_t base;
  float factor;
  float offset;
  Exception exceptions[kMostExceptions];  ///< those that are not needed repeat a true entry
  const std::uint8_t* entries;            ///< the table; must live as long as the ramp
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
