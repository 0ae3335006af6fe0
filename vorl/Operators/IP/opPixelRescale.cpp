#include <vorl/Operators/IP/opPixelRescale.h>

#include <cstdint>
#include <numeric>
#include <tuple>

#include <vorl/Common/LogContext.h>
#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Operators/IP/kernels/ImageCheck.h>
#include <vorl/Operators/IP/kernels/Pixels.h>
#include <vorl/Operators/IP/kernels/RowLoop.h>

inline namespace vorl {

namespace {

/// Rescales runs of samples.
template <class T>
class Rescaler {
 public:
  Rescaler(double factor, double offset) : m_factor(factor), m_offset(offset) {}

  void operator()(const T* source, T* target, std::size_t count) const {
    m_rescale(source, target, count, m_factor, m_offset);
  }

 private:
  vorl_detail::RescaleRun<T>* m_rescale =
      std::get<vorl_detail::RescaleRun<T>*>(vorl_detail::ActivePixelKernels().rescale);
  double m_factor;
  double m_offset;
};

/// There are only 256 samples of 8 bits: they are rescaled once, and looked up.
template <class T>
requires(sizeof(T) == 1) class Rescaler<T> {
 public:
  Rescaler(double factor, double offset) {
    T samples[256];
    std::iota(reinterpret_cast<std::uint8_t*>(samples),
              reinterpret_cast<std::uint8_t*>(samples) + 256, std::uint8_t{0});
    vorl_detail::RescaleRunRef(samples, reinterpret_cast<T*>(m_entries), 256, factor, offset);
  }

  void operator()(const T* source, T* target, std::size_t count) const {
    vorl_detail::ActivePixelKernels().mapBytes(reinterpret_cast<const std::uint8_t*>(source),
                                               reinterpret_cast<std::uint8_t*>(target), count,
                                               m_entries);
  }

 private:
  std::uint8_t m_entries[256];
};

}  // namespace

VORL_REGISTER_CLASS(opPixelRescale, OpBase);

opPixelRescale::opPixelRescale() {
  opPixelRescale::Reset();
}

opPixelRescale::opPixelRescale(dImage* source, dImage* target, double factor, double offset) {
  Run(source, target, factor, offset);
}

opPixelRescale::opPixelRescale(dImage* image, double factor, double offset)
    : opPixelRescale(image, image, factor, offset) {}

opPixelRescale::opPixelRescale(const opPixelRescale& source) = default;
opPixelRescale& opPixelRescale::operator=(const opPixelRescale& source) = default;

opPixelRescale::~opPixelRescale() {
  Terminate();
  opPixelRescale::Reset();
}

bool opPixelRescale::Reset() {
  m_pSource = nullptr;
  m_pTarget = nullptr;
  m_factor = 1.0;
  m_offset = 0.0;
  return true;
}

bool opPixelRescale::Run(dImage* source, dImage* target, double factor, double offset) {
  m_pSource = source;
  m_pTarget = target;
  m_factor = factor;
  m_offset = offset;
  return Run();
}

bool opPixelRescale::Prepare() {
  LogContext context("opPixelRescale::Prepare", __FILE__, __LINE__, true);
  if (m_pSource == nullptr) {
    m_status.Set(false, "uninitialized parameter: m_pSource = null");
    context.Status(__LINE__, m_status);
    return false;
  }
  if (m_pTarget == nullptr) {
    m_pTarget = m_pSource;
  }
  if (m_pTarget != m_pSource && !m_pTarget->Init(*m_pSource, 0, 0, 0)) {
    m_status.Set(m_pTarget->GetStatus(), "error while initializing target image: ");
    context.Status(__LINE__, m_status);
    return false;
  }
  return true;
}

bool opPixelRescale::Process() {
  LogContext context("opPixelRescale::Process", __FILE__, __LINE__, true);
  if (m_factor == 1.0 && m_offset == 0.0) {
    m_pTarget = m_pSource;
    return true;
  }
  bool ok = false;
  switch (m_pSource->GetDataType()) {
    case ImageDataType_U8:
      ok = RescaleU8(m_pSource, m_pTarget, m_factor, m_offset);
      break;
    case ImageDataType_S8:
      ok = RescaleS8(m_pSource, m_pTarget, m_factor, m_offset);
      break;
    case ImageDataType_U16:
      ok = RescaleU16(m_pSource, m_pTarget, m_factor, m_offset);
      break;
    case ImageDataType_S16:
      ok = RescaleS16(m_pSource, m_pTarget, m_factor, m_offset);
      break;
    default:
      m_status.Set(false, "unsupported pixel data type: %s",
                   dImage::DataType2Str(m_pSource->GetDataType()));
      break;
  }
  if (!ok) {
    context.Status(__LINE__, m_status);
  }
  return ok;
}

template <class T>
bool opPixelRescale::Rescale(dImage* source, dImage* target, double factor, double offset) {
  if (source == nullptr || target == nullptr) {
    return true;
  }
  const auto* from = static_cast<const T*>(source->GetDataPtr());
  auto* to = static_cast<T*>(target->GetDataPtr());
  if (from == nullptr || to == nullptr) {
    return true;
  }
  // One dense run of samples, taken in pieces of a row's length so that it can be stopped.
  const std::size_t length = source->GetDataSamplesInRow();
  const std::uint64_t runBytes = std::uint64_t{length} * source->GetNumRows() * sizeof(T);
  for (const dImage* image : {source, target}) {
    if (!vorl_detail::HoldsBytes(*image, runBytes, sizeof(T))) {
      m_status.Set(false, "invalid pixel data in the %s image",
                   image == source ? "source" : "target");
      return false;
    }
  }
  const Rescaler<T> rescale(factor, offset);
  const auto row = [&](std::size_t index) {
    rescale(from + index * length, to + index * length, length);
  };
  return vorl_detail::ForEachRow({m_stopRequested, m_progress, HasThread()}, source->GetNumRows(),
                                 row) ||
         Stopped();
}

bool opPixelRescale::RescaleU8(dImage* source, dImage* target, double factor, double offset) {
  return Rescale<std::uint8_t>(source, target, factor, offset);
}

bool opPixelRescale::RescaleS8(dImage* source, dImage* target, double factor, double offset) {
  return Rescale<std::int8_t>(source, target, factor, offset);
}

bool opPixelRescale::RescaleU16(dImage* source, dImage* target, double factor, double offset) {
  return Rescale<std::uint16_t>(source, target, factor, offset);
}

bool opPixelRescale::RescaleS16(dImage* source, dImage* target, double factor, double offset) {
  return Rescale<std::int16_t>(source, target, factor, offset);
}

}  // namespace vorl
