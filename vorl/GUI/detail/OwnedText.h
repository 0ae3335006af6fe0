#ifndef VORL_GUI_DETAIL_OWNEDTEXT_H
#define VORL_GUI_DETAIL_OWNEDTEXT_H

/// @file
/// Texts that objects keep for themselves.

#include <new>
#include <string>

inline namespace vorl {
namespace vorl_detail {

/// A copy of a text; empty for null. One that finds no memory is dropped: the numbers beside it are
/// what matters.
inline std::string TextOf(const char* text) noexcept {
  try {
    return text != nullptr ? text : "";
  } catch (const std::bad_alloc&) {
    return {};
  }
}

}  // namespace vorl_detail
}  // namespace vorl

#endif
