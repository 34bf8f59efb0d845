// Everything of the matrix package.
#ifndef REISTI_MATRIX_MATRIX_LIBRARY_H
#define REISTI_MATRIX_MATRIX_LIBRARY_H

#include "matrix/allege.h"
#include "matrix/matrix_checks.h"
#include "matrix/matrix_columns.h"
#include "matrix/matrix_exceptions.h"
#include "matrix/matrix_expression.h"
#include "matrix/matrix_functions.h"
#include "matrix/matrix_ludecomposition.h"
#include "matrix/matrix_new.h"
#include "matrix/matrix_products.h"
#include "matrix/matrix_quadratic_forms.h"
#include "matrix/matrix_sums.h"
#include "matrix/trace.h"
#include "matrix/vector_output.h"

#endif
