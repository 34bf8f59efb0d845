#include "matrix/matrix_dimensions.h"

#include <limits>

#include "matrix/matrix_exceptions.h"

namespace qan::matrix_library {

namespace {

constexpr std::int64_t kMostElements = std::numeric_limits<int>::max();

int checkedCount(std::int64_t count) {
    if (count > kMostElements) throw MatrixException("matrix: the number of elements does not fit in 32 bits");
    return static_cast<int>(count);
}

void checkDimension(std::int64_t dimension) {
    if (dimension < 0) throw MatrixException("matrix: negative dimension");
    if (dimension > kMostElements) throw MatrixException("matrix: a dimension does not fit in 32 bits");
}

}  // namespace

int elementCount(std::int64_t rows, std::int64_t cols) {
    checkDimension(rows);
    checkDimension(cols);
    // Two factors below 2^31: the 64-bit product cannot overflow.
    return checkedCount(rows * cols);
}

int triangleCount(std::int64_t order) {
    checkDimension(order);
    return checkedCount((order + 1) * order / 2);
}

int toDimension(std::size_t length) {
    if (length > static_cast<std::size_t>(kMostElements)) {
        throw MatrixException("matrix: a dimension does not fit in 32 bits");
    }
    return static_cast<int>(length);
}

}  // namespace qan::matrix_library
