#ifndef VORL_TESTS_SUPPORT_GUARDPAGES_H
#define VORL_TESTS_SUPPORT_GUARDPAGES_H

#include <cstddef>

/// A block of memory between two pages that nobody may touch: one byte too far ends the program.
///
/// That also finds what no sanitizer watches: the instructions that gather from a table of
/// addresses.
class GuardPages {
 public:
  /// Which page the block touches. Between it and the other one may lie up to a page of memory.
  enum class Side { Before, Behind };
  static constexpr Side kSides[] = {Side::Before, Side::Behind};

  /// `size` bytes; all of the memory is filled with `kFilling`. Throws std::bad_alloc.
  GuardPages(std::size_t size, Side side);
  GuardPages(const GuardPages&) = delete;
  GuardPages& operator=(const GuardPages&) = delete;
  ~GuardPages();

  static constexpr unsigned char kFilling = 0xA5;

  /// The block's first byte. Beside the page behind it, it is aligned as its size is.
  void* Data() const { return m_data; }

 private:
  unsigned char* m_pages;
  std::size_t m_pagesSize;
  unsigned char* m_data;
};

#endif
