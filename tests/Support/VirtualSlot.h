#ifndef VORL_TESTS_SUPPORT_VIRTUALSLOT_H
#define VORL_TESTS_SUPPORT_VIRTUALSLOT_H

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <type_traits>

/// The place of a virtual function in its class's table, counted from 0. A virtual destructor takes
/// two places.
///
/// Under the C++ ABI of GCC, Clang and MinGW a pointer to a virtual member function begins with the
/// byte offset in the table, on most processors plus 1.
template <typename Member>
std::size_t VirtualSlot(Member member) {
  static_assert(std::is_member_function_pointer_v<Member>);
  std::uintptr_t offset = 0;
  static_assert(sizeof(member) >= sizeof(offset));
  std::memcpy(&offset, &member, sizeof(offset));
  return offset / sizeof(void*);
}

#endif
