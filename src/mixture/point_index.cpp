#include "mixture/point_index.h"

#include <algorithm>
#include <bit>

namespace reisti {

PointIndex::PointIndex(std::size_t q) : directions_(kDirections * q) {
    for (std::size_t d = 0; d < kDirections; ++d) {
        double* const weights = &directions_[d * q];
        double length = 0.0;
        for (std::size_t j = 0; j < q; ++j) {
            // Irregular weights in [-1, 1): with regular ones many centroids of a symmetric region would share a cell.
            weights[j] = std::ldexp(static_cast<double>(mixBits(d * q + j) >> 11U), -52) - 1.0;
            length += std::fabs(weights[j]);
        }
        // Points within the tolerance of each other are at most tolerance * length apart in this direction; a little
        // more covers the rounding of the projections.
        const double reach = length * kSamePointAbsolute * (1.0 + 1e-6) + 1e-12;
        for (std::size_t j = 0; j < q; ++j)
            weights[j] *= kReach / reach;
    }
}

PointIndex::Place PointIndex::place(const double* point) const {
    const std::size_t q = directions_.size() / kDirections;
    Place place{};
    for (std::size_t j = 0; j < q; ++j) {
        for (std::size_t d = 0; d < kDirections; ++d)
            place[d] += directions_[d * q + j] * point[j];
    }
    return place;
}

namespace {

PointIndex::Place cellOf(const PointIndex::Place& place) {
    PointIndex::Place cell;
    std::transform(place.begin(), place.end(), cell.begin(), [](double coordinate) { return std::floor(coordinate); });
    return cell;
}

}  // namespace

void PointIndex::insert(const Place& place, std::uint32_t id) {
    table_.insert(hashOfCell(cellOf(place)), id);
}

void PointIndex::prefetch(const Place& place) const {
    table_.prefetch(hashOfCell(cellOf(place)));
}

std::uint64_t PointIndex::hashOfCell(const Place& cell) {
    std::uint64_t hash = 0;
    // Adding 0.0 makes the two zeros one cell.
    for (const double coordinate : cell)
        hash = mixBits(hash ^ std::bit_cast<std::uint64_t>(coordinate + 0.0));
    return hash;
}

}  // namespace reisti
