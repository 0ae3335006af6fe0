#include <vorl/Data/dImage.h>

#include <algorithm>
#include <cstring>
#include <functional>
#include <new>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/detail/ImageLayout.h>

inline namespace vorl {

using vorl_detail::ImageFormat;
using vorl_detail::ImageFormatError;
using vorl_detail::ImageLayout;

namespace {

// False when there is no memory for the copy. A null text is taken as empty.
bool CopyText(const char* text, std::string& copy) {
  try {
    copy.assign(text != nullptr ? text : "");
    return true;
  } catch (const std::bad_alloc&) {
    return false;
  }
}

}  // namespace

VORL_REGISTER_CLASS(dImage, DataBase);

dImage::dImage() {
  dImage::Reset();
  m_status.Set(-1, "not initialized");
}

dImage::dImage(const dImage& source) : DataBase(source), IBinaryDataIO(source) {
  dImage::Reset();
  *this = source;
}

dImage::~dImage() {
  dImage::Reset();
}

void dImage::Reset() {
  m_buffer.Delete();
  m_rect.Reset();
  m_numChannels = 0;
  m_dataType = ImageDataType_U8;
  m_dataOrder = ImageDataOrder_Pixel;
  m_rowAlignment = 1;
  m_pixelBits = 0;
  m_channelOffset = 0;
  m_columnOffset = 0;
  m_rowOffset = 0;
  m_channelOffsetBytes = 0;
  m_channelSequence.clear();
  OnReset();
}

bool dImage::IsValid() const {
  return static_cast<bool>(m_buffer);
}

void dImage::OnInit() {}

void dImage::OnReset() {}

bool dImage::Fail(LogContext& context, int line) {
  context.Status(line, m_status);
  return false;
}

bool dImage::Init(unsigned long width, unsigned long height, unsigned short dataType,
                  const char* channelSequence, unsigned short dataOrder,
                  unsigned short rowAlignment) {
  LogContext context("dImage::Init", __FILE__, __LINE__, true);
  // Copied: the sequence may be this image's own, which a reset clears.
  std::string sequence;
  if (!CopyText(channelSequence, sequence)) {
    Reset();
    m_status.Set(false, "no memory(%zu bytes required)", std::strlen(channelSequence));
    return Fail(context, __LINE__);
  }
  ImageFormat format{width,     height,      dataType, ScanNumberOfChannels(sequence.c_str()),
                     dataOrder, rowAlignment};
  switch (vorl_detail::CheckImageFormat(format)) {
    case ImageFormatError::None:
      break;
    case ImageFormatError::ChannelSequence:
      Reset();
      m_status.Set(false, "invalid 'ChannelSequence':'%s'", sequence.c_str());
      return Fail(context, __LINE__);
    case ImageFormatError::DataType:
      Reset();
      m_status.Set(false, "invalid 'DataType': %d", format.dataType);
      return Fail(context, __LINE__);
    case ImageFormatError::DataOrder:
      Reset();
      m_status.Set(false, "invalid 'DataOrder': %d", format.dataOrder);
      return Fail(context, __LINE__);
    case ImageFormatError::RowAlignment:
      Reset();
      m_status.Set(false, "invalid 'RowAlignment': %d", format.rowAlignment);
      return Fail(context, __LINE__);
  }
  const ImageLayout layout(format);
  if (!layout.FitsImage()) {
    Reset();
    m_status.Set(false, "no memory(%llu bytes required)",
                 static_cast<unsigned long long>(layout.totalBytes));
    return Fail(context, __LINE__);
  }
  if (layout.totalBytes != m_buffer.GetSize()) {
    Reset();
    if (AllocateDataBuffer(static_cast<unsigned long>(layout.totalBytes)) == nullptr) {
      return m_status.IsOK();  // an image without pixels has no failure to report
    }
  }
  SetLayout(layout);
  m_channelSequence.swap(sequence);
  m_status = true;
  OnInit();
  return m_status.IsOK();
}

void dImage::SetLayout(const ImageLayout& layout) {
  m_rect.Set(0, 0, static_cast<unsigned>(layout.format.width),
             static_cast<unsigned>(layout.format.height));
  m_numChannels = static_cast<std::uint16_t>(layout.format.numChannels);
  m_dataType = layout.format.dataType;
  m_dataOrder = layout.format.dataOrder;
  m_rowAlignment = layout.format.rowAlignment;
  m_pixelBits = static_cast<std::uint32_t>(layout.pixelBits);
  m_channelOffset = static_cast<std::uint32_t>(layout.channelOffset);
  m_columnOffset = m_pixelBits / 8;
  m_rowOffset = static_cast<std::uint32_t>(layout.rowBytes);
  m_channelOffsetBytes = m_channelOffset / 8;
}

bool dImage::Init(const dImage& model, unsigned long width, unsigned long height,
                  unsigned short dataType) {
  Init(width != 0 ? width : model.GetWidth(), height != 0 ? height : model.GetHeight(),
       dataType != 0 ? dataType : model.GetDataType(), model.GetChannelSequence(),
       model.GetDataOrder(), model.GetRowAlignment());
  return m_status.IsOK();
}

// Resets this image and gives it the format of `source`. The pixels stay for the transfer that
// follows: the source may refer to them, and the buffer knows how to part from them then. False,
// with the image reset, when there is no memory for the names of the channels.
bool dImage::ResetTo(const dImage& source) {
  std::string sequence;
  if (!CopyText(source.GetChannelSequence(), sequence)) {
    Reset();
    m_status.Set(false, "no memory(%zu bytes required)", source.m_channelSequence.size());
    return false;
  }
  dBuffer pixels;
  pixels <<= m_buffer;
  Reset();
  m_buffer <<= pixels;
  m_rect = source.m_rect;
  m_numChannels = source.m_numChannels;
  m_dataType = source.m_dataType;
  m_dataOrder = source.m_dataOrder;
  m_rowAlignment = source.m_rowAlignment;
  m_pixelBits = source.m_pixelBits;
  m_channelOffset = source.m_channelOffset;
  m_channelSequence.swap(sequence);
  m_columnOffset = source.m_columnOffset;
  m_rowOffset = source.m_rowOffset;
  m_channelOffsetBytes = source.m_channelOffsetBytes;
  m_status = source.m_status;
  return true;
}

// False, with the image reset, when there is no memory for a copy.
bool dImage::TakePixels(dImage& source, DataTransferMode mode) {
  const bool isCopy = mode == DTM_Copy || (mode == DTM_TakeOver && source.m_lendsPixels);
  m_buffer.Init(source.m_buffer, isCopy ? DTM_Copy : mode);
  if (isCopy && source.m_buffer && !m_buffer) {
    Reset();
    m_status.Set(false, "no memory(%lu bytes required)", source.GetImageSize());
    return false;
  }
  return true;
}

bool dImage::LendsTo(const dImage& image) const {
  const std::less<const void*> before;
  const void* const pixels = image.GetDataPtr();
  const auto* const first = static_cast<const unsigned char*>(GetDataPtr());
  return m_lendsPixels && pixels != nullptr && !before(pixels, first) &&
         before(pixels, first + GetImageSize());
}

bool dImage::Init(DataTransferMode mode, dImage& source) {
  LogContext context("dImage::Init", __FILE__, __LINE__, true);
  if (this == &source) {
    return IsValid();
  }
  if (!ResetTo(source)) {
    return Fail(context, __LINE__);
  }
  if (!TakePixels(source, mode)) {
    return Fail(context, __LINE__);
  }
  OnInit();
  if (mode == DTM_TakeOver) {
    source.Reset();
  }
  return IsValid();
}

dImage& dImage::operator=(const dImage& source) {
  if (this == &source) {
    return *this;
  }
  if (LendsTo(source)) {
    const dImage copy(source);
    *this = copy;
    if (!copy.IsValid()) {
      m_status = copy.m_status;
    }
    return *this;
  }
  dBuffer oldPixels;  // kept until the end where the source may refer to a part of them
  if (source.m_buffer.IsReference() && source.GetImageSize() != GetImageSize()) {
    oldPixels <<= m_buffer;
  }
  if (!source.IsValid()) {
    Reset();
  } else if (Init(source, 0, 0, 0)) {
    if (GetImageSize() == source.GetImageSize()) {
      m_buffer = source.m_buffer;
    } else {
      CopyRows(source);
    }
    m_status = source.m_status;
  }
  return *this;
}

void dImage::operator<<=(dImage& source) {
  Init(DTM_TakeOver, source);
}

void dImage::operator>>=(dImage& destination) {
  destination <<= *this;
}

void dImage::CopyRows(const dImage& source) {
  const auto bytes = static_cast<std::size_t>(std::min(m_rowOffset, source.m_rowOffset));
  const auto rows = static_cast<int>(std::min(GetNumRows(), source.GetNumRows()));
  for (int y = 0; y < rows; ++y) {
    std::memcpy(GetRowPtr(y), source.GetRowPtr(y), bytes);
  }
}

bool dImage::Fill(char value) {
  if (!IsValid()) {
    return false;
  }
  std::memset(m_buffer.Get(0), static_cast<unsigned char>(value), m_buffer.GetSize());
  return true;
}

bool dImage::CheckPixelAccess(int x, int y, int channel) {
  LogContext context("dImage::CheckPixelAccess", __FILE__, __LINE__, true);
  if (!IsValid()) {
    m_status.Set(false, "uninitialized image object");
    return Fail(context, __LINE__);
  }
  if (x < 0 || y < 0 || static_cast<unsigned>(x) >= m_rect.width ||
      static_cast<unsigned>(y) >= m_rect.height) {
    m_status.Set(false, "invalid pixel coordinates: %d/%d", x, y);
    return Fail(context, __LINE__);
  }
  if (channel < 0 || channel >= m_numChannels) {
    m_status.Set(false, "invalid channel index: %d", channel);
    return Fail(context, __LINE__);
  }
  return true;
}

void* dImage::AllocateDataBuffer(unsigned long size) {
  LogContext context("dImage::AllocateDataBuffer", __FILE__, __LINE__, true);
  if (size == 0) {
    return nullptr;
  }
  m_buffer.New(size, false);
  if (!m_buffer) {
    m_status.Set(false, "no memory(%lu bytes required)", size);
    context.Status(__LINE__, m_status);
    return nullptr;
  }
  return m_buffer.Get(0);
}

}  // namespace vorl
