#include "TestFolder.h"
#include "TestStudies.h"

#include <gtest/gtest.h>
#include <study/VoxelListFile.h>

#include <functional>

using namespace study;
using namespace study_test;

namespace {

/// Three voxels of a volume of 5 x 4 x 3.
VoxelList MakeList() {
  VoxelList list;
  list.size = {5, 4, 3};
  list.coordinates =
      dCoordSys3D(dVect3D(1, 2, 3), dVect3D(0.5F, 0, 0), dVect3D(0, 0.5F, 0), dVect3D(0, 0, 2));
  list.scale = 0.5;
  list.offset = -1000;
  list.unit = "HU";
  list.criterion = "edge";
  list.limit = 7;
  list.lowestClass = 321;
  list.voxels = {0, (1U << 22) | (3U << 11) | 4U, 2U << 22};
  return list;
}

class VoxelListFile : public testing::Test {
 protected:
  /// The failure of writing a list after `change`.
  std::string WriteError(const std::function<void(VoxelList&)>& change) {
    VoxelList list = MakeList();
    change(list);
    return ErrorOf([&] { WriteVoxelList(list, m_path); });
  }

  std::string CantWrite(const std::string& why) const {
    return "can't write '" + m_path.string() + "': " + why;
  }

  TestFolder m_folder;
  fs::path m_path = m_folder / "list.bdf";
};

TEST_F(VoxelListFile, ReadsBackWhatWasWritten) {
  const VoxelList list = MakeList();
  WriteVoxelList(list, m_path);
  const VoxelList copy = ReadVoxelList(m_path);
  EXPECT_EQ(copy.size, list.size);
  EXPECT_EQ(copy.coordinates.origin.y, 2);
  EXPECT_EQ(copy.coordinates.axisZ.z, 2);
  EXPECT_EQ(copy.scale, 0.5);
  EXPECT_EQ(copy.offset, -1000);
  EXPECT_EQ(copy.unit, "HU");
  EXPECT_EQ(copy.criterion, "edge");
  EXPECT_EQ(copy.limit, 7u);
  EXPECT_EQ(copy.lowestClass, 321u);
  EXPECT_EQ(copy.voxels, list.voxels);
  EXPECT_EQ(m_folder.Names(), std::vector<std::string>{"list.bdf"});
}

TEST_F(VoxelListFile, BeginsWithItsTypeVersionAndSize) {
  WriteVoxelList(MakeList(), m_path);
  // Each number stands behind the tag of an unsigned 32-bit one, 5.
  const std::string head("BDF\0vorlVoxelList\0\5\1\0\0\0\5\5\0\0\0\5\4\0\0\0\5\3\0\0\0", 38);
  EXPECT_EQ(ReadBytes(m_path).substr(0, head.size()), head);
}

TEST_F(VoxelListFile, MayBeEmpty) {
  VoxelList list = MakeList();
  list.voxels.clear();
  WriteVoxelList(list, m_path);
  EXPECT_TRUE(ReadVoxelList(m_path).voxels.empty());
}

TEST_F(VoxelListFile, WhatAReaderWouldRefuseIsNotWritten) {
  EXPECT_EQ(WriteError([](VoxelList& list) { list.voxels.push_back(5); }),
            CantWrite("a voxel in it lies outside the volume"));
  EXPECT_EQ(WriteError([](VoxelList& list) { list.voxels.push_back(4U << 11); }),
            CantWrite("a voxel in it lies outside the volume"));
  EXPECT_EQ(WriteError([](VoxelList& list) { list.voxels.push_back(3U << 22); }),
            CantWrite("a voxel in it lies outside the volume"));
  EXPECT_EQ(WriteError([](VoxelList& list) { list.limit = 2; }),
            CantWrite("it holds more voxels than were allowed"));
  EXPECT_EQ(WriteError([](VoxelList& list) { list.criterion = "colour"; }),
            CantWrite("its voxels were selected in an unknown way"));
  EXPECT_EQ(WriteError([](VoxelList& list) { list.size[2] = 513; }),
            CantWrite("the size of its volume is impossible"));
  EXPECT_EQ(WriteError([](VoxelList& list) { list.size[0] = 0; }),
            CantWrite("the size of its volume is impossible"));
  EXPECT_EQ(WriteError([](VoxelList& list) { list.scale = 0; }),
            CantWrite("its scale is not greater than 0"));
  EXPECT_TRUE(m_folder.Names().empty());
}

TEST_F(VoxelListFile, CutShortItIsRefusedAtEveryLength) {
  WriteVoxelList(MakeList(), m_path);
  const std::string bytes = ReadBytes(m_path);
  const fs::path cut = m_folder / "cut.bdf";
  for (std::size_t length = 0; length < bytes.size(); ++length) {
    WriteBytes(cut, bytes.substr(0, length));
    EXPECT_EQ(ErrorOf([&] { ReadVoxelList(cut); }).substr(0, 12), "can't read '") << length;
  }
  WriteBytes(cut, bytes + "x");
  EXPECT_EQ(ErrorOf([&] { ReadVoxelList(cut); }),
            "can't read '" + cut.string() + "': something follows its end mark");
}

TEST_F(VoxelListFile, OtherFilesAreNamed) {
  WriteBytes(m_path, std::string("BDF\0vorlStudy", 14));
  EXPECT_EQ(ErrorOf([&] { ReadVoxelList(m_path); }),
            "can't read '" + m_path.string() +
                "': it is a binary data file, but holds no list of voxels");
}

}  // namespace
