#include <study/Error.h>
#include <study/dicom/Attributes.h>

#include <dcmtk/dcmdata/dcspchrs.h>

#include <cmath>

namespace study {
namespace {

constexpr std::size_t kShownCharacters = 40;

std::string Printable(const std::string& text) {
  std::string result;
  for (const char c : text) {
    result += static_cast<unsigned char>(c) < 0x20 || c == 0x7F ? ' ' : c;
  }
  const std::size_t begin = result.find_first_not_of(' ');
  const std::size_t end = result.find_last_not_of(' ');
  return begin == std::string::npos ? std::string() : result.substr(begin, end - begin + 1);
}

bool IsAscii(const std::string& text) {
  for (const char c : text) {
    if (static_cast<unsigned char>(c) >= 0x80) {
      return false;
    }
  }
  return true;
}

/// Text in the data set's character set as UTF-8; characters that cannot be told become '?'.
std::string ToUtf8(const std::string& text, DcmItem& item) {
  if (IsAscii(text)) {
    return text;
  }
  OFString sets;
  OFString converted;
  DcmItem& root = item.getRootItem() != nullptr ? *item.getRootItem() : item;
  DcmSpecificCharacterSet converter;
  if (root.findAndGetOFStringArray(DCM_SpecificCharacterSet, sets).good() &&
      converter.selectCharacterSet(sets).good() &&
      converter.convertString(OFString(text.c_str()), converted).good()) {
    return converted.c_str();
  }
  std::string result = text;
  for (char& c : result) {
    c = static_cast<unsigned char>(c) >= 0x80 ? '?' : c;
  }
  return result;
}

[[noreturn]] void ThrowInvalid(const DcmTagKey& tag, DcmElement& element) {
  OFString value;
  std::string shown;
  if (element.getOFStringArray(value).good()) {
    shown = Printable(value.c_str()).substr(0, kShownCharacters);
  }
  if (!IsAscii(shown)) {
    shown.clear();
  }
  throw Error("the value '" + shown + "' of " + AttributeName(tag) + " is not valid");
}

}  // namespace

std::string AttributeName(const DcmTagKey& tag) {
  DcmTag named(tag);
  return std::string(named.getTagName()) + " " + tag.toString().c_str();
}

DcmElement* Attributes::Find(const DcmTagKey& tag, DcmItem** owner) const {
  for (DcmItem* scope : m_scopes) {
    DcmElement* element = nullptr;
    if (scope->findAndGetElement(tag, element).good() && element != nullptr &&
        element->getLength() > 0) {
      if (owner != nullptr) {
        *owner = scope;
      }
      return element;
    }
  }
  return nullptr;
}

bool Attributes::Has(const DcmTagKey& tag) const {
  return Find(tag) != nullptr;
}

std::string Attributes::Text(const DcmTagKey& tag) const {
  DcmItem* owner = nullptr;
  DcmElement* element = Find(tag, &owner);
  OFString value;
  if (element == nullptr || element->getOFString(value, 0).bad()) {
    return {};
  }
  return Printable(ToUtf8(value.c_str(), *owner));
}

std::optional<double> Attributes::Number(const DcmTagKey& tag, unsigned long index) const {
  DcmElement* element = Find(tag);
  if (element == nullptr) {
    return std::nullopt;
  }
  Float64 value = 0;
  Uint16 whole = 0;
  if (element->getFloat64(value, index).bad()) {
    if (element->getUint16(whole, index).bad()) {
      ThrowInvalid(tag, *element);
    }
    value = whole;
  }
  if (!std::isfinite(value)) {
    ThrowInvalid(tag, *element);
  }
  return value;
}

std::optional<long> Attributes::Integer(const DcmTagKey& tag) const {
  DcmElement* element = Find(tag);
  if (element == nullptr) {
    return std::nullopt;
  }
  Sint32 value = 0;
  Uint16 small = 0;
  if (element->getSint32(value, 0).good()) {
    return value;
  }
  if (element->getUint16(small, 0).good()) {
    return small;
  }
  ThrowInvalid(tag, *element);
}

std::optional<Vec3> Attributes::Vector(const DcmTagKey& tag, unsigned long firstIndex) const {
  const auto x = Number(tag, firstIndex);
  const auto y = Number(tag, firstIndex + 1);
  const auto z = Number(tag, firstIndex + 2);
  if (!x || !y || !z) {
    return std::nullopt;
  }
  return Vec3{*x, *y, *z};
}

unsigned Attributes::RequiredUnsigned(const DcmTagKey& tag) const {
  DcmElement* element = Find(tag);
  if (element == nullptr) {
    throw Error("it has no " + AttributeName(tag));
  }
  Uint16 value = 0;
  if (element->getUint16(value, 0).bad()) {
    ThrowInvalid(tag, *element);
  }
  return value;
}

}  // namespace study
