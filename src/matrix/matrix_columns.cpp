#include "matrix/matrix_columns.h"

#include <algorithm>

#include "matrix/matrix_exceptions.h"

namespace qan::matrix_library {

namespace {

template <typename Kind>
void checkCount(const Kind& m, int count) {
    if (count > m.rowCount()) throw MatrixException("matrix::number of products greater than dimension");
}

}  // namespace

double DotProduct(const matrix<double>& m, int c1, int c2, int count) {
    checkCount(m, count);
    double sum = 0.0;
    for (int i = 0; i < count; ++i) {
        sum += m(i, c1) * m(i, c2);
    }
    return sum;
}

double DotProduct(const matrix<double>& m, int c, const std::vector<double>& v, int count) {
    checkCount(m, count);
    double sum = 0.0;
    for (int i = 0; i < count; ++i) {
        sum += m(i, c) * v.data()[i];
    }
    return sum;
}

void KTimesColumnPlusVector(const matrix<double>& m, double k, int c, std::vector<double>& v, int count) {
    checkCount(m, count);
    for (int i = 0; i < count; ++i) {
        v.data()[i] += k * m(i, c);
    }
}

void KTimesColumnPlusVector(const UTmatrix<double>& u, double k, int c, std::vector<double>& v, int count) {
    checkCount(u, count);
    // Below the diagonal there is nothing to add.
    for (int i = 0; i < std::min(count, c + 1); ++i) {
        v.data()[i] += k * u(i, c);
    }
}

}  // namespace qan::matrix_library
