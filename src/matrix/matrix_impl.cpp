#include "matrix/matrix_impl.h"

namespace qan::matrix_library {

template class matrix<double>;
template class matrix<int>;

}  // namespace qan::matrix_library
