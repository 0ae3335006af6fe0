#ifndef VORL_TESTS_DATA_LUTTESTING_H
#define VORL_TESTS_DATA_LUTTESTING_H

#include <vorl/Data/dLUT.h>

#include <cstddef>
#include <vector>

/// A table that counts its computations and shows its mark.
template <class Table>
class CountingLUT : public Table {
 public:
  bool IsMarked() const { return this->m_recalculate; }
  void Mark() { this->m_recalculate = true; }
  bool Calculate() { return CalculateLUT(); }

  int calculations = 0;  ///< since construction

 protected:
  bool CalculateLUT() override {
    ++calculations;
    return Table::CalculateLUT();
  }
};

/// The entries of the first row.
inline std::vector<int> Entries(dLUT& table) {
  const unsigned char* entries = table.GetLUT(0);
  return std::vector<int>(entries, entries + table.GetSize());
}

#endif
