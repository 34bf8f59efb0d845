// Products of square dense matrices, each into a matrix that the caller keeps.
#include "peers.h"

namespace reisti::bench {
namespace {

namespace ours = qan::matrix_library;

void multiplyOurs(benchmark::State& state) {
    const Dense a = randomDense(orderOf(state), 1);
    const Dense b = randomDense(orderOf(state), 2);
    Dense c;
    for (auto _ : state) {
        c = a * b;
        benchmark::DoNotOptimize(c.data());
    }
}

void multiplyPeer(benchmark::State& state) {
    const Peer a = toPeer(randomDense(orderOf(state), 1));
    const Peer b = toPeer(randomDense(orderOf(state), 2));
    Peer c;
    for (auto _ : state) {
        c = a * b;
        benchmark::DoNotOptimize(c.data());
    }
}

void multiplyLeftTransposeOurs(benchmark::State& state) {
    const Dense a = randomDense(orderOf(state), 1);
    const Dense b = randomDense(orderOf(state), 2);
    Dense c;
    for (auto _ : state) {
        ours::multiplyLeftTranspose(a, b, c);
        benchmark::DoNotOptimize(c.data());
    }
}

void multiplyLeftTransposePeer(benchmark::State& state) {
    const Peer a = toPeer(randomDense(orderOf(state), 1));
    const Peer b = toPeer(randomDense(orderOf(state), 2));
    Peer c(orderOf(state), orderOf(state));
    for (auto _ : state) {
        c.noalias() = a.transpose() * b;
        benchmark::DoNotOptimize(c.data());
    }
}

void multiplyRightTransposeOurs(benchmark::State& state) {
    const Dense a = randomDense(orderOf(state), 1);
    const Dense b = randomDense(orderOf(state), 2);
    Dense c;
    for (auto _ : state) {
        ours::multiplyRightTranspose(a, b, c);
        benchmark::DoNotOptimize(c.data());
    }
}

void multiplyRightTransposePeer(benchmark::State& state) {
    const Peer a = toPeer(randomDense(orderOf(state), 1));
    const Peer b = toPeer(randomDense(orderOf(state), 2));
    Peer c(orderOf(state), orderOf(state));
    for (auto _ : state) {
        c.noalias() = a * b.transpose();
        benchmark::DoNotOptimize(c.data());
    }
}

#ifdef REISTI_BENCH_OPENBLAS

void multiplyBound(benchmark::State& state, CBLAS_TRANSPOSE leftForm, CBLAS_TRANSPOSE rightForm) {
    const int n = orderOf(state);
    const Dense a = randomDense(n, 1);
    const Dense b = randomDense(n, 2);
    Dense c(n, n, 0.0);
    for (auto _ : state) {
        cblas_dgemm(CblasRowMajor, leftForm, rightForm, n, n, n, 1.0, a.data(), n, b.data(), n, 0.0, c.data(), n);
        benchmark::DoNotOptimize(c.data());
    }
}

#endif

void orders(benchmark::internal::Benchmark* benchmark) {
    for (const int order : {8, 32, 128, 512, 1024})
        benchmark->Arg(order);
}

BENCHMARK(multiplyOurs)->Name("product/ours")->Apply(orders);
BENCHMARK(multiplyPeer)->Name("product/eigen")->Apply(orders);
BENCHMARK(multiplyLeftTransposeOurs)->Name("multiplyLeftTranspose/ours")->Apply(orders);
BENCHMARK(multiplyLeftTransposePeer)->Name("multiplyLeftTranspose/eigen")->Apply(orders);
BENCHMARK(multiplyRightTransposeOurs)->Name("multiplyRightTranspose/ours")->Apply(orders);
BENCHMARK(multiplyRightTransposePeer)->Name("multiplyRightTranspose/eigen")->Apply(orders);
#ifdef REISTI_BENCH_OPENBLAS
BENCHMARK_CAPTURE(multiplyBound, , CblasNoTrans, CblasNoTrans)->Name("product/openblas")->Apply(orders);
BENCHMARK_CAPTURE(multiplyBound, , CblasTrans, CblasNoTrans)->Name("multiplyLeftTranspose/openblas")->Apply(orders);
BENCHMARK_CAPTURE(multiplyBound, , CblasNoTrans, CblasTrans)->Name("multiplyRightTranspose/openblas")->Apply(orders);
#endif

}  // namespace
}  // namespace reisti::bench
