#include <vorl/Data/dVolume.h>

#include <algorithm>
#include <iterator>
#include <mutex>
#include <new>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/detail/Placement.h>

inline namespace vorl {

namespace {

// False when there is no memory for the slices or for the pixels of one.
bool CopySlices(const std::list<dSlice>& source, std::list<dSlice>& copy) {
  try {
    for (const dSlice& slice : source) {
      copy.push_back(slice);
      if (copy.back().GetImage().IsValid() != slice.GetImage().IsValid()) {
        return false;
      }
    }
    return true;
  } catch (const std::bad_alloc&) {
    return false;
  }
}

}  // namespace

VORL_REGISTER_CLASS(dVolume, DataBase);

dVolume::dVolume() {
  dVolume::Reset();
}

dVolume::dVolume(const dVolume& source) : DataBase(source) {
  dVolume::operator=(source);
}

dVolume& dVolume::operator=(const dVolume& source) {
  if (this != &source) {
    // New slices, and the old ones freed only afterwards: slices may refer to pixels elsewhere,
    // which are not to be overwritten, and those of the source to pixels of this volume.
    std::list<dSlice> slices;
    if (!CopySlices(source.m_sliceList, slices)) {
      Reset();
      return *this;
    }
    m_sliceList.swap(slices);
    m_sliceDataArray = source.m_sliceDataArray;
    m_coordinates = source.m_coordinates;
  }
  return *this;
}

dVolume::~dVolume() = default;

void dVolume::Reset() {
  m_sliceList.clear();
  m_sliceDataArray.Reset();
  m_coordinates.Reset();
}

bool dVolume::IsValid() {
  return !m_sliceList.empty();
}
bool dVolume::IsValid() const {
  return !m_sliceList.empty();
}

int dVolume::GetSliceCount() const {
  return static_cast<int>(m_sliceList.size());
}
int dVolume::GetSizeX() const {
  return IsValid() ? m_sliceList.front().GetWidth() : 0;
}
int dVolume::GetSizeY() const {
  return IsValid() ? m_sliceList.front().GetHeight() : 0;
}
int dVolume::GetSizeZ() const {
  return GetSliceCount();
}

unsigned short dVolume::GetDataType() const {
  return IsValid() ? m_sliceList.front().GetDataType() : 0;
}

unsigned short dVolume::GetDataDepth() const {
  return IsValid() ? m_sliceList.front().GetDataDepth() : 0;
}

dSlice* dVolume::GetSlice(int index) {
  return const_cast<dSlice*>(static_cast<const dVolume*>(this)->GetSlice(index));
}

const dSlice* dVolume::GetSlice(int index) const {
  if (index < 0 || index >= GetSliceCount()) {
    return nullptr;
  }
  if (index == GetSliceCount() - 1) {
    return &m_sliceList.back();
  }
  return &*std::next(m_sliceList.begin(), index);
}

std::list<dSlice>& dVolume::GetSliceList() {
  return m_sliceList;
}
const std::list<dSlice>& dVolume::GetSliceList() const {
  return m_sliceList;
}

bool dVolume::Accepts(const dSlice& slice) const {
  if (m_sliceList.empty()) {
    return true;
  }
  const dImage& image = slice.GetImage();
  const dImage& first = m_sliceList.front().GetImage();
  // Its own slice would lose its pixels to the new one.
  const auto isSlice = [&](const dSlice& own) { return &own == &slice; };
  return image.GetWidth() == first.GetWidth() && image.GetHeight() == first.GetHeight() &&
         image.GetFormatID() == first.GetFormatID() &&
         std::none_of(m_sliceList.begin(), m_sliceList.end(), isSlice);
}

int dVolume::AddSlice(dSlice& slice) {
  if (!Accepts(slice)) {
    return -1;
  }
  try {
    m_sliceList.emplace_back();
  } catch (const std::bad_alloc&) {
    return -1;
  }
  dSlice& added = m_sliceList.back();
  added.SetCoordinates(slice.GetCoordinates());
  added.GetImage() <<= slice.GetImage();
  return GetSliceCount() - 1;
}

void** dVolume::GetSliceDataArray() {
  // Two operators may ask for the array of one volume at once.
  static std::mutex building;
  const std::lock_guard lock(building);
  const std::size_t count = m_sliceList.size();
  if (count == 0) {
    m_sliceDataArray.Delete();
    return nullptr;
  }
  const std::size_t size = (count + 2) * sizeof(void*);
  if (m_sliceDataArray.GetSize() != size) {
    m_sliceDataArray.New(static_cast<unsigned long>(size), false);
    auto** entry = static_cast<void**>(m_sliceDataArray.Get(0));
    if (entry == nullptr) {
      return nullptr;
    }
    *entry++ = m_sliceList.front().GetImage().GetDataPtr();
    for (const dSlice& slice : m_sliceList) {
      *entry++ = slice.GetImage().GetDataPtr();
    }
    *entry = m_sliceList.back().GetImage().GetDataPtr();
  }
  return static_cast<void**>(m_sliceDataArray.Get(0)) + 1;
}

dCoordSys3D& dVolume::GetCoordinates() {
  return m_coordinates;
}
const dCoordSys3D& dVolume::GetCoordinates() const {
  return m_coordinates;
}
void dVolume::GetCoordinates(dCoordSys3D& coordinates) const {
  coordinates = m_coordinates;
}

void dVolume::GetCoordinates(dVect3D& origin, dVect3D& axisX, dVect3D& axisY,
                             dVect3D& axisZ) const {
  vorl_detail::CopyParts(m_coordinates, origin, axisX, axisY, axisZ);
}

void dVolume::SetCoordinates(const dCoordSys3D& coordinates) {
  m_coordinates = coordinates;
}

void dVolume::SetCoordinates(const dVect3D& origin, const dVect3D& axisX, const dVect3D& axisY,
                             const dVect3D& axisZ) {
  m_coordinates.Set(origin, axisX, axisY, axisZ);
}

dVect3D& dVolume::GetPosition() {
  return m_coordinates.origin;
}
const dVect3D& dVolume::GetPosition() const {
  return m_coordinates.origin;
}
void dVolume::GetPosition(dVect3D& position) const {
  position = m_coordinates.origin;
}
void dVolume::SetPosition(const dVect3D& position) {
  m_coordinates.origin = position;
}

void dVolume::GetVolCenter(dVect3D& center) const {
  center.Set(GetSizeX() * 0.5, GetSizeY() * 0.5, GetSizeZ() * 0.5);
}

void dVolume::GetCenterPos(dVect3D& center) const {
  vorl_detail::GridCenter(m_coordinates, GetSizeX(), GetSizeY(), GetSizeZ(), center);
}

}  // namespace vorl
