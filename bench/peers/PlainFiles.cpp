// Files: the same bytes by fwrite and fread, without a format.
#include <cstdio>

#include "../ScratchFile.h"
#include "Plain.h"
#include "Works.h"

namespace peers {
namespace {

/// Slice by slice, or an image at once.
bool Write(const char* path, const std::uint8_t* bytes, std::size_t size, std::size_t part) {
  std::FILE* const file = std::fopen(path, "wb");
  bool isDone = file != nullptr;
  for (std::size_t i = 0; isDone && i < size; i += part) {
    isDone = std::fwrite(bytes + i, part, 1, file) == 1;
  }
  return file != nullptr && std::fclose(file) == 0 && isDone;
}

bool Read(const char* path, std::uint8_t* bytes, std::size_t size, std::size_t part) {
  std::FILE* const file = std::fopen(path, "rb");
  bool isDone = file != nullptr;
  for (std::size_t i = 0; isDone && i < size; i += part) {
    isDone = std::fread(bytes + i, part, 1, file) == 1;
  }
  return file != nullptr && std::fclose(file) == 0 && isDone;
}

struct Content {
  const std::uint8_t* bytes;
  std::size_t size;
  std::size_t part;
};

std::string CheckFile(const char* path, const Content& content) {
  Samples<std::uint8_t> bytes(content.size);
  const bool isEqual = Read(path, bytes.data(), content.size, content.part) &&
                       std::equal(bytes.begin(), bytes.end(), content.bytes);
  return isEqual ? "" : "wrong: other bytes";
}

void EnterWriting(const Work& work, const Content& content) {
  Enter(work, "fwrite", [=] {
    const auto file = std::make_shared<bench::ScratchFile>(".raw");
    return Contender{[=] { return Write(file->Name(), content.bytes, content.size, content.part); },
                     [=] { return CheckFile(file->Name(), content); }};
  });
}

void EnterReading(const Work& work, const Content& content) {
  Enter(work, "fread", [=] {
    const auto file = std::make_shared<bench::ScratchFile>(".raw");
    const auto target = MakeSamples<std::uint8_t>(content.size);
    Write(file->Name(), content.bytes, content.size, content.part);
    return Contender{[=] { return Read(file->Name(), target->data(), content.size, content.part); },
                     [=] {
                       const bool isEqual =
                           std::equal(target->begin(), target->end(), content.bytes);
                       return isEqual ? "" : "wrong: other bytes";
                     }};
  });
}

}  // namespace

void EnterPlainFiles() {
  const Content bitmap{Image24().data(), Image24().size(), Image24().size()};
  EnterWriting(BitmapSaving(), bitmap);
  EnterReading(BitmapLoading(), bitmap);
  const Content study{reinterpret_cast<const std::uint8_t*>(Volume().data()),
                      kVoxels * sizeof(std::uint16_t), kSliceVoxels * sizeof(std::uint16_t)};
  EnterWriting(StudyWriting(), study);
  EnterReading(StudyReading(), study);
}

}  // namespace peers
