#ifndef VORL_TESTS_DATA_IMAGETESTING_H
#define VORL_TESTS_DATA_IMAGETESTING_H

#include <vorl/Data/dImage.h>

#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <vector>

using Bytes = std::vector<unsigned char>;

/// An image that notes its hooks and opens what is protected.
class HookedImage : public dImage {
 public:
  using dImage::AllocateDataBuffer;
  using dImage::CheckPixelAccess;
  using dImage::Init;
  using dImage::operator=;

  bool Init(unsigned long width, unsigned long height, unsigned short dataType,
            const char* channelSequence, unsigned short dataOrder,
            unsigned short rowAlignment) override {
    ++formatCalls;
    return dImage::Init(width, height, dataType, channelSequence, dataOrder, rowAlignment);
  }

  std::string trail;            ///< "I" for each OnInit, "R" for each OnReset
  bool wasValidAtInit = false;  ///< whether the pixels were there at the last OnInit
  bool failOnInit = false;      ///< OnInit sets a failure
  int formatCalls = 0;          ///< calls of the six-argument Init

 protected:
  void OnInit() override {
    trail += 'I';
    wasValidAtInit = IsValid();
    if (failOnInit) {
      m_status.Set(-7, "refused");
    }
  }
  void OnReset() override { trail += 'R'; }
};

/// Gives every byte, the row padding included, a value of its own.
inline void FillWithPattern(dImage& image, unsigned char first = 1) {
  auto* bytes = static_cast<unsigned char*>(image.GetDataPtr());
  for (unsigned long i = 0; i < image.GetImageSize(); ++i) {
    bytes[i] = static_cast<unsigned char>(first + i * 7);
  }
}

inline Bytes BytesOf(const dImage& image) {
  Bytes bytes(image.GetImageSize());
  if (!bytes.empty()) {
    std::memcpy(bytes.data(), image.GetDataPtr(), bytes.size());
  }
  return bytes;
}

/// Everything that a format consists of.
inline void ExpectSameFormat(const dImage& image, const dImage& model) {
  EXPECT_EQ(image.GetWidth(), model.GetWidth());
  EXPECT_EQ(image.GetHeight(), model.GetHeight());
  EXPECT_EQ(image.GetNumChannels(), model.GetNumChannels());
  EXPECT_EQ(image.GetDataType(), model.GetDataType());
  EXPECT_EQ(image.GetDataOrder(), model.GetDataOrder());
  EXPECT_EQ(image.GetRowAlignment(), model.GetRowAlignment());
  EXPECT_EQ(image.GetChannelOffset(), model.GetChannelOffset());
  EXPECT_EQ(image.GetColumnOffset(), model.GetColumnOffset());
  EXPECT_EQ(image.GetRowOffset(), model.GetRowOffset());
  EXPECT_EQ(image.GetBytesPerRow(), model.GetBytesPerRow());
  EXPECT_STREQ(image.GetChannelSequence(), model.GetChannelSequence());
}

/// No pixels, and the format of an image that has never been formatted.
inline void ExpectReset(const dImage& image) {
  EXPECT_FALSE(image.IsValid());
  EXPECT_EQ(image.GetDataPtr(), nullptr);
  EXPECT_EQ(image.GetImageSize(), 0u);
  EXPECT_EQ(image.GetPosX(), 0);
  EXPECT_EQ(image.GetPosY(), 0);
  EXPECT_EQ(image.GetWidth(), 0u);
  EXPECT_EQ(image.GetHeight(), 0u);
  EXPECT_EQ(image.GetNumChannels(), 0);
  EXPECT_EQ(image.GetDataType(), 8);
  EXPECT_EQ(image.GetDataOrder(), 0);
  EXPECT_EQ(image.GetRowAlignment(), 1);
  EXPECT_EQ(image.GetChannelOffset(), 0u);
  EXPECT_EQ(image.GetColumnOffset(), 0u);
  EXPECT_EQ(image.GetRowOffset(), 0u);
  EXPECT_EQ(image.GetBytesPerRow(), 0u);
  EXPECT_STREQ(image.GetChannelSequence(), "");
}

inline void ExpectStatus(const dStatus& status, long code, const std::string& message) {
  EXPECT_EQ(static_cast<long>(status), code);
  EXPECT_STREQ(static_cast<const char*>(status), message.c_str());
}

#endif
