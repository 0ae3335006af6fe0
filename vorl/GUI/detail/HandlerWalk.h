#ifndef VORL_GUI_DETAIL_HANDLERWALK_H
#define VORL_GUI_DETAIL_HANDLERWALK_H

/// @file
/// Going through the list of a handler while anything may be deleted from it.

#include <vorl/GUI/GraphicHandler.h>

inline namespace vorl {

/// Keeps every object in its place.
class GraphicHandler::Walk {
 public:
  explicit Walk(GraphicHandler& handler) : m_handler(handler), m_end(handler.m_list.size()) {
    ++m_handler.m_walks;
  }
  Walk(const Walk&) = delete;
  Walk& operator=(const Walk&) = delete;
  ~Walk() {
    if (--m_handler.m_walks == 0) {
      std::erase_if(m_handler.m_list, [](const Entry& entry) { return entry.object == nullptr; });
    }
  }
  /// Behind the last place that there was at the start.
  std::size_t End() const { return m_end; }

 private:
  GraphicHandler& m_handler;
  std::size_t m_end;
};

}  // namespace vorl

#endif
