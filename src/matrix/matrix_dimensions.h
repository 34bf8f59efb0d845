// Dimensions and element counts are 32-bit: these functions turn what does not fit into a MatrixException before any
// storage is asked for.
#ifndef REISTI_MATRIX_MATRIX_DIMENSIONS_H
#define REISTI_MATRIX_MATRIX_DIMENSIONS_H

#include <cstddef>
#include <cstdint>

namespace qan::matrix_library {

// rows * cols; throws when a factor is negative or the product exceeds the range of int.
int elementCount(std::int64_t rows, std::int64_t cols);

// (order + 1) * order / 2, the number of elements in one triangle; throws as elementCount does.
int triangleCount(std::int64_t order);

// The length of a vector as a dimension; throws when it exceeds the range of int.
int toDimension(std::size_t length);

}  // namespace qan::matrix_library

#endif
