// How an image persists itself.

#include <vorl/Data/dImage.h>

#include <vorl/Data/detail/ImageLayout.h>

inline namespace vorl {

using vorl_detail::ImageFormat;
using vorl_detail::ImageFormatError;
using vorl_detail::ImageLayout;

void dImage::Write(BinaryDataOut& out) {
  out.Write(&m_rect);
  out.WriteU16(m_dataType);
  out.WriteU16(m_dataOrder);
  out.WriteU16(m_rowAlignment);
  out.WriteString(m_channelSequence);
  out.WriteBuffer(m_buffer);
}

void dImage::Read(BinaryDataIn& in) {
  try {
    ReadItems(in);
  } catch (const dStatus& status) {
    Reset();  // half an image is none
    m_status = status;
    throw;
  } catch (...) {
    Reset();
    throw;
  }
}

void dImage::ReadItems(BinaryDataIn& in) {
  dRect rect;
  unsigned short dataType = 0;
  unsigned short dataOrder = 0;
  unsigned short rowAlignment = 0;
  std::string sequence;
  in.Read(&rect);
  in.ReadU16(dataType);
  in.ReadU16(dataOrder);
  in.ReadU16(rowAlignment);
  in.ReadString(sequence);
  // The stored text ends with a zero byte that belongs to it; the names end before it.
  ImageFormat format{rect.width, rect.height, dataType, ScanNumberOfChannels(sequence.c_str()),
                     dataOrder,  rowAlignment};
  if (vorl_detail::CheckImageFormat(format) == ImageFormatError::None) {
    in.RequireBytes(ImageLayout(format).totalBytes);
  }
  m_status = true;  // an image without pixels keeps the status, which may be an old failure
  Init(rect.width, rect.height, dataType, sequence.c_str(), dataOrder, rowAlignment);
  const bool isEmptyImage = rect.IsEmpty() && sequence.c_str()[0] == '\0';
  if (!m_status.IsOK() && !isEmptyImage) {
    throw dStatus(m_status);
  }
  in.ReadBuffer(m_buffer, true);
}

}  // namespace vorl
