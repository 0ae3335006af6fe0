#include <vorl/Data/dTrafo.h>

#include <gtest/gtest.h>

#include <cmath>
#include <utility>

#include "GeometryTesting.h"

namespace {

using geometry_testing::Numbers;
using geometry_testing::Same;

/// Opens what derived transforms may use.
class OpenTrafo : public dTrafo3D {
 public:
  using dTrafo3D::CalculateTransformation;
  using dTrafo3D::InvertMatrix;
};

/// A matrix by its columns.
struct Matrix {
  Matrix(const dVect3D& a, const dVect3D& b, const dVect3D& c) : m{a, b, c} {}

  dVect3D m[3];
};

Matrix Diagonal(float x, float y, float z) {
  return {dVect3D(x, 0.0F, 0.0F), dVect3D(0.0F, y, 0.0F), dVect3D(0.0F, 0.0F, z)};
}

void ExpectSame(const Matrix& actual, const Matrix& expected) {
  for (int i = 0; i < 3; ++i) {
    EXPECT_TRUE(Same(actual.m[i], expected.m[i])) << "column " << i;
  }
}

TEST(dTrafo3DInversion, KeepsTheColumnLayout) {
  //  1 2 3      -24  18   5
  //  0 1 4  ->   20 -15  -4
  //  5 6 0       -5   4   1
  Matrix matrix({1.0F, 0.0F, 5.0F}, {2.0F, 1.0F, 6.0F}, {3.0F, 4.0F, 0.0F});
  EXPECT_TRUE(OpenTrafo::InvertMatrix(matrix.m));
  ExpectSame(matrix, Matrix({-24.0F, 20.0F, -5.0F}, {18.0F, -15.0F, 4.0F}, {5.0F, -4.0F, 1.0F}));
}

TEST(dTrafo3DInversion, DividesByTheDeterminant) {
  Matrix matrix = Diagonal(2.0F, -4.0F, 3.0F);
  EXPECT_TRUE(OpenTrafo::InvertMatrix(matrix.m));
  EXPECT_TRUE(matrix.m[0] == dVect3D(0.5F, 0.0F, 0.0F));
  EXPECT_TRUE(matrix.m[1] == dVect3D(0.0F, -0.25F, 0.0F));
  EXPECT_TRUE(Same(matrix.m[2].z, 1.0 / 3.0));
}

TEST(dTrafo3DInversion, ProductWithTheInverseIsTheIdentity) {
  Numbers numbers(71);
  for (int i = 0; i < 1000; ++i) {
    const Matrix a(numbers.Next3D(), numbers.Next3D(), numbers.Next3D());
    const double determinant = a.m[0].Product(a.m[1] * a.m[2]);
    double size = 1.0;
    for (const dVect3D& column : a.m) {
      size *= column.Length();
    }
    if (std::abs(determinant) < 0.1 * size || std::abs(determinant) < 1e-5) {
      continue;  // too flat for a sharp comparison
    }
    Matrix inverse(a);
    ASSERT_TRUE(OpenTrafo::InvertMatrix(inverse.m));
    for (int row = 0; row < 3; ++row) {
      for (int column = 0; column < 3; ++column) {
        double sum = 0.0;
        double magnitude = 1.0;
        for (int k = 0; k < 3; ++k) {
          const double term = static_cast<double>(a.m[k][row]) * inverse.m[column][k];
          sum += term;
          magnitude += std::abs(term);
        }
        ASSERT_NEAR(sum, row == column ? 1.0 : 0.0, 1e-6 * magnitude);
      }
    }
  }
}

TEST(dTrafo3DInversion, ASingularMatrixStaysAsItIs) {
  const Matrix flat({1.0F, 2.0F, 3.0F}, {4.0F, 5.0F, 6.0F}, {5.0F, 7.0F, 9.0F});
  Matrix matrix(flat);
  EXPECT_FALSE(OpenTrafo::InvertMatrix(matrix.m));
  ExpectSame(matrix, flat);
}

/// The matrix
///
///     1e-6 rest 0
///      0    1   1
///      1    0   1
///
/// whose determinant is 1e-6F * 1 * 1 + rest * 1 * 1; all other products are zero.
Matrix WithDeterminant(float rest) {
  return {dVect3D(1e-6F, 0.0F, 1.0F), dVect3D(rest, 1.0F, 0.0F), dVect3D(0.0F, 1.0F, 1.0F)};
}

TEST(dTrafo3DInversion, DeterminantOfExactlyTheToleranceIsSingular) {
  // 1e-6 in double precision is the single-precision 1e-6F plus 11922829 / 2^72.
  const float rest = std::ldexp(11922829.0F, -72);
  ASSERT_EQ(static_cast<double>(1e-6F) + rest, 1e-6);
  Matrix matrix = WithDeterminant(rest);
  EXPECT_FALSE(OpenTrafo::InvertMatrix(matrix.m));
  // One unit in the last place more is not.
  const float more = std::ldexp(11922830.0F, -72);
  ASSERT_EQ(static_cast<double>(1e-6F) + more, std::nextafter(1e-6, 1.0));
  matrix.m[1].x = more;
  EXPECT_TRUE(OpenTrafo::InvertMatrix(matrix.m));
}

TEST(dTrafo3DInversion, NegativeDeterminantOfTheToleranceIsSingularToo) {
  const float rest = std::ldexp(11922829.0F, -72);
  Matrix matrix = WithDeterminant(rest);
  std::swap(matrix.m[0], matrix.m[1]);
  EXPECT_FALSE(OpenTrafo::InvertMatrix(matrix.m));
  matrix.m[0].x = std::ldexp(11922830.0F, -72);
  EXPECT_TRUE(OpenTrafo::InvertMatrix(matrix.m));
}

TEST(dTrafo3DInversion, SmallDeterminantsAboveTheToleranceAreInverted) {
  Matrix matrix = Diagonal(1.0F, 1.0F, 1.0001e-6F);
  EXPECT_TRUE(OpenTrafo::InvertMatrix(matrix.m));
  EXPECT_TRUE(Same(matrix.m[2].z, 1.0 / static_cast<double>(1.0001e-6F)));
  matrix = Diagonal(1.0F, 1.0F, 1e-6F);  // 9.99999997e-7
  EXPECT_FALSE(OpenTrafo::InvertMatrix(matrix.m));
  matrix = Diagonal(0.01F, 0.01F, 0.01F);  // voxels of a hundredth: 9.99999933e-7
  EXPECT_FALSE(OpenTrafo::InvertMatrix(matrix.m));
  matrix = Diagonal(0.011F, 0.011F, 0.011F);
  EXPECT_TRUE(OpenTrafo::InvertMatrix(matrix.m));
}

TEST(dTrafo3DInversion, CalculatesAxesInTheCoordinatesOfAnotherSystem) {
  const dVect3D zero;
  const dCoordSys3D a(dVect3D(9.0F, 9.0F, 9.0F), dVect3D(2.0F, 4.0F, 8.0F),
                      dVect3D(1.0F, 0.0F, 0.0F), dVect3D(0.0F, -2.0F, 16.0F));
  const dCoordSys3D b(zero, dVect3D(2.0F, 0.0F, 0.0F), dVect3D(0.0F, 4.0F, 0.0F),
                      dVect3D(0.0F, 0.0F, 8.0F));
  OpenTrafo trafo;
  dVect3D out[3];
  trafo.CalculateTransformation(a, b, out[0], out[1], out[2]);
  EXPECT_TRUE(Same(out[0], 1, 1, 1));
  EXPECT_TRUE(Same(out[1], 0.5, 0, 0));
  EXPECT_TRUE(Same(out[2], 0, -0.5, 2));
  EXPECT_TRUE(Same(trafo.s2t[0], 0, 0, 0));  // the transform itself is not touched
}

TEST(dTrafo3DInversion, AFailedCalculationResetsTheTransformOnly) {
  const dVect3D x(1.0F, 0.0F, 0.0F);
  const dCoordSys3D flat(x, x, x, x);
  OpenTrafo trafo;
  dVect3D out[3] = {dVect3D(1.0F, 2.0F, 3.0F), dVect3D(4.0F, 5.0F, 6.0F),
                    dVect3D(7.0F, 8.0F, 9.0F)};
  trafo.CalculateTransformation(dCoordSys3D(), flat, out[0], out[1], out[2]);
  EXPECT_TRUE(Same(out[0], 1, 2, 3));
  EXPECT_TRUE(Same(out[1], 4, 5, 6));
  EXPECT_TRUE(Same(out[2], 7, 8, 9));
  for (const dVect3D* m : {trafo.s2t, trafo.t2s}) {
    EXPECT_TRUE(Same(m[0], 1, 0, 0));
    EXPECT_TRUE(Same(m[1], 0, 1, 0));
    EXPECT_TRUE(Same(m[2], 0, 0, 1));
  }
}

TEST(dTrafo3DInversion, AFailedCalculationIntoTheTransformLeavesTheIdentityThere) {
  const dVect3D x(1.0F, 0.0F, 0.0F);
  OpenTrafo trafo;
  trafo.transS2T.Set(1, 2, 3);
  trafo.CalculateTransformation(dCoordSys3D(), dCoordSys3D(x, x, x, x), trafo.t2s[0], trafo.t2s[1],
                                trafo.t2s[2]);
  EXPECT_TRUE(Same(trafo.t2s[0], 1, 0, 0));
  EXPECT_TRUE(Same(trafo.t2s[1], 0, 1, 0));
  EXPECT_TRUE(Same(trafo.t2s[2], 0, 0, 1));
  EXPECT_TRUE(Same(trafo.transS2T, 0, 0, 0));
}

}  // namespace
