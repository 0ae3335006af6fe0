// Sixteen lanes of 16 bits in an AVX2 register.

#include <immintrin.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

class Words {
 public:
  using Mask = __m256i;
  static constexpr std::size_t kCount = 16;

  static Words All(int value) { return _mm256_set1_epi16(static_cast<short>(value)); }
  static Words Load(const void* samples) {
    return _mm256_loadu_si256(static_cast<const __m256i*>(samples));
  }
  void Store(void* samples) const { _mm256_storeu_si256(static_cast<__m256i*>(samples), m_lanes); }
  /// Lanes below 256 as bytes, those of `low` first.
  static void StoreBytes(const Words& low, const Words& high, std::uint8_t* target) {
    const __m256i mixed = _mm256_packus_epi16(low.m_lanes, high.m_lanes);
    _mm256_storeu_si256(reinterpret_cast<__m256i*>(target), _mm256_permute4x64_epi64(mixed, 0xD8));
  }

  Words Xor(const Words& other) const { return _mm256_xor_si256(m_lanes, other.m_lanes); }
  Words Min(const Words& other) const { return _mm256_min_epu16(m_lanes, other.m_lanes); }
  Words SubtractSaturated(const Words& other) const {
    return _mm256_subs_epu16(m_lanes, other.m_lanes);
  }
  Mask Equals(const Words& other) const { return _mm256_cmpeq_epi16(m_lanes, other.m_lanes); }
  Mask IsNonZero() const {
    return _mm256_xor_si256(Equals(_mm256_setzero_si256()), _mm256_set1_epi16(-1));
  }
  Words Replaced(const Mask& where, const Words& other) const {
    return _mm256_blendv_epi8(m_lanes, other.m_lanes, where);
  }
  /// lane * factor + offset in single precision, truncated; to be 0 to 65535.
  Words Line(float factor, float offset) const {
    const __m256i zero = _mm256_setzero_si256();
    return _mm256_packus_epi32(LineOf(_mm256_unpacklo_epi16(m_lanes, zero), factor, offset),
                               LineOf(_mm256_unpackhi_epi16(m_lanes, zero), factor, offset));
  }
  /// lane * factor + offset in double precision, truncated and saturated.
  Words ScaledUnsigned(double factor, double offset) const {
    const __m256i zero = _mm256_setzero_si256();
    return _mm256_packus_epi32(
        ScaledEight(_mm256_unpacklo_epi16(m_lanes, zero), factor, offset, 65535),
        ScaledEight(_mm256_unpackhi_epi16(m_lanes, zero), factor, offset, 65535));
  }
  Words ScaledSigned(double factor, double offset) const {
    const __m256i low = _mm256_srai_epi32(_mm256_unpacklo_epi16(m_lanes, m_lanes), 16);
    const __m256i high = _mm256_srai_epi32(_mm256_unpackhi_epi16(m_lanes, m_lanes), 16);
    return _mm256_packs_epi32(ScaledEight(low, factor, offset, 32767),
                              ScaledEight(high, factor, offset, 32767));
  }

 private:
  Words(__m256i lanes) : m_lanes(lanes) {}

  static __m256i LineOf(__m256i numbers, float factor, float offset) {
    const __m256 product = _mm256_mul_ps(_mm256_cvtepi32_ps(numbers), _mm256_set1_ps(factor));
    return _mm256_cvttps_epi32(_mm256_add_ps(product, _mm256_set1_ps(offset)));
  }

  static __m256i ScaledEight(__m256i numbers, double factor, double offset, double highest) {
    const __m128i low = ScaledFour(_mm256_castsi256_si128(numbers), factor, offset, highest);
    const __m128i high = ScaledFour(_mm256_extracti128_si256(numbers, 1), factor, offset, highest);
    return _mm256_inserti128_si256(_mm256_castsi128_si256(low), high, 1);
  }
  static __m128i ScaledFour(__m128i numbers, double factor, double offset, double highest) {
    const __m256d product = _mm256_mul_pd(_mm256_cvtepi32_pd(numbers), _mm256_set1_pd(factor));
    const __m256d sum = _mm256_add_pd(product, _mm256_set1_pd(offset));
    // What is too low to be converted becomes the lowest number, which the packing saturates.
    return _mm256_cvttpd_epi32(_mm256_min_pd(sum, _mm256_set1_pd(highest)));
  }

  __m256i m_lanes;
};

/// Its instructions look up no more than 16 bytes at once: the plain loop is as fast.
struct ByteTable {
  explicit ByteTable(const std::uint8_t*) {}
  std::size_t MapRegisters(const std::uint8_t*, std::uint8_t*, std::size_t) const { return 0; }
};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl
