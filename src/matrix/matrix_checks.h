// What the operators check before they build a result.
#ifndef REISTI_MATRIX_MATRIX_CHECKS_H
#define REISTI_MATRIX_MATRIX_CHECKS_H

#include <string>
#include <string_view>

#include "matrix/matrix_exceptions.h"

namespace qan::matrix_library {

// The message begins with `what`. Two square kinds that agree in their rows agree in their columns.
template <typename Left, typename Right>
void checkEqualDimensions(const Left& a, const Right& b, std::string_view what) {
    if (a.rowCount() != b.rowCount()) throw MatrixException(std::string(what) + " : row counts are different");
    if (a.colCount() != b.colCount()) throw MatrixException(std::string(what) + " : col counts are different");
}

template <typename Left, typename Right>
void checkMultiplyDimensions(const Left& a, const Right& b) {
    if (a.colCount() != b.rowCount()) throw MatrixException("Matrix multiplication: incompatible orders");
}

}  // namespace qan::matrix_library

#endif
