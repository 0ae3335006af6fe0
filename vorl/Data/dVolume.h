#ifndef VORL_DATA_DVOLUME_H
#define VORL_DATA_DVOLUME_H

/// @file
/// An ordered stack of slices that share one placement in space.

#include <vorl/Data/dSlice.h>

#include <list>

inline namespace vorl {

/// A stack of slices of one size and pixel format.
///
/// Voxel (i, j, k) is pixel (i, j) of slice k. The volume's own coordinate system, which adding
/// slices does not change, maps voxel to world coordinates; the application sets it. Slices keep
/// their addresses while others are added.
class VORL_API dVolume : public DataBase {
 public:
  /// No slices, identity coordinates.
  dVolume();
  /// Copies slices and coordinates. The cached slice data array is taken over as it stands: it
  /// shows the source's slices until the number of slices changes.
  dVolume(const dVolume& source);
  /// As above. When there is no memory for all slices, this volume is left reset.
  dVolume& operator=(const dVolume& source);

  ClassInfo* GetClassInfo() override;
  ~dVolume() override;
  /// Destroys all slices and resets the coordinates to the identity.
  void Reset() override;
  /// True when there is at least one slice.
  bool IsValid() override;
  bool IsValid() const;

  static dVolume* Create();
  static ClassInfo& CI();

  int GetSliceCount() const;
  /// Width and height of the first slice, 0 when there is none, and the number of slices.
  int GetSizeX() const;
  int GetSizeY() const;
  int GetSizeZ() const;
  /// The data-type code of the first slice; 0 when there is none.
  unsigned short GetDataType() const;
  /// The sample width of the first slice in bits; 0 when there is none.
  unsigned short GetDataDepth() const;

  /// Slice `index`; null when there is no such slice. Owned by the volume.
  dSlice* GetSlice(int index);
  const dSlice* GetSlice(int index) const;
  std::list<dSlice>& GetSliceList();
  const std::list<dSlice>& GetSliceList() const;
  /// Appends a slice that takes over the coordinates and the pixels of `slice`, whose image is left
  /// reset. Returns the new slice's index, or -1, without any change, when `slice` differs from the
  /// first one in width, height or pixel format, already is a slice of this volume, or finds no
  /// memory.
  int AddSlice(dSlice& slice);

  /// The pixel data pointers of the slices, in order; null when there are none. Entry -1 repeats
  /// the first slice and entry `GetSliceCount()` the last, so that an interpolating reader may step
  /// one beyond either end. The array is cached, belongs to the volume, and is built anew only when
  /// the number of slices has changed.
  void** GetSliceDataArray();

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

  /// The centre in voxel coordinates: half of each size.
  void GetVolCenter(dVect3D& center) const;
  /// The centre in world coordinates.
  void GetCenterPos(dVect3D& center) const;

 private:
  bool Accepts(const dSlice& slice) const;

  std::list<dSlice> m_sliceList;
  dBuffer m_sliceDataArray;
  dCoordSys3D m_coordinates;
};

}  // namespace vorl

#endif
