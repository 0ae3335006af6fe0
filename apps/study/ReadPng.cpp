#include <study/Error.h>
#include <study/Pictures.h>

#include <cstdio>
#include <memory>
#include <string>
#include <vector>

#include <png.h>

namespace study {
namespace {

/// No deflated byte stands for more bytes than this: a header that promises more lies.
constexpr std::uintmax_t kLargestExpansion = 1040;

struct CloseFile {
  void operator()(std::FILE* file) const { std::fclose(file); }
};

/// What the reading functions of the PNG library share.
struct PngReading {
  std::FILE* file = nullptr;
  dImage* image = nullptr;
  std::vector<png_bytep> rows;
  std::uintmax_t fileSize = 0;
  std::string problem;
};

void OnError(png_structp png, png_const_charp message) {
  auto* reading = static_cast<PngReading*>(png_get_error_ptr(png));
  if (reading->problem.empty()) {
    reading->problem = message;
  }
  png_longjmp(png, 1);
}

void OnWarning(png_structp, png_const_charp) {}

/// Formats the image and lists its rows; false with the problem.
bool MakeRows(PngReading& reading, png_structp png, png_infop info) {
  const unsigned long height = png_get_image_height(png, info);
  const std::uintmax_t bytes = std::uintmax_t{png_get_rowbytes(png, info)} * height;
  if (bytes / kLargestExpansion > reading.fileSize) {
    reading.problem = "it is too short for its size";
    return false;
  }
  const int channels = png_get_channels(png, info);
  const char* const sequence = channels == 1 ? "G" : channels == 3 ? "BGR" : "BGRA";
  if (!reading.image->Init(png_get_image_width(png, info), height, ImageDataType_U8, sequence,
                           ImageDataOrder_Pixel, 4) ||
      !reading.image->Fill(0)) {
    reading.problem = "no memory for the picture";
    return false;
  }
  for (unsigned long y = 0; y < height; ++y) {
    reading.rows.push_back(static_cast<png_bytep>(reading.image->GetRowPtr(static_cast<int>(y))));
  }
  return true;
}

/// Everything that may be jumped out of: only trivial objects live here.
bool ReadImage(PngReading& reading) {
  png_structp png = png_create_read_struct(PNG_LIBPNG_VER_STRING, &reading, OnError, OnWarning);
  png_infop info = png != nullptr ? png_create_info_struct(png) : nullptr;
  if (info == nullptr || setjmp(png_jmpbuf(png)) != 0) {
    png_destroy_read_struct(&png, &info, nullptr);
    return false;
  }
  png_init_io(png, reading.file);
  png_read_info(png, info);
  if (png_get_bit_depth(png, info) == 16) {
    png_error(png, "it has 16 bits per sample, 8 are the most");
  }
  png_set_expand(png);  // palettes to colours, fewer bits to 8, a transparent colour to a channel
  if ((png_get_color_type(png, info) & PNG_COLOR_MASK_COLOR) == 0 &&
      ((png_get_color_type(png, info) & PNG_COLOR_MASK_ALPHA) != 0 ||
       png_get_valid(png, info, PNG_INFO_tRNS) != 0)) {
    png_set_gray_to_rgb(png);  // grey with transparency has no layout of its own
  }
  png_set_bgr(png);
  png_set_interlace_handling(png);
  png_read_update_info(png, info);
  if (!MakeRows(reading, png, info)) {
    png_destroy_read_struct(&png, &info, nullptr);
    return false;
  }
  png_read_image(png, reading.rows.data());
  png_read_end(png, nullptr);
  png_destroy_read_struct(&png, &info, nullptr);
  return true;
}

}  // namespace

void LoadPng(const std::filesystem::path& path, dImage& image) {
  std::error_code error;
  if (!std::filesystem::is_regular_file(path, error)) {
    throw Error("can't read " + Quoted(path.string()) + ": there is no such file");
  }
  PngReading reading;
  reading.fileSize = std::filesystem::file_size(path, error);
  const std::unique_ptr<std::FILE, CloseFile> file(std::fopen(path.string().c_str(), "rb"));
  if (file == nullptr) {
    throw Error("can't read " + Quoted(path.string()) + ": it can't be opened");
  }
  reading.file = file.get();
  reading.image = &image;
  if (!ReadImage(reading)) {
    image.Reset();
    throw Error("can't read " + Quoted(path.string()) + ": " +
                (reading.problem.empty() ? "no memory" : reading.problem));
  }
}

}  // namespace study
