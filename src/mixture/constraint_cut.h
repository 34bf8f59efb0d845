#ifndef REISTI_MIXTURE_CONSTRAINT_CUT_H
#define REISTI_MIXTURE_CONSTRAINT_CUT_H

#include <cstddef>
#include <cstdint>
#include <utility>
#include <vector>

namespace reisti {

/// A vertex lies on a plane whose function is smaller than this there, absolutely; a plane cuts a region that it leaves
/// by more than this on both sides.
inline constexpr double kOnPlaneAbsolute = 1e-6;

/// The value of a plane at a point: q coefficients and a constant, added last.
inline double planeValue(const double* plane, const double* point, std::size_t q) {
    double sum = 0.0;
    for (std::size_t j = 0; j < q; ++j)
        sum += point[j] * plane[j];
    return sum + plane[q];
}

/// The values at a point of planes of which the first 2q are the lower and the upper bounds of the components.
void planeValues(const double* planes, std::size_t numPlanes, const double* point, std::size_t q, double* values);

/// The point at which the segment from vertex a to vertex b meets a plane that has the values sa and sb there.
inline void meetPlane(const double* a, const double* b, double sa, double sb, std::size_t q, double* point) {
    const double t = sb / (sb - sa);
    for (std::size_t j = 0; j < q; ++j)
        point[j] = b[j] * (1.0 - t) + a[j] * t;
}

/// A region, given by its vertices and the planes that bound it, which further planes cut.
///
/// Invariants: vertex v is row v of points(); bit p of its mask tells whether it lies on plane p.
class CutRegion {
  public:
    /// @param planes the planes, q + 1 numbers each: for i < q, plane i bounds component i from below, plane q + i from
    ///               above; planes behind them are taken as they come
    /// @param slack  [numVertices][numPlanes] the values of the planes at the vertices
    CutRegion(std::size_t q, std::vector<double> points, std::vector<double> planes, const double* slack);

    /// Cuts off the part of the region where the plane's function is negative. Vertices keep their order; those that
    /// the cut makes follow, in the order of the vertices cut off and, for each, of the vertices kept.
    /// @return false, and nothing changes, when the plane does not cut the region
    /// @throw std::length_error when the vertices could not be indexed in 32 bits
    bool cut(const std::vector<double>& plane);

    std::size_t numVertices() const { return points_.size() / q_; }
    std::size_t numPlanes() const { return planes_.size() / (q_ + 1); }
    const std::vector<double>& planes() const { return planes_; }
    /// The points, with no more memory than they need; the region is spent.
    std::vector<double> takePoints() &&;

  private:
    class Neighbours;
    class TakenPlaces;

    const double* row(std::size_t vertex) const { return &points_[vertex * q_]; }
    const std::uint64_t* mask(std::size_t vertex) const { return &masks_[vertex * words_]; }
    void setBit(std::size_t vertex, std::size_t plane);
    bool areAdjacent(std::size_t a, std::size_t b) const;
    void addCutVertices(const std::vector<double>& plane, std::vector<double>& values);
    void appendMask(const double* point);
    void widenMasks();
    void markPlane(std::size_t plane, const std::vector<double>& values);
    void keepOnly(const std::vector<double>& values);

    std::size_t q_;
    std::size_t words_;
    std::vector<double> points_;
    std::vector<double> planes_;
    std::vector<std::uint64_t> masks_;  // words_ per vertex
};

}  // namespace reisti

#endif
