#include <gtest/gtest.h>

#include <memory>

#include <vorl/Data/dPoint.h>
#include <vorl/Data/dRect.h>
#include <vorl/Data/dTrafo.h>

namespace {

/// A geometry class with its name, its parent's record and its answer to `IsValid`.
template <typename T>
struct Expected;

#define EXPECTED_CLASS(Class, Parent, Valid)     \
  template <>                                    \
  struct Expected<Class> {                       \
    using ParentClass = Parent;                  \
    static constexpr const char* kName = #Class; \
    static constexpr bool kValid = Valid;        \
  }

EXPECTED_CLASS(dVect2D, DataBase, false);
EXPECTED_CLASS(dVect3D, DataBase, false);
EXPECTED_CLASS(dPoint, DataBase, false);
EXPECTED_CLASS(dRect, DataBase, false);
EXPECTED_CLASS(dCoordSys1D, DataBase, true);
EXPECTED_CLASS(dCoordSys2D, DataBase, true);
EXPECTED_CLASS(dCoordSys3D, DataBase, true);
EXPECTED_CLASS(dTrafo1D, DataBase, true);
EXPECTED_CLASS(dTrafo2D, DataBase, true);
EXPECTED_CLASS(dTrafo3D, DataBase, true);
EXPECTED_CLASS(dUnitTrafo, dTrafo1D, true);

template <typename T>
class GeometryClasses : public ::testing::Test {};

using Classes = ::testing::Types<dVect2D, dVect3D, dPoint, dRect, dCoordSys1D, dCoordSys2D,
                                 dCoordSys3D, dTrafo1D, dTrafo2D, dTrafo3D, dUnitTrafo>;
TYPED_TEST_SUITE(GeometryClasses, Classes, );

TYPED_TEST(GeometryClasses, HaveARecordWithNameAndParent) {
  const ClassInfo& record = TypeParam::CI();
  EXPECT_STREQ(record.name, Expected<TypeParam>::kName);
  ASSERT_NE(record.parents, nullptr);
  EXPECT_EQ(record.parents[0], &Expected<TypeParam>::ParentClass::CI());
  EXPECT_EQ(record.parents[1], nullptr);
  EXPECT_TRUE(record.CoversClass(DataBase::CI().RTTID));
}

TYPED_TEST(GeometryClasses, AreCreatedByTheirFactory) {
  const std::unique_ptr<TypeParam> made(TypeParam::Create());
  ASSERT_NE(made, nullptr);
  EXPECT_EQ(made->GetClassInfo(), &TypeParam::CI());
  const std::unique_ptr<BaseClass> byRecord(TypeParam::CI().Create());
  EXPECT_NE(dynamic_cast<TypeParam*>(byRecord.get()), nullptr);
}

TYPED_TEST(GeometryClasses, AnswerWhetherTheyAreValid) {
  TypeParam object;
  EXPECT_EQ(object.IsValid(), Expected<TypeParam>::kValid);
  object.Reset();
  EXPECT_EQ(static_cast<DataBase&>(object).IsValid(), Expected<TypeParam>::kValid);
}

}  // namespace
