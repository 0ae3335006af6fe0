#ifndef VORL_OPERATORS_IP_OPMIP_H
#define VORL_OPERATORS_IP_OPMIP_H

/// @file
/// Maximum intensity projection: the brightest samples of a slab.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dVolume.h>

#include <cstdint>

inline namespace vorl {

/// The algorithms of `opMIP`.
enum MIPAlgo : std::int32_t {
  MIPAlgo_Nearest = 201,    ///< the nearest voxels along the slab
  MIPAlgo_Trilinear = 202,  ///< interpolated samples along the slab
  MIPAlgo_VoxelList = 205   ///< listed voxels carried into the slice
};

/// Projects the largest values of a slab into a slice.
///
/// *Shape.* The caller allocates the output slice's image in the wanted size, with the volume's
/// data type (unsigned or signed 16-bit). The slice's coordinate system is the projection plane;
/// the slab lies half a thickness (axisZ) below and above it. Sampling is that of `opMPR`; the
/// volume's slices have one channel and rows without padding.
///
/// *Range.* The largest sample is at least 0, for signed data too: a pixel without a positive
/// sample inside the volume becomes 0. An interpolated sample may exceed the data type (see
/// `opMPR`); its low 16 bits are stored.
///
/// *Voxel lists.* `MIPAlgo_VoxelList` takes packed addresses, (z << 22) | (y << 11) | x, in volumes
/// of at most 512 slices. Its admission rule takes only voxels that project outside the slice, and
/// those are not drawn: the slice stays as it is.
///
/// *Stopping.* A stop request ends the run within one output row, or within 4,096 listed voxels,
/// with the status "stopped".
///
/// *Errors.* "missing input parameter 'Volume'", "given Volume is empty", "missing input parameter
/// 'MIP Slice'", "incompatible data types(Volume: 0x%x, Slice: 0x%x", "missing input parameter
/// 'Voxel List'", "'Voxel List' is empty", "invalid MIP Algo ID: %d", "unsupported data type: %d",
/// "invalid pixel data in slice %d of the Volume" (a slice whose pixels were taken away or laid out
/// otherwise after it was added, or whose rows are shorter than those of slice 0), "invalid pixel
/// data in the MIP Slice" (its buffer was exchanged for one that does not hold its rows), "out of
/// memory".
class VORL_API opMIP : public OpBase {
 public:
  opMIP();
  opMIP(const opMIP& source);
  opMIP& operator=(const opMIP& source);

  ClassInfo* GetClassInfo() override;
  ~opMIP() override;
  /// Drops slice, volume and list; nearest voxel, steps derived from the thickness; returns true.
  bool Reset() override;

 protected:
  bool Prepare() override;
  bool Process() override;

 public:
  static opMIP* Create();
  static ClassInfo& CI();

  /// Chooses a `MIPAlgo`; checked when the operator runs.
  void SelectAlgo(int id);
  /// The number of samples across the slab, at least 2; negative for one per voxel that the
  /// thickness crosses along its dominant axis.
  void SetDepthSteps(int count);

  dSlice* mipSlice = nullptr;             ///< output; not owned
  dVolume* volume = nullptr;              ///< input; not owned
  dBuffer* voxelList = nullptr;           ///< input of `MIPAlgo_VoxelList`; not owned
  std::int32_t algoID = MIPAlgo_Nearest;  ///< a `MIPAlgo`
  std::int32_t depthSteps = -1;           ///< see `SetDepthSteps`

 private:
  template <class T, class Sampler>
  bool Project(dVolume& source, dSlice& target);
  template <class T>
  bool ProjectList(dVolume& source, dBuffer& list, dSlice& target);

  bool MIPNearestU16(dVolume& source, dSlice& target);
  bool MIPTrilinearU16(dVolume& source, dSlice& target);
  bool MIPVoxelListU16(dVolume& source, dBuffer& list, dSlice& target);
  bool MIPNearestS16(dVolume& source, dSlice& target);
  bool MIPTrilinearS16(dVolume& source, dSlice& target);
  bool MIPVoxelListS16(dVolume& source, dBuffer& list, dSlice& target);
};

}  // namespace vorl

#endif
