#include <study/FileItems.h>
#include <study/OutputFile.h>
#include <study/StudyFile.h>
#include <vorl/IO/BinaryDataIO.h>

#include <cstring>
#include <fstream>

namespace study {
namespace {

namespace fs = std::filesystem;

constexpr char kTypeName[] = "vorlStudy";
constexpr char kEndMark[] = "end";
constexpr std::uint32_t kVersion = 1;

// ---------------------------------------------------------------------------------- writing

void WriteHeader(BinaryDataOut& out, Study& study) {
  out.WriteU32(static_cast<unsigned long>(kVersion));
  out.WriteF64(study.scale);
  out.WriteF64(study.offset);
  out.WriteString(study.unit);
  out.WriteString(study.modality);
  out.WriteString(study.description);
  out.WriteF64(study.windowCentre);
  out.WriteF64(study.windowWidth);
  WriteCoordinates(out, study.volume.GetCoordinates());
  out.WriteU32(static_cast<unsigned long>(study.volume.GetSliceCount()));
}

void WriteSlice(BinaryDataOut& out, dSlice& slice, unsigned long index) {
  out.OpenBlock(index);
  WriteCoordinates(out, slice.GetCoordinates());
  out.Write(&slice.GetImage());
  out.CloseBlock();
}

void WriteAll(Study& study, const char* fileName, const Progress& progress) {
  BinaryDataOut out;
  out.Open(fileName, kTypeName);
  WriteHeader(out, study);
  const double count = study.volume.GetSliceCount();
  unsigned long index = 0;
  for (dSlice& slice : study.volume.GetSliceList()) {
    Report(progress, static_cast<double>(index) / count, "writing");
    WriteSlice(out, slice, index++);
  }
  out.WriteString(std::string(kEndMark));
  if (!out.Finish()) {
    throw out.GetStatus();
  }
}

// ---------------------------------------------------------------------------------- reading

int ReadHeader(BinaryDataIn& in, Study& study) {
  std::uint32_t version = 0;
  in.ReadU32(version);
  if (version != kVersion) {
    throw Error("its version " + std::to_string(version) + " is not known");
  }
  study.scale = ReadFinite(in);
  study.offset = ReadFinite(in);
  Require(study.scale > 0, "its scale is not greater than 0");
  study.unit = ReadText(in);
  study.modality = ReadText(in);
  study.description = ReadText(in);
  study.windowCentre = ReadFinite(in);
  study.windowWidth = ReadFinite(in);
  Require(study.windowWidth >= 0, "its window width is negative");
  study.volume.GetCoordinates() = ReadCoordinates(in);
  std::uint32_t count = 0;
  in.ReadU32(count);
  Require(count >= 1 && count <= kLargestVolumeSide, "it has an impossible number of slices");
  return static_cast<int>(count);
}

void CheckImage(const dImage& image) {
  Require(
      image.IsValid() && image.GetDataType() == ImageDataType_U16 && image.GetNumChannels() == 1,
      "a slice in it is not of unsigned 16-bit grey values");
  Require(image.GetBytesPerRow() == 2 * image.GetWidth(), "a slice in it has padded rows");
  Require(image.GetWidth() <= kLargestVolumeSide && image.GetHeight() <= kLargestVolumeSide,
          "a slice in it is too large");
}

void ReadSlice(BinaryDataIn& in, dSlice& slice, unsigned long index) {
  in.OpenBlock(index);
  slice.SetCoordinates(ReadCoordinates(in));
  in.Read(&slice.GetImage());
  in.CloseBlock();
  CheckImage(slice.GetImage());
}

void ReadEnd(BinaryDataIn& in) {
  Require(ReadText(in) == kEndMark, "its end mark is missing");
  Require(in.GetRemainingBytes() == 0, "something follows its end mark");
}

void ReadAll(Study& study, const char* fileName, const Progress& progress) {
  BinaryDataIn in;
  in.Open(fileName, kTypeName);
  const int count = ReadHeader(in, study);
  for (int index = 0; index < count; ++index) {
    Report(progress, static_cast<double>(index) / count, "reading");
    dSlice slice;
    ReadSlice(in, slice, static_cast<unsigned long>(index));
    Require(study.volume.AddSlice(slice) == index, "its slices differ in size");
  }
  ReadEnd(in);
}

// -------------------------------------------------------------------------------- verifying

bool SameBits(const Study& a, const Study& b) {
  return a.scale == b.scale && a.offset == b.offset && a.unit == b.unit &&
         a.modality == b.modality && a.description == b.description &&
         a.windowCentre == b.windowCentre && a.windowWidth == b.windowWidth &&
         study::SameBits(a.volume.GetCoordinates(), b.volume.GetCoordinates());
}

bool SameBits(const dSlice& a, const dSlice& b) {
  const auto first = SamplesOf(a);
  const auto second = SamplesOf(b);
  return study::SameBits(a.GetCoordinates(), b.GetCoordinates()) && a.GetWidth() == b.GetWidth() &&
         first.size() == second.size() &&
         std::memcmp(first.data(), second.data(), first.size_bytes()) == 0;
}

/// Reads the file back one slice at a time and compares it with what was meant to be written.
void Verify(const Study& study, const char* fileName, const Progress& progress) {
  BinaryDataIn in;
  in.Open(fileName, kTypeName);
  Study header;
  const int count = ReadHeader(in, header);
  bool same = SameBits(study, header) && count == study.volume.GetSliceCount();
  unsigned long index = 0;
  for (const dSlice& slice : study.volume.GetSliceList()) {
    Report(progress, static_cast<double>(index) / count, "checking");
    dSlice copy;
    ReadSlice(in, copy, index++);
    same = same && SameBits(slice, copy);
  }
  ReadEnd(in);
  Require(same, "what was written reads back otherwise");
}

/// What must hold for a reader to accept the file; caught here, before anything is written.
void CheckWritable(const Study& study) {
  Require(study.volume.IsValid(), "the study is empty");
  Require(study.unit.size() < kLongestText && study.modality.size() < kLongestText &&
              study.description.size() < kLongestText,
          "a text of the study is too long");
}

}  // namespace

bool IsStudyFile(const fs::path& path) {
  char head[4 + sizeof kTypeName] = {};
  std::ifstream file(path, std::ios::binary);
  file.read(head, sizeof head);
  return file.gcount() == sizeof head && std::memcmp(head, "BDF\0vorlStudy", sizeof head) == 0;
}

void WriteStudyFile(Study& study, const fs::path& path, const Progress& progress) {
  OutputFile output(path);
  const std::string name = output.TemporaryPath().string();
  const auto fail = [&path](const std::string& reason) -> Error {
    return Error("can't write " + Quoted(path.string()) + ": " + reason);
  };
  try {
    CheckWritable(study);
    WriteAll(study, name.c_str(), PartOf(progress, 0, 0.7));
    Verify(study, name.c_str(), PartOf(progress, 0.7, 1));
    Report(progress, 1, "written");
  } catch (const dStatus& status) {
    throw fail(WhatWentWrong(status, "study"));
  } catch (const Cancelled&) {
    throw;
  } catch (const Error& error) {
    throw fail(error.what());
  }
  output.Commit();
}

std::unique_ptr<Study> ReadStudyFile(const fs::path& path, const Progress& progress) {
  const auto fail = [&path](const std::string& reason) -> Error {
    return Error("can't read " + Quoted(path.string()) + ": " + reason);
  };
  auto study = std::make_unique<Study>();
  try {
    ReadAll(*study, path.string().c_str(), progress);
  } catch (const dStatus& status) {
    throw fail(WhatWentWrong(status, "study"));
  } catch (const Cancelled&) {
    throw;
  } catch (const Error& error) {
    throw fail(error.what());
  }
  Report(progress, 1, "read");
  return study;
}

}  // namespace study
