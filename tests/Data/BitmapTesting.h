#ifndef VORL_TESTS_DATA_BITMAPTESTING_H
#define VORL_TESTS_DATA_BITMAPTESTING_H

#include <gtest/gtest.h>
#include <vorl/Data/dImage.h>

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
