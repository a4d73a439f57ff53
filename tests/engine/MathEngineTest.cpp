#include <gtest/gtest.h>

#include "MathEngine.h"

namespace {

cMatrixDC Matrix(int32_t rows, int32_t columns, std::initializer_list<double> values) {
    cMatrixDC m(rows, columns);
    std::copy(values.begin(), values.end(), m.Values());
    return m;
}

TEST(MathEngine, ProductShapesAndAliasing) {
    const cMatrixDC a = Matrix(2, 3, {1, 2, 3, 4, 5, 6});
    cMatrixDC result;
    EXPECT_TRUE(theMathEngine.Product(a, Matrix(3, 1, {1, 0, -1}), result));
    ASSERT_EQ(result.Rows(), 2);
    ASSERT_EQ(result.Columns(), 1);
    EXPECT_EQ(result.At(1, 0), -2.0);
    EXPECT_FALSE(theMathEngine.Product(a, a, result));
    EXPECT_FALSE(theMathEngine.Power(a, Matrix(3, 2, {}), result));
    cMatrixDC square = Matrix(2, 2, {1, 1, 0, 1});
    EXPECT_TRUE(theMathEngine.Product(square, square, square));
    EXPECT_EQ(square.At(0, 1), 2.0);
    EXPECT_DOUBLE_EQ(theMathEngine.FrobeniusNorm(Matrix(2, 2, {1, 2, 2, 4})), 5.0);
}

TEST(DataCollection, Resize) {
    cMatrixDC m(4, 3);
    m.At(0, 1) = 7.0;
    m.Resize(2, 6);  // same element count: the values stay
    EXPECT_EQ(m.At(0, 1), 7.0);
    m.Resize(5, 5);
    m.At(4, 4) = 1.0;  // the grown buffer is addressable
    m.Resize(-1, 3);
    EXPECT_EQ(m.Rows(), 0);
}

}  // namespace
