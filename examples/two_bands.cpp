// Two operators at work side by side, each in its own thread and on its own half of one picture:
// the cut through a volume is made in two bands of rows.
#include <vorl/vorl.h>

#include <cstdio>
#include <thread>

namespace {

constexpr int kSize = 64;

// Makes the band a plane of the volume that begins with a row of the picture and refers to that
// part of the picture's pixels.
void SetUpBand(dSlice& band, dImage& picture, int firstRow, int rows) {
  dImage& image = band.GetImage();
  image.GetDataBuffer().Init(picture.GetRowPtr(firstRow),
                             picture.GetBytesPerRow() * static_cast<unsigned long>(rows),
                             DTM_Reference);
  image.Init(kSize, static_cast<unsigned long>(rows), ImageDataType_U16, "G", ImageDataOrder_Pixel,
             2);  // the same size: the pixels stay
  band.SetCoordinates({0, static_cast<float>(firstRow), 10}, {1, 0, 0}, {0, 1, 0}, {0, 0, 1});
}

}  // namespace

int main() {
  dVolume volume;  // voxel (x, y, z) has the value x + y + z
  for (int z = 0; z < 20; ++z) {
    dSlice slice;
    slice.GetImage().Init(kSize, kSize, ImageDataType_U16, "G", ImageDataOrder_Pixel, 2);
    for (int y = 0; y < kSize; ++y) {
      auto* const row = static_cast<unsigned short*>(slice.GetImage().GetRowPtr(y));
      for (int x = 0; x < kSize; ++x) {
        row[x] = static_cast<unsigned short>(x + y + z);
      }
    }
    volume.AddSlice(slice);
  }

  dImage picture;
  picture.Init(kSize, kSize, ImageDataType_U16, "G", ImageDataOrder_Pixel, 2);
  dSlice upper, lower;
  SetUpBand(upper, picture, 0, kSize / 2);
  SetUpBand(lower, picture, kSize / 2, kSize / 2);
  opMPR first, second;
  first.volume = second.volume = &volume;
  first.mprSlice = &upper;
  second.mprSlice = &lower;
  first.RunAsThread(0);
  second.RunAsThread(0);
  while (first.IsRunning() || second.IsRunning()) {
    std::this_thread::yield();  // an application would show the progress
  }
  if (!first.GetStatus().IsOK() || !second.GetStatus().IsOK()) {
    return 1;
  }
  for (const int y : {0, kSize / 2 - 1, kSize / 2, kSize - 1}) {
    const auto* const row = static_cast<const unsigned short*>(picture.GetRowPtr(y));
    std::printf("row %2d: %u to %u\n", y, row[0], row[kSize - 1]);
  }
}

// Prints:
//   row  0: 10 to 73
//   row 31: 41 to 104
//   row 32: 42 to 105
//   row 63: 73 to 136
