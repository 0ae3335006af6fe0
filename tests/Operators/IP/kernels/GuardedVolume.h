#ifndef TESTS_OPERATORS_IP_KERNELS_GUARDEDVOLUME_H
#define TESTS_OPERATORS_IP_KERNELS_GUARDEDVOLUME_H

/// @file
/// Volumes whose every slice ends where memory ends.

#include <tests/Support/GuardPages.h>
#include <vorl/Operators/IP/kernels/VolumeView.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <memory>
#include <ostream>
#include <random>
#include <type_traits>
#include <vector>

namespace guarded_volume {

struct Shape {
  int width = 1;
  int height = 1;
  int depth = 1;
  unsigned short alignment = 2;  ///< of rows, in bytes
};

inline std::ostream& operator<<(std::ostream& out, const Shape& shape) {
  return out << shape.width << " x " << shape.height << " x " << shape.depth
             << " voxels, rows aligned to " << shape.alignment;
}

/// What the voxels are: numbers from `low` to `high`, or one of the two; `rareOutliers` of a
/// thousand are anything.
struct Values {
  int low;
  int high;
  bool onlyEnds = false;
  unsigned rareOutliers = 0;

  template <class T>
  T Next(std::mt19937& random) const {
    if (rareOutliers != 0 && random() % 1000 < rareOutliers) {
      return static_cast<T>(random());
    }
    if (onlyEnds) {
      return static_cast<T>(random() % 2 != 0 ? low : high);
    }
    return static_cast<T>(low + static_cast<int>(random() % static_cast<unsigned>(high - low + 1)));
  }
};

inline std::ostream& operator<<(std::ostream& out, const Values& values) {
  return out << "values " << values.low << (values.onlyEnds ? " or " : " to ") << values.high
             << " with " << values.rareOutliers << " outliers of a thousand";
}

/// The raster of each slice, from its first voxel to its last, is a block of guarded memory.
template <class T>
class GuardedVolume {
 public:
  /// Slices other than the first have the least padding: the rows of slice 0 count for all.
  GuardedVolume(const Shape& shape, const Values& values, GuardPages::Side side,
                std::mt19937& random) {
    for (int z = 0; z < shape.depth; ++z) {
      dSlice slice;
      const unsigned short type = std::is_signed_v<T> ? ImageDataType_S16 : ImageDataType_U16;
      EXPECT_TRUE(slice.GetImage().Init(static_cast<unsigned long>(shape.width),
                                        static_cast<unsigned long>(shape.height), type, "G",
                                        ImageDataOrder_Pixel, z == 0 ? shape.alignment : 2));
      EXPECT_EQ(m_volume.AddSlice(slice), z);
    }
    const std::size_t pitch = m_volume.GetSlice(0)->GetImage().GetDataSamplesPerRow();
    const auto width = static_cast<std::size_t>(shape.width);
    const std::size_t samples = pitch * static_cast<std::size_t>(shape.height - 1) + width;
    for (dSlice& slice : m_volume.GetSliceList()) {
      m_rasters.push_back(std::make_unique<GuardPages>(samples * sizeof(T), side));
      T* const raster = static_cast<T*>(m_rasters.back()->Data());
      for (std::size_t i = 0; i < samples; ++i) {
        if (i % pitch < width) {  // the padding stays filled otherwise
          raster[i] = values.Next<T>(random);
        }
      }
      slice.GetImage().GetDataBuffer().Init(raster, static_cast<unsigned long>(samples * sizeof(T)),
                                            DTM_Reference);
    }
    m_view = std::make_unique<vorl_detail::VolumeView>(m_volume);
    EXPECT_FALSE(m_view->FindInvalidSlice());
  }

  const vorl_detail::VolumeView& View() const { return *m_view; }

 private:
  std::vector<std::unique_ptr<GuardPages>> m_rasters;
  dVolume m_volume;
  std::unique_ptr<vorl_detail::VolumeView> m_view;
};

}  // namespace guarded_volume

#endif
