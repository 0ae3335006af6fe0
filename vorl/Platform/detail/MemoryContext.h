#ifndef VORL_PLATFORM_DETAIL_MEMORYCONTEXT_H
#define VORL_PLATFORM_DETAIL_MEMORYCONTEXT_H

#include <vorl/Platform/Gdi.h>

inline namespace vorl {
namespace vorl_detail {

/// A memory device context with a bitmap selected, for the length of a scope.
class MemoryContext {
 public:
  /// Compatible with `model`, or with the screen where that is null.
  MemoryContext(HDC model, HGDIOBJ bitmap)
      : m_dc(CreateCompatibleDC(model)), m_first(SelectObject(m_dc, bitmap)) {}
  MemoryContext(const MemoryContext&) = delete;
  MemoryContext& operator=(const MemoryContext&) = delete;
  ~MemoryContext() {
    if (HasBitmap()) {
      SelectObject(m_dc, m_first);
    }
    DeleteDC(m_dc);
  }

  HDC Get() const { return m_dc; }
  /// False when the bitmap could not be selected, because another context has it, for example.
  bool HasBitmap() const { return m_first != nullptr; }
  /// Selects another bitmap in place of the first.
  void Select(HGDIOBJ bitmap) { SelectObject(m_dc, bitmap); }

 private:
  HDC m_dc;
  HGDIOBJ m_first;  ///< what the context had selected when it was made
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
