// Eigenvalues and eigenvectors of symmetric matrices.
#include <vector>

#include "peers.h"

namespace reisti::bench {
namespace {

void solveOurs(benchmark::State& state) {
    const Dense a = randomSymmetric(orderOf(state), 1);
    std::vector<double> values;
    Dense vectors;
    for (auto _ : state) {
        qan::matrix_library::EigenSystems(a, values, vectors);
        benchmark::DoNotOptimize(vectors.data());
    }
}

void solvePeer(benchmark::State& state) {
    const Peer a = toPeer(randomSymmetric(orderOf(state), 1));
    for (auto _ : state)
        benchmark::DoNotOptimize(Eigen::SelfAdjointEigenSolver<Peer>(a));
}

#ifdef REISTI_BENCH_OPENBLAS

// Divide and conquer: fewer operations than QL iteration needs.
void solveBound(benchmark::State& state) {
    const Dense a = randomSymmetric(orderOf(state), 1);
    const int n = orderOf(state);
    std::vector<double> values(static_cast<std::size_t>(n));
    const int workLength = 1 + 6 * n + 2 * n * n;
    const int intLength = 3 + 5 * n;
    std::vector<double> work(static_cast<std::size_t>(workLength));
    std::vector<int> intWork(static_cast<std::size_t>(intLength));
    int info = 0;
    for (auto _ : state) {
        std::vector<double> vectors(a.data(), a.data() + a.size());
        dsyevd_("V", "L", &n, vectors.data(), &n, values.data(), work.data(), &workLength, intWork.data(), &intLength,
                &info);
        benchmark::DoNotOptimize(vectors.data());
    }
}

#endif

void orders(benchmark::internal::Benchmark* benchmark) {
    for (const int order : {8, 32, 64, 128, 256, 512})
        benchmark->Arg(order);
}

BENCHMARK(solveOurs)->Name("EigenSystems/ours")->Apply(orders);
BENCHMARK(solvePeer)->Name("EigenSystems/eigen")->Apply(orders);
#ifdef REISTI_BENCH_OPENBLAS
BENCHMARK(solveBound)->Name("EigenSystems/openblas")->Apply(orders);
#endif

}  // namespace
}  // namespace reisti::bench
