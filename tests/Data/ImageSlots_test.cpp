// The places of the virtual functions of images, tables, slices and volumes, which applications
// compiled against the library rely on.

#include <vorl/Data/dVolume.h>
#include <vorl/Data/dWindowingLUT.h>

#include <gtest/gtest.h>

#include "../Support/VirtualSlot.h"

namespace {

// The class record comes first, then the destructor with two places, `Release`, and what data
// classes add.
constexpr std::size_t kReset = 4;
constexpr std::size_t kIsValid = 5;
constexpr std::size_t kFirstOwn = 6;

/// Opens the hooks.
class OpenImage : public dImage {
 public:
  static std::size_t SlotOfOnInit() { return VirtualSlot(&OpenImage::OnInit); }
  static std::size_t SlotOfOnReset() { return VirtualSlot(&OpenImage::OnReset); }
};

class OpenLUT : public dLUT {
 public:
  static std::size_t SlotOfCalculateLUT() { return VirtualSlot(&OpenLUT::CalculateLUT); }
};

TEST(ImageSlots, ImagesAddValidityFormattingAndHooks) {
  using IsValid = bool (dImage::*)() const;
  using Take = bool (dImage::*)(DataTransferMode, dImage&);
  using Format = bool (dImage::*)(unsigned long, unsigned long, unsigned short, const char*,
                                  unsigned short, unsigned short);
  EXPECT_EQ(VirtualSlot(&dImage::GetClassInfo), 0u);
  EXPECT_EQ(VirtualSlot(&dImage::Reset), kReset);
  EXPECT_EQ(VirtualSlot(static_cast<IsValid>(&dImage::IsValid)), kFirstOwn);
  EXPECT_EQ(VirtualSlot(static_cast<Take>(&dImage::Init)), kFirstOwn + 1);
  EXPECT_EQ(VirtualSlot(static_cast<Format>(&dImage::Init)), kFirstOwn + 2);
  EXPECT_EQ(OpenImage::SlotOfOnInit(), kFirstOwn + 3);
  EXPECT_EQ(OpenImage::SlotOfOnReset(), kFirstOwn + 4);
}

TEST(ImageSlots, ThePersistenceOfImagesStandsInATableOfItsOwn) {
  EXPECT_EQ(VirtualSlot(&IBinaryDataIO::WriteFile), 0u);
  EXPECT_EQ(VirtualSlot(&IBinaryDataIO::ReadFile), 1u);
  EXPECT_EQ(VirtualSlot(&IBinaryDataIO::Write), 2u);
  EXPECT_EQ(VirtualSlot(&IBinaryDataIO::Read), 3u);
  dImage image;
  IBinaryDataIO& persistent = image;
  EXPECT_NE(static_cast<void*>(&persistent), static_cast<void*>(&image));
}

TEST(ImageSlots, TablesAddInitAndTheComputation) {
  EXPECT_EQ(VirtualSlot(&dLUT::Reset), kReset);
  EXPECT_EQ(VirtualSlot(&dLUT::IsValid), kIsValid);
  EXPECT_EQ(VirtualSlot(&dLUT::Init), kFirstOwn);
  EXPECT_EQ(OpenLUT::SlotOfCalculateLUT(), kFirstOwn + 1);
}

TEST(ImageSlots, SlicesAndVolumesAddNone) {
  using SliceIsValid = bool (dSlice::*)();
  using VolumeIsValid = bool (dVolume::*)();
  EXPECT_EQ(VirtualSlot(&dSlice::Reset), kReset);
  EXPECT_EQ(VirtualSlot(static_cast<SliceIsValid>(&dSlice::IsValid)), kIsValid);
  EXPECT_EQ(VirtualSlot(&dVolume::Reset), kReset);
  EXPECT_EQ(VirtualSlot(static_cast<VolumeIsValid>(&dVolume::IsValid)), kIsValid);
}

}  // namespace
