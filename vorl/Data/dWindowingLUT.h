#ifndef VORL_DATA_DWINDOWINGLUT_H
#define VORL_DATA_DWINDOWINGLUT_H

/// @file
/// The display window: 16-bit samples to 8-bit grey levels.

#include <vorl/Data/dBCGLUT.h>

inline namespace vorl {

/// A table of 65,536 8-bit entries that maps samples through a window.
///
/// Samples below the window become the lower limit, samples at or above its upper edge the upper
/// limit, and those inside rise from the low to the high target value, optionally through a
/// brightness/contrast/gamma table. The window reaches from centre - width / 2 up to, but not
/// including, that plus the width.
class VORL_API dWindowingLUT : public dLUT {
 public:
  /// Unsigned samples, centre 32768, width 65536, target and limits 0 to 255; table computed.
  dWindowingLUT();
  /// Copies the table and all parameters; an attached second stage is shared.
  dWindowingLUT(const dWindowingLUT& source);
  dWindowingLUT& operator=(const dWindowingLUT& source);

  ClassInfo* GetClassInfo() override;
  ~dWindowingLUT() override;
  /// Restores the default parameters and sets all entries to 0: they stay so until a setter changes
  /// something.
  void Reset() override;

  static dWindowingLUT* Create();
  static ClassInfo& CI();

  /// In sample units. The next computation clamps the centre to [-32768, 32767] for signed samples
  /// and [0, 65536] for unsigned ones, and the width to [2, 65536].
  void SetWinCenter(int center);
  void SetWinWidth(int width);
  void SetWindow(int center, int width);
  /// The output at the window's lower and upper edge; high may be below low.
  void SetTargetRange(unsigned char low, unsigned char high);
  /// The output below and at or above the window; not passed through the second stage.
  void SetLimits(unsigned char lower, unsigned char upper);
  /// Whether samples are signed 16-bit; the first entry then stands for -32768.
  void SetSignedSource(bool isSigned);
  /// Attaches a second stage, which the caller owns and keeps alive; null detaches. A later change
  /// of the second stage shows when this table is computed next.
  void SetBCGLUT(dBCGLUT* lut);
  int GetWinCenter() const;
  int GetWinWidth() const;
  void GetTargetRange(unsigned char& low, unsigned char& high) const;
  void GetLimits(unsigned char& lower, unsigned char& upper) const;

 protected:
  /// Refuses: the format is fixed. Sets "Don't call 'Init' for a 'dWindowingLUT' object. It has
  /// been initialized during construction" and returns false.
  bool Init(long size, LUTType type, int numChannels, long startIndex) override;
  bool CalculateLUT() override;

 private:
  template <class T>
  void SetValue(T& field, T value);
  const unsigned char* FetchSecondStage() const;

  std::int32_t m_center = 32768;
  std::int32_t m_width = 65536;
  bool m_signedSource = false;
  std::uint8_t m_targetLow = 0;
  std::uint8_t m_targetHigh = 255;
  std::uint8_t m_lowerLimit = 0;
  std::uint8_t m_upperLimit = 255;
  dBCGLUT* m_pBCGLUT = nullptr;
};

}  // namespace vorl

#endif
