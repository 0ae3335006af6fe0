#ifndef TESTS_OPERATORS_IP_RASTERS_H
#define TESTS_OPERATORS_IP_RASTERS_H

/// @file
/// What the operators' tests share: random numbers, images to work on, and images whose
/// surroundings are watched.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <cstring>
#include <memory>
#include <random>
#include <string>
#include <vector>

namespace rasters {

using Bytes = std::vector<unsigned char>;

/// Random numbers that are the same on every platform.
class Random {
 public:
  explicit Random(std::uint32_t seed) : m_engine(seed) {}

  /// From `low` to `high`, both included.
  int Between(int low, int high) {
    const auto span = static_cast<std::uint32_t>(high - low) + 1U;
    return low + static_cast<int>(span != 0 ? m_engine() % span : m_engine());
  }

  template <class Container>
  auto Pick(const Container& choices) {
    return choices[static_cast<std::size_t>(Between(0, static_cast<int>(std::size(choices)) - 1))];
  }

  void Fill(void* bytes, std::size_t count) {
    for (std::size_t i = 0; i < count; ++i) {
      static_cast<unsigned char*>(bytes)[i] = static_cast<unsigned char>(m_engine() >> 7);
    }
  }

 private:
  std::mt19937 m_engine;
};

struct Format {
  unsigned long width = 1;
  unsigned long height = 1;
  unsigned short type = ImageDataType_U8;
  const char* channels = "G";
  unsigned short order = ImageDataOrder_Pixel;
  unsigned short alignment = 1;
};

/// Formats the image; its pixels are not set.
inline void Make(dImage& image, const Format& format) {
  ASSERT_TRUE(image.Init(format.width, format.height, format.type, format.channels, format.order,
                         format.alignment));
}

/// Formats the image and fills all its bytes, padding included.
inline void MakeRandom(dImage& image, const Format& format, Random& random) {
  Make(image, format);
  random.Fill(image.GetDataPtr(), image.GetImageSize());
}

/// Formats the image like an unpadded raster of T and copies the samples.
template <class T>
void MakeOf(dImage& image, const Format& format, const std::vector<T>& samples) {
  Make(image, format);
  ASSERT_EQ(image.GetImageSize(), samples.size() * sizeof(T));
  std::memcpy(image.GetDataPtr(), samples.data(), image.GetImageSize());
}

/// All bytes of the image, padding included.
inline Bytes BytesOf(const dImage& image) {
  const auto* data = static_cast<const unsigned char*>(image.GetDataPtr());
  return Bytes(data, data + image.GetImageSize());
}

/// The samples of an image's rows, all planes, without their padding.
template <class T>
std::vector<T> SamplesOf(const dImage& image) {
  std::vector<T> samples;
  const auto* row = static_cast<const unsigned char*>(image.GetDataPtr());
  for (unsigned long y = 0; y < image.GetNumRows(); ++y, row += image.GetBytesPerRow()) {
    const auto* first = reinterpret_cast<const T*>(row);
    samples.insert(samples.end(), first, first + image.GetDataSamplesInRow());
  }
  return samples;
}

/// The operator's class record names it, has the operator base as its parent, and makes it.
template <class Op>
void ExpectRegistered(const char* name) {
  EXPECT_STREQ(Op::CI().name, name);
  ASSERT_NE(Op::CI().parents, nullptr);
  EXPECT_EQ(Op::CI().parents[0], &OpBase::CI());
  EXPECT_EQ(Op::CI().parents[1], nullptr);
  const std::unique_ptr<Op> op(Op::Create());
  EXPECT_EQ(op->GetClassInfo(), &Op::CI());
  const std::unique_ptr<BaseClass> made(Op::CI().Create());
  ASSERT_NE(made, nullptr);
  EXPECT_EQ(made->GetClassInfo(), &Op::CI());
}

/// An operator that is asked to stop between its preparation and its work.
template <class Op>
class StoppedBeforeWork : public Op {
 protected:
  bool Prepare() override {
    const bool ok = Op::Prepare();
    this->m_stopRequested = true;
    return ok;
  }
};

/// An operator that is asked to stop while it starts.
template <class Op>
class StoppedAtStart : public Op {
 protected:
  void Start() override {
    Op::Start();
    this->m_stopRequested = true;
  }
};

/// An operator whose preparation can be asked for alone.
template <class Op>
class Preparing : public Op {
 public:
  using Op::Prepare;
};

/// An image that cannot be formatted.
class StubbornImage : public dImage {
 public:
  using dImage::Init;
  bool Init(unsigned long, unsigned long, unsigned short, const char*, unsigned short,
            unsigned short) override {
    m_status.Set(-7, "no room");
    return false;
  }
};

/// What an operator reported.
inline std::string MessageOf(const OpBase& op) {
  return static_cast<const char*>(op.GetStatus());
}

inline long CodeOf(const OpBase& op) {
  return static_cast<long>(op.GetStatus());
}

/// Memory under an image, with a known byte in every place that no sample occupies.
class GuardedMemory {
 public:
  static constexpr unsigned char kMark = 0xA5;

  /// Formats the image and lets it show this memory, filled with the mark.
  void PutUnder(dImage& image, const Format& format) {
    Make(image, format);
    const unsigned long size = image.GetImageSize();
    m_memory.assign(size + 2 * kGuard, kMark);
    image.GetDataBuffer().Init(m_memory.data() + kGuard, size, DTM_Reference);
    m_image = &image;
  }

  /// The guards before and behind the pixels and the padding of each row are as they were, and the
  /// image still shows this memory.
  void ExpectSurroundingsUntouched() const {
    ExpectGuardsUntouched();
    const unsigned long rowBytes = m_image->GetBytesPerRow();
    const unsigned long used = m_image->GetDataSamplesInRow() * (m_image->GetChannelDepth() / 8U);
    for (std::size_t i = kGuard; i < m_memory.size() - kGuard; ++i) {
      if ((i - kGuard) % rowBytes >= used) {
        ASSERT_EQ(m_memory[i], kMark) << "at byte " << i << " of " << m_memory.size();
      }
    }
  }

  /// The same without the padding of the rows.
  void ExpectGuardsUntouched() const {
    ASSERT_EQ(m_image->GetDataPtr(), m_memory.data() + kGuard);
    for (std::size_t i = 0; i < kGuard; ++i) {
      ASSERT_EQ(m_memory[i], kMark) << i << " bytes into the guard before the pixels";
      ASSERT_EQ(m_memory[m_memory.size() - 1 - i], kMark) << "in the guard behind the pixels";
    }
  }

 private:
  static constexpr std::size_t kGuard = 64;

  dImage* m_image = nullptr;
  Bytes m_memory;
};

}  // namespace rasters

#endif
