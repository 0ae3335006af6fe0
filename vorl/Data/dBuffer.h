#ifndef VORL_DATA_DBUFFER_H
#define VORL_DATA_DBUFFER_H

/// @file
/// The block of raw bytes behind images, slice tables and file contents.

#include <vorl/Common/BaseClass.h>

#include <cstdint>

inline namespace vorl {

/// How bytes pass from one owner to another.
enum DataTransferMode : int {
  DTM_Copy = 1,      ///< the destination gets its own copy of the bytes
  DTM_TakeOver = 2,  ///< the destination takes the source's block; the source is left empty
  DTM_Reference = 3  ///< the destination points at the source's bytes without owning them
};

/// A block of bytes that the buffer owns, or a reference to memory that belongs to someone else.
///
/// An owned block is allocated in multiples of eight bytes (the capacity), so that fills work in
/// whole words. A buffer that refers to foreign memory has the capacity 0 and never frees it; the
/// memory must outlive the reference. An empty buffer has no data, size 0 and capacity 0.
///
/// Only allocation can fail. It then reports "can't allocate %d bytes", with the rounded byte
/// count, through the log and leaves the buffer empty; nothing is thrown. Test the buffer
/// (`operator bool`) after a call that allocates. Sizes are held in 32 bits: an own block whose
/// rounded size is 4 GiB - 8 or more, and a reference to 4 GiB or more, fail in the same way.
class VORL_API dBuffer : public DataBase {
 public:
  /// An empty buffer.
  dBuffer();
  /// `New(size, false)`: the bytes are not initialised.
  explicit dBuffer(unsigned long size);
  /// `Init(data, size, mode)`.
  dBuffer(void* data, unsigned long size, DataTransferMode mode);
  /// `Init(source, mode)`.
  dBuffer(dBuffer& source, DataTransferMode mode);
  /// `Init(source, mode)`: take-over copies, because a constant source cannot be emptied.
  dBuffer(const dBuffer& source, DataTransferMode mode);
  /// A deep copy, also of a reference.
  dBuffer(const dBuffer& source);
  /// A deep copy into the current block where it is large enough (see `New`), which for a reference
  /// means into the memory referred to. `source` may refer into this buffer's block.
  dBuffer& operator=(const dBuffer& source);

  ClassInfo* GetClassInfo() override;
  /// `Delete`.
  ~dBuffer() override;
  /// `Delete`.
  void Reset() override;
  /// True when the buffer has data.
  bool IsValid() override;

  static dBuffer* Create();
  static ClassInfo& CI();

  /// Gives the buffer `size` bytes. A block, own or referred to, that has room for them is kept and
  /// only the size changes; otherwise it is given up for a fresh one, and its contents are lost.
  /// `clear` zeroes the bytes (see `Set`); else a fresh block is not initialised. Size 0 keeps the
  /// block; an empty buffer stays empty.
  dBuffer& New(unsigned long size, bool clear);

  /// Fills the buffer from memory of the caller.
  ///
  /// `DTM_Copy` copies `size` bytes. `DTM_TakeOver` copies as well, for a raw pointer cannot be
  /// taken over. `DTM_Reference` refers to the memory. Any other mode, or a null pointer, leaves
  /// the buffer empty. When `data` is the buffer's own data pointer, nothing happens. `data` may
  /// lie inside the buffer's own block; a reference to that, which would outlive its block, becomes
  /// a copy.
  dBuffer& Init(void* data, unsigned long size, DataTransferMode mode);
  /// Fills the buffer from another one: copies its bytes, takes over its block with its ownership
  /// (the source is left empty), or refers to its bytes. Any other mode leaves the buffer empty.
  /// When `source` is this buffer, nothing happens. Where `source` refers into this buffer's own
  /// block, which ends here, every mode copies the bytes.
  dBuffer& Init(dBuffer& source, DataTransferMode mode);
  /// As above; take-over copies, because a constant source cannot be emptied.
  dBuffer& Init(const dBuffer& source, DataTransferMode mode);

  /// Changes the size and keeps the first bytes, as many as old and new size have in common. All
  /// bytes behind them up to the capacity become zero. A reference becomes an own copy, unless
  /// `size` is 0, which keeps it. After a failed allocation the contents are lost.
  dBuffer& Resize(unsigned long size);
  /// Frees an own block, forgets a referred one, and leaves the buffer empty. Returns true.
  bool Delete();

  /// `Init(source, DTM_TakeOver)`: this buffer takes the source's block.
  void operator<<=(dBuffer& source);
  /// `destination.Init(*this, DTM_TakeOver)`: this buffer hands its block over.
  void operator>>=(dBuffer& destination);

  /// Fills with a 32-bit pattern (the low 32 bits of the argument), repeated in the machine's byte
  /// order. An own block is filled to its size rounded up to a multiple of eight bytes; of foreign
  /// memory no byte beyond the size is touched.
  void Set(unsigned long pattern);
  void Set(unsigned int pattern);
  /// As above: a plain number, such as in `Set(0)`, is a 32-bit pattern.
  void Set(int pattern);
  /// Fills with a 16-bit value.
  void Set(unsigned short value);
  /// Fills with a byte.
  void Set(unsigned char value);

  /// The address of the byte at `offset`; null when `offset` is greater than the size. The size
  /// itself gives the end of the bytes.
  void* Get(unsigned long offset) const {
    return offset > m_size || m_data == nullptr ? nullptr : m_data + offset;
  }
  /// Bytes in use.
  unsigned long GetSize() const { return m_size; }
  /// Bytes allocated and owned, a multiple of 8; 0 for an empty buffer and for a reference.
  unsigned long GetCapacity() const;
  /// True when the buffer has bytes that belong to someone else.
  bool IsReference() const;
  /// True when the buffer has data.
  operator bool() const;

 protected:
  /// True when `address` lies in the block that this buffer owns.
  bool OwnsAddress(const void* address) const;

 private:
  void* Detach();
  void CopyBytes(const void* bytes, unsigned long size);
  void Refer(void* data, std::uint32_t size);

  unsigned char* m_data = nullptr;
  std::uint32_t m_size = 0;
  std::uint32_t m_capacity = 0;
};

}  // namespace vorl

#endif
