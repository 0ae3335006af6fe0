#include <study/FileItems.h>
#include <study/OutputFile.h>
#include <study/VoxelListFile.h>

#include <algorithm>
#include <utility>

namespace study {
namespace {

namespace fs = std::filesystem;

constexpr char kTypeName[] = "vorlVoxelList";
constexpr char kEndMark[] = "end";
constexpr std::uint32_t kVersion = 1;
constexpr std::uint32_t kFieldMask = 2047;

void WriteAll(const VoxelList& list, const char* fileName) {
  BinaryDataOut out;
  out.Open(fileName, kTypeName);
  const auto number = [&out](std::uint32_t value) {
    out.WriteU32(static_cast<unsigned long>(value));
  };
  number(kVersion);
  std::for_each(list.size.begin(), list.size.end(), number);
  WriteCoordinates(out, list.coordinates);
  out.WriteF64(list.scale);
  out.WriteF64(list.offset);
  out.WriteString(list.unit);
  out.WriteString(list.criterion);
  number(list.limit);
  number(list.lowestClass);
  out.WriteU32Array(list.voxels.data(), static_cast<int>(list.voxels.size()));
  out.WriteString(std::string(kEndMark));
  if (!out.Finish()) {
    throw out.GetStatus();
  }
}

bool IsInside(const VoxelList& list, std::uint32_t voxel) {
  return (voxel & kFieldMask) < list.size[0] && (voxel >> 11 & kFieldMask) < list.size[1] &&
         voxel >> 22 < list.size[2];
}

void ReadHeader(BinaryDataIn& in, VoxelList& list) {
  std::uint32_t version = 0;
  in.ReadU32(version);
  if (version != kVersion) {
    throw Error("its version " + std::to_string(version) + " is not known");
  }
  for (std::size_t i = 0; i < list.size.size(); ++i) {
    in.ReadU32(list.size[i]);
    Require(list.size[i] >= 1 && std::cmp_less_equal(list.size[i], kLargestListedVolume[i]),
            "the size of its volume is impossible");
  }
  list.coordinates = ReadCoordinates(in);
  list.scale = ReadFinite(in);
  list.offset = ReadFinite(in);
  Require(list.scale > 0, "its scale is not greater than 0");
  list.unit = ReadText(in);
  list.criterion = ReadText(in);
  Require(list.criterion == "value" || list.criterion == "edge",
          "its voxels were selected in an unknown way");
  in.ReadU32(list.limit);
  in.ReadU32(list.lowestClass);
}

void ReadVoxels(BinaryDataIn& in, VoxelList& list) {
  const unsigned long count = in.ReadArrayLength();
  Require(count <= list.limit, "it holds more voxels than were allowed");
  in.RequireBytes(std::uint64_t{count} * sizeof(std::uint32_t));
  list.voxels.resize(count);
  in.ReadU32Array(list.voxels.data(), static_cast<int>(count));
  Require(std::all_of(list.voxels.begin(), list.voxels.end(),
                      [&list](std::uint32_t voxel) { return IsInside(list, voxel); }),
          "a voxel in it lies outside the volume");
}

VoxelList ReadAll(const char* fileName) {
  BinaryDataIn in;
  in.Open(fileName, kTypeName);
  VoxelList list;
  ReadHeader(in, list);
  ReadVoxels(in, list);
  Require(ReadText(in) == kEndMark, "its end mark is missing");
  Require(in.GetRemainingBytes() == 0, "something follows its end mark");
  return list;
}

bool SameContent(const VoxelList& a, const VoxelList& b) {
  return a.size == b.size && SameBits(a.coordinates, b.coordinates) && a.scale == b.scale &&
         a.offset == b.offset && a.unit == b.unit && a.criterion == b.criterion &&
         a.limit == b.limit && a.lowestClass == b.lowestClass && a.voxels == b.voxels;
}

/// Calls `work`; any failure becomes an error that begins with `prefix`.
template <class Work>
void Guard(const std::string& prefix, Work&& work) {
  try {
    work();
  } catch (const dStatus& status) {
    throw Error(prefix + WhatWentWrong(status, "list of voxels"));
  } catch (const Cancelled&) {
    throw;
  } catch (const Error& error) {
    throw Error(prefix + error.what());
  }
}

}  // namespace

void WriteVoxelList(const VoxelList& list, const fs::path& path, const Progress& progress) {
  OutputFile output(path);
  const std::string name = output.TemporaryPath().string();
  Guard("can't write " + Quoted(path.string()) + ": ", [&] {
    Report(progress, 0, "writing");
    WriteAll(list, name.c_str());
    Report(progress, 0.5, "checking");
    Require(SameContent(list, ReadAll(name.c_str())), "what was written reads back otherwise");
    Report(progress, 1, "written");
  });
  output.Commit();
}

VoxelList ReadVoxelList(const fs::path& path) {
  VoxelList list;
  Guard("can't read " + Quoted(path.string()) + ": ",
        [&] { list = ReadAll(path.string().c_str()); });
  return list;
}

}  // namespace study
