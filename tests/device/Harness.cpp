#include "Harness.h"

#include <cstdio>
#include <string>

namespace {

struct Options {
  std::string group;
  std::string only;
  std::string dump;
  bool list = false;
};

Options options;
std::string line;

bool IsWanted(const std::string& name) {
  if (!options.group.empty() &&
      name.compare(0, options.group.size() + 1, options.group + "/") != 0) {
    return false;
  }
  return (options.only.empty() || name == options.only) &&
         (options.dump.empty() || name == options.dump);
}

std::uint32_t SeedOf(const std::string& name) {
  std::uint32_t hash = 2166136261U;
  for (const char c : name) {
    hash ^= static_cast<std::uint8_t>(c);
    hash *= 16777619U;
  }
  return hash;
}

bool ReadOption(const std::string& option, const std::string& value, int* index) {
  if (option == "--list") {
    options.list = true;
    return true;
  }
  std::string* target = option == "--group"  ? &options.group
                        : option == "--only" ? &options.only
                        : option == "--dump" ? &options.dump
                                             : nullptr;
  if (target == nullptr || value.empty()) {
    return false;
  }
  *target = value;
  ++*index;
  return true;
}

}  // namespace

Random::Random(std::uint32_t seed) : m_state(seed != 0 ? seed : 0x1234567U) {
  for (int i = 0; i < 6; ++i) {
    Next();
  }
}

std::uint32_t Random::Next() {
  m_state ^= m_state << 13U;
  m_state ^= m_state >> 17U;
  m_state ^= m_state << 5U;
  return m_state;
}

int Random::In(int low, int high) {
  return low + static_cast<int>((Next() >> 4U) % static_cast<std::uint32_t>(high - low + 1));
}

bool Random::Flip() {
  return ((Next() >> 9U) & 1U) != 0;
}

void CheckSum::Add(std::uint8_t byte) {
  m_value ^= byte;
  for (int bit = 0; bit < 8; ++bit) {
    m_value = (m_value >> 1U) ^ (0xEDB88320U & (0U - (m_value & 1U)));
  }
}

void Scene(const std::string& name, const std::function<void(Random&)>& draw) {
  if (!IsWanted(name)) {
    return;
  }
  if (options.list) {
    std::printf("%s\n", name.c_str());
    return;
  }
  line = name;
  Random random(SeedOf(name));
  draw(random);
  std::printf("%s\n", line.c_str());
  std::fflush(stdout);
}

void Report(const char* key, long long value) {
  line += ' ';
  line += key;
  line += '=';
  line += std::to_string(value);
}

void ReportHex(const char* key, std::uint32_t value) {
  char text[64];
  std::snprintf(text, sizeof text, " %s=%08x", key, static_cast<unsigned>(value));
  line += text;
}

void ReportWord(const char* word) {
  line += ' ';
  line += word;
}

bool IsDumping() {
  return !options.dump.empty();
}

int RunScenes(int argc, char** argv, const std::function<void()>& allGroups) {
  bool failed = false;
  for (int i = 1; i < argc; ++i) {
    failed |= !ReadOption(argv[i], i + 1 < argc ? argv[i + 1] : "", &i);
  }
  if (failed) {
    std::fprintf(
        stderr, "usage: vorl_device_scenes [--list] [--group GROUP] [--only NAME] [--dump NAME]\n");
    return 2;
  }
  allGroups();
  return 0;
}
