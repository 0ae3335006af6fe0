#ifndef VORL_DATA_DIMAGE_H
#define VORL_DATA_DIMAGE_H

/// @file
/// The library's pixel container.

#include <vorl/Common/dStatus.h>
#include <vorl/Data/dBuffer.h>
#include <vorl/Data/dRect.h>
#include <vorl/IO/BinaryDataIO.h>

#include <cstdint>
#include <string>

inline namespace vorl {

class LogContext;

namespace vorl_detail {
struct ImageLayout;
}

/// Data-type codes: the sample width in bits, plus 0x1000 for signed integers or 0x2000 for
/// floating point.
enum ImageDataType : unsigned short {
  ImageDataType_U1 = 0x0001,
  ImageDataType_U8 = 0x0008,
  ImageDataType_U16 = 0x0010,
  ImageDataType_U32 = 0x0020,
  ImageDataType_U64 = 0x0040,
  ImageDataType_S8 = 0x1008,
  ImageDataType_S16 = 0x1010,
  ImageDataType_S32 = 0x1020,
  ImageDataType_S64 = 0x1040,
  ImageDataType_F32 = 0x2020,
  ImageDataType_F64 = 0x2040
};

/// How the channels of an image lie in memory.
enum ImageDataOrder : unsigned short {
  ImageDataOrder_Pixel = 0,  ///< the channels of one pixel are adjacent
  ImageDataOrder_Plane = 1   ///< one complete padded raster per channel, one after another
};

/// A raster of pixels in one contiguous byte buffer.
///
/// *Shape.* `width` x `height` pixels of one or more channels of one data type. The channels are
/// named by a channel sequence, each name an upper-case letter followed by lower-case letters
/// ("RGB", "BGRA", "YCrCb", "G"). They lie in pixel order (interleaved) or plane order. Every row
/// is padded to a multiple of the row alignment (1 to 32 bytes, at least the sample size).
///
/// *Position.* The image rectangle carries a position, which formatting sets to (0, 0).
///
/// *Errors.* A method that fails returns false and sets the status (`GetStatus`), which is also
/// logged. The messages stand with the methods.
///
/// *Ownership.* The image owns its pixels unless it was made to refer to another image's
/// (`DTM_Reference`).
///
/// Derived classes follow a change of format through `OnInit` and `OnReset`.
class VORL_API dImage : public DataBase, public IBinaryDataIO {
 public:
  /// An empty image with the status "not initialized".
  dImage();
  /// A deep copy (see `operator=`).
  dImage(const dImage& source);

  ClassInfo* GetClassInfo() override;
  ~dImage() override;
  /// Frees the pixels and returns to the format of an empty image: no channels, data type 8, pixel
  /// order, row alignment 1. The status stays.
  void Reset() override;
#if defined(__GNUC__)
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Woverloaded-virtual"
#endif
  /// True when the image has pixels. (Asked through a `DataBase` reference, an image answers with
  /// that class's own test, which is false.)
  virtual bool IsValid() const;
#if defined(__GNUC__)
#pragma GCC diagnostic pop
#endif
  /// Takes over the format and the pixels of `source`: `DTM_Copy` copies the pixels,
  /// `DTM_TakeOver` moves them and resets the source (pixels that end with the source, such as
  /// those of a `dDIB`, are copied), `DTM_Reference` refers to them without owning them. The same
  /// object: nothing changes. A source that refers to this image's own pixels, which end here, is
  /// copied in every mode. Any other mode takes the format without the pixels. Returns whether the
  /// image is valid; when there is no memory for a copy the image is reset ("no memory(%d bytes
  /// required)").
  virtual bool Init(DataTransferMode mode, dImage& source);
  /// Formats the image.
  ///
  /// Pixels are kept as they are, neither cleared nor moved, when the new format has the same byte
  /// size as the current one; otherwise they are allocated anew and their values are undefined. A
  /// single channel is always in pixel order; the row alignment is raised to the sample size. A
  /// width or height of 0 gives an image without pixels.
  ///
  /// Fails, leaving the image reset, with
  /// - "invalid 'ChannelSequence':'%s'": no upper-case letter in it;
  /// - "invalid 'DataType': %d": not an `ImageDataType`;
  /// - "invalid 'DataOrder': %d": greater than 1;
  /// - "invalid 'RowAlignment': %d": not 1, 2, 4, 8, 16 or 32;
  /// - "no memory(%d bytes required)": the size is not to be had, or does not fit into 32 bits.
  virtual bool Init(unsigned long width, unsigned long height, unsigned short dataType,
                    const char* channelSequence, unsigned short dataOrder,
                    unsigned short rowAlignment);

 protected:
  /// Called at the end of every (re)format.
  virtual void OnInit();
  /// Called at the end of `Reset`.
  virtual void OnReset();

 public:
  /// Writes rectangle, data type, data order, row alignment, channel sequence and pixels.
  void Write(BinaryDataOut& out) override;
  /// Reads what `Write` wrote. The position is not restored: a read image sits at (0, 0). A format
  /// that asks for more bytes than the file still holds is a short read (-200), a format that
  /// `Init` refuses fails with its status. Whenever reading fails the image is left reset, with the
  /// status that is thrown. An empty image is read like any other, though `Init` reports that it
  /// has no channels.
  void Read(BinaryDataIn& in) override;

  static dImage* Create();
  static ClassInfo& CI();

  /// Formats this image like `model`, without its pixels; a zero `width`, `height` or `dataType` is
  /// taken from the model. Fails like the six-argument `Init`.
  bool Init(const dImage& model, unsigned long width, unsigned long height,
            unsigned short dataType);
  /// Sets every byte of the pixels, row padding included; false when there are none.
  bool Fill(char value);

  /// A deep copy of format, pixels and status, at position (0, 0); an invalid source resets this
  /// image. Pixels of the same byte size are overwritten in place, which for an image that refers
  /// to pixels means those it refers to. `source` may refer to this image's pixels.
  dImage& operator=(const dImage& source);
  /// Moves `source` into this image, as `Init(DTM_TakeOver, source)` of this image's own class
  /// does.
  void operator<<=(dImage& source);
  /// Moves this image into `destination`; this image is reset.
  void operator>>=(dImage& destination);

  /// The outcome of the last failing or formatting operation.
  const dStatus& GetStatus() const;

  // What operators ask of every slice of a volume is answered without a call.

  /// Pixels.
  unsigned long GetWidth() const {
    return m_rect.width;
  }
  /// Pixels.
  unsigned long GetHeight() const {
    return m_rect.height;
  }
  int GetPosX() const;
  int GetPosY() const;
  /// Moves the image rectangle; the size stays.
  void SetPosition(int x, int y);
  void GetImaRect(dRect& rect) const;
  operator dRect&();
  operator const dRect&() const;
  unsigned short GetNumChannels() const;
  /// An `ImageDataType`.
  unsigned short GetDataType() const;
  /// An `ImageDataOrder`.
  unsigned short GetDataOrder() const;
  /// Bytes.
  unsigned short GetRowAlignment() const;
  /// The sample width in bits.
  unsigned short GetChannelDepth() const;
  /// 2 to the power of the sample width, the shift taken modulo 32 and the result cut to 16 bits.
  unsigned short GetChannelLevels() const;
  /// True for signed integers and for floating point.
  bool IsSigned() const;
  bool IsFloat() const;
  /// Bits from one channel of a pixel to the next.
  unsigned long GetChannelOffset() const;
  /// Bits from one pixel of a row to the next.
  unsigned long GetColumnOffset() const;
  /// Bits from one row to the next.
  unsigned long GetRowOffset() const;
  /// Bytes from one row to the next.
  unsigned long GetBytesPerRow() const {
    return m_rowOffset;
  }
  /// Bytes of the whole image.
  unsigned long GetImageSize() const {
    return m_buffer.GetSize();
  }
  /// Samples that fill the image's bytes, padding included.
  unsigned long GetNumDataSamples() const;
  /// Samples that fill a row's bytes, padding included.
  unsigned long GetDataSamplesPerRow() const;
  /// Samples of a row without its padding: the width, times the channels in pixel order.
  unsigned long GetDataSamplesInRow() const;
  /// The number of channels in plane order, else 1.
  unsigned long GetNumPlanes() const;
  /// The rows of all planes.
  unsigned long GetNumRows() const;
  /// Channels << 8 | sample width, plus 0x10000 in plane order. Signed, unsigned and floating-point
  /// images of one layout share an identifier.
  unsigned long GetFormatID() const {
    const unsigned long planes = m_dataOrder == ImageDataOrder_Plane ? 0x10000 : 0;
    return (static_cast<unsigned long>(m_numChannels) << 8) | (m_dataType & 0xFFU) | planes;
  }
  const char* GetChannelSequence() const;
  /// `ScanColorModel` of the channel sequence.
  const char* GetColorModel() const;
  /// `ScanChannelIndex` in the channel sequence.
  int GetChannelIndex(const char* channel) const;
  /// The index of the channel "A"; -1 when there is none.
  int GetAlphaChannelIndex() const;

  dBuffer& GetDataBuffer();
  const dBuffer& GetDataBuffer() const;
  /// The first byte of the pixels; null when there are none. The pointer accessors do no range
  /// checks; pointers are valid until the image is formatted anew.
  void* GetDataPtr() const {
    return m_buffer.Get(0);
  }
  /// The pixel at (x, y). For 1-bit images the start of the row.
  void* GetDataPtr(int x, int y) const;
  /// The sample of a channel at (x, y).
  void* GetDataPtr(int x, int y, int channel) const;
  /// The first byte of a row. In plane order the rows of all planes count on.
  void* GetRowPtr(int y) const;

  /// The text for a data-type code, such as "16 bit unsigned".
  static const char* DataType2Str(unsigned short dataType);
  /// "pixel order", "plane order" or "unknown data order".
  static const char* DataOrder2Str(unsigned short dataOrder);
  /// The number of upper-case letters in the text; 0 for null.
  static int ScanNumberOfChannels(const char* sequence);
  /// The index of the channel with exactly this name; characters before the first upper-case letter
  /// belong to no channel. Logs "uninitialized parameter(s)" for null or "channel '%s' not found in
  /// '%s'" and returns -1.
  static int ScanChannelIndex(const char* sequence, const char* channel);
  /// The colour model of a whole channel sequence: "G", "RGB", "HSV", "HLS", "LUV", "XYZ", "YCrCb"
  /// or "YUV". Empty for null or an empty text, and, after logging "can't map '%s' to a color
  /// model", for any other.
  static const char* ScanColorModel(const char* sequence);

 protected:
  /// True for a pixel and channel inside a valid image. Otherwise sets and logs "uninitialized
  /// image object", "invalid pixel coordinates: %d/%d" or "invalid channel index: %d".
  bool CheckPixelAccess(int x, int y, int channel);
  /// Allocates the pixels. Null without a message for size 0; null with "no memory(%d bytes
  /// required)" when the size is not to be had.
  void* AllocateDataBuffer(unsigned long size);
  /// Copies the pixels of an image of the same format, whose rows may be of another length.
  void CopyRows(const dImage& source);
  /// True when the image shows pixels of this one that end with its `Reset`.
  bool LendsTo(const dImage& image) const;

  dStatus m_status;
  dBuffer m_buffer;
  /// Set by a derived class whose `Reset` ends the pixels that the buffer refers to: whoever is to
  /// take them over gets a copy.
  bool m_lendsPixels = false;

 private:
  bool ResetTo(const dImage& source);
  void SetLayout(const vorl_detail::ImageLayout& layout);
  void ReadItems(BinaryDataIn& in);
  bool TakePixels(dImage& source, DataTransferMode mode);
  bool Fail(LogContext& context, int line);

  dRect m_rect;
  std::uint16_t m_numChannels = 0;
  std::uint16_t m_dataType = ImageDataType_U8;
  std::uint16_t m_dataOrder = ImageDataOrder_Pixel;
  std::uint16_t m_rowAlignment = 1;
  std::uint32_t m_pixelBits = 0;
  std::uint32_t m_channelOffset = 0;  ///< bits
  std::string m_channelSequence;
  std::uint32_t m_columnOffset = 0;        ///< bytes
  std::uint32_t m_rowOffset = 0;           ///< bytes
  std::uint32_t m_channelOffsetBytes = 0;  ///< bytes
};

}  // namespace vorl

#endif
