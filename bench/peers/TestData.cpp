#include "TestData.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <random>

namespace peers {
namespace {

constexpr int kAir = 30;
constexpr int kTissue = 950;
constexpr int kBalls = 70;

/// Noise without a pattern, from -255 to 255, small values more often than large ones.
class Noise {
 public:
  explicit Noise(std::uint32_t seed) : m_state(seed * 2654435761U + 1) {}
  int operator()() {
    m_state = m_state * 1664525U + 1013904223U;
    return static_cast<int>(m_state >> 24) + static_cast<int>(m_state >> 16 & 0xFF) - 255;
  }

 private:
  std::uint32_t m_state;
};

/// Up and down between 0 and `period`.
int Wave(int position, int period) {
  return std::abs(position % (2 * period) - period);
}

std::uint16_t InRange(int value) {
  return static_cast<std::uint16_t>(std::clamp(value, 0, kValues - 1));
}

void MakeRow(std::uint16_t* row, int y, int z) {
  Noise noise(static_cast<std::uint32_t>(z * kHeight + y));
  const double up = (y - 0.5 * (kHeight - 1)) / (0.5 * kHeight);
  for (int x = 0; x < kWidth; ++x) {
    const double right = (x - 0.5 * (kWidth - 1)) / (0.5 * kWidth);
    if (right * right + up * up > 1) {
      continue;  // outside the circle: 0
    }
    const double body = std::hypot(right / 0.8, up / 0.6);
    if (body > 1) {
      row[x] = InRange(kAir + noise() / 6);
    } else {
      const int soft = Wave(x + z / 2, 90) + Wave(y - z / 3 + kDepth, 110) + Wave(x + 2 * y, 150);
      row[x] = InRange(kTissue + soft - (body > 0.95 ? 120 : 0) + noise() / 2);
    }
  }
}

/// Brightest in the middle, as bright as before at the edge.
void AddBall(Samples<std::uint16_t>& volume, std::mt19937& random) {
  const auto upTo = [&random](int limit) {
    return static_cast<int>(random() % static_cast<unsigned>(limit));
  };
  const int centre[3] = {110 + upTo(290), 130 + upTo(250), 25 + upTo(250)};
  const int radius = 4 + upTo(18);
  const int brightness = 1000 + upTo(2200);
  for (int z = -radius; z <= radius; ++z) {
    for (int y = -radius; y <= radius; ++y) {
      for (int x = -radius; x <= radius; ++x) {
        const int left = radius * radius - x * x - y * y - z * z;
        if (left > 0) {
          std::uint16_t& voxel = volume[static_cast<std::size_t>(centre[2] + z) * kSliceVoxels +
                                        static_cast<std::size_t>(centre[1] + y) * kWidth +
                                        static_cast<std::size_t>(centre[0] + x)];
          voxel = InRange(voxel + brightness * left / (radius * radius));
        }
      }
    }
  }
}

Samples<std::uint16_t> MakeVolume() {
  Samples<std::uint16_t> volume(kVoxels);
  for (int z = 0; z < kDepth; ++z) {
    for (int y = 0; y < kHeight; ++y) {
      MakeRow(
          &volume[(static_cast<std::size_t>(z) * kHeight + static_cast<std::size_t>(y)) * kWidth],
          y, z);
    }
  }
  std::mt19937 random(7);
  for (int i = 0; i < kBalls; ++i) {
    AddBall(volume, random);
  }
  return volume;
}

Samples<std::uint16_t> MakeImage16() {
  constexpr std::size_t kScale = kImageEdge / kWidth;
  const std::uint16_t* const slice = &Volume()[kDepth / 2 * kSliceVoxels];
  Samples<std::uint16_t> image(kImagePixels);
  Noise noise(1);
  for (std::size_t i = 0; i < kImagePixels; ++i) {
    const int voxel = slice[i / kImageEdge / kScale * kWidth + i % kImageEdge / kScale];
    image[i] = voxel == 0 ? std::uint16_t{0} : InRange(voxel + noise() / 4);
  }
  return image;
}

/// The highest 8 of 12 bits.
Samples<std::uint8_t> MakeImage8(const std::uint16_t* source, std::size_t pixels) {
  Samples<std::uint8_t> image(pixels);
  std::transform(source, source + pixels, image.begin(),
                 [](std::uint16_t value) { return static_cast<std::uint8_t>(value >> 4); });
  return image;
}

Samples<std::uint32_t> MakeImage32(const Samples<std::uint8_t>& grey) {
  Samples<std::uint32_t> image(grey.size());
  Noise noise(2);
  std::transform(grey.begin(), grey.end(), image.begin(), [&noise](std::uint8_t level) {
    const auto blue = static_cast<std::uint32_t>(noise() & 0x3F);
    return 0xFF000000U | std::uint32_t{level} << 16 | (255U - level) << 8 | blue;
  });
  return image;
}

Samples<std::uint8_t> MakeImage24() {
  Samples<std::uint8_t> image;
  image.reserve(3 * kImagePixels);
  for (const std::uint32_t pixel : Image32(kImageEdge)) {
    for (int shift = 0; shift < 24; shift += 8) {
      image.push_back(static_cast<std::uint8_t>(pixel >> shift));
    }
  }
  return image;
}

}  // namespace

const Samples<std::uint16_t>& Volume() {
  static const Samples<std::uint16_t> volume = MakeVolume();
  return volume;
}

const Samples<std::uint16_t>& Image16() {
  static const Samples<std::uint16_t> image = MakeImage16();
  return image;
}

const Samples<std::uint8_t>& Image8(int edge) {
  static const Samples<std::uint8_t> large = MakeImage8(Image16().data(), kImagePixels);
  static const Samples<std::uint8_t> little =
      MakeImage8(&Volume()[kDepth / 3 * kSliceVoxels], kSliceVoxels);
  return edge == kImageEdge ? large : little;
}

const Samples<std::uint32_t>& Image32(int edge) {
  static const Samples<std::uint32_t> large = MakeImage32(Image8(kImageEdge));
  static const Samples<std::uint32_t> little = MakeImage32(Image8(kWidth));
  return edge == kImageEdge ? large : little;
}

const Samples<std::uint8_t>& Image24() {
  static const Samples<std::uint8_t> image = MakeImage24();
  return image;
}

}  // namespace peers
