#include <study/dicom/JpegHeader.h>

#include <cstddef>

namespace study {
namespace {

constexpr unsigned kStart = 0xD8;
constexpr unsigned kEnd = 0xD9;
constexpr unsigned kScan = 0xDA;
constexpr unsigned kFrameLs = 0xF7;
constexpr unsigned kParametersLs = 0xF8;

constexpr char kCutShort[] = "its header is cut short";
constexpr char kDamaged[] = "its header is damaged";

unsigned Word(std::span<const std::uint8_t> bytes, std::size_t at) {
  return static_cast<unsigned>(bytes[at] << 8 | bytes[at + 1]);
}

/// Frame headers are C0 to CF without the table markers C4, C8 and CC, and JPEG-LS's own.
bool IsFrame(unsigned marker) {
  return marker == kFrameLs ||
         (marker >= 0xC0 && marker <= 0xCF && marker != 0xC4 && marker != 0xC8 && marker != 0xCC);
}

bool StandsAlone(unsigned marker) {
  return marker == 0x01 || (marker >= 0xD0 && marker <= 0xD8);
}

/// How long a segment of one component must be for a decoder to find all its fields.
std::size_t LeastLength(unsigned marker) {
  if (IsFrame(marker)) {
    return 11;
  }
  if (marker == kScan) {
    return 8;
  }
  return marker == kParametersLs ? 13 : 2;
}

/// Checks the fields of a frame header (behind its length).
std::string FrameProblem(std::span<const std::uint8_t> segment, std::uint32_t columns,
                         std::uint32_t rows, unsigned bits) {
  const unsigned precision = segment[2];
  const unsigned height = Word(segment, 3);
  const unsigned width = Word(segment, 5);
  if (width != columns || height != rows) {
    return "it is " + std::to_string(width) + " x " + std::to_string(height) +
           " pixels instead of " + std::to_string(columns) + " x " + std::to_string(rows);
  }
  if (segment[7] != 1) {
    return "it has " + std::to_string(segment[7]) + " channels";
  }
  if (precision < 2 || precision > bits) {
    return "it has samples of " + std::to_string(precision) + " bits";
  }
  return {};
}

}  // namespace

std::string JpegHeaderProblem(std::span<const std::uint8_t> stream, std::uint32_t columns,
                              std::uint32_t rows, unsigned bits) {
  if (stream.size() < 2 || stream[0] != 0xFF || stream[1] != kStart) {
    return kDamaged;
  }
  bool hasFrame = false;
  std::size_t at = 2;
  while (at + 4 <= stream.size()) {
    if (stream[at] != 0xFF) {
      return kDamaged;
    }
    const unsigned marker = stream[at + 1];
    if (marker == 0xFF || StandsAlone(marker)) {
      at += marker == 0xFF ? 1 : 2;
      continue;
    }
    const std::size_t length = Word(stream, at + 2);
    if (marker == kEnd || length < LeastLength(marker) || (hasFrame && IsFrame(marker))) {
      return kDamaged;
    }
    if (length > stream.size() - at - 2) {
      return kCutShort;
    }
    if (IsFrame(marker)) {
      const std::string problem = FrameProblem(stream.subspan(at + 2, length), columns, rows, bits);
      if (!problem.empty()) {
        return problem;
      }
      hasFrame = true;
    } else if (marker == kScan) {
      return hasFrame ? std::string() : kDamaged;
    }
    at += 2 + length;
  }
  return kCutShort;
}

}  // namespace study
