#include <vorl/Common/BaseClass.h>

#include <gtest/gtest.h>
#include <tests/Support/VirtualSlot.h>
#include <vorl/Common/HRTimer.h>
#include <vorl/Common/OpBase.h>
#include <vorl/Common/dStatus.h>

#include <memory>
#include <set>
#include <string>
#include <type_traits>

namespace {

// A class as an application would write one.
class Marker : public DataBase {
 public:
  static ClassInfo& CI() {
    static ClassInfo& record = BuildClassInfo(
        "Marker", &DataBase::CI(), +[]() -> BaseClass* { return new Marker(); });
    return record;
  }
  ClassInfo* GetClassInfo() override { return &CI(); }
  ~Marker() override {
    if (m_destroyed != nullptr) {
      *m_destroyed = true;
    }
  }
  void Reset() override {}

  bool* m_destroyed = nullptr;
};

class Unregistered : public BaseClass {
 public:
  ClassInfo* GetClassInfo() override { return nullptr; }
};

class IdleOperator : public OpBase {
 protected:
  bool Prepare() override { return true; }
  bool Process() override { return true; }
};

BaseClass* CreateMarker() {
  return Marker::CI().Create();
}

constexpr long kUnknownId = 1000000;

TEST(ClassInfo, DefaultRecordIsEmpty) {
  const ClassInfo info;
  EXPECT_STREQ(info.name, "");
  EXPECT_EQ(info.instanceCount, 0);
  EXPECT_EQ(info.parents, nullptr);
  EXPECT_EQ(info.create, nullptr);
}

TEST(ClassInfo, EachDefaultRecordTakesTheNextIdentifier) {
  const ClassInfo first;
  const ClassInfo second;
  const ClassInfo third;
  EXPECT_EQ(second.RTTID, first.RTTID + 1);
  EXPECT_EQ(third.RTTID, second.RTTID + 1);
}

// The root's record is the first that is built, because every other one names its parent.
TEST(ClassInfo, IdentifiersStartAt100) {
  EXPECT_EQ(BaseClass::CI().RTTID, 100);
}

TEST(ClassInfo, CopyTakesAllFieldsAndNoIdentifier) {
  ClassInfo* parents[] = {&BaseClass::CI(), nullptr};
  ClassInfo source;
  source.name = "source";
  source.instanceCount = 7;
  source.parents = parents;
  source.create = &CreateMarker;

  const ClassInfo copy(source);
  const ClassInfo next;

  EXPECT_STREQ(copy.name, "source");
  EXPECT_EQ(copy.RTTID, source.RTTID);
  EXPECT_EQ(copy.instanceCount, 7);
  EXPECT_EQ(copy.parents, parents);
  EXPECT_EQ(copy.create, &CreateMarker);
  EXPECT_EQ(next.RTTID, source.RTTID + 1);
}

TEST(ClassInfo, AssignmentTakesAllFieldsAndNoIdentifier) {
  ClassInfo* parents[] = {&BaseClass::CI(), nullptr};
  ClassInfo source;
  source.name = "source";
  source.instanceCount = 7;
  source.parents = parents;
  source.create = &CreateMarker;
  ClassInfo target;
  const std::int32_t newest = target.RTTID;

  target = source;
  const ClassInfo next;

  EXPECT_STREQ(target.name, "source");
  EXPECT_EQ(target.RTTID, source.RTTID);
  EXPECT_EQ(target.instanceCount, 7);
  EXPECT_EQ(target.parents, parents);
  EXPECT_EQ(target.create, &CreateMarker);
  EXPECT_EQ(next.RTTID, newest + 1);
}

TEST(ClassInfo, OnlyTheDestructorIsVirtual) {
  EXPECT_TRUE(std::has_virtual_destructor_v<ClassInfo>);
  // One hidden pointer, then the five fields and nothing else.
  struct Fields {
    virtual ~Fields() = default;
    const char* name;
    std::int32_t id;
    std::int32_t count;
    ClassInfo** parents;
    ClassInfo::CreateFunction create;
  };
  EXPECT_EQ(sizeof(ClassInfo), sizeof(Fields));
}

TEST(ClassInfo, CreateGivesNullWithoutFactory) {
  const ClassInfo info;
  EXPECT_EQ(info.Create(), nullptr);
  EXPECT_EQ(BaseClass::CI().Create(), nullptr);
  EXPECT_EQ(DataBase::CI().Create(), nullptr);
  EXPECT_EQ(OpBase::CI().Create(), nullptr);
}

TEST(ClassInfo, CreateCallsTheFactory) {
  const std::unique_ptr<BaseClass> object(dStatus::CI().Create());
  ASSERT_NE(object, nullptr);
  EXPECT_NE(dynamic_cast<dStatus*>(object.get()), nullptr);
}

TEST(ClassInfo, CoversItselfAndNoUnknownIdentifier) {
  const ClassInfo info;
  EXPECT_TRUE(info.CoversClass(info.RTTID));
  EXPECT_FALSE(info.CoversClass(kUnknownId));
  EXPECT_FALSE(info.CoversClass(-1));
}

TEST(ClassInfo, EmptyParentListCoversNothingMore) {
  ClassInfo* none[] = {nullptr};
  ClassInfo info;
  info.parents = none;
  EXPECT_TRUE(info.CoversClass(info.RTTID));
  EXPECT_FALSE(info.CoversClass(BaseClass::CI().RTTID));
}

TEST(ClassInfo, CoversEveryParentAndTheirParents) {
  ClassInfo grandparent;
  ClassInfo* grandparents[] = {&grandparent, nullptr};
  ClassInfo father;
  ClassInfo mother;
  mother.parents = grandparents;
  ClassInfo* parents[] = {&father, &mother, nullptr};
  ClassInfo child;
  child.parents = parents;

  EXPECT_TRUE(child.CoversClass(father.RTTID));
  EXPECT_TRUE(child.CoversClass(mother.RTTID));
  EXPECT_TRUE(child.CoversClass(grandparent.RTTID));
  EXPECT_FALSE(mother.CoversClass(child.RTTID)) << "a parent is not its child";
  EXPECT_FALSE(mother.CoversClass(father.RTTID));
}

TEST(ClassInfo, RecordsNameClassParentAndFactory) {
  struct {
    const char* name;
    const ClassInfo& record;
    const ClassInfo* parent;
    bool factory;
  } const classes[] = {
      {"BaseClass", BaseClass::CI(), nullptr, false},
      {"DataBase", DataBase::CI(), &BaseClass::CI(), false},
      {"dStatus", dStatus::CI(), &DataBase::CI(), true},
      {"HRTimer", HRTimer::CI(), &BaseClass::CI(), true},
      {"OpBase", OpBase::CI(), &BaseClass::CI(), false},
  };
  std::set<std::int32_t> ids;
  for (const auto& expected : classes) {
    SCOPED_TRACE(expected.name);
    EXPECT_STREQ(expected.record.name, expected.name);
    EXPECT_EQ(expected.record.create != nullptr, expected.factory);
    EXPECT_TRUE(expected.record.CoversClass(BaseClass::CI().RTTID));
    EXPECT_TRUE(ids.insert(expected.record.RTTID).second) << "identifier used twice";
    if (expected.parent == nullptr) {
      EXPECT_EQ(expected.record.parents, nullptr);
    } else {
      ASSERT_NE(expected.record.parents, nullptr);
      EXPECT_EQ(expected.record.parents[0], expected.parent);
      EXPECT_EQ(expected.record.parents[1], nullptr);
    }
  }
}

TEST(ClassInfo, BuildTakesAMissingNameAsEmpty) {
  static ClassInfo& record = BuildClassInfo(nullptr, nullptr, nullptr);  // lives as all records do
  EXPECT_STREQ(record.name, "");
}

TEST(BaseClass, ObjectAnswersThroughItsRecord) {
  Marker marker;
  EXPECT_STREQ(marker.ClassName(), "Marker");
  EXPECT_EQ(marker.RTTID(), Marker::CI().RTTID);
  EXPECT_TRUE(marker.CoversClass(Marker::CI().RTTID));
  EXPECT_TRUE(marker.CoversClass(DataBase::CI().RTTID));
  EXPECT_TRUE(marker.CoversClass(BaseClass::CI().RTTID));
  EXPECT_FALSE(marker.CoversClass(dStatus::CI().RTTID));
  EXPECT_FALSE(marker.CoversClass(kUnknownId));
}

TEST(BaseClass, QueriesGoToTheDynamicClass) {
  Marker marker;
  const BaseClass& object = marker;
  EXPECT_STREQ(object.ClassName(), "Marker");
  EXPECT_EQ(object.RTTID(), Marker::CI().RTTID);
}

TEST(BaseClass, ObjectWithoutRecordGivesNeutralAnswers) {
  Unregistered object;
  EXPECT_STREQ(object.ClassName(), "");
  EXPECT_EQ(object.RTTID(), -1);
  EXPECT_FALSE(object.CoversClass(BaseClass::CI().RTTID));
  EXPECT_FALSE(object.CoversClass(-1));
  EXPECT_EQ(object.Create(), nullptr);
}

TEST(BaseClass, PlainObjectAnswersWithTheRootRecord) {
  BaseClass object;
  EXPECT_EQ(object.GetClassInfo(), &BaseClass::CI());
  EXPECT_STREQ(object.ClassName(), "BaseClass");
  EXPECT_EQ(object.Create(), nullptr) << "the root has no factory";
}

TEST(BaseClass, CreateMakesAnObjectOfTheSameDynamicClass) {
  Marker marker;
  const BaseClass& object = marker;
  const std::unique_ptr<BaseClass> created(object.Create());
  ASSERT_NE(created, nullptr);
  EXPECT_STREQ(created->ClassName(), "Marker");
}

TEST(BaseClass, ReleaseDestroysTheWholeObject) {
  bool destroyed = false;
  auto* marker = new Marker();
  marker->m_destroyed = &destroyed;
  BaseClass* object = marker;
  EXPECT_TRUE(object->Release());
  EXPECT_TRUE(destroyed);
}

TEST(BaseClass, InstanceCountFollowsConstructionAndDestruction) {
  const std::int32_t before = BaseClass::CI().instanceCount;
  {
    const Marker marker;
    EXPECT_EQ(BaseClass::CI().instanceCount, before + 1);
    const dStatus status;
    EXPECT_EQ(BaseClass::CI().instanceCount, before + 2);
    const IdleOperator op;  // with its status and its timer
    EXPECT_EQ(BaseClass::CI().instanceCount, before + 5);
    const std::unique_ptr<BaseClass> created(HRTimer::CI().Create());
    EXPECT_EQ(BaseClass::CI().instanceCount, before + 6);
  }
  EXPECT_EQ(BaseClass::CI().instanceCount, before);
}

TEST(BaseClass, OnlyTheRootRecordCounts) {
  const Marker marker;
  const dStatus status;
  EXPECT_EQ(Marker::CI().instanceCount, 0);
  EXPECT_EQ(DataBase::CI().instanceCount, 0);
  EXPECT_EQ(dStatus::CI().instanceCount, 0);
}

TEST(BaseClass, CopiesAreNotCountedButTheirEndIs) {
  const dStatus source;
  const std::int32_t before = BaseClass::CI().instanceCount;
  {
    const dStatus copy(source);
    EXPECT_EQ(BaseClass::CI().instanceCount, before);
  }
  EXPECT_EQ(BaseClass::CI().instanceCount, before - 1);
}

TEST(BaseClass, CopiedOperatorCountsNoneOfItsParts) {
  const IdleOperator source;
  const std::int32_t before = BaseClass::CI().instanceCount;
  {
    const IdleOperator copy(source);
    EXPECT_EQ(BaseClass::CI().instanceCount, before);
  }
  EXPECT_EQ(BaseClass::CI().instanceCount, before - 3);
}

TEST(BaseClass, AssignmentLeavesTheCount) {
  const dStatus source;
  dStatus target;
  const std::int32_t before = BaseClass::CI().instanceCount;
  target = source;
  EXPECT_EQ(BaseClass::CI().instanceCount, before);
}

TEST(BaseClass, VirtualFunctionsStandInOrder) {
  EXPECT_EQ(VirtualSlot(&BaseClass::GetClassInfo), 0u);
  EXPECT_TRUE(std::has_virtual_destructor_v<BaseClass>);  // places 1 and 2
  EXPECT_EQ(VirtualSlot(&BaseClass::Release), 3u);
}

TEST(DataBase, AddsResetAndIsValidInOrder) {
  EXPECT_EQ(VirtualSlot(&DataBase::Reset), 4u);
  EXPECT_EQ(VirtualSlot(&DataBase::IsValid), 5u);
  EXPECT_TRUE(std::is_abstract_v<DataBase>);
}

TEST(DataBase, IsNotValidByItself) {
  Marker marker;
  EXPECT_FALSE(marker.IsValid());
}

}  // namespace
