#ifndef VORL_DATA_DPOINT_H
#define VORL_DATA_DPOINT_H

/// @file
/// An integer point.

#include <vorl/Common/BaseClass.h>
#include <vorl/Platform/GdiFwd.h>

#include <cstdint>

inline namespace vorl {

/// Two signed 32-bit coordinates. A sum, difference or negation beyond their range wraps around.
class VORL_API dPoint : public DataBase {
 public:
  /// (0, 0).
  dPoint();
  dPoint(const tagPOINT& point);
  dPoint(const dPoint& source);
  dPoint& operator=(const dPoint& source);
  dPoint& operator=(const tagPOINT& point);

  ClassInfo* GetClassInfo() override;
  ~dPoint() override;
  /// (0, 0).
  void Reset() override;

  static dPoint* Create();
  static ClassInfo& CI();

  /// (0, 0).
  void Init();
  void Init(int newX, int newY);

  bool operator==(const dPoint& other) const;
  bool operator!=(const dPoint& other) const;
  /// Both coordinates are 0.
  bool IsEmpty() const;

  dPoint& operator+=(const dPoint& other);
  dPoint& operator-=(const dPoint& other);
  /// Negates this point itself, and returns it.
  dPoint& operator-();

  std::int32_t x = 0;
  std::int32_t y = 0;
};

VORL_API dPoint operator+(const dPoint& a, const dPoint& b);
VORL_API dPoint operator-(const dPoint& a, const dPoint& b);

}  // namespace vorl

#endif
