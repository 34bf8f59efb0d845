// Members of the diagonal matrix.
#ifndef REISTI_MATRIX_MATRIX_DIAGONAL_IMPL_H
#define REISTI_MATRIX_MATRIX_DIAGONAL_IMPL_H

#include <algorithm>
#include <utility>

#include "matrix/matrix_dimensions.h"
#include "matrix/matrix_exceptions.h"
#include "matrix/matrix_new.h"

namespace qan::matrix_library {

template <typename T>
Dmatrix<T>::Dmatrix(int n, const T& fill) : m_(elementCount(n, 1)), v_(static_cast<std::size_t>(m_), fill) {}

template <typename T>
void Dmatrix<T>::swap(Dmatrix& other) noexcept {
    std::swap(zero_, other.zero_);
    std::swap(m_, other.m_);
    v_.swap(other.v_);
    std::swap(scratch_, other.scratch_);
}

template <typename T>
void Dmatrix<T>::resize(int n, const T& fill) {
    const T value = fill;
    v_.assign(static_cast<std::size_t>(elementCount(n, 1)), value);
    m_ = n;
}

template <typename T>
void Dmatrix<T>::set(const T& x) {
    const T value = x;
    std::fill(v_.begin(), v_.end(), value);
}

template <typename T>
Dmatrix<T> Dmatrix<T>::operator-() const {
    Dmatrix result(*this);
    for (T& element : result.v_) {
        element = -element;
    }
    return result;
}

template <typename T>
matrix<T> Dmatrix<T>::getCol(int j) const {
    assert(0 <= j && j < m_);
    matrix<T> column(m_, 1, T());
    column(j, 0) = v_.data()[j];
    return column;
}

template <typename T>
void Dmatrix<T>::removeColRow(int i) {
    assert(0 <= i && i < m_);
    v_.erase(v_.begin() + i);
    --m_;
}

template <typename T>
void Dmatrix<T>::setSubmatrix(int r, int c, const Dmatrix& d) {
    if (r < 0 || c < 0 || std::int64_t{r} + d.m_ > m_ || std::int64_t{c} + d.m_ > m_) {
        // The doubled word is meant: callers know the text.
        throw MatrixException("Dmatrixmatrix::setSubmatrix incompatible matrices");
    }
    if (r != c || this == &d) return;
    std::copy(d.v_.begin(), d.v_.end(), v_.begin() + r);
}

}  // namespace qan::matrix_library

#endif
