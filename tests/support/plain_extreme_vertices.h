#ifndef REISTI_TESTS_SUPPORT_PLAIN_EXTREME_VERTICES_H
#define REISTI_TESTS_SUPPORT_PLAIN_EXTREME_VERTICES_H

#include <cstddef>
#include <exception>
#include <vector>

// The enumeration of vertices and face centroids in its plainest form: a table of all combinations of bounds, every
// pair compared, every subset of planes tried on every vertex. It is the measure of the fast code, to the last bit and
// in the order of the rows, so nothing here is ever made faster at the cost of being obvious.

namespace reisti::test {

using Table = std::vector<std::vector<double>>;

/// A linear constraint as a caller states it. `status` is changed by the enumeration as in the caller's record.
struct PlainConstraint {
    bool hasLower = false;
    double lower = 0.0;
    bool hasUpper = false;
    double upper = 0.0;
    std::vector<double> coefficients;
    int status = 0;
};

/// A region and what is known of it: bounds and constraints go in, the rest comes out.
struct PlainRegion {
    std::vector<double> lower;
    std::vector<double> upper;
    std::vector<PlainConstraint> constraints;
    double total = 1.0;
    bool boundsChanged = false;
    Table points;                                         ///< one row per vertex
    Table planes;                                         ///< one row per plane: coefficients, then the constant
    Table slack;                                          ///< one row per vertex, one column per plane
    std::size_t patience = static_cast<std::size_t>(-1);  ///< most vertices before the enumeration gives up
};

/// Thrown when a region has more vertices than its patience. Where a range nearly vanishes, both its planes count as
/// common to all vertices, every pair of vertices passes for an edge, and each cut can square their number.
struct OutOfPatience : std::exception {};

/// List of components (0-based) by ascending range; the last one is free.
std::vector<std::size_t> plainComponentOrder(const std::vector<double>& lower, const std::vector<double>& upper);

/// The vertices within the bounds alone.
Table plainBoxVertices(const std::vector<double>& lower, const std::vector<double>& upper);

/// The whole enumeration: fills points, planes and slack, writes statuses, tightens the bounds.
void plainExtremeVertices(PlainRegion& region);

/// What the centroid search leaves behind.
struct PlainCentroids {
    bool withinLimit = true;
    int count = 0;           ///< centroids of the dimensions that were finished
    Table points;            ///< vertices, then every centroid appended
    std::vector<int> types;  ///< types of the dimensions that were finished
};

/// Centroids of the faces of dimension 1 to degree-1, appended to the vertices `points`.
PlainCentroids plainFaceCentroids(const Table& points, const Table& slack, int numPlanes, int q, int degree,
                                  int maxPoints);

}  // namespace reisti::test

#endif
