// LU decomposition by Crout's method, with partial pivoting on implicitly scaled rows.
#ifndef REISTI_MATRIX_MATRIX_LUDECOMPOSITION_H
#define REISTI_MATRIX_MATRIX_LUDECOMPOSITION_H

#include <vector>

#include "matrix/matrix_new.h"

namespace qan::matrix_library {

// The factors of a row permutation of a in one matrix: below the diagonal L, whose own diagonal is 1, on and above it
// U. At step j rows j and index[j] were swapped; d is +1.0 or -1.0, the parity of the swaps. Every sum is formed from
// 0.0 in ascending order and then subtracted, so the pivots do not depend on the processor or on how loops are blocked.
// Empty when a row or a pivot is zero within 4e-12. MatrixException when a is not square.
matrix<double> LUDecompSafeIterator(const matrix<double>& a, std::vector<int>& index, double& d);

// Solves with the factors of LUDecompSafeIterator; *x holds the right-hand side and gets the solution. Asserts that no
// diagonal element of lhs is exactly 0.
void LUBackSubTemplate(const matrix<double>& lhs, const std::vector<int>& index, std::vector<double>* x);

// The factors of a square matrix, for solving with them again and again. When the matrix is singular every operation
// returns false and leaves its output empty.
class LUDecomposition {
  public:
    // MatrixException when a is not square.
    explicit LUDecomposition(const matrix<double>& a);

    // 0.0 when singular.
    bool Determinant(double* result) const;
    // MatrixException when the right-hand side has not as many rows as the matrix.
    bool Solve(const std::vector<double>& b, std::vector<double>* x) const;
    // Column by column; X must be another object than B.
    bool Solve(const matrix<double>& B, matrix<double>* X) const;
    bool Inverse(matrix<double>* result) const;

  private:
    matrix<double> lu_;
    bool singular_ = false;
    std::vector<int> index_;
    double d_ = 1.0;
};

}  // namespace qan::matrix_library

#endif
