#include "matrix/vector_output.h"

#include <iostream>

namespace qan::matrix_library {

std::ostream& operator<<(std::ostream& os, const std::vector<double>& v) {
    os << "[";
    for (const double x : v) {
        std::cout << x << ", ";
    }
    return os << "]";
}

}  // namespace qan::matrix_library
