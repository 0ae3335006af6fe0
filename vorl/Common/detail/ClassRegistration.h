#ifndef VORL_COMMON_DETAIL_CLASSREGISTRATION_H
#define VORL_COMMON_DETAIL_CLASSREGISTRATION_H

/// @file
/// One line per class in its source file: defines `CI`, `GetClassInfo` and, where the class has
/// one, the factory, and registers the record while the library is loaded.

#include <vorl/Common/BaseClass.h>

#include <exception>
#include <new>

/// For a class with the factory `static Class* Create()`.
#define VORL_REGISTER_CLASS(Class, Parent)                                       \
  Class* Class::Create() {                                                       \
    try {                                                                        \
      return new Class();                                                        \
    } catch (const std::bad_alloc&) {                                            \
      return nullptr;                                                            \
    }                                                                            \
  }                                                                              \
  ClassInfo& Class::CI() {                                                       \
    static ClassInfo& record = BuildClassInfo(                                   \
        #Class, &Parent::CI(), +[]() -> BaseClass* { return Class::Create(); }); \
    return record;                                                               \
  }                                                                              \
  ClassInfo* Class::GetClassInfo() {                                             \
    return &CI();                                                                \
  }                                                                              \
  [[maybe_unused]] static const ClassInfo& vorlRegistered##Class = Class::CI()

/// For an abstract class, which has no factory.
#define VORL_REGISTER_ABSTRACT_CLASS(Class, Parent)                            \
  ClassInfo& Class::CI() {                                                     \
    static ClassInfo& record = BuildClassInfo(#Class, &Parent::CI(), nullptr); \
    return record;                                                             \
  }                                                                            \
  ClassInfo* Class::GetClassInfo() {                                           \
    return &CI();                                                              \
  }                                                                            \
  [[maybe_unused]] static const ClassInfo& vorlRegistered##Class = Class::CI()

#endif
