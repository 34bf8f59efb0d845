// The matrix kinds: what they hold, how their elements are reached, and the index checks they share.
#ifndef REISTI_MATRIX_MATRIX_NEW_H
#define REISTI_MATRIX_MATRIX_NEW_H

#include <cassert>
#include <concepts>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "matrix/allege.h"
#include "matrix/matrix_dimensions.h"

namespace qan::matrix_library {

template <typename T>
class Dmatrix;
template <typename T>
class UTmatrix;
template <typename T>
class Smatrix;

// The general dense matrix, for T = double and T = int.
//
// 1. mn_ == m_ * n_, and it is also the number of stored elements.
// 2. Element (i, j) is stored at i * n_ + j.
// Only the constructor from a vector can break the first property, when the length is no multiple of the columns;
// whatever grows the storage asserts it.
//
// Indices start at 0. Where a comment says "unchecked", a release build trusts the caller. A failed call leaves the
// matrix as it was. Values and matrices passed in may be parts of the matrix itself.
template <typename T>
class matrix {
  public:
    matrix() = default;
    matrix(int rows, int cols, const T& fill);
    // Row by row; v.size() / cols rows, and a remainder is kept but belongs to no row (deliberately not rejected).
    matrix(const std::vector<T>& v, int cols);
    // The same, taking over the storage of v: tables of hundreds of megabytes are built row by row and then handed
    // over.
    matrix(std::vector<T>&& v, int cols);
    matrix(const Dmatrix<T>& d);
    matrix(const UTmatrix<T>& u);
    matrix(const Smatrix<T>& s);
    matrix(const matrix& other);
    matrix(matrix&& other) noexcept;
    ~matrix() = default;

    static matrix CreateRowVector(const std::vector<T>& v);

    matrix& operator=(const matrix& other);
    matrix& operator=(matrix&& other) noexcept;
    matrix& operator=(const Dmatrix<T>& d);
    matrix& operator=(const UTmatrix<T>& u);
    matrix& operator=(const Smatrix<T>& s);
    // Every element becomes x.
    matrix& operator=(const T& x);
    // Becomes the column v, unless the stored elements already equal v: then not even the dimensions change, on
    // purpose.
    matrix& operator=(const std::vector<T>& v);
    void set(const T& x);
    void swap(matrix& other) noexcept;

    // New dimensions; every element becomes fill, old contents are never kept.
    void Initialize(int rows, int cols, const T& fill);
    void resize(int rows, int cols, const T& fill);
    void ResizeStorage(int rows, int cols, const T& fill);

    int rowCount() const { return m_; }
    int colCount() const { return n_; }
    int size() const { return mn_; }
    bool empty() const { return mn_ == 0; }

    // Unchecked.
    T& operator()(int i, int j) {
        assertElement(i, j);
        return v_.data()[offset(i, j)];
    }
    const T& operator()(int i, int j) const {
        assertElement(i, j);
        return v_.data()[offset(i, j)];
    }

    T& at(int row, int column) {
        QAN_ALLEGE(row >= 0 && row < m_);
        QAN_ALLEGE(column >= 0 && column < n_);
        return v_.data()[offset(row, column)];
    }
    const T& at(int row, int column) const {
        QAN_ALLEGE(row >= 0 && row < m_);
        QAN_ALLEGE(column >= 0 && column < n_);
        return v_.data()[offset(row, column)];
    }

    // Checks nothing, and is meant to: generic callers name it for every kind.
    void range_check(int, int) const {}

    // The elements row by row.
    T* data() { return v_.data(); }
    const T* data() const { return v_.data(); }

    matrix getRow(int i) const;                // unchecked; 1 by n
    std::vector<T> getRowVector(int i) const;  // unchecked
    matrix getCol(int j) const;                // m by 1
    std::vector<T> getColVector(int j) const;
    void setRow(int i, const matrix& r);          // the first row of r
    void setRow(int i, const std::vector<T>& r);  // length unchecked
    void setCol(int j, const matrix& c);          // the first elements of c
    void setCol(int j, const std::vector<T>& c);  // length unchecked

    // Appending needs amortized constant time per element. A matrix without elements takes the length of the first row
    // or column; a single value has no length to offer and throws.
    void addRow(const std::vector<T>& r);
    void addRow(const T& x);
    void addCol(const std::vector<T>& c);
    void addCol(const T& x);

    // Before row i or column j; the positions are unchecked.
    void insertRow(int i, const T& x);
    void insertRow(int i, const std::vector<T>& r);
    void insertCol(int j, const T& x);
    void insertCol(int j, const std::vector<T>& c);

    void removeRow(int i);
    void removeCol(int j);
    matrix delRow(int i) const;
    matrix delCol(int j) const;

    // The rows by cols block whose first element is (r, c).
    matrix getSubmatrix(int r, int c, int rows, int cols) const;
    void setSubmatrix(int r, int c, const matrix& b);

    matrix& operator+=(const matrix& other);
    matrix& operator-=(const matrix& other);
    matrix operator+(const matrix& other) const;
    matrix operator-(const matrix& other) const;
    matrix operator-() const;
    matrix& operator*=(const T& x);
    matrix operator*(const T& x) const;
    // std::overflow_error when x is 0.
    matrix& operator/=(const T& x);
    matrix operator/(const T& x) const;
    matrix transpose() const;

    // Only a single column converts.
    std::vector<T> ConvertToVector() const;
    operator std::vector<T>() const { return ConvertToVector(); }
    // The lower triangle of a matrix that is symmetric within kSymmetryFuzz.
    Smatrix<T> ConvertToSmatrix() const;
    void mFlattenMatrix(std::vector<T>& out, int start, bool byRows) const;

    // As the free functions of matrix_functions.h and matrix_quadratic_forms.h, of double only. Templates, so that the
    // instantiation of matrix<int> passes them over.
    template <std::same_as<double> U = T>
    int EigenSystems(std::vector<U>& values, matrix<U>& vectors) const;
    template <std::same_as<double> U = T>
    U mQuadraticForm(const std::vector<U>& x) const;
    template <std::same_as<double> U = T>
    U mQuadraticForm(const matrix<U>& b, const std::vector<U>& x, const std::vector<U>& y) const;

    void CheckInvariant() const { QAN_ALLEGE(signature_ == matrixsignature_); }

  private:
    static constexpr std::uint32_t matrixsignature_ = 0xFEEDBAAA;

    std::ptrdiff_t offset(int i, int j) const { return std::ptrdiff_t{i} * n_ + j; }
    void assertElement([[maybe_unused]] int i, [[maybe_unused]] int j) const {
        assert(0 <= i && i < m_);
        assert(0 <= j && j < n_);
    }
    void checkRow(int i) const { QAN_ALLEGE(0 <= i && i < m_); }
    void checkCol(int j) const { QAN_ALLEGE(0 <= j && j < n_); }
    void checkStorage() const;
    void openRow(int i, const T* values, std::ptrdiff_t step);
    void openCol(int j, const T* values, std::ptrdiff_t step);
    void setDimensions(int rows, int cols);

    std::uint32_t signature_ = matrixsignature_;
    int m_ = 0;
    int n_ = 0;
    int mn_ = 0;
    std::vector<T> v_;
};

// The square kinds below store their order m_ and only the elements that their pattern leaves free. Positions outside
// the pattern read 0; a write there is discarded, on purpose, by handing out scratch_. Order and packed indices are
// ints, as in the dense matrix.

// Diagonal: v_[i] is element (i, i).
template <typename T>
class Dmatrix {
  public:
    Dmatrix() = default;
    Dmatrix(int n, const T& fill);
    Dmatrix(const Dmatrix& other) = default;
    Dmatrix(Dmatrix&& other) noexcept { swap(other); }
    ~Dmatrix() = default;
    Dmatrix& operator=(Dmatrix other) noexcept {
        swap(other);
        return *this;
    }
    void swap(Dmatrix& other) noexcept;

    void resize(int n, const T& fill);  // old contents are dropped
    void set(const T& x);

    int rowCount() const { return m_; }
    int colCount() const { return m_; }
    int size() const { return m_; }

    // Unchecked.
    T& operator()(int i, int j) { return i == j ? v_.data()[i] : (scratch_ = T()); }
    const T& operator()(int i, int j) const { return i == j ? v_.data()[i] : zero_; }
    T& at(int row, int column) {
        QAN_ALLEGE(row >= 0 && row < m_);
        QAN_ALLEGE(column >= 0 && column < m_);
        return (*this)(row, column);
    }
    const T& at(int row, int column) const {
        QAN_ALLEGE(row >= 0 && row < m_);
        QAN_ALLEGE(column >= 0 && column < m_);
        return (*this)(row, column);
    }
    void range_check(int, int) const {}

    // The diagonal.
    T* data() { return v_.data(); }
    const T* data() const { return v_.data(); }

    Dmatrix operator-() const;
    Dmatrix transpose() const { return *this; }
    matrix<T> getCol(int j) const;  // unchecked; m by 1
    void removeColRow(int i);       // unchecked
    // Does nothing when r and c differ, on purpose: such a block has no stored place.
    void setSubmatrix(int r, int c, const Dmatrix& d);

    // Writes the inverse, or an empty matrix when there is none, and returns a diagonal matrix of order 1 or 0 for
    // success or failure, whose element is 0. The odd result is kept: callers read its order only.
    Dmatrix inverse(Dmatrix* result) const;

  private:
    T zero_ = T();
    int m_ = 0;
    std::vector<T> v_;
    T scratch_ = T();
};

// Upper-triangular: row i holds columns i to m_ - 1, row after row.
template <typename T>
class UTmatrix {
  public:
    UTmatrix() = default;
    UTmatrix(int n, const T& fill);
    UTmatrix(int m, const std::vector<T>& v);  // packed as above
    UTmatrix(const UTmatrix& other) = default;
    UTmatrix(UTmatrix&& other) noexcept { swap(other); }
    ~UTmatrix() = default;
    UTmatrix& operator=(UTmatrix other) noexcept {
        swap(other);
        return *this;
    }
    void swap(UTmatrix& other) noexcept;

    static int calculate_size(int m) { return triangleCount(m); }
    void resize(int n, const T& fill);  // old contents are dropped
    void set(const T& x);

    int rowCount() const { return m_; }
    int colCount() const { return m_; }
    int size() const { return m_; }  // the order, and meant to be, unlike Smatrix

    // Unchecked.
    T& operator()(int i, int j) { return i <= j ? v_.data()[offset(i, j)] : (scratch_ = T()); }
    const T& operator()(int i, int j) const { return i <= j ? v_.data()[offset(i, j)] : zero_; }
    T& at(int row, int column) {
        QAN_ALLEGE(row >= 0 && row < m_);
        QAN_ALLEGE(column >= 0 && column < m_);
        return (*this)(row, column);
    }
    const T& at(int row, int column) const {
        QAN_ALLEGE(row >= 0 && row < m_);
        QAN_ALLEGE(column >= 0 && column < m_);
        return (*this)(row, column);
    }
    void range_check(int, int) const {}

    // The packed elements.
    T* data() { return v_.data(); }
    const T* data() const { return v_.data(); }

    UTmatrix operator-() const;
    matrix<T> transpose() const;  // dense: no kind of ours stores a lower triangle

    // As the free functions of matrix_functions.h.
    UTmatrix CholeskyDecomp(int start, int* failedRow, double* pivot) const;
    std::vector<T> CholeskyBackSub(const std::vector<T>& b) const;
    Smatrix<T> CholeskyInverse() const;

  private:
    std::ptrdiff_t offset(std::ptrdiff_t i, std::ptrdiff_t j) const { return i * m_ - i * (i + 1) / 2 + j; }

    int m_ = 0;
    std::vector<T> v_;
    T zero_ = T();
    T scratch_ = T();
};

// Symmetric: row a of the lower triangle holds columns 0 to a, row after row; (i, j) and (j, i) are one element.
template <typename T>
class Smatrix {
  public:
    Smatrix() = default;
    Smatrix(int n, const T& fill);
    // The lower triangle of a matrix that is symmetric within kSymmetryFuzz.
    Smatrix(const matrix<T>& a);
    // One triangle of a square matrix, whatever the other holds.
    Smatrix(const matrix<T>& a, bool lower);
    Smatrix(const Smatrix& other) = default;
    Smatrix(Smatrix&& other) noexcept { swap(other); }
    ~Smatrix() = default;
    Smatrix& operator=(Smatrix other) noexcept {
        swap(other);
        return *this;
    }
    Smatrix& operator=(const matrix<T>& a);
    void swap(Smatrix& other) noexcept;

    static int calculate_size(int m) { return triangleCount(m); }
    void resize(int n, const T& fill);  // old contents are dropped
    void set(const T& x);

    int rowCount() const { return m_; }
    int colCount() const { return m_; }
    int size() const { return static_cast<int>(v_.size()); }  // stored elements, and meant to be, unlike UTmatrix
    bool isEmpty() const { return m_ == 0; }

    // Unchecked.
    T& operator()(int i, int j) { return v_.data()[offset(i, j)]; }
    const T& operator()(int i, int j) const { return v_.data()[offset(i, j)]; }
    T& at(int i, int j) {
        QAN_ALLEGE(i >= 0 && i < m_);
        QAN_ALLEGE(j >= 0 && j < m_);
        return (*this)(i, j);
    }
    const T& at(int i, int j) const {
        QAN_ALLEGE(i >= 0 && i < m_);
        QAN_ALLEGE(j >= 0 && j < m_);
        return (*this)(i, j);
    }
    void range_check(int, int) const {}

    // The packed elements.
    T* data() { return v_.data(); }
    const T* data() const { return v_.data(); }

    Smatrix operator-() const;
    Smatrix transpose() const { return *this; }
    std::vector<T> getRowVector(int i) const;
    std::vector<T> getColVector(int j) const;
    matrix<T> getSubmatrix(int r, int c, int rows, int cols) const;  // unchecked

    // A new row and column before target_row, which may equal the order.
    void insertColRow(int target_row, const T& x);
    void insertColRow(int target_row, const std::vector<T>& v);
    void removeColRow(int j);
    Smatrix delColRow(int j) const;

    // Adds a[k] * c[i] + b[k] to the elements (i, k), k <= i, of the first n rows; n and the lengths are unchecked.
    void UpdateForFisher(const std::vector<T>& a, const std::vector<T>& b, const std::vector<T>& c, int n);

    UTmatrix<T> mSmatrixToUTmatrix() const;
    // As the free functions of matrix_functions.h and matrix_quadratic_forms.h.
    bool CholeskyDecomp(UTmatrix<T>* factor) const;
    T mQuadraticForm(const std::vector<T>& x) const;
    T mQuadraticForm(const matrix<T>& b, const std::vector<T>& x, const std::vector<T>& y) const;
    void mFlattenMatrix(std::vector<T>& out, int start, bool byRows) const;

  private:
    static std::ptrdiff_t offset(std::ptrdiff_t i, std::ptrdiff_t j) {
        return i >= j ? i * (i + 1) / 2 + j : j * (j + 1) / 2 + i;
    }
    void checkStorage() const;

    int m_ = 0;
    std::vector<T> v_;
};

}  // namespace qan::matrix_library

#include "matrix/matrix_conversions.h"
#include "matrix/matrix_diagonal_impl.h"
#include "matrix/matrix_impl.h"
#include "matrix/matrix_symmetric_impl.h"
#include "matrix/matrix_upper_impl.h"

namespace qan::matrix_library {

// Compiled once, in matrix_impl.cpp.
extern template class matrix<double>;
extern template class matrix<int>;
extern template class Dmatrix<double>;
extern template class UTmatrix<double>;
extern template class Smatrix<double>;

}  // namespace qan::matrix_library

#endif
