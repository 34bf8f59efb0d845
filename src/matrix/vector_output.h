// Vectors on a stream, for debugging.
#ifndef REISTI_MATRIX_VECTOR_OUTPUT_H
#define REISTI_MATRIX_VECTOR_OUTPUT_H

#include <iosfwd>
#include <vector>

namespace qan::matrix_library {

// Writes the brackets to os but the elements, each followed by a comma, to standard output. Both are meant.
std::ostream& operator<<(std::ostream& os, const std::vector<double>& v);

}  // namespace qan::matrix_library

#endif
