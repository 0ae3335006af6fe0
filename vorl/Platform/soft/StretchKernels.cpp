#include <vorl/Platform/soft/StretchKernels.h>

#include <algorithm>
#include <cstring>

inline namespace vorl {
namespace vorl_detail {

extern const StretchKernels kStretchKernelsAvx2;
extern const StretchKernels kStretchKernelsAvx512;

template <int kBytes>
void GatherRunRef(const std::uint8_t* units, const GatherBlocks& plan, std::uint8_t* target) {
  for (std::size_t i = 0; i < plan.count; ++i) {
    std::memcpy(target + i * kBytes, units + static_cast<std::ptrdiff_t>(plan.columns[i]) * kBytes,
                kBytes);
  }
}

template void GatherRunRef<1>(const std::uint8_t*, const GatherBlocks&, std::uint8_t*);
template void GatherRunRef<2>(const std::uint8_t*, const GatherBlocks&, std::uint8_t*);
template void GatherRunRef<3>(const std::uint8_t*, const GatherBlocks&, std::uint8_t*);
template void GatherRunRef<4>(const std::uint8_t*, const GatherBlocks&, std::uint8_t*);

PixelTable::PixelTable(const std::array<std::uint32_t, 256>& source) {
  for (std::size_t i = 0; i < source.size(); ++i) {
    pixels[i] = source[i];
    for (unsigned k = 0; k < 4; ++k) {
      planes[k][i] = static_cast<std::uint8_t>(source[i] >> (8 * k));
    }
    topIsZero = topIsZero && planes[3][i] == 0;
    isGrey = isGrey && topIsZero && planes[0][i] == planes[1][i] && planes[1][i] == planes[2][i];
  }
}

void MapTo32RunRef(const std::uint8_t* source, std::uint8_t* target, std::size_t count,
                   const PixelTable& table) {
  for (std::size_t i = 0; i < count; ++i) {
    const std::uint32_t pixel = table.pixels[source[i]];
    for (unsigned k = 0; k < 4; ++k) {
      target[4 * i + k] = static_cast<std::uint8_t>(pixel >> (8 * k));
    }
  }
}

namespace {

constexpr StretchKernels kStretchKernelsRef = {
    &GatherRunRef<1>, 0, &GatherRunRef<4>, 0, &MapTo32RunRef, nullptr, [] {}};

GatherRun* GatherFor(int bytes, const StretchKernels& kernels) {
  switch (bytes) {
    case 1:
      return kernels.gather1;
    case 2:
      return &GatherRunRef<2>;
    case 3:
      return &GatherRunRef<3>;
    default:
      return kernels.gather4;
  }
}

std::size_t BlockOf(int bytes, const StretchKernels& kernels) {
  return bytes == 1 ? kernels.block1 : bytes == 4 ? kernels.block4 : 0;
}

}  // namespace

const StretchKernels& StretchKernelsOf(CpuVariant variant) {
#if defined(VORL_X86_KERNELS)
  switch (variant) {
    case CpuVariant::Avx512:
      return kStretchKernelsAvx512;
    case CpuVariant::Avx2:
      return kStretchKernelsAvx2;
    case CpuVariant::Reference:
      break;
  }
#else
  static_cast<void>(variant);
#endif
  return kStretchKernelsRef;
}

const StretchKernels& ActiveStretchKernels() {
  static const StretchKernels& active = StretchKernelsOf(ActiveVariant());
  return active;
}

GatherPlan::GatherPlan(const std::vector<int>& columns, int sourceCount, int bytes,
                       const StretchKernels& kernels)
    : m_gather(GatherFor(bytes, kernels)), m_stream(bytes == 4 ? kernels.stream4 : nullptr) {
  m_blocks.columns = columns.data();
  m_blocks.count = columns.size();
  const std::size_t block = BlockOf(bytes, kernels);
  if (block != 0 && static_cast<std::size_t>(sourceCount) >= block) {
    Prepare(static_cast<std::size_t>(sourceCount), block);
  }
}

// As far as each block's source units fit into a register: all the way where a row is enlarged.
void GatherPlan::Prepare(std::size_t sourceCount, std::size_t block) {
  m_firsts.reserve(m_blocks.count / block);
  m_offsets.reserve(m_blocks.count);
  for (const int* columns = m_blocks.columns; m_blocks.count - m_offsets.size() >= block;
       columns += block) {
    const auto [low, high] = std::minmax_element(columns, columns + block);
    if (static_cast<std::size_t>(*high - *low) >= block) {
      break;
    }
    const int first = std::min(*low, static_cast<int>(sourceCount - block));
    m_firsts.push_back(first);
    for (std::size_t i = 0; i < block; ++i) {
      m_offsets.push_back(static_cast<std::uint8_t>(columns[i] - first));
    }
  }
  m_blocks.blocks = m_firsts.size();
  m_blocks.firsts = m_firsts.data();
  m_blocks.offsets = m_offsets.data();
}

void GatherPlan::Gather(const std::uint8_t* units, std::uint8_t* target) const {
  m_gather(units, m_blocks, target);
}

bool GatherPlan::Stream(const std::uint8_t* units, std::uint8_t* target) const {
  constexpr std::uintptr_t kCacheLine = 64;
  if (m_stream == nullptr || reinterpret_cast<std::uintptr_t>(target) % kCacheLine != 0) {
    return false;
  }
  m_stream(units, m_blocks, target);
  return true;
}

}  // namespace vorl_detail
}  // namespace vorl
