// The places of the virtual functions of the maps of the plane, which applications compiled against
// the library rely on.

#include <vorl/GUI/Trafo2D.h>

#include <gtest/gtest.h>

#include "../Support/VirtualSlot.h"

namespace {

// Seven mappings come first, then the destructor with two places.
constexpr std::size_t kFirstOwn = 9;

/// Opens the mappings of any map.
template <typename Trafo>
class Open : public Trafo {
 public:
  static std::size_t SlotOf_pA2B() { return VirtualSlot(&Open::_pA2B); }
  static std::size_t SlotOf_pB2A() { return VirtualSlot(&Open::_pB2A); }
  static std::size_t SlotOf_vA2B() { return VirtualSlot(&Open::_vA2B); }
  static std::size_t SlotOf_vB2A() { return VirtualSlot(&Open::_vB2A); }
};

/// Opens the mappings of single coordinates, and adds a function behind them.
class OpenScale : public Scale2D {
 public:
  static std::size_t SlotOf_X_pA2B() { return VirtualSlot(&OpenScale::_X_pA2B); }
  static std::size_t SlotOf_X_pB2A() { return VirtualSlot(&OpenScale::_X_pB2A); }
  static std::size_t SlotOf_Y_pA2B() { return VirtualSlot(&OpenScale::_Y_pA2B); }
  static std::size_t SlotOf_Y_pB2A() { return VirtualSlot(&OpenScale::_Y_pB2A); }
  virtual void Next() {}
};

/// Adds a function behind those of a map.
template <typename Trafo>
class Extended : public Trafo {
 public:
  virtual void Next() {}
};

template <typename Trafo>
class TrafoSlots : public ::testing::Test {};

using Maps = ::testing::Types<Translate2D, Scale2D, Rotate2D, TrafoST2D, TrafoSRT2D, MultiTrafo2D>;
TYPED_TEST_SUITE(TrafoSlots, Maps, );

TYPED_TEST(TrafoSlots, MappingsComeFirst) {
  using Vector = void (Trafo2DBase::*)(dVect2D&, dVect2D&);
  using Rect = void (Trafo2DBase::*)(Rect2D&, Rect2D&);
  EXPECT_EQ(VirtualSlot(static_cast<Vector>(&TypeParam::pA2B)), 0u);
  EXPECT_EQ(VirtualSlot(static_cast<Rect>(&TypeParam::rA2B)), 1u);
  EXPECT_EQ(VirtualSlot(static_cast<Rect>(&TypeParam::rB2A)), 2u);
  EXPECT_EQ(Open<TypeParam>::SlotOf_pA2B(), 3u);
  EXPECT_EQ(Open<TypeParam>::SlotOf_pB2A(), 4u);
  EXPECT_EQ(Open<TypeParam>::SlotOf_vA2B(), 5u);
  EXPECT_EQ(Open<TypeParam>::SlotOf_vB2A(), 6u);
}

TEST(TrafoSlotsEnd, ScalingAddsTheMappingsOfSingleCoordinates) {
  EXPECT_EQ(OpenScale::SlotOf_X_pA2B(), kFirstOwn);
  EXPECT_EQ(OpenScale::SlotOf_X_pB2A(), kFirstOwn + 1);
  EXPECT_EQ(OpenScale::SlotOf_Y_pA2B(), kFirstOwn + 2);
  EXPECT_EQ(OpenScale::SlotOf_Y_pB2A(), kFirstOwn + 3);
  EXPECT_EQ(VirtualSlot(&OpenScale::Next), kFirstOwn + 4);
}

TEST(TrafoSlotsEnd, TheOthersAddNone) {
  EXPECT_EQ(VirtualSlot(&Extended<Translate2D>::Next), kFirstOwn);
  EXPECT_EQ(VirtualSlot(&Extended<Rotate2D>::Next), kFirstOwn);
  EXPECT_EQ(VirtualSlot(&Extended<TrafoST2D>::Next), kFirstOwn);
  EXPECT_EQ(VirtualSlot(&Extended<TrafoSRT2D>::Next), kFirstOwn);
  EXPECT_EQ(VirtualSlot(&Extended<MultiTrafo2D>::Next), kFirstOwn);
}

}  // namespace
