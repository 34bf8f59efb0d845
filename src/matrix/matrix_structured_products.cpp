// Products with a structured operand. Diagonal operands scale; symmetric and triangular ones are unpacked strip by
// strip, so that a product runs at the speed of the dense one with a few kilobytes of scratch, and the triangle that
// the pattern cuts from a strip is multiplied by plain loops, which never meet a structural zero.
#include <algorithm>

#include "matrix/kernels/products.h"
#include "matrix/matrix_checks.h"
#include "matrix/matrix_products.h"
#include "matrix/vector_kernels.h"

namespace qan::matrix_library {

namespace {

using Index = std::ptrdiff_t;

// Values of k in a strip. Wide strips cost more in the cut triangles, narrow ones more in traffic through the result.
constexpr Index kStrip = 32;

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

void accumulate(Panel a, Panel b, Target c, Index m, Index k, Index n) {
    reisti::kernels::accumulateProduct(a.data, static_cast<std::size_t>(a.stride), b.data,
                                       static_cast<std::size_t>(b.stride), c.data, static_cast<std::size_t>(c.stride),
                                       static_cast<std::size_t>(m), static_cast<std::size_t>(k),
                                       static_cast<std::size_t>(n));
}

// accumulate where only the upper triangle of a, of b or of both counts.
void accumulateUpper(Panel a, bool isUpperA, Panel b, bool isUpperB, Target c, Index m, Index k, Index n) {
    for (Index i = 0; i < m; ++i) {
        double* const sums = c.data + i * c.stride;
        for (Index l = isUpperA ? i : 0; l < k; ++l) {
            const double factor = a.data[i * a.stride + l];
            const double* const row = b.data + l * b.stride;
            for (Index j = isUpperB ? l : 0; j < n; ++j) {
                sums[j] += factor * row[j];
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

    explicit SymmetricOperand(const Smatrix<double>& s) : packed_(s.data()), order_(s.rowCount()) {}

    Panel columns(Index k0, Index k1) {
        scratch_.resize(static_cast<std::size_t>(order_ * kStrip));
        // Above the strip its columns are stored as rows; a few rows of the strip at a time stay in the cache.
        constexpr Index kBand = 16;
        for (Index band = 0; band < k0; band += kBand) {
            for (Index k = k0; k < k1; ++k) {
                const double* const stored = packed_ + packedRow(k);
                for (Index i = band; i < std::min(band + kBand, k0); ++i) {
                    scratch_.data()[i * kStrip + k - k0] = stored[i];
                }
            }
        }
        for (Index i = k0; i < k1; ++i) {
            for (Index k = k0; k < k1; ++k) {
                scratch_.data()[i * kStrip + k - k0] = packed_[packedRow(std::max(i, k)) + std::min(i, k)];
            }
        }
        for (Index i = k1; i < order_; ++i) {
            std::copy_n(packed_ + packedRow(i) + k0, k1 - k0, scratch_.data() + i * kStrip);
        }
        return {scratch_.data(), kStrip};
    }

    Panel rows(Index k0, Index k1) {
        const Index stride = scatteredStride(order_);
        scratch_.resize(static_cast<std::size_t>(stride * kStrip));
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
    std::vector<double> scratch_;
};

class UpperOperand {
  public:
    static constexpr bool kIsUpper = true;

    explicit UpperOperand(const UTmatrix<double>& u) : packed_(u.data()), order_(u.rowCount()) {}

    // Rows 0 to k1.
    Panel columns(Index k0, Index k1) {
        scratch_.resize(static_cast<std::size_t>(order_ * kStrip));
        for (Index i = 0; i < k1; ++i) {
            const Index first = std::max(i, k0);
            std::copy_n(packed_ + upperRow(order_, i) + first, k1 - first, scratch_.data() + i * kStrip + first - k0);
        }
        return {scratch_.data(), kStrip};
    }

    // Columns k0 to the end, the first of them at column k0 of the panel.
    Panel rows(Index k0, Index k1) {
        const Index stride = scatteredStride(order_);
        scratch_.resize(static_cast<std::size_t>(stride * kStrip));
        for (Index k = k0; k < k1; ++k) {
            std::copy_n(packed_ + upperRow(order_, k) + k, order_ - k, scratch_.data() + (k - k0) * stride + k);
        }
        return {scratch_.data(), stride};
    }

  private:
    const double* packed_;
    Index order_;
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
    for (Index k0 = 0; k0 < depth; k0 += kStrip) {
        const Index k1 = std::min<Index>(k0 + kStrip, depth);
        const Panel a = left.columns(k0, k1);
        const Panel b = right.rows(k0, k1);
        if constexpr (Left::kIsUpper) {
            accumulate(a, b, c, k0, k1 - k0, n);
            accumulateUpper(a.from(k0, 0), true, b, false, c.from(k0, 0), k1 - k0, k1 - k0, n);
        } else if constexpr (Right::kIsUpper) {
            accumulateUpper(a, false, b.from(0, k0), true, c.from(0, k0), m, k1 - k0, k1 - k0);
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

// Rows i0 to i1 of a * b, both upper triangular, into c, whose first column is column i0 of the product.
void multiplyUpperRows(const UTmatrix<double>& a, UpperOperand& b, Index i0, Index i1, Target c) {
    const Index order = a.rowCount();
    const Index rows = i1 - i0;
    const Index width = order - i0;
    std::vector<double> strip(static_cast<std::size_t>(rows * width));
    for (Index i = i0; i < i1; ++i) {
        std::copy_n(a.data() + upperRow(order, i) + i, order - i, strip.data() + (i - i0) * width + i - i0);
    }
    const Panel left{strip.data(), width};
    for (Index k0 = i0; k0 < order; k0 += kStrip) {
        const Index k1 = std::min(k0 + kStrip, order);
        const Index depth = k1 - k0;
        const bool isDiagonal = k0 == i0;
        const Panel factors = left.from(0, k0 - i0);
        const Panel right = b.rows(k0, k1);
        accumulateUpper(factors, isDiagonal, right.from(0, k0), true, c.from(0, k0 - i0), rows, depth, depth);
        if (isDiagonal) {
            accumulateUpper(factors, true, right.from(0, k1), false, c.from(0, k1 - i0), rows, depth, order - k1);
        } else {
            accumulate(factors, right.from(0, k1), c.from(0, k1 - i0), rows, depth, order - k1);
        }
    }
}

// The product of one term is still a sum that starts from 0.0: minus zero becomes zero.
double oneTerm(double x, double y) {
    return 0.0 + x * y;
}

// Rows of a dense matrix are copied and scaled a few at a time, while they are in the cache.
template <typename Scale>
matrix<double> copyAndScaleRows(const matrix<double>& a, Scale scale) {
    if (a.empty()) return a;
    constexpr Index kElementsAtOnce = 1024;
    const Index cols = a.colCount();
    const Index rowsAtOnce = std::max<Index>(kElementsAtOnce / cols, 1);
    std::vector<double> elements;
    elements.reserve(static_cast<std::size_t>(a.size()));
    for (Index i0 = 0; i0 < a.rowCount(); i0 += rowsAtOnce) {
        const Index i1 = std::min<Index>(i0 + rowsAtOnce, a.rowCount());
        elements.insert(elements.end(), a.data() + i0 * cols, a.data() + i1 * cols);
        for (Index i = i0; i < i1; ++i) {
            scale(elements.data() + i * cols, i, cols);
        }
    }
    return matrix<double>(std::move(elements), a.colCount());
}

// Multiplies rows, of any length, by one element of the diagonal each; or element for element by the diagonal.
auto byRow(const double* diagonal) {
    return [diagonal](double* row, Index i, Index cols) {
        const double factor = diagonal[i];
        for (Index j = 0; j < cols; ++j) {
            row[j] = oneTerm(factor, row[j]);
        }
    };
}

auto byColumn(const double* diagonal) {
    return [diagonal](double* row, Index, Index cols) {
        for (Index j = 0; j < cols; ++j) {
            row[j] = oneTerm(row[j], diagonal[j]);
        }
    };
}

template <typename Scale>
matrix<double> unpackAndScaleRows(const Smatrix<double>& s, Scale scale) {
    const Index order = s.rowCount();
    SymmetricOperand operand(s);
    std::vector<double> elements;
    elements.reserve(static_cast<std::size_t>(elementCount(order, order)));
    for (Index i0 = 0; i0 < order; i0 += kStrip) {
        const Index i1 = std::min(i0 + kStrip, order);
        const Panel strip = operand.rows(i0, i1);
        for (Index i = i0; i < i1; ++i) {
            const double* const row = strip.from(i - i0, 0).data;
            elements.insert(elements.end(), row, row + order);
            scale(elements.data() + i * order, i, order);
        }
    }
    return matrix<double>(std::move(elements), s.rowCount());
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
    return multiplyByStrips(DenseOperand(a), UpperOperand(b), a.rowCount(), b.rowCount(), b.colCount());
}

matrix<double> operator*(const matrix<double>& a, const Dmatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return copyAndScaleRows(a, byColumn(b.data()));
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
    return unpackAndScaleRows(a, byColumn(b.data()));
}

matrix<double> operator*(const UTmatrix<double>& a, const matrix<double>& b) {
    checkMultiplyDimensions(a, b);
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
    for (Index i0 = 0; i0 < order; i0 += kStrip) {
        const Index i1 = std::min(i0 + kStrip, order);
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
    UTmatrix<double> result(a);
    const Index order = a.rowCount();
    for (Index i = 0; i < order; ++i) {
        byColumn(b.data() + i)(result.data() + upperRow(order, i) + i, i, order - i);
    }
    return result;
}

matrix<double> operator*(const Dmatrix<double>& a, const matrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return copyAndScaleRows(b, byRow(a.data()));
}

matrix<double> operator*(const Dmatrix<double>& a, const Smatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    return unpackAndScaleRows(b, byRow(a.data()));
}

UTmatrix<double> operator*(const Dmatrix<double>& a, const UTmatrix<double>& b) {
    checkMultiplyDimensions(a, b);
    UTmatrix<double> result(b);
    const Index order = b.rowCount();
    for (Index i = 0; i < order; ++i) {
        byRow(a.data())(result.data() + upperRow(order, i) + i, i, order - i);
    }
    return result;
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
