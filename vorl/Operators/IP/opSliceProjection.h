#ifndef VORL_OPERATORS_IP_OPSLICEPROJECTION_H
#define VORL_OPERATORS_IP_OPSLICEPROJECTION_H

/// @file
/// Slices, voxel lists and a volume drawn into one view through a depth buffer.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dVolume.h>

#include <cstdint>

inline namespace vorl {

/// The algorithms of `opSliceProjection`.
enum SliceProjectionAlgo : std::int32_t {
  SliceProjectionAlgo_Slice = 301,      ///< a slice with its outline and corner mark
  SliceProjectionAlgo_Volume = 302,     ///< the volume's brightest voxels in front of the depth
  SliceProjectionAlgo_VoxelList = 303,  ///< listed voxels of the volume
  SliceProjectionAlgo_SliceBack = 311   ///< accepted, but draws nothing and fails
};

/// Draws what lies in front of a projection plane, hiding what lies behind something drawn before.
///
/// Set the plane, call `InitZBuffer` and `ClearProjectionPlane`, then run the operator once per
/// object to draw, changing algorithm and inputs between runs: several slices first, for example,
/// then the volume, of which only what lies in front of the slices is then seen through to them.
/// Plane and depth buffer keep what was drawn.
///
/// *Shape.* The plane's image is allocated by the caller with the data type of slices and volume
/// (unsigned or signed 16-bit). A volume is required for every algorithm. Slices and volume have
/// one channel; the volume's rows have no padding, nor have the plane's for voxel lists.
///
/// *Units and frame.* Depths are whole steps along the plane's axisZ, smaller ones nearer; the
/// depth buffer holds the nearest drawn so far for each pixel, 32767 for none.
///
/// *Outlines.* A slice's first and last rows and columns are drawn in the border value, and so are
/// its columns 1 to 7 of rows 1 to 7: a mark at its first pixel.
///
/// *Stopping.* A stop request ends the run within one row, or within 4,096 listed voxels, with the
/// status "stopped".
///
/// *Errors.* "missing input parameter 'Projection Slice'", "no slice to project", "incompatible
/// data types(Projection Plane: 0x%x, Slice: 0x%x", "no volume to project", "given Volume is
/// empty", "incompatible data types(Projection Plane: 0x%x, Volume: 0x%x", "no voxel list to
/// project", "Z-Buffer is incompatible to 'Projection Plane'", "unsupported data type: %d" (also
/// for an unknown algorithm), "invalid pixel data in slice %d of the Volume" (a slice whose pixels
/// were taken away or laid out otherwise after it was added, or whose rows are shorter than those
/// of slice 0), "invalid pixel data in the Projection Plane", "... the Z Buffer" or "... the Slice"
/// (its buffer was exchanged for one that does not hold its rows, or the depth buffer for one of
/// another data type), "error while initializing the 'Z Buffer'", "out of memory".
/// `SliceProjectionAlgo_SliceBack` fails without a message.
class VORL_API opSliceProjection : public OpBase {
 public:
  opSliceProjection();
  opSliceProjection(const opSliceProjection& source);
  opSliceProjection& operator=(const opSliceProjection& source);

  ClassInfo* GetClassInfo() override;
  ~opSliceProjection() override;
  /// Drops the inputs and the depth buffer; border value 0xFFFF; the algorithm stays; returns true.
  bool Reset() override;

 protected:
  bool Prepare() override;
  bool Process() override;

 public:
  static opSliceProjection* Create();
  static ClassInfo& CI();

  /// Chooses a `SliceProjectionAlgo`; checked when the operator runs.
  void SelectAlgo(int id);
  /// The value in which outlines are drawn.
  void SetBorderValue(unsigned short value);
  /// Formats the depth buffer like the plane and sets every depth to the farthest; without a plane,
  /// empties it. False, with a status, when there is no memory or the plane has no pixels.
  bool InitZBuffer();
  /// Fills the plane with 0.
  void ClearProjectionPlane();

  dSlice* projectionPlane = nullptr;  ///< output; not owned
  dSlice* slice = nullptr;            ///< the slice to draw; not owned
  dBuffer* voxelList = nullptr;       ///< packed voxel addresses; not owned
  dVolume* volume = nullptr;          ///< not owned
  dImage zBuffer;                     ///< signed 16-bit, one depth per pixel of the plane
  std::int32_t algoID = SliceProjectionAlgo_Slice;  ///< a `SliceProjectionAlgo`
  std::uint16_t borderValue = 0xFFFF;               ///< of outlines and marks

 protected:
  /// The workers of the algorithms, one per data type. They rely on what `Prepare` and `Process`
  /// check before: inputs of one type, and pixels and depths where their formats say.
  bool SliceProjectionU16(dSlice* source, dSlice* plane);
  bool SliceProjectionS16(dSlice* source, dSlice* plane);
  bool VolumeBackProjectionU16(dVolume* source, dSlice* plane);
  bool VolumeBackProjectionS16(dVolume* source, dSlice* plane);
  bool VoxelListProjectionU16(dVolume* source, dBuffer* list, dSlice* plane);
  bool VoxelListProjectionS16(dVolume* source, dBuffer* list, dSlice* plane);
  /// Do nothing; return false.
  bool SliceBackProjectionU16(dSlice* source, dSlice* plane);
  bool SliceBackProjectionS16(dSlice* source, dSlice* plane);
  /// The volume's brightest voxels without regard to depths; no algorithm selects them.
  bool VolumeProjectionU16(dVolume* source, dSlice* plane);
  bool VolumeProjectionS16(dVolume* source, dSlice* plane);

 private:
  bool CheckBuffers();
  template <class T>
  bool DrawSlice(const dSlice& source, dSlice& plane);
  template <class T>
  bool DrawVolume(const dVolume& source, dSlice& plane, bool limitedByDepth);
  template <class T>
  bool DrawVoxels(const dVolume& source, const dBuffer& list, dSlice& plane);
};

}  // namespace vorl

#endif
