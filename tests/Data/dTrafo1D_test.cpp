#include <vorl/Data/dTrafo.h>

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

namespace {

::testing::AssertionResult Has(const dTrafo1D& t, double scaleS2T, double offsetS2T,
                               double scaleT2S, double offsetT2S) {
  if (t.scaleS2T == scaleS2T && t.offsetS2T == offsetS2T && t.scaleT2S == scaleT2S &&
      t.offsetT2S == offsetT2S) {
    return ::testing::AssertionSuccess();
  }
  return ::testing::AssertionFailure() << "(" << t.scaleS2T << ", " << t.offsetS2T << ", "
                                       << t.scaleT2S << ", " << t.offsetT2S << ")";
}

TEST(dTrafo1D, IsUnsetUntilReset) {
  dTrafo1D trafo;
  for (const double number :
       {trafo.scaleS2T, trafo.offsetS2T, trafo.scaleT2S, trafo.offsetT2S, trafo.pS2T(1.0)}) {
    EXPECT_TRUE(std::isnan(number));
  }
  EXPECT_TRUE(trafo.IsValid());
  trafo.Reset();
  EXPECT_TRUE(Has(trafo, 1, 0, 1, 0));
  EXPECT_TRUE(trafo.IsValid());
}

TEST(dTrafo1D, MapsLengthsAndPoints) {
  dTrafo1D trafo;
  EXPECT_TRUE(trafo.Init(2.0, 10.0, 1.0, 3.0));
  EXPECT_TRUE(Has(trafo, 5.0, -2.0, 0.2, 1.0 - 0.2 * 3.0));
  EXPECT_EQ(trafo.pS2T(1.0), 3.0);
  EXPECT_EQ(trafo.vS2T(1.0), 5.0);
  EXPECT_EQ(trafo.pT2S(3.0), 1.0);
  EXPECT_EQ(trafo.vT2S(3.0), 0.2 * 3.0);
}

TEST(dTrafo1D, TwoSystemsGiveTheirScalesWithoutOrigins) {
  dTrafo1D trafo;
  EXPECT_TRUE(trafo.Init(dCoordSys1D(7.0, 4.0), dCoordSys1D(9.0, 8.0)));
  EXPECT_TRUE(Has(trafo, 2.0, 0.0, 0.5, 0.0));
}

TEST(dTrafo1D, TwoSystemsAndTwoPointsGiveTheOffsets) {
  dTrafo1D trafo;
  EXPECT_TRUE(trafo.Init(dCoordSys1D(7.0, 4.0), dCoordSys1D(9.0, 8.0), 10.0, 3.0));
  EXPECT_TRUE(Has(trafo, 2.0, -17.0, 0.5, 8.5));
}

TEST(dTrafo1D, ConstructorsInitialiseAlike) {
  const dCoordSys1D s(7.0, 4.0), t(9.0, 8.0);
  EXPECT_TRUE(Has(dTrafo1D(s, t), 2.0, 0.0, 0.5, 0.0));
  EXPECT_TRUE(Has(dTrafo1D(s, t, 10.0, 3.0), 2.0, -17.0, 0.5, 8.5));
  EXPECT_TRUE(Has(dTrafo1D(4, 8, 10, 3), 2.0, -17.0, 0.5, 8.5));
}

TEST(dTrafo1D, Copies) {
  dTrafo1D source;
  source.scaleS2T = 1.0;
  source.offsetS2T = 2.0;
  source.scaleT2S = 3.0;
  source.offsetT2S = 4.0;
  EXPECT_TRUE(Has(dTrafo1D(source), 1, 2, 3, 4));
  dTrafo1D assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  EXPECT_TRUE(Has(assigned, 1, 2, 3, 4));
}

TEST(dTrafo1D, SetTranslationKeepsTheScales) {
  dTrafo1D trafo;
  trafo.Reset();
  trafo.scaleS2T = 2.0;
  trafo.scaleT2S = 7.0;  // not the inverse: each direction keeps its own
  trafo.SetTranslation(10.0, 3.0);
  EXPECT_TRUE(Has(trafo, 2.0, -17.0, 7.0, -11.0));
}

TEST(dTrafo1D, EachConversionUsesItsOwnNumbers) {
  dTrafo1D trafo;
  trafo.scaleS2T = 2.0;
  trafo.offsetS2T = 3.0;
  trafo.scaleT2S = 5.0;
  trafo.offsetT2S = 7.0;
  EXPECT_EQ(trafo.vS2T(10.0), 20.0);
  EXPECT_EQ(trafo.pS2T(10.0), 23.0);
  EXPECT_EQ(trafo.vT2S(10.0), 50.0);
  EXPECT_EQ(trafo.pT2S(10.0), 57.0);
  // Whole numbers, a literal zero among them, are values.
  EXPECT_EQ(trafo.vS2T(0), 0.0);
  EXPECT_EQ(trafo.pS2T(0), 3.0);
  EXPECT_EQ(trafo.vT2S(10L), 50.0);
  EXPECT_EQ(trafo.pT2S(10U), 57.0);
  EXPECT_EQ(trafo.pT2S(1.0F), 12.0);
}

TEST(dTrafo1D, ConvertsInPlace) {
  dTrafo1D trafo;
  trafo.scaleS2T = 2.0;
  trafo.offsetS2T = 3.0;
  trafo.scaleT2S = 5.0;
  trafo.offsetT2S = 7.0;
  double x = 10.0;
  trafo.vS2T(&x);
  EXPECT_EQ(x, 20.0);
  trafo.pS2T(&x);
  EXPECT_EQ(x, 43.0);
  trafo.vT2S(&x);
  EXPECT_EQ(x, 215.0);
  trafo.pT2S(&x);
  EXPECT_EQ(x, 1082.0);
  double* const nothing = nullptr;
  trafo.vS2T(nothing);
  trafo.pS2T(nothing);
  trafo.vT2S(nothing);
  trafo.pT2S(nothing);
}

TEST(dTrafo1D, DivisionByZeroGivesInfinityOrNaN) {
  constexpr double kInfinity = std::numeric_limits<double>::infinity();
  dTrafo1D trafo;
  EXPECT_TRUE(trafo.Init(0.0, 2.0, 1.0, 3.0));
  EXPECT_TRUE(Has(trafo, kInfinity, -kInfinity, 0.0, 1.0));
  EXPECT_TRUE(trafo.Init(dCoordSys1D(0.0, 0.0), dCoordSys1D(0.0, 0.0)));
  EXPECT_TRUE(std::isnan(trafo.scaleS2T));
  EXPECT_TRUE(std::isnan(trafo.scaleT2S));
  EXPECT_EQ(trafo.offsetS2T, 0.0);
  EXPECT_EQ(trafo.offsetT2S, 0.0);
}

TEST(dUnitTrafo, ConstructorsMirrorTheTransformAndLeaveTheTextsEmpty) {
  const dCoordSys1D s(7.0, 4.0), t(9.0, 8.0);
  const dUnitTrafo unset;
  const dUnitTrafo scaled(s, t);
  const dUnitTrafo placed(s, t, 10.0, 3.0);
  const dUnitTrafo numbers(4, 8, 10, 3);
  EXPECT_TRUE(std::isnan(unset.scaleS2T));
  EXPECT_TRUE(std::isnan(unset.offsetT2S));
  EXPECT_TRUE(Has(scaled, 2.0, 0.0, 0.5, 0.0));
  EXPECT_TRUE(Has(placed, 2.0, -17.0, 0.5, 8.5));
  EXPECT_TRUE(Has(numbers, 2.0, -17.0, 0.5, 8.5));
  for (const dUnitTrafo* trafo : {&unset, &scaled, &placed, &numbers}) {
    EXPECT_STREQ(trafo->GetShortUnitText(), "");
    EXPECT_STREQ(trafo->GetLongUnitText(), "");
  }
}

TEST(dUnitTrafo, KeepsItsOwnCopiesOfTheTexts) {
  dUnitTrafo trafo;
  std::string text = "mm";
  trafo.SetShortUnitText(text.c_str());
  text = "millimetres";
  trafo.SetLongUnitText(text.c_str());
  text = "xx";
  EXPECT_STREQ(trafo.GetShortUnitText(), "mm");
  EXPECT_STREQ(trafo.GetLongUnitText(), "millimetres");
  trafo.SetShortUnitText(trafo.GetShortUnitText() + 1);
  EXPECT_STREQ(trafo.GetShortUnitText(), "m");
}

TEST(dUnitTrafo, NullEmptiesAText) {
  dUnitTrafo trafo;
  trafo.SetShortUnitText("HU");
  trafo.SetLongUnitText("Hounsfield units");
  trafo.SetShortUnitText(nullptr);
  EXPECT_STREQ(trafo.GetShortUnitText(), "");
  EXPECT_STREQ(trafo.GetLongUnitText(), "Hounsfield units");
  trafo.SetLongUnitText(nullptr);
  EXPECT_STREQ(trafo.GetLongUnitText(), "");
}

TEST(dUnitTrafo, CopiesNumbersAndTexts) {
  dUnitTrafo source(2.0, 10.0, 1.0, 3.0);
  source.SetShortUnitText("mm");
  source.SetLongUnitText("millimetres");
  const dUnitTrafo copy(source);
  dUnitTrafo assigned;
  EXPECT_EQ(&(assigned = source), &assigned);
  assigned = *&assigned;
  source.Reset();
  for (const dUnitTrafo* trafo : {&copy, &static_cast<const dUnitTrafo&>(assigned)}) {
    EXPECT_EQ(trafo->pS2T(1.0), 3.0);
    EXPECT_EQ(trafo->pT2S(3.0), 1.0);
    EXPECT_STREQ(trafo->GetShortUnitText(), "mm");
    EXPECT_STREQ(trafo->GetLongUnitText(), "millimetres");
  }
}

TEST(dUnitTrafo, ResetGivesTheIdentityWithoutTexts) {
  dUnitTrafo trafo(2.0, 10.0, 1.0, 3.0);
  trafo.SetShortUnitText("mm");
  trafo.SetLongUnitText("millimetres");
  static_cast<DataBase&>(trafo).Reset();
  EXPECT_TRUE(Has(trafo, 1, 0, 1, 0));
  EXPECT_STREQ(trafo.GetShortUnitText(), "");
  EXPECT_STREQ(trafo.GetLongUnitText(), "");
  EXPECT_TRUE(trafo.IsValid());
}

TEST(dUnitTrafo, InitKeepsTheTexts) {
  dUnitTrafo trafo;
  trafo.SetShortUnitText("mm");
  EXPECT_TRUE(trafo.Init(2.0, 10.0, 1.0, 3.0));
  EXPECT_EQ(trafo.pS2T(1.0), 3.0);
  EXPECT_STREQ(trafo.GetShortUnitText(), "mm");
}

}  // namespace
