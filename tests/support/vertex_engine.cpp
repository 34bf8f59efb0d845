#include "support/vertex_engine.h"

#include <algorithm>
#include <bit>
#include <cstddef>
#include <sstream>

#include "mixture/extreme_vertex_util.h"
#include "mixture/face_centroids.h"

namespace reisti::test {

using qan::matrix_library::matrix;

matrix<double> matrixOf(const Table& rows, int numColumns) {
    matrix<double> made(static_cast<int>(rows.size()), numColumns, 0.0);
    for (std::size_t r = 0; r < rows.size(); ++r)
        for (std::size_t c = 0; c < rows[r].size(); ++c)
            made(static_cast<int>(r), static_cast<int>(c)) = rows[r][c];
    return made;
}

Table tableOf(const matrix<double>& rows) {
    Table table;
    for (int r = 0; r < rows.rowCount(); ++r) {
        table.emplace_back();
        for (int c = 0; c < rows.colCount(); ++c)
            table.back().push_back(rows(r, c));
    }
    return table;
}

std::vector<des_MixtureDesignLinearConstraint> recordsOf(const std::vector<PlainConstraint>& constraints) {
    std::vector<des_MixtureDesignLinearConstraint> records;
    for (const PlainConstraint& c : constraints)
        records.push_back({static_cast<std::uint8_t>(c.hasLower), c.lower, static_cast<std::uint8_t>(c.hasUpper),
                           c.upper, c.coefficients.data(), c.status});
    return records;
}

EnumeratedRegion enumerated(const PlainRegion& region) {
    EnumeratedRegion out;
    out.lower = region.lower;
    out.upper = region.upper;
    auto records = recordsOf(region.constraints);
    matrix<double> points;
    matrix<double> slack;
    auto changed = static_cast<std::uint8_t>(region.boundsChanged);
    unsigned int numVertices = 0;
    CmExtremeVertexUtil util;
    out.returned =
        util.mExtremeVertex(static_cast<int>(region.lower.size()), static_cast<int>(records.size()), region.total,
                            out.lower.data(), out.upper.data(), records.empty() ? nullptr : records.data(), &changed,
                            &numVertices, &out.numPlanes, points, slack);
    out.numVertices = numVertices;
    out.points = tableOf(points);
    out.slack = tableOf(slack);
    out.boundsChanged = changed != 0;
    for (const auto& record : records)
        out.statuses.push_back(record.status);
    return out;
}

EnumeratedRegion plainlyEnumerated(PlainRegion region) {
    plainExtremeVertices(region);
    EnumeratedRegion out;
    out.numVertices = static_cast<std::uint32_t>(region.points.size());
    out.numPlanes = static_cast<int>(region.planes.size());
    out.points = region.points;
    out.slack = region.slack;
    out.lower = region.lower;
    out.upper = region.upper;
    out.boundsChanged = region.boundsChanged;
    for (const PlainConstraint& c : region.constraints)
        out.statuses.push_back(c.status);
    return out;
}

PlainCentroids faceCentroids(const Table& points, const Table& slack, int numPlanes, int q, int degree, int maxPoints) {
    PlainCentroids out;
    matrix<double> rows = matrixOf(points, q);
    const matrix<double> slackRows = matrixOf(slack, numPlanes);
    out.withinLimit = mCalculateCentroidsControl(numPlanes, out.count, degree, q, static_cast<int>(points.size()),
                                                 slackRows, rows, out.types, maxPoints);
    out.points = tableOf(rows);
    return out;
}

testing::AssertionResult sameTable(const Table& actual, const Table& expected) {
    if (actual.size() != expected.size())
        return testing::AssertionFailure() << actual.size() << " rows, not " << expected.size();
    for (std::size_t r = 0; r < actual.size(); ++r) {
        if (actual[r].size() != expected[r].size())
            return testing::AssertionFailure()
                   << "row " << r << " has " << actual[r].size() << " entries, not " << expected[r].size();
        for (std::size_t c = 0; c < actual[r].size(); ++c) {
            if (std::bit_cast<std::uint64_t>(actual[r][c]) == std::bit_cast<std::uint64_t>(expected[r][c])) continue;
            std::ostringstream text;
            text.precision(17);
            text << "row " << r << ", column " << c << ": " << actual[r][c] << ", not " << expected[r][c];
            return testing::AssertionFailure() << text.str();
        }
    }
    return testing::AssertionSuccess();
}

testing::AssertionResult sameEnumeration(const EnumeratedRegion& actual, const EnumeratedRegion& expected) {
    const auto differ = [](const char* what, const auto& a, const auto& b) {
        return testing::AssertionFailure()
               << what << ' ' << testing::PrintToString(a) << ", not " << testing::PrintToString(b);
    };
    if (actual.returned != expected.returned) return differ("result", actual.returned, expected.returned);
    if (actual.numVertices != expected.numVertices) return differ("vertices", actual.numVertices, expected.numVertices);
    if (actual.numPlanes != expected.numPlanes) return differ("planes", actual.numPlanes, expected.numPlanes);
    if (actual.statuses != expected.statuses) return differ("statuses", actual.statuses, expected.statuses);
    if (actual.boundsChanged != expected.boundsChanged)
        return differ("boundsChanged", actual.boundsChanged, expected.boundsChanged);
    if (const auto same = sameTable(actual.points, expected.points); !same)
        return testing::AssertionFailure() << "points: " << same.message();
    if (const auto same = sameTable(actual.slack, expected.slack); !same)
        return testing::AssertionFailure() << "slack: " << same.message();
    if (const auto same = sameTable({actual.lower, actual.upper}, {expected.lower, expected.upper}); !same)
        return testing::AssertionFailure() << "lower (row 0) and upper (row 1) bounds: " << same.message();
    return testing::AssertionSuccess();
}

testing::AssertionResult sameCentroids(const PlainCentroids& actual, const PlainCentroids& expected) {
    if (actual.withinLimit != expected.withinLimit)
        return testing::AssertionFailure() << "withinLimit " << actual.withinLimit;
    if (actual.count != expected.count)
        return testing::AssertionFailure() << actual.count << " centroids, not " << expected.count;
    // Entries that are not there stand for vertices as those that are 1 do.
    std::vector<int> types = actual.types;
    std::vector<int> expectedTypes = expected.types;
    types.resize(std::max(types.size(), expected.points.size()), 1);
    expectedTypes.resize(types.size(), 1);
    if (types != expectedTypes)
        return testing::AssertionFailure() << "types " << testing::PrintToString(actual.types) << ", not "
                                           << testing::PrintToString(expected.types);
    return sameTable(actual.points, expected.points);
}

}  // namespace reisti::test
