#include "support/plain_extreme_vertices.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <utility>

namespace reisti::test {

namespace {

// Absolute: a component this close to a bound is on it, and two vertices this close are one.
constexpr double kSameVertex = 1e-12;
// Relative to the larger: an implied bound this close to the given one leaves it alone.
constexpr double kSameBound = 1e-12;
// Absolute, on the value of a plane's function: on the plane, and clearly on one side of it.
constexpr double kOnPlaneWhenCutting = 1e-6;
// Absolute: a new point this close to a vertex is that vertex.
constexpr double kSamePointWhenCutting = 1e-5;
// Absolute, on the value of a plane's function: a vertex belongs to a face.
constexpr double kOnFace = 1e-4;
// Absolute: two centroids this close are one.
constexpr double kSameCentroid = 1e-5;

bool samePoint(const std::vector<double>& a, const std::vector<double>& b, double tolerance) {
    for (std::size_t j = 0; j < a.size(); ++j)
        if (!(std::fabs(a[j] - b[j]) <= tolerance)) return false;
    return true;
}

double valueOfPlane(const std::vector<double>& plane, const std::vector<double>& x) {
    double sum = 0.0;
    for (std::size_t j = 0; j < x.size(); ++j)
        sum += x[j] * plane[j];
    return sum + plane[x.size()];
}

enum class Place { kWithin, kBelow, kAbove };

// A component within the tolerance of a bound is set to it.
Place settle(double& x, double lower, double upper) {
    if (std::fabs(x - lower) <= kSameVertex) {
        x = lower;
        return Place::kWithin;
    }
    if (std::fabs(x - upper) <= kSameVertex) {
        x = upper;
        return Place::kWithin;
    }
    if (x < lower) return Place::kBelow;
    if (x > upper) return Place::kAbove;
    return Place::kWithin;
}

void appendIfNew(Table& points, const std::vector<double>& x) {
    for (const std::vector<double>& earlier : points)
        if (samePoint(earlier, x, kSameVertex)) return;
    points.push_back(x);
}

// The point where the segment from vertex a to vertex b meets the newest plane, if a and b are adjacent. Rows from
// `firstNew` on were added under this plane.
void addPointOnEdge(PlainRegion& region, std::size_t a, std::size_t b, std::size_t firstNew) {
    const std::size_t q = region.lower.size();
    const std::size_t newest = region.planes.size() - 1;
    std::size_t common = 0;
    for (std::size_t p = 0; p < newest; ++p) {
        const bool bothOn =
            std::fabs(region.slack[a][p]) < kOnPlaneWhenCutting && std::fabs(region.slack[b][p]) < kOnPlaneWhenCutting;
        if (bothOn) ++common;
    }
    if (common + 2 < q) return;

    const double sa = region.slack[a][newest];
    const double sb = region.slack[b][newest];
    const double t = sb / (sb - sa);
    std::vector<double> x(q);
    for (std::size_t j = 0; j < q; ++j)
        x[j] = region.points[b][j] * (1 - t) + region.points[a][j] * t;

    for (std::size_t v = 0; v < region.points.size(); ++v) {
        const bool stays = v >= firstNew || region.slack[v][newest] >= -kOnPlaneWhenCutting;
        if (stays && samePoint(region.points[v], x, kSamePointWhenCutting)) return;
    }
    std::vector<double> slack;
    for (const std::vector<double>& plane : region.planes)
        slack.push_back(valueOfPlane(plane, x));
    if (region.points.size() >= region.patience) throw OutOfPatience();
    region.points.push_back(x);
    region.slack.push_back(slack);
}

// Cuts the region with one plane; false when the plane does not cut it, and is then forgotten.
bool cutWith(PlainRegion& region, const std::vector<double>& plane) {
    const std::size_t before = region.points.size();
    const std::size_t newest = region.planes.size();
    region.planes.push_back(plane);
    bool someOutside = false;
    bool someInside = false;
    for (std::size_t r = 0; r < before; ++r) {
        const double s = valueOfPlane(plane, region.points[r]);
        region.slack[r].push_back(s);
        someOutside = someOutside || s <= -kOnPlaneWhenCutting;
        someInside = someInside || s > kOnPlaneWhenCutting;
    }
    if (!someOutside || !someInside) {
        region.planes.pop_back();
        for (std::vector<double>& row : region.slack)
            row.pop_back();
        return false;
    }

    for (std::size_t a = 0; a < before; ++a) {
        if (!(region.slack[a][newest] < -kOnPlaneWhenCutting)) continue;
        for (std::size_t b = 0; b < region.points.size(); ++b)
            if (b != a && region.slack[b][newest] > kOnPlaneWhenCutting) addPointOnEdge(region, a, b, before);
    }

    Table keptPoints;
    Table keptSlack;
    for (std::size_t r = 0; r < region.points.size(); ++r) {
        if (!(region.slack[r][newest] >= -kOnPlaneWhenCutting)) continue;
        keptPoints.push_back(region.points[r]);
        keptSlack.push_back(region.slack[r]);
    }
    region.points = keptPoints;
    region.slack = keptSlack;
    return true;
}

void applyConstraint(PlainRegion& region, PlainConstraint& constraint) {
    std::vector<double> lowerPlane = constraint.coefficients;
    lowerPlane.push_back(-constraint.lower / region.total);
    std::vector<double> upperPlane;
    for (const double c : constraint.coefficients)
        upperPlane.push_back(-c);
    upperPlane.push_back(constraint.upper / region.total);

    bool lowerCuts = true;  // a lower side that is not there counts as one that cuts
    if (constraint.hasLower) {
        lowerCuts = cutWith(region, lowerPlane);
        if (!lowerCuts) constraint.status = 1;
    }
    if (!constraint.hasLower || constraint.hasUpper) {
        if (!cutWith(region, upperPlane)) constraint.status = lowerCuts ? 2 : 3;
    }
}

bool sameBound(double a, double b) {
    return std::max(std::fabs(a), std::fabs(b)) * kSameBound >= std::fabs(a - b);
}

void tightenBounds(PlainRegion& region) {
    if (region.points.empty()) return;
    for (std::size_t j = 0; j < region.lower.size(); ++j) {
        double least = region.points[0][j];
        double greatest = region.points[0][j];
        for (const std::vector<double>& x : region.points) {
            if (x[j] < least) least = x[j];
            if (x[j] > greatest) greatest = x[j];
        }
        if (!sameBound(least, region.lower[j])) {
            region.boundsChanged = true;
            region.lower[j] = least;
        }
        if (!sameBound(greatest, region.upper[j])) {
            region.boundsChanged = true;
            region.upper[j] = greatest;
        }
    }
}

// The next k-subset of {0, .., n-1} in lexicographic order; false after the last.
bool nextSubset(std::vector<std::size_t>& subset, std::size_t n) {
    const std::size_t k = subset.size();
    for (std::size_t i = k; i-- > 0;) {
        if (subset[i] + (k - i) >= n) continue;
        ++subset[i];
        for (std::size_t j = i + 1; j < k; ++j)
            subset[j] = subset[j - 1] + 1;
        return true;
    }
    return false;
}

// Appends the centroid of the vertices on all the planes of `subset`, if they span a face and its centroid is new.
// False when the limit forbids it.
bool averageVertices(PlainCentroids& found, const Table& slack, std::size_t numVertices, std::size_t q,
                     const std::vector<std::size_t>& subset, int& added, int maxPoints) {
    std::vector<double> centroid(q, 0.0);
    std::size_t m = 0;
    for (std::size_t r = 0; r < numVertices; ++r) {
        bool onFace = true;
        for (const std::size_t p : subset) {
            if (std::fabs(slack[r][p]) <= kOnFace) continue;
            onFace = false;
            break;
        }
        if (!onFace) continue;
        ++m;
        for (std::size_t j = 0; j < q; ++j)
            centroid[j] += found.points[r][j];
    }
    if (m < q - subset.size()) return true;
    for (double& x : centroid)
        x /= static_cast<double>(m);

    for (std::size_t r = numVertices; r < found.points.size(); ++r)
        if (samePoint(found.points[r], centroid, kSameCentroid)) return true;
    ++added;
    if (added + static_cast<long long>(numVertices) + found.count > maxPoints) return false;
    found.points.push_back(centroid);
    return true;
}

}  // namespace

std::vector<std::size_t> plainComponentOrder(const std::vector<double>& lower, const std::vector<double>& upper) {
    const std::size_t q = lower.size();
    std::vector<std::size_t> order;
    for (std::size_t j = 0; j < q; ++j)
        order.push_back(j);
    const auto range = [&](std::size_t position) { return upper[order[position]] - lower[order[position]]; };
    for (std::size_t i = 0; i + 1 < q; ++i) {
        std::size_t best = i;
        for (std::size_t j = i + 1; j < q; ++j)
            if (range(best) - range(j) > kSameVertex) best = j;
        std::swap(order[i], order[best]);
    }
    return order;
}

Table plainBoxVertices(const std::vector<double>& lower, const std::vector<double>& upper) {
    const std::vector<std::size_t> order = plainComponentOrder(lower, upper);
    const std::size_t q = order.size();
    const std::size_t fixed = q - 1;
    const std::size_t free = order[fixed];

    Table candidates;
    for (std::size_t r = 0; r < (std::size_t{1} << fixed); ++r) {
        std::vector<double> x(q);
        double sum = 0.0;
        for (std::size_t t = 0; t < fixed; ++t) {
            const std::size_t j = order[t];
            x[j] = (r >> t) % 2 == 0 ? lower[j] : upper[j];
            sum += x[j];
        }
        x[free] = 1 - sum;
        candidates.push_back(x);
    }

    Table points;
    for (std::vector<double> x : candidates) {
        const Place place = settle(x[free], lower[free], upper[free]);
        if (place == Place::kWithin) {
            appendIfNew(points, x);
            continue;
        }
        x[free] = place == Place::kBelow ? lower[free] : upper[free];
        for (std::size_t t = 0; t < fixed; ++t) {
            double sum = 0.0;
            for (std::size_t other = 0; other < q; ++other)
                if (other != t) sum += x[order[other]];
            std::vector<double> repaired = x;
            double& component = repaired[order[t]];
            component = 1 - sum;
            if (settle(component, lower[order[t]], upper[order[t]]) == Place::kWithin) appendIfNew(points, repaired);
        }
    }
    return points;
}

void plainExtremeVertices(PlainRegion& region) {
    const std::size_t q = region.lower.size();
    region.points = plainBoxVertices(region.lower, region.upper);
    region.planes.assign(2 * q, std::vector<double>(q + 1, 0.0));
    for (std::size_t i = 0; i < q; ++i) {
        region.planes[i][i] = 1.0;
        region.planes[i][q] = -region.lower[i];
        region.planes[q + i][i] = -1.0;
        region.planes[q + i][q] = region.upper[i];
    }
    region.slack.clear();
    for (const std::vector<double>& x : region.points) {
        region.slack.emplace_back();
        for (const std::vector<double>& plane : region.planes)
            region.slack.back().push_back(valueOfPlane(plane, x));
    }
    if (region.constraints.empty()) return;
    for (PlainConstraint& constraint : region.constraints)
        applyConstraint(region, constraint);
    tightenBounds(region);
}

PlainCentroids plainFaceCentroids(const Table& points, const Table& slack, int numPlanes, int q, int degree,
                                  int maxPoints) {
    PlainCentroids found;
    found.points = points;
    const std::size_t numVertices = points.size();
    for (int d = 1; d <= degree - 1; ++d) {
        int added = 0;
        std::vector<std::size_t> subset;
        for (int i = 0; i < q - d - 1; ++i)
            subset.push_back(static_cast<std::size_t>(i));
        do {
            if (!averageVertices(found, slack, numVertices, static_cast<std::size_t>(q), subset, added, maxPoints)) {
                found.withinLimit = false;
                return found;
            }
        } while (nextSubset(subset, static_cast<std::size_t>(numPlanes)));
        const int type = d + 1 == q ? 0 : d + 1;
        for (int i = 0; i < added; ++i) {
            const std::size_t index = numVertices + static_cast<std::size_t>(found.count + i);
            if (found.types.size() < index + 1) found.types.resize(index + 1, 1);
            found.types[index] = type;
        }
        found.count += added;
    }
    return found;
}

}  // namespace reisti::test
