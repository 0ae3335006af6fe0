#ifndef VORL_PLATFORM_SOFT_ROP3_H
#define VORL_PLATFORM_SOFT_ROP3_H

#include <vorl/Platform/soft/Painter.h>

#include <cstdint>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// Does a ternary operation read the source, the pattern?
bool UsesSource(DWORD rop);
bool UsesPattern(DWORD rop);

/// One of the 256 ternary operations (bits 16 to 23 of its code) with a solid pattern. For each
/// value of a source bit, what remains is a binary operation on the destination bit.
class Rop3 {
 public:
  Rop3(DWORD rop, std::uint32_t patternPixel);

  /// The result is the source.
  bool IsCopy() const { return m_isCopy; }

  /// The whole operation, for codes that do not use the source.
  BitOperation WithoutSource() const { return m_on0; }

  /// Combines the columns from x on, `count` of them, of a row with as many source units.
  void CombineRow(std::uint8_t* row, int depth, int x, int count, const std::uint8_t* source);

 private:
  template <int kBytes>
  void CombineUnits(std::uint8_t* target, const std::uint8_t* source, int count) const;

  BitOperation m_on0;  // where the source bit is 0
  BitOperation m_on1;  // where the source bit is 1
  bool m_isCopy;
  std::vector<std::uint8_t> m_units;  // of rows whose pixels are less than a byte
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
