// Factorizations and inverses. Everybody starts from a finished matrix in its own storage and ends with a result in
// memory of its own.
#include <vector>

#include "peers.h"

namespace reisti::bench {
namespace {

namespace ours = qan::matrix_library;

void decomposeOurs(benchmark::State& state) {
    const Dense a = randomDense(orderOf(state), 1);
    for (auto _ : state)
        benchmark::DoNotOptimize(ours::LUDecomposition(a));
}

void decomposePeer(benchmark::State& state) {
    const Peer a = toPeer(randomDense(orderOf(state), 1));
    for (auto _ : state)
        benchmark::DoNotOptimize(Eigen::PartialPivLU<Peer>(a));
}

void invertOurs(benchmark::State& state) {
    const Dense a = randomDense(orderOf(state), 1);
    Dense inverted;
    for (auto _ : state) {
        ours::inverse(a, &inverted);
        benchmark::DoNotOptimize(inverted.data());
    }
}

void invertPeer(benchmark::State& state) {
    const Peer a = toPeer(randomDense(orderOf(state), 1));
    Peer inverted;
    for (auto _ : state) {
        inverted = a.inverse();
        benchmark::DoNotOptimize(inverted.data());
    }
}

void determineOurs(benchmark::State& state) {
    const Dense a = randomDense(orderOf(state), 1);
    double determinant = 0.0;
    for (auto _ : state) {
        ours::determinant(a, &determinant);
        benchmark::DoNotOptimize(determinant);
    }
}

void determinePeer(benchmark::State& state) {
    const Peer a = toPeer(randomDense(orderOf(state), 1));
    for (auto _ : state)
        benchmark::DoNotOptimize(a.determinant());
}

void choleskyOurs(benchmark::State& state) {
    const Symmetric a(randomPositive(orderOf(state), 1));
    Upper u;
    for (auto _ : state) {
        ours::CholeskyDecomp(a, &u);
        benchmark::DoNotOptimize(u.data());
    }
}

void choleskyPeer(benchmark::State& state) {
    const Peer a = toPeer(randomPositive(orderOf(state), 1));
    for (auto _ : state)
        benchmark::DoNotOptimize(Eigen::LLT<Peer>(a));
}

void choleskyInverseOurs(benchmark::State& state) {
    const Upper u = ours::CholeskyDecompWithThrow(Symmetric(randomPositive(orderOf(state), 1)));
    for (auto _ : state)
        benchmark::DoNotOptimize(ours::CholeskyInverse(u));
}

void choleskyInversePeer(benchmark::State& state) {
    const Eigen::LLT<Peer> llt(toPeer(randomPositive(orderOf(state), 1)));
    const int n = orderOf(state);
    Peer inverted;
    for (auto _ : state) {
        inverted = llt.solve(Peer::Identity(n, n));
        benchmark::DoNotOptimize(inverted.data());
    }
}

#ifdef REISTI_BENCH_OPENBLAS

std::vector<double> elementsOf(const Dense& a) {
    return {a.data(), a.data() + a.size()};
}

void decomposeBound(benchmark::State& state) {
    const std::vector<double> a = elementsOf(randomDense(orderOf(state), 1));
    const int n = orderOf(state);
    std::vector<int> pivots(a.size());
    int info = 0;
    for (auto _ : state) {
        std::vector<double> lu(a);
        dgetrf_(&n, &n, lu.data(), &n, pivots.data(), &info);
        benchmark::DoNotOptimize(lu.data());
    }
}

void invertBound(benchmark::State& state) {
    const std::vector<double> a = elementsOf(randomDense(orderOf(state), 1));
    const int n = orderOf(state);
    std::vector<int> pivots(a.size());
    const int scratch = 64 * n;
    std::vector<double> work(static_cast<std::size_t>(scratch));
    int info = 0;
    for (auto _ : state) {
        std::vector<double> lu(a);
        dgetrf_(&n, &n, lu.data(), &n, pivots.data(), &info);
        dgetri_(&n, lu.data(), &n, pivots.data(), work.data(), &scratch, &info);
        benchmark::DoNotOptimize(lu.data());
    }
}

void choleskyBound(benchmark::State& state) {
    const std::vector<double> a = elementsOf(randomPositive(orderOf(state), 1));
    const int n = orderOf(state);
    int info = 0;
    for (auto _ : state) {
        std::vector<double> factor(a);
        dpotrf_("L", &n, factor.data(), &n, &info);
        benchmark::DoNotOptimize(factor.data());
    }
}

void choleskyInverseBound(benchmark::State& state) {
    std::vector<double> factor = elementsOf(randomPositive(orderOf(state), 1));
    const int n = orderOf(state);
    int info = 0;
    dpotrf_("L", &n, factor.data(), &n, &info);
    for (auto _ : state) {
        std::vector<double> inverted(factor);
        dpotri_("L", &n, inverted.data(), &n, &info);
        benchmark::DoNotOptimize(inverted.data());
    }
}

#endif

void orders(benchmark::internal::Benchmark* benchmark) {
    for (const int order : {8, 32, 128, 512, 1024})
        benchmark->Arg(order);
}

BENCHMARK(decomposeOurs)->Name("LUDecomposition/ours")->Apply(orders);
BENCHMARK(decomposePeer)->Name("LUDecomposition/eigen")->Apply(orders);
BENCHMARK(invertOurs)->Name("inverse/ours")->Apply(orders);
BENCHMARK(invertPeer)->Name("inverse/eigen")->Apply(orders);
BENCHMARK(determineOurs)->Name("determinant/ours")->Apply(orders);
BENCHMARK(determinePeer)->Name("determinant/eigen")->Apply(orders);
BENCHMARK(choleskyOurs)->Name("CholeskyDecomp/ours")->Apply(orders);
BENCHMARK(choleskyPeer)->Name("CholeskyDecomp/eigen")->Apply(orders);
BENCHMARK(choleskyInverseOurs)->Name("CholeskyInverse/ours")->Apply(orders);
BENCHMARK(choleskyInversePeer)->Name("CholeskyInverse/eigen")->Apply(orders);
#ifdef REISTI_BENCH_OPENBLAS
BENCHMARK(decomposeBound)->Name("LUDecomposition/openblas")->Apply(orders);
BENCHMARK(invertBound)->Name("inverse/openblas")->Apply(orders);
BENCHMARK(decomposeBound)->Name("determinant/openblas")->Apply(orders);
BENCHMARK(choleskyBound)->Name("CholeskyDecomp/openblas")->Apply(orders);
BENCHMARK(choleskyInverseBound)->Name("CholeskyInverse/openblas")->Apply(orders);
#endif

}  // namespace
}  // namespace reisti::bench
