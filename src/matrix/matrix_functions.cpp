#include "matrix/matrix_functions.h"

#include <algorithm>
#include <cstddef>

#include "matrix/kernels/eigen_system.h"
#include "matrix/kernels/factorizations.h"
#include "matrix/matrix_exceptions.h"
#include "matrix/matrix_ludecomposition.h"

namespace qan::matrix_library {

namespace {

[[noreturn]] void throwSingular() {
    throw MatrixSingular("Matrix is singular");
}

void checkCount(int count, int order) {
    if (count > order) throw MatrixException("matrix::number of products greater than dimension");
}

std::size_t orderOf(const UTmatrix<double>& u) {
    return static_cast<std::size_t>(u.rowCount());
}

}  // namespace

UTmatrix<double> CholeskyDecomp(const UTmatrix<double>& a, int start, int* failedRow, double* pivot) {
    QAN_ALLEGE(failedRow);
    QAN_ALLEGE(pivot);
    if (a.rowCount() < start) throw MatrixException("UTmatrix: starting row greater than dimension");
    UTmatrix<double> u(a);
    *failedRow = -1;
    if (u.rowCount() <= start) return u;
    const auto first = static_cast<std::size_t>(std::max(start, 0));
    *failedRow = static_cast<int>(reisti::kernels::factorCholesky(u.data(), orderOf(u), first, *pivot));
    return u;
}

bool CholeskyDecomp(const Smatrix<double>& a, UTmatrix<double>* result) {
    QAN_ALLEGE(result);
    UTmatrix<double> u = SmatrixToUTmatrix(a);
    double pivot = 0.0;
    const bool succeeds = reisti::kernels::factorCholesky(u.data(), orderOf(u), 0, pivot) < 0;
    *result = succeeds ? std::move(u) : UTmatrix<double>();
    return succeeds;
}

UTmatrix<double> CholeskyDecompWithThrow(const Smatrix<double>& a) {
    UTmatrix<double> u;
    if (!CholeskyDecomp(a, &u)) throwSingular();
    return u;
}

Smatrix<double> CholeskyInverse(const UTmatrix<double>& u) {
    Smatrix<double> inverted(u.rowCount(), 0.0);
    reisti::kernels::invertCholesky(u.data(), orderOf(u), inverted.data());
    return inverted;
}

std::vector<double> CholeskyBackSub(const UTmatrix<double>& u, const std::vector<double>& b) {
    if (b.size() != orderOf(u)) throw MatrixException("UTmatrix: matrix and vector have incompatible dimensions");
    std::vector<double> x(b);
    reisti::kernels::solveCholesky(u.data(), orderOf(u), x.data());
    return x;
}

bool inverse(const Smatrix<double>& a, Smatrix<double>* result) {
    QAN_ALLEGE(result);
    UTmatrix<double> u;
    const bool succeeds = CholeskyDecomp(a, &u);
    *result = CholeskyInverse(u);
    return succeeds;
}

Smatrix<double> inverseWithThrow(const Smatrix<double>& a) {
    Smatrix<double> inverted;
    if (!inverse(a, &inverted)) throwSingular();
    return inverted;
}

bool inverse(const matrix<double>& a, matrix<double>* result) {
    return LUDecomposition(a).Inverse(result);
}

matrix<double> inverseWithThrow(const matrix<double>& a) {
    matrix<double> inverted;
    if (!inverse(a, &inverted)) throwSingular();
    return inverted;
}

bool inverse(const Dmatrix<double>& a, Dmatrix<double>* result) {
    QAN_ALLEGE(result);
    Dmatrix<double> inverted(a);
    for (int i = 0; i < a.rowCount(); ++i) {
        if (a.data()[i] == 0.0) {
            result->resize(0, 0.0);
            return false;
        }
        inverted.data()[i] = 1.0 / a.data()[i];
    }
    result->swap(inverted);
    return true;
}

Dmatrix<double> inverseWithThrow(const Dmatrix<double>& a) {
    Dmatrix<double> inverted;
    if (!inverse(a, &inverted)) throwSingular();
    return inverted;
}

bool determinant(const matrix<double>& a, double* det) {
    return LUDecomposition(a).Determinant(det);
}

bool determinant(const Smatrix<double>& a, double* det) {
    return determinant(matrix<double>(a), det);
}

double determinantWithThrow(const matrix<double>& a) {
    double det = 0.0;
    if (!determinant(a, &det)) throwSingular();
    return det;
}

double determinantWithThrow(const Smatrix<double>& a) {
    return determinantWithThrow(matrix<double>(a));
}

int EigenSystems(const matrix<double>& a, std::vector<double>& values, matrix<double>& vectors) {
    const matrix<double>& lhs = a;
    const int iNumRows = lhs.rowCount();
    QAN_ALLEGE(iNumRows == lhs.colCount());
    const auto n = static_cast<std::size_t>(iNumRows);
    std::vector<double> foundValues(n);
    matrix<double> foundVectors(iNumRows, iNumRows, 0.0);
    const std::size_t failed = reisti::kernels::eigenSystem(lhs.data(), n, foundValues.data(), foundVectors.data());
    values.swap(foundValues);
    vectors.swap(foundVectors);
    return static_cast<int>(failed);
}

void KTimesColumn(Smatrix<double>& s, double k, int col, int count) {
    checkCount(count, s.rowCount());
    for (int i = 0; i < count; ++i) {
        s(i, col) *= k;
    }
}

void KTimesColumnPlusColumn(Smatrix<double>& s, double k, int src, int dst, int count) {
    checkCount(count, s.rowCount());
    for (int i = 0; i < count; ++i) {
        s(i, dst) += k * s(i, src);
    }
}

}  // namespace qan::matrix_library
