#include "MathEngine.h"

#include <cmath>
#include <vector>

const cMathEngine theMathEngine;

cMathEngine::~cMathEngine() = default;

namespace {

bool SameShape(const cMatrixDC& a, const cMatrixDC& b) {
    return a.Rows() == b.Rows() && a.Columns() == b.Columns();
}

template <typename Op>
bool ElementWise(const cMatrixDC& a, cMatrixDC& result, Op op) {
    const int32_t rows = a.Rows();
    const int32_t columns = a.Columns();
    result.Resize(rows, columns);
    const size_t count = static_cast<size_t>(rows) * columns;
    const double* in = a.Values();
    double* out = result.Values();
    for (size_t i = 0; i < count; ++i) out[i] = op(in[i], i);
    return true;
}

}  // namespace

bool cMathEngine::Product(const cMatrixDC& a, const cMatrixDC& b, cMatrixDC& result) const {
    if (a.Columns() != b.Rows()) return false;
    const int32_t rows = a.Rows();
    const int32_t columns = b.Columns();
    const int32_t inner = a.Columns();
    // Computed aside so that result may be one of the operands.
    std::vector<double> product(static_cast<size_t>(rows) * columns, 0.0);
    for (int32_t i = 0; i < rows; ++i) {
        for (int32_t j = 0; j < columns; ++j) {
            double sum = 0.0;
            for (int32_t k = 0; k < inner; ++k) sum += a.At(i, k) * b.At(k, j);
            product[static_cast<size_t>(i) * columns + j] = sum;
        }
    }
    result.Resize(rows, columns);
    std::copy(product.begin(), product.end(), result.Values());
    return true;
}

bool cMathEngine::Power(const cMatrixDC& a, const cMatrixDC& exponents, cMatrixDC& result) const {
    if (!SameShape(a, exponents)) return false;
    const double* e = exponents.Values();
    return ElementWise(a, result, [e](double v, size_t i) { return std::pow(v, e[i]); });
}

bool cMathEngine::Power(const cMatrixDC& a, double exponent, cMatrixDC& result) const {
    return ElementWise(a, result, [exponent](double v, size_t) { return std::pow(v, exponent); });
}

bool cMathEngine::Exp(const cMatrixDC& a, cMatrixDC& result) const {
    return ElementWise(a, result, [](double v, size_t) { return std::exp(v); });
}

bool cMathEngine::Sqrt(const cMatrixDC& a, cMatrixDC& result) const {
    return ElementWise(a, result, [](double v, size_t) { return std::sqrt(v); });
}

double cMathEngine::FrobeniusNorm(const cMatrixDC& a) const {
    const size_t count = static_cast<size_t>(a.Rows()) * a.Columns();
    const double* v = a.Values();
    double sum = 0.0;
    for (size_t i = 0; i < count; ++i) sum += v[i] * v[i];
    return std::sqrt(sum);
}
