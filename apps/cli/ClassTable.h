#ifndef VORL_APPS_CLI_CLASSTABLE_H
#define VORL_APPS_CLI_CLASSTABLE_H

/// @file
/// A selection as a table of classes.

#include <cli/Selection.h>

#include <string>

namespace cli {

/// The histogram of the classes from the highest on, in at most 20 rows of equal, round width: the
/// real values from and to (both inclusive), the number of voxels, their share of all that were
/// counted, that share added up from the top, and how many of them are listed. A last line sums up.
std::string ClassTable(const Selection& selection);

}  // namespace cli

#endif
