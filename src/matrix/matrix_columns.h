// Dot products and updates with one column of a matrix. Each throws when count exceeds the rows; columns and the
// lengths of vectors are unchecked.
#ifndef REISTI_MATRIX_MATRIX_COLUMNS_H
#define REISTI_MATRIX_MATRIX_COLUMNS_H

#include <vector>

#include "matrix/matrix_new.h"

namespace qan::matrix_library {

// The sum over i < count, ascending, of m(i, c1) * m(i, c2), or of m(i, c) * v[i].
double DotProduct(const matrix<double>& m, int c1, int c2, int count);
double DotProduct(const matrix<double>& m, int c, const std::vector<double>& v, int count);

// v[i] += k * m(i, c) for i < count.
void KTimesColumnPlusVector(const matrix<double>& m, double k, int c, std::vector<double>& v, int count);
void KTimesColumnPlusVector(const UTmatrix<double>& u, double k, int c, std::vector<double>& v, int count);

}  // namespace qan::matrix_library

#endif
