#ifndef VORL_TESTS_IO_BINARYFILETEST_H
#define VORL_TESTS_IO_BINARYFILETEST_H

#include <vorl/IO/BinaryDataIO.h>

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <functional>
#include <initializer_list>
#include <iterator>
#include <string>
#include <utility>
#include <vector>

#include "../Support/TestFolder.h"

using Bytes = std::vector<unsigned char>;

inline Bytes operator+(Bytes a, const Bytes& b) {
  a.insert(a.end(), b.begin(), b.end());
  return a;
}

/// A test with a file of its own, removed at the end.
class BinaryFileTest : public testing::Test {
 protected:
  const char* FileName() const { return m_path.c_str(); }

  void MakeFile(const Bytes& bytes) const {
    std::ofstream file(m_path, std::ios::binary);
    file.write(reinterpret_cast<const char*>(bytes.data()),
               static_cast<std::streamsize>(bytes.size()));
  }
  /// The header of a file of type "T", then the items.
  void MakeItems(const Bytes& items) const { MakeFile(Bytes{'B', 'D', 'F', 0, 'T', 0} + items); }

  /// Changes one byte of the file in place, which is much cheaper than to write it anew.
  void PatchFile(std::size_t position, unsigned char value) const {
    std::fstream file(m_path, std::ios::binary | std::ios::in | std::ios::out);
    file.seekp(static_cast<std::streamoff>(position));
    file.put(static_cast<char>(value));
  }

  Bytes FileBytes() const {
    std::ifstream file(m_path, std::ios::binary);
    return Bytes(std::istreambuf_iterator<char>(file), {});
  }
  /// What stands behind the header "BDF", "T".
  Bytes ItemBytes() const {
    const Bytes bytes = FileBytes();
    EXPECT_GE(bytes.size(), 6u);
    return Bytes(bytes.begin() + 6, bytes.end());
  }

  /// The items that `write` leaves in a file of type "T".
  Bytes Written(const std::function<void(BinaryDataOut&)>& write) const {
    BinaryDataOut out(FileName(), "T");
    write(out);
    EXPECT_TRUE(out.Finish());
    return ItemBytes();
  }

  const TestFolder m_folder;
  const std::string m_path = (m_folder / "file").string();
};

/// The code of the status that `action` throws; 0 when it throws nothing.
inline long ThrownCode(const std::function<void()>& action) {
  try {
    action();
  } catch (const dStatus& status) {
    return static_cast<long>(status);
  }
  return 0;
}

/// Reads items of a file of type "T".
class BinaryDataInTest : public BinaryFileTest {
 protected:
  /// The code thrown by `read` on a file of these items.
  long CodeOf(const Bytes& items, const std::function<void(BinaryDataIn&)>& read) const {
    MakeItems(items);
    BinaryDataIn in(FileName(), "T");
    return ThrownCode([&] { read(in); });
  }
};

#endif
