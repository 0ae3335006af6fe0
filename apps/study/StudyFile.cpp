#include <study/OutputFile.h>
#include <study/StudyFile.h>
#include <vorl/IO/BinaryDataIO.h>

#include <array>
#include <cmath>
#include <cstring>
#include <fstream>
#include <limits>

namespace study {
namespace {

namespace fs = std::filesystem;

constexpr char kTypeName[] = "vorlStudy";
constexpr char kEndMark[] = "end";
constexpr std::uint32_t kVersion = 1;
constexpr std::size_t kLongestText = 4096;

using CoordinateArray = std::array<float, 12>;

CoordinateArray ToArray(const dCoordSys3D& c) {
  return {c.origin.x, c.origin.y, c.origin.z, c.axisX.x, c.axisX.y, c.axisX.z,
          c.axisY.x,  c.axisY.y,  c.axisY.z,  c.axisZ.x, c.axisZ.y, c.axisZ.z};
}

dCoordSys3D FromArray(const CoordinateArray& a) {
  return {dVect3D(a[0], a[1], a[2]), dVect3D(a[3], a[4], a[5]), dVect3D(a[6], a[7], a[8]),
          dVect3D(a[9], a[10], a[11])};
}

std::string WhatWentWrong(const dStatus& status) {
  switch (static_cast<long>(status)) {
    case -3:
      return "the file can't be opened";
    case -100:
      return "the disk is full, or the writing failed";
    case -200:
    case -201:
      return "the file ends too early or is damaged";
    case -202:
      return "it is a binary data file, but holds no study";
    case -203:
      return "it is no binary data file";
    default:
      return std::string("the file is damaged (") + static_cast<const char*>(status) + ")";
  }
}

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
  const CoordinateArray coordinates = ToArray(study.volume.GetCoordinates());
  out.WriteF32Array(coordinates.data(), static_cast<int>(coordinates.size()));
  out.WriteU32(static_cast<unsigned long>(study.volume.GetSliceCount()));
}

void WriteSlice(BinaryDataOut& out, dSlice& slice, unsigned long index) {
  out.OpenBlock(index);
  const CoordinateArray coordinates = ToArray(slice.GetCoordinates());
  out.WriteF32Array(coordinates.data(), static_cast<int>(coordinates.size()));
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

void Require(bool holds, const char* what) {
  if (!holds) {
    throw Error(what);
  }
}

double ReadFinite(BinaryDataIn& in) {
  double value = 0;
  in.ReadF64(value);
  Require(std::isfinite(value), "a number in it is not finite");
  return value;
}

/// A text without the zero byte that the format keeps behind it.
std::string ReadText(BinaryDataIn& in) {
  const unsigned long size = in.ReadArrayLength();
  Require(size >= 1 && size <= kLongestText, "a text in it has an impossible length");
  std::string text(size, '\0');
  in.ReadU8Array(reinterpret_cast<unsigned char*>(text.data()), static_cast<int>(size));
  Require(text.find('\0') == size - 1, "a text in it is not ended by a zero byte");
  text.pop_back();
  return text;
}

dCoordSys3D ReadCoordinates(BinaryDataIn& in) {
  CoordinateArray numbers{};
  Require(in.ReadArrayLength() == numbers.size(), "its coordinates are not twelve numbers");
  in.ReadF32Array(numbers.data(), static_cast<int>(numbers.size()));
  const dCoordSys3D coordinates = FromArray(numbers);
  const std::string problem = PlacementProblem(coordinates);
  if (!problem.empty()) {
    throw Error(problem);
  }
  return coordinates;
}

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

bool SameBits(const dCoordSys3D& a, const dCoordSys3D& b) {
  const CoordinateArray first = ToArray(a);
  const CoordinateArray second = ToArray(b);
  return std::memcmp(first.data(), second.data(), sizeof first) == 0;
}

bool SameBits(const Study& a, const Study& b) {
  return a.scale == b.scale && a.offset == b.offset && a.unit == b.unit &&
         a.modality == b.modality && a.description == b.description &&
         a.windowCentre == b.windowCentre && a.windowWidth == b.windowWidth &&
         SameBits(a.volume.GetCoordinates(), b.volume.GetCoordinates());
}

bool SameBits(const dSlice& a, const dSlice& b) {
  const auto first = SamplesOf(a);
  const auto second = SamplesOf(b);
  return SameBits(a.GetCoordinates(), b.GetCoordinates()) && a.GetWidth() == b.GetWidth() &&
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
    throw fail(WhatWentWrong(status));
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
    throw fail(WhatWentWrong(status));
  } catch (const Cancelled&) {
    throw;
  } catch (const Error& error) {
    throw fail(error.what());
  }
  Report(progress, 1, "read");
  return study;
}

}  // namespace study
