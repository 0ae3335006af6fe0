#include <study/Error.h>
#include <study/OutputFile.h>
#include <study/Pictures.h>
#include <study/PngProblem.h>

#include <bit>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <vector>

#include <png.h>

namespace study {
namespace {

/// What the writing functions of the PNG library share.
struct PngJob {
  std::FILE* file = nullptr;
  PngProblem problem;
};

const char* WritingProblem() {
  return errno != 0 ? std::strerror(errno) : "the writing failed";
}

void WriteBytes(png_structp png, png_bytep data, png_size_t size) {
  auto* job = static_cast<PngJob*>(png_get_io_ptr(png));
  errno = 0;
  if (std::fwrite(data, 1, size, job->file) != size) {
    png_error(png, WritingProblem());
  }
}

void FlushBytes(png_structp) {}

/// Everything that may be jumped out of: see PngProblem.h.
bool WriteImage(PngJob& job, const dImage& image, png_bytepp rows) {
  png_structp png =
      png_create_write_struct(PNG_LIBPNG_VER_STRING, &job.problem, OnPngError, OnPngWarning);
  png_infop info = png != nullptr ? png_create_info_struct(png) : nullptr;
  if (info == nullptr || setjmp(png_jmpbuf(png)) != 0) {
    png_destroy_write_struct(&png, &info);
    return false;
  }
  const bool colour = image.GetNumChannels() == 3;
  png_set_write_fn(png, &job, WriteBytes, FlushBytes);
  png_set_IHDR(png, info, static_cast<png_uint_32>(image.GetWidth()),
               static_cast<png_uint_32>(image.GetHeight()), image.GetChannelDepth(),
               colour ? PNG_COLOR_TYPE_RGB : PNG_COLOR_TYPE_GRAY, PNG_INTERLACE_NONE,
               PNG_COMPRESSION_TYPE_DEFAULT, PNG_FILTER_TYPE_DEFAULT);
  png_write_info(png, info);
  if (colour) {
    png_set_bgr(png);
  }
  if (image.GetChannelDepth() == 16 && std::endian::native == std::endian::little) {
    png_set_swap(png);
  }
  png_write_image(png, rows);
  png_write_end(png, info);
  png_destroy_write_struct(&png, &info);
  return true;
}

void CheckImage(const dImage& image) {
  const bool grey = image.GetNumChannels() == 1 && (image.GetDataType() == ImageDataType_U8 ||
                                                    image.GetDataType() == ImageDataType_U16);
  const bool colour = image.GetDataType() == ImageDataType_U8 &&
                      image.GetDataOrder() == ImageDataOrder_Pixel &&
                      std::strcmp(image.GetChannelSequence(), "BGR") == 0;
  if (!image.IsValid() || !(grey || colour)) {
    throw Error("only grey images of 8 or 16 bits and BGR images can be written as PNG");
  }
}

}  // namespace

void SavePng(const dImage& image, const std::filesystem::path& path) {
  CheckImage(image);
  OutputFile output(path);
  std::vector<png_bytep> rows;
  for (unsigned long y = 0; y < image.GetHeight(); ++y) {
    rows.push_back(static_cast<png_bytep>(image.GetRowPtr(static_cast<int>(y))));
  }

  PngJob job;
  job.file = std::fopen(output.TemporaryPath().string().c_str(), "wb");
  if (job.file == nullptr) {
    throw Error("can't write " + Quoted(path.string()) + ": " + std::strerror(errno));
  }
  bool written = WriteImage(job, image, rows.data());
  errno = 0;
  if (std::fclose(job.file) != 0 && written) {
    job.problem.Set(WritingProblem());
    written = false;
  }
  if (!written) {
    throw Error("can't write " + Quoted(path.string()) + ": " + job.problem.Text());
  }
  output.Commit();
}

}  // namespace study
