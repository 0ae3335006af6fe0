#include <immintrin.h>

#include <vorl/Platform/soft/StretchKernels.h>

inline namespace vorl {
namespace vorl_detail {
namespace {

struct Register1 {
  using Units = __m512i;
  static constexpr std::size_t kCount = 64;

  static __m512i Chosen(const std::uint8_t* units, const std::uint8_t* offsets) {
    return _mm512_permutexvar_epi8(_mm512_loadu_si512(offsets), _mm512_loadu_si512(units));
  }
  static void Store(__m512i units, std::uint8_t* target) { _mm512_storeu_si512(target, units); }
};

struct Register4 {
  using Units = __m512i;
  static constexpr std::size_t kCount = 16;

  static __m512i Chosen(const std::uint8_t* units, const std::uint8_t* offsets) {
    const __m128i bytes = _mm_loadu_si128(reinterpret_cast<const __m128i*>(offsets));
    return _mm512_permutexvar_epi32(_mm512_cvtepu8_epi32(bytes), _mm512_loadu_si512(units));
  }
  static void Store(__m512i units, std::uint8_t* target) { _mm512_storeu_si512(target, units); }
  static void Stream(__m512i units, std::uint8_t* target) {
    _mm512_stream_si512(reinterpret_cast<__m512i*>(target), units);
  }
};

void EndStream() {
  _mm_sfence();
}

// A table of 256 bytes in four registers.
struct Plane {
  __m512i quarters[4];

  static Plane Of(const std::uint8_t* bytes) {
    return {{_mm512_loadu_si512(bytes), _mm512_loadu_si512(bytes + 64),
             _mm512_loadu_si512(bytes + 128), _mm512_loadu_si512(bytes + 192)}};
  }

  __m512i At(__m512i index, __mmask64 isUpper) const {
    const __m512i lower = _mm512_permutex2var_epi8(quarters[0], index, quarters[1]);
    const __m512i upper = _mm512_permutex2var_epi8(quarters[2], index, quarters[3]);
    return _mm512_mask_mov_epi8(lower, isUpper, upper);
  }
};

// The bytes of 64 pixels from four planes. Unpacking keeps to the 128-bit lanes: lane n of the
// results belongs to samples 16 n to 16 n + 15.
void StorePixels(__m512i byte0, __m512i byte1, __m512i byte2, __m512i byte3, std::uint8_t* target) {
  const __m512i low01 = _mm512_unpacklo_epi8(byte0, byte1);
  const __m512i high01 = _mm512_unpackhi_epi8(byte0, byte1);
  const __m512i low23 = _mm512_unpacklo_epi8(byte2, byte3);
  const __m512i high23 = _mm512_unpackhi_epi8(byte2, byte3);
  const __m512i first = _mm512_unpacklo_epi16(low01, low23);
  const __m512i second = _mm512_unpackhi_epi16(low01, low23);
  const __m512i third = _mm512_unpacklo_epi16(high01, high23);
  const __m512i fourth = _mm512_unpackhi_epi16(high01, high23);
  _mm512_storeu_si512(target, first);
  _mm512_storeu_si512(target + 64, second);
  _mm512_storeu_si512(target + 128, third);
  _mm512_storeu_si512(target + 192, fourth);
}

// Grey pixels: one look-up, its results spread over three bytes each, 16 pixels to a register.
void MapToGrey(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
               const PixelTable& table) {
  const __mmask64 colourBytes = 0x7777777777777777U;
  const __m512i numbers = _mm512_setr_epi32(0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15);
  const __m512i spread = _mm512_mullo_epi32(numbers, _mm512_set1_epi32(0x01010101));
  const Plane plane = Plane::Of(table.planes[0]);
  for (std::size_t i = 0; i < count; i += 64) {
    const __m512i index = _mm512_loadu_si512(source + i);
    const __m512i grey = plane.At(index, _mm512_movepi8_mask(index));
    for (int k = 0; k < 4; ++k) {
      const __m512i chosen = _mm512_add_epi8(spread, _mm512_set1_epi8(static_cast<char>(16 * k)));
      _mm512_storeu_si512(target + 4 * i + static_cast<std::size_t>(64 * k),
                          _mm512_maskz_permutexvar_epi8(colourBytes, chosen, grey));
    }
  }
}

template <bool kTopIsZero>
void MapToColours(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
                  const PixelTable& table) {
  // The order of a register's 32-bit words that makes unpacking leave the pixels in order.
  const __m512i order = _mm512_setr_epi32(0, 4, 8, 12, 1, 5, 9, 13, 2, 6, 10, 14, 3, 7, 11, 15);
  const Plane planes[4] = {Plane::Of(table.planes[0]), Plane::Of(table.planes[1]),
                           Plane::Of(table.planes[2]), Plane::Of(table.planes[3])};
  for (std::size_t i = 0; i < count; i += 64) {
    const __m512i index = _mm512_permutexvar_epi32(order, _mm512_loadu_si512(source + i));
    const __mmask64 isUpper = _mm512_movepi8_mask(index);
    StorePixels(planes[0].At(index, isUpper), planes[1].At(index, isUpper),
                planes[2].At(index, isUpper),
                kTopIsZero ? _mm512_setzero_si512() : planes[3].At(index, isUpper), target + 4 * i);
  }
}

void MapTo32(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
             const PixelTable& table) {
  const std::size_t whole = count / 64 * 64;
  if (table.isGrey) {
    MapToGrey(source, target, whole, table);
  } else if (table.topIsZero) {
    MapToColours<true>(source, target, whole, table);
  } else {
    MapToColours<false>(source, target, whole, table);
  }
  MapTo32RunRef(source + whole, target + 4 * whole, count - whole, table);
}

}  // namespace
}  // namespace vorl_detail
}  // namespace vorl

#include <vorl/Platform/soft/Stretch_body.h>

inline namespace vorl {
namespace vorl_detail {

extern const StretchKernels kStretchKernelsAvx512;
const StretchKernels kStretchKernelsAvx512 = kKernels;

}  // namespace vorl_detail
}  // namespace vorl
