#include <vorl/Operators/IP/opMinMax.h>

#include <algorithm>
#include <limits>
#include <tuple>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Operators/IP/kernels/ImageCheck.h>
#include <vorl/Operators/IP/kernels/Pixels.h>
#include <vorl/Operators/IP/kernels/RowLoop.h>

inline namespace vorl {

namespace {

constexpr std::int32_t kSmallest = std::numeric_limits<std::int32_t>::min();
constexpr std::int32_t kLargest = std::numeric_limits<std::int32_t>::max();

std::int32_t ToSeed(long value) {
  return static_cast<std::int32_t>(std::clamp<long long>(value, kSmallest, kLargest));
}

}  // namespace

VORL_REGISTER_CLASS(opMinMax, OpBase);

opMinMax::opMinMax() {
  opMinMax::Reset();
}

opMinMax::opMinMax(dImage* source, long& minimum, long& maximum) : opMinMax() {
  Run(source, minimum, maximum);
}

opMinMax::opMinMax(dImage* source, std::int32_t& minimum, std::int32_t& maximum) : opMinMax() {
  Run(source, minimum, maximum);
}

opMinMax::opMinMax(const opMinMax& source) = default;
opMinMax& opMinMax::operator=(const opMinMax& source) = default;

opMinMax::~opMinMax() {
  Terminate();
  opMinMax::Reset();
}

bool opMinMax::Reset() {
  m_pSource = nullptr;
  m_minimum = kLargest;
  m_maximum = kSmallest;
  return true;
}

bool opMinMax::Run(dImage* source, long& minimum, long& maximum) {
  std::int32_t smallest = ToSeed(minimum);
  std::int32_t largest = ToSeed(maximum);
  if (!Run(source, smallest, largest)) {
    return false;
  }
  minimum = smallest;
  maximum = largest;
  return true;
}

bool opMinMax::Run(dImage* source, std::int32_t& minimum, std::int32_t& maximum) {
  m_pSource = source;
  m_minimum = minimum;
  m_maximum = maximum;
  if (!Run()) {
    return false;
  }
  minimum = m_minimum;
  maximum = m_maximum;
  return true;
}

bool opMinMax::Prepare() {
  if (m_pSource == nullptr) {
    m_status.Set(false, "missing source image");
    return false;
  }
  if (!m_pSource->IsValid()) {
    m_status.Set(false, "uninitialized source image");
    return false;
  }
  m_status = true;
  return true;
}

template <class T>
bool opMinMax::Search() {
  if (!vorl_detail::HoldsRows(*m_pSource)) {
    m_status.Set(false, "invalid pixel data in the source image");
    return false;
  }
  std::int32_t minimum = m_minimum;
  std::int32_t maximum = m_maximum;
  vorl_detail::MinMaxRun<T>* const search =
      std::get<vorl_detail::MinMaxRun<T>*>(vorl_detail::ActivePixelKernels().minMax);
  const auto row = [&](std::size_t index) {
    search(vorl_detail::RowOf<const T>(*m_pSource, index), m_pSource->GetDataSamplesInRow(),
           minimum, maximum);
  };
  if (!vorl_detail::ForEachRow({m_stopRequested, m_progress, HasThread()}, m_pSource->GetNumRows(),
                               row)) {
    return Stopped();
  }
  const bool found = maximum >= minimum;
  m_minimum = found ? minimum : 0;
  m_maximum = found ? maximum : 0;
  return true;
}

bool opMinMax::Process() {
  switch (m_pSource->GetDataType()) {
    case ImageDataType_U8:
      return Search<std::uint8_t>();
    case ImageDataType_S8:
      return Search<std::int8_t>();
    case ImageDataType_U16:
      return Search<std::uint16_t>();
    case ImageDataType_S16:
      return Search<std::int16_t>();
    case ImageDataType_S32:
      return Search<std::int32_t>();
    default:
      m_status.Set(false, "unsupported data type: %d(%d bit)", m_pSource->GetDataType(),
                   m_pSource->GetChannelDepth());
      return false;
  }
}

}  // namespace vorl
