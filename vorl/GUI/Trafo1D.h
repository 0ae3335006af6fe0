#ifndef VORL_GUI_TRAFO1D_H
#define VORL_GUI_TRAFO1D_H

/// @file
/// A linear map of numbers, and a set of four of them that shows values in selectable units.

#include <vorl/export.h>

#include <concepts>
#include <cstdint>
#include <string>

inline namespace vorl {

/// A scale and an offset. Side A is, for example, the stored value, side B the displayed one.
///
/// All in double precision. The division is not guarded: with a scale of zero `B2A` gives
/// infinities or NaN.
class VORL_API Trafo1D {
 public:
  /// The identity: scale 1, offset 0.
  Trafo1D();
  Trafo1D(double scale, double offset);
  Trafo1D(const Trafo1D& source);
  Trafo1D& operator=(const Trafo1D& source);
  ~Trafo1D();

  void Set(double scale, double offset);
  double GetScale() const;
  double GetOffset() const;

  /// scale * x + offset.
  double A2B(double x) const;
  /// (x - offset) / scale.
  double B2A(double x) const;
  /// In place; a null pointer is ignored.
  void A2B(double* x) const;
  void B2A(double* x) const;
  /// For whole numbers, of which a literal 0 could else be taken for a null pointer.
  template <std::integral Integer>
  double A2B(Integer x) const {
    return A2B(static_cast<double>(x));
  }
  template <std::integral Integer>
  double B2A(Integer x) const {
    return B2A(static_cast<double>(x));
  }

 private:
  double m_scale = 1.0;
  double m_offset = 0.0;
};

/// Four units to show a value in, one of which is selected: each a `Trafo1D` from the value (A) to
/// its number in the unit (B), a short and a long name, and whether its numbers are whole.
///
/// A unit index outside 0 to 3 is ignored wherever one is taken.
class VORL_API UnitTrafo {
 public:
  /// As after `Reset`.
  UnitTrafo();
  /// Copies all four units and the selection. A text that finds no memory is left empty.
  UnitTrafo(const UnitTrafo& source);
  UnitTrafo& operator=(const UnitTrafo& source);
  virtual ~UnitTrafo();

  /// Selects unit 0 and makes every unit the identity, without texts, not of whole numbers.
  void Reset();

  void SetUnitTrafo(int unit, double scale, double offset);
  /// States whether the unit's numbers are shown without decimals.
  void SetIntegerUnit(int unit, bool isInteger);
  /// Copies both texts, for example "mm" and "Millimetres"; null empties one. A text that finds no
  /// memory is left empty.
  void SetUnitText(int unit, const char* shortText, const char* longText);
  void SelectUnit(int unit);

  /// The index of the selected unit, 0 to 3. What follows answers for this unit.
  int GetUnitID() const;
  Trafo1D& GetUnitTrafo();
  const Trafo1D& GetUnitTrafo() const;
  bool IsIntegerUnit() const;
  /// Never null; valid until the texts change.
  const char* GetShortUnitText() const;
  const char* GetLongUnitText() const;

  /// From the value to its number in the selected unit.
  double A2B(double x) const;
  /// From a number in the selected unit to the value.
  double B2A(double x) const;
  /// In place; a null pointer is ignored.
  void A2B(double* x) const;
  void B2A(double* x) const;
  /// For whole numbers (see `Trafo1D`).
  template <std::integral Integer>
  double A2B(Integer x) const {
    return A2B(static_cast<double>(x));
  }
  template <std::integral Integer>
  double B2A(Integer x) const {
    return B2A(static_cast<double>(x));
  }

 private:
  static constexpr int kUnits = 4;

  struct Unit {
    Trafo1D trafo;
    std::string shortText;
    std::string longText;
    bool isInteger = false;
  };

  /// Null for an index outside.
  Unit* UnitAt(int unit);
  const Unit& Selected() const;

  std::int16_t m_selected = 0;
  Unit m_units[kUnits];
};

}  // namespace vorl

#endif
