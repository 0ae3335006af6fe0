#ifndef VORL_DATA_DLUT_H
#define VORL_DATA_DLUT_H

/// @file
/// The general lookup table.

#include <vorl/Data/dImage.h>

#include <cstdint>

inline namespace vorl {

/// The data type of a table's entries, coded like an `ImageDataType`. The library itself creates
/// tables of 8-bit unsigned entries only.
enum LUTType : std::int32_t { LUTType_U8 = ImageDataType_U8 };

/// Maps an integer sample value to an output value, one table per channel.
///
/// The entries lie in an image: one row per channel, one column per entry. Entry 0 stands for the
/// sample value `GetStartIndex()`. Tables are computed lazily: setters of derived classes mark the
/// table, and it is computed when its entries are fetched next.
class VORL_API dLUT : public DataBase {
 public:
  /// No table.
  dLUT();
  dLUT(const dLUT& source);
  /// Copies the table, its type, start index and mark.
  dLUT& operator=(const dLUT& source);

  ClassInfo* GetClassInfo() override;
  ~dLUT() override;
  /// Drops the table; type 8, start index 0.
  void Reset() override;
  /// True when there is a table.
  bool IsValid() override;
  /// Makes a table of `size` entries for each of `numChannels` channels and computes it. Fails with
  /// "LUT initialization error: " followed by the message of the table image.
  virtual bool Init(long size, LUTType type, int numChannels, long startIndex);

 protected:
  /// Computes the entries; here they become 0. Returns whether there is a table.
  virtual bool CalculateLUT();

 public:
  static dLUT* Create();
  static ClassInfo& CI();

  /// The entries of a channel, computed if need be; null without a table. The channel is not
  /// checked. Valid until the table is made anew.
  unsigned char* GetLUT(int channel);
  /// The table image, computed if need be. The mark stays until `GetLUT` is called, so until then
  /// each conversion computes again.
  operator dImage&();

  LUTType GetType() const;
  /// Entries per channel.
  long GetSize() const;
  long GetNumChannels() const;
  /// The sample value for which the first entry stands.
  long GetStartIndex() const;
  /// Bits per entry.
  int GetDataDepth() const;
  const dStatus& GetStatus() const;

 protected:
  dStatus m_status;
  dImage m_table;
  LUTType m_type = LUTType_U8;
  std::int32_t m_startIndex = 0;
  bool m_recalculate = false;  ///< the entries are out of date
};

}  // namespace vorl

#endif
