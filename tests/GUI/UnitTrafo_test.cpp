#include <vorl/GUI/Trafo1D.h>

#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <type_traits>

namespace {

static_assert(std::has_virtual_destructor_v<UnitTrafo>);

/// Four units that differ in everything.
UnitTrafo Sample() {
  UnitTrafo units;
  for (int i = 0; i < 4; ++i) {
    const std::string number = std::to_string(i);
    units.SetUnitTrafo(i, 2.0 + i, 10.0 * i);
    units.SetUnitText(i, ("s" + number).c_str(), ("long" + number).c_str());
    units.SetIntegerUnit(i, i % 2 == 1);
  }
  return units;
}

void ExpectSampleUnit(UnitTrafo& units, int i) {
  units.SelectUnit(i);
  EXPECT_EQ(units.GetUnitID(), i);
  EXPECT_EQ(units.GetUnitTrafo().GetScale(), 2.0 + i);
  EXPECT_EQ(units.GetUnitTrafo().GetOffset(), 10.0 * i);
  EXPECT_EQ(units.GetShortUnitText(), "s" + std::to_string(i));
  EXPECT_EQ(units.GetLongUnitText(), "long" + std::to_string(i));
  EXPECT_EQ(units.IsIntegerUnit(), i % 2 == 1);
}

void ExpectEmpty(UnitTrafo& units) {
  EXPECT_EQ(units.GetUnitID(), 0);
  for (int i = 0; i < 4; ++i) {
    units.SelectUnit(i);
    EXPECT_EQ(units.GetUnitTrafo().GetScale(), 1.0);
    EXPECT_EQ(units.GetUnitTrafo().GetOffset(), 0.0);
    EXPECT_STREQ(units.GetShortUnitText(), "");
    EXPECT_STREQ(units.GetLongUnitText(), "");
    EXPECT_FALSE(units.IsIntegerUnit());
  }
}

TEST(UnitTrafo, HasFourPlainUnitsAfterConstruction) {
  UnitTrafo units;
  ExpectEmpty(units);
}

TEST(UnitTrafo, ResetGivesTheSame) {
  UnitTrafo units = Sample();
  units.SelectUnit(3);
  units.Reset();
  ExpectEmpty(units);
}

TEST(UnitTrafo, EachUnitKeepsItsOwn) {
  UnitTrafo units = Sample();
  EXPECT_EQ(units.GetUnitID(), 0);  // filling a unit does not select it
  for (int i = 0; i < 4; ++i) {
    ExpectSampleUnit(units, i);
  }
}

TEST(UnitTrafo, IgnoresIndicesOutside) {
  for (const int unit :
       {-1, 4, 65536, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()}) {
    UnitTrafo units = Sample();
    units.SelectUnit(2);
    units.SelectUnit(unit);
    EXPECT_EQ(units.GetUnitID(), 2) << unit;
    units.SetUnitTrafo(unit, 99.0, 99.0);
    units.SetUnitText(unit, "x", "y");
    units.SetIntegerUnit(unit, true);
    units.SetIntegerUnit(unit, false);
    for (int i = 0; i < 4; ++i) {
      ExpectSampleUnit(units, i);
    }
  }
}

TEST(UnitTrafo, MapsWithTheSelectedUnit) {
  UnitTrafo units = Sample();
  units.SelectUnit(3);  // scale 5, offset 30
  EXPECT_EQ(units.A2B(2.0), 40.0);
  EXPECT_EQ(units.B2A(40.0), 2.0);
  EXPECT_EQ(units.A2B(0), 30.0);
  EXPECT_EQ(units.B2A(0), -6.0);
  double x = 2.0;
  units.A2B(&x);
  EXPECT_EQ(x, 40.0);
  units.B2A(&x);
  EXPECT_EQ(x, 2.0);
  units.SelectUnit(0);  // scale 2, offset 0
  EXPECT_EQ(units.A2B(2.0), 4.0);
}

TEST(UnitTrafo, GivesAccessToTheSelectedMap) {
  UnitTrafo units;
  units.SelectUnit(1);
  units.GetUnitTrafo().Set(8.0, 1.0);
  EXPECT_EQ(units.A2B(2.0), 17.0);
  const UnitTrafo& constant = units;
  EXPECT_EQ(&constant.GetUnitTrafo(), &units.GetUnitTrafo());
}

TEST(UnitTrafo, ANullTextIsEmpty) {
  UnitTrafo units = Sample();
  units.SetUnitText(0, nullptr, "kept");
  EXPECT_STREQ(units.GetShortUnitText(), "");
  EXPECT_STREQ(units.GetLongUnitText(), "kept");
  units.SetUnitText(0, "kept", nullptr);
  EXPECT_STREQ(units.GetShortUnitText(), "kept");
  EXPECT_STREQ(units.GetLongUnitText(), "");
}

TEST(UnitTrafo, TakesItsOwnTexts) {
  UnitTrafo units;
  const std::string longer(100, 'a'), other(200, 'b');
  units.SetUnitText(0, longer.c_str(), other.c_str());
  units.SetUnitText(0, units.GetLongUnitText(), units.GetShortUnitText());
  EXPECT_EQ(units.GetShortUnitText(), other);
  EXPECT_EQ(units.GetLongUnitText(), longer);
}

TEST(UnitTrafo, CopiesEverything) {
  UnitTrafo source = Sample();
  source.SelectUnit(2);
  UnitTrafo copy(source);
  UnitTrafo assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  for (UnitTrafo* units : {&copy, &assigned}) {
    EXPECT_EQ(units->GetUnitID(), 2);
    for (int i = 0; i < 4; ++i) {
      ExpectSampleUnit(*units, i);
    }
  }
  source.SetUnitText(0, "changed", "changed");  // the copies' texts are their own
  ExpectSampleUnit(copy, 0);
}

TEST(UnitTrafo, AssignmentToItselfKeepsEverything) {
  UnitTrafo units = Sample();
  const UnitTrafo& same = units;
  units = same;
  ExpectSampleUnit(units, 1);
}

}  // namespace
