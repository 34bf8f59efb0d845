// What the benchmarks of the matrix package are measured beside. Every benchmark is called Operation/who/order, with
// `ours`, `eigen` (the peer, compiled with the same flags) and `openblas` (the bound, where it is installed).
#ifndef REISTI_BENCH_MATRIX_PEERS_H
#define REISTI_BENCH_MATRIX_PEERS_H

#include <Eigen/Dense>
#include <benchmark/benchmark.h>
#include <cstdint>
#include <random>

#include "matrix/matrix_library.h"

#ifdef REISTI_BENCH_OPENBLAS
#include <cblas.h>

extern "C" {
void dgetrf_(const int* m, const int* n, double* a, const int* lda, int* ipiv, int* info);
void dgetri_(const int* n, double* a, const int* lda, const int* ipiv, double* work, const int* lwork, int* info);
void dpotrf_(const char* uplo, const int* n, double* a, const int* lda, int* info);
void dpotri_(const char* uplo, const int* n, double* a, const int* lda, int* info);
void dsyevd_(const char* jobz, const char* uplo, const int* n, double* a, const int* lda, double* w, double* work,
             const int* lwork, int* iwork, const int* liwork, int* info);
}

// Everybody works on one thread.
inline const bool kBoundUsesOneThread = [] {
    openblas_set_num_threads(1);
    return true;
}();
#endif

namespace reisti::bench {

using Dense = qan::matrix_library::matrix<double>;
using Symmetric = qan::matrix_library::Smatrix<double>;
using Upper = qan::matrix_library::UTmatrix<double>;
using Peer = Eigen::MatrixXd;

/// The same seeded random matrix for everybody; values from -1 to 1.
inline Dense randomDense(int order, std::uint32_t seed) {
    std::mt19937_64 engine(seed);
    std::uniform_real_distribution<double> uniform(-1.0, 1.0);
    Dense a(order, order, 0.0);
    for (int i = 0; i < a.size(); ++i)
        a.data()[i] = uniform(engine);
    return a;
}

inline Peer toPeer(const Dense& a) {
    using RowMajor = Eigen::Matrix<double, Eigen::Dynamic, Eigen::Dynamic, Eigen::RowMajor>;
    return Eigen::Map<const RowMajor>(a.data(), a.rowCount(), a.colCount());
}

/// Symmetric, with eigenvalues of both signs.
inline Dense randomSymmetric(int order, std::uint32_t seed) {
    Dense a = randomDense(order, seed);
    for (int i = 0; i < order; ++i) {
        for (int j = 0; j < i; ++j)
            a(j, i) = a(i, j);
    }
    return a;
}

/// Symmetric and positive definite: the diagonal outweighs the rest.
inline Dense randomPositive(int order, std::uint32_t seed) {
    Dense a = randomSymmetric(order, seed);
    for (int i = 0; i < order; ++i)
        a(i, i) += order;
    return a;
}

inline int orderOf(const benchmark::State& state) {
    return static_cast<int>(state.range(0));
}

}  // namespace reisti::bench

#endif
