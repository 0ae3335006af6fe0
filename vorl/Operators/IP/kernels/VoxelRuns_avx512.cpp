#include <immintrin.h>

#include <cstddef>
#include <cstdint>

inline namespace vorl {
namespace vorl_detail {
namespace {

class Classes {
 public:
  static constexpr std::size_t kCount = 32;

  static Classes All(std::uint16_t value) {
    return _mm512_set1_epi16(static_cast<std::int16_t>(value));
  }
  static Classes Load(const std::uint16_t* values) { return _mm512_loadu_si512(values); }
  /// The low 12 bits of each.
  static Classes Load12(const std::uint16_t* values) {
    return _mm512_and_si512(Load(values).m_lanes, _mm512_set1_epi16(0xFFF));
  }
  void Store(std::uint16_t* values) const { _mm512_storeu_si512(values, m_lanes); }

  Classes Min(Classes other) const { return _mm512_min_epu16(m_lanes, other.m_lanes); }
  Classes Subtract(Classes other) const { return _mm512_sub_epi16(m_lanes, other.m_lanes); }
  /// One bit for each lane.
  std::uint32_t IsAtMost(Classes other) const {
    return _mm512_cmple_epu16_mask(m_lanes, other.m_lanes);
  }

  /// The entries of the lanes whose bits are set. What follows them is overwritten, up to `kCount`
  /// entries in all: a store that leaves it alone takes several times as long on some machines.
  static std::size_t WriteEntries(std::uint32_t chosen, std::uint32_t base, std::uint32_t x,
                                  unsigned char* entries) {
    const auto low = static_cast<__mmask16>(chosen & 0xFFFFU);
    const auto high = static_cast<__mmask16>(chosen >> 16U);
    const auto lowCount = static_cast<std::size_t>(_mm_popcnt_u32(chosen & 0xFFFFU));
    _mm512_storeu_si512(entries, _mm512_maskz_compress_epi32(low, EntriesFrom(base, x)));
    _mm512_storeu_si512(entries + 4 * lowCount,
                        _mm512_maskz_compress_epi32(high, EntriesFrom(base, x + 16)));
    return static_cast<std::size_t>(_mm_popcnt_u32(chosen));
  }

 private:
  Classes(__m512i lanes) : m_lanes(lanes) {}

  static __m512i EntriesFrom(std::uint32_t base, std::uint32_t x) {
    const __m512i numbers = _mm512_setr_epi32(0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15);
    const __m512i columns = _mm512_add_epi32(numbers, _mm512_set1_epi32(static_cast<int>(x)));
    return _mm512_or_si512(columns, _mm512_set1_epi32(static_cast<int>(base)));
  }

  __m512i m_lanes;
};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#include <vorl/Operators/IP/kernels/VoxelRuns_body.h>

inline namespace vorl {
namespace vorl_detail {

extern const VoxelKernels kVoxelKernelsAvx512;
const VoxelKernels kVoxelKernelsAvx512 = kKernels;

}  // namespace vorl_detail
}  // namespace vorl
