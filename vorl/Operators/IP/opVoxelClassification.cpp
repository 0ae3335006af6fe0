// 1. Prepare checks the inputs and allocates what the pass fills: the counters or the voxel list.
// 2. A classification counts the class of every voxel (VoxelClasses.h).
// 3. A selection adds the counters up from the highest class down until the next class would exceed
//    the limit, and lists the voxels from there on.

#include <vorl/Operators/IP/opVoxelClassification.h>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <limits>
#include <optional>
#include <vector>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Operators/IP/kernels/VolumeView.h>
#include <vorl/Operators/IP/kernels/VoxelClasses.h>
#include <vorl/Operators/IP/kernels/VoxelList.h>
#include <vorl/Operators/IP/kernels/VoxelRuns.h>

inline namespace vorl {

namespace {

constexpr std::uint32_t kCounterBytes = 4;
constexpr std::uint32_t kEntryBytes = 4;
constexpr unsigned long kInitialCounterBytes = 16384;
constexpr int kSignedBase = 32768;  // the counter of the signed value 0
constexpr std::uint32_t kLargestLimit = std::numeric_limits<std::uint32_t>::max();

// Whether a buffer holds a counter per class: the application may have exchanged it, and a copy may
// have found no memory.
bool HoldCounters(const dBuffer& counters, std::uint32_t classes) {
  return counters.GetSize() / kCounterBytes >= classes &&
         reinterpret_cast<std::uintptr_t>(counters.Get(0)) % kCounterBytes == 0;
}

// The lowest class of the highest ones that together hold at most `capacity` voxels; `lowBound`
// when all do.
int LowerThreshold(const std::uint32_t* counters, int lowBound, int highClass,
                   std::uint64_t capacity) {
  std::uint64_t sum = 0;
  int voxelClass = highClass;
  for (int steps = -lowBound; steps > 0; --steps, --voxelClass) {
    sum += counters[voxelClass];
    if (sum > capacity) {
      return voxelClass + 1;
    }
  }
  return lowBound;
}

// The values of T from `lower` to before `end`; none when there are none.
template <class T>
std::optional<vorl_detail::ClassRange> RangeOf(int lower, int end) {
  const int first = std::max<int>(lower, std::numeric_limits<T>::min());
  const int last = std::min<int>(end - 1, std::numeric_limits<T>::max());
  if (first > last) {
    return std::nullopt;
  }
  return vorl_detail::ClassRange{static_cast<std::uint16_t>(first),
                                 static_cast<std::uint16_t>(last - first)};
}

// The bits of a row's values, or the edge classes that `run` makes of them.
class ClassRow {
 public:
  ClassRow(vorl_detail::EdgeClassRun* run, const vorl_detail::VoxelBox& box)
      : m_run(run), m_classes(run == nullptr || box.IsEmpty() ? 0 : box.endX - box.firstX) {}

  template <class T>
  const std::uint16_t* Of(const vorl_detail::VoxelRow<T>& row) {
    const auto* voxels = reinterpret_cast<const std::uint16_t*>(row.voxels) + row.firstX;
    if (m_run == nullptr) {
      return voxels;
    }
    m_run(voxels, reinterpret_cast<const std::uint16_t*>(row.below) + row.firstX, m_classes.size(),
          m_classes.data());
    return m_classes.data();
  }

 private:
  vorl_detail::EdgeClassRun* m_run;
  std::vector<std::uint16_t> m_classes;
};

}  // namespace

VORL_REGISTER_CLASS(opVoxelClassification, OpBase);

opVoxelClassification::opVoxelClassification() {
  opVoxelClassification::Reset();
}

opVoxelClassification::opVoxelClassification(const opVoxelClassification& source) = default;
opVoxelClassification& opVoxelClassification::operator=(const opVoxelClassification& source) =
    default;

opVoxelClassification::~opVoxelClassification() {
  Terminate();
  opVoxelClassification::Reset();
}

bool opVoxelClassification::Reset() {
  volume = nullptr;
  voxelList = nullptr;
  algoID = VoxelClassificationAlgo_None;
  classifiedBy = VoxelClassificationAlgo_None;
  selectionLimit = 0;
  classCounters.Delete();
  classCounters.New(kInitialCounterBytes, true);
  m_spareBuffer.Reset();
  return true;
}

void opVoxelClassification::SelectAlgo(short id) {
  algoID = id;
}

void opVoxelClassification::SetSelectionLimit(unsigned long voxels) {
  SetSelectionLimit(static_cast<unsigned long long>(voxels));
}

void opVoxelClassification::SetSelectionLimit(unsigned long long voxels) {
  selectionLimit = static_cast<std::uint32_t>(std::min<unsigned long long>(voxels, kLargestLimit));
}

void opVoxelClassification::SetSelectionLimit(long voxels) {
  SetSelectionLimit(static_cast<unsigned long long>(voxels));
}

void opVoxelClassification::SetSelectionLimit(unsigned int voxels) {
  selectionLimit = voxels;
}

void opVoxelClassification::SetSelectionLimit(int voxels) {
  SetSelectionLimit(static_cast<unsigned long long>(voxels));
}

void opVoxelClassification::SetSelectionLimit(double percent) {
  if (volume == nullptr) {
    return;
  }
  // The product of the sizes wraps at 32 bits.
  const std::uint32_t voxels = static_cast<std::uint32_t>(volume->GetSizeX()) *
                               static_cast<std::uint32_t>(volume->GetSizeY()) *
                               static_cast<std::uint32_t>(volume->GetSizeZ());
  const double limit = voxels * (percent / 100.0);
  if (!std::isnan(limit)) {
    selectionLimit = static_cast<std::uint32_t>(std::clamp<double>(limit, 0.0, kLargestLimit));
  }
}

bool opVoxelClassification::Prepare() {
  if (volume == nullptr) {
    m_status.Set(false, "missing input parameter 'Volume'");
    return false;
  }
  if (!volume->IsValid()) {
    m_status.Set(false, "given Volume is empty");
    return false;
  }
  switch (algoID) {
    case VoxelClassificationAlgo_None:
      m_status.Set(false, "no 'Algorithm ID' specified");
      return false;
    case VoxelClassificationAlgo_Value:
    case VoxelClassificationAlgo_Edge:
      // First: where there is no memory for new counters, the old ones are gone, too.
      classifiedBy = VoxelClassificationAlgo_None;
      if (!AllocateCounters()) {
        return false;
      }
      break;
    case VoxelClassificationAlgo_Select:
      if (!AllocateList()) {
        return false;
      }
      break;
    default:  // refused when it is to be processed
      break;
  }
  m_status = true;
  return m_stopRequested ? Stopped() : true;
}

bool opVoxelClassification::AllocateCounters() {
  const double count = std::ldexp(1.0, volume->GetDataDepth());
  const double bytes = count * kCounterBytes;
  classCounters.Delete();
  if (bytes <= std::numeric_limits<std::uint32_t>::max()) {
    classCounters.New(static_cast<unsigned long>(bytes), true);
  }
  if (!classCounters) {
    m_status.Set(false, "class counter allocation failed[Size: %.0f]", count);
    return false;
  }
  return true;
}

bool opVoxelClassification::AllocateList() {
  if (classifiedBy == VoxelClassificationAlgo_None) {
    m_status.Set(false, "can't select voxels: voxels are not yet classified");
    return false;
  }
  if (selectionLimit == 0) {
    m_status.Set(false, "can't select voxels: no 'Selection Limit' specified");
    return false;
  }
  if (voxelList == nullptr) {
    m_status.Set(false, "missing input parameter 'Voxel List'");
    return false;
  }
  if (voxelList == &classCounters) {
    m_status.Set(false, "the class counters can't be the 'Voxel List'");
    return false;
  }
  const std::uint64_t bytes = std::uint64_t{selectionLimit} * kEntryBytes;
  if (bytes <= std::numeric_limits<std::uint32_t>::max()) {
    voxelList->New(static_cast<unsigned long>(bytes), false);
  } else {
    voxelList->Delete();
  }
  if (voxelList->GetSize() != bytes) {
    m_status.Set(false, "can't create voxel list[Size: %lu]",
                 static_cast<unsigned long>(selectionLimit));
    return false;
  }
  return true;
}

bool opVoxelClassification::Process() {
  bool ok = false;
  switch (algoID) {
    case VoxelClassificationAlgo_Value:
    case VoxelClassificationAlgo_Edge:
      ok = ClassifyVoxels();
      if (ok && !m_stopRequested) {
        classifiedBy = algoID;
      }
      break;
    case VoxelClassificationAlgo_Select:
      ok = SelectVoxels();
      break;
    default:
      m_status.Set(false, "invalid algo ID: %d", algoID);
      break;
  }
  return ok && m_stopRequested ? Stopped() : ok;
}

bool opVoxelClassification::ClassifyVoxels() {
  auto* counters = static_cast<std::uint32_t*>(classCounters.Get(0));
  const unsigned short dataType = volume->GetDataType();
  if (dataType != ImageDataType_U16 && dataType != ImageDataType_S16) {
    m_status.Set(false, "unsupported data type: %d", dataType);
    return false;
  }
  if (!vorl_detail::CheckPixels(vorl_detail::VolumeView(*volume), m_status)) {
    return false;
  }
  const bool signedValues =
      dataType == ImageDataType_S16 && algoID == VoxelClassificationAlgo_Value;
  const bool ok =
      dataType == ImageDataType_S16
          ? ClassifyVoxelsS16(algoID, volume, nullptr, counters + (signedValues ? kSignedBase : 0))
          : ClassifyVoxelsU16(algoID, volume, nullptr, counters);
  if (!ok) {
    m_status.Set(false, "voxel classification error");
  }
  return ok;
}

bool opVoxelClassification::SelectVoxels() {
  const auto* counters = static_cast<const std::uint32_t*>(classCounters.Get(0));
  const unsigned short dataType = volume->GetDataType();
  if (dataType != ImageDataType_U16 && dataType != ImageDataType_S16) {
    m_status.Set(false, "unsupported data type: %d", dataType);
    return false;
  }
  if (!vorl_detail::CheckPixels(vorl_detail::VolumeView(*volume), m_status)) {
    return false;
  }
  const int classes = 1 << volume->GetDataDepth();
  if (!HoldCounters(classCounters, static_cast<std::uint32_t>(classes))) {
    m_status.Set(false, "voxel selection error");
    return false;
  }
  const bool signedValues =
      dataType == ImageDataType_S16 && classifiedBy == VoxelClassificationAlgo_Value;
  const int base = signedValues ? kSignedBase : 0;
  const auto worker = dataType == ImageDataType_S16 ? &opVoxelClassification::SelectVoxelsS16
                                                    : &opVoxelClassification::SelectVoxelsU16;
  const bool ok = (this->*worker)(classifiedBy, volume, nullptr, voxelList, counters + base,
                                  -classes, classes - 1 - base, false);
  if (!ok) {
    m_status.Set(false, "voxel selection error");
  }
  return ok;
}

template <class T>
bool opVoxelClassification::Count(int algo, const dVolume& source, const dVOI* region,
                                  std::uint32_t* counters) {
  const auto count = [&](auto classOf, auto countedAs, vorl_detail::EdgeClassRun* edgeClasses) {
    using Class = decltype(classOf);
    const vorl_detail::VoxelBox box(source, region, Class::kNeighbours);
    vorl_detail::ValueCounter counter(box.Count());
    ClassRow classes(edgeClasses, box);
    const auto visit = [&](const vorl_detail::VoxelRow<T>& row) {
      if (counter.IsValid()) {
        counter.Count(classes.Of(row), row.endX - row.firstX);
        return;
      }
      for (std::uint32_t x = row.firstX; x < row.endX; ++x) {
        const std::int32_t voxelClass = Class::Of(row, x);
        ++counters[Class::kNeighbours != 0 ? std::max(voxelClass, 0) : voxelClass];
      }
    };
    vorl_detail::ForEachVoxelRow<T>({m_stopRequested, m_progress, HasThread()}, source, box, visit);
    if (counter.IsValid()) {
      counter.ForEach(
          [&](std::uint16_t bits, std::uint32_t times) { counters[countedAs(bits)] += times; });
    }
  };
  if (algo == VoxelClassificationAlgo_Edge) {
    count(
        vorl_detail::EdgeClass{},
        [](std::uint16_t bits) { return std::max<int>(static_cast<std::int16_t>(bits), 0); },
        vorl_detail::ActiveVoxelKernels().edgeClasses);
  } else {
    count(
        vorl_detail::ValueClass{}, [](std::uint16_t bits) { return static_cast<T>(bits); },
        nullptr);
  }
  return true;
}

template <class T>
bool opVoxelClassification::Select(int classAlgo, const dVolume& source, const dVOI* region,
                                   dBuffer& list, const std::uint32_t* counters, int lowBound,
                                   int highClass) {
  const std::uint32_t capacity = static_cast<std::uint32_t>(list.GetSize() / kEntryBytes);
  const int lower = LowerThreshold(counters, lowBound, highClass, capacity);
  auto* entries = static_cast<unsigned char*>(list.Get(0));
  std::size_t written = 0;
  const auto& kernels = vorl_detail::ActiveVoxelKernels();
  const auto select = [&](auto classOf, auto classType, vorl_detail::EdgeClassRun* edgeClasses) {
    using Class = decltype(classOf);
    const auto range = RangeOf<decltype(classType)>(lower, highClass);
    const vorl_detail::VoxelBox box(source, region, Class::kNeighbours);
    ClassRow classes(edgeClasses, box);
    const auto visit = [&](const vorl_detail::VoxelRow<T>& row) {
      // The limit holds whatever has become of the volume since it was classified.
      if (range && written < capacity) {
        written += kernels.select(classes.Of(row), row.endX - row.firstX, *range,
                                  vorl_detail::PackVoxel(0, row.y, row.z), row.firstX,
                                  entries + written * kEntryBytes, capacity - written);
      }
    };
    vorl_detail::ForEachVoxelRow<T>({m_stopRequested, m_progress, HasThread()}, source, box, visit);
  };
  if (classAlgo == VoxelClassificationAlgo_Edge) {
    select(vorl_detail::EdgeClass{}, std::int16_t{}, kernels.edgeClasses);
  } else {
    select(vorl_detail::ValueClass{}, T{}, nullptr);
  }
  // A list in foreign memory becomes one of its own here, for which there may be no memory.
  const auto bytes = static_cast<unsigned long>(written * kEntryBytes);
  list.Resize(bytes);
  return list.GetSize() == bytes;
}

bool opVoxelClassification::ClassifyVoxelsU16(int algo, dVolume* source, const dVOI* region,
                                              std::uint32_t* counters) {
  return Count<std::uint16_t>(algo, *source, region, counters);
}

bool opVoxelClassification::ClassifyVoxelsS16(int algo, dVolume* source, const dVOI* region,
                                              std::uint32_t* counters) {
  return Count<std::int16_t>(algo, *source, region, counters);
}

bool opVoxelClassification::SelectVoxelsU16(int classAlgo, dVolume* source, const dVOI* region,
                                            dBuffer* list, const std::uint32_t* counters,
                                            int lowBound, int highClass, bool) {
  return Select<std::uint16_t>(classAlgo, *source, region, *list, counters, lowBound, highClass);
}

bool opVoxelClassification::SelectVoxelsS16(int classAlgo, dVolume* source, const dVOI* region,
                                            dBuffer* list, const std::uint32_t* counters,
                                            int lowBound, int highClass, bool) {
  return Select<std::int16_t>(classAlgo, *source, region, *list, counters, lowBound, highClass);
}

}  // namespace vorl
