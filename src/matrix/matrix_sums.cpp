#include "matrix/matrix_sums.h"

#include <functional>

#include "matrix/matrix_checks.h"

namespace qan::matrix_library {

namespace {

// Differences are called additions too, on purpose: the check is the same and callers know its text.
constexpr auto kDense = "matrix addition";
constexpr auto kUpper = "upper matrix element wise op";
constexpr auto kDiagonal = "diagonal matrix elementwise op";

using Plus = std::plus<double>;
using Minus = std::minus<double>;

// The operation with its operands exchanged, for a structured operand on the left.
template <typename Operation>
struct Exchanged {
    double operator()(double x, double y) const { return Operation()(y, x); }
};

// The structured operand is spread out in the result first, which needs no storage beside the result.
template <typename Operation, typename Structured>
matrix<double> denseWith(const matrix<double>& a, const Structured& b) {
    checkEqualDimensions(a, b, kDense);
    matrix<double> result(b);
    const double* const dense = a.data();
    double* const element = result.data();
    for (int k = 0; k < result.size(); ++k) {
        element[k] = Operation()(dense[k], element[k]);
    }
    return result;
}

template <typename Operation>
matrix<double> symmetricWithUpper(const Smatrix<double>& s, const UTmatrix<double>& u) {
    checkEqualDimensions(s, u, kDense);
    matrix<double> result(s);
    const int order = s.rowCount();
    const double* packed = u.data();
    double* element = result.data();
    for (int i = 0; i < order; ++i) {
        for (int j = 0; j < i; ++j, ++element) {
            *element = Operation()(*element, 0.0);
        }
        for (int j = i; j < order; ++j, ++element) {
            *element = Operation()(*element, *packed++);
        }
    }
    return result;
}

// Two operands of one packed kind, of which `length` elements are stored.
template <typename Operation, typename Kind>
Kind samePattern(const Kind& a, const Kind& b, int length) {
    Kind result(a);
    const double* const other = b.data();
    double* const element = result.data();
    for (int k = 0; k < length; ++k) {
        element[k] = Operation()(element[k], other[k]);
    }
    return result;
}

// A packed kind with a diagonal matrix, whose zeros count everywhere else.
template <typename Operation, typename Kind>
Kind packedWithDiagonal(const Kind& a, const Dmatrix<double>& d) {
    Kind result(a);
    double* const element = result.data();
    const int length = Kind::calculate_size(a.rowCount());
    for (int k = 0; k < length; ++k) {
        element[k] = Operation()(element[k], 0.0);
    }
    for (int i = 0; i < a.rowCount(); ++i) {
        result(i, i) = Operation()(a(i, i), d.data()[i]);
    }
    return result;
}

template <typename Operation>
Smatrix<double> symmetricWith(const Smatrix<double>& a, const Dmatrix<double>& d) {
    checkEqualDimensions(a, d, kDense);
    return packedWithDiagonal<Operation>(a, d);
}

template <typename Operation>
UTmatrix<double> upperWith(const UTmatrix<double>& a, const Dmatrix<double>& d) {
    checkEqualDimensions(a, d, kUpper);
    return packedWithDiagonal<Operation>(a, d);
}

template <typename Operation>
Smatrix<double> symmetricWith(const Smatrix<double>& a, const Smatrix<double>& b) {
    checkEqualDimensions(a, b, kDense);
    return samePattern<Operation>(a, b, a.size());
}

template <typename Operation>
UTmatrix<double> upperWith(const UTmatrix<double>& a, const UTmatrix<double>& b) {
    checkEqualDimensions(a, b, kUpper);
    return samePattern<Operation>(a, b, UTmatrix<double>::calculate_size(a.rowCount()));
}

template <typename Operation>
Dmatrix<double> diagonalWith(const Dmatrix<double>& a, const Dmatrix<double>& b) {
    checkEqualDimensions(a, b, kDiagonal);
    return samePattern<Operation>(a, b, a.rowCount());
}

void checkColumn(const matrix<double>& a, const std::vector<double>& v, const char* message) {
    const bool isColumn = a.colCount() == 1 && static_cast<std::size_t>(a.rowCount()) == v.size();
    if (!isColumn) throw MatrixException(message);
}

}  // namespace

matrix<double> operator+(const matrix<double>& a, const Dmatrix<double>& b) {
    return denseWith<Plus>(a, b);
}
matrix<double> operator+(const matrix<double>& a, const Smatrix<double>& b) {
    return denseWith<Plus>(a, b);
}
matrix<double> operator+(const matrix<double>& a, const UTmatrix<double>& b) {
    return denseWith<Plus>(a, b);
}
matrix<double> operator+(const Dmatrix<double>& a, const matrix<double>& b) {
    return denseWith<Plus>(b, a);
}
matrix<double> operator+(const Smatrix<double>& a, const matrix<double>& b) {
    return denseWith<Plus>(b, a);
}
matrix<double> operator+(const UTmatrix<double>& a, const matrix<double>& b) {
    return denseWith<Plus>(b, a);
}
matrix<double> operator+(const Smatrix<double>& a, const UTmatrix<double>& b) {
    return symmetricWithUpper<Plus>(a, b);
}
matrix<double> operator+(const UTmatrix<double>& a, const Smatrix<double>& b) {
    return symmetricWithUpper<Plus>(b, a);
}
Smatrix<double> operator+(const Dmatrix<double>& a, const Smatrix<double>& b) {
    return symmetricWith<Plus>(b, a);
}
Smatrix<double> operator+(const Smatrix<double>& a, const Dmatrix<double>& b) {
    return symmetricWith<Plus>(a, b);
}
Smatrix<double> operator+(const Smatrix<double>& a, const Smatrix<double>& b) {
    return symmetricWith<Plus>(a, b);
}
UTmatrix<double> operator+(const Dmatrix<double>& a, const UTmatrix<double>& b) {
    return upperWith<Plus>(b, a);
}
UTmatrix<double> operator+(const UTmatrix<double>& a, const Dmatrix<double>& b) {
    return upperWith<Plus>(a, b);
}
UTmatrix<double> operator+(const UTmatrix<double>& a, const UTmatrix<double>& b) {
    return upperWith<Plus>(a, b);
}
Dmatrix<double> operator+(const Dmatrix<double>& a, const Dmatrix<double>& b) {
    return diagonalWith<Plus>(a, b);
}

matrix<double> operator-(const matrix<double>& a, const Dmatrix<double>& b) {
    return denseWith<Minus>(a, b);
}
matrix<double> operator-(const matrix<double>& a, const Smatrix<double>& b) {
    return denseWith<Minus>(a, b);
}
matrix<double> operator-(const matrix<double>& a, const UTmatrix<double>& b) {
    return denseWith<Minus>(a, b);
}
matrix<double> operator-(const Dmatrix<double>& a, const matrix<double>& b) {
    return denseWith<Exchanged<Minus>>(b, a);
}
matrix<double> operator-(const Smatrix<double>& a, const matrix<double>& b) {
    return denseWith<Exchanged<Minus>>(b, a);
}
matrix<double> operator-(const UTmatrix<double>& a, const matrix<double>& b) {
    return denseWith<Exchanged<Minus>>(b, a);
}
matrix<double> operator-(const Smatrix<double>& a, const UTmatrix<double>& b) {
    return symmetricWithUpper<Minus>(a, b);
}
matrix<double> operator-(const UTmatrix<double>& a, const Smatrix<double>& b) {
    return symmetricWithUpper<Exchanged<Minus>>(b, a);
}
Smatrix<double> operator-(const Dmatrix<double>& a, const Smatrix<double>& b) {
    return symmetricWith<Exchanged<Minus>>(b, a);
}
Smatrix<double> operator-(const Smatrix<double>& a, const Dmatrix<double>& b) {
    return symmetricWith<Minus>(a, b);
}
Smatrix<double> operator-(const Smatrix<double>& a, const Smatrix<double>& b) {
    return symmetricWith<Minus>(a, b);
}
UTmatrix<double> operator-(const Dmatrix<double>& a, const UTmatrix<double>& b) {
    return upperWith<Exchanged<Minus>>(b, a);
}
UTmatrix<double> operator-(const UTmatrix<double>& a, const Dmatrix<double>& b) {
    return upperWith<Minus>(a, b);
}
UTmatrix<double> operator-(const UTmatrix<double>& a, const UTmatrix<double>& b) {
    return upperWith<Minus>(a, b);
}
Dmatrix<double> operator-(const Dmatrix<double>& a, const Dmatrix<double>& b) {
    return diagonalWith<Minus>(a, b);
}

matrix<double>& operator+=(matrix<double>& a, const Dmatrix<double>& b) {
    checkEqualDimensions(a, b, "matrix += diagonal");
    for (int i = 0; i < a.rowCount(); ++i) {
        a(i, i) += b.data()[i];
    }
    return a;
}

matrix<double>& operator+=(matrix<double>& a, const std::vector<double>& v) {
    checkColumn(a, v, "op+= matrix and vector must be of same order");
    double* element = a.data();
    for (const double x : v) {
        *element++ += x;
    }
    return a;
}

matrix<double>& operator-=(matrix<double>& a, const std::vector<double>& v) {
    checkColumn(a, v, "op-= matrix and vector must be of same order");
    double* element = a.data();
    for (const double x : v) {
        *element++ -= x;
    }
    return a;
}

matrix<double> operator+(const matrix<double>& a, const std::vector<double>& v) {
    matrix<double> result(a);
    result += v;
    return result;
}

matrix<double> operator+(const std::vector<double>& v, const matrix<double>& a) {
    return a + v;
}

matrix<double> operator-(const matrix<double>& a, const std::vector<double>& v) {
    matrix<double> result(a);
    result -= v;
    return result;
}

}  // namespace qan::matrix_library
