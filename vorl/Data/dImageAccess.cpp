// The reading side of dImage: accessors and pointers.

#include <vorl/Data/dImage.h>

#include <cstddef>

inline namespace vorl {

namespace {

constexpr unsigned kFlagSigned = 0x1000;
constexpr unsigned kFlagFloat = 0x2000;

}  // namespace

const dStatus& dImage::GetStatus() const {
  return m_status;
}

int dImage::GetPosX() const {
  return m_rect.x;
}
int dImage::GetPosY() const {
  return m_rect.y;
}
void dImage::SetPosition(int x, int y) {
  m_rect.SetPos(x, y);
}
void dImage::GetImaRect(dRect& rect) const {
  rect = m_rect;
}
dImage::operator dRect&() {
  return m_rect;
}
dImage::operator const dRect&() const {
  return m_rect;
}

unsigned short dImage::GetNumChannels() const {
  return m_numChannels;
}
unsigned short dImage::GetDataType() const {
  return m_dataType;
}
unsigned short dImage::GetDataOrder() const {
  return m_dataOrder;
}
unsigned short dImage::GetRowAlignment() const {
  return m_rowAlignment;
}
unsigned short dImage::GetChannelDepth() const {
  return m_dataType & 0xFFU;
}

unsigned short dImage::GetChannelLevels() const {
  return static_cast<unsigned short>(1U << (GetChannelDepth() % 32U));
}

bool dImage::IsSigned() const {
  return (m_dataType & (kFlagSigned | kFlagFloat)) != 0;
}
bool dImage::IsFloat() const {
  return (m_dataType & kFlagFloat) != 0;
}

unsigned long dImage::GetChannelOffset() const {
  return m_channelOffset;
}
unsigned long dImage::GetColumnOffset() const {
  return m_pixelBits;
}
unsigned long dImage::GetRowOffset() const {
  return static_cast<unsigned long>(m_rowOffset) * 8;
}
unsigned long dImage::GetNumDataSamples() const {
  return static_cast<unsigned long>(std::uint64_t{m_buffer.GetSize()} * 8 / GetChannelDepth());
}

unsigned long dImage::GetDataSamplesPerRow() const {
  return static_cast<unsigned long>(std::uint64_t{m_rowOffset} * 8 / GetChannelDepth());
}

unsigned long dImage::GetDataSamplesInRow() const {
  const auto width = static_cast<unsigned long>(m_rect.width);
  return m_dataOrder == ImageDataOrder_Plane ? width : width * m_numChannels;
}

unsigned long dImage::GetNumPlanes() const {
  return m_dataOrder == ImageDataOrder_Plane ? m_numChannels : 1;
}

unsigned long dImage::GetNumRows() const {
  return GetNumPlanes() * static_cast<unsigned long>(m_rect.height);
}

const char* dImage::GetChannelSequence() const {
  return m_channelSequence.c_str();
}
const char* dImage::GetColorModel() const {
  return ScanColorModel(GetChannelSequence());
}

int dImage::GetChannelIndex(const char* channel) const {
  return ScanChannelIndex(GetChannelSequence(), channel);
}

int dImage::GetAlphaChannelIndex() const {
  return GetChannelIndex("A");
}

dBuffer& dImage::GetDataBuffer() {
  return m_buffer;
}
const dBuffer& dImage::GetDataBuffer() const {
  return m_buffer;
}

void* dImage::GetDataPtr(int x, int y) const {
  return GetDataPtr(x, y, 0);
}

void* dImage::GetDataPtr(int x, int y, int channel) const {
  auto* start = static_cast<unsigned char*>(GetDataPtr());
  if (start == nullptr) {
    return nullptr;
  }
  return start + (std::ptrdiff_t{x} * m_columnOffset + std::ptrdiff_t{y} * m_rowOffset +
                  std::ptrdiff_t{channel} * m_channelOffsetBytes);
}

void* dImage::GetRowPtr(int y) const {
  return GetDataPtr(0, y, 0);
}

}  // namespace vorl
