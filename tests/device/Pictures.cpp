#include "Pictures.h"

#include <cstdio>
#include <cstring>

std::uint32_t Colour(int red, int green, int blue) {
  return (static_cast<std::uint32_t>(red) & 255U) |
         (static_cast<std::uint32_t>(green) & 255U) << 8U |
         (static_cast<std::uint32_t>(blue) & 255U) << 16U;
}

std::uint32_t Grey(int value) {
  return Colour(value, value, value);
}

std::string NameOf(Format format) {
  return std::to_string(format.bits) + (format.topDown ? "t" : "b");
}

void Raster::Describe(int columns, int rows, Format format, bool inverted) {
  width = columns;
  height = rows;
  bits = format.bits;
  topDown = format.topDown;
  rowBytes = (width * bits + 31) / 32 * 4;
  std::memset(&header, 0, sizeof header);
  header.h.biSize = 40;
  header.h.biWidth = width;
  header.h.biHeight = topDown ? -height : height;
  header.h.biPlanes = 1;
  header.h.biBitCount = static_cast<std::uint16_t>(bits);
  if (bits > 8) {
    return;
  }
  const int count = 1 << bits;
  header.h.biClrUsed = static_cast<std::uint32_t>(count);
  for (int i = 0; i < count; ++i) {
    const int ascending = i * 255 / (count - 1);
    const auto value = static_cast<std::uint8_t>(inverted ? 255 - ascending : ascending);
    header.colours[i] = RGBQUAD{value, value, value, 0};
  }
}

void Raster::RandomColours(Random& random) {
  for (RGBQUAD& colour : header.colours) {
    colour.rgbRed = static_cast<std::uint8_t>(random.Next() >> 8U);
    colour.rgbGreen = static_cast<std::uint8_t>(random.Next() >> 8U);
    colour.rgbBlue = static_cast<std::uint8_t>(random.Next() >> 8U);
  }
}

std::uint8_t* Raster::Row(int y) const {
  return pixels + static_cast<std::ptrdiff_t>(topDown ? y : height - 1 - y) * rowBytes;
}

std::uint32_t Raster::Get(int x, int y) const {
  const std::uint8_t* row = Row(y);
  if (bits < 8) {
    const int shift = 8 - bits - x * bits % 8;
    return static_cast<std::uint32_t>(row[x * bits / 8] >> shift) & ((1U << bits) - 1U);
  }
  std::uint32_t value = 0;
  for (int k = 0; k < bits / 8; ++k) {
    value |= static_cast<std::uint32_t>(row[x * (bits / 8) + k]) << (8 * k);
  }
  return value;
}

void Raster::Set(int x, int y, std::uint32_t value) {
  std::uint8_t* row = Row(y);
  if (bits < 8) {
    const int shift = 8 - bits - x * bits % 8;
    const std::uint32_t mask = ((1U << bits) - 1U) << shift;
    std::uint8_t& raw = row[x * bits / 8];
    raw = static_cast<std::uint8_t>((raw & ~mask) | ((value << shift) & mask));
    return;
  }
  for (int k = 0; k < bits / 8; ++k) {
    row[x * (bits / 8) + k] = static_cast<std::uint8_t>(value >> (8 * k));
  }
}

void Raster::Fill(std::uint32_t value) {
  for (int y = 0; y < height; ++y) {
    for (int x = 0; x < width; ++x) {
      Set(x, y, value);
    }
  }
}

void Raster::Noise(Random& random) {
  for (int y = 0; y < height; ++y) {
    for (int x = 0; x < width; ++x) {
      const std::uint32_t first = random.Next();
      Set(x, y, first ^ (random.Next() << 7U));
    }
  }
}

void Raster::NoiseFor(Random& random, int destinationBits) {
  for (int y = 0; y < height; ++y) {
    for (int x = 0; x < width; ++x) {
      std::uint32_t value = random.Next();
      value ^= random.Next() << 7U;
      if (destinationBits == 1 && bits != 1) {
        value = (value >> 3U & 1U) != 0 ? 0xFFFFFFU : 0;
      }
      if (destinationBits == 8 && bits > 8) {
        value = ((value & 0xF8U) | 4U) * 0x010101U;
      }
      Set(x, y, value);
    }
  }
}

void Raster::Ramp() {
  for (int y = 0; y < height; ++y) {
    for (int x = 0; x < width; ++x) {
      if (bits == 1) {
        Set(x, y, (x + y) % 3 == 0 ? 1 : 0);
      } else if (bits <= 8) {
        Set(x, y, static_cast<std::uint32_t>((y * 16 + x) & 255));
      } else {
        Set(x, y, Colour(x * 5, y * 7, x * y));
      }
    }
  }
}

Memory::Memory(int columns, int rows, Format format, bool inverted) {
  Describe(columns, rows, format, inverted);
  memory.assign(static_cast<std::size_t>(rowBytes) * static_cast<std::size_t>(height), 0);
  pixels = memory.data();
}

Section::Section(int columns, int rows, Format format, bool inverted)
    : dc(CreateCompatibleDC(nullptr)) {
  Describe(columns, rows, format, inverted);
  Create();
}

Section::Section(int columns, int rows, Format format, const std::vector<std::uint32_t>& colours)
    : dc(CreateCompatibleDC(nullptr)) {
  Describe(columns, rows, format, false);
  header.h.biClrUsed = static_cast<std::uint32_t>(colours.size());
  for (std::size_t i = 0; i < colours.size(); ++i) {
    header.colours[i] = RGBQUAD{static_cast<std::uint8_t>(colours[i] >> 16U),
                                static_cast<std::uint8_t>(colours[i] >> 8U),
                                static_cast<std::uint8_t>(colours[i]), 0};
  }
  Create();
}

void Section::Create() {
  void* memory = nullptr;
  bitmap = CreateDIBSection(dc, Info(), DIB_RGB_COLORS, &memory, nullptr, 0);
  const std::size_t bytes = static_cast<std::size_t>(rowBytes) * static_cast<std::size_t>(height);
  if (dc == nullptr || bitmap == nullptr || memory == nullptr) {
    ReportWord("no-section");
    m_substitute.assign(bytes, 0);
    pixels = m_substitute.data();
    return;
  }
  pixels = static_cast<std::uint8_t*>(memory);
  m_old = SelectObject(dc, bitmap);
  std::memset(pixels, 0, bytes);
}

Section::~Section() {
  if (m_old != nullptr) {
    SelectObject(dc, m_old);
  }
  DeleteDC(dc);
  if (bitmap != nullptr) {
    DeleteObject(bitmap);
  }
}

std::uint32_t Section::Paint(int number) const {
  if (bits == 1) {
    return number % 2 != 0 ? 0xFFFFFFU : 0U;
  }
  if (bits == 4) {
    return Grey(number * 7 % 16 * 17);
  }
  return bits == 8 ? Grey(number * 37 + 40)
                   : Colour(number * 53 + 60, number * 29 + 120, number * 97 + 200);
}

std::uint32_t Section::Ink() const {
  return bits == 1 ? 0xFFFFFFU : bits == 8 ? Grey(200) : Colour(250, 180, 60);
}

Mono::Mono(int columns, int rows, const void* data)
    : dc(CreateCompatibleDC(nullptr)),
      bitmap(CreateBitmap(columns, rows, 1, 1, data)),
      width(columns),
      height(rows),
      m_old(SelectObject(dc, bitmap)) {}

Mono::~Mono() {
  SelectObject(dc, m_old);
  DeleteDC(dc);
  DeleteObject(bitmap);
}

void Mono::Show(const char* key) const {
  CheckSum sum;
  for (int y = 0; y < height; ++y) {
    for (int x = 0; x < width; ++x) {
      const auto value = static_cast<std::uint32_t>(GetPixel(dc, x, y));
      sum.Add(static_cast<std::uint8_t>(value));
      sum.Add(static_cast<std::uint8_t>(value >> 24U));
      if (IsDumping()) {
        std::printf("%c%s",
                    value == 0xFFFFFFU ? '#'
                    : value == 0       ? '.'
                                       : '?',
                    x == width - 1 ? "\n" : "");
      }
    }
  }
  ReportHex(key, sum.Get());
}

static void Print(const Raster& picture) {
  std::printf("-- %dx%d %d bits, rows from the top\n", picture.width, picture.height, picture.bits);
  for (int y = 0; y < picture.height; ++y) {
    for (int x = 0; x < picture.width; ++x) {
      const std::uint32_t value = picture.Get(x, y);
      if (picture.bits == 1) {
        std::printf("%c", value != 0 ? '#' : '.');
      } else {
        std::printf("%0*x ", picture.bits / 4, static_cast<unsigned>(value));
      }
    }
    std::printf("\n");
  }
}

void Show(const Raster& picture) {
  GdiFlush();
  CheckSum sum;
  CheckSum fourth;
  for (int i = 0; i < picture.height; ++i) {
    const int y = picture.topDown ? i : picture.height - 1 - i;
    for (int x = 0; x < picture.width; ++x) {
      const std::uint32_t value = picture.Get(x, y);
      for (int k = 0; k < (picture.bits + 7) / 8 && k < 3; ++k) {
        sum.Add(static_cast<std::uint8_t>(value >> (8 * k)));
      }
      if (picture.bits == 32) {
        fourth.Add(static_cast<std::uint8_t>(value >> 24U));
      }
    }
  }
  ReportHex("crc", sum.Get());
  if (picture.bits == 32) {
    ReportHex("x", fourth.Get());
  }
  if (IsDumping()) {
    Print(picture);
  }
}
