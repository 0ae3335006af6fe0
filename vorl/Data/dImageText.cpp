// The texts of image formats: names of data types and orders, channel sequences, colour models.

#include <vorl/Data/dImage.h>

#include <cstring>
#include <string_view>

#include <vorl/Common/LogContext.h>

inline namespace vorl {

namespace {

bool IsChannelStart(char c) {
  return c >= 'A' && c <= 'Z';
}

struct ColorModel {
  const char* sequence;
  const char* model;
};

constexpr ColorModel kColorModels[] = {{"G", "G"},     {"Gray", "G"},      {"RGB", "RGB"},
                                       {"BGR", "RGB"}, {"RGBA", "RGB"},    {"BGRA", "RGB"},
                                       {"HSV", "HSV"}, {"HLS", "HLS"},     {"LUV", "LUV"},
                                       {"XYZ", "XYZ"}, {"YCrCb", "YCrCb"}, {"YUV", "YUV"}};

}  // namespace

const char* dImage::DataType2Str(unsigned short dataType) {
  switch (dataType) {
    case ImageDataType_U1:
      return "1 bit unsigned";
    case ImageDataType_U8:
      return "8 bit unsigned";
    case ImageDataType_U16:
      return "16 bit unsigned";
    case ImageDataType_U32:
      return "32 bit unsigned";
    case ImageDataType_U64:
      return "64 bit unsigned";
    case ImageDataType_S8:
      return "8 bit signed";
    case ImageDataType_S16:
      return "16 bit signed";
    case ImageDataType_S32:
      return "32 bit signed";
    case ImageDataType_S64:
      return "64 bit signed";
    case ImageDataType_F32:
      return "32 bit floating point";
    case ImageDataType_F64:
      return "64 bit floating point";
    default:
      return "unknown data type";
  }
}

const char* dImage::DataOrder2Str(unsigned short dataOrder) {
  switch (dataOrder) {
    case ImageDataOrder_Pixel:
      return "pixel order";
    case ImageDataOrder_Plane:
      return "plane order";
    default:
      return "unknown data order";
  }
}

int dImage::ScanNumberOfChannels(const char* sequence) {
  int count = 0;
  if (sequence != nullptr) {
    for (const char* c = sequence; *c != '\0'; ++c) {
      count += IsChannelStart(*c) ? 1 : 0;
    }
  }
  return count;
}

int dImage::ScanChannelIndex(const char* sequence, const char* channel) {
  LogContext context("dImage::ScanChannelIndex", __FILE__, __LINE__, true);
  if (sequence == nullptr || channel == nullptr) {
    context.Error(__LINE__, "uninitialized parameter(s)");
    return -1;
  }
  const std::string_view wanted(channel);
  const char* name = sequence;
  while (*name != '\0' && !IsChannelStart(*name)) {
    ++name;
  }
  for (int index = 0; *name != '\0'; ++index) {
    const char* end = name + 1;
    while (*end != '\0' && !IsChannelStart(*end)) {
      ++end;
    }
    if (wanted == std::string_view(name, static_cast<std::size_t>(end - name))) {
      return index;
    }
    name = end;
  }
  context.Error(__LINE__, "channel '%s' not found in '%s'", channel, sequence);
  return -1;
}

const char* dImage::ScanColorModel(const char* sequence) {
  if (sequence == nullptr || *sequence == '\0') {
    return "";
  }
  for (const ColorModel& entry : kColorModels) {
    if (std::strcmp(entry.sequence, sequence) == 0) {
      return entry.model;
    }
  }
  LogContext context("dImage::ScanColorModel", __FILE__, __LINE__, true);
  context.Error(__LINE__, "can't map '%s' to a color model", sequence);
  return "";
}

}  // namespace vorl
