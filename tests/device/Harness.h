#ifndef VORL_TESTS_DEVICE_HARNESS_H
#define VORL_TESTS_DEVICE_HARNESS_H

#include <cstdint>
#include <functional>
#include <string>

/// Numbers that are the same on every platform, from a seed.
class Random {
 public:
  explicit Random(std::uint32_t seed);
  std::uint32_t Next();
  int In(int low, int high);  ///< both included
  bool Flip();

 private:
  std::uint32_t m_state;
};

/// Draws one picture and prints one line: the name, what the scene reports, the check sums of its
/// pictures. The random numbers depend on the name alone. The options of the program decide whether
/// the scene is drawn at all.
void Scene(const std::string& name, const std::function<void(Random&)>& draw);

/// Add to the line of the running scene.
void Report(const char* key, long long value);
void ReportHex(const char* key, std::uint32_t value);
void ReportWord(const char* word);

/// Has the program been asked to print the pictures themselves?
bool IsDumping();

/// The usual check sum of 32 bits over bytes.
class CheckSum {
 public:
  void Add(std::uint8_t byte);
  std::uint32_t Get() const { return ~m_value; }

 private:
  std::uint32_t m_value = 0xFFFFFFFFU;
};

/// Runs the groups that the command line asks for.
int RunScenes(int argc, char** argv, const std::function<void()>& allGroups);

#endif
