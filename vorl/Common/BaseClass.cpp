#include <vorl/Common/BaseClass.h>

#include <atomic>

#include <vorl/Common/detail/ClassRegistration.h>

inline namespace vorl {

namespace {

std::atomic<std::int32_t> nextId{100};

// Operators create temporary objects in their own threads, so the one shared count is atomic.
void CountInstance(std::int32_t difference) {
  std::atomic_ref<std::int32_t>(BaseClass::CI().instanceCount)
      .fetch_add(difference, std::memory_order_relaxed);
}

// The virtual query is not const, as applications override it; it changes nothing.
const ClassInfo* InfoOf(const BaseClass& object) {
  return const_cast<BaseClass&>(object).GetClassInfo();
}

}  // namespace

ClassInfo::ClassInfo() : RTTID(nextId.fetch_add(1, std::memory_order_relaxed)) {}

ClassInfo::~ClassInfo() = default;

BaseClass* ClassInfo::Create() const {
  return create != nullptr ? create() : nullptr;
}

bool ClassInfo::CoversClass(long id) const {
  if (RTTID == id) {
    return true;
  }
  if (parents == nullptr) {
    return false;
  }
  for (ClassInfo** parent = parents; *parent != nullptr; ++parent) {
    if ((*parent)->CoversClass(id)) {
      return true;
    }
  }
  return false;
}

ClassInfo& BuildClassInfo(const char* name, ClassInfo* parent, ClassInfo::CreateFunction create) {
  // Never freed: objects with static lifetime may outlive any destructor run at exit.
  auto* record = new ClassInfo();
  record->name = name != nullptr ? name : "";
  record->create = create;
  if (parent != nullptr) {
    record->parents = new ClassInfo* [2] { parent, nullptr };
  }
  return *record;
}

ClassInfo& BaseClass::CI() {
  static ClassInfo& record = BuildClassInfo("BaseClass", nullptr, nullptr);
  return record;
}

ClassInfo* BaseClass::GetClassInfo() {
  return &CI();
}

[[maybe_unused]] static const ClassInfo& vorlRegisteredBaseClass = BaseClass::CI();

BaseClass::BaseClass() {
  CountInstance(1);
}

BaseClass::BaseClass(const BaseClass&) {}

BaseClass::~BaseClass() {
  CountInstance(-1);
}

bool BaseClass::Release() {
  delete this;
  return true;
}

const char* BaseClass::ClassName() const {
  const ClassInfo* info = InfoOf(*this);
  return info != nullptr ? info->name : "";
}

long BaseClass::RTTID() const {
  const ClassInfo* info = InfoOf(*this);
  return info != nullptr ? info->RTTID : -1;
}

bool BaseClass::CoversClass(long id) const {
  const ClassInfo* info = InfoOf(*this);
  return info != nullptr && info->CoversClass(id);
}

BaseClass* BaseClass::Create() const {
  const ClassInfo* info = InfoOf(*this);
  return info != nullptr ? info->Create() : nullptr;
}

VORL_REGISTER_ABSTRACT_CLASS(DataBase, BaseClass);

DataBase::DataBase() = default;

DataBase::DataBase(const DataBase&) = default;

DataBase::~DataBase() = default;

bool DataBase::IsValid() {
  return false;
}

}  // namespace vorl
