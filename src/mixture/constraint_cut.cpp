#include "mixture/constraint_cut.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>
#include <numeric>
#include <stdexcept>

#include "mixture/id_table.h"
#include "mixture/point_index.h"

namespace reisti {

namespace {

constexpr std::size_t kWordBits = 64;

/// Below this number of pairs, trying all of them is faster than filing the vertices.
constexpr std::size_t kFewPairs = std::size_t{1} << 16U;

bool isKept(double value) {
    // Also drops a NaN, which only coefficients near the end of the range of double can give.
    return value >= -kOnPlaneAbsolute;
}

bool isOn(double value) {
    return std::fabs(value) < kOnPlaneAbsolute;
}

/// Hashes of all sets of `size` planes out of a vertex's planes, for vertices on at most size + 2 planes.
void hashPlaneSets(const std::vector<std::uint64_t>& keys, std::size_t size, std::vector<std::uint64_t>& hashes) {
    hashes.clear();
    std::uint64_t all = 0;
    for (const std::uint64_t key : keys)
        all ^= key;
    if (keys.size() == size) {
        hashes.push_back(all);
    } else if (keys.size() == size + 1) {
        for (const std::uint64_t key : keys)
            hashes.push_back(all ^ key);
    } else if (keys.size() == size + 2) {
        for (std::size_t i = 0; i < keys.size(); ++i) {
            for (std::size_t j = i + 1; j < keys.size(); ++j)
                hashes.push_back(all ^ keys[i] ^ keys[j]);
        }
    }
}

}  // namespace

void planeValues(const double* planes, std::size_t numPlanes, const double* point, std::size_t q, double* values) {
    // A bound has one coefficient; the products with its zeros change no sum, unless they are NaN.
    const bool finite = std::isfinite(std::accumulate(point, point + q, 0.0));
    for (std::size_t j = 0; finite && j < q; ++j) {
        values[j] = point[j] + planes[j * (q + 1) + q];
        values[q + j] = planes[(q + j) * (q + 1) + q] - point[j];
    }
    for (std::size_t p = finite ? 2 * q : 0; p < numPlanes; ++p)
        values[p] = planeValue(planes + p * (q + 1), point, q);
}

/// Finds, for a vertex that is cut off, the kept vertices with which it shares an edge: those with at least q - 2
/// planes in common. Two vertices have that many in common exactly when some set of q - 2 planes holds both, so the
/// kept ones are filed under every such set. Vertices on so many planes that their sets are too many are tried one by
/// one.
class CutRegion::Neighbours {
  public:
    Neighbours(const CutRegion& region, std::size_t numBelow, std::vector<std::uint32_t> above)
        : region_(region), above_(std::move(above)), tryAll_(numBelow * above_.size() <= kFewPairs || region.q_ < 3) {
        if (tryAll_) return;
        table_.reserve(above_.size() * (region.q_ - 1));
        for (const std::uint32_t vertex : above_) {
            collectKeys(vertex);
            if (keys_.size() > edgePlanes() + 2) {
                crowded_.push_back(vertex);
                continue;
            }
            hashSets();
            for (const std::uint64_t hash : hashes_)
                table_.insert(hash, vertex);
        }
    }

    /// In ascending order.
    const std::vector<std::uint32_t>& of(std::uint32_t vertex) {
        found_.clear();
        const auto collect = [&](std::uint32_t other) {
            if (region_.areAdjacent(vertex, other)) found_.push_back(other);
            return false;
        };
        if (!tryAll_) collectKeys(vertex);
        if (tryAll_ || keys_.size() > edgePlanes() + 2) {
            std::for_each(above_.begin(), above_.end(), collect);
            return found_;
        }
        hashSets();
        for (const std::uint64_t hash : hashes_)
            table_.any(hash, collect);
        std::for_each(crowded_.begin(), crowded_.end(), collect);
        std::sort(found_.begin(), found_.end());
        found_.erase(std::unique(found_.begin(), found_.end()), found_.end());
        return found_;
    }

  private:
    std::size_t edgePlanes() const { return region_.q_ - 2; }

    /// Hashes of all sets of planes that an edge can have, from keys_.
    void hashSets() {
        hashPlaneSets(keys_, edgePlanes(), hashes_);
        for (const std::uint64_t hash : hashes_)
            table_.prefetch(hash);
    }

    /// One key per plane on which the vertex lies; a set of planes is hashed to the exclusive or of its keys.
    void collectKeys(std::size_t vertex) {
        keys_.clear();
        const std::uint64_t* const mask = region_.mask(vertex);
        for (std::size_t w = 0; w < region_.words_; ++w) {
            for (std::uint64_t bits = mask[w]; bits != 0; bits &= bits - 1)
                keys_.push_back(mixBits(w * kWordBits + static_cast<std::size_t>(std::countr_zero(bits))));
        }
    }

    const CutRegion& region_;
    std::vector<std::uint32_t> above_;
    bool tryAll_;
    std::vector<std::uint32_t> crowded_;
    IdTable table_;
    std::vector<std::uint64_t> keys_;
    std::vector<std::uint64_t> hashes_;
    std::vector<std::uint32_t> found_;
};

CutRegion::CutRegion(std::size_t q, std::vector<double> points, std::vector<double> planes, const double* slack)
    : q_(q),
      words_((planes.size() / (q + 1) + kWordBits - 1) / kWordBits),
      points_(std::move(points)),
      planes_(std::move(planes)),
      masks_(numVertices() * words_, 0) {
    for (std::size_t v = 0; v < numVertices(); ++v) {
        for (std::size_t p = 0; p < numPlanes(); ++p)
            if (isOn(slack[v * numPlanes() + p])) setBit(v, p);
    }
}

std::vector<double> CutRegion::takePoints() && {
    std::vector<std::uint64_t>().swap(masks_);
    // Not shrink_to_fit(): it would hide that there was no memory.
    if (points_.capacity() > points_.size()) std::vector<double>(points_).swap(points_);
    return std::move(points_);
}

void CutRegion::setBit(std::size_t vertex, std::size_t plane) {
    masks_[vertex * words_ + plane / kWordBits] |= std::uint64_t{1} << (plane % kWordBits);
}

bool CutRegion::areAdjacent(std::size_t a, std::size_t b) const {
    int common = 0;
    for (std::size_t w = 0; w < words_; ++w)
        common += std::popcount(mask(a)[w] & mask(b)[w]);
    return common >= static_cast<int>(q_) - 2;
}

bool CutRegion::cut(const std::vector<double>& plane) {
    std::vector<double> values(numVertices());
    bool below = false;
    bool above = false;
    for (std::size_t v = 0; v < values.size(); ++v) {
        values[v] = planeValue(plane.data(), row(v), q_);
        below = below || values[v] <= -kOnPlaneAbsolute;
        above = above || values[v] > kOnPlaneAbsolute;
    }
    if (!below || !above) return false;

    addCutVertices(plane, values);
    const std::size_t added = numPlanes();
    planes_.insert(planes_.end(), plane.begin(), plane.end());
    widenMasks();
    markPlane(added, values);
    keepOnly(values);
    return true;
}

/// The points that a cut must not double: the vertices that stay and the points added before. A vertex that is about to
/// go does not count: a corner beside it would vanish with it.
///
/// A new point lies on the plane, so only vertices beside the plane are filed.
class CutRegion::TakenPlaces {
  public:
    TakenPlaces(const CutRegion& region, const std::vector<double>& plane, const std::vector<double>& values)
        : region_(region), values_(values), numOld_(values.size()), index_(region.q_) {
        double slope = 0.0;
        for (std::size_t j = 0; j < region.q_; ++j)
            slope += std::fabs(plane[j]);
        // Points that differ nowhere by more than the tolerance differ by no more than this in the plane's function.
        reach_ = 1.01 * kSamePointAbsolute * slope;
        for (std::uint32_t v = 0; v < numOld_; ++v)
            if (isKept(values[v]) && std::fabs(values[v]) <= 2.0 * reach_) add(region.row(v), v);
    }

    void add(const double* point, std::uint32_t vertex) { index_.insert(index_.place(point), vertex); }

    /// @param value the plane's function at the point
    bool contain(const double* point, double value) const {
        const auto isSame = [&](std::uint32_t v) { return isSamePoint(region_.row(v), point, region_.q_); };
        if (index_.contains(index_.place(point), isSame)) return true;
        // Huge coefficients can put a new point off the plane, and those not filed beside it.
        for (std::uint32_t v = 0; !(std::fabs(value) <= 0.9 * reach_) && v < numOld_; ++v)
            if (isKept(values_[v]) && isSame(v)) return true;
        return false;
    }

  private:
    const CutRegion& region_;
    const std::vector<double>& values_;
    std::size_t numOld_;
    double reach_;
    PointIndex index_;
};

/// Appends the points at which edges meet the plane, and their values of the plane.
void CutRegion::addCutVertices(const std::vector<double>& plane, std::vector<double>& values) {
    TakenPlaces taken(*this, plane, values);
    std::vector<std::uint32_t> below;
    std::vector<std::uint32_t> above;
    for (std::uint32_t v = 0; v < values.size(); ++v) {
        if (values[v] < -kOnPlaneAbsolute) below.push_back(v);
        if (values[v] > kOnPlaneAbsolute) above.push_back(v);
    }

    // New vertices that huge coefficients put off the plane are met by the edges that come after them.
    std::vector<std::uint32_t> aboveByRounding;
    std::vector<double> point(q_);
    const auto meet = [&](std::uint32_t a, std::uint32_t b) {
        meetPlane(row(a), row(b), values[a], values[b], q_, point.data());
        const double value = planeValue(plane.data(), point.data(), q_);
        if (taken.contain(point.data(), value)) return;

        if (points_.size() + q_ > static_cast<std::size_t>(std::numeric_limits<int>::max()))
            throw std::length_error("more vertices than a matrix holds");
        const auto added = static_cast<std::uint32_t>(values.size());
        taken.add(point.data(), added);
        points_.insert(points_.end(), point.begin(), point.end());
        values.push_back(value);
        appendMask(point.data());
        if (value > kOnPlaneAbsolute) aboveByRounding.push_back(added);
    };

    Neighbours neighbours(*this, below.size(), std::move(above));
    for (const std::uint32_t a : below) {
        for (const std::uint32_t b : neighbours.of(a))
            meet(a, b);
        for (std::size_t i = 0; i < aboveByRounding.size(); ++i)
            if (areAdjacent(a, aboveByRounding[i])) meet(a, aboveByRounding[i]);
    }
}

void CutRegion::appendMask(const double* point) {
    std::vector<double> values(numPlanes());
    planeValues(planes_.data(), numPlanes(), point, q_, values.data());
    const std::size_t first = masks_.size();
    masks_.resize(first + words_, 0);
    for (std::size_t p = 0; p < values.size(); ++p)
        if (isOn(values[p])) setBit(first / words_, p);
}

/// Gives the masks another word when the planes have outgrown them.
void CutRegion::widenMasks() {
    if (numPlanes() <= words_ * kWordBits) return;
    std::vector<std::uint64_t> wider(numVertices() * (words_ + 1), 0);
    for (std::size_t v = 0; v < numVertices(); ++v)
        std::copy_n(mask(v), words_, &wider[v * (words_ + 1)]);
    masks_ = std::move(wider);
    ++words_;
}

void CutRegion::markPlane(std::size_t plane, const std::vector<double>& values) {
    for (std::size_t v = 0; v < values.size(); ++v)
        if (isOn(values[v])) setBit(v, plane);
}

void CutRegion::keepOnly(const std::vector<double>& values) {
    std::size_t kept = 0;
    for (std::size_t v = 0; v < values.size(); ++v) {
        if (!isKept(values[v])) continue;
        std::copy_n(row(v), q_, &points_[kept * q_]);
        std::copy_n(mask(v), words_, &masks_[kept * words_]);
        ++kept;
    }
    points_.resize(kept * q_);
    masks_.resize(kept * words_);
}

}  // namespace reisti
