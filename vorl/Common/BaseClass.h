#ifndef VORL_COMMON_BASECLASS_H
#define VORL_COMMON_BASECLASS_H

/// @file
/// The root of the class tree: run-time class records, the object base and the base of all data
/// classes.

#include <vorl/export.h>

#include <cstdint>

inline namespace vorl {

class BaseClass;

/// The run-time record of one class: its name, identifier, direct base classes and factory.
///
/// Each class owns one record, returned by its static `CI()`. Records are built on first use, are
/// registered when the library is loaded, and live as long as the process. A record that an
/// application builds for a class of its own works like the library's (see `BuildClassInfo`).
class VORL_API ClassInfo {
 public:
  /// A factory without arguments; the caller owns the object.
  using CreateFunction = BaseClass* (*)();

  /// Takes the next free identifier from a process-wide counter that starts at 100. Name, count,
  /// parents and factory are empty.
  ClassInfo();
  /// Copies all fields, the identifier included; the counter stays.
  ClassInfo(const ClassInfo& source) = default;
  ClassInfo& operator=(const ClassInfo& source) = default;
  virtual ~ClassInfo();

  /// Creates an object through the factory; null when the record has none or memory is exhausted.
  /// The caller owns the object.
  BaseClass* Create() const;

  /// True when `id` is this record's identifier or that of any direct or indirect base class.
  bool CoversClass(long id) const;

  const char* name = "";            ///< the class's own name; empty until registered; not owned
  std::int32_t RTTID;               ///< unique in the process
  std::int32_t instanceCount = 0;   ///< live objects; counted in `BaseClass`'s record only
  ClassInfo** parents = nullptr;    ///< direct base classes, ended by null; may be null; not owned
  CreateFunction create = nullptr;  ///< the class's factory; may be null
};

/// Builds the record of a class: a fresh identifier, the given name (kept by pointer), one direct
/// base class (may be null) and the factory (may be null). The record is never freed. Meant to be
/// called once per class, from a static local in its `CI()`.
VORL_API ClassInfo& BuildClassInfo(const char* name, ClassInfo* parent,
                                   ClassInfo::CreateFunction create);

/// The root of every class of the library.
class VORL_API BaseClass {
 public:
  /// Counts the object in `BaseClass::CI().instanceCount`.
  BaseClass();
  /// Does not count: the instance count follows default construction and destruction only.
  BaseClass(const BaseClass& source);
  BaseClass& operator=(const BaseClass& source) = default;

  /// The record of the object's class. Every class overrides this to return its own `CI()`.
  virtual ClassInfo* GetClassInfo();
  virtual ~BaseClass();
  /// Destroys and frees this object, which must have been created with `new`; returns true.
  virtual bool Release();

  /// The record of `BaseClass` itself.
  static ClassInfo& CI();

  /// The name of the object's class; empty when it has no record.
  const char* ClassName() const;
  /// The identifier of the object's class; -1 when it has no record.
  long RTTID() const;
  /// True when the object's class is, or derives from, the class with this identifier.
  bool CoversClass(long id) const;
  /// A new object of the same dynamic class, owned by the caller; null without a factory.
  BaseClass* Create() const;
};

/// The base of all data classes: adds a reset and a validity test.
class VORL_API DataBase : public BaseClass {
 public:
  DataBase();
  DataBase(const DataBase& source);
  DataBase& operator=(const DataBase& source) = default;

  ClassInfo* GetClassInfo() override;
  ~DataBase() override;
  /// Returns the object to its empty, uninitialised state.
  virtual void Reset() = 0;
  /// False here; classes that can be valid override it.
  virtual bool IsValid();

  static ClassInfo& CI();
};

}  // namespace vorl

#endif
