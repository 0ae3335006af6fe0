#include <immintrin.h>

#include <vorl/Platform/soft/StretchKernels.h>

inline namespace vorl {
namespace vorl_detail {
namespace {

struct Register1 {
  using Units = __m128i;
  static constexpr std::size_t kCount = 16;

  static __m128i Load(const std::uint8_t* units) {
    return _mm_loadu_si128(reinterpret_cast<const __m128i*>(units));
  }
  static __m128i Chosen(const std::uint8_t* units, const std::uint8_t* offsets) {
    return _mm_shuffle_epi8(Load(units), Load(offsets));
  }
  static void Store(__m128i units, std::uint8_t* target) {
    _mm_storeu_si128(reinterpret_cast<__m128i*>(target), units);
  }
};

struct Register4 {
  using Units = __m256i;
  static constexpr std::size_t kCount = 8;

  static __m256i Chosen(const std::uint8_t* units, const std::uint8_t* offsets) {
    const __m128i bytes = _mm_loadl_epi64(reinterpret_cast<const __m128i*>(offsets));
    return _mm256_permutevar8x32_epi32(_mm256_loadu_si256(reinterpret_cast<const __m256i*>(units)),
                                       _mm256_cvtepu8_epi32(bytes));
  }
  static void Store(__m256i units, std::uint8_t* target) {
    _mm256_storeu_si256(reinterpret_cast<__m256i*>(target), units);
  }
  static void Stream(__m256i units, std::uint8_t* target) {
    _mm256_stream_si256(reinterpret_cast<__m256i*>(target), units);
  }
};

void EndStream() {
  _mm_sfence();
}

// No faster way is known here: gathering from memory takes as long, on some machines much longer.
void MapTo32(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
             const PixelTable& table) {
  MapTo32RunRef(source, target, count, table);
}

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#include <vorl/Platform/soft/Stretch_body.h>

inline namespace vorl {
namespace vorl_detail {

extern const StretchKernels kStretchKernelsAvx2;
const StretchKernels kStretchKernelsAvx2 = kKernels;

}  // namespace vorl_detail
}  // namespace vorl
