#include "matrix/kernels/factorizations.h"

#include "matrix/kernels/level_table.h"

namespace reisti::kernels {

namespace {

// Start of row i in a packed upper triangle, moved back by i so that column j is at [j].
std::size_t upperRow(std::size_t n, std::size_t i) {
    return i * n - i * (i + 1) / 2;
}

}  // namespace

bool factorLu(double* a, std::size_t n, int* index, double& parity) {
    return bestTable().factorLu(a, n, index, parity);
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
    bestTable().solveLuColumns(lu, index, n, b, columns);
}

void invertLu(const double* lu, const int* index, std::size_t n, double* inverse) {
    bestTable().invertLu(lu, index, n, inverse);
}

std::ptrdiff_t factorCholesky(double* a, std::size_t n, std::size_t start, double& pivot) {
    return bestTable().factorCholesky(a, n, start, pivot);
}

void invertCholesky(const double* u, std::size_t n, double* inverse) {
    bestTable().invertCholesky(u, n, inverse);
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
