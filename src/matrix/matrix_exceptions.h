// What the matrix package throws when a caller, not the package, is at fault.
#ifndef REISTI_MATRIX_MATRIX_EXCEPTIONS_H
#define REISTI_MATRIX_MATRIX_EXCEPTIONS_H

#include <stdexcept>

namespace qan::matrix_library {

// Incompatible dimensions, a vector of the wrong length, an operation on an empty matrix, a conversion that fails.
class MatrixException : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

// A singular or not positive definite matrix, from the solvers that throw. Deliberately no MatrixException: a handler
// for caller errors must not swallow it.
class MatrixSingular : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

}  // namespace qan::matrix_library

#endif
