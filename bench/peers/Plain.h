#ifndef BENCH_PEERS_PLAIN_H
#define BENCH_PEERS_PLAIN_H

/// @file
/// What the plain loops share, and the functions that set the pace.

#include <memory>
#include <utility>

#include "Contest.h"
#include "TestData.h"

namespace peers {

/// Memory for a result, which the contender keeps.
template <class T>
std::shared_ptr<Samples<T>> MakeSamples(std::size_t count) {
  return std::make_shared<Samples<T>>(count);
}

/// A loop that cannot fail.
template <class Loop, class Check>
void EnterLoop(const Work& work, Loop loop, Check check) {
  Enter(work, "plain", [=] {
    return Contender{[=] {
                       loop();
                       return true;
                     },
                     check};
  });
}

/// As many bytes copied as the work reads: as many are written, too.
void EnterMemcpy(const Work& work, const void* source, std::size_t bytes);
/// The bytes that the work reads, folded into one word: nothing is written.
void EnterRead(const Work& work, const void* source, std::size_t bytes);
/// As many bytes set as the work writes.
void EnterMemset(const Work& work, std::size_t bytes);

}  // namespace peers

#endif
