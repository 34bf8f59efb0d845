#include "matrix/vector_kernels.h"

#include <algorithm>

namespace qan::matrix_library {

namespace {

// A sum in fixed order waits for each addition; so many sums at once fill the wait.
constexpr std::size_t kTogether = 8;

template <std::size_t kRows>
void rowsTimesColumn(const double* a, std::size_t cols, const double* x, double* y) {
    double sum[kRows] = {};
    for (std::size_t k = 0; k < cols; ++k) {
        for (std::size_t r = 0; r < kRows; ++r) {
            sum[r] += a[r * cols + k] * x[k];
        }
    }
    std::copy_n(sum, kRows, y);
}

// The rows of the lower triangle from `first` on, kRows of them. Element i of y already holds its terms of columns
// below `first`, for i < first; on return the elements up to the last of these rows hold those up to that row.
template <std::size_t kRows>
void addSymmetricRows(const double* s, std::size_t first, const double* x, double* y) {
    const double* row[kRows];
    for (std::size_t r = 0; r < kRows; ++r) {
        row[r] = s + (first + r) * (first + r + 1) / 2;
    }
    double sum[kRows] = {};
    for (std::size_t i = 0; i < first; ++i) {
        double mirrored = y[i];
        for (std::size_t r = 0; r < kRows; ++r) {
            sum[r] += row[r][i] * x[i];
            mirrored += row[r][i] * x[first + r];
        }
        y[i] = mirrored;
    }
    for (std::size_t r = 0; r < kRows; ++r) {
        for (std::size_t i = first; i < first + r; ++i) {
            sum[r] += row[r][i] * x[i];
            y[i] += row[r][i] * x[first + r];
        }
        y[first + r] = sum[r] + row[r][first + r] * x[first + r];
    }
}

// Rows of an upper triangle, kRows of them; rows[r] is where row r would begin if it had all columns.
template <std::size_t kRows>
void upperRowsTimesColumn(const double* const* rows, std::size_t first, std::size_t order, const double* x, double* y) {
    double sum[kRows] = {};
    for (std::size_t r = 0; r < kRows; ++r) {
        for (std::size_t k = first + r; k < first + kRows; ++k) {
            sum[r] += rows[r][k] * x[k];
        }
    }
    for (std::size_t k = first + kRows; k < order; ++k) {
        for (std::size_t r = 0; r < kRows; ++r) {
            sum[r] += rows[r][k] * x[k];
        }
    }
    std::copy_n(sum, kRows, y + first);
}

}  // namespace

void timesColumn(const double* a, std::size_t rows, std::size_t cols, const double* x, double* y) {
    std::size_t i = 0;
    for (; i + kTogether <= rows; i += kTogether) {
        rowsTimesColumn<kTogether>(a + i * cols, cols, x, y + i);
    }
    for (; i < rows; ++i) {
        rowsTimesColumn<1>(a + i * cols, cols, x, y + i);
    }
}

void symmetricTimesColumn(const double* s, std::size_t order, const double* x, double* y) {
    constexpr std::size_t kRows = kTogether / 2;
    std::size_t k = 0;
    for (; k + kRows <= order; k += kRows) {
        addSymmetricRows<kRows>(s, k, x, y);
    }
    for (; k < order; ++k) {
        addSymmetricRows<1>(s, k, x, y);
    }
}

void upperTimesColumn(const double* u, std::size_t order, const double* x, double* y) {
    const double* rows[kTogether];
    std::size_t i = 0;
    for (; i + kTogether <= order; i += kTogether) {
        for (std::size_t r = 0; r < kTogether; ++r) {
            rows[r] = u + (i + r) * order - (i + r) * (i + r + 1) / 2;
        }
        upperRowsTimesColumn<kTogether>(rows, i, order, x, y);
    }
    for (; i < order; ++i) {
        rows[0] = u + i * order - i * (i + 1) / 2;
        upperRowsTimesColumn<1>(rows, i, order, x, y);
    }
}

void rowTimesUpper(const double* x, const double* u, std::size_t order, double* y) {
    std::fill_n(y, order, 0.0);
    for (std::size_t k = 0; k < order; ++k) {
        for (std::size_t j = k; j < order; ++j) {
            y[j] += x[k] * *u++;
        }
    }
}

}  // namespace qan::matrix_library
