#ifndef VORL_DATA_DDIB_H
#define VORL_DATA_DDIB_H

/// @file
/// An image that the graphics device can draw on and draw from.

#include <vorl/Data/dImaDescriptorDIB.h>
#include <vorl/Data/dImage.h>
#include <vorl/Platform/Gdi.h>

#include <string>

inline namespace vorl {

/// An image whose pixels are those of a DIB section: what is drawn into the section's handle shows
/// in the image, and the other way round.
///
/// *Shape.* One of the layouts of `dImaDescriptorDIB`, in pixel order, with rows a multiple of 4
/// bytes long, whatever alignment is asked for. A fresh section is all zeros.
///
/// *Ownership.* The bitmap owns its section, unless it was made to refer to another bitmap's
/// (`DTM_Reference`): then it shows that one's section and handle, which must outlive it, and
/// deletes neither. A section that is deleted must not be selected into a device context.
///
/// *Errors.* A method that fails returns false and sets and logs the status; a failing `Init`
/// leaves the bitmap reset. Beside the messages of `dImage`, which come from its formats:
/// - "dDIB: unsupported pixel depth: %d * %d bit", "dDIB: invalid size: %ld x %ld";
/// - "initialization error:" and the message of the descriptor or the importer;
/// - "CreateDIBSection failed".
class VORL_API dDIB : public dImage {
 public:
  dDIB();
  /// A deep copy with a section of its own.
  dDIB(const dDIB& source);
  /// `Init(width, height, channels, bitsPerChannel)`.
  dDIB(long width, long height, short channels, short bitsPerChannel);
  /// `Init(filePath)`.
  explicit dDIB(const char* filePath);
  /// `Init(info, bits)`.
  dDIB(const tagBITMAPINFO* info, const void* bits);

  ClassInfo* GetClassInfo() override;
  ~dDIB() override;
  /// Deletes an own section, and forgets the file name.
  void Reset() override;
  /// True when there are pixels.
  bool IsValid() override;
  bool IsValid() const override;
  /// Takes over format and pixels of `source`; the same object: nothing changes, true.
  ///
  /// Another `dDIB`: `DTM_Copy` copies the pixels into plain memory, without a section;
  /// `DTM_TakeOver` moves section, handle and file name and resets the source; `DTM_Reference`
  /// shows the source's section and handle. Any other image is copied into a section of this
  /// bitmap, whatever the mode; with `DTM_TakeOver` it is reset afterwards. A source that cannot be
  /// taken stays as it is.
  bool Init(DataTransferMode mode, dImage& source) override;
  /// Formats the bitmap and creates its section. The row alignment is always 4. Earlier pixels are
  /// lost, also those of the same size.
  bool Init(unsigned long width, unsigned long height, unsigned short dataType,
            const char* channelSequence, unsigned short dataOrder,
            unsigned short rowAlignment) override;

 protected:
  /// Describes the pixels anew; on failure the bitmap is reset.
  void OnInit() override;

 public:
  static dDIB* Create();
  static ClassInfo& CI();

  using dImage::Init;
  /// Formats the bitmap: 1 channel of 1 or 8 bits ("G"), 3 ("BGR") or 4 ("BGRA") of 8 bits.
  bool Init(long width, long height, short channels, short bitsPerChannel);
  /// The same, with values that are 0 taken from the model. No pixels are copied.
  bool Init(const dImage& model, long width, long height, short channels, short bitsPerChannel);
  /// Reads a bitmap file (see `opDIB2Ima`) and remembers its name for `Save`.
  bool Init(const char* filePath);
  /// Copies a bitmap in memory (see `opDIB2Ima`).
  bool Init(const tagBITMAPINFO* info, const void* bits);

  /// A deep copy with a section of its own.
  dDIB& operator=(const dDIB& source);
  dDIB& operator=(const dImage& source);
  /// `Init(DTM_TakeOver, source)`.
  void operator<<=(dImage& source);
  /// Moves this bitmap into `destination`, which gets a copy of the pixels unless it is a `dDIB`;
  /// this bitmap is reset.
  void operator>>=(dImage& destination);

  /// The section; null without one.
  HBITMAP GetHandle() const;
  /// See `dImaDescriptorDIB`: null, or 0, while the bitmap is not valid.
  tagBITMAPINFO* GetHeader() const;
  unsigned short GetBitsPerPixel() const;
  unsigned short GetPaletteSize() const;
  tagRGBQUAD* GetPalette() const;
  /// Makes the colour table of the description, which `Save` and `Combine` use, a grey ramp. False
  /// without a colour table.
  bool ResetPalette(bool ascending);

  /// Writes a bitmap file. A null path stands for the name of the file that the bitmap was read
  /// from; without one for "DIBImage%d.bmp" in the current folder, with a number that counts such
  /// calls of the process from 1. Fails with "dDIB::Save: image is not initialized", or
  /// "dDIB::Save: error:" and the message of `dImaDescriptorDIB::Save`.
  bool Save(const char* filePath, bool overwrite);
  /// True when the file begins as a bitmap file does; then tells its size in pixels, else 0 x 0.
  /// Logs "missing filename(NULL)", "can't open '%s'" or, as information, "'%s' is not a bitmap
  /// file".
  static bool IsBitmapFile(const char* filePath, int& width, int& height);
  /// Draws the source at (x, y) by a ternary raster operation such as SRCCOPY. Fails with "Combine:
  /// missing target bitmap handle", "Combine: missing source bitmap handle", or "Combine: BitBlt
  /// error:'%s'" and the system's reason.
  bool Combine(const dDIB& source, int x, int y, int rasterOperation);

 protected:
  /// The name that `Save` uses for a null path; null for none.
  void SetFileName(const char* filePath);

 private:
  bool TakeImage(DataTransferMode mode, dImage& source);
  bool TakeSection(DataTransferMode mode, dDIB& source);
  bool CreateSection(LogContext& context, unsigned long size);
  bool DrawBits(const dDIB& source, int x, int y, DWORD rasterOperation) const;
  bool Fail(LogContext& context, int line);

  dImaDescriptorDIB m_descriptor;  ///< of this bitmap
  HBITMAP m_handle = nullptr;
  bool m_ownsHandle = false;
  std::string m_fileName;
};

}  // namespace vorl

#endif
