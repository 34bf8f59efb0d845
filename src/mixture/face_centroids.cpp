#include "mixture/face_centroids.h"

#include <algorithm>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <stdexcept>
#include <utility>

#include "mixture/face_walk.h"
#include "mixture/point_index.h"

namespace reisti {

namespace {

using qan::matrix_library::matrix;

/// Rows of q values in blocks of about a megabyte. A single array that doubles would hold its contents twice while it
/// grows.
class RowBlocks {
  public:
    explicit RowBlocks(std::size_t q) : q_(q), rowsPerBlock_(std::bit_floor(std::max<std::size_t>(1, kBlock / q))) {}

    std::size_t count() const { return count_; }

    const double* row(std::size_t i) const { return &blocks_[i / rowsPerBlock_][i % rowsPerBlock_ * q_]; }

    void append(const double* values) {
        if (count_ % rowsPerBlock_ == 0) {
            blocks_.emplace_back();
            blocks_.back().reserve(rowsPerBlock_ * q_);
        }
        blocks_.back().insert(blocks_.back().end(), values, values + q_);
        ++count_;
    }

    /// Moves all rows to the end of an array that has room for them.
    void moveTo(std::vector<double>& rows) {
        for (std::vector<double>& block : blocks_) {
            rows.insert(rows.end(), block.begin(), block.end());
            std::vector<double>().swap(block);
        }
        blocks_.clear();
        count_ = 0;
    }

  private:
    static constexpr std::size_t kBlock = std::size_t{1} << 17U;

    std::size_t q_;
    std::size_t rowsPerBlock_;
    std::size_t count_ = 0;
    std::vector<std::vector<double>> blocks_;
};

/// Collects the distinct centroids of faces, up to a limit on all points.
class Centroids {
  public:
    Centroids(const double* vertices, std::size_t numVertices, std::size_t q, int maxPoints)
        : vertices_(vertices), numVertices_(numVertices), q_(q), maxPoints_(maxPoints), mean_(q), rows_(q), index_(q) {}

    std::size_t count() const { return rows_.count(); }
    RowBlocks& rows() { return rows_; }

    /// @return false when the centroid is new and beyond the limit
    bool add(const FaceWalk::Vertices& face) {
        mAvgExtremeVertices(face);
        const PointIndex::Place place = index_.place(mean_.data());
        const auto isSame = [this](std::uint32_t i) { return isSamePoint(rows_.row(i), mean_.data(), q_); };
        if (index_.contains(place, isSame)) return true;
        const std::size_t numPoints = numVertices_ + count() + 1;
        if (static_cast<std::int64_t>(numPoints) > maxPoints_) return false;
        if (numPoints > static_cast<std::size_t>(std::numeric_limits<int>::max()) / q_)
            throw std::length_error("more points than a matrix holds");
        index_.insert(place, static_cast<std::uint32_t>(count()));
        rows_.append(mean_.data());
        return true;
    }

  private:
    /// The mean of the vertices, each sum formed in their order.
    void mAvgExtremeVertices(const FaceWalk::Vertices& face) {
        std::size_t j = 0;
        for (; j + 8 <= q_; j += 8)
            averageColumns<8>(face, j);
        for (; j + 2 <= q_; j += 2)
            averageColumns<2>(face, j);
        for (; j < q_; ++j)
            averageColumns<1>(face, j);
    }

    /// A few columns at a time, so that their sums stay in registers.
    template <std::size_t Width>
    void averageColumns(const FaceWalk::Vertices& face, std::size_t column) {
        double sums[Width] = {};
        for (const std::uint32_t vertex : face) {
            const double* const values = vertices_ + vertex * q_ + column;
            for (std::size_t i = 0; i < Width; ++i)
                sums[i] += values[i];
        }
        const auto count = static_cast<double>(face.size());
        for (std::size_t i = 0; i < Width; ++i)
            mean_[column + i] = sums[i] / count;
    }

    const double* vertices_;
    std::size_t numVertices_;
    std::size_t q_;
    std::int64_t maxPoints_;
    std::vector<double> mean_;
    RowBlocks rows_;
    PointIndex index_;
};

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
    FaceWalk walk(slack.data(), vertices, static_cast<std::size_t>(numPlanes));
    Centroids centroids(points.data(), vertices, columns, maxPoints);
    bool withinLimit = true;
    for (int dimension = 1; withinLimit && dimension < numDimensions; ++dimension) {
        withinLimit = walk.walk(static_cast<std::size_t>(q - 1 - dimension), static_cast<std::size_t>(dimension) + 1,
                                [&](const FaceWalk::Vertices& face) { return centroids.add(face); });
        if (!withinLimit) break;
        const std::size_t numTyped = vertices + centroids.count();
        if (pointTypes.size() < numTyped) pointTypes.resize(numTyped, 1);
        std::fill(pointTypes.begin() + (numVertices + numCentroids),
                  pointTypes.begin() + static_cast<std::ptrdiff_t>(numTyped), dimension + 1 == q ? 0 : dimension + 1);
        numCentroids = static_cast<int>(centroids.count());
    }

    std::vector<double> rows;
    rows.reserve((vertices + centroids.count()) * columns);
    rows.insert(rows.end(), points.data(), points.data() + vertices * columns);
    centroids.rows().moveTo(rows);
    points = matrix<double>(std::move(rows), q);
    return withinLimit;
}

}  // namespace reisti
