#include "Sha256.h"

#include <array>
#include <bit>
#include <cmath>
#include <cstdio>

namespace study_test {
namespace {

/// The first 32 bits of the fractional part of a root.
std::uint32_t FractionOf(double root) {
  return static_cast<std::uint32_t>((root - std::floor(root)) * 4294967296.0);
}

bool IsPrime(int number) {
  for (int divisor = 2; divisor * divisor <= number; ++divisor) {
    if (number % divisor == 0) {
      return false;
    }
  }
  return true;
}

struct Constants {
  std::array<std::uint32_t, 64> round{};
  std::array<std::uint32_t, 8> start{};

  Constants() {
    std::size_t count = 0;
    for (int number = 2; count < 64; ++number) {
      if (IsPrime(number)) {
        round[count] = FractionOf(std::cbrt(number));
        if (count < 8) {
          start[count] = FractionOf(std::sqrt(number));
        }
        ++count;
      }
    }
  }
};

using State = std::array<std::uint32_t, 8>;

void Compress(State& state, const std::string& bytes, std::size_t at, const Constants& constants) {
  std::array<std::uint32_t, 64> w{};
  for (std::size_t i = 0; i < 64; ++i) {
    if (i < 16) {
      for (std::size_t b = 0; b < 4; ++b) {
        w[i] = w[i] << 8 | static_cast<unsigned char>(bytes[at + 4 * i + b]);
      }
      continue;
    }
    const auto s0 = std::rotr(w[i - 15], 7) ^ std::rotr(w[i - 15], 18) ^ (w[i - 15] >> 3);
    const auto s1 = std::rotr(w[i - 2], 17) ^ std::rotr(w[i - 2], 19) ^ (w[i - 2] >> 10);
    w[i] = w[i - 16] + s0 + w[i - 7] + s1;
  }
  auto [a, b, c, d, e, f, g, h] = state;
  for (std::size_t i = 0; i < 64; ++i) {
    const auto s1 = std::rotr(e, 6) ^ std::rotr(e, 11) ^ std::rotr(e, 25);
    const auto t1 = h + s1 + ((e & f) ^ (~e & g)) + constants.round[i] + w[i];
    const auto s0 = std::rotr(a, 2) ^ std::rotr(a, 13) ^ std::rotr(a, 22);
    const auto t2 = s0 + ((a & b) ^ (a & c) ^ (b & c));
    h = g;
    g = f;
    f = e;
    e = d + t1;
    d = c;
    c = b;
    b = a;
    a = t1 + t2;
  }
  const State added{a, b, c, d, e, f, g, h};
  for (std::size_t i = 0; i < 8; ++i) {
    state[i] += added[i];
  }
}

}  // namespace

std::string Sha256(std::string bytes) {
  static const Constants constants;
  const std::uint64_t bits = std::uint64_t{bytes.size()} * 8;
  bytes += static_cast<char>(0x80);
  bytes.append((120 - bytes.size() % 64) % 64, '\0');
  for (int shift = 56; shift >= 0; shift -= 8) {
    bytes += static_cast<char>(bits >> shift & 0xFF);
  }
  State state = constants.start;
  for (std::size_t at = 0; at < bytes.size(); at += 64) {
    Compress(state, bytes, at, constants);
  }
  std::string text;
  for (const std::uint32_t word : state) {
    char digits[9];
    std::snprintf(digits, sizeof digits, "%08x", word);
    text += digits;
  }
  return text;
}

}  // namespace study_test
