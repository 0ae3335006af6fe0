#ifndef VORL_TESTS_DEVICE_PICTURES_H
#define VORL_TESTS_DEVICE_PICTURES_H

#include "Device.h"
#include "Harness.h"

#include <cstdint>
#include <string>
#include <vector>

std::uint32_t Colour(int red, int green, int blue);
std::uint32_t Grey(int value);

struct Format {
  int bits;
  bool topDown;
};
inline constexpr Format kFormats[8] = {{32, true}, {24, false}, {8, true}, {1, false},
                                       {24, true}, {32, false}, {1, true}, {8, false}};
inline constexpr int kDepths[4] = {1, 8, 24, 32};
std::string NameOf(Format format);

/// A header with room for 256 colours.
struct Header {
  BITMAPINFOHEADER h;
  RGBQUAD colours[256];
};

/// The description of a picture, and its pixels wherever they are. Row 0 is the top row.
struct Raster {
  int width = 0;
  int height = 0;
  int bits = 0;
  int rowBytes = 0;
  bool topDown = true;
  std::uint8_t* pixels = nullptr;
  Header header;

  /// Up to 8 bits get grey colours, ascending or, inverted, descending.
  void Describe(int columns, int rows, Format format, bool inverted);
  void RandomColours(Random& random);
  BITMAPINFO* Info() { return reinterpret_cast<BITMAPINFO*>(&header); }

  std::uint8_t* Row(int y) const;
  std::uint32_t Get(int x, int y) const;
  void Set(int x, int y, std::uint32_t value);

  void Fill(std::uint32_t value);
  void Noise(Random& random);
  /// Pixels whose conversion to the given depth is the same whatever the device does for colours
  /// that are not in the destination's table: black and white for 1 bit; for 8 bits the greys 4,
  /// 12, 20 ... 252.
  void NoiseFor(Random& random, int destinationBits);
  void Ramp();
};

/// A picture in plain memory.
struct Memory : Raster {
  Memory(int columns, int rows, Format format, bool inverted = false);
  std::vector<std::uint8_t> memory;
};

/// A bitmap section, selected into a memory context of its own. Its pixels start as 0.
struct Section : Raster {
  Section(int columns, int rows, Format format, bool inverted = false);
  /// With colours of the caller's.
  Section(int columns, int rows, Format format, const std::vector<std::uint32_t>& colours);
  Section(const Section&) = delete;
  Section& operator=(const Section&) = delete;
  ~Section();

  /// A colour that the section's format holds exactly, different for different numbers.
  std::uint32_t Paint(int number) const;
  std::uint32_t Ink() const;

  HDC dc;
  HBITMAP bitmap = nullptr;

 private:
  void Create();
  HGDIOBJ m_old = nullptr;
  std::vector<std::uint8_t> m_substitute;  // where the section could not be made
};

/// A monochrome device bitmap in a context of its own.
struct Mono {
  Mono(int columns, int rows, const void* data = nullptr);
  Mono(const Mono&) = delete;
  Mono& operator=(const Mono&) = delete;
  ~Mono();
  void Show(const char* key) const;

  HDC dc;
  HBITMAP bitmap;
  int width;
  int height;

 private:
  HGDIOBJ m_old;
};

/// Adds the check sum of a picture to the line: of its pixel bytes without padding, and of the
/// fourth bytes of 32 bits apart from that.
void Show(const Raster& picture);

#endif
