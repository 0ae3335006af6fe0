// The forms in which every map of the plane takes points, vectors and rectangles.

#include <vorl/GUI/Trafo2D.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <type_traits>

#include <vorl/Platform/Gdi.h>

#include "RectTesting.h"
#include "TrafoTesting.h"

namespace {

using geometry_testing::Same;
using gui_testing::Same;

static_assert(std::is_abstract_v<Trafo2DBase>);
static_assert(std::has_virtual_destructor_v<Trafo2DBase>);

/// Four mappings that cannot be taken for one another, and mix x and y.
class Mixer : public Trafo2DBase {
 public:
  double factor = 1.0;

 protected:
  void _pA2B(double x, double y, double& xOut, double& yOut) override {
    xOut = factor * (x + 2.0 * y + 100.0);
    yOut = factor * (x - y + 200.0);
  }
  void _pB2A(double x, double y, double& xOut, double& yOut) override {
    xOut = factor * (x + 2.0 * y + 300.0);
    yOut = factor * (x - y + 400.0);
  }
  void _vA2B(double x, double y, double& xOut, double& yOut) override {
    xOut = factor * (x + 2.0 * y + 500.0);
    yOut = factor * (x - y + 600.0);
  }
  void _vB2A(double x, double y, double& xOut, double& yOut) override {
    xOut = factor * (x + 2.0 * y + 700.0);
    yOut = factor * (x - y + 800.0);
  }
};

/// All forms of one family (`pA2B`, `vB2A` ...) on the input (10, 3); the mapping adds the given
/// offset to 16 in x and to 107 in y.
#define EXPECT_ALL_FORMS(family, offset)                        \
  do {                                                          \
    Mixer trafo;                                                \
    const double wantX = 16.0 + (offset);                       \
    const double wantY = 107.0 + (offset);                      \
    double x = 10.0, y = 3.0, outX = 0.0, outY = 0.0;           \
    trafo.family(x, y, outX, outY);                             \
    EXPECT_EQ(outX, wantX);                                     \
    EXPECT_EQ(outY, wantY);                                     \
    EXPECT_EQ(x, 10.0);                                         \
    trafo.family(x, y);                                         \
    EXPECT_EQ(x, wantX);                                        \
    EXPECT_EQ(y, wantY);                                        \
    dVect2D in(10.0F, 3.0F), out, both(in);                     \
    trafo.family(in, out);                                      \
    EXPECT_TRUE(Same(out, wantX, wantY));                       \
    EXPECT_TRUE(Same(in, 10, 3));                               \
    trafo.family(dVect2D(10.0F, 3.0F), out = dVect2D());        \
    EXPECT_TRUE(Same(out, wantX, wantY));                       \
    trafo.family(in);                                           \
    EXPECT_TRUE(Same(in, wantX, wantY));                        \
    trafo.family(both, both);                                   \
    EXPECT_TRUE(Same(both, wantX, wantY));                      \
    /* Centres of pixels: 1.5 more in x, nothing in y. */       \
    const int pixelX = static_cast<int>(wantX + 1.5);           \
    const int pixelY = static_cast<int>(wantY);                 \
    long longX = 10, longY = 3, longOutX = 0, longOutY = 0;     \
    trafo.family(longX, longY, longOutX, longOutY);             \
    EXPECT_EQ(longOutX, pixelX);                                \
    EXPECT_EQ(longOutY, pixelY);                                \
    trafo.family(longX, longY);                                 \
    EXPECT_EQ(longX, pixelX);                                   \
    EXPECT_EQ(longY, pixelY);                                   \
    std::int32_t intX = 10, intY = 3, intOutX = 0, intOutY = 0; \
    trafo.family(intX, intY, intOutX, intOutY);                 \
    EXPECT_EQ(intOutX, pixelX);                                 \
    EXPECT_EQ(intOutY, pixelY);                                 \
    trafo.family(intX, intY);                                   \
    EXPECT_EQ(intX, pixelX);                                    \
    EXPECT_EQ(intY, pixelY);                                    \
    tagPOINT point = {10, 3}, pointOut = {};                    \
    trafo.family(point, pointOut);                              \
    EXPECT_EQ(pointOut.x, pixelX);                              \
    EXPECT_EQ(pointOut.y, pixelY);                              \
    EXPECT_EQ(point.x, 10);                                     \
    trafo.family(point);                                        \
    EXPECT_EQ(point.x, pixelX);                                 \
    EXPECT_EQ(point.y, pixelY);                                 \
  } while (false)

TEST(Trafo2DBase, MapsPointsForthInEveryForm) {
  EXPECT_ALL_FORMS(pA2B, 100.0);
}

TEST(Trafo2DBase, MapsPointsBackInEveryForm) {
  EXPECT_ALL_FORMS(pB2A, 300.0);
}

TEST(Trafo2DBase, MapsVectorsForthInEveryForm) {
  EXPECT_ALL_FORMS(vA2B, 500.0);
}

TEST(Trafo2DBase, MapsVectorsBackInEveryForm) {
  EXPECT_ALL_FORMS(vB2A, 700.0);
}

TEST(Trafo2DBase, MapsTheCornersOfRectanglesForth) {
  Mixer trafo;
  Rect2D in(10, 3, 1, 20), out;
  trafo.rA2B(in, out);
  EXPECT_TRUE(Same(out, 116, 207, 141, 181));
  EXPECT_TRUE(Same(in, 10, 3, 1, 20));
  out.Reset();
  trafo.rA2B(Rect2D(10, 3, 1, 20), out);
  EXPECT_TRUE(Same(out, 116, 207, 141, 181));
  trafo.rA2B(in);
  EXPECT_TRUE(Same(in, 116, 207, 141, 181));
}

TEST(Trafo2DBase, MapsTheCornersOfRectanglesBack) {
  Mixer trafo;
  Rect2D in(10, 3, 1, 20), out;
  trafo.rB2A(in, out);
  EXPECT_TRUE(Same(out, 316, 407, 341, 381));
  EXPECT_TRUE(Same(in, 10, 3, 1, 20));
  out.Reset();
  trafo.rB2A(Rect2D(10, 3, 1, 20), out);
  EXPECT_TRUE(Same(out, 316, 407, 341, 381));
  trafo.rB2A(in);
  EXPECT_TRUE(Same(in, 316, 407, 341, 381));
}

TEST(Trafo2DBase, MirroredRectanglesAreNotNormalised) {
  Scale2D mirror(-1.0, -1.0, 0.0, 0.0);
  Rect2D rect(1, 2, 3, 4);
  mirror.rA2B(rect);
  EXPECT_TRUE(Same(rect, -1, -2, -3, -4));
  mirror.rB2A(rect);
  EXPECT_TRUE(Same(rect, 1, 2, 3, 4));
}

void ExpectEdges(const tagRECT& rect, int left, int top, int right, int bottom) {
  EXPECT_EQ(rect.left, left);
  EXPECT_EQ(rect.top, top);
  EXPECT_EQ(rect.right, right);
  EXPECT_EQ(rect.bottom, bottom);
}

TEST(Trafo2DBase, MapsIntegerRectanglesByTheCentresOfTheirCorners) {
  Mixer trafo;
  const tagRECT in = {10, 3, 1, 20};
  tagRECT out = {};
  trafo.rA2B(in, out);
  ExpectEdges(out, 117, 207, 142, 181);
  trafo.rB2A(in, out);
  ExpectEdges(out, 317, 407, 342, 381);
  tagRECT rect = in;
  trafo.rA2B(rect);
  ExpectEdges(rect, 117, 207, 142, 181);
  rect = in;
  trafo.rB2A(rect);
  ExpectEdges(rect, 317, 407, 342, 381);
}

TEST(Trafo2DBase, APixelIsMappedByItsCentreAndCutOff) {
  Scale2D scale(3.0, 5.0, 0.0, 0.0);
  tagPOINT point = {0, 0};
  scale.pA2B(point);  // (0.5, 0.5) becomes (1.5, 2.5)
  EXPECT_EQ(point.x, 1);
  EXPECT_EQ(point.y, 2);
}

TEST(Trafo2DBase, DecimalsAreCutTowardsZero) {
  Translate2D trafo(-1.4, -2.4);
  tagPOINT point = {0, 0};
  trafo.pA2B(point);  // (-0.9, -1.9)
  EXPECT_EQ(point.x, 0);
  EXPECT_EQ(point.y, -1);
}

TEST(Trafo2DBase, IntegerVectorsAreMovedToTheCentreToo) {
  Scale2D scale(4.0, 4.0, 0.0, 0.0);
  long x = 0, y = -1;
  scale.vA2B(x, y);
  EXPECT_EQ(x, 2);
  EXPECT_EQ(y, -2);
}

TEST(Trafo2DBase, IntegersOfTheIdentityStay) {
  Translate2D identity;
  for (const std::int32_t value : {0, 1, 1000, std::numeric_limits<std::int32_t>::max()}) {
    std::int32_t x = value, y = value;
    identity.pA2B(x, y);
    EXPECT_EQ(x, value);
    EXPECT_EQ(y, value);
  }
}

TEST(Trafo2DBase, ResultsBeyondTheRangeGiveItsLimits) {
  Mixer trafo;
  for (const double factor : {1e10, 1e100, std::numeric_limits<double>::infinity()}) {
    trafo.factor = factor;
    tagPOINT point = {1, 1};
    trafo.pA2B(point);
    EXPECT_EQ(point.x, std::numeric_limits<LONG>::max());
    std::int32_t x = 1, y = 1;
    trafo.factor = -factor;
    trafo.pA2B(x, y);
    EXPECT_EQ(x, std::numeric_limits<std::int32_t>::min());
    EXPECT_EQ(y, std::numeric_limits<std::int32_t>::min());
  }
  trafo.factor = 1e100;
  long longX = 1, longY = 1;
  trafo.pA2B(longX, longY);
  EXPECT_EQ(longX, std::numeric_limits<long>::max());
  trafo.factor = -1e100;
  longX = longY = 1;
  trafo.pA2B(longX, longY);
  EXPECT_EQ(longY, std::numeric_limits<long>::min());
}

TEST(Trafo2DBase, TheLimitsThemselvesAreReached) {
  constexpr std::int32_t kLargest = std::numeric_limits<std::int32_t>::max();
  constexpr std::int32_t kLowest = std::numeric_limits<std::int32_t>::min();
  std::int32_t x = kLargest, y = kLowest;
  Translate2D(0.25, -1.25).pA2B(x, y);  // 2147483647.75 and -2147483648.75 are cut off to them
  EXPECT_EQ(x, kLargest);
  EXPECT_EQ(y, kLowest);
  x = kLargest;
  y = kLowest;
  Translate2D(0.5, -1.5).pA2B(x, y);  // one beyond each
  EXPECT_EQ(x, kLargest);
  EXPECT_EQ(y, kLowest);
  x = kLargest;
  y = kLowest;
  Translate2D(-1.0, 0.5).pA2B(x, y);
  EXPECT_EQ(x, kLargest - 1);
  EXPECT_EQ(y, kLowest + 1);
}

TEST(Trafo2DBase, WhatIsNotANumberGivesZero) {
  Mixer trafo;
  trafo.factor = std::numeric_limits<double>::quiet_NaN();
  tagRECT rect = {1, 2, 3, 4};
  trafo.rA2B(rect);
  ExpectEdges(rect, 0, 0, 0, 0);
  long x = 5, y = 6;
  trafo.vB2A(x, y);
  EXPECT_EQ(x, 0);
  EXPECT_EQ(y, 0);
}

/// Changes the virtual form of mapping points.
class Snapping : public Translate2D {
 public:
  using Trafo2DBase::pA2B;
  void pA2B(dVect2D& /*in*/, dVect2D& out) override { out.Set(7, 8); }
};

TEST(Trafo2DBase, TheOtherFloatFormsFollowTheVirtualOne) {
  Snapping trafo;
  dVect2D v(1.0F, 2.0F);
  trafo.pA2B(v);
  EXPECT_TRUE(Same(v, 7, 8));
  trafo.pA2B(dVect2D(1.0F, 2.0F), v = dVect2D());
  EXPECT_TRUE(Same(v, 7, 8));
  Rect2D rect(1, 2, 3, 4);
  trafo.rA2B(rect);
  EXPECT_TRUE(Same(rect, 7, 8, 7, 8));
}

}  // namespace
