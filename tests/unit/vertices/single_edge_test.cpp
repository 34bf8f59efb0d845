// Where one edge meets the newest plane: edge by edge the region is cut as all edges at once are.
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "mixture/extreme_vertex_util.h"
#include "support/random_regions.h"
#include "support/scale.h"
#include "support/vertex_engine.h"
#include "support/vertices_request.h"

namespace reisti::test {
namespace {

using qan::matrix_library::matrix;

/// The tables that the steps of the enumeration hand on.
struct Tables {
    unsigned int numVertices = 0;
    int numPlanes = 0;
    matrix<double> points, planes, slack;
};

/// A region within its bounds, with room for one constraint.
Tables withinBounds(std::vector<double> lower, std::vector<double> upper) {
    const int q = static_cast<int>(lower.size());
    Tables made;
    CmExtremeVertexUtil util;
    util.mGenerateVertices(q, lower.data(), upper.data(), &made.numVertices, made.points);
    util.mInitCoeff(q, 1, &made.numVertices, lower.data(), upper.data(), made.points, &made.numPlanes, made.planes,
                    made.slack);
    return made;
}

/// Enters the plane and its values at the vertices.
void enterPlane(Tables& tables, int q, const std::vector<double>& plane) {
    tables.planes.setRow(tables.numPlanes, plane);
    std::vector<double> values;
    for (int r = 0; r < static_cast<int>(tables.numVertices); ++r) {
        double value = 0.0;
        for (int j = 0; j < q; ++j)
            value += tables.points(r, j) * plane[static_cast<std::size_t>(j)];
        values.push_back(value + plane.back());
    }
    tables.slack.addCol(values);
    ++tables.numPlanes;
}

Tables simplexBelowHalf() {
    Tables tables = withinBounds({0, 0, 0}, {1, 1, 1});
    enterPlane(tables, 3, {-1, 0, 0, 0.5});  // x1 <= 0.5; the vertices are (0, 0, 1), (1, 0, 0), (0, 1, 0)
    return tables;
}

int vertexAt(const Tables& tables, const std::vector<double>& point) {
    for (int r = 0; r < static_cast<int>(tables.numVertices); ++r)
        if (tableOf(tables.points)[static_cast<std::size_t>(r)] == point) return r;
    ADD_FAILURE() << "no such vertex";
    return 0;
}

void addEdge(Tables& tables, int a, int b) {
    CmExtremeVertexUtil().mEdge(a, b, tables.points.colCount(), &tables.numVertices, tables.numPlanes, tables.points,
                                tables.planes, tables.slack);
}

TEST(SingleEdge, AppendsTheCutPointAndItsValues) {
    Tables tables = simplexBelowHalf();
    addEdge(tables, vertexAt(tables, {1, 0, 0}), vertexAt(tables, {0, 1, 0}));
    ASSERT_EQ(tables.numVertices, 4U);
    EXPECT_EQ(tableOf(tables.points).back(), (std::vector<double>{0.5, 0.5, 0}));
    EXPECT_EQ(tableOf(tables.slack).back(), (std::vector<double>{0.5, 0.5, 0, 0.5, 0.5, 1, 0}));
}

TEST(SingleEdge, IsNotAddedTwice) {
    Tables tables = simplexBelowHalf();
    for (int i = 0; i < 2; ++i)
        addEdge(tables, vertexAt(tables, {1, 0, 0}), vertexAt(tables, {0, 1, 0}));
    EXPECT_EQ(tables.numVertices, 4U);
}

TEST(SingleEdge, BetweenVerticesWithTooFewCommonPlanesIsNone) {
    // Opposite corners of the square x1 + x3 = 0.5, 0 <= x1, x2 <= 0.5 ... of a region of four components.
    Tables tables = withinBounds({0, 0, 0, 0}, {0.5, 0.5, 0.5, 0.5});
    enterPlane(tables, 4, {-1, -1, 0, 0, 0.5});
    addEdge(tables, vertexAt(tables, {0.5, 0.5, 0, 0}), vertexAt(tables, {0, 0, 0.5, 0.5}));
    EXPECT_EQ(tables.numVertices, 6U) << "the octahedron has its six vertices still";
}

TEST(SingleEdge, PointNearAVertexThatStaysIsNotAdded) {
    Tables tables = withinBounds({0, 0, 0}, {1, 1, 1});
    enterPlane(tables, 3, {-1, 0, 0, 9e-6});  // leaves x1 <= 9e-6, and both corners with x1 = 0 within 1e-5 of the cut
    addEdge(tables, vertexAt(tables, {1, 0, 0}), vertexAt(tables, {0, 1, 0}));
    EXPECT_EQ(tables.numVertices, 3U);
}

TEST(SingleEdge, PointNearAVertexThatIsCutOffIsAdded) {
    Tables tables = withinBounds({0, 0, 0}, {1, 1, 1});
    enterPlane(tables, 3, {-1, 0, 0, 1 - 9e-6});  // takes (1, 0, 0) away, a little
    addEdge(tables, vertexAt(tables, {1, 0, 0}), vertexAt(tables, {0, 1, 0}));
    EXPECT_EQ(tables.numVertices, 4U);
}

/// Every pair of a vertex below the plane and one above it, then those below dropped: the cut as a loop over pairs.
void cutEdgeByEdge(Tables& tables) {
    const int newest = tables.numPlanes - 1;
    const int numOld = static_cast<int>(tables.numVertices);
    for (int a = 0; a < numOld; ++a)
        for (int b = 0; tables.slack(a, newest) < -1e-6 && b < static_cast<int>(tables.numVertices); ++b)
            if (b != a && tables.slack(b, newest) > 1e-6) addEdge(tables, a, b);
    for (int r = static_cast<int>(tables.numVertices) - 1; r >= 0; --r) {
        if (tables.slack(r, newest) >= -1e-6) continue;
        tables.points.removeRow(r);
        tables.slack.removeRow(r);
        --tables.numVertices;
    }
}

TEST(SingleEdge, ByEdgeTheRegionIsCutAsAllAtOnce) {
    RegionMaker maker(41);
    int cuts = 0;
    for (int i = 0; i < scaled(600); ++i) {
        const auto q = static_cast<int>(3 + maker.below(3));
        std::vector<double> lower;
        std::vector<double> upper;
        maker.decimalBounds(static_cast<std::size_t>(q), 2, lower, upper);
        Tables atOnce = withinBounds(lower, upper);
        if (atOnce.numVertices == 0) continue;

        const PlainConstraint constraint = maker.constraint(lower, upper, 1.0, {});
        PlainConstraint upperSide = atMost(constraint.upper, constraint.coefficients);
        auto records = recordsOf({upperSide});
        records[0].coefficients = upperSide.coefficients.data();
        Tables byEdge = withinBounds(lower, upper);
        CmExtremeVertexUtil().mAddConstraints(q, 1, &atOnce.numVertices, &atOnce.numPlanes, 1.0, records.data(),
                                              atOnce.points, atOnce.planes, atOnce.slack);
        if (atOnce.numPlanes == 2 * q) continue;
        ++cuts;

        std::vector<double> plane;
        for (int j = 0; j <= q; ++j)
            plane.push_back(atOnce.planes(2 * q, j));
        enterPlane(byEdge, q, plane);
        cutEdgeByEdge(byEdge);
        ASSERT_TRUE(sameTable(tableOf(byEdge.points), tableOf(atOnce.points)))
            << describe(lower, upper, {upperSide}, 1.0);
        ASSERT_TRUE(sameTable(tableOf(byEdge.slack), tableOf(atOnce.slack)));
    }
    EXPECT_GT(cuts, scaled(600) / 10);
}

}  // namespace
}  // namespace reisti::test
