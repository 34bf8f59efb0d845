// Products with a structured operand. Diagonal operands scale; symmetric and triangular ones are unpacked strip by
// strip, so that a product runs at the speed of the dense one with a few kilobytes of scratch, and the triangle that
// the pattern cuts from a strip is multiplied by plain loops, which never meet a structural zero.
#include <algorithm>

#include "matrix/kernels/products.h"
#include "matrix/kernels/scaling.h"
#include "matrix/kernels/triangles.h"
#include "matrix/matrix_checks.h"
#include "matrix/matrix_products.h"
#include "matrix/vector_kernels.h"

namespace qan::matrix_library {

namespace {

namespace kernels = reisti::kernels;

using Index = std::ptrdiff_t;

// Values of k in a strip. Scratch memory grows with the strip, up to an eighth of what a dense copy would take; narrow
// strips cost more in traffic through the result.
Index stripOf(Index order) {
    constexpr Index kLeast = 32;
    constexpr Index kMost = 128;
    return std::clamp(order / 8 / kLeast * kLeast, kLeast, kMost);
}

// Some rows of row-major storage.
struct Panel {
    const double* data;
    Index stride;

    Panel from(Index row, Index column) const { return {data + row * stride + column, stride}; }
};

struct Target {
    double* data;
    Index stride;

    Target from(Index row, Index column) const { return {data + row * stride + column, stride}; }
};

// Calls a kernel on two panels and a target, with some sizes.
template <typename Kernel, typename... Sizes>
void call(Kernel kernel, Panel a, Panel b, Target c, Sizes... sizes) {
    kernel(a.data, static_cast<std::size_t>(a.stride), b.data, static_cast<std::size_t>(b.stride), c.data,
           static_cast<std::size_t>(c.stride), static_cast<std::size_t>(sizes)...);
}

// c (m x n) += a (m x k) * b (k x n).
void accumulate(Panel a, Panel b, Target c, Index m, Index k, Index n) {
    call(kernels::accumulateProduct, a, b, c, m, k, n);
}

constexpr Index kSmallTriangle = kernels::kSmallTriangle;

// How many rows of a triangle of k go into the first half: a whole number of small triangles.
Index firstPart(Index k) {
    return (k / 2 + kSmallTriangle - 1) / kSmallTriangle * kSmallTriangle;
}

// c += a * b where only the upper triangle of a, k x k, counts. In halves: what lies beside a half is a full product.
void accumulateUpperLeft(Panel a, Panel b, Target c, Index k, Index n) {
    if (k > kSmallTriangle) {
        const Index half = firstPart(k);
        accumulateUpperLeft(a, b, c, half, n);
        accumulate(a.from(0, half), b.from(half, 0), c, half, k - half, n);
        accumulateUpperLeft(a.from(half, half), b.from(half, 0), c.from(half, 0), k - half, n);
        return;
    }
    call(kernels::accumulateUpperLeft, a, b, c, k, n);
}

// c += a * b where only the upper triangle of b, k x k, counts; a has m rows.
void accumulateUpperRight(Panel a, Panel b, Target c, Index m, Index k) {
    if (k > kSmallTriangle) {
        const Index half = firstPart(k);
        accumulateUpperRight(a, b, c, m, half);
        accumulate(a, b.from(0, half), c.from(0, half), m, half, k - half);
        accumulateUpperRight(a.from(0, half), b.from(half, half), c.from(0, half), m, k - half);
        return;
    }
    call(kernels::accumulateUpperRight, a, b, c, m, k);
}

// c += a * b where only the upper triangles of both, k x k, count.
void accumulateUpperBoth(Panel a, Panel b, Target c, Index k) {
    if (k > kSmallTriangle) {
        const Index half = firstPart(k);
        accumulateUpperBoth(a, b, c, half);
        accumulateUpperLeft(a, b.from(0, half), c.from(0, half), half, k - half);
        accumulateUpperRight(a.from(0, half), b.from(half, half), c.from(0, half), half, k - half);
        accumulateUpperBoth(a.from(half, half), b.from(half, half), c.from(half, half), k - half);
        return;
    }
    for (Index i = 0; i < k; ++i) {
        for (Index l = i; l < k; ++l) {
            for (Index j = l; j < k; ++j) {
                c.data[i * c.stride + j] += a.data[i * a.stride + l] * b.data[l * b.stride + j];
            }
        }
    }
}

// A stride at which the rows of a strip do not compete for the same places in the cache.
Index scatteredStride(Index columns) {
    return (columns + 7) / 16 * 16 + 8;
}

Index packedRow(Index row) {
    return row * (row + 1) / 2;
}

// Where row `row` of a packed upper triangle would begin if it had all columns.
Index upperRow(Index order, Index row) {
    return row * order - packedRow(row);
}

// An operand hands out strips: columns k0 to k1 when it stands on the left, rows k0 to k1 when on the right. Strips may
// lie in the operand itself or in scratch memory that the next strip reuses. A strip that is cut by the pattern holds
// values only where the pattern does.

class DenseOperand {
  public:
    static constexpr bool kIsUpper = false;

    explicit DenseOperand(const matrix<double>& a) : whole_{a.data(), a.colCount()} {}

    Panel columns(Index k0, Index) const { return whole_.from(0, k0); }
    Panel rows(Index k0, Index) const { return whole_.from(k0, 0); }

  private:
    Panel whole_;
};

class SymmetricOperand {
  public:
    static constexpr bool kIsUpper = false;

    explicit SymmetricOperand(const Smatrix<double>& s)
        : packed_(s.data()), order_(s.rowCount()), strip_(stripOf(order_)) {}

    Panel columns(Index k0, Index k1) {
        scratch_.resize(static_cast<std::size_t>(order_ * strip_));
        // Above the strip its columns are stored as rows; a few rows of the strip at a time stay in the cache.
        constexpr Index kBand = 16;
        for (Index band = 0; band < k0; band += kBand) {
            for (Index k = k0; k < k1; ++k) {
                const double* const stored = packed_ + packedRow(k);
                for (Index i = band; i < std::min(band + kBand, k0); ++i) {
                    scratch_.data()[i * strip_ + k - k0] = stored[i];
                }
            }
        }
        for (Index i = k0; i < k1; ++i) {
            for (Index k = k0; k < k1; ++k) {
                scratch_.data()[i * strip_ + k - k0] = packed_[packedRow(std::max(i, k)) + std::min(i, k)];
            }
        }
        for (Index i = k1; i < order_; ++i) {
            std::copy_n(packed_ + packedRow(i) + k0, k1 - k0, scratch_.data() + i * strip_);
        }
        return {scratch_.data(), strip_};
    }

    Panel rows(Index k0, Index k1) {
        const Index stride = scatteredStride(order_);
        scratch_.resize(static_cast<std::size_t>(stride * strip_));
        for (Index k = k0; k < k1; ++k) {
            std::copy_n(packed_ + packedRow(k), k + 1, scratch_.data() + (k - k0) * stride);
        }
        // Right of the diagonal the rows are stored as columns.
        for (Index j = k0 + 1; j < order_; ++j) {
            const double* const stored = packed_ + packedRow(j);
            for (Index k = k0; k < std::min(k1, j); ++k) {
                scratch_.data()[(k - k0) * stride + j] = stored[k];
            }
        }
        return {scratch_.data(), stride};
    }

  private:
    const double* packed_;
    Index order_;
    Index strip_;
    std::vector<double> scratch_;
};

class UpperOperand {
  public:
    static constexpr bool kIsUpper = true;

    explicit UpperOperand(const UTmatrix<double>& u)
        : packed_(u.data()), order_(u.rowCount()), strip_(stripOf(order_)) {}

    // Rows 0 to k1.
    Panel columns(Index k0, Index k1) {
        scratch_.resize(static_cast<std::size_t>(order_ * strip_));
        for (Index i = 0; i < k1; ++i) {
            const Index first = std::max(i, k0);
            std::copy_n(packed_ + upperRow(order_, i) + first, k1 - first, scratch_.data() + i * strip_ + first - k0);
        }
        return {scratch_.data(), strip_};
    }

    // Columns k0 to the end, the first of them at column k0 of the panel.
    Panel rows(Index k0, Index k1) {
        const Index stride = scatteredStride(order_);
        scratch_.resize(static_cast<std::size_t>(stride * strip_));
        for (Index k = k0; k < k1; ++k) {
            std::copy_n(packed_ + upperRow(order_, k) + k, order_ - k, scratch_.data() + (k - k0) * stride + k);
        }
        return {scratch_.data(), stride};
    }

  private:
    const double* packed_;
    Index order_;
    Index strip_;
    std::vector<double> scratch_;
};

// left (m x depth) * right (depth x n), at most one of them triangular. Strips come in ascending k, and each continues
// the sums of those before it.
template <typename Left, typename Right>
matrix<double> multiplyByStrips(Left left, Right right, int m, int depth, int n) {
    static_assert(!(Left::kIsUpper && Right::kIsUpper));
    matrix<double> result(m, n, 0.0);
    if (result.empty()) return result;
    const Target c{result.data(), n};
    const Index strip = stripOf(depth);
    for (Index k0 = 0; k0 < depth; k0 += strip) {
        const Index k1 = std::min<Index>(k0 + strip, depth);
        const Panel a = left.columns(k0, k1);
        const Panel b = right.rows(k0, k1);
        if constexpr (Left::kIsUpper) {
            accumulate(a, b, c, k0, k1 - k0, n);
            accumulateUpperLeft(a.from(k0, 0), b, c.from(k0, 0), k1 - k0, n);
        } else if constexpr (Right::kIsUpper) {
            accumulateUpperRight(a, b.from(0, k0), c.from(0, k0), m, k1 - k0);
            accumulate(a, b.from(0, k1), c.from(0, k1), m, k1 - k0, n - k1);
        } else {
            accumulate(a, b, c, m, k1 - k0, n);
        }
    }
    return result;
}

matrix<double> symmetricTimesVector(const Smatrix<double>& s, const double* x) {
    matrix<double> result(s.rowCount(), 1, 0.0);
    symmetricTimesColumn(s.data(), static_cast<std::size_t>(s.rowCount()), x, result.data());
    return result;
}

// Rows i0 to i1 of a * b, both upper triangular, into c, whose first column is column i0 of the product. The number of
// rows is that of a strip, or all that are left.
void multiplyUpperRows(const UTmatrix<double>& a, UpperOperand& b, Index i0, Index i1, Target c) {
    const Index order = a.rowCount();
    const Index rows = i1 - i0;
    const Index width = order - i0;
    std::vector<double> unpacked(static_cast<std::size_t>(rows * width));
    for (Index i = i0; i < i1; ++i) {
        std::copy_n(a.data() + upperRow(order, i) + i, order - i, unpacked.data() + (i - i0) * width + i - i0);
    }
    const Panel left{unpacked.data(), width};

    const Panel first = b.rows(i0, i1);
    accumulateUpperBoth(left, first.from(0, i0), c, rows);
    accumulateUpperLeft(left, first.from(0, i1), c.from(0, rows), rows, order - i1);
    const Index strip = stripOf(order);
    for (Index k0 = i1; k0 < order; k0 += strip) {
        const Index k1 = std::min(k0 + strip, order);
        const Panel factors = left.from(0, k0 - i0);
        const Panel right = b.rows(k0, k1);
        accumulateUpperRight(factors, right.from(0, k0), c.from(0, k0 - i0), rows, k1 - k0);
        accumulate(factors, right.from(0, k1), c.from(0, k1 - i0), rows, k1 - k0, order - k1);
    }
}

// A scale multiplies elements of row i of a result, in place: `count` of them from column `first` on.

// Row i by element i of the diagonal.
struct ByRow {
    const double* diagonal;

    void operator()(double* elements, Index i, Index, Index count) const {
        kernels::scaleRow(elements, diagonal[i], static_cast<std::size_t>(count));
    }
};

// Every row element for element by the diagonal.
struct ByColumn {
    const double* diagonal;

    void operator()(double* elements, Index, Index first, Index count) const {
        kernels::scaleElements(elements, diagonal + first, static_cast<std::size_t>(count));
    }
};

// So many elements are copied and scaled at a time, while they are in the nearest cache.
constexpr Index kElementsAtOnce = 512;

template <typename Scale>
matrix<double> copyAndScale(const matrix<double>& a, Scale scale) {
    if (a.empty()) return a;
    const Index cols = a.colCount();
    const Index rowsAtOnce = std::max<Index>(kElementsAtOnce / cols, 1);
    const Index colsAtOnce = std::min(kElementsAtOnce, cols);
    std::vector<double> elements;
    elements.reserve(static_cast<std::size_t>(a.size()));
    for (Index i0 = 0; i0 < a.rowCount(); i0 += rowsAtOnce) {
        const Index i1 = std::min<Index>(i0 + rowsAtOnce, a.rowCount());
        for (Index j0 = 0; j0 < cols; j0 += colsAtOnce) {
            // Either some whole rows or a part of one.
            const Index count = std::min(colsAtOnce, cols - j0);
            const double* const source = a.data() + i0 * cols + j0;
            elements.insert(elements.end(), source, source + (i1 - i0) * count);
            for (Index i = i0; i < i1; ++i) {
                scale(elements.data() + i * cols + j0, i, j0, count);
            }
        }
    }
    return matrix<double>(std::move(elements), a.colCount());
}

template <typename Scale>
matrix<double> unpackAndScale(const Smatrix<double>& s, Scale scale) {
    const Index order = s.rowCount();
    SymmetricOperand operand(s);
    std::vector<double> elements;
    elements.reserve(static_cast<std::size_t>(elementCount(order, order)));
    const Index strip = stripOf(order);
    for (Index i0 = 0; i0 < order; i0 += strip) {
        const Index i1 = std::min(i0 + strip, order);
        const Panel rows = operand.rows(i0, i1);
        for (Index i = i0; i < i1; ++i) {
            const double* const row = rows.from(i - i0, 0).data;
            elements.insert(elements.end(), row, row + order);
            scale(elements.data() + i * order, i, 0, order);
        }
    }
    return matrix<double>(std::move(elements), s.rowCount());
}

template <typename Scale>
UTmatrix<double> scaleUpper(const UTmatrix<double>& u, Scale scale) {
    UTmatrix<double> result(u);
    const Index order = u.rowCount();
    for (Index i = 0; i < order; ++i) {
        scale(result.data() + upperRow(order, i) + i, i, i, order - i);
    }
    return result;
}

}  // namespace

matrix<double> operator*(const matrix<double>& a, const Smatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    // One row times a symmetric matrix has the terms of the matrix times that row as a column.
    if (a.rowCount() == 1) return symmetricTimesVector(b, a.data()).transpose();
    return multiplyByStrips(DenseOperand(a), SymmetricOperand(b), a.rowCount(), b.rowCount(), b.colCount());
}

matrix<double> operator*(const matrix<double>& a, const UTmatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    if (a.rowCount() == 1) {
        matrix<double> result(1, b.colCount(), 0.0);
        rowTimesUpper(a.data(), b.data(), static_cast<std::size_t>(b.rowCount()), result.data());
        return result;
    }
    return multiplyByStrips(DenseOperand(a), UpperOperand(b), a.rowCount(), b.rowCount(), b.colCount());
}

matrix<double> operator*(const matrix<double>& a, const Dmatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return copyAndScale(a, ByColumn{b.data()});
}

matrix<double> operator*(const Smatrix<double>& a, const matrix<double>& b) {
    checkMultiplyDimensions(a, b);
    if (b.colCount() == 1) return symmetricTimesVector(a, b.data());
    return multiplyByStrips(SymmetricOperand(a), DenseOperand(b), a.rowCount(), b.rowCount(), b.colCount());
}

matrix<double> operator*(const Smatrix<double>& a, const Smatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return multiplyByStrips(SymmetricOperand(a), SymmetricOperand(b), a.rowCount(), b.rowCount(), b.colCount());
}

matrix<double> operator*(const Smatrix<double>& a, const UTmatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return multiplyByStrips(SymmetricOperand(a), UpperOperand(b), a.rowCount(), b.rowCount(), b.colCount());
}

matrix<double> operator*(const Smatrix<double>& a, const Dmatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return unpackAndScale(a, ByColumn{b.data()});
}

matrix<double> operator*(const UTmatrix<double>& a, const matrix<double>& b) {
    checkMultiplyDimensions(a, b);
    if (b.colCount() == 1) {
        matrix<double> result(a.rowCount(), 1, 0.0);
        upperTimesColumn(a.data(), static_cast<std::size_t>(a.rowCount()), b.data(), result.data());
        return result;
    }
    return multiplyByStrips(UpperOperand(a), DenseOperand(b), a.rowCount(), b.rowCount(), b.colCount());
}

matrix<double> operator*(const UTmatrix<double>& a, const Smatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return multiplyByStrips(UpperOperand(a), SymmetricOperand(b), a.rowCount(), b.rowCount(), b.colCount());
}

UTmatrix<double> operator*(const UTmatrix<double>& a, const UTmatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    const Index order = a.rowCount();
    UTmatrix<double> result(a.rowCount(), 0.0);
    UpperOperand right(b);
    const Index strip = stripOf(order);
    for (Index i0 = 0; i0 < order; i0 += strip) {
        const Index i1 = std::min(i0 + strip, order);
        const Index width = order - i0;
        std::vector<double> sums(static_cast<std::size_t>((i1 - i0) * width));
        multiplyUpperRows(a, right, i0, i1, {sums.data(), width});
        for (Index i = i0; i < i1; ++i) {
            std::copy_n(sums.data() + (i - i0) * width + i - i0, order - i, result.data() + upperRow(order, i) + i);
        }
    }
    return result;
}

UTmatrix<double> operator*(const UTmatrix<double>& a, const Dmatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return scaleUpper(a, ByColumn{b.data()});
}

matrix<double> operator*(const Dmatrix<double>& a, const matrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return copyAndScale(b, ByRow{a.data()});
}

matrix<double> operator*(const Dmatrix<double>& a, const Smatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return unpackAndScale(b, ByRow{a.data()});
}

UTmatrix<double> operator*(const Dmatrix<double>& a, const UTmatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return scaleUpper(b, ByRow{a.data()});
}

Dmatrix<double> operator*(const Dmatrix<double>& a, const Dmatrix<double>& b) {
    Dmatrix<double> result(a);
    result *= b;
    return result;
}

Dmatrix<double>& operator*=(Dmatrix<double>& a, const Dmatrix<double>& b) {
    checkEqualDimensions(a, b, "diagonal matrix elementwise op");
    checkMultiplyDimensions(a, b);
    for (int i = 0; i < a.rowCount(); ++i) {
        a(i, i) *= b.data()[i];
    }
    return a;
}

matrix<double> operator*(const Smatrix<double>& a, const std::vector<double>& v) {
    if (v.size() != static_cast<std::size_t>(a.colCount())) {
        throw MatrixException("matrix and vector must be of same order");
    }
    return symmetricTimesVector(a, v.data());
}

}  // namespace qan::matrix_library
