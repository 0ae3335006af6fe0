#include <vorl/Data/dSlice.h>

#include <algorithm>
#include <limits>

#include <vorl/Common/detail/ClassRegistration.h>
#include <vorl/Data/detail/Placement.h>

inline namespace vorl {

namespace {

std::int32_t ToSigned(unsigned long size) {
  constexpr unsigned long kLargest = std::numeric_limits<std::int32_t>::max();
  return static_cast<std::int32_t>(std::min(size, kLargest));
}

}  // namespace

VORL_REGISTER_CLASS(dSlice, DataBase);

dSlice::dSlice() {
  dSlice::Reset();
}

dSlice::dSlice(const dSlice& source)
    : DataBase(source), m_coordinates(source.m_coordinates), m_image(source.m_image) {}

dSlice& dSlice::operator=(const dSlice& source) {
  if (this != &source) {
    m_coordinates = source.m_coordinates;
    m_image = source.m_image;
  }
  return *this;
}

dSlice::~dSlice() = default;

void dSlice::Reset() {
  m_image.Reset();
  m_coordinates.Reset();
}

bool dSlice::IsValid() {
  return m_image.IsValid();
}
bool dSlice::IsValid() const {
  return m_image.IsValid();
}

std::int32_t dSlice::GetWidth() const {
  return ToSigned(m_image.GetWidth());
}
std::int32_t dSlice::GetHeight() const {
  return ToSigned(m_image.GetHeight());
}

unsigned short dSlice::GetDataType() const {
  return IsValid() ? m_image.GetDataType() : 0;
}
unsigned short dSlice::GetDataDepth() const {
  return IsValid() ? m_image.GetChannelDepth() : 0;
}

dCoordSys3D& dSlice::GetCoordinates() {
  return m_coordinates;
}
const dCoordSys3D& dSlice::GetCoordinates() const {
  return m_coordinates;
}
void dSlice::GetCoordinates(dCoordSys3D& coordinates) const {
  coordinates = m_coordinates;
}

void dSlice::GetCoordinates(dVect3D& origin, dVect3D& axisX, dVect3D& axisY, dVect3D& axisZ) const {
  vorl_detail::CopyParts(m_coordinates, origin, axisX, axisY, axisZ);
}

void dSlice::SetCoordinates(const dCoordSys3D& coordinates) {
  m_coordinates = coordinates;
}

void dSlice::SetCoordinates(const dVect3D& origin, const dVect3D& axisX, const dVect3D& axisY,
                            const dVect3D& axisZ) {
  m_coordinates.Set(origin, axisX, axisY, axisZ);
}

dVect3D& dSlice::GetPosition() {
  return m_coordinates.origin;
}
const dVect3D& dSlice::GetPosition() const {
  return m_coordinates.origin;
}
void dSlice::GetPosition(dVect3D& position) const {
  position = m_coordinates.origin;
}
void dSlice::SetPosition(const dVect3D& position) {
  m_coordinates.origin = position;
}

double dSlice::GetSliceThickness() const {
  return m_coordinates.axisZ.Length();
}

void dSlice::SetSliceThickness(double thickness) {
  m_coordinates.axisZ *= thickness / GetSliceThickness();
}

void dSlice::GetSliceCenter(dVect3D& center) const {
  center.Set(static_cast<double>(m_image.GetWidth()) * 0.5,
             static_cast<double>(m_image.GetHeight()) * 0.5, 0.5);
}

void dSlice::GetCenterPos(dVect3D& center) const {
  vorl_detail::GridCenter(m_coordinates, static_cast<double>(m_image.GetWidth()),
                          static_cast<double>(m_image.GetHeight()), 1.0, center);
}

}  // namespace vorl
