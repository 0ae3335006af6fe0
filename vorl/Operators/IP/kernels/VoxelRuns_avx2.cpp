#include <immintrin.h>

#include <cstddef>
#include <cstdint>
#include <cstring>

inline namespace vorl {
namespace vorl_detail {
namespace {

class Classes {
 public:
  static constexpr std::size_t kCount = 16;

  static Classes All(std::uint16_t value) {
    return _mm256_set1_epi16(static_cast<std::int16_t>(value));
  }
  static Classes Load(const std::uint16_t* values) {
    return _mm256_loadu_si256(reinterpret_cast<const __m256i*>(values));
  }
  /// The low 12 bits of each.
  static Classes Load12(const std::uint16_t* values) {
    return _mm256_and_si256(Load(values).m_lanes, _mm256_set1_epi16(0xFFF));
  }
  void Store(std::uint16_t* values) const {
    _mm256_storeu_si256(reinterpret_cast<__m256i*>(values), m_lanes);
  }

  Classes Min(Classes other) const { return _mm256_min_epu16(m_lanes, other.m_lanes); }
  Classes Subtract(Classes other) const { return _mm256_sub_epi16(m_lanes, other.m_lanes); }
  /// One bit for each lane.
  std::uint32_t IsAtMost(Classes other) const {
    const __m256i holds = _mm256_cmpeq_epi16(_mm256_min_epu16(m_lanes, other.m_lanes), m_lanes);
    return _pext_u32(static_cast<std::uint32_t>(_mm256_movemask_epi8(holds)), 0x55555555U);
  }

  /// The entries of the lanes whose bits are set, of which there are some.
  static std::size_t WriteEntries(std::uint32_t chosen, std::uint32_t base, std::uint32_t x,
                                  unsigned char* entries) {
    std::size_t written = 0;
    for (; chosen != 0; chosen &= chosen - 1, ++written) {
      const std::uint32_t entry = base | (x + static_cast<std::uint32_t>(__builtin_ctz(chosen)));
      std::memcpy(entries + 4 * written, &entry, sizeof(entry));
    }
    return written;
  }

 private:
  Classes(__m256i lanes) : m_lanes(lanes) {}

  __m256i m_lanes;
};

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#include <vorl/Operators/IP/kernels/VoxelRuns_body.h>

inline namespace vorl {
namespace vorl_detail {

extern const VoxelKernels kVoxelKernelsAvx2;
const VoxelKernels kVoxelKernelsAvx2 = kKernels;

}  // namespace vorl_detail
}  // namespace vorl
