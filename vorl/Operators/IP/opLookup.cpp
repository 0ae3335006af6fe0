#include <vorl/Operators/IP/opLookup.h>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Operators/IP/kernels/ImageCheck.h>
#include <vorl/Operators/IP/kernels/Pixels.h>
#include <vorl/Operators/IP/kernels/RowLoop.h>

inline namespace vorl {

namespace {

enum LookupMode { kNone = -1, kEightToEight = 0, kSixteenToEight = 1 };

template <class T>
bool MapRows(const vorl_detail::RunControl& control, const dImage& source, const dImage& target,
             const vorl_detail::LookupTable& table) {
  return vorl_detail::ForEachRow(control, source.GetNumRows(), [&](std::size_t row) {
    vorl_detail::LookupRunRef(vorl_detail::RowOf<const T>(source, row),
                              vorl_detail::RowOf<std::uint8_t>(target, row),
                              source.GetDataSamplesInRow(), table);
  });
}

// The application may have exchanged the table's buffer through its image.
bool HoldsEntries(dLUT& lut) {
  lut.GetLUT(0);  // brings the table up to date
  return vorl_detail::HoldsRows(static_cast<dImage&>(lut));
}

}  // namespace

VORL_REGISTER_CLASS(opLookup, OpBase);

opLookup::opLookup() {
  opLookup::Reset();
}

opLookup::opLookup(dImage* source, dImage* target, dLUT* lut)
    : m_pSource(source), m_pTarget(target), m_pLUT(lut) {
  OpBase::Run();
}

opLookup::opLookup(const opLookup& source) = default;
opLookup& opLookup::operator=(const opLookup& source) = default;

opLookup::~opLookup() {
  Terminate();
  opLookup::Reset();
}

bool opLookup::Reset() {
  m_pSource = nullptr;
  m_pTarget = nullptr;
  m_pLUT = nullptr;
  m_lookupMode = kNone;
  return true;
}

bool opLookup::Prepare() {
  m_lookupMode = kNone;
  if (m_pSource == nullptr) {
    m_status.Set(false, "missing source image");
  } else if (!m_pSource->IsValid()) {
    m_status.Set(false, "uninitialized source image");
  } else if (m_pSource->GetNumChannels() != 1) {
    m_status.Set(false, "multi channel(%d) source images are not supported",
                 m_pSource->GetNumChannels());
  } else if (m_pSource->GetChannelDepth() != 8 && m_pSource->GetChannelDepth() != 16) {
    m_status.Set(false, "invalid channel depth:%d bit(must be 8 or 16 bit)",
                 m_pSource->GetChannelDepth());
  } else if (m_pLUT == nullptr) {
    m_status.Set(false, "missing LUT");
  } else if (!m_pLUT->IsValid()) {
    m_status.Set(false, "uninitialized LUT");
  } else if (m_pLUT->GetNumChannels() != 1) {
    m_status.Set(false, "LUT has more(%ld) than 1 channel", m_pLUT->GetNumChannels());
  } else if (m_pLUT->GetDataDepth() != 8) {
    m_status.Set(false, "data depth of the LUT(%d bit) must be 8 bit", m_pLUT->GetDataDepth());
  } else if (!vorl_detail::HoldsRows(*m_pSource)) {
    m_status.Set(false, "invalid pixel data in the source image");
  } else if (!HoldsEntries(*m_pLUT)) {
    m_status.Set(false, "invalid entries in the LUT");
  } else {
    m_lookupMode = m_pSource->GetChannelDepth() == 8 ? kEightToEight : kSixteenToEight;
    m_status = true;
    return true;
  }
  return false;
}

bool opLookup::Process() {
  switch (m_lookupMode) {
    case kEightToEight:
      return Lookup8to8();
    case kSixteenToEight:
      return Lookup16to8();
    default:
      return false;
  }
}

bool opLookup::Map(const dImage& source, const dImage& target) {
  const std::uint8_t* entries = m_pLUT->GetLUT(0);
  const vorl_detail::LookupTable table{entries, m_pLUT->GetStartIndex(), m_pLUT->GetSize()};
  const vorl_detail::RunControl control{m_stopRequested, m_progress};
  bool finished = false;
  switch (source.GetDataType()) {
    case ImageDataType_U8:
      finished = MapRows<std::uint8_t>(control, source, target, table);
      break;
    case ImageDataType_S8:
      finished = MapRows<std::int8_t>(control, source, target, table);
      break;
    case ImageDataType_U16:
      finished = MapRows<std::uint16_t>(control, source, target, table);
      break;
    default:  // the last type of 8 or 16 bits
      finished = MapRows<std::int16_t>(control, source, target, table);
      break;
  }
  return finished || Stopped();
}

bool opLookup::Lookup8to8() {
  dImage* target = m_pTarget != nullptr ? m_pTarget : m_pSource;
  if (target != m_pSource && !target->Init(*m_pSource, 0, 0, 0)) {
    m_status.Set(target->GetStatus(), "error while creating image buffer:");
    return false;
  }
  return Map(*m_pSource, *target);
}

bool opLookup::Lookup16to8() {
  dImage result;
  if (!result.Init(*m_pSource, 0, 0, static_cast<unsigned short>(m_pLUT->GetType()))) {
    m_status.Set(result.GetStatus(), "error while creating image buffer:");
    return false;
  }
  if (!Map(*m_pSource, result)) {
    return false;
  }
  (m_pTarget != nullptr ? *m_pTarget : *m_pSource) <<= result;
  return true;
}

}  // namespace vorl
