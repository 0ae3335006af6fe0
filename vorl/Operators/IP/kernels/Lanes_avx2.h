// Lanes of 16 and 32 bits in AVX2 registers.

#include <immintrin.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

/// 32 bits each, signed.
class Numbers {
 public:
  using Mask = __m256i;
  static constexpr std::size_t kCount = 8;

  static Numbers All(std::int32_t value) { return _mm256_set1_epi32(value); }
  /// 0, 1, 2 ...
  static Numbers Lanes() { return _mm256_setr_epi32(0, 1, 2, 3, 4, 5, 6, 7); }
  static Numbers Load(const std::int32_t* numbers) {
    return _mm256_loadu_si256(reinterpret_cast<const __m256i*>(numbers));
  }
  void Store(std::int32_t* numbers) const {
    _mm256_storeu_si256(reinterpret_cast<__m256i*>(numbers), m_lanes);
  }
  static Numbers LoadSamples(const std::uint16_t* samples) {
    return _mm256_cvtepu16_epi32(LoadHalf(samples));
  }
  static Numbers LoadSamples(const std::int16_t* samples) {
    return _mm256_cvtepi16_epi32(LoadHalf(samples));
  }
  /// The low 16 bits of each lane.
  void StoreLow(void* samples) const {
    const __m256i order =
        _mm256_setr_epi8(0, 1, 4, 5, 8, 9, 12, 13, -1, -1, -1, -1, -1, -1, -1, -1, 0, 1, 4, 5, 8, 9,
                         12, 13, -1, -1, -1, -1, -1, -1, -1, -1);
    const __m256i halves = _mm256_shuffle_epi8(m_lanes, order);
    const __m256i packed = _mm256_permute4x64_epi64(halves, 0x08);
    _mm_storeu_si128(static_cast<__m128i*>(samples), _mm256_castsi256_si128(packed));
  }
  static Numbers Gather(const std::int32_t* table, const Numbers& index) {
    return _mm256_i32gather_epi32(table, index.m_lanes, 4);
  }
  /// Two neighbouring samples of 16 bits each, the first one in the low half.
  static Numbers GatherPairs(const void* samples, const Numbers& index) {
    return _mm256_i32gather_epi32(static_cast<const int*>(samples), index.m_lanes, 2);
  }

  Numbers operator+(const Numbers& other) const { return _mm256_add_epi32(m_lanes, other.m_lanes); }
  Numbers operator-(const Numbers& other) const { return _mm256_sub_epi32(m_lanes, other.m_lanes); }
  /// The low 32 bits of the products.
  Numbers operator*(const Numbers& other) const {
    return _mm256_mullo_epi32(m_lanes, other.m_lanes);
  }
  Numbers operator&(const Numbers& other) const { return _mm256_and_si256(m_lanes, other.m_lanes); }
  Numbers Min(const Numbers& other) const { return _mm256_min_epi32(m_lanes, other.m_lanes); }
  Numbers Max(const Numbers& other) const { return _mm256_max_epi32(m_lanes, other.m_lanes); }
  /// By 16 bits, with the sign.
  Numbers ShiftedRight() const { return _mm256_srai_epi32(m_lanes, 16); }
  /// The halves of pairs of samples.
  template <class T>
  Numbers LowSample() const {
    if constexpr (static_cast<T>(-1) < 0) {
      return _mm256_srai_epi32(_mm256_slli_epi32(m_lanes, 16), 16);
    } else {
      return _mm256_and_si256(m_lanes, _mm256_set1_epi32(0xFFFF));
    }
  }
  template <class T>
  Numbers HighSample() const {
    if constexpr (static_cast<T>(-1) < 0) {
      return _mm256_srai_epi32(m_lanes, 16);
    } else {
      return _mm256_srli_epi32(m_lanes, 16);
    }
  }
  Mask Equals(const Numbers& other) const { return _mm256_cmpeq_epi32(m_lanes, other.m_lanes); }
  Mask IsBelow(const Numbers& other) const { return _mm256_cmpgt_epi32(other.m_lanes, m_lanes); }
  Numbers Replaced(const Mask& where, const Numbers& other) const {
    return _mm256_blendv_epi8(m_lanes, other.m_lanes, where);
  }
  /// 0 elsewhere.
  Numbers Where(const Mask& mask) const { return _mm256_and_si256(m_lanes, mask); }

 private:
  friend class Words;

  Numbers(__m256i lanes) : m_lanes(lanes) {}

  static __m128i LoadHalf(const void* samples) {
    return _mm_loadu_si128(static_cast<const __m128i*>(samples));
  }

  __m256i m_lanes;
};

/// 16 bits each.
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
  /// The high byte of each lane, those of `low` first.
  static void StoreHighBytes(const Words& low, const Words& high, std::uint8_t* target) {
    StoreBytes(_mm256_srli_epi16(low.m_lanes, 8), _mm256_srli_epi16(high.m_lanes, 8), target);
  }

  /// The high halves of 32-bit lanes, those of `low` first.
  static Words HighHalves(const Numbers& low, const Numbers& high) {
    const __m256i mixed = _mm256_packus_epi32(_mm256_srli_epi32(low.m_lanes, 16),
                                              _mm256_srli_epi32(high.m_lanes, 16));
    return _mm256_permute4x64_epi64(mixed, 0xD8);
  }
  /// From a register full of samples those at the lanes of `index`.
  static Words Chosen(const void* samples, const Words& index) {
    const __m256i all = Load(samples).m_lanes;
    const __m256i bytes = _mm256_add_epi16(
        _mm256_mullo_epi16(index.m_lanes, _mm256_set1_epi16(0x0202)), _mm256_set1_epi16(0x0100));
    const __m256i lower = _mm256_shuffle_epi8(_mm256_permute2x128_si256(all, all, 0x00), bytes);
    const __m256i upper = _mm256_shuffle_epi8(_mm256_permute2x128_si256(all, all, 0x11), bytes);
    const __m256i isUpper = _mm256_cmpgt_epi16(index.m_lanes, _mm256_set1_epi16(7));
    return _mm256_blendv_epi8(lower, upper, isUpper);
  }

  Words() = default;

  Words operator+(const Words& other) const { return _mm256_add_epi16(m_lanes, other.m_lanes); }
  Words operator-(const Words& other) const { return _mm256_sub_epi16(m_lanes, other.m_lanes); }
  /// The low and the high 16 bits of the products of unsigned lanes.
  Words operator*(const Words& other) const { return _mm256_mullo_epi16(m_lanes, other.m_lanes); }
  Words HighProductUnsigned(const Words& other) const {
    return _mm256_mulhi_epu16(m_lanes, other.m_lanes);
  }
  Words operator&(const Words& other) const { return _mm256_and_si256(m_lanes, other.m_lanes); }
  Words operator|(const Words& other) const { return _mm256_or_si256(m_lanes, other.m_lanes); }
  Words MaxSigned(const Words& other) const { return _mm256_max_epi16(m_lanes, other.m_lanes); }
  /// The larger lanes, as samples of a type.
  template <class T>
  Words Larger(const Words& other) const {
    if constexpr (static_cast<T>(-1) < 0) {
      return _mm256_max_epi16(m_lanes, other.m_lanes);
    } else {
      return _mm256_max_epu16(m_lanes, other.m_lanes);
    }
  }
  /// The largest unsigned lane.
  std::uint16_t LargestLane() const {
    const __m128i eight =
        _mm_max_epu16(_mm256_castsi256_si128(m_lanes), _mm256_extracti128_si256(m_lanes, 1));
    // There is an instruction for the smallest one.
    const __m128i ones = _mm_set1_epi16(-1);
    const int smallest = _mm_cvtsi128_si32(_mm_minpos_epu16(_mm_xor_si128(eight, ones)));
    return static_cast<std::uint16_t>(~smallest);
  }
  /// The high 16 bits of the products of signed lanes.
  Words HighProduct(const Words& other) const { return _mm256_mulhi_epi16(m_lanes, other.m_lanes); }
  bool IsZero() const { return _mm256_testz_si256(m_lanes, m_lanes) != 0; }
  /// The first and the last half of the lanes, as samples of a type.
  template <class T>
  Numbers LowNumbers() const {
    return Widened<T>(_mm256_castsi256_si128(m_lanes));
  }
  template <class T>
  Numbers HighNumbers() const {
    return Widened<T>(_mm256_extracti128_si256(m_lanes, 1));
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
  template <class T>
  static Numbers Widened(__m128i samples) {
    if constexpr (static_cast<T>(-1) < 0) {
      return _mm256_cvtepi16_epi32(samples);
    } else {
      return _mm256_cvtepu16_epi32(samples);
    }
  }

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
