#ifndef VORL_OPERATORS_IP_OPVOXELCLASSIFICATION_H
#define VORL_OPERATORS_IP_OPVOXELCLASSIFICATION_H

/// @file
/// Voxels counted by class, and the highest classes picked into a voxel list.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dVOI.h>
#include <vorl/Data/dVolume.h>

#include <cstdint>

inline namespace vorl {

/// The algorithms of `opVoxelClassification`.
enum VoxelClassificationAlgo : std::int16_t {
  VoxelClassificationAlgo_None = 400,
  VoxelClassificationAlgo_Value = 401,  ///< classify by voxel value: the histogram
  VoxelClassificationAlgo_Edge = 402,   ///< classify by edge strength
  VoxelClassificationAlgo_Select = 403  ///< pick the voxels of the highest classes
};

/// Counts the voxels of each class, and lists those of the highest classes.
///
/// *Passes.* A classification (by value or by edge strength) counts the classes into
/// `classCounters`; a selection then lists as many voxels of the highest classes as fit under the
/// selection limit, and always whole classes: those from the lowest that still fits up to, but not
/// including, the very highest class that the data type can hold.
///
/// *Classes.* By value: the voxel value, unsigned or signed 16-bit. By edge strength: how far the
/// low 12 bits of a voxel rise above the lower of its right and lower neighbours, 0 when they do
/// not; the last column and the last row are left out.
///
/// *Voxel list.* Packed addresses, (z << 22) | (y << 11) | x, in the order z, y, x. There is room
/// for 2048 columns, 2048 rows and 1024 slices, of which the projections read 512: in larger
/// volumes the parts of an address run into each other. Where all voxels fit under the limit, a
/// selection by edge strength also lists those that do not rise above their neighbours. A list that
/// refers to foreign memory becomes one of its own.
///
/// *Shape.* One channel of unsigned or signed 16-bit samples; rows may be padded.
///
/// *Stopping.* A stop request ends the run within one row of voxels, with the status "stopped".
///
/// *Errors.* "missing input parameter 'Volume'", "given Volume is empty", "no 'Algorithm ID'
/// specified", "class counter allocation failed[Size: %d]", "can't select voxels: voxels are not
/// yet classified", "can't select voxels: no 'Selection Limit' specified", "missing input parameter
/// 'Voxel List'", "can't create voxel list[Size: %d]", "invalid algo ID: %d", "unsupported data
/// type: %d", "voxel classification error", "voxel selection error", "invalid pixel data in slice
/// %d of the Volume" (a slice whose pixels were taken away or laid out otherwise after it was
/// added, or whose rows are shorter than those of slice 0), "the class counters can't be the 'Voxel
/// List'", "out of memory". After a failed classification no selection runs.
class VORL_API opVoxelClassification : public OpBase {
 public:
  opVoxelClassification();
  opVoxelClassification(const opVoxelClassification& source);
  opVoxelClassification& operator=(const opVoxelClassification& source);

  ClassInfo* GetClassInfo() override;
  ~opVoxelClassification() override;
  /// Drops inputs, counters, limit and classification; returns true.
  bool Reset() override;

 protected:
  bool Prepare() override;
  bool Process() override;

 public:
  static opVoxelClassification* Create();
  static ClassInfo& CI();

  /// Chooses a `VoxelClassificationAlgo`; checked when the operator runs.
  void SelectAlgo(short id);
  /// The largest number of voxels that a selection lists; 0 for not specified. A number beyond 32
  /// bits counts as the largest one, for which no list can be created.
  void SetSelectionLimit(unsigned long voxels);
  void SetSelectionLimit(unsigned long long voxels);
  /// A negative number counts as the largest one.
  void SetSelectionLimit(long voxels);
  void SetSelectionLimit(unsigned int voxels);
  void SetSelectionLimit(int voxels);
  /// The same as a percentage of the volume, which must be set first; without one nothing changes.
  void SetSelectionLimit(double percent);

  dVolume* volume = nullptr;     ///< input; not owned
  dBuffer* voxelList = nullptr;  ///< output of a selection, which sizes it; not owned
  dBuffer classCounters;         ///< one unsigned 32-bit counter per class; signed values start at
                                 ///< counter 32768
  std::int16_t algoID = VoxelClassificationAlgo_None;        ///< a `VoxelClassificationAlgo`
  std::int16_t classifiedBy = VoxelClassificationAlgo_None;  ///< what the counters count
  std::uint32_t selectionLimit = 0;                          ///< in voxels; 0: not specified

 protected:
  bool ClassifyVoxels();
  bool SelectVoxels();

 private:
  bool AllocateCounters();
  bool AllocateList();

  bool ClassifyVoxelsU16(int algo, dVolume* source, const dVOI* region, std::uint32_t* counters);
  bool ClassifyVoxelsS16(int algo, dVolume* source, const dVOI* region, std::uint32_t* counters);
  bool SelectVoxelsU16(int classAlgo, dVolume* source, const dVOI* region, dBuffer* list,
                       const std::uint32_t* counters, int lowBound, int highClass, bool upward);
  bool SelectVoxelsS16(int classAlgo, dVolume* source, const dVOI* region, dBuffer* list,
                       const std::uint32_t* counters, int lowBound, int highClass, bool upward);
  template <class T>
  bool Count(int algo, const dVolume& source, const dVOI* region, std::uint32_t* counters);
  template <class T>
  bool Select(int classAlgo, const dVolume& source, const dVOI* region, dBuffer& list,
              const std::uint32_t* counters, int lowBound, int highClass);

  dBuffer m_spareBuffer;  ///< reset with the operator
};

}  // namespace vorl

#endif
