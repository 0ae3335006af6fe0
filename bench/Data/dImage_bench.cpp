// Formatting an image as it is already: operators do so with their targets at every run.
#include <vorl/Data/dImage.h>

#include "../Fixtures.h"

namespace {

void InitAgain(benchmark::State& state) {
  dImage image;
  for (auto _ : state) {
    image.Init(512UL, 512UL, ImageDataType_U16, "G", ImageDataOrder_Pixel, 4);
    benchmark::DoNotOptimize(image.GetDataPtr());
  }
  state.SetItemsProcessed(state.iterations());
}

BENCHMARK(InitAgain)->Name("dImage/init/equal");

}  // namespace
