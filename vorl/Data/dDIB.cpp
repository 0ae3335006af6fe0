#include <vorl/Data/dDIB.h>

#include <new>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/detail/ImageLayout.h>
#include <vorl/IO/File/opDIB2Ima.h>
#include <vorl/Platform/detail/Section.h>

inline namespace vorl {

namespace {

constexpr unsigned short kAlignment = 4;

/// An image that is laid out without its pixels: what a section is created for.
class Layout : public dImage {
 public:
  Layout(unsigned long width, unsigned long height, unsigned short dataType, const char* sequence,
         unsigned short dataOrder) {
    vorl_detail::ImageFormat format{width,     height,    dataType, ScanNumberOfChannels(sequence),
                                    dataOrder, kAlignment};
    m_isFormat = vorl_detail::CheckImageFormat(format) == vorl_detail::ImageFormatError::None;
    if (m_isFormat) {
      const vorl_detail::ImageLayout layout(format);
      m_isFormat = layout.FitsImage();
      if (m_isFormat && layout.totalBytes > 0) {
        // `Init` keeps a buffer that has the right size; nobody reads this one.
        static unsigned char placeholder;
        m_buffer.Init(&placeholder, static_cast<unsigned long>(layout.totalBytes), DTM_Reference);
      }
    }
    Init(width, height, dataType, sequence, dataOrder, kAlignment);
  }

  /// False for what no image can be; the status tells why.
  bool IsFormat() const { return m_isFormat; }

 private:
  bool m_isFormat;
};

// The channels of a bitmap layout; null where there is none.
const char* SequenceOf(int channels, int bits) {
  if (channels == 1 && (bits == 1 || bits == 8)) {
    return "G";
  }
  if (channels == 3 && bits == 8) {
    return "BGR";
  }
  return channels == 4 && bits == 8 ? "BGRA" : nullptr;
}

}  // namespace

VORL_REGISTER_CLASS(dDIB, dImage);

dDIB::dDIB() = default;

dDIB::dDIB(const dDIB& source) : dImage() {
  *this = source;
}

dDIB::dDIB(long width, long height, short channels, short bitsPerChannel) {
  Init(width, height, channels, bitsPerChannel);
}

dDIB::dDIB(const char* filePath) {
  Init(filePath);
}

dDIB::dDIB(const tagBITMAPINFO* info, const void* bits) {
  Init(info, bits);
}

dDIB::~dDIB() {
  dDIB::Reset();
}

void dDIB::Reset() {
  dImage::Reset();
  m_descriptor.Reset();
  if (m_ownsHandle) {
    DeleteObject(m_handle);
  }
  m_handle = nullptr;
  m_ownsHandle = false;
  m_lendsPixels = false;
  m_fileName.clear();
}

bool dDIB::IsValid() {
  return dImage::IsValid();
}
bool dDIB::IsValid() const {
  return dImage::IsValid();
}

bool dDIB::Fail(LogContext& context, int line) {
  Reset();
  context.Status(line, m_status);
  return false;
}

void dDIB::OnInit() {
  if (m_descriptor.Init(*this) == nullptr) {
    LogContext context("dDIB::OnInit", __FILE__, __LINE__, true);
    m_status.Set(m_descriptor.GetStatus(), "initialization error:");
    Fail(context, __LINE__);
  }
}

bool dDIB::Init(unsigned long width, unsigned long height, unsigned short dataType,
                const char* channelSequence, unsigned short dataOrder, unsigned short) {
  LogContext context("dDIB::Init", __FILE__, __LINE__, true);
  std::string sequence;  // copied: it may be this bitmap's own
  try {
    sequence = channelSequence != nullptr ? channelSequence : "";
  } catch (const std::bad_alloc&) {
    m_status.Set(false, "out of memory");
    return Fail(context, __LINE__);
  }
  Reset();
  Layout layout(width, height, dataType, sequence.c_str(), dataOrder);
  if (!layout.IsFormat()) {
    m_status = layout.GetStatus();
    return false;  // logged by the layout
  }
  if (m_descriptor.Init(layout) == nullptr) {
    m_status.Set(m_descriptor.GetStatus(), "initialization error:");
    return Fail(context, __LINE__);
  }
  if (!CreateSection(context, layout.GetImageSize())) {
    return false;
  }
  return dImage::Init(width, height, dataType, sequence.c_str(), dataOrder, kAlignment);
}

// Creates the section that the descriptor describes, and refers to its pixels.
bool dDIB::CreateSection(LogContext& context, unsigned long size) {
  void* bits = nullptr;
  const HDC screen = CreateCompatibleDC(nullptr);
  const BITMAPINFO* const info = m_descriptor.GetHeader();
  m_handle = m_isToBeFilled ? vorl_detail::CreateSectionToFill(screen, info, &bits)
                            : CreateDIBSection(screen, info, DIB_RGB_COLORS, &bits, nullptr, 0);
  DeleteDC(screen);
  if (m_handle == nullptr || bits == nullptr) {
    m_status.Set(false, "CreateDIBSection failed");
    return Fail(context, __LINE__);
  }
  m_ownsHandle = true;
  m_lendsPixels = true;
  m_buffer.Init(bits, size, DTM_Reference);
  return true;
}

bool dDIB::Init(long width, long height, short channels, short bitsPerChannel) {
  LogContext context("dDIB::Init", __FILE__, __LINE__, true);
  const char* const sequence = SequenceOf(channels, bitsPerChannel);
  if (sequence == nullptr) {
    m_status.Set(false, "dDIB: unsupported pixel depth: %d * %d bit", channels, bitsPerChannel);
    return Fail(context, __LINE__);
  }
  if (width <= 0 || height <= 0) {
    m_status.Set(false, "dDIB: invalid size: %ld x %ld", width, height);
    return Fail(context, __LINE__);
  }
  return Init(static_cast<unsigned long>(width), static_cast<unsigned long>(height),
              static_cast<unsigned short>(bitsPerChannel), sequence, ImageDataOrder_Pixel,
              kAlignment);
}

bool dDIB::Init(const dImage& model, long width, long height, short channels,
                short bitsPerChannel) {
  return Init(width != 0 ? width : static_cast<long>(model.GetWidth()),
              height != 0 ? height : static_cast<long>(model.GetHeight()),
              channels != 0 ? channels : static_cast<short>(model.GetNumChannels()),
              bitsPerChannel != 0 ? bitsPerChannel : static_cast<short>(model.GetChannelDepth()));
}

bool dDIB::Init(const char* filePath) {
  LogContext context("dDIB::Init", __FILE__, __LINE__, true);
  dDIB named;  // the path may be this bitmap's own, which a reset clears
  named.SetFileName(filePath);
  opDIB2Ima importer;
  m_isToBeFilled = true;
  const bool isRead =
      importer.Convert(filePath != nullptr ? named.m_fileName.c_str() : nullptr, *this);
  m_isToBeFilled = false;
  if (!isRead) {
    m_status.Set(importer.GetStatus(), "initialization error:");
    return Fail(context, __LINE__);
  }
  m_fileName.swap(named.m_fileName);
  return true;
}

bool dDIB::Init(const tagBITMAPINFO* info, const void* bits) {
  LogContext context("dDIB::Init", __FILE__, __LINE__, true);
  opDIB2Ima importer;
  if (!importer.Convert(info, bits, *this)) {
    m_status.Set(importer.GetStatus(), "initialization error:");
    return Fail(context, __LINE__);
  }
  return true;
}

bool dDIB::Init(DataTransferMode mode, dImage& source) {
  if (this == &source) {
    return true;
  }
  if (LendsTo(source)) {
    dImage copy(source);
    if (!TakeImage(DTM_Copy, copy)) {
      return false;
    }
    if (mode == DTM_TakeOver) {
      source.Reset();
    }
    return true;
  }
  auto* const bitmap = dynamic_cast<dDIB*>(&source);
  if (bitmap == nullptr) {
    return TakeImage(mode, source);
  }
  return mode == DTM_Copy ? dImage::Init(mode, source) : TakeSection(mode, *bitmap);
}

// Copies the pixels of an image that has no section into one of this bitmap.
bool dDIB::TakeImage(DataTransferMode mode, dImage& source) {
  if (!Init(source, 0, 0, 0)) {
    return false;
  }
  CopyRows(source);
  if (mode == DTM_TakeOver) {
    source.Reset();
  }
  return IsValid();
}

bool dDIB::TakeSection(DataTransferMode mode, dDIB& source) {
  const HBITMAP handle = source.m_handle;
  const bool takesHandle = mode == DTM_TakeOver && source.m_ownsHandle;
  std::string fileName;
  try {
    fileName = source.m_fileName;
  } catch (const std::bad_alloc&) {
    fileName.clear();
  }
  // The pixels of an own section stay with their handle: they are referred to also when it moves.
  if (!dImage::Init(takesHandle ? DTM_Reference : mode, source)) {
    return false;
  }
  m_handle = handle;
  m_ownsHandle = takesHandle;
  m_lendsPixels = takesHandle;
  m_fileName.swap(fileName);
  if (mode == DTM_TakeOver) {
    source.m_handle = nullptr;
    source.m_ownsHandle = false;
    source.Reset();
  }
  return true;
}

dDIB& dDIB::operator=(const dDIB& source) {
  return *this = static_cast<const dImage&>(source);
}

dDIB& dDIB::operator=(const dImage& source) {
  dImage::operator=(source);
  return *this;
}

void dDIB::operator<<=(dImage& source) {
  Init(DTM_TakeOver, source);
}

void dDIB::operator>>=(dImage& destination) {
  destination <<= *this;
}

}  // namespace vorl
