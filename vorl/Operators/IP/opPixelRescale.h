#ifndef VORL_OPERATORS_IP_OPPIXELRESCALE_H
#define VORL_OPERATORS_IP_OPPIXELRESCALE_H

/// @file
/// A linear rescale of samples.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dImage.h>

inline namespace vorl {

/// Computes sample * factor + offset, truncated towards zero and saturated to the source's own data
/// type: unsigned or signed, 8 or 16 bits. A result that is not a number counts as 0.
///
/// *Shape.* The target is formatted like the source; without one the source is rescaled in place.
/// The samples are taken as one dense run of (rows x samples in a row) from the start of the
/// buffers: row padding is not skipped, so images to be rescaled are kept unpadded.
///
/// *Identity.* Factor 1 and offset 0 compute nothing: the target pointer is set to the source, and
/// a separate target image keeps its pixels unwritten.
///
/// *Errors.* "uninitialized parameter: m_pSource = null", "error while initializing target image: "
/// followed by the target's message, "unsupported pixel data type: %s", "invalid pixel data in the
/// source image" or "... target image" (its buffer was exchanged for one that does not hold the
/// run), and "stopped" after a stop request, with the rows before it written.
class VORL_API opPixelRescale : public OpBase {
 public:
  opPixelRescale();
  /// Sets the operands and runs at once; `GetStatus` tells how it went.
  opPixelRescale(dImage* source, dImage* target, double factor, double offset);
  /// The same in place.
  opPixelRescale(dImage* image, double factor, double offset);
  opPixelRescale(const opPixelRescale& source);
  opPixelRescale& operator=(const opPixelRescale& source);

  ClassInfo* GetClassInfo() override;
  ~opPixelRescale() override;
  /// Drops the operands; factor 1, offset 0; returns true.
  bool Reset() override;

 protected:
  bool Prepare() override;
  bool Process() override;

 public:
  static opPixelRescale* Create();
  static ClassInfo& CI();

  using OpBase::Run;
  /// Sets the operands and runs.
  bool Run(dImage* source, dImage* target, double factor, double offset);

  dImage* m_pSource = nullptr;  ///< input; not owned
  dImage* m_pTarget = nullptr;  ///< output; may be the source; not owned
  double m_factor = 1.0;
  double m_offset = 0.0;

 protected:
  /// Each rescales the samples of one data type; null images are left alone. False when stopped.
  bool RescaleU8(dImage* source, dImage* target, double factor, double offset);
  bool RescaleS8(dImage* source, dImage* target, double factor, double offset);
  bool RescaleU16(dImage* source, dImage* target, double factor, double offset);
  bool RescaleS16(dImage* source, dImage* target, double factor, double offset);

 private:
  template <class T>
  bool Rescale(dImage* source, dImage* target, double factor, double offset);
};

}  // namespace vorl

#endif
