#include "mixture/face_centroids.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <span>
#include <stdexcept>
#include <utility>

#include "mixture/face_walk.h"
#include "mixture/point_index.h"

namespace reisti {

namespace {

using qan::matrix_library::matrix;

/// Collects the points of a design: its vertices, then the distinct centroids of faces, up to a limit.
///
/// A new centroid waits while a few more are computed, so that the index has time to fetch what it compares with.
class PointCollector {
  public:
    /// @param room the number of points to expect
    PointCollector(const matrix<double>& vertices, std::size_t q, std::size_t room, int maxPoints)
        : q_(q), maxPoints_(maxPoints), waitingPoints_(kMostWaiting * q), index_(q) {
        const std::size_t numVertices = static_cast<std::size_t>(vertices.rowCount());
        rows_.reserve(room * q);
        rows_.insert(rows_.end(), vertices.data(), vertices.data() + numVertices * q);
        index_.reserve(room - numVertices);
    }

    std::size_t count() const { return rows_.size() / q_; }
    matrix<double> takePoints() { return matrix<double>(std::move(rows_), static_cast<int>(q_)); }

    /// @return false when a centroid is new and beyond the limit
    bool addCentroid(std::span<const FaceWalk::Member> face) {
        if (numWaiting_ == kMostWaiting && !settleOldest()) return false;
        const std::size_t slot = (oldest_ + numWaiting_++) % kMostWaiting;
        double* const point = &waitingPoints_[slot * q_];
        mAvgExtremeVertices(face, point);
        waitingPlaces_[slot] = index_.place(point);
        index_.prefetch(waitingPlaces_[slot]);
        return true;
    }

    /// Takes in the centroids that wait.
    /// @return as addCentroid()
    bool settle() {
        while (numWaiting_ > 0)
            if (!settleOldest()) return false;
        return true;
    }

  private:
    static constexpr std::size_t kMostWaiting = 16;

    /// The mean of the vertices; the sums are formed in their order.
    void mAvgExtremeVertices(std::span<const FaceWalk::Member> face, double* __restrict mean) const {
        const double* const vertices = rows_.data();
        std::fill_n(mean, q_, 0.0);
        for (const FaceWalk::Member& member : face) {
            const double* const vertex = vertices + member.vertex * q_;
            for (std::size_t j = 0; j < q_; ++j)
                mean[j] += vertex[j];
        }
        const auto count = static_cast<double>(face.size());
        for (std::size_t j = 0; j < q_; ++j)
            mean[j] /= count;
    }

    bool settleOldest() {
        const double* const point = &waitingPoints_[oldest_ * q_];
        const PointIndex::Place& place = waitingPlaces_[oldest_];
        oldest_ = (oldest_ + 1) % kMostWaiting;
        --numWaiting_;
        const auto isSame = [&](std::uint32_t row) { return isSamePoint(&rows_[row * q_], point, q_); };
        if (index_.contains(place, isSame)) return true;

        const std::size_t row = count();
        if (static_cast<std::int64_t>(row) >= maxPoints_) return false;
        if (row >= static_cast<std::size_t>(std::numeric_limits<int>::max()) / q_)
            throw std::length_error("more points than a matrix holds");
        index_.insert(place, static_cast<std::uint32_t>(row));
        rows_.insert(rows_.end(), point, point + q_);
        return true;
    }

    std::size_t q_;
    std::int64_t maxPoints_;
    std::vector<double> rows_;
    std::size_t oldest_ = 0;
    std::size_t numWaiting_ = 0;
    std::vector<double> waitingPoints_;
    std::array<PointIndex::Place, kMostWaiting> waitingPlaces_{};
    PointIndex index_;
};

std::size_t planesOfFace(int q, int dimension) {
    return static_cast<std::size_t>(q - 1 - dimension);
}

std::size_t verticesOfFace(int dimension) {
    return static_cast<std::size_t>(dimension) + 1;
}

/// The number of points of the design, or more, but no more than the limit and what a matrix holds.
std::size_t expectPoints(FaceWalk& walk, int q, int numDimensions, int numVertices, int maxPoints) {
    const auto most =
        static_cast<std::size_t>(std::max(numVertices, std::min(maxPoints, std::numeric_limits<int>::max() / q)));
    auto room = static_cast<std::size_t>(numVertices);
    for (int dimension = 1; dimension < numDimensions; ++dimension)
        room = std::min(most, room + walk.count(planesOfFace(q, dimension), verticesOfFace(dimension), most - room));
    return room;
}

}  // namespace

bool mCalculateCentroidsControl(int numPlanes, int& numCentroids, int degree, int q, int numVertices,
                                const matrix<double>& slack, matrix<double>& points, std::vector<int>& pointTypes,
                                int maxPoints) {
    numCentroids = 0;
    // The region itself is its only face of dimension q - 1; there are none beyond.
    const int numDimensions = std::min(degree, q);
    if (numDimensions < 2) return true;

    const auto columns = static_cast<std::size_t>(q);
    const auto vertices = static_cast<std::size_t>(numVertices);
    FaceWalk walk(columns, slack.data(), vertices, static_cast<std::size_t>(numPlanes));
    // Counting first costs less than letting the array of points grow, which would hold it twice.
    const std::size_t room = expectPoints(walk, q, numDimensions, numVertices, maxPoints);
    PointCollector collector(points, columns, room, maxPoints);
    points = matrix<double>();

    bool withinLimit = true;
    for (int dimension = 1; withinLimit && dimension < numDimensions; ++dimension) {
        withinLimit = walk.walk(planesOfFace(q, dimension), verticesOfFace(dimension),
                                [&](std::span<const FaceWalk::Member> face) { return collector.addCentroid(face); }) &&
                      collector.settle();
        if (!withinLimit) break;
        if (pointTypes.size() < collector.count()) pointTypes.resize(collector.count(), 1);
        std::fill(pointTypes.begin() + (numVertices + numCentroids),
                  pointTypes.begin() + static_cast<std::ptrdiff_t>(collector.count()),
                  dimension + 1 == q ? 0 : dimension + 1);
        numCentroids = static_cast<int>(collector.count() - vertices);
    }
    points = collector.takePoints();
    return withinLimit;
}

}  // namespace reisti
