#include <vorl/Operators/IP/opLookup.h>

#include <cstdint>
#include <optional>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/dWindowingLUT.h>
#include <vorl/Operators/IP/kernels/ImageCheck.h>
#include <vorl/Operators/IP/kernels/Pixels.h>
#include <vorl/Operators/IP/kernels/RowLoop.h>
#include <vorl/Operators/IP/kernels/WindowRamp.h>

inline namespace vorl {

namespace {

enum LookupMode { kNone = -1, kEightToEight = 0, kSixteenToEight = 1 };

/// Calls `map(source, target, count)` for the samples of each row.
template <class T, class Map>
bool MapRows(const vorl_detail::RunControl& control, const dImage& source, const dImage& target,
             Map&& map) {
  const std::size_t count = source.GetDataSamplesInRow();
  return vorl_detail::ForEachRow(control, source.GetNumRows(), [&](std::size_t row) {
    map(vorl_detail::RowOf<const T>(source, row), vorl_detail::RowOf<std::uint8_t>(target, row),
        count);
  });
}

template <class T>
bool LookUpRows(const vorl_detail::RunControl& control, const dImage& source, const dImage& target,
                const vorl_detail::LookupTable& table) {
  return MapRows<T>(control, source, target,
                    [&](const T* from, std::uint8_t* to, std::size_t count) {
                      vorl_detail::LookupRunRef(from, to, count, table);
                    });
}

/// The same for samples of 8 bits, of which there are only 256.
template <class T>
bool MapByteRows(const vorl_detail::RunControl& control, const dImage& source, const dImage& target,
                 const vorl_detail::LookupTable& table) {
  std::uint8_t entries[256];
  for (unsigned i = 0; i < 256; ++i) {
    const auto sample = static_cast<T>(i);
    vorl_detail::LookupRunRef(&sample, entries + i, 1, table);
  }
  return MapRows<std::uint8_t>(
      control, source, target, [&](const std::uint8_t* from, std::uint8_t* to, std::size_t count) {
        vorl_detail::ActivePixelKernels().mapBytes(from, to, count, entries);
      });
}

/// Looking for the arithmetic form of a table takes as long as some ten thousand look-ups.
constexpr std::uint64_t kFewSamples = 1U << 16;

// The table's arithmetic form, where it has one and the image is worth the search for it.
std::optional<vorl_detail::WindowRamp> FindRamp(const dImage& source, dLUT& lut) {
  auto* const window = dynamic_cast<dWindowingLUT*>(&lut);
  if (window == nullptr || source.GetChannelDepth() != 16 ||
      std::uint64_t{source.GetNumRows()} * source.GetDataSamplesInRow() < kFewSamples) {
    return std::nullopt;
  }
  return vorl_detail::WindowRamp::Of(*window, source.IsSigned(),
                                     vorl_detail::ActivePixelKernels().window);
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
  const vorl_detail::RunControl control{m_stopRequested, m_progress, HasThread()};
  if (const auto ramp = FindRamp(source, *m_pLUT)) {
    const auto map = [&](const std::uint16_t* from, std::uint8_t* to, std::size_t count) {
      vorl_detail::ActivePixelKernels().window(from, to, count, *ramp);
    };
    return MapRows<std::uint16_t>(control, source, target, map) || Stopped();
  }
  bool finished = false;
  switch (source.GetDataType()) {
    case ImageDataType_U8:
      finished = MapByteRows<std::uint8_t>(control, source, target, table);
      break;
    case ImageDataType_S8:
      finished = MapByteRows<std::int8_t>(control, source, target, table);
      break;
    case ImageDataType_U16:
      finished = LookUpRows<std::uint16_t>(control, source, target, table);
      break;
    default:  // the last type of 8 or 16 bits
      finished = LookUpRows<std::int16_t>(control, source, target, table);
      break;
  }
  return finished || Stopped();
}

// Formats the image like the source, then fills it.
bool opLookup::MapTo(dImage& image, unsigned short dataType) {
  if (!image.Init(*m_pSource, 0, 0, dataType)) {
    m_status.Set(image.GetStatus(), "error while creating image buffer:");
    return false;
  }
  return Map(*m_pSource, image);
}

bool opLookup::Lookup8to8() {
  if (m_pTarget == nullptr || m_pTarget == m_pSource) {
    return Map(*m_pSource, *m_pSource);
  }
  return MapTo(*m_pTarget, 0);
}

bool opLookup::Lookup16to8() {
  const auto dataType = static_cast<unsigned short>(m_pLUT->GetType());
  dImage result;
  if (!MapTo(result, dataType)) {
    return false;
  }
  (m_pTarget != nullptr ? *m_pTarget : *m_pSource) <<= result;
  return true;
}

}  // namespace vorl
