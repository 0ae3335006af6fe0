#ifndef VORL_DATA_DBCGLUT_H
#define VORL_DATA_DBCGLUT_H

/// @file
/// Brightness, contrast and gamma for 8-bit samples.

#include <vorl/Data/dLUT.h>

inline namespace vorl {

/// A table of 256 8-bit entries that applies brightness, contrast and gamma.
///
/// The entries lie on a line whose angle the contrast turns from 0 (-1) over 45 (0) to 90 degrees
/// (1) and whose place the brightness moves; gamma then bends the part between its ends. With the
/// defaults the table is deliberately not the exact identity: pi counts as 3.141592, and the
/// entries of the upper half lie one below their index.
class VORL_API dBCGLUT : public dLUT {
 public:
  /// Brightness 0, contrast 0, gamma 1, table computed.
  dBCGLUT();
  dBCGLUT(const dBCGLUT& source);
  dBCGLUT& operator=(const dBCGLUT& source);

  ClassInfo* GetClassInfo() override;
  ~dBCGLUT() override;
  /// Sets brightness 0, contrast 0 and gamma 1; the table storage is kept.
  void Reset() override;

  static dBCGLUT* Create();
  static ClassInfo& CI();

  /// Clamped to [-1, 1]; a value that is not a number is ignored.
  void SetBrightness(double brightness);
  /// Clamped to [-1, 1]; a value that is not a number is ignored.
  void SetContrast(double contrast);
  /// Clamped to [0.01, 10]; a value that is not a number is ignored.
  void SetGamma(double gamma);
  void SetBCG(double brightness, double contrast, double gamma);
  /// Adds to the three values, which saturate at the ends of their ranges.
  void SetBCGRelative(double brightness, double contrast, double gamma);
  double GetBrightness() const;
  double GetContrast() const;
  double GetGamma() const;

 protected:
  /// Refuses: the format is fixed. Sets "Don't call 'Init' for a 'dBCGLUT' object. It has been
  /// initialized during construction" and returns false.
  bool Init(long size, LUTType type, int numChannels, long startIndex) override;
  /// Computes the entries. When the table image was made smaller or reset from outside: "BCG LUT is
  /// not initialized" and false, with nothing written.
  bool CalculateLUT() override;

 private:
  void SetValue(double& field, double value, double low, double high);
  void ApplyGamma(unsigned char* entries, int first, int last, double low, double high) const;

  double m_brightness = 0.0;
  double m_contrast = 0.0;
  double m_gamma = 1.0;
};

}  // namespace vorl

#endif
