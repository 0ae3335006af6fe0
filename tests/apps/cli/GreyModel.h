#ifndef VORL_TESTS_APPS_CLI_GREYMODEL_H
#define VORL_TESTS_APPS_CLI_GREYMODEL_H

/// @file
/// What grey level each stored value must have, computed from the definition.

#include <vector>

namespace cli_test {

/// The levels of the stored values from 0 on, `count` of them: black below centre - width / 2 (half
/// a width cut off), then rising by 255 / width from 0.5 on, cut off to whole numbers; white from
/// the lower edge plus the width on. The rise is a repeated addition, which decides ties.
std::vector<int> WindowLevels(long centre, long width, int count);

/// The 256 entries of brightness, contrast and gamma.
std::vector<int> SecondStage(double brightness, double contrast, double gamma);

}  // namespace cli_test

#endif
