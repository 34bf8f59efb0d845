#ifndef REISTI_TESTS_SUPPORT_VERTEX_ENGINE_H
#define REISTI_TESTS_SUPPORT_VERTEX_ENGINE_H

#include <cstdint>
#include <gtest/gtest.h>
#include <vector>

#include "matrix/matrix_library.h"
#include "reisti/reisti.h"
#include "support/plain_extreme_vertices.h"

// The library's enumeration of vertices and centroids, called directly and beside the plain one, with the same values
// in and out.

namespace reisti::test {

qan::matrix_library::matrix<double> matrixOf(const Table& rows, int numColumns);
Table tableOf(const qan::matrix_library::matrix<double>& rows);

/// The caller's constraints as records that point into `constraints`.
std::vector<des_MixtureDesignLinearConstraint> recordsOf(const std::vector<PlainConstraint>& constraints);

/// Everything that the enumeration of a region leaves behind.
struct EnumeratedRegion {
    bool returned = true;
    std::uint32_t numVertices = 0;
    int numPlanes = 0;
    Table points;
    Table slack;
    std::vector<double> lower;
    std::vector<double> upper;
    bool boundsChanged = false;
    std::vector<int> statuses;
};

EnumeratedRegion enumerated(const PlainRegion& region);
EnumeratedRegion plainlyEnumerated(PlainRegion region);

/// The library's centroids in the form of the plain ones.
PlainCentroids faceCentroids(const Table& points, const Table& slack, int numPlanes, int q, int degree, int maxPoints);

/// Equal to the last bit and in the order of the rows, or the first difference.
testing::AssertionResult sameTable(const Table& actual, const Table& expected);
testing::AssertionResult sameEnumeration(const EnumeratedRegion& actual, const EnumeratedRegion& expected);
testing::AssertionResult sameCentroids(const PlainCentroids& actual, const PlainCentroids& expected);

}  // namespace reisti::test

#endif
