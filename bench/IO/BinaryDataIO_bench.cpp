// A study of 300 slices of 512 x 512 pixels, 150 MB, written to and read from one binary data file,
// beside plain writing and reading of the same bytes. Files lie in the folder for temporary files:
// its file system sets the pace.
#include <vorl/IO/BinaryDataIO.h>

#include <cstdio>

#include "../Fixtures.h"
#include "../ImageStudy.h"
#include "../ScratchFile.h"

namespace {

class Study : public bench::ImageStudy {
 public:
  Study() : ImageStudy(static_cast<std::size_t>(bench::Shrunk(300))) {}

  void Fill() {
    for (dImage& image : Images()) {
      bench::MakeImage(image, 512, ImageDataType_U16);
    }
  }
};

void Report(benchmark::State& state, Study& study) {
  const dImage& image = study.Images().front();
  bench::Report(state, study.Images().size() * image.GetNumDataSamples(),
                study.Images().size() * image.GetImageSize());
}

void WriteStudy(benchmark::State& state) {
  const bench::ScratchFile file(".bdf");
  Study study;
  study.Fill();
  for (auto _ : state) {
    if (!study.WriteFile(file.Name(), "Study")) {
      state.SkipWithError("cannot write");
      return;
    }
  }
  Report(state, study);
}

void ReadStudy(benchmark::State& state) {
  const bench::ScratchFile file(".bdf");
  Study study;
  study.Fill();
  study.WriteFile(file.Name(), "Study");
  for (auto _ : state) {
    if (!study.ReadFile(file.Name(), "Study")) {
      state.SkipWithError("cannot read");
      return;
    }
    benchmark::ClobberMemory();
  }
  Report(state, study);
}

// The pixels alone, image by image.
template <class Transfer>
void Plain(benchmark::State& state, const char* mode, Transfer transfer) {
  const bench::ScratchFile file(".raw");
  Study study;
  study.Fill();
  study.WriteFile(file.Name(), "Study");  // something to read
  for (auto _ : state) {
    std::FILE* const raw = std::fopen(file.Name(), mode);
    for (dImage& image : study.Images()) {
      if (raw == nullptr || transfer(image.GetDataPtr(), image.GetImageSize(), 1, raw) != 1) {
        state.SkipWithError("cannot transfer");
        return;
      }
    }
    std::fclose(raw);
    benchmark::ClobberMemory();
  }
  Report(state, study);
}

void PlainWrite(benchmark::State& state) {
  Plain(state, "wb", &std::fwrite);
}
void PlainRead(benchmark::State& state) {
  Plain(state, "rb", &std::fread);
}

BENCHMARK(WriteStudy)->Name("BinaryDataOut/study")->Unit(benchmark::kMillisecond);
BENCHMARK(PlainWrite)->Name("BinaryDataOut/fwrite")->Unit(benchmark::kMillisecond);
BENCHMARK(ReadStudy)->Name("BinaryDataIn/study")->Unit(benchmark::kMillisecond);
BENCHMARK(PlainRead)->Name("BinaryDataIn/fread")->Unit(benchmark::kMillisecond);

}  // namespace
