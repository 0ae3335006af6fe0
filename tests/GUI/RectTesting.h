#ifndef TESTS_GUI_RECTTESTING_H
#define TESTS_GUI_RECTTESTING_H

/// @file
/// Exact comparison of rectangles.

#include <vorl/GUI/Rect2D.h>

#include <gtest/gtest.h>

#include "../Data/GeometryTesting.h"

namespace gui_testing {

/// The same bits in all four coordinates, which `==` of rectangles does not ask for.
inline ::testing::AssertionResult Same(const Rect2D& rect, double x1, double y1, double x2,
                                       double y2) {
  const auto topLeft = geometry_testing::Same(rect.GetTL(), x1, y1);
  return topLeft ? geometry_testing::Same(rect.GetBR(), x2, y2) << " at the bottom right" : topLeft;
}

}  // namespace gui_testing

#endif
