#ifndef VORL_IO_FILE_OPDIB2IMA_H
#define VORL_IO_FILE_OPDIB2IMA_H

/// @file
/// Bitmaps and bitmap files as images.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dImage.h>
#include <vorl/Platform/Gdi.h>

inline namespace vorl {

class LogContext;

namespace vorl_detail {
class BitmapSource;
}

/// Converts a device-independent bitmap, or a bitmap file, into an image.
///
/// *Shape.* The image is in pixel order, its rows a multiple of 4 bytes long, top row first:
///
///     bits per pixel  image                                 rows
///     1               1 bit, "G"                            copied; the colour table is ignored
///     2, 4, 8         8 bit "G" if the colour table is      through the colour table
///                     grey, else 24 bit "BGR"
///     16              24 bit "BGR"                          5 bits per colour, each times 8
///     24              24 bit "BGR"                          copied
///     32              32 bit "BGRA"                         copied, the fourth byte too
///
/// A colour table has as many entries as the header says, or as the bits allow when it says 0; in a
/// file never more than stand before the pixels. An index without an entry is black.
///
/// Bitmaps have a header of 40 bytes, or one of 52, 56, 108 or 124 that goes on behind the same
/// fields, and are not compressed. 16-bit bitmaps with bit masks are read like those without; of
/// 32-bit ones the masks must be those of plain pixels.
///
/// *Errors.* `Convert` returns false, sets and logs the status, and leaves the image reset:
/// - "no name for bitmap file specified", "no bitmap information block specified", "no pixel bits
///   specified": a null pointer;
/// - "unable to open file '%s'", also for folders, pipes and devices;
/// - "file '%s' is not a bitmap file", "file '%s' ends within its header", "file '%s' has sizes
///   that cannot be true", "file '%s' ends within its pixel data";
/// - "opDIB2Ima: unsupported header size: %lu", "opDIB2Ima: invalid number of planes: %d",
///   "opDIB2Ima: unsupported compression: %s", "opDIB2Ima: invalid bitmap size: %ld x %ld",
///   "opDIB2Ima: unsupported pixel depth: %d";
/// - "can't initialize the output image: " and the image's message, or "it has another format": the
///   `Init` of a derived class succeeded, but gave it other pixels than it was asked for.
///
/// What a file claims is compared with its size before anything is allocated.
///
/// As an operator this class does nothing: `Run` succeeds.
class VORL_API opDIB2Ima : public OpBase {
 public:
  /// Converts nothing yet.
  opDIB2Ima();
  /// `Convert(filePath, image)` at once.
  opDIB2Ima(const char* filePath, dImage& image);
  /// `Convert(info, bits, image)` at once.
  opDIB2Ima(const tagBITMAPINFO* info, const void* bits, dImage& image);
  /// Has the status of `source`.
  opDIB2Ima(const opDIB2Ima& source);
  /// Takes the status of `source`.
  opDIB2Ima& operator=(const opDIB2Ima& source);

  /// The record of the object's class: `CI()`, unless a derived class overrides it.
  ClassInfo* GetClassInfo() override;
  ~opDIB2Ima() override;
  /// Returns true.
  bool Reset() override;

 protected:
  /// Returns true.
  bool Prepare() override;
  /// Returns true.
  bool Process() override;

 public:
  /// A new object, which the caller deletes; null without memory.
  static opDIB2Ima* Create();
  /// The record of this class.
  static ClassInfo& CI();

  /// Reads a bitmap file into the image, whose virtual `Init` gives it its format.
  bool Convert(const char* filePath, dImage& image);
  /// Converts a bitmap in memory: `info` is followed by its colour table, `bits` are all its rows,
  /// each a multiple of 4 bytes long. Both may belong to the image itself.
  bool Convert(const tagBITMAPINFO* info, const void* bits, dImage& image);

 protected:
  /// Formats the image for 1, 8, 24 or 32 bits per pixel, through its virtual `Init`, without the
  /// signs of width and height. False, with the status set and logged: "opDIB2Ima: unsupported
  /// pixel depth: %d", and the two kinds of "can't initialize the output image: ".
  bool InitOutputImage(dImage& image, int width, int height, int bitsPerPixel);

 private:
  bool ConvertSource(LogContext& context, vorl_detail::BitmapSource& source, dImage& image);
  bool Fail(LogContext& context, int line, dImage& image);
};

}  // namespace vorl

#endif
