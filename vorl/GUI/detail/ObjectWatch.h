#ifndef VORL_GUI_DETAIL_OBJECTWATCH_H
#define VORL_GUI_DETAIL_OBJECTWATCH_H

/// @file
/// Telling, after a call that may have destroyed an object, whether it has.

#include <vorl/GUI/VGObjectView.h>

inline namespace vorl {

/// Stands on the stack around such calls; several may watch one object, the last comes down first.
class VGObjectView::Watch {
 public:
  explicit Watch(VGObjectView& object) : m_object(&object), m_outer(object.m_watch) {
    object.m_watch = this;
  }
  Watch(const Watch&) = delete;
  Watch& operator=(const Watch&) = delete;
  ~Watch() {
    if (m_object != nullptr) {
      m_object->m_watch = m_outer;
    }
  }

  bool IsGone() const { return m_object == nullptr; }
  /// The object of these watches ends.
  static void End(Watch* watch) {
    for (; watch != nullptr; watch = watch->m_outer) {
      watch->m_object = nullptr;
    }
  }

 private:
  VGObjectView* m_object;  ///< null once it is gone
  Watch* m_outer;
};

}  // namespace vorl

#endif
