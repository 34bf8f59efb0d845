#ifndef REISTI_MIXTURE_POINT_INDEX_H
#define REISTI_MIXTURE_POINT_INDEX_H

#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "mixture/id_table.h"

namespace reisti {

/// Two computed points of a region, cut vertices or centroids, are one when they are this close in every component.
inline constexpr double kSamePointAbsolute = 1e-5;

/// Whether two points of q components differ nowhere by more than kSamePointAbsolute.
inline bool isSamePoint(const double* a, const double* b, std::size_t q) {
    for (std::size_t j = 0; j < q; ++j)
        if (!(std::fabs(a[j] - b[j]) <= kSamePointAbsolute)) return false;
    return true;
}

/// Finds points near a given one, for the test of isSamePoint().
///
/// Points are filed by the cell in which they lie after projection to a few fixed directions. The cells are many times
/// wider than the projection of the tolerance, so most look-ups read one cell; near a border they read its neighbour
/// too.
class PointIndex {
  public:
    explicit PointIndex(std::size_t q);

    /// The projections of a point, to be handed to contains() and insert().
    static constexpr std::size_t kDirections = 3;
    using Place = std::array<double, kDirections>;
    Place place(const double* point) const;

    void insert(const Place& place, std::uint32_t id);

    /// Makes room for so many points in all.
    void reserve(std::size_t count) { table_.reserve(count); }

    /// Announces a look-up a little later.
    void prefetch(const Place& place) const;

    /// Calls same(id) for points filed near a place until it returns true.
    /// @return whether it did; never for a place with a NaN, which is near to nothing
    template <typename Same>
    bool contains(const Place& place, Same&& same) const {
        std::array<double, kDirections> first;
        std::array<double, kDirections> last;
        for (std::size_t d = 0; d < kDirections; ++d) {
            first[d] = std::floor(place[d] - kReach);
            last[d] = std::floor(place[d] + kReach);
        }
        Place cell = first;
        for (unsigned corner = 0; corner < (1U << kDirections); ++corner) {
            bool distinct = true;
            for (std::size_t d = 0; d < kDirections; ++d) {
                const bool far = (corner >> d & 1U) != 0;
                distinct = distinct && (!far || first[d] != last[d]);
                cell[d] = far ? last[d] : first[d];
            }
            if (distinct && table_.any(hashOfCell(cell), same)) return true;
        }
        return false;
    }

  private:
    /// Half the width, in cells, that a look-up covers in each direction.
    static constexpr double kReach = 1.0 / 32;

    static std::uint64_t hashOfCell(const Place& cell);

    std::vector<double> directions_;  // q weights for each direction, in cells per unit
    IdTable table_;
};

}  // namespace reisti

#endif
