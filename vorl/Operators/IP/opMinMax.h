#ifndef VORL_OPERATORS_IP_OPMINMAX_H
#define VORL_OPERATORS_IP_OPMINMAX_H

/// @file
/// The smallest and the largest sample of an image.

#include <vorl/Common/OpBase.h>
#include <vorl/Data/dImage.h>

#include <cstdint>

inline namespace vorl {

/// Finds the smallest and the largest sample over all channels.
///
/// Samples may be unsigned or signed of 8 or 16 bits, or signed of 32 bits. The search starts from
/// the values that stand in the operator, so that results extend over several images; 2147483647
/// and -2147483648 start afresh.
///
/// *Errors.* "missing source image", "uninitialized source image", "invalid pixel data in the
/// source image" (its buffer was exchanged for one that does not hold its rows), "unsupported data
/// type: %d(%d bit)", and "stopped" after a stop request.
class VORL_API opMinMax : public OpBase {
 public:
  opMinMax();
  /// `Run(source, minimum, maximum)` at once.
  opMinMax(dImage* source, long& minimum, long& maximum);
  opMinMax(dImage* source, std::int32_t& minimum, std::int32_t& maximum);
  opMinMax(const opMinMax& source);
  opMinMax& operator=(const opMinMax& source);

  ClassInfo* GetClassInfo() override;
  ~opMinMax() override;
  /// Drops the source and starts afresh; returns true.
  bool Reset() override;

 protected:
  bool Prepare() override;
  bool Process() override;

 public:
  static opMinMax* Create();
  static ClassInfo& CI();

  using OpBase::Run;
  /// Searches from the values of both references and, on success, stores the results in them. Seeds
  /// beyond 32 bits count as the nearest 32-bit value. On failure the references stay.
  bool Run(dImage* source, long& minimum, long& maximum);
  bool Run(dImage* source, std::int32_t& minimum, std::int32_t& maximum);

  dImage* m_pSource = nullptr;  ///< input; not owned
  std::int32_t m_minimum;       ///< seed before, result after a run
  std::int32_t m_maximum;       ///< seed before, result after a run

 private:
  template <class T>
  bool Search();
};

}  // namespace vorl

#endif
