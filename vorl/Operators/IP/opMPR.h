#ifndef VORL_OPERATORS_IP_OPMPR_H
#define VORL_OPERATORS_IP_OPMPR_H

/// @file
/// Multi-planar reconstruction: an arbitrary plane out of a volume.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dVolume.h>

#include <cstdint>

inline namespace vorl {

/// The algorithms of `opMPR`.
enum MPRAlgo : std::int32_t {
  MPRAlgo_Trilinear = 101,  ///< interpolated between voxels
  MPRAlgo_Nearest = 102     ///< the voxel whose cell holds the point
};

/// Resamples a volume on a plane, thin or as the mean across a slab.
///
/// *Shape.* The caller allocates the output slice's image in the wanted size, with the volume's
/// data type (unsigned or signed 16-bit). The slice's coordinate system is the sampling plane:
/// pixel (i, j) is taken at origin + i * axisX + j * axisY, the slab lies half a thickness (axisZ)
/// below and above it.
///
/// *Units and frame.* Points are carried into the voxel coordinates of the volume and walked in
/// 16.16 fixed point. Voxel (i, j, k) covers the cell from i to i + 1 in each direction; nearest
/// takes the voxel whose cell holds the point, trilinear weighs the voxel and its upper neighbours
/// (at the last one the voxel itself) by the fractions. Of the two rows the lower one counts the
/// difference between its columns with the opposite sign, on purpose. A point outside the volume
/// gives 0. The volume's slices have one channel and rows without padding.
///
/// *Range.* Trilinear results below 0 are stored as 0; above the data type's largest value the low
/// 16 bits are stored; products of a difference and a fraction wrap at 32 bits, which differences
/// above 32,767 can reach. Volumes have fewer than 32,768 voxels in each direction, and so far may
/// the plane reach: positions wrap at 32 bits. A plane whose place is not a number lies outside.
///
/// *Stopping.* A stop request ends the run within one output row, with the status "stopped"; the
/// rows before it are written.
///
/// *Errors.* "missing input parameter 'Volume'", "given Volume is empty", "missing input parameter
/// 'MPR Slice'", "incompatible data types(Volume: 0x%x, Slice: 0x%x", "invalid MPR Algo ID: %d",
/// "unsupported data type: %d", "invalid pixel data in slice %d of the Volume" (a slice whose
/// pixels were taken away or laid out otherwise after it was added, or whose rows are shorter than
/// those of slice 0), "invalid pixel data in the MPR Slice" (its buffer was exchanged for one that
/// does not hold its rows), "out of memory".
class VORL_API opMPR : public OpBase {
 public:
  opMPR();
  opMPR(const opMPR& source);
  opMPR& operator=(const opMPR& source);

  ClassInfo* GetClassInfo() override;
  ~opMPR() override;
  /// Drops slice and volume; nearest voxel, thin; returns true.
  bool Reset() override;

 protected:
  bool Prepare() override;
  bool Process() override;

 public:
  static opMPR* Create();
  static ClassInfo& CI();

  /// Chooses an `MPRAlgo`; checked when the operator runs.
  void SelectAlgo(int id);
  /// The number of samples across the slab, at least 2; 0 for a thin plane; negative for one per
  /// voxel that the thickness crosses along its dominant axis.
  void SetDepthSteps(int count);

  dSlice* mprSlice = nullptr;             ///< output; not owned
  dVolume* volume = nullptr;              ///< input; not owned
  std::int32_t algoID = MPRAlgo_Nearest;  ///< an `MPRAlgo`
  std::int32_t depthSteps = 0;            ///< see `SetDepthSteps`

 private:
  template <class T, class Sampler>
  bool Reconstruct(dVolume& source, dSlice& target, bool thick);

  bool MPRThinNearestU16(dVolume& source, dSlice& target);
  bool MPRThickNearestU16(dVolume& source, dSlice& target);
  bool MPRThinTrilinearU16(dVolume& source, dSlice& target);
  bool MPRThickTrilinearU16(dVolume& source, dSlice& target);
  bool MPRThinNearestS16(dVolume& source, dSlice& target);
  bool MPRThickNearestS16(dVolume& source, dSlice& target);
  bool MPRThinTrilinearS16(dVolume& source, dSlice& target);
  bool MPRThickTrilinearS16(dVolume& source, dSlice& target);
};

}  // namespace vorl

#endif
