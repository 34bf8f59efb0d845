#include "matrix/matrix_functions.h"
#include "matrix/matrix_new.h"
#include "matrix/matrix_quadratic_forms.h"

namespace qan::matrix_library {

template class matrix<double>;
template class matrix<int>;
template class Dmatrix<double>;
template class UTmatrix<double>;
template class Smatrix<double>;

}  // namespace qan::matrix_library
