// Lanes of 16 and 32 bits in AVX-512 registers.

#include <immintrin.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

/// 32 bits each, signed.
class Numbers {
 public:
  using Mask = __mmask16;
  static constexpr std::size_t kCount = 16;

  static Numbers All(std::int32_t value) { return _mm512_set1_epi32(value); }
  /// 0, 1, 2 ...
  static Numbers Lanes() {
    return _mm512_setr_epi32(0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15);
  }
  static Numbers Load(const std::int32_t* numbers) { return _mm512_loadu_si512(numbers); }
  void Store(std::int32_t* numbers) const { _mm512_storeu_si512(numbers, m_lanes); }
  static Numbers LoadSamples(const std::uint16_t* samples) {
    return _mm512_cvtepu16_epi32(LoadHalf(samples));
  }
  static Numbers LoadSamples(const std::int16_t* samples) {
    return _mm512_cvtepi16_epi32(LoadHalf(samples));
  }
  /// The low 16 bits of each lane.
  void StoreLow(void* samples) const {
    _mm256_storeu_si256(static_cast<__m256i*>(samples), _mm512_cvtepi32_epi16(m_lanes));
  }
  static Numbers Gather(const std::int32_t* table, const Numbers& index) {
    return _mm512_i32gather_epi32(index.m_lanes, table, 4);
  }
  /// Two neighbouring samples of 16 bits each, the first one in the low half.
  static Numbers GatherPairs(const void* samples, const Numbers& index) {
    return _mm512_i32gather_epi32(index.m_lanes, samples, 2);
  }

  Numbers operator+(const Numbers& other) const { return _mm512_add_epi32(m_lanes, other.m_lanes); }
  Numbers operator-(const Numbers& other) const { return _mm512_sub_epi32(m_lanes, other.m_lanes); }
  /// The low 32 bits of the products.
  Numbers operator*(const Numbers& other) const {
    return _mm512_mullo_epi32(m_lanes, other.m_lanes);
  }
  Numbers operator&(const Numbers& other) const { return _mm512_and_si512(m_lanes, other.m_lanes); }
  Numbers Min(const Numbers& other) const { return _mm512_min_epi32(m_lanes, other.m_lanes); }
  Numbers Max(const Numbers& other) const { return _mm512_max_epi32(m_lanes, other.m_lanes); }
  /// By 16 bits, with the sign.
  Numbers ShiftedRight() const { return _mm512_srai_epi32(m_lanes, 16); }
  /// The halves of pairs of samples.
  template <class T>
  Numbers LowSample() const {
    if constexpr (static_cast<T>(-1) < 0) {
      return _mm512_srai_epi32(_mm512_slli_epi32(m_lanes, 16), 16);
    } else {
      return _mm512_and_si512(m_lanes, _mm512_set1_epi32(0xFFFF));
    }
  }
  template <class T>
  Numbers HighSample() const {
    if constexpr (static_cast<T>(-1) < 0) {
      return _mm512_srai_epi32(m_lanes, 16);
    } else {
      return _mm512_srli_epi32(m_lanes, 16);
    }
  }
  Mask Equals(const Numbers& other) const {
    return _mm512_cmpeq_epi32_mask(m_lanes, other.m_lanes);
  }
  Mask IsBelow(const Numbers& other) const {
    return _mm512_cmplt_epi32_mask(m_lanes, other.m_lanes);
  }
  Numbers Replaced(const Mask& where, const Numbers& other) const {
    return _mm512_mask_mov_epi32(m_lanes, where, other.m_lanes);
  }
  /// 0 elsewhere.
  Numbers Where(const Mask& mask) const { return _mm512_maskz_mov_epi32(mask, m_lanes); }

 private:
  friend class Words;

  Numbers(__m512i lanes) : m_lanes(lanes) {}

  static __m256i LoadHalf(const void* samples) {
    return _mm256_loadu_si256(static_cast<const __m256i*>(samples));
  }

  __m512i m_lanes;
};

/// 16 bits each.
class Words {
 public:
  using Mask = __mmask32;
  static constexpr std::size_t kCount = 32;

  static Words All(int value) { return _mm512_set1_epi16(static_cast<short>(value)); }
  static Words Load(const void* samples) { return _mm512_loadu_si512(samples); }
  void Store(void* samples) const { _mm512_storeu_si512(samples, m_lanes); }
  /// Lanes below 256 as bytes, those of `low` first.
  static void StoreBytes(const Words& low, const Words& high, std::uint8_t* target) {
    const __m512i mixed = _mm512_packus_epi16(low.m_lanes, high.m_lanes);
    const __m512i order = _mm512_set_epi64(7, 5, 3, 1, 6, 4, 2, 0);
    _mm512_storeu_si512(target, _mm512_permutexvar_epi64(order, mixed));
  }
  /// The high byte of each lane, those of `low` first.
  static void StoreHighBytes(const Words& low, const Words& high, std::uint8_t* target) {
    StoreBytes(_mm512_srli_epi16(low.m_lanes, 8), _mm512_srli_epi16(high.m_lanes, 8), target);
  }

  /// The high halves of 32-bit lanes, those of `low` first.
  static Words HighHalves(const Numbers& low, const Numbers& high) {
    const __m512i pairs = _mm512_setr_epi32(
        0x030001, 0x070005, 0x0B0009, 0x0F000D, 0x130011, 0x170015, 0x1B0019, 0x1F001D, 0x230021,
        0x270025, 0x2B0029, 0x2F002D, 0x330031, 0x370035, 0x3B0039, 0x3F003D);
    return _mm512_permutex2var_epi16(low.m_lanes, pairs, high.m_lanes);
  }
  /// From a register full of samples those at the lanes of `index`.
  static Words Chosen(const void* samples, const Words& index) {
    return _mm512_permutexvar_epi16(index.m_lanes, _mm512_loadu_si512(samples));
  }

  Words() = default;

  Words operator+(const Words& other) const { return _mm512_add_epi16(m_lanes, other.m_lanes); }
  Words operator-(const Words& other) const { return _mm512_sub_epi16(m_lanes, other.m_lanes); }
  /// The low and the high 16 bits of the products of unsigned lanes.
  Words operator*(const Words& other) const { return _mm512_mullo_epi16(m_lanes, other.m_lanes); }
  Words HighProductUnsigned(const Words& other) const {
    return _mm512_mulhi_epu16(m_lanes, other.m_lanes);
  }
  Words operator&(const Words& other) const { return _mm512_and_si512(m_lanes, other.m_lanes); }
  Words operator|(const Words& other) const { return _mm512_or_si512(m_lanes, other.m_lanes); }
  Words MaxSigned(const Words& other) const { return _mm512_max_epi16(m_lanes, other.m_lanes); }
  /// The larger lanes, as samples of a type.
  template <class T>
  Words Larger(const Words& other) const {
    if constexpr (static_cast<T>(-1) < 0) {
      return _mm512_max_epi16(m_lanes, other.m_lanes);
    } else {
      return _mm512_max_epu16(m_lanes, other.m_lanes);
    }
  }
  /// The largest unsigned lane.
  std::uint16_t LargestLane() const {
    const __m256i sixteen =
        _mm256_max_epu16(_mm512_castsi512_si256(m_lanes), _mm512_extracti64x4_epi64(m_lanes, 1));
    const __m128i eight =
        _mm_max_epu16(_mm256_castsi256_si128(sixteen), _mm256_extracti128_si256(sixteen, 1));
    // There is an instruction for the smallest one.
    const __m128i ones = _mm_set1_epi16(-1);
    const int smallest = _mm_cvtsi128_si32(_mm_minpos_epu16(_mm_xor_si128(eight, ones)));
    return static_cast<std::uint16_t>(~smallest);
  }
  /// The high 16 bits of the products of signed lanes.
  Words HighProduct(const Words& other) const { return _mm512_mulhi_epi16(m_lanes, other.m_lanes); }
  bool IsZero() const { return _mm512_test_epi32_mask(m_lanes, m_lanes) == 0; }
  /// The first and the last half of the lanes, as samples of a type.
  template <class T>
  Numbers LowNumbers() const {
    return Widened<T>(_mm512_castsi512_si256(m_lanes));
  }
  template <class T>
  Numbers HighNumbers() const {
    return Widened<T>(_mm512_extracti64x4_epi64(m_lanes, 1));
  }
  Words Xor(const Words& other) const { return _mm512_xor_si512(m_lanes, other.m_lanes); }
  Words Min(const Words& other) const { return _mm512_min_epu16(m_lanes, other.m_lanes); }
  Words SubtractSaturated(const Words& other) const {
    return _mm512_subs_epu16(m_lanes, other.m_lanes);
  }
  Mask Equals(const Words& other) const { return _mm512_cmpeq_epi16_mask(m_lanes, other.m_lanes); }
  Mask IsNonZero() const { return _mm512_test_epi16_mask(m_lanes, m_lanes); }
  Words Replaced(const Mask& where, const Words& other) const {
    return _mm512_mask_mov_epi16(m_lanes, where, other.m_lanes);
  }
  /// lane * factor + offset in single precision, truncated; to be 0 to 65535.
  Words Line(float factor, float offset) const {
    const __m512i zero = _mm512_setzero_si512();
    return _mm512_packus_epi32(LineOf(_mm512_unpacklo_epi16(m_lanes, zero), factor, offset),
                               LineOf(_mm512_unpackhi_epi16(m_lanes, zero), factor, offset));
  }
  /// lane * factor + offset in double precision, truncated and saturated.
  Words ScaledUnsigned(double factor, double offset) const {
    const __m512i zero = _mm512_setzero_si512();
    return _mm512_packus_epi32(
        ScaledSixteen(_mm512_unpacklo_epi16(m_lanes, zero), factor, offset, 65535),
        ScaledSixteen(_mm512_unpackhi_epi16(m_lanes, zero), factor, offset, 65535));
  }
  Words ScaledSigned(double factor, double offset) const {
    const __m512i low = _mm512_srai_epi32(_mm512_unpacklo_epi16(m_lanes, m_lanes), 16);
    const __m512i high = _mm512_srai_epi32(_mm512_unpackhi_epi16(m_lanes, m_lanes), 16);
    return _mm512_packs_epi32(ScaledSixteen(low, factor, offset, 32767),
                              ScaledSixteen(high, factor, offset, 32767));
  }

 private:
  template <class T>
  static Numbers Widened(__m256i samples) {
    if constexpr (static_cast<T>(-1) < 0) {
      return _mm512_cvtepi16_epi32(samples);
    } else {
      return _mm512_cvtepu16_epi32(samples);
    }
  }

  Words(__m512i lanes) : m_lanes(lanes) {}

  static __m512i LineOf(__m512i numbers, float factor, float offset) {
    const __m512 product = _mm512_mul_ps(_mm512_cvtepi32_ps(numbers), _mm512_set1_ps(factor));
    return _mm512_cvttps_epi32(_mm512_add_ps(product, _mm512_set1_ps(offset)));
  }

  static __m512i ScaledSixteen(__m512i numbers, double factor, double offset, double highest) {
    const __m256i low = ScaledEight(_mm512_castsi512_si256(numbers), factor, offset, highest);
    const __m256i high =
        ScaledEight(_mm512_extracti64x4_epi64(numbers, 1), factor, offset, highest);
    return _mm512_inserti64x4(_mm512_castsi256_si512(low), high, 1);
  }
  static __m256i ScaledEight(__m256i numbers, double factor, double offset, double highest) {
    const __m512d product = _mm512_mul_pd(_mm512_cvtepi32_pd(numbers), _mm512_set1_pd(factor));
    const __m512d sum = _mm512_add_pd(product, _mm512_set1_pd(offset));
    // What is too low to be converted becomes the lowest number, which the packing saturates.
    return _mm512_cvttpd_epi32(_mm512_min_pd(sum, _mm512_set1_pd(highest)));
  }

  __m512i m_lanes;
};

/// 256 bytes in four registers.
class ByteTable {
 public:
  explicit ByteTable(const std::uint8_t* entries)
      : m_quarters{_mm512_loadu_si512(entries), _mm512_loadu_si512(entries + 64),
                   _mm512_loadu_si512(entries + 128), _mm512_loadu_si512(entries + 192)} {}

  /// Maps as many whole registers as there are; returns the number of bytes.
  std::size_t MapRegisters(const std::uint8_t* source, std::uint8_t* target,
                           std::size_t count) const {
    std::size_t i = 0;
    for (; i + 64 <= count; i += 64) {
      const __m512i index = _mm512_loadu_si512(source + i);
      const __m512i low = _mm512_permutex2var_epi8(m_quarters[0], index, m_quarters[1]);
      const __m512i high = _mm512_permutex2var_epi8(m_quarters[2], index, m_quarters[3]);
      _mm512_storeu_si512(target + i, _mm512_mask_mov_epi8(low, _mm512_movepi8_mask(index), high));
    }
    return i;
  }

 private:
  __m512i m_quarters[4];
};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl
