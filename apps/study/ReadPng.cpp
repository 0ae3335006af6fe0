#include <study/Error.h>
#include <study/Pictures.h>
#include <study/PngProblem.h>

#include <fstream>
#include <vector>

#include <png.h>

namespace study {
namespace {

/// No deflated byte stands for more bytes than this: a header that promises more lies.
constexpr std::uintmax_t kLargestExpansion = 1040;

void ReadBytes(png_structp png, png_bytep data, png_size_t size) {
  auto* const file = static_cast<std::ifstream*>(png_get_io_ptr(png));
  if (!file->read(reinterpret_cast<char*>(data), static_cast<std::streamsize>(size))) {
    png_error(png, "it ends too early");
  }
}

/// A PNG file that is being read. The two functions that may be jumped out of do nothing else: see
/// PngProblem.h.
class PngFile {
 public:
  explicit PngFile(std::ifstream& file)
      : m_png(png_create_read_struct(PNG_LIBPNG_VER_STRING, &m_problem, OnPngError, OnPngWarning)),
        m_info(m_png != nullptr ? png_create_info_struct(m_png) : nullptr) {
    if (m_info != nullptr) {
      png_set_read_fn(m_png, &file, ReadBytes);
    }
  }
  PngFile(const PngFile&) = delete;
  PngFile& operator=(const PngFile&) = delete;
  ~PngFile() { png_destroy_read_struct(&m_png, &m_info, nullptr); }

  /// Reads what comes before the pixels, and settles what they become.
  bool ReadHeader();
  bool ReadRows(png_bytepp rows);

  png_uint_32 Width() const { return png_get_image_width(m_png, m_info); }
  png_uint_32 Height() const { return png_get_image_height(m_png, m_info); }
  int Channels() const { return png_get_channels(m_png, m_info); }
  std::uintmax_t RowBytes() const { return png_get_rowbytes(m_png, m_info); }
  const char* Problem() const { return m_problem.Text(); }

 private:
  PngProblem m_problem;
  png_structp m_png;
  png_infop m_info;
};

bool PngFile::ReadHeader() {
  if (m_info == nullptr || setjmp(png_jmpbuf(m_png)) != 0) {
    return false;
  }
  png_read_info(m_png, m_info);
  if (png_get_bit_depth(m_png, m_info) == 16) {
    png_error(m_png, "it has 16 bits per sample, 8 are the most");
  }
  png_set_expand(m_png);  // palettes to colours, fewer bits to 8, a transparent colour to a channel
  if ((png_get_color_type(m_png, m_info) & PNG_COLOR_MASK_COLOR) == 0 &&
      ((png_get_color_type(m_png, m_info) & PNG_COLOR_MASK_ALPHA) != 0 ||
       png_get_valid(m_png, m_info, PNG_INFO_tRNS) != 0)) {
    png_set_gray_to_rgb(m_png);  // grey with transparency has no layout of its own
  }
  png_set_bgr(m_png);
  png_set_interlace_handling(m_png);
  png_read_update_info(m_png, m_info);
  return true;
}

bool PngFile::ReadRows(png_bytepp rows) {
  if (setjmp(png_jmpbuf(m_png)) != 0) {
    return false;
  }
  png_read_image(m_png, rows);
  png_read_end(m_png, nullptr);
  return true;
}

/// Formats the image as the file says.
void Format(const PngFile& png, std::uintmax_t fileSize, dImage& image) {
  if (png.RowBytes() * png.Height() / kLargestExpansion > fileSize) {
    throw Error("it is too short for its size");
  }
  const int channels = png.Channels();
  const char* const sequence = channels == 1 ? "G" : channels == 3 ? "BGR" : "BGRA";
  if (!image.Init(png.Width(), png.Height(), ImageDataType_U8, sequence, ImageDataOrder_Pixel, 4) ||
      !image.Fill(0)) {
    throw Error("no memory for the picture");
  }
}

void Read(std::ifstream& file, std::uintmax_t fileSize, dImage& image) {
  PngFile png(file);
  if (!png.ReadHeader()) {
    throw Error(png.Problem());
  }
  Format(png, fileSize, image);
  std::vector<png_bytep> rows;
  for (unsigned long y = 0; y < image.GetHeight(); ++y) {
    rows.push_back(static_cast<png_bytep>(image.GetRowPtr(static_cast<int>(y))));
  }
  if (!png.ReadRows(rows.data())) {
    throw Error(png.Problem());
  }
}

}  // namespace

void LoadPng(const std::filesystem::path& path, dImage& image) {
  try {
    std::error_code error;
    if (!std::filesystem::is_regular_file(path, error)) {
      throw Error("there is no such file");
    }
    std::ifstream file(path, std::ios::binary);
    if (!file) {
      throw Error("it can't be opened");
    }
    Read(file, std::filesystem::file_size(path, error), image);
  } catch (const Error& error) {
    image.Reset();
    throw Error("can't read " + Quoted(path.string()) + ": " + error.what());
  }
}

}  // namespace study
