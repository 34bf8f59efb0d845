// Members of the dense matrix.
#ifndef REISTI_MATRIX_MATRIX_IMPL_H
#define REISTI_MATRIX_MATRIX_IMPL_H

#include <algorithm>
#include <cmath>
#include <stdexcept>
#include <utility>

#include "matrix/matrix_dimensions.h"
#include "matrix/matrix_exceptions.h"
#include "matrix/matrix_new.h"

namespace qan::matrix_library {

// Two elements mirror each other when they differ by less than this, absolutely or, with this as the floor, relative to
// the greater.
inline constexpr double kSymmetryFuzz = 4e-12;

template <typename T>
matrix<T>::matrix(int rows, int cols, const T& fill)
    : m_(rows), n_(cols), mn_(elementCount(rows, cols)), v_(static_cast<std::size_t>(mn_), fill) {}

template <typename T>
matrix<T>::matrix(const std::vector<T>& v, int cols) : matrix(std::vector<T>(v), cols) {}

template <typename T>
matrix<T>::matrix(std::vector<T>&& v, int cols) {
    const int length = toDimension(v.size());
    if (cols < 0 || (cols == 0 && length > 0)) throw MatrixException("matrix: a vector needs at least one column");
    v_ = std::move(v);
    setDimensions(cols == 0 ? 0 : length / cols, cols);
}

template <typename T>
matrix<T>::matrix(const matrix& other) : m_(other.m_), n_(other.n_), mn_(other.mn_), v_(other.v_) {}

template <typename T>
matrix<T>::matrix(matrix&& other) noexcept
    : m_(std::exchange(other.m_, 0)),
      n_(std::exchange(other.n_, 0)),
      mn_(std::exchange(other.mn_, 0)),
      v_(std::exchange(other.v_, {})) {}

template <typename T>
matrix<T> matrix<T>::CreateRowVector(const std::vector<T>& v) {
    return matrix(v, toDimension(v.size()));
}

template <typename T>
matrix<T>& matrix<T>::operator=(const matrix& other) {
    if (this == &other) return *this;
    // The storage first: if it cannot be had, the dimensions still describe the old one.
    v_ = other.v_;
    m_ = other.m_;
    n_ = other.n_;
    mn_ = other.mn_;
    return *this;
}

template <typename T>
matrix<T>& matrix<T>::operator=(matrix&& other) noexcept {
    matrix taken(std::move(other));
    swap(taken);
    return *this;
}

template <typename T>
matrix<T>& matrix<T>::operator=(const T& x) {
    set(x);
    return *this;
}

template <typename T>
matrix<T>& matrix<T>::operator=(const std::vector<T>& v) {
    if (v_ == v) return *this;
    const int length = toDimension(v.size());
    v_ = v;
    setDimensions(length, 1);
    return *this;
}

template <typename T>
void matrix<T>::set(const T& x) {
    const T value = x;
    std::fill(v_.begin(), v_.end(), value);
}

template <typename T>
void matrix<T>::swap(matrix& other) noexcept {
    std::swap(signature_, other.signature_);
    std::swap(m_, other.m_);
    std::swap(n_, other.n_);
    std::swap(mn_, other.mn_);
    v_.swap(other.v_);
}

template <typename T>
void matrix<T>::Initialize(int rows, int cols, const T& fill) {
    ResizeStorage(rows, cols, fill);
}

template <typename T>
void matrix<T>::resize(int rows, int cols, const T& fill) {
    ResizeStorage(rows, cols, fill);
}

template <typename T>
void matrix<T>::ResizeStorage(int rows, int cols, const T& fill) {
    const auto count = static_cast<std::size_t>(elementCount(rows, cols));
    const T value = fill;
    v_.assign(count, value);
    setDimensions(rows, cols);
    checkStorage();
}

template <typename T>
void matrix<T>::setDimensions(int rows, int cols) {
    m_ = rows;
    n_ = cols;
    mn_ = rows * cols;
}

template <typename T>
void matrix<T>::checkStorage() const {
    QAN_ALLEGE_AS(mn_ == static_cast<int>(v_.size()), "mn_ == static_cast<int>( v_.size() )");
}

template <typename T>
matrix<T> matrix<T>::getRow(int i) const {
    matrix row;
    row.v_ = getRowVector(i);
    row.setDimensions(1, n_);
    return row;
}

template <typename T>
std::vector<T> matrix<T>::getRowVector(int i) const {
    assert(0 <= i && i < m_);
    const T* const row = data() + offset(i, 0);
    return std::vector<T>(row, row + n_);
}

template <typename T>
matrix<T> matrix<T>::getCol(int j) const {
    return matrix(getColVector(j), 1);
}

template <typename T>
std::vector<T> matrix<T>::getColVector(int j) const {
    checkCol(j);
    std::vector<T> column(static_cast<std::size_t>(m_));
    for (int i = 0; i < m_; ++i) {
        column.data()[i] = data()[offset(i, j)];
    }
    return column;
}

template <typename T>
void matrix<T>::setRow(int i, const matrix& r) {
    checkRow(i);
    if (r.n_ != n_ || r.mn_ < n_) throw MatrixException("matrix::setRow incompatible matrices");
    if (this == &r && i == 0) return;
    std::copy_n(r.data(), n_, data() + offset(i, 0));
}

template <typename T>
void matrix<T>::setRow(int i, const std::vector<T>& r) {
    checkRow(i);
    assert(static_cast<std::size_t>(offset(i, 0)) + r.size() <= v_.size());
    std::copy(r.begin(), r.end(), data() + offset(i, 0));
}

template <typename T>
void matrix<T>::setCol(int j, const matrix& c) {
    checkCol(j);
    if (c.m_ != m_ || c.mn_ < m_) throw MatrixException("matrix::setCol incompatible matrices");
    setCol(j, std::vector<T>(c.data(), c.data() + m_));
}

template <typename T>
void matrix<T>::setCol(int j, const std::vector<T>& c) {
    checkCol(j);
    assert(c.size() <= static_cast<std::size_t>(m_));
    int i = 0;
    for (const T& value : c) {
        data()[offset(i++, j)] = value;
    }
}

template <typename T>
void matrix<T>::addRow(const std::vector<T>& r) {
    if (mn_ != 0 && r.size() != static_cast<std::size_t>(n_)) {
        throw MatrixException("addRow row std::vector must be of same order");
    }
    const int cols = toDimension(r.size());
    const auto count = static_cast<std::size_t>(elementCount(std::int64_t{m_} + 1, cols));
    constexpr auto kQuotedTest = "mn_ == static_cast<int>( v_.size() ) && \"vector not the right size\"";
    QAN_ALLEGE_AS(mn_ == static_cast<int>(v_.size()), kQuotedTest);
    if (mn_ == 0) {
        // Rows that had no columns until now become rows of zeros.
        v_.assign(count, T());
        std::copy(r.begin(), r.end(), v_.end() - cols);
    } else {
        v_.insert(v_.end(), r.begin(), r.end());
    }
    setDimensions(m_ + 1, cols);
}

template <typename T>
void matrix<T>::addRow(const T& x) {
    if (mn_ == 0) throw MatrixException("addRow operating on a null matrix");
    openRow(m_, &x, 0);
}

template <typename T>
void matrix<T>::addCol(const std::vector<T>& c) {
    if (mn_ == 0) {
        const int length = toDimension(c.size());
        v_ = c;
        setDimensions(length, 1);
        return;
    }
    if (c.size() != static_cast<std::size_t>(m_)) {
        throw MatrixException("addCol column std::vector must be of same order");
    }
    openCol(n_, c.data(), 1);
}

template <typename T>
void matrix<T>::addCol(const T& x) {
    if (mn_ == 0) throw MatrixException("addCol operating on a null matrix");
    openCol(n_, &x, 0);
}

template <typename T>
void matrix<T>::insertRow(int i, const T& x) {
    openRow(i, &x, 0);
}

template <typename T>
void matrix<T>::insertRow(int i, const std::vector<T>& r) {
    // The words of addRow are meant: to the caller both add a row.
    if (r.size() != static_cast<std::size_t>(n_)) throw MatrixException("addRow row std::vector must be of same order");
    openRow(i, r.data(), 1);
}

template <typename T>
void matrix<T>::insertCol(int j, const T& x) {
    openCol(j, &x, 0);
}

template <typename T>
void matrix<T>::insertCol(int j, const std::vector<T>& c) {
    // The words of addCol are meant: to the caller both add a column.
    if (c.size() != static_cast<std::size_t>(m_)) {
        throw MatrixException("addCol column std::vector must be of same order");
    }
    openCol(j, c.data(), 1);
}

// Inserts row i: values[0], values[step], values[2 * step] and so on. A step of 0 repeats one value, which may be an
// element of this matrix; with a step of 1 the values lie elsewhere.
template <typename T>
void matrix<T>::openRow(int i, const T* values, std::ptrdiff_t step) {
    assert(0 <= i && i <= m_);
    checkStorage();
    elementCount(std::int64_t{m_} + 1, n_);
    const auto position = v_.begin() + offset(i, 0);
    if (step == 0) {
        v_.insert(position, static_cast<std::size_t>(n_), *values);
    } else {
        v_.insert(position, values, values + n_);
    }
    setDimensions(m_ + 1, n_);
}

// Inserts column j, with values as for openRow.
template <typename T>
void matrix<T>::openCol(int j, const T* values, std::ptrdiff_t step) {
    assert(0 <= j && j <= n_);
    checkStorage();
    const int count = elementCount(m_, std::int64_t{n_} + 1);
    const T repeated = m_ > 0 && step == 0 ? *values : T();
    if (step == 0) values = &repeated;
    v_.resize(static_cast<std::size_t>(count));

    // Between the new places of two rows lie n_ old elements, which move together. From the bottom up they only move
    // towards the end, so none is overwritten before it has moved.
    T* const elements = data();
    for (std::ptrdiff_t row = std::ptrdiff_t{m_} - 1; row >= 0; --row) {
        T* const oldPlace = elements + row * n_ + j;
        T* const newPlace = oldPlace + row;
        const std::ptrdiff_t following = row == m_ - 1 ? n_ - j : n_;
        std::copy_backward(oldPlace, oldPlace + following, newPlace + 1 + following);
        *newPlace = values[row * step];
    }
    setDimensions(m_, n_ + 1);
}

template <typename T>
void matrix<T>::removeRow(int i) {
    checkRow(i);
    // Never reached while the assertion stands before it; kept on purpose as the caller's error should it ever go.
    if (i < 0 || i >= m_) throw MatrixException("matrix access row out of range");
    const auto row = v_.begin() + offset(i, 0);
    v_.erase(row, row + n_);
    setDimensions(m_ - 1, n_);
}

template <typename T>
void matrix<T>::removeCol(int j) {
    checkCol(j);
    // Never reached while the assertion stands before it; kept on purpose as the caller's error should it ever go.
    if (j < 0 || j >= n_) throw MatrixException("matrix access col out of range");

    // The n_ - 1 elements between two removed ones move together, top row first, towards the front.
    T* const elements = data();
    for (std::ptrdiff_t row = 0; row < m_; ++row) {
        T* const removed = elements + row * n_ + j;
        const std::ptrdiff_t following = row == m_ - 1 ? n_ - 1 - j : n_ - 1;
        std::copy(removed + 1, removed + 1 + following, removed - row);
    }
    v_.resize(static_cast<std::size_t>(std::ptrdiff_t{m_} * (n_ - 1)));
    setDimensions(m_, n_ - 1);
}

template <typename T>
matrix<T> matrix<T>::delRow(int i) const {
    matrix result(*this);
    result.removeRow(i);
    return result;
}

template <typename T>
matrix<T> matrix<T>::delCol(int j) const {
    matrix result(*this);
    result.removeCol(j);
    return result;
}

template <typename T>
matrix<T> matrix<T>::getSubmatrix(int r, int c, int rows, int cols) const {
    if (r < 0 || c < 0 || std::int64_t{r} + rows > m_ || std::int64_t{c} + cols > n_) {
        throw MatrixException("matrix::getSubmatrix incompatible matrices");
    }
    matrix block(rows, cols, T());
    for (int i = 0; i < rows; ++i) {
        std::copy_n(data() + offset(r + i, c), cols, block.data() + block.offset(i, 0));
    }
    return block;
}

template <typename T>
void matrix<T>::setSubmatrix(int r, int c, const matrix& b) {
    if (r < 0 || c < 0 || std::int64_t{r} + b.m_ > m_ || std::int64_t{c} + b.n_ > n_) {
        throw MatrixException("matrix::setSubmatrix incompatible matrices");
    }
    // A matrix fits into itself in one place only, and there it changes nothing.
    if (this == &b) return;
    for (int i = 0; i < b.m_; ++i) {
        std::copy_n(b.data() + b.offset(i, 0), b.n_, data() + offset(r + i, c));
    }
}

template <typename T>
matrix<T>& matrix<T>::operator+=(const matrix& other) {
    QAN_ALLEGE(m_ == other.m_ && n_ == other.n_);
    QAN_ALLEGE(v_.size() == other.v_.size());
    const T* const added = other.data();
    for (std::size_t k = 0; k < v_.size(); ++k) {
        v_[k] += added[k];
    }
    return *this;
}

template <typename T>
matrix<T>& matrix<T>::operator-=(const matrix& other) {
    QAN_ALLEGE(m_ == other.m_ && n_ == other.n_);
    QAN_ALLEGE(v_.size() == other.v_.size());
    const T* const subtracted = other.data();
    for (std::size_t k = 0; k < v_.size(); ++k) {
        v_[k] -= subtracted[k];
    }
    return *this;
}

template <typename T>
matrix<T> matrix<T>::operator+(const matrix& other) const {
    matrix result(*this);
    result += other;
    return result;
}

template <typename T>
matrix<T> matrix<T>::operator-(const matrix& other) const {
    matrix result(*this);
    result -= other;
    return result;
}

template <typename T>
matrix<T> matrix<T>::operator-() const {
    matrix result(*this);
    for (T& element : result.v_) {
        element = -element;
    }
    return result;
}

template <typename T>
matrix<T>& matrix<T>::operator*=(const T& x) {
    const T factor = x;
    for (T& element : v_) {
        element *= factor;
    }
    return *this;
}

template <typename T>
matrix<T> matrix<T>::operator*(const T& x) const {
    matrix result(*this);
    result *= x;
    return result;
}

template <typename T>
matrix<T>& matrix<T>::operator/=(const T& x) {
    const T divisor = x;
    if (divisor == T()) throw std::overflow_error("op/ scalar division by zero");
    // No multiplication by the reciprocal: it would round twice.
    for (T& element : v_) {
        element /= divisor;
    }
    return *this;
}

template <typename T>
matrix<T> matrix<T>::operator/(const T& x) const {
    matrix result(*this);
    result /= x;
    return result;
}

template <typename T>
matrix<T> matrix<T>::transpose() const {
    if (m_ == 1 || n_ == 1) {
        matrix result(*this);
        result.setDimensions(n_, m_);
        return result;
    }
    matrix result(n_, m_, T());
    // In square tiles, so that the lines of both matrices stay in the cache while a tile is copied.
    constexpr int kTile = 16;
    for (int row = 0; row < m_; row += kTile) {
        for (int col = 0; col < n_; col += kTile) {
            const int rowEnd = std::min(row + kTile, m_);
            const int colEnd = std::min(col + kTile, n_);
            for (int j = col; j < colEnd; ++j) {
                for (int i = row; i < rowEnd; ++i) {
                    result.v_.data()[result.offset(j, i)] = v_.data()[offset(i, j)];
                }
            }
        }
    }
    return result;
}

template <typename T>
std::vector<T> matrix<T>::ConvertToVector() const {
    if (n_ != 1) throw MatrixException("vector cast: result not a vector");
    return v_;
}

// Whether two elements mirror each other; false when either is not a number or their difference is none.
template <typename T>
bool mirrorsWithinFuzz(const T& a, const T& b) {
    const double first = static_cast<double>(a);
    const double second = static_cast<double>(b);
    const double difference = std::fabs(first - second);
    if (kSymmetryFuzz > difference) return true;
    return std::max(std::fabs(first), std::fabs(second)) * kSymmetryFuzz + kSymmetryFuzz > difference;
}

template <typename T>
Smatrix<T> matrix<T>::ConvertToSmatrix() const {
    const int rows = m_;
    const int cols = n_;
    QAN_ALLEGE(rows == cols);
    for (int i = 0; i < rows; ++i) {
        for (int j = 0; j < i; ++j) {
            if (!mirrorsWithinFuzz((*this)(i, j), (*this)(j, i))) {
                throw MatrixException("Smatrix cast: result not a symmetric matrix");
            }
        }
    }
    return Smatrix<T>(*this, true);
}

}  // namespace qan::matrix_library

#endif
