#ifndef REISTI_TESTS_UNIT_MATRIX_SOLVER_SAMPLES_H
#define REISTI_TESTS_UNIT_MATRIX_SOLVER_SAMPLES_H

#include <cmath>

#include "support/plain_matrix.h"

namespace reisti::test {

/// Random symmetric positive definite: R^T R plus a little of the identity.
inline PlainMatrix positiveDefinite(int order, UniformNumbers& random) {
    const PlainMatrix r = random.matrix(order, order);
    PlainMatrix result = plainProduct(plainTranspose(r), r);
    for (int i = 0; i < order; ++i)
        result(i, i) += 0.5;
    return result;
}

/// Symmetric positive definite with a diagonal that falls from 1 to 1e-10: badly scaled, but well conditioned after
/// scaling, so that no pivot is lost.
inline PlainMatrix graded(int order, UniformNumbers& random) {
    PlainMatrix result(order, order);
    for (int i = 0; i < order; ++i) {
        for (int j = 0; j <= i; ++j) {
            const double scale = std::pow(10.0, -5.0 * (i + j) / std::max(1, order - 1));
            result(i, j) = result(j, i) = scale * (i == j ? 1.0 : random.between(-0.4, 0.4) / order);
        }
    }
    return result;
}

/// Elements 1 / (i + j + 1): the condition number grows by a factor of about 30 with each order.
inline PlainMatrix hilbert(int order) {
    PlainMatrix result(order, order);
    for (int i = 0; i < order; ++i)
        for (int j = 0; j < order; ++j)
            result(i, j) = 1.0 / (i + j + 1);
    return result;
}

/// Random symmetric, in general indefinite.
inline PlainMatrix randomSymmetric(int order, UniformNumbers& random) {
    PlainMatrix result = random.matrix(order, order);
    for (int i = 0; i < order; ++i)
        for (int j = 0; j < i; ++j)
            result(j, i) = result(i, j);
    return result;
}

/// A random orthogonal matrix, a product of reflections.
inline PlainMatrix randomOrthogonal(int order, UniformNumbers& random) {
    PlainMatrix result = plainIdentity(order);
    for (int reflection = 0; reflection < order; ++reflection) {
        const PlainMatrix v = random.matrix(order, 1);
        const double squaredLength = plainProduct(plainTranspose(v), v)(0, 0);
        const PlainMatrix image = plainProduct(plainTranspose(v), result);
        for (int i = 0; i < order; ++i)
            for (int j = 0; j < order; ++j)
                result(i, j) -= 2.0 / squaredLength * v(i, 0) * image(0, j);
    }
    return result;
}

/// Q diag(values) Q^T, made exactly symmetric.
inline PlainMatrix withSpectrum(const std::vector<double>& values, UniformNumbers& random) {
    const int order = static_cast<int>(values.size());
    const PlainMatrix q = randomOrthogonal(order, random);
    PlainMatrix result(order, order);
    for (int i = 0; i < order; ++i) {
        for (int j = 0; j <= i; ++j) {
            double sum = 0.0;
            for (int k = 0; k < order; ++k)
                sum += q(i, k) * values[static_cast<std::size_t>(k)] * q(j, k);
            result(i, j) = result(j, i) = sum;
        }
    }
    return result;
}

}  // namespace reisti::test

#endif
