// Everything of the matrix package.
#ifndef REISTI_MATRIX_MATRIX_LIBRARY_H
#define REISTI_MATRIX_MATRIX_LIBRARY_H

#include "matrix/allege.h"
#include "matrix/matrix_exceptions.h"
#include "matrix/matrix_functions.h"
#include "matrix/matrix_ludecomposition.h"
#include "matrix/matrix_new.h"
#include "matrix/trace.h"

#endif
