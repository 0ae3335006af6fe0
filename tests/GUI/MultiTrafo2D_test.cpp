#include <vorl/GUI/Trafo2D.h>

#include <gtest/gtest.h>

#include "TrafoTesting.h"

namespace {

using geometry_testing::Numbers;
using gui_testing::Is;
using gui_testing::IsUndone;
using gui_testing::NextScale;
using gui_testing::PointA2B;
using gui_testing::PointB2A;
using gui_testing::VectorA2B;
using gui_testing::VectorB2A;

TEST(MultiTrafo2D, AnEmptyChainIsTheIdentity) {
  MultiTrafo2D chain;
  EXPECT_TRUE(Is(PointA2B(chain, 3, 4), 3, 4));
  EXPECT_TRUE(Is(PointB2A(chain, 3, 4), 3, 4));
  EXPECT_TRUE(Is(VectorA2B(chain, 3, 4), 3, 4));
  EXPECT_TRUE(Is(VectorB2A(chain, 3, 4), 3, 4));
}

TEST(MultiTrafo2D, AppliesItsMembersInTheOrderOfAddition) {
  Translate2D translate(10, 20);
  Scale2D scale(2, 4, 0, 0);
  MultiTrafo2D first, second;
  EXPECT_TRUE(first.AddTransformation(&translate));
  EXPECT_TRUE(first.AddTransformation(&scale));
  EXPECT_TRUE(second.AddTransformation(&scale));
  EXPECT_TRUE(second.AddTransformation(&translate));
  EXPECT_TRUE(Is(PointA2B(first, 1, 1), 22, 84));
  EXPECT_TRUE(Is(PointA2B(second, 1, 1), 12, 24));
  EXPECT_TRUE(Is(VectorA2B(first, 1, 1), 2, 4));
}

TEST(MultiTrafo2D, GoesBackFromTheLastToTheFirst) {
  Translate2D translate(10, 20);
  Scale2D scale(2, 4, 0, 0);
  MultiTrafo2D chain;
  chain.AddTransformation(&translate);
  chain.AddTransformation(&scale);
  EXPECT_TRUE(Is(PointB2A(chain, 22, 84), 1, 1));
  EXPECT_TRUE(Is(VectorB2A(chain, 2, 4), 1, 1));
}

/// Directions in which order matters for vectors too: a quarter turn, exactly, and back.
class QuarterTurn : public Trafo2DBase {
 protected:
  void _pA2B(double x, double y, double& xOut, double& yOut) override { Turn(x, y, xOut, yOut); }
  void _pB2A(double x, double y, double& xOut, double& yOut) override { Turn(-x, -y, xOut, yOut); }
  void _vA2B(double x, double y, double& xOut, double& yOut) override { Turn(x, y, xOut, yOut); }
  void _vB2A(double x, double y, double& xOut, double& yOut) override { Turn(-x, -y, xOut, yOut); }

 private:
  static void Turn(double x, double y, double& xOut, double& yOut) {
    xOut = -y;
    yOut = x;
  }
};

TEST(MultiTrafo2D, KeepsTheOrderForVectors) {
  QuarterTurn turn;
  Scale2D scale(2, 4, 100, 100);
  MultiTrafo2D chain;
  chain.AddTransformation(&turn);
  chain.AddTransformation(&scale);
  EXPECT_TRUE(Is(VectorA2B(chain, 1, 3), -6, 4));
  EXPECT_TRUE(Is(VectorB2A(chain, -6, 4), 1, 3));
}

TEST(MultiTrafo2D, MembersMayRepeatAndChange) {
  Translate2D translate(10, 20);
  MultiTrafo2D chain;
  chain.AddTransformation(&translate);
  EXPECT_TRUE(chain.AddTransformation(&translate));
  EXPECT_TRUE(Is(PointA2B(chain, 0, 0), 20, 40));
  translate = Translate2D(1, 2);
  EXPECT_TRUE(Is(PointA2B(chain, 0, 0), 2, 4));
}

TEST(MultiTrafo2D, IgnoresNull) {
  MultiTrafo2D chain;
  EXPECT_FALSE(chain.AddTransformation(nullptr));
  EXPECT_TRUE(Is(PointA2B(chain, 3, 4), 3, 4));
}

TEST(MultiTrafo2D, ResetEmptiesTheChain) {
  Translate2D translate(10, 20);
  MultiTrafo2D chain;
  chain.AddTransformation(&translate);
  chain.Reset();
  EXPECT_TRUE(Is(PointA2B(chain, 3, 4), 3, 4));
}

/// Tells its end.
class Mortal : public Translate2D {
 public:
  explicit Mortal(bool& isGone) : m_isGone(isGone) {}
  ~Mortal() override { m_isGone = true; }

 private:
  bool& m_isGone;
};

TEST(MultiTrafo2D, DoesNotOwnItsMembers) {
  bool isGone = false;
  {
    Mortal member(isGone);
    {
      MultiTrafo2D chain;
      chain.AddTransformation(&member);
      chain.Reset();
      chain.AddTransformation(&member);
    }
    EXPECT_FALSE(isGone);
  }
  EXPECT_TRUE(isGone);
}

TEST(MultiTrafo2D, CopiesNameTheSameMembers) {
  Translate2D translate(10, 20), other(1, 1);
  MultiTrafo2D source, assigned;
  source.AddTransformation(&translate);
  assigned.AddTransformation(&other);
  MultiTrafo2D copy(source);
  EXPECT_EQ(&(assigned = source), &assigned);
  source.Reset();
  EXPECT_TRUE(Is(PointA2B(copy, 0, 0), 10, 20));
  EXPECT_TRUE(Is(PointA2B(assigned, 0, 0), 10, 20));
  const MultiTrafo2D& same = assigned;
  assigned = same;
  EXPECT_TRUE(Is(PointA2B(assigned, 0, 0), 10, 20));
}

TEST(MultiTrafo2D, ChainsMayBeMembers) {
  Translate2D translate(10, 20);
  Scale2D scale(2, 4, 0, 0);
  MultiTrafo2D inner, outer;
  inner.AddTransformation(&translate);
  EXPECT_TRUE(outer.AddTransformation(&inner));
  EXPECT_TRUE(outer.AddTransformation(&scale));
  EXPECT_TRUE(outer.AddTransformation(&inner));
  EXPECT_TRUE(Is(PointA2B(outer, 1, 1), 32, 104));
  EXPECT_TRUE(Is(PointB2A(outer, 32, 104), 1, 1));
}

TEST(MultiTrafo2D, NoChainLeadsBackToItself) {
  Translate2D translate(10, 20);
  MultiTrafo2D inner, middle, outer;
  EXPECT_FALSE(inner.AddTransformation(&inner));
  middle.AddTransformation(&inner);
  outer.AddTransformation(&middle);
  outer.AddTransformation(&translate);
  EXPECT_FALSE(inner.AddTransformation(&outer));
  EXPECT_TRUE(Is(PointA2B(inner, 1, 1), 1, 1));
  inner = outer;  // all but the chain that it is part of
  EXPECT_TRUE(Is(PointA2B(inner, 1, 1), 11, 21));
  EXPECT_TRUE(Is(PointA2B(outer, 1, 1), 21, 41));
}

TEST(MultiTrafo2D, BackUndoesForth) {
  Numbers numbers(161);
  for (int i = 0; i < 500; ++i) {
    Translate2D translate(numbers.Next(), numbers.Next());
    Scale2D scale(NextScale(numbers), NextScale(numbers), numbers.Next(), numbers.Next());
    TrafoST2D st;
    st.SetScale(NextScale(numbers), NextScale(numbers));
    st.SetTranslation(numbers.Next(), numbers.Next());
    TrafoSRT2D srt;
    srt.SetScale(NextScale(numbers), NextScale(numbers));
    srt.SetRotationRad(numbers.Next());
    Trafo2DBase* const members[] = {&translate, &scale, &st, &srt};
    MultiTrafo2D chain;
    for (int k = 0; k < 5; ++k) {
      chain.AddTransformation(members[(i >> (2 * k)) & 3]);
    }
    ASSERT_TRUE(IsUndone(chain, {numbers.Next(), numbers.Next()}, 1e-6)) << i;
  }
}

TEST(MultiTrafo2D, EqualsItsMembersOneByOne) {
  Numbers numbers(162);
  for (int i = 0; i < 500; ++i) {
    TrafoSRT2D a, b;
    a.SetScale(NextScale(numbers), NextScale(numbers));
    a.SetRotationRad(numbers.Next());
    b.SetRotationRad(numbers.Next());
    b.SetTranslation(numbers.Next(), numbers.Next());
    MultiTrafo2D chain;
    chain.AddTransformation(&a);
    chain.AddTransformation(&b);
    double x = numbers.Next(), y = numbers.Next();
    const auto mapped = PointA2B(chain, x, y);
    a.pA2B(x, y);
    b.pA2B(x, y);
    ASSERT_TRUE(Is(mapped, x, y));
  }
}

}  // namespace
