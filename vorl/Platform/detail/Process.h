#ifndef VORL_PLATFORM_DETAIL_PROCESS_H
#define VORL_PLATFORM_DETAIL_PROCESS_H

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

/// The system's identifier of this process.
std::uint32_t CurrentProcessId();

/// The system's identifier of the calling thread.
std::uint32_t CurrentThreadId();

}  // namespace vorl_detail
}  // namespace vorl

#endif
