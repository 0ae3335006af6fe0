// What moves as many bytes as a work does, and nothing more.
#include <algorithm>
#include <cstring>
#include <functional>
#include <numeric>

#include "Plain.h"

namespace peers {
namespace {

/// Four pages at a time: more arrives when the processor follows several of them.
std::uint64_t FoldPages(const std::uint64_t* words, std::size_t count) {
  constexpr std::size_t kPage = 4096 / sizeof(std::uint64_t);
  std::uint64_t word[4] = {};
  std::size_t i = 0;
  for (; i + 4 * kPage <= count; i += 4 * kPage) {
    for (const std::uint64_t* p = words + i; p < words + i + kPage; ++p) {
      word[0] ^= p[0];
      word[1] ^= p[kPage];
      word[2] ^= p[2 * kPage];
      word[3] ^= p[3 * kPage];
    }
  }
  const std::uint64_t folded = word[0] ^ word[1] ^ word[2] ^ word[3];
  return std::accumulate(words + i, words + count, folded, std::bit_xor<>());
}

}  // namespace

void EnterMemcpy(const Work& work, const void* source, std::size_t bytes) {
  Enter(work, "memcpy", [=] {
    const auto target = MakeSamples<std::uint8_t>(bytes);
    return Contender{[=] {
                       std::memcpy(target->data(), source, bytes);
                       return true;
                     },
                     [=] {
                       const bool isEqual = std::memcmp(target->data(), source, bytes) == 0;
                       return isEqual ? "" : "wrong: not copied";
                     }};
  });
}

void EnterRead(const Work& work, const void* source, std::size_t bytes) {
  Enter(work, "read", [=] {
    const auto folded = std::make_shared<std::uint64_t>();
    const auto* const words = static_cast<const std::uint64_t*>(source);
    const std::size_t count = bytes / sizeof(std::uint64_t);
    return Contender{[=] {
                       *folded = FoldPages(words, count);
                       return true;
                     },
                     [=] {
                       const std::uint64_t expected = std::accumulate(
                           words, words + count, std::uint64_t{0}, std::bit_xor<>());
                       return *folded == expected ? "" : "wrong: another word";
                     }};
  });
}

void EnterMemset(const Work& work, std::size_t bytes) {
  static constexpr std::uint8_t kByte = 0x55;
  Enter(work, "memset", [=] {
    const auto target = MakeSamples<std::uint8_t>(bytes);
    return Contender{[=] {
                       std::memset(target->data(), kByte, bytes);
                       return true;
                     },
                     [=] {
                       const bool isSet =
                           std::all_of(target->begin(), target->end(),
                                       [](std::uint8_t byte) { return byte == kByte; });
                       return isSet ? "" : "wrong: not set";
                     }};
  });
}

}  // namespace peers
