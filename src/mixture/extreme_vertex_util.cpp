#include "mixture/extreme_vertex_util.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <functional>
#include <limits>
#include <stdexcept>
#include <utility>
#include <vector>

#include "mixture/box_vertices.h"
#include "mixture/constraint_cut.h"
#include "mixture/point_index.h"
#include "util/math_routines.h"

namespace reisti {

namespace {

using qan::matrix_library::matrix;

/// Bounds that differ from the implied ones by no more than this, relatively, are left as the caller typed them.
constexpr double kSameBoundRelative = 1e-12;

int toInt(std::int64_t count) {
    if (count > std::numeric_limits<int>::max()) throw std::length_error("more planes than a matrix holds");
    return static_cast<int>(count);
}

std::vector<double> lowerPlane(const des_MixtureDesignLinearConstraint& constraint, std::size_t q, double total) {
    std::vector<double> plane(constraint.coefficients, constraint.coefficients + q);
    plane.push_back(-constraint.lowerValue / total);
    return plane;
}

std::vector<double> upperPlane(const des_MixtureDesignLinearConstraint& constraint, std::size_t q, double total) {
    std::vector<double> plane(q);
    std::transform(constraint.coefficients, constraint.coefficients + q, plane.begin(), std::negate<>());
    plane.push_back(constraint.upperValue / total);
    return plane;
}

void cutWith(CutRegion& region, des_MixtureDesignLinearConstraint& constraint, std::size_t q, double total) {
    constexpr std::int32_t kLowerIdle = 1;
    constexpr std::int32_t kUpperIdle = 2;
    constexpr std::int32_t kBothIdle = 3;

    const bool hasLower = constraint.hasLowerValue != 0;
    bool lowerIdle = false;
    if (hasLower) {
        lowerIdle = !region.cut(lowerPlane(constraint, q, total));
        if (lowerIdle) constraint.status = kLowerIdle;
    }
    if (!hasLower || constraint.hasUpperValue != 0)
        if (!region.cut(upperPlane(constraint, q, total))) constraint.status = lowerIdle ? kBothIdle : kUpperIdle;
}

/// The table of the values of all planes at all vertices.
matrix<double> tableOfValues(const double* planes, std::size_t numPlanes, const double* points, std::size_t numVertices,
                             std::size_t q) {
    if (numPlanes > 0 && numVertices > static_cast<std::size_t>(std::numeric_limits<int>::max()) / numPlanes)
        throw std::length_error("more slacks than a matrix holds");
    std::vector<double> values;
    values.reserve(numVertices * numPlanes);
    std::vector<double> row(numPlanes);
    for (std::size_t v = 0; v < numVertices; ++v) {
        planeValues(planes, numPlanes, points + v * q, q, row.data());
        values.insert(values.end(), row.begin(), row.end());
    }
    return matrix<double>(std::move(values), static_cast<int>(numPlanes));
}

}  // namespace

bool CmExtremeVertexUtil::mExtremeVertex(int q, int numConstraints, double total, double* lowerBounds,
                                         double* upperBounds, des_MixtureDesignLinearConstraint* constraints,
                                         std::uint8_t* boundsChanged, unsigned int* numVertices, int* numPlanes,
                                         matrix<double>& points, matrix<double>& slack) {
    *numPlanes = 0;
    slack = matrix<double>();
    matrix<double> planes;
    mGenerateVertices(q, lowerBounds, upperBounds, numVertices, points);
    mInitCoeff(q, numConstraints, numVertices, lowerBounds, upperBounds, points, numPlanes, planes, slack);
    if (numConstraints <= 0) return true;
    mAddConstraints(q, numConstraints, numVertices, numPlanes, total, constraints, points, planes, slack);
    if (*numVertices == 0) return true;

    const auto numRows = static_cast<int>(*numVertices);
    for (int j = 0; j < q; ++j) {
        double least = points(0, j);
        double most = points(0, j);
        for (int r = 1; r < numRows; ++r) {
            least = std::min(least, points(r, j));
            most = std::max(most, points(r, j));
        }
        if (mCompareWithFuzz(least, lowerBounds[j], 0.0, kSameBoundRelative) != 0) {
            *boundsChanged = 1;
            lowerBounds[j] = least;
        }
        if (mCompareWithFuzz(most, upperBounds[j], 0.0, kSameBoundRelative) != 0) {
            *boundsChanged = 1;
            upperBounds[j] = most;
        }
    }
    return true;
}

void CmExtremeVertexUtil::mGenerateVertices(int q, double* lowerBounds, double* upperBounds, unsigned int* numVertices,
                                            matrix<double>& points) {
    *numVertices = 0;
    points = matrix<double>();
    if (q < 1) return;
    points = matrix<double>(enumerateBoxVertices(static_cast<std::size_t>(q), lowerBounds, upperBounds), q);
    *numVertices = static_cast<unsigned int>(points.rowCount());
}

void CmExtremeVertexUtil::mInitCoeff(int q, int numConstraints, unsigned int* numVertices, double* lowerBounds,
                                     double* upperBounds, matrix<double>& points, int* numPlanes,
                                     matrix<double>& planes, matrix<double>& slack) {
    *numPlanes = 2 * q;
    const std::int64_t numRows = std::int64_t{3} * q + std::int64_t{2} * std::max(numConstraints, 0);
    planes = matrix<double>(toInt(numRows), q + 1, 0.0);
    for (int i = 0; i < q; ++i) {
        planes(i, i) = 1.0;
        planes(i, q) = -lowerBounds[i];
        planes(q + i, i) = -1.0;
        planes(q + i, q) = upperBounds[i];
    }
    const auto columns = static_cast<std::size_t>(q);
    slack = tableOfValues(planes.data(), 2 * columns, points.data(), *numVertices, columns);
}

void CmExtremeVertexUtil::mAddConstraints(int q, int numConstraints, unsigned int* numVertices, int* numPlanes,
                                          double total, des_MixtureDesignLinearConstraint* constraints,
                                          matrix<double>& points, matrix<double>& planes, matrix<double>& slack) {
    const auto columns = static_cast<std::size_t>(std::max(q, 0));
    if (columns == 0) return;
    const std::ptrdiff_t planeElements = std::ptrdiff_t{*numPlanes} * (q + 1);
    CutRegion region(columns, std::vector<double>(points.data(), points.data() + std::size_t{*numVertices} * columns),
                     std::vector<double>(planes.data(), planes.data() + planeElements), slack.data());
    for (int c = 0; c < numConstraints; ++c)
        cutWith(region, constraints[c], columns, total);
    if (region.numPlanes() == static_cast<std::size_t>(*numPlanes)) return;

    *numVertices = static_cast<unsigned int>(region.numVertices());
    *numPlanes = static_cast<int>(region.numPlanes());
    std::copy(region.planes().begin(), region.planes().end(), planes.data());
    // The old table goes before the new one is made: it is the larger part of the memory.
    slack = matrix<double>();
    points = matrix<double>(std::move(region).takePoints(), q);
    slack = tableOfValues(planes.data(), static_cast<std::size_t>(*numPlanes), points.data(), *numVertices, columns);
}

void CmExtremeVertexUtil::mEdge(int a, int b, int q, unsigned int* numVertices, int numPlanes, matrix<double>& points,
                                matrix<double>& planes, matrix<double>& slack) {
    const int newest = numPlanes - 1;
    int common = 0;
    for (int p = 0; p < newest; ++p)
        if (std::fabs(slack(a, p)) < kOnPlaneAbsolute && std::fabs(slack(b, p)) < kOnPlaneAbsolute) ++common;
    if (common < q - 2) return;

    const auto columns = static_cast<std::size_t>(q);
    std::vector<double> point(columns);
    meetPlane(&points(a, 0), &points(b, 0), slack(a, newest), slack(b, newest), columns, point.data());
    for (int r = 0; r < static_cast<int>(*numVertices); ++r)
        if (slack(r, newest) >= -kOnPlaneAbsolute && isSamePoint(&points(r, 0), point.data(), columns)) return;

    std::vector<double> values(static_cast<std::size_t>(numPlanes));
    for (int p = 0; p < numPlanes; ++p)
        values[static_cast<std::size_t>(p)] = planeValue(&planes(p, 0), point.data(), columns);
    points.addRow(point);
    slack.addRow(values);
    ++*numVertices;
}

}  // namespace reisti
