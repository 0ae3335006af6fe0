#ifndef VORL_APPS_STUDY_DICOM_ATTRIBUTES_H
#define VORL_APPS_STUDY_DICOM_ATTRIBUTES_H

/// @file
/// Reading single values out of DICOM data sets.

#include <dcmtk/config/osconfig.h>

#include <dcmtk/dcmdata/dctk.h>
#include <study/Vec3.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace study {

/// Looks attributes up in several items in turn: for a frame of a multi-frame file first what is
/// its own, then what all frames share, then the data set. The first item that has a value decides.
///
/// A missing or empty value is an empty result; a value that is there but is not what it must be
/// throws `Error` with the attribute's name and the value.
class Attributes {
 public:
  explicit Attributes(std::vector<DcmItem*> scopes) : m_scopes(std::move(scopes)) {}

  bool Has(const DcmTagKey& tag) const;
  /// Trimmed, in UTF-8, without control characters; empty when missing.
  std::string Text(const DcmTagKey& tag) const;
  /// A finite number.
  std::optional<double> Number(const DcmTagKey& tag, unsigned long index = 0) const;
  std::optional<long> Integer(const DcmTagKey& tag) const;
  std::optional<Vec3> Vector(const DcmTagKey& tag, unsigned long firstIndex = 0) const;
  /// Throws `Error` when the value is missing, too.
  unsigned RequiredUnsigned(const DcmTagKey& tag) const;

 private:
  /// The element from the first item where it has a value; null when there is none.
  DcmElement* Find(const DcmTagKey& tag, DcmItem** owner = nullptr) const;

  std::vector<DcmItem*> m_scopes;
};

/// The attribute's name in the toolkit's dictionary, for messages.
std::string AttributeName(const DcmTagKey& tag);

}  // namespace study

#endif
