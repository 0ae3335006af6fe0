#include <vorl/Data/dLUT.h>

#include <limits>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>

inline namespace vorl {

namespace {

constexpr char kInitPrefix[] = "LUT initialization error: ";

bool FitsStartIndex(long value) {
  return value >= std::numeric_limits<std::int32_t>::min() &&
         value <= std::numeric_limits<std::int32_t>::max();
}

// An image takes data types of 16 bits; 0 is none of them.
unsigned short ImageTypeOf(LUTType type) {
  const auto code = static_cast<std::int32_t>(type);
  return code < 0 || code > 0xFFFF ? 0 : static_cast<unsigned short>(code);
}

}  // namespace

VORL_REGISTER_CLASS(dLUT, DataBase);

dLUT::dLUT() {
  dLUT::Reset();
}

dLUT::dLUT(const dLUT& source) : DataBase(source) {
  dLUT::operator=(source);
}

dLUT& dLUT::operator=(const dLUT& source) {
  if (this != &source) {
    m_status = source.m_status;
    m_table = source.m_table;
    m_type = source.m_type;
    m_startIndex = source.m_startIndex;
    m_recalculate = source.m_recalculate;
  }
  return *this;
}

dLUT::~dLUT() = default;

void dLUT::Reset() {
  m_table.Reset();
  m_type = LUTType_U8;
  m_startIndex = 0;
  m_recalculate = false;
}

bool dLUT::IsValid() {
  return m_table.IsValid();
}

bool dLUT::Init(long size, LUTType type, int numChannels, long startIndex) {
  LogContext context("dLUT::Init", __FILE__, __LINE__, true);
  Reset();
  // Negative counts turn into ones that no table can have.
  if (!m_table.Init(static_cast<unsigned long>(size), static_cast<unsigned long>(numChannels),
                    ImageTypeOf(type), "G", ImageDataOrder_Pixel, 4)) {
    m_status.Set(m_table.GetStatus(), kInitPrefix);
    context.Status(__LINE__, m_status);
    return false;
  }
  if (!FitsStartIndex(startIndex)) {
    const unsigned long bytes = m_table.GetImageSize();
    Reset();
    m_status.Set(false, "%sno memory(%lu bytes required)", kInitPrefix, bytes);
    context.Status(__LINE__, m_status);
    return false;
  }
  m_startIndex = static_cast<std::int32_t>(startIndex);
  m_type = type;
  m_status = true;
  CalculateLUT();
  return IsValid();
}

bool dLUT::CalculateLUT() {
  m_table.Fill(0);
  m_recalculate = false;
  return IsValid();
}

unsigned char* dLUT::GetLUT(int channel) {
  if (m_recalculate) {
    CalculateLUT();
  }
  m_recalculate = false;
  return static_cast<unsigned char*>(m_table.GetRowPtr(channel));
}

dLUT::operator dImage&() {
  if (m_recalculate) {
    CalculateLUT();
  }
  return m_table;
}

LUTType dLUT::GetType() const {
  return m_type;
}
long dLUT::GetSize() const {
  return static_cast<long>(m_table.GetWidth());
}
long dLUT::GetNumChannels() const {
  return static_cast<long>(m_table.GetHeight());
}
long dLUT::GetStartIndex() const {
  return m_startIndex;
}
int dLUT::GetDataDepth() const {
  return m_type & 0xFF;
}
const dStatus& dLUT::GetStatus() const {
  return m_status;
}

}  // namespace vorl
