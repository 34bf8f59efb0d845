// Members of the upper-triangular matrix.
#ifndef REISTI_MATRIX_MATRIX_UPPER_IMPL_H
#define REISTI_MATRIX_MATRIX_UPPER_IMPL_H

#include <algorithm>
#include <utility>

#include "matrix/matrix_dimensions.h"
#include "matrix/matrix_new.h"

namespace qan::matrix_library {

template <typename T>
UTmatrix<T>::UTmatrix(int n, const T& fill) : m_(n), v_(static_cast<std::size_t>(triangleCount(n)), fill) {}

template <typename T>
UTmatrix<T>::UTmatrix(int m, const std::vector<T>& v) : m_(m) {
    constexpr auto kQuotedTest = "static_cast<int>( v.size() ) == calculate_size( m )";
    QAN_ALLEGE_AS(static_cast<int>(v.size()) == calculate_size(m), kQuotedTest);
    v_ = v;
}

template <typename T>
void UTmatrix<T>::swap(UTmatrix& other) noexcept {
    std::swap(m_, other.m_);
    v_.swap(other.v_);
    std::swap(zero_, other.zero_);
    std::swap(scratch_, other.scratch_);
}

template <typename T>
void UTmatrix<T>::resize(int n, const T& fill) {
    const T value = fill;
    v_.assign(static_cast<std::size_t>(triangleCount(n)), value);
    m_ = n;
}

template <typename T>
void UTmatrix<T>::set(const T& x) {
    const T value = x;
    std::fill(v_.begin(), v_.end(), value);
}

template <typename T>
UTmatrix<T> UTmatrix<T>::operator-() const {
    UTmatrix result(*this);
    for (T& element : result.v_) {
        element = -element;
    }
    return result;
}

template <typename T>
matrix<T> UTmatrix<T>::transpose() const {
    return matrix<T>(*this).transpose();
}

}  // namespace qan::matrix_library

#endif
