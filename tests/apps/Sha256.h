#ifndef VORL_TESTS_APPS_SHA256_H
#define VORL_TESTS_APPS_SHA256_H

/// @file
/// The check sum in which tables of foreign test data tell what a file holds (FIPS 180-4).

#include <cstdint>
#include <string>

namespace study_test {

/// The SHA-256 sum of the bytes as 64 hexadecimal digits.
std::string Sha256(std::string bytes);

}  // namespace study_test

#endif
