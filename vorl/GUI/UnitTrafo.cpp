#include <utility>

#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/detail/OwnedText.h>

inline namespace vorl {

using vorl_detail::TextOf;

UnitTrafo::UnitTrafo() = default;

UnitTrafo::UnitTrafo(const UnitTrafo& source) {
  *this = source;
}

UnitTrafo& UnitTrafo::operator=(const UnitTrafo& source) {
  if (this == &source) {
    return *this;
  }
  m_selected = source.m_selected;
  for (int i = 0; i < kUnits; ++i) {
    const Unit& from = source.m_units[i];
    m_units[i].trafo = from.trafo;
    m_units[i].isInteger = from.isInteger;
    SetUnitText(i, from.shortText.c_str(), from.longText.c_str());
  }
  return *this;
}

UnitTrafo::~UnitTrafo() = default;

void UnitTrafo::Reset() {
  m_selected = 0;
  for (Unit& unit : m_units) {
    unit = Unit();
  }
}

void UnitTrafo::SetUnitTrafo(int unit, double scale, double offset) {
  if (Unit* const entry = UnitAt(unit)) {
    entry->trafo.Set(scale, offset);
  }
}

void UnitTrafo::SetIntegerUnit(int unit, bool isInteger) {
  if (Unit* const entry = UnitAt(unit)) {
    entry->isInteger = isInteger;
  }
}

void UnitTrafo::SetUnitText(int unit, const char* shortText, const char* longText) {
  if (Unit* const entry = UnitAt(unit)) {
    std::string newShort = TextOf(shortText);  // the texts may be this unit's own
    std::string newLong = TextOf(longText);
    entry->shortText = std::move(newShort);
    entry->longText = std::move(newLong);
  }
}

void UnitTrafo::SelectUnit(int unit) {
  if (UnitAt(unit) != nullptr) {
    m_selected = static_cast<std::int16_t>(unit);
  }
}

int UnitTrafo::GetUnitID() const {
  return m_selected;
}

Trafo1D& UnitTrafo::GetUnitTrafo() {
  return m_units[m_selected].trafo;
}

const Trafo1D& UnitTrafo::GetUnitTrafo() const {
  return Selected().trafo;
}

bool UnitTrafo::IsIntegerUnit() const {
  return Selected().isInteger;
}

const char* UnitTrafo::GetShortUnitText() const {
  return Selected().shortText.c_str();
}

const char* UnitTrafo::GetLongUnitText() const {
  return Selected().longText.c_str();
}

double UnitTrafo::A2B(double x) const {
  return Selected().trafo.A2B(x);
}

double UnitTrafo::B2A(double x) const {
  return Selected().trafo.B2A(x);
}

void UnitTrafo::A2B(double* x) const {
  Selected().trafo.A2B(x);
}

void UnitTrafo::B2A(double* x) const {
  Selected().trafo.B2A(x);
}

UnitTrafo::Unit* UnitTrafo::UnitAt(int unit) {
  return unit >= 0 && unit < kUnits ? &m_units[unit] : nullptr;
}

const UnitTrafo::Unit& UnitTrafo::Selected() const {
  return m_units[m_selected];
}

}  // namespace vorl
