// Growing and cutting a matrix, products of structured matrices and expressions, each beside its bound: a block move, a
// copy or the dense product of the same order.
#include <benchmark/benchmark.h>
#include <cstring>
#include <random>
#include <vector>

#include "matrix/matrix_library.h"

namespace {

using qan::matrix_library::Dmatrix;
using qan::matrix_library::matrix;
using qan::matrix_library::Smatrix;
using qan::matrix_library::UTmatrix;

constexpr int kRowLength = 10;

std::vector<double> randomValues(int count) {
    std::mt19937_64 generator(1);
    std::uniform_real_distribution<double> value(-1.0, 1.0);
    std::vector<double> values(static_cast<std::size_t>(count));
    for (double& x : values)
        x = value(generator);
    return values;
}

int orderOf(const benchmark::State& state) {
    return static_cast<int>(state.range(0));
}

matrix<double> dense(int order) {
    return {randomValues(order * order), order};
}
UTmatrix<double> upper(int order) {
    return {order, randomValues(UTmatrix<double>::calculate_size(order))};
}
Smatrix<double> symmetric(int order) {
    return Smatrix<double>(dense(order), true);
}

Dmatrix<double> diagonal(int order) {
    const std::vector<double> values = randomValues(order);
    Dmatrix<double> d(order, 0.0);
    std::copy(values.begin(), values.end(), d.data());
    return d;
}

/// Bytes of a dense matrix of the order, counted once: times of moves and copies compare directly.
void countBytes(benchmark::State& state) {
    state.SetBytesProcessed(state.iterations() * state.range(0) * state.range(0) *
                            static_cast<std::int64_t>(sizeof(double)));
}

// ---- growing and cutting

void addRows(benchmark::State& state) {
    const std::vector<double> row(kRowLength, 1.0);
    for (auto _ : state) {
        matrix<double> m;
        for (std::int64_t i = 0; i < state.range(0); ++i)
            m.addRow(row);
        benchmark::DoNotOptimize(m.data());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
    state.SetComplexityN(state.range(0));
}
BENCHMARK(addRows)->RangeMultiplier(10)->Range(10'000, 1'000'000)->Complexity(benchmark::oN);

/// The bound of addRows: the same rows into a vector.
void appendToVector(benchmark::State& state) {
    const std::vector<double> row(kRowLength, 1.0);
    for (auto _ : state) {
        std::vector<double> v;
        for (std::int64_t i = 0; i < state.range(0); ++i)
            v.insert(v.end(), row.begin(), row.end());
        benchmark::DoNotOptimize(v.data());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(appendToVector)->Arg(1'000'000);

/// The bound of the four that follow: the whole matrix moved by one row.
void moveAll(benchmark::State& state) {
    const int order = orderOf(state);
    std::vector<double> v = randomValues(order * (order + 1));
    const std::size_t bytes = static_cast<std::size_t>(order * order) * sizeof(double);
    for (auto _ : state) {
        std::memmove(v.data() + order, v.data(), bytes);
        benchmark::ClobberMemory();
    }
    countBytes(state);
}
BENCHMARK(moveAll)->Arg(100)->Arg(1000);

// Each change is undone in the same iteration by one that costs little: at the end for rows, or a second measured one.
void insertFirstRowRemoveLast(benchmark::State& state) {
    matrix<double> m = dense(orderOf(state));
    for (auto _ : state) {
        m.insertRow(0, 1.0);
        m.removeRow(m.rowCount() - 1);
        benchmark::ClobberMemory();
    }
    countBytes(state);
}
BENCHMARK(insertFirstRowRemoveLast)->Arg(100)->Arg(1000);

void addRowRemoveFirst(benchmark::State& state) {
    matrix<double> m = dense(orderOf(state));
    for (auto _ : state) {
        m.addRow(1.0);
        m.removeRow(0);
        benchmark::ClobberMemory();
    }
    countBytes(state);
}
BENCHMARK(addRowRemoveFirst)->Arg(100)->Arg(1000);

/// Two passes over the matrix: twice the bound.
void insertAndRemoveFirstCol(benchmark::State& state) {
    matrix<double> m = dense(orderOf(state));
    for (auto _ : state) {
        m.insertCol(0, 1.0);
        m.removeCol(0);
        benchmark::ClobberMemory();
    }
    countBytes(state);
}
BENCHMARK(insertAndRemoveFirstCol)->Arg(100)->Arg(1000);

/// The same on a long narrow matrix, where every row costs a call.
void insertAndRemoveColOfNarrow(benchmark::State& state) {
    matrix<double> m(100'000, kRowLength, 1.0);
    for (auto _ : state) {
        m.insertCol(kRowLength / 2, 2.0);
        m.removeCol(kRowLength / 2);
        benchmark::ClobberMemory();
    }
    state.SetBytesProcessed(state.iterations() * 100'000 * kRowLength * static_cast<std::int64_t>(sizeof(double)));
}
BENCHMARK(insertAndRemoveColOfNarrow);

// ---- diagonal products

/// The bound of diagonalTimesDense and denseTimesDiagonal.
void copyDense(benchmark::State& state) {
    const matrix<double> b = dense(orderOf(state));
    for (auto _ : state) {
        matrix<double> c(b);
        benchmark::DoNotOptimize(c.data());
    }
    countBytes(state);
}
BENCHMARK(copyDense)->Arg(100)->Arg(1000);

/// left * right, both built for the order.
template <auto kLeft, auto kRight>
void product(benchmark::State& state) {
    const auto a = kLeft(orderOf(state));
    const auto b = kRight(orderOf(state));
    for (auto _ : state) {
        auto c = a * b;
        benchmark::DoNotOptimize(c.data());
    }
    countBytes(state);
}
BENCHMARK(product<diagonal, dense>)->Name("diagonalTimesDense")->Arg(100)->Arg(1000);
BENCHMARK(product<dense, diagonal>)->Name("denseTimesDiagonal")->Arg(100)->Arg(1000);
BENCHMARK(product<symmetric, diagonal>)->Name("symmetricTimesDiagonal")->Arg(100)->Arg(1000);

// ---- other structured products

BENCHMARK(product<dense, dense>)->Name("denseTimesDense")->Arg(32)->Arg(128)->Arg(512)->Arg(1000);
BENCHMARK(product<symmetric, dense>)->Name("symmetricTimesDense")->Arg(32)->Arg(128)->Arg(512)->Arg(1000);
BENCHMARK(product<dense, symmetric>)->Name("denseTimesSymmetric")->Arg(32)->Arg(128)->Arg(512)->Arg(1000);
BENCHMARK(product<symmetric, symmetric>)->Name("symmetricTimesSymmetric")->Arg(32)->Arg(128)->Arg(512)->Arg(1000);
BENCHMARK(product<upper, dense>)->Name("upperTimesDense")->Arg(32)->Arg(128)->Arg(512)->Arg(1000);
BENCHMARK(product<dense, upper>)->Name("denseTimesUpper")->Arg(32)->Arg(128)->Arg(512)->Arg(1000);
BENCHMARK(product<upper, upper>)->Name("upperTimesUpper")->Arg(32)->Arg(128)->Arg(512)->Arg(1000);

// ---- products with a vector

template <auto kLeft>
void timesVector(benchmark::State& state) {
    const auto a = kLeft(orderOf(state));
    const std::vector<double> x = randomValues(orderOf(state));
    for (auto _ : state) {
        auto c = a * x;
        benchmark::DoNotOptimize(c.data());
    }
    countBytes(state);
}
BENCHMARK(timesVector<dense>)->Name("denseTimesVector")->Arg(100)->Arg(1000);
BENCHMARK(timesVector<symmetric>)->Name("symmetricTimesVector")->Arg(100)->Arg(1000);

// ---- expressions

/// One column of a product that would fill 3.2 gigabytes.
void columnOfLargeProduct(benchmark::State& state) {
    using namespace qan::matrix_library::expressions;
    constexpr int kLength = 20'000;
    const auto e = Mult(M_(matrix<double>(kLength, 1, 2.0)), M_(matrix<double>(1, kLength, 3.0)));
    for (auto _ : state) {
        auto column = GetColumn(e, kLength / 2);
        benchmark::DoNotOptimize(column.data());
    }
}
BENCHMARK(columnOfLargeProduct);

}  // namespace
