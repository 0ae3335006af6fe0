#ifndef VORL_DATA_DSLICE_H
#define VORL_DATA_DSLICE_H

/// @file
/// A two-dimensional image placed in three-dimensional world space.

#include <vorl/Data/dCoordSys.h>
#include <vorl/Data/dImage.h>

inline namespace vorl {

/// An image with a place in space.
///
/// The coordinate system maps voxel to world coordinates: its origin is the world position of the
/// outer corner of pixel (0, 0), axisX and axisY are the steps from pixel to pixel, and axisZ is
/// the slice normal scaled to the slice thickness. Pixel (i, j) covers the cell from i to i + 1 and
/// from j to j + 1.
class VORL_API dSlice : public DataBase {
 public:
  /// An empty image in the identity coordinate system.
  dSlice();
  /// Copies coordinates and pixels.
  dSlice(const dSlice& source);
  dSlice& operator=(const dSlice& source);

  ClassInfo* GetClassInfo() override;
  ~dSlice() override;
  /// Resets the image, and the coordinates to the identity.
  void Reset() override;
  /// True when the image has pixels.
  bool IsValid() override;
  bool IsValid() const;

  static dSlice* Create();
  static ClassInfo& CI();

  dImage& GetImage() { return m_image; }
  const dImage& GetImage() const { return m_image; }
  /// Pixels.
  std::int32_t GetWidth() const;
  std::int32_t GetHeight() const;
  /// The image's data-type code; 0 without pixels.
  unsigned short GetDataType() const;
  /// The sample width in bits; 0 without pixels.
  unsigned short GetDataDepth() const;

  dCoordSys3D& GetCoordinates();
  const dCoordSys3D& GetCoordinates() const;
  void GetCoordinates(dCoordSys3D& coordinates) const;
  void GetCoordinates(dVect3D& origin, dVect3D& axisX, dVect3D& axisY, dVect3D& axisZ) const;
  void SetCoordinates(const dCoordSys3D& coordinates);
  void SetCoordinates(const dVect3D& origin, const dVect3D& axisX, const dVect3D& axisY,
                      const dVect3D& axisZ);
  /// The origin of the coordinate system.
  dVect3D& GetPosition();
  const dVect3D& GetPosition() const;
  void GetPosition(dVect3D& position) const;
  void SetPosition(const dVect3D& position);

  /// The length of axisZ, in world units.
  double GetSliceThickness() const;
  /// Scales axisZ to this length. An axisZ of zero length becomes NaN.
  void SetSliceThickness(double thickness);
  /// The centre in voxel coordinates: half the width, half the height, 0.5.
  void GetSliceCenter(dVect3D& center) const;
  /// The centre in world coordinates.
  void GetCenterPos(dVect3D& center) const;

 private:
  dCoordSys3D m_coordinates;
  dImage m_image;
};

}  // namespace vorl

#endif
