#include "matrix/kernels/factorizations.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <utility>
#include <vector>

namespace reisti::kernels {

namespace {

// A row or a pivot below this, absolutely or relative to itself with this as the floor, counts as zero.
constexpr double kZeroFuzz = 4e-12;

bool isZero(double x) {
    const double magnitude = std::fabs(x);
    return magnitude < kZeroFuzz || magnitude * kZeroFuzz + kZeroFuzz > magnitude;
}

// Start of row i in a packed upper triangle, moved back by i so that column j is at [j].
std::size_t upperRow(std::size_t n, std::size_t i) {
    return i * n - i * (i + 1) / 2;
}

}  // namespace

bool factorLu(double* a, std::size_t n, int* index, double& parity) {
    std::fill_n(index, n, 0);
    parity = 1.0;
    std::vector<double> scale(n);
    for (std::size_t i = 0; i < n; ++i) {
        double greatest = 0.0;
        for (std::size_t j = 0; j < n; ++j)
            greatest = std::max(greatest, std::fabs(a[i * n + j]));
        if (isZero(greatest)) return false;
        scale[i] = 1.0 / greatest;
    }
    for (std::size_t j = 0; j < n; ++j) {
        double greatest = 0.0;
        std::size_t pivot = j;
        for (std::size_t i = 0; i < n; ++i) {
            double sum = 0.0;
            for (std::size_t k = 0; k < std::min(i, j); ++k)
                sum += a[i * n + k] * a[k * n + j];
            a[i * n + j] -= sum;
            if (i < j) continue;
            const double candidate = scale[i] * std::fabs(a[i * n + j]);
            // Ties go to the later row. A NaN is never chosen, and row j is the choice from the start.
            if (candidate >= greatest) {
                greatest = candidate;
                pivot = i;
            }
        }
        if (pivot != j) {
            std::swap_ranges(a + pivot * n, a + (pivot + 1) * n, a + j * n);
            parity = -parity;
            scale[pivot] = scale[j];
        }
        index[j] = static_cast<int>(pivot);
        if (isZero(a[j * n + j])) return false;
        if (j + 1 == n) break;
        const double reciprocal = 1.0 / a[j * n + j];
        for (std::size_t i = j + 1; i < n; ++i)
            a[i * n + j] *= reciprocal;
    }
    return true;
}

void solveLu(const double* lu, const int* index, std::size_t n, double* b) {
    // Leading zeros of the right-hand side stay zeros, whatever the factors hold there.
    std::size_t first = n;
    for (std::size_t i = 0; i < n; ++i) {
        const auto pivot = static_cast<std::size_t>(index[i]);
        double sum = b[pivot];
        b[pivot] = b[i];
        for (std::size_t k = first; k < i; ++k)
            sum -= lu[i * n + k] * b[k];
        if (first == n && sum != 0.0) first = i;
        b[i] = sum;
    }
    for (std::size_t i = n; i-- > 0;) {
        double sum = 0.0;
        for (std::size_t k = i + 1; k < n; ++k)
            sum += lu[i * n + k] * b[k];
        b[i] = (b[i] - sum) / lu[i * n + i];
    }
}

void solveLuColumns(const double* lu, const int* index, std::size_t n, double* b, std::size_t columns) {
    std::vector<double> column(n);
    for (std::size_t j = 0; j < columns; ++j) {
        for (std::size_t i = 0; i < n; ++i)
            column[i] = b[i * columns + j];
        solveLu(lu, index, n, column.data());
        for (std::size_t i = 0; i < n; ++i)
            b[i * columns + j] = column[i];
    }
}

void invertLu(const double* lu, const int* index, std::size_t n, double* inverse) {
    std::fill_n(inverse, n * n, 0.0);
    for (std::size_t i = 0; i < n; ++i)
        inverse[i * n + i] = 1.0;
    solveLuColumns(lu, index, n, inverse, n);
}

std::ptrdiff_t factorCholesky(double* a, std::size_t n, std::size_t start, double& pivot) {
    for (std::size_t j = start; j < n; ++j) {
        double squares = 0.0;
        for (std::size_t i = 0; i < j; ++i) {
            double& element = a[upperRow(n, i) + j];
            if (i >= start) {
                double sum = 0.0;
                for (std::size_t k = 0; k < i; ++k)
                    sum += a[upperRow(n, k) + i] * a[upperRow(n, k) + j];
                element = (element - sum) / a[upperRow(n, i) + i];
            }
            squares += element * element;
        }
        double& diagonal = a[upperRow(n, j) + j];
        pivot = diagonal - squares;
        if (0.0 >= pivot) {
            pivot = std::fabs(pivot);
            return static_cast<std::ptrdiff_t>(j);
        }
        diagonal = std::sqrt(pivot);
    }
    return -1;
}

void invertCholesky(const double* u, std::size_t n, double* inverse) {
    // Column j of the factor is row j of the packed lower triangle.
    const auto column = [inverse](std::size_t j) { return inverse + j * (j + 1) / 2; };
    for (std::size_t i = 0; i < n; ++i) {
        for (std::size_t j = i; j < n; ++j)
            column(j)[i] = *u++;
    }
    for (std::size_t j = 0; j < n; ++j) {
        const double reciprocal = 1.0 / column(j)[j];
        column(j)[j] = reciprocal;
        for (std::size_t i = 0; i < j; ++i)
            column(j)[i] *= -reciprocal;
        for (std::size_t m = j + 1; m < n; ++m) {
            const double factor = std::exchange(column(m)[j], 0.0);
            for (std::size_t i = 0; i <= j; ++i)
                column(m)[i] += factor * column(j)[i];
        }
    }
    for (std::size_t j = 0; j < n; ++j) {
        for (std::size_t i = 0; i < j; ++i) {
            const double factor = column(j)[i];
            for (std::size_t k = 0; k <= i; ++k)
                column(i)[k] += factor * column(j)[k];
        }
        const double diagonal = column(j)[j];
        for (std::size_t k = 0; k <= j; ++k)
            column(j)[k] *= diagonal;
    }
}

void solveCholesky(const double* u, std::size_t n, double* b) {
    for (std::size_t i = 0; i < n; ++i) {
        double sum = 0.0;
        for (std::size_t k = 0; k < i; ++k)
            sum += u[upperRow(n, k) + i] * b[k];
        b[i] = (b[i] - sum) / u[upperRow(n, i) + i];
    }
    for (std::size_t i = n; i-- > 0;) {
        double sum = 0.0;
        for (std::size_t k = i + 1; k < n; ++k)
            sum += u[upperRow(n, i) + k] * b[k];
        b[i] = (b[i] - sum) / u[upperRow(n, i) + i];
    }
}

}  // namespace reisti::kernels
