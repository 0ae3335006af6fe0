#ifndef VORL_PLATFORM_SOFT_ROWCONVERTER_H
#define VORL_PLATFORM_SOFT_ROWCONVERTER_H

#include <vorl/Platform/soft/StretchKernels.h>
#include <vorl/Platform/soft/Surface.h>

#include <array>
#include <cstdint>
#include <vector>

inline namespace vorl {
namespace vorl_detail {

/// Rows of units: one byte for each pixel of 1, 4 or 8 bits, else the pixel's own bytes.

/// The units of the columns from x on, `count` of them, in `units`.
void UnpackRow(const std::uint8_t* row, int depth, int x, int count, std::uint8_t* units);
/// The reverse.
void PackRow(std::uint8_t* row, int depth, int x, int count, const std::uint8_t* units);

/// The colours that decide between two formats when one of them is monochrome.
struct MonoColours {
  std::uint32_t text = 0;        ///< what a 0 of a monochrome source becomes
  std::uint32_t background = 0;  ///< what a 1 of a monochrome source becomes
  std::uint32_t white = 0;       ///< which value of another source a monochrome target shows as 1
};

/// Turns units of one format into units of another. Colours that the target lacks become the
/// nearest that it has.
class RowConverter {
 public:
  RowConverter(const PixelFormat& source, const PixelFormat& target, const MonoColours& colours);

  /// Nothing changes: rows may be used as they are.
  bool IsCopy() const { return m_convert == nullptr; }
  /// Source and target do not overlap.
  void Convert(const std::uint8_t* source, std::uint8_t* target, int count);

 private:
  using Function = void (RowConverter::*)(const std::uint8_t*, std::uint8_t*, int);

  std::uint32_t Translate(std::uint32_t pixel);
  template <int kBytes>
  void ConvertIndices(const std::uint8_t* source, std::uint8_t* target, int count);
  void ConvertIndicesTo32(const std::uint8_t* source, std::uint8_t* target, int count);
  template <int kSourceBytes, int kTargetBytes>
  void ConvertPixels(const std::uint8_t* source, std::uint8_t* target, int count);
  void Convert24To32(const std::uint8_t* source, std::uint8_t* target, int count);
  void Convert32To24(const std::uint8_t* source, std::uint8_t* target, int count);

  void ChooseForIndices(const MonoColours& colours);
  Function ChooseForPixels() const;

  const PixelFormat& m_source;
  const PixelFormat& m_target;
  std::uint32_t m_white = 0;
  Function m_convert = nullptr;
  std::array<std::uint32_t, 256> m_table{};  // from the units of up to 8 bits
  PixelTable m_pixels;                       // the same, for a target of 32 bits
  // The results for colours seen before, found by a hash: the search of a table is long.
  struct Known {
    std::uint32_t pixel = 0;
    std::uint32_t result = 0;
    bool valid = false;
  };
  std::vector<Known> m_known;
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
