// From one matrix kind to another, and from a matrix to a vector.
#ifndef REISTI_MATRIX_MATRIX_CONVERSIONS_H
#define REISTI_MATRIX_MATRIX_CONVERSIONS_H

#include <algorithm>
#include <utility>

#include "matrix/matrix_exceptions.h"
#include "matrix/matrix_new.h"

namespace qan::matrix_library {

// The symmetric matrix whose lower triangle mirrors u.
template <typename T>
Smatrix<T> mUTmatrixToSmatrix(const UTmatrix<T>& u) {
    const int order = u.rowCount();
    Smatrix<T> result(order, T());
    const T* element = u.data();
    for (int i = 0; i < order; ++i) {
        for (int j = i; j < order; ++j) {
            result(j, i) = *element++;
        }
    }
    return result;
}

// The upper triangle of s.
template <typename T>
UTmatrix<T> SmatrixToUTmatrix(const Smatrix<T>& s) {
    const int order = s.rowCount();
    UTmatrix<T> result(order, T());
    // Rows of s in bands: they become columns, and a band of columns shares its cache lines.
    constexpr std::ptrdiff_t kBand = 8;
    const T* const mirrored = s.data();
    for (std::ptrdiff_t band = 0; band < order; band += kBand) {
        const std::ptrdiff_t bandEnd = std::min<std::ptrdiff_t>(band + kBand, order);
        T* row = result.data();
        for (std::ptrdiff_t i = 0; i < bandEnd; ++i) {
            const std::ptrdiff_t first = std::max(i, band);
            std::ptrdiff_t place = first * (first + 1) / 2 + i;
            for (std::ptrdiff_t j = first; j < bandEnd; ++j) {
                row[j - i] = mirrored[place];
                place += j + 1;
            }
            row += order - i;
        }
    }
    return result;
}

// Fills out with the rows (byRows) or columns of the matrix from number start on; none is left when start lies past the
// end.
template <typename Matrix, typename T>
void mFlattenmatrix(const Matrix& source, std::vector<T>& out, int start, bool byRows) {
    out.clear();
    const int rows = source.rowCount();
    const int cols = source.colCount();
    if (rows == 0 || cols == 0) return;
    if (start < 0) throw MatrixException("mFlattenmatrix: negative start");
    const int lines = byRows ? rows : cols;
    const int length = byRows ? cols : rows;
    if (start >= lines) return;
    out.resize(static_cast<std::size_t>(lines - start) * static_cast<std::size_t>(length));
    T* element = out.data();
    for (int line = start; line < lines; ++line) {
        for (int k = 0; k < length; ++k) {
            *element++ = byRows ? source(line, k) : source(k, line);
        }
    }
}

template <typename T>
void matrix<T>::mFlattenMatrix(std::vector<T>& out, int start, bool byRows) const {
    mFlattenmatrix(*this, out, start, byRows);
}

template <typename T>
matrix<T>::matrix(const Dmatrix<T>& d) : matrix(d.rowCount(), d.rowCount(), T()) {
    for (int i = 0; i < m_; ++i) {
        (*this)(i, i) = d.data()[i];
    }
}

template <typename T>
matrix<T>::matrix(const UTmatrix<T>& u) : matrix(u.rowCount(), u.rowCount(), T()) {
    const T* packed = u.data();
    for (int i = 0; i < m_; ++i) {
        std::copy_n(packed, m_ - i, data() + offset(i, i));
        packed += m_ - i;
    }
}

template <typename T>
matrix<T>::matrix(const Smatrix<T>& s) : matrix(s.rowCount(), s.rowCount(), T()) {
    // Rows in bands: the upper triangle is written down the columns, and a band of columns shares its cache lines.
    constexpr int kBand = 16;
    for (int band = 0; band < m_; band += kBand) {
        const int bandEnd = std::min(band + kBand, m_);
        for (int i = band; i < bandEnd; ++i) {
            std::copy_n(&s(i, 0), i + 1, data() + offset(i, 0));
        }
        for (int j = 0; j < bandEnd; ++j) {
            for (int i = std::max(band, j + 1); i < bandEnd; ++i) {
                (*this)(j, i) = s(i, j);
            }
        }
    }
}

template <typename T>
matrix<T>& matrix<T>::operator=(const Dmatrix<T>& d) {
    matrix dense(d);
    swap(dense);
    return *this;
}

template <typename T>
matrix<T>& matrix<T>::operator=(const UTmatrix<T>& u) {
    matrix dense(u);
    swap(dense);
    return *this;
}

template <typename T>
matrix<T>& matrix<T>::operator=(const Smatrix<T>& s) {
    matrix dense(s);
    swap(dense);
    return *this;
}

}  // namespace qan::matrix_library

#endif
