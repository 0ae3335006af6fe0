#ifndef VORL_DATA_DIMADESCRIPTORDIB_H
#define VORL_DATA_DIMADESCRIPTORDIB_H

/// @file
/// An image seen as a device-independent bitmap, and its way into a bitmap file.

#include <vorl/Data/dImage.h>
#include <vorl/Platform/Gdi.h>

#include <cstdint>
#include <vector>

inline namespace vorl {

namespace vorl_detail {
class BitmapFile;
}

/// Describes an existing image as a bitmap and saves it as a bitmap file.
///
/// *Shape.* The image is in pixel order, its rows a multiple of 4 bytes long, and of one of these
/// layouts:
///
///     channels  data type  channel sequence     bits per pixel  colour table
///     1         1          any                  1               2 entries
///     1         8          any                  8               256 entries
///     3         8          any ("BGR" is meant) 24              none
///     4         8          "BGRA"               32              none
///
/// *Ownership.* The image belongs to the caller and must stay as it is while it is described; the
/// information block belongs to the descriptor.
///
/// *Errors.* A method that fails sets and logs the status: "uninitialized image", "image rows are
/// not 4 byte aligned", "not a 'Bitmap' format: %d x %d bit - '%s' - %s" and, allocating, "%s no
/// memory for 'BITMAPINFO' structure".
class VORL_API dImaDescriptorDIB : public DataBase {
 public:
  /// Describes nothing.
  dImaDescriptorDIB();
  /// Describes the image at once.
  explicit dImaDescriptorDIB(dImage& image);
  /// A copy describes the same image with an information block of its own.
  dImaDescriptorDIB(const dImaDescriptorDIB& source);

  /// Describes what `source` describes, with an information block of its own.
  dImaDescriptorDIB& operator=(const dImaDescriptorDIB& source);

  /// The record of the object's class: `CI()`, unless a derived class overrides it.
  ClassInfo* GetClassInfo() override;
  /// The image stays.
  ~dImaDescriptorDIB() override;
  /// Describes nothing from now on; the status stays.
  void Reset() override;
  /// True while an image is described.
  bool IsValid() override;
  /// The same.
  bool IsValid() const;

  /// A new object, which the caller deletes; null without memory.
  static dImaDescriptorDIB* Create();
  /// The record of this class.
  static ClassInfo& CI();

  /// Describes the image: returns the information block, or null on failure.
  ///
  /// The block shows the padded row length as its width and a negative height (top row first), so
  /// that the bitmap's rows are the image's; a colour table is an ascending grey ramp.
  tagBITMAPINFO* Init(dImage& image);
  /// The information block; null without an image. Valid until the next `Init` or `Reset`.
  tagBITMAPINFO* GetHeader() const;
  /// True while the block describes the image as it is now: false without an image, and when the
  /// image has been formatted anew since.
  bool IsCurrent() const;
  /// The first pixel byte of the image, whose it is; null without an image.
  void* GetPixelData() const;
  /// The number of colour-table entries: 2, 256 or 0.
  unsigned short GetPaletteSize() const;
  /// The colour table behind the information header, to be read and changed; null without one.
  tagRGBQUAD* GetPalette() const;
  /// Makes the colour table a grey ramp from black to white, or from white to black. False without
  /// a colour table.
  bool ResetPalette(bool ascending);
  /// Writes the image as an uncompressed bitmap file, bottom row first. Fails with
  /// - "dImaDescriptorDIB: not initialized": no image, or it has changed since it was described;
  /// - "NULL parameter:'FilePath'": a null or empty path;
  /// - "file already exists:'%s'": only without `overwrite`; the file stays;
  /// - "can't remove '%s'": the existing file, or what else has its name, cannot be removed;
  /// - "unable to open file '%s'";
  /// - "error while writing file header to '%s'", "error while writing bitmap info to '%s'", "error
  ///   while writing pixel data to '%s'": the disk is full, for example; the file begun is removed.
  bool Save(const char* filePath, bool overwrite);

  /// The outcome of the last operation that can fail.
  const dStatus& GetStatus() const;

 protected:
  /// True for an image of a bitmap layout; else sets and logs the reason.
  bool CheckImage(dImage* image);

 private:
  std::uint64_t RowCount() const;
  std::uint64_t MemoryRowBytes() const;
  std::uint64_t FileRowBytes() const;
  bool WriteFileHeader(vorl_detail::BitmapFile& file) const;
  bool WriteInfo(vorl_detail::BitmapFile& file) const;
  bool WriteRows(vorl_detail::BitmapFile& file) const;

  dStatus m_status;
  dImage* m_pImage = nullptr;
  std::vector<tagBITMAPINFO> m_block;  ///< as many as hold the header and the colour table
  void* m_pixelData = nullptr;
  std::uint32_t m_imageWidth = 0;
  std::uint32_t m_headerSize = 0;  ///< information header and colour table, in bytes
};

}  // namespace vorl

#endif
