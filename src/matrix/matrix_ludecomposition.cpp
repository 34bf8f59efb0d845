#include "matrix/matrix_ludecomposition.h"

#include <cstddef>

#include "matrix/kernels/factorizations.h"
#include "matrix/matrix_exceptions.h"

namespace qan::matrix_library {

namespace {

std::size_t orderOf(const matrix<double>& a) {
    return static_cast<std::size_t>(a.rowCount());
}

}  // namespace

matrix<double> LUDecompSafeIterator(const matrix<double>& a, std::vector<int>& index, double& d) {
    if (a.rowCount() != a.colCount()) throw MatrixException("LU Decomp is defined for only square matrices");
    matrix<double> lu(a);
    index.resize(orderOf(a));
    if (!reisti::kernels::factorLu(lu.data(), orderOf(a), index.data(), d)) return {};
    return lu;
}

void LUBackSubTemplate(const matrix<double>& lhs, const std::vector<int>& index, std::vector<double>* x) {
    QAN_ALLEGE(x);
    for (int i = lhs.rowCount() - 1; i >= 0; --i) {
        QAN_ALLEGE_AS(lhs(i, i) != 0.0, "lhs( i, i )");
    }
    reisti::kernels::solveLu(lhs.data(), index.data(), orderOf(lhs), x->data());
}

LUDecomposition::LUDecomposition(const matrix<double>& a) {
    lu_ = LUDecompSafeIterator(a, index_, d_);
    singular_ = lu_.rowCount() != a.rowCount();
}

bool LUDecomposition::Determinant(double* result) const {
    QAN_ALLEGE(result);
    *result = 0.0;
    if (singular_) return false;
    double product = d_;
    for (int i = 0; i < lu_.rowCount(); ++i) {
        product *= lu_(i, i);
    }
    *result = product;
    return true;
}

bool LUDecomposition::Solve(const std::vector<double>& b, std::vector<double>* x) const {
    QAN_ALLEGE(x);
    if (singular_) {
        x->clear();
        return false;
    }
    if (b.size() != orderOf(lu_)) throw MatrixException("LU Decomp: matrix and vector have incompatible dimensions");
    std::vector<double> solution(b);
    LUBackSubTemplate(lu_, index_, &solution);
    x->swap(solution);
    return true;
}

bool LUDecomposition::Solve(const matrix<double>& B, matrix<double>* X) const {
    QAN_ALLEGE(&B != X);
    QAN_ALLEGE(X);
    if (singular_) {
        *X = matrix<double>();
        return false;
    }
    if (B.rowCount() != lu_.rowCount()) throw MatrixException("LU Decomp: matrices have incompatible dimensions");
    *X = B;
    reisti::kernels::solveLuColumns(lu_.data(), index_.data(), orderOf(lu_), X->data(),
                                    static_cast<std::size_t>(B.colCount()));
    return true;
}

bool LUDecomposition::Inverse(matrix<double>* result) const {
    QAN_ALLEGE(result);
    if (singular_) {
        *result = matrix<double>();
        return false;
    }
    matrix<double> inverted(lu_.rowCount(), lu_.rowCount(), 0.0);
    reisti::kernels::invertLu(lu_.data(), index_.data(), orderOf(lu_), inverted.data());
    result->swap(inverted);
    return true;
}

}  // namespace qan::matrix_library
