#ifndef TESTS_OPERATORS_IP_THREADJOBS_H
#define TESTS_OPERATORS_IP_THREADJOBS_H

/// @file
/// Work for the volume operators to do in their own threads: short rows, and many of them.

#include <vorl/Operators/IP/opMIP.h>
#include <vorl/Operators/IP/opSliceProjection.h>
#include <vorl/Operators/IP/opVoxelClassification.h>

#include <memory>

#include "Volumes.h"
#include "VoxelLists.h"

namespace thread_jobs {

/// An operator with its inputs and outputs.
class Job {
 public:
  virtual ~Job() = default;
  virtual OpBase& Op() = 0;
  /// Puts the outputs back to what they were before the first run.
  virtual void Clear() = 0;
  virtual rasters::Bytes Result() const = 0;
  /// The pieces of work between which the operator looks for a stop request.
  virtual double Rows() const = 0;
};

/// Some milliseconds of work, or more of it than anyone waits for.
enum class Amount { Small, Large };

/// A list of the voxels of a counting volume of 8 x 8 x 8, over and over.
inline dBuffer MakeList(std::uint32_t count) {
  dBuffer list(count * 4UL);
  auto* next = static_cast<unsigned char*>(list.Get(0));
  for (std::uint32_t i = 0; i < count; ++i, next += 4) {
    const std::uint32_t entry = voxel_lists::Pack(i % 8, i / 8 % 8, i / 64 % 8);
    std::memcpy(next, &entry, 4);
  }
  return list;
}

inline double PiecesOf(const dBuffer& list) {
  return static_cast<double>((list.GetSize() / 4 + 4095) / 4096);
}

class MIPJob : public Job {
 public:
  MIPJob(int algo, Amount amount) {
    const bool large = amount == Amount::Large;
    rasters::MakeCounting(m_volume, 8, 8, 8);
    rasters::MakeSlice(m_slice, 8, large ? 1000000 : 500);
    m_slice.SetPosition(dVect3D(0, 0, 4));
    m_slice.GetCoordinates().axisY = dVect3D(0, large ? 0.000015F : 0.015F, 0);
    m_slice.GetCoordinates().axisZ = dVect3D(0, 0, 8);
    if (algo == MIPAlgo_VoxelList) {
      m_list = MakeList(large ? 20000000 : 100000);
    }
    m_op.volume = &m_volume;
    m_op.mipSlice = &m_slice;
    m_op.voxelList = &m_list;
    m_op.SelectAlgo(algo);
    m_op.SetDepthSteps(100);
  }
  OpBase& Op() override { return m_op; }
  void Clear() override { m_slice.GetImage().Fill(0x5A); }
  rasters::Bytes Result() const override { return rasters::BytesOf(m_slice.GetImage()); }
  double Rows() const override {
    return m_op.algoID == MIPAlgo_VoxelList ? PiecesOf(m_list)
                                            : static_cast<double>(m_slice.GetHeight());
  }

 private:
  dVolume m_volume;
  dSlice m_slice;
  dBuffer m_list;
  opMIP m_op;
};

class SliceProjectionJob : public Job {
 public:
  SliceProjectionJob(int algo, Amount amount) {
    const bool large = amount == Amount::Large;
    const bool drawsVolume = algo == SliceProjectionAlgo_Volume;
    rasters::MakeCounting(m_volume, 8, 8, 8);
    rasters::MakeSlice(m_plane, 8, !drawsVolume ? 8 : large ? 500000 : 200);
    rasters::MakeSlice(m_slice, 8, large ? 4000000 : 20000);
    m_slice.GetImage().Fill(7);
    m_slice.GetCoordinates().axisY = dVect3D(0, 0.0001F, -0.0001F);
    if (drawsVolume) {
      m_plane.GetCoordinates().axisY = dVect3D(0, large ? 0.001F : 0.04F, 0);
      m_plane.GetCoordinates().axisZ = dVect3D(0, 0, 0.02F);
    }
    if (algo == SliceProjectionAlgo_VoxelList) {
      m_list = MakeList(large ? 20000000 : 100000);
    }
    m_op.volume = &m_volume;
    m_op.projectionPlane = &m_plane;
    m_op.slice = &m_slice;
    m_op.voxelList = &m_list;
    m_op.SelectAlgo(algo);
    SliceProjectionJob::Clear();
  }
  OpBase& Op() override { return m_op; }
  void Clear() override {
    m_op.ClearProjectionPlane();
    EXPECT_TRUE(m_op.InitZBuffer());
  }
  rasters::Bytes Result() const override {
    rasters::Bytes bytes = rasters::BytesOf(m_plane.GetImage());
    const rasters::Bytes depths = rasters::BytesOf(m_op.zBuffer);
    bytes.insert(bytes.end(), depths.begin(), depths.end());
    return bytes;
  }
  double Rows() const override {
    switch (m_op.algoID) {
      case SliceProjectionAlgo_Slice:
        return static_cast<double>(m_slice.GetHeight());
      case SliceProjectionAlgo_Volume:
        return static_cast<double>(m_plane.GetHeight());
      default:
        return PiecesOf(m_list);
    }
  }

 private:
  dVolume m_volume;
  dSlice m_plane;
  dSlice m_slice;
  dBuffer m_list;
  opSliceProjection m_op;
};

/// The slices of its volume share one block.
class ClassificationJob : public Job {
 public:
  ClassificationJob(short algo, Amount amount) {
    const bool large = amount == Amount::Large;
    const rasters::Format format = {.width = large ? 1000UL : 300UL,
                                    .height = large ? 1000UL : 100UL,
                                    .type = ImageDataType_U16};
    m_pixels.resize(format.width * format.height);
    rasters::Random(71).Fill(m_pixels.data(), m_pixels.size() * 2);
    for (int z = 0; z < (large ? 4000 : 10); ++z) {
      dSlice slice;
      rasters::Make(slice.GetImage(), format);
      slice.GetImage().GetDataBuffer().Init(
          m_pixels.data(), static_cast<unsigned long>(m_pixels.size() * 2), DTM_Reference);
      EXPECT_EQ(m_volume.AddSlice(slice), z);
    }
    m_op.volume = &m_volume;
    m_op.voxelList = &m_list;
    m_op.SetSelectionLimit(large ? 100U : 100000U);
    m_op.SelectAlgo(algo);
    if (algo == VoxelClassificationAlgo_Select) {
      CountOneSlice();
    }
  }
  OpBase& Op() override { return m_op; }
  void Clear() override {}
  rasters::Bytes Result() const override {
    const dBuffer& output =
        m_op.algoID == VoxelClassificationAlgo_Select ? m_list : m_op.classCounters;
    const auto* first = static_cast<const unsigned char*>(output.Get(0));
    return rasters::Bytes(first, first + output.GetSize());
  }
  double Rows() const override {
    const int leftOut = m_op.algoID == VoxelClassificationAlgo_Edge ? 1 : 0;
    return static_cast<double>(m_volume.GetSizeY() - leftOut) * m_volume.GetSizeZ();
  }

 private:
  // One slice stands for all of them: classifying the whole large volume would take too long.
  void CountOneSlice() {
    dVolume one;
    dSlice slice(m_volume.GetSliceList().front());
    one.AddSlice(slice);
    m_op.volume = &one;
    m_op.SelectAlgo(VoxelClassificationAlgo_Value);
    EXPECT_TRUE(m_op.Run());
    m_op.volume = &m_volume;
    m_op.SelectAlgo(VoxelClassificationAlgo_Select);
  }

  std::vector<std::uint16_t> m_pixels;
  dVolume m_volume;
  dBuffer m_list;
  opVoxelClassification m_op;
};

/// The job of an algorithm of any of the three operators.
inline std::unique_ptr<Job> Make(int algo, Amount amount) {
  switch (algo / 100) {
    case 2:
      return std::make_unique<MIPJob>(algo, amount);
    case 3:
      return std::make_unique<SliceProjectionJob>(algo, amount);
    default:
      return std::make_unique<ClassificationJob>(static_cast<short>(algo), amount);
  }
}

}  // namespace thread_jobs

#endif
