#ifndef VORL_TESTS_DATA_BITMAPTESTING_H
#define VORL_TESTS_DATA_BITMAPTESTING_H

#include <gtest/gtest.h>
#include <vorl/Data/dImage.h>

/// An image of one channel that claims more pixels than there are. Nobody may look at them.
class ClaimingImage : public dImage {
 public:
  ClaimingImage(unsigned long width, unsigned long height, unsigned short type) {
    static unsigned char nothing;
    const unsigned long bytes = (width / 8 * type + 3) / 4 * 4 * height;
    // `Init` keeps a buffer of the right size.
    EXPECT_TRUE(m_buffer.Init(&nothing, bytes, DTM_Reference));
    EXPECT_TRUE(Init(width, height, type, "G", ImageDataOrder_Pixel, 4));
    EXPECT_EQ(GetDataPtr(), &nothing);
  }
};

/// An image in pixel order whose bytes, padding included, differ from their neighbours.
inline dImage MakeImage(unsigned long width, unsigned long height, unsigned short type,
                        const char* sequence, unsigned short alignment = 4) {
  dImage image;
  EXPECT_TRUE(image.Init(width, height, type, sequence, ImageDataOrder_Pixel, alignment));
  auto* bytes = static_cast<unsigned char*>(image.GetDataPtr());
  for (unsigned long i = 0; i < image.GetImageSize(); ++i) {
    bytes[i] = static_cast<unsigned char>(i * 7 + 1);
  }
  return image;
}

#endif
