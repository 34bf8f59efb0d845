// Members of the symmetric matrix.
#ifndef REISTI_MATRIX_MATRIX_SYMMETRIC_IMPL_H
#define REISTI_MATRIX_MATRIX_SYMMETRIC_IMPL_H

#include <algorithm>
#include <stdexcept>
#include <utility>

#include "matrix/matrix_conversions.h"
#include "matrix/matrix_dimensions.h"
#include "matrix/matrix_exceptions.h"
#include "matrix/matrix_new.h"

namespace qan::matrix_library {

template <typename T>
Smatrix<T>::Smatrix(int n, const T& fill) : m_(n), v_(static_cast<std::size_t>(triangleCount(n)), fill) {}

template <typename T>
Smatrix<T>::Smatrix(const matrix<T>& a) : Smatrix(a.ConvertToSmatrix()) {}

template <typename T>
Smatrix<T>::Smatrix(const matrix<T>& a, bool lower) {
    if (a.rowCount() != a.colCount()) throw std::domain_error("Originating matrix must be a square matrix");
    resize(a.rowCount(), T());
    T* element = data();
    for (int i = 0; i < m_; ++i) {
        for (int j = 0; j <= i; ++j) {
            *element++ = lower ? a(i, j) : a(j, i);
        }
    }
}

template <typename T>
Smatrix<T>& Smatrix<T>::operator=(const matrix<T>& a) {
    Smatrix symmetric = a.ConvertToSmatrix();
    swap(symmetric);
    return *this;
}

template <typename T>
void Smatrix<T>::swap(Smatrix& other) noexcept {
    std::swap(m_, other.m_);
    v_.swap(other.v_);
}

template <typename T>
void Smatrix<T>::resize(int n, const T& fill) {
    const T value = fill;
    v_.assign(static_cast<std::size_t>(triangleCount(n)), value);
    m_ = n;
}

template <typename T>
void Smatrix<T>::set(const T& x) {
    const T value = x;
    std::fill(v_.begin(), v_.end(), value);
}

template <typename T>
Smatrix<T> Smatrix<T>::operator-() const {
    Smatrix result(*this);
    for (T& element : result.v_) {
        element = -element;
    }
    return result;
}

template <typename T>
std::vector<T> Smatrix<T>::getRowVector(int i) const {
    QAN_ALLEGE(i >= 0 && i < m_);
    std::vector<T> row(static_cast<std::size_t>(m_));
    // Up to the diagonal the row is stored together; beyond it the elements go down column i.
    std::copy_n(data() + offset(i, 0), i + 1, row.data());
    for (int j = i + 1; j < m_; ++j) {
        row.data()[j] = data()[offset(j, i)];
    }
    return row;
}

template <typename T>
std::vector<T> Smatrix<T>::getColVector(int j) const {
    QAN_ALLEGE(j >= 0 && j < m_);
    return getRowVector(j);
}

template <typename T>
matrix<T> Smatrix<T>::getSubmatrix(int r, int c, int rows, int cols) const {
    matrix<T> block(rows, cols, T());
    for (int a = 0; a < rows; ++a) {
        for (int b = 0; b < cols; ++b) {
            block(a, b) = (*this)(r + a, c + b);
        }
    }
    return block;
}

template <typename T>
void Smatrix<T>::checkStorage() const {
    constexpr auto kQuotedTest = "static_cast<int>( v_.size() ) == calculate_size( m_ )";
    QAN_ALLEGE_AS(static_cast<int>(v_.size()) == calculate_size(m_), kQuotedTest);
}

template <typename T>
void Smatrix<T>::insertColRow(int target_row, const T& x) {
    QAN_ALLEGE(target_row >= 0 && target_row < m_ + 1);
    const T value = x;
    v_.resize(static_cast<std::size_t>(triangleCount(std::int64_t{m_} + 1)));

    // Between the new places of two rows lie old elements that move together: the end of one row, the start of the
    // next. From the bottom up they only move towards the end, so none is overwritten before it has moved.
    T* const elements = data();
    const std::ptrdiff_t target = target_row;
    for (std::ptrdiff_t row = m_; row >= target; --row) {
        T* const oldPlace = elements + row * (row - 1) / 2 + target;
        T* const newPlace = oldPlace + row;
        const std::ptrdiff_t following = row == m_ ? row - target : row;
        std::copy_backward(oldPlace, oldPlace + following, newPlace + 1 + following);
        *newPlace = value;
    }
    std::fill_n(elements + offset(target, 0), target, value);
    ++m_;
    checkStorage();
}

template <typename T>
void Smatrix<T>::insertColRow(int target_row, const std::vector<T>& v) {
    if (v.size() != static_cast<std::size_t>(m_) + 1) {
        throw MatrixException("insertColRow: vector length must be 1 more than the number of rows in the matrix");
    }
    insertColRow(target_row, T());
    for (int k = 0; k < m_; ++k) {
        (*this)(target_row, k) = v.data()[k];
    }
}

template <typename T>
void Smatrix<T>::removeColRow(int j) {
    QAN_ALLEGE(j >= 0 && j < m_);
    // The reverse of the insertion: what lies between two removed elements moves together, top row first.
    T* const elements = data();
    const std::ptrdiff_t removed = j;
    for (std::ptrdiff_t row = removed; row < m_; ++row) {
        T* const newPlace = elements + row * (row - 1) / 2 + removed;
        T* const oldPlace = newPlace + row + 1;
        const std::ptrdiff_t following = row == m_ - 1 ? row - removed : row;
        std::copy(oldPlace, oldPlace + following, newPlace);
    }
    --m_;
    v_.resize(static_cast<std::size_t>(triangleCount(m_)));
}

template <typename T>
Smatrix<T> Smatrix<T>::delColRow(int j) const {
    Smatrix result(*this);
    result.removeColRow(j);
    return result;
}

template <typename T>
void Smatrix<T>::UpdateForFisher(const std::vector<T>& a, const std::vector<T>& b, const std::vector<T>& c, int n) {
    assert(n <= m_);
    T* element = data();
    for (int i = 0; i < n; ++i) {
        const T factor = c.data()[i];
        for (int k = 0; k <= i; ++k) {
            *element++ += a.data()[k] * factor + b.data()[k];
        }
    }
}

template <typename T>
UTmatrix<T> Smatrix<T>::mSmatrixToUTmatrix() const {
    return SmatrixToUTmatrix(*this);
}

template <typename T>
void Smatrix<T>::mFlattenMatrix(std::vector<T>& out, int start, bool byRows) const {
    mFlattenmatrix(*this, out, start, byRows);
}

}  // namespace qan::matrix_library

#endif
