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
  /// Without pixels.
  dDIB();
  /// A deep copy with a section of its own.
  dDIB(const dDIB& source);
  /// `Init(width, height, channels, bitsPerChannel)`; `IsValid` tells whether it succeeded.
  dDIB(long width, long height, short channels, short bitsPerChannel);
  /// `Init(filePath)`; `IsValid` tells whether it succeeded.
  explicit dDIB(const char* filePath);
  /// `Init(info, bits)`; `IsValid` tells whether it succeeded.
  dDIB(const tagBITMAPINFO* info, const void* bits);

  /// The record of the object's class: `CI()`, unless a derived class overrides it.
  ClassInfo* GetClassInfo() override;
  /// Deletes an own section.
  ~dDIB() override;
  /// Leaves no pixels: deletes an own section, and forgets the description and the file name.
  void Reset() override;
  /// True when there are pixels; whether they are a section's, `GetHandle` tells.
  bool IsValid() override;
  /// The same.
  bool IsValid() const override;
  /// Takes over format and pixels of `source`; the same object: nothing changes, true.
  ///
  /// Another `dDIB`: `DTM_Copy` copies the pixels into plain memory, without a section;
  /// `DTM_TakeOver` moves section, handle and file name and resets the source; `DTM_Reference`
  /// shows the source's section and handle. Any other image is copied into a section of this
  /// bitmap, whatever the mode; with `DTM_TakeOver` it is reset afterwards. A source that cannot be
  /// taken stays as it is.
  bool Init(DataTransferMode mode, dImage& source) override;
  /// Formats the bitmap and creates its section, all zeros. The row alignment is always 4, the
  /// order of one channel always by pixels, whatever is asked for. Earlier pixels are lost, also
  /// those of the same size, and so is the file name. Fails for what `dImage::Init` refuses, with
  /// its message, with "initialization error:" and the descriptor's for what no bitmap is, and with
  /// "CreateDIBSection failed"; the bitmap is then reset.
  bool Init(unsigned long width, unsigned long height, unsigned short dataType,
            const char* channelSequence, unsigned short dataOrder,
            unsigned short rowAlignment) override;

 protected:
  /// Describes the pixels anew. Called whenever the format changes; a derived class calls it first
  /// when it overrides it. When a file is read, the pixels come later. Fails with "initialization
  /// error:" and the descriptor's message; the bitmap is then reset.
  void OnInit() override;

 public:
  /// A new object, which the caller deletes; null without memory.
  static dDIB* Create();
  /// The record of this class.
  static ClassInfo& CI();

  using dImage::Init;
  /// Formats the bitmap: 1 channel of 1 or 8 bits ("G"), 3 ("BGR") or 4 ("BGRA") of 8 bits. Width
  /// and height are in pixels. Fails with "dDIB: unsupported pixel depth: %d * %d bit" (channels,
  /// bits), "dDIB: invalid size: %ld x %ld", and like the six-argument `Init`; the bitmap is then
  /// reset.
  bool Init(long width, long height, short channels, short bitsPerChannel);
  /// The same, with values that are 0 taken from the model, which may be this bitmap. No pixels are
  /// copied, and channels have the names of the bitmap's layout, not the model's.
  bool Init(const dImage& model, long width, long height, short channels, short bitsPerChannel);
  /// Reads a bitmap file (see `opDIB2Ima`) into a section and remembers its name for `Save`. Fails
  /// with "initialization error:" and the importer's message; the bitmap is then reset.
  bool Init(const char* filePath);
  /// Copies a bitmap in memory (see `opDIB2Ima`) into a section; `info` and `bits` may be this
  /// bitmap's own. Fails with "initialization error:" and the importer's message; the bitmap is
  /// then reset.
  bool Init(const tagBITMAPINFO* info, const void* bits);

  /// A deep copy with a section of its own.
  dDIB& operator=(const dDIB& source);
  dDIB& operator=(const dImage& source);
  /// `Init(DTM_TakeOver, source)`.
  void operator<<=(dImage& source);
  /// Moves this bitmap into `destination`, which gets a copy of the pixels unless it is a `dDIB`;
  /// this bitmap is reset.
  void operator>>=(dImage& destination);

  /// The section, to be selected into a device context; null without one. It stays the bitmap's:
  /// do not delete it, and select it out before the bitmap is formatted anew, reset or destroyed.
  HBITMAP GetHandle() const;
  /// The description of the pixels: the padded row length as width, a negative height, the colour
  /// table. Null while the bitmap is not valid. It is the bitmap's own and valid until the next
  /// format.
  tagBITMAPINFO* GetHeader() const;
  /// 1, 8, 24 or 32; 0 while the bitmap is not valid.
  unsigned short GetBitsPerPixel() const;
  /// The entries of the colour table: 2 or 256; 0 for 24 and 32 bits, and while the bitmap is not
  /// valid.
  unsigned short GetPaletteSize() const;
  /// The colour table of the description, which `Save` and `Combine` use; null without one. What is
  /// written there does not reach the section: that keeps the ascending ramp it was created with.
  tagRGBQUAD* GetPalette() const;
  /// Makes that colour table a grey ramp from black to white, or from white to black. False without
  /// one.
  bool ResetPalette(bool ascending);

  /// Writes a bitmap file, bottom row first (see `dImaDescriptorDIB::Save`). An existing file fails
  /// without `overwrite`, and is replaced with it. A null path stands for the name of the file that
  /// the bitmap was read from; without one for "DIBImage%d.bmp" in the current folder, with a
  /// number that counts such calls of the process from 1. Fails with "dDIB::Save: image is not
  /// initialized", or "dDIB::Save: error:" and the message of `dImaDescriptorDIB::Save`.
  bool Save(const char* filePath, bool overwrite);
  /// True when the file begins as a bitmap file does; then tells its size in pixels, without signs,
  /// else 0 x 0. That the file can be read is not said. Logs "missing filename(NULL)", "can't open
  /// '%s'" or, as information, "'%s' is not a bitmap file".
  static bool IsBitmapFile(const char* filePath, int& width, int& height);
  /// Draws the source into this section with its upper left corner at (x, y), in pixels, by a
  /// ternary raster operation such as SRCCOPY; what lies outside is left out. A source of 1 or 8
  /// bits is drawn through its colour table. This bitmap must not be selected into another context;
  /// the source may be, and may be this bitmap. Fails with "Combine:
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
  bool m_isToBeFilled = false;  ///< a file is read, and writes every byte of the section
  std::string m_fileName;
};

}  // namespace vorl

#endif
