#ifndef VORL_OPERATORS_IP_OPLOOKUP_H
#define VORL_OPERATORS_IP_OPLOOKUP_H

/// @file
/// Pixels through a lookup table.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dImage.h>
#include <vorl/Data/dLUT.h>

inline namespace vorl {

/// Maps a one-channel image of 8 or 16 bits through an 8-bit table into an 8-bit image.
///
/// *Shape.* The target is formatted like the source; a 16-bit source gives an image of the table's
/// type. Without a target, or with the source as target, the source is replaced by the result.
///
/// *Range.* A sample below the table's start index takes its first entry, one beyond its end the
/// last.
///
/// *Errors.* "missing source image", "uninitialized source image", "invalid pixel data in the
/// source image" and "invalid entries in the LUT" (a buffer was exchanged for one that does not
/// hold the rows), "multi channel(%d) source images are not supported", "invalid channel depth:%d
/// bit(must be 8 or 16 bit)", "missing LUT", "uninitialized LUT", "LUT has more(%d) than 1
/// channel", "data depth of the LUT(%d bit) must be 8 bit", "error while creating image buffer:"
/// followed by the image's message, and "stopped" after a stop request. The target of a 16-bit
/// source, and such a source that is replaced, stay as they are when the operator fails; of an
/// 8-bit one, the rows before the stop have been replaced.
class VORL_API opLookup : public OpBase {
 public:
  opLookup();
  /// Sets the operands and runs at once; `GetStatus` tells how it went.
  opLookup(dImage* source, dImage* target, dLUT* lut);
  opLookup(const opLookup& source);
  opLookup& operator=(const opLookup& source);

  ClassInfo* GetClassInfo() override;
  ~opLookup() override;
  /// Drops the operands; returns true.
  bool Reset() override;

 protected:
  bool Prepare() override;
  bool Process() override;

 public:
  static opLookup* Create();
  static ClassInfo& CI();

  dImage* m_pSource = nullptr;  ///< input; not owned
  dImage* m_pTarget = nullptr;  ///< output, may be the source or null; not owned
  dLUT* m_pLUT = nullptr;       ///< not owned

 protected:
  bool Lookup8to8();
  bool Lookup16to8();

 private:
  bool Map(const dImage& source, const dImage& target);
  bool MapTo(dImage& image, unsigned short dataType);

  std::int32_t m_lookupMode = -1;  ///< -1 none, 0 eight to eight, 1 sixteen to eight
};

}  // namespace vorl

#endif
