#include "mixture/face_walk.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <stdexcept>

#include "mixture/id_table.h"

namespace reisti {

namespace {

/// Enough to remember the branches of any region that is planned by hand; beyond it, repeated branches are walked
/// again.
constexpr std::size_t kMostCovered = std::size_t{1} << 20U;

std::uint64_t foldedBit(std::uint32_t plane) {
    return std::uint64_t{1} << (plane % 64);
}

}  // namespace

FaceWalk::FaceWalk(std::size_t q, const double* slack, std::size_t numVertices, std::size_t numPlanes)
    : q_(q), numVertices_(numVertices), numPlanes_(numPlanes), folded_(numVertices), places_(numPlanes, 0) {
    if (numPlanes > 0 && numVertices >= std::numeric_limits<std::uint32_t>::max() / numPlanes)
        throw std::length_error("more slacks than a matrix holds");
    all_.begin.reserve(numVertices + 1);
    all_.begin.push_back(0);
    for (std::size_t v = 0; v < numVertices; ++v) {
        for (std::uint32_t p = 0; p < numPlanes; ++p)
            if (std::fabs(slack[v * numPlanes + p]) <= kOnFaceAbsolute) all_.planes.push_back(p);
        all_.begin.push_back(static_cast<std::uint32_t>(all_.planes.size()));
    }
}

std::size_t FaceWalk::count(std::size_t setSize, std::size_t minVertices, std::size_t limit) {
    begin(setSize, minVertices, true);
    std::size_t count = 0;
    while (count < limit) {
        const Level* const last = nextLastLevel();
        if (last == nullptr) break;
        count += last->children.size();
    }
    return count;
}

void FaceWalk::begin(std::size_t setSize, std::size_t minVertices, bool isCounting) {
    setSize_ = setSize;
    minVertices_ = minVertices;
    isCounting_ = isCounting;
    depth_ = 0;
    covered_.clear();
    if (setSize > numPlanes_) return;

    dropIdlePlanes();
    std::vector<Member> members(numVertices_);
    for (std::uint32_t v = 0; v < numVertices_; ++v)
        members[v] = {v, lists_.begin[v]};
    if (levels_.size() <= setSize) levels_.resize(setSize + 1);
    Level& root = levels_[0];
    root.foldedBranch = 0;
    root.next = 0;
    depth_ = 1;
    if (setSize > 0) {
        expand(members, setSize, root);
    } else if (numVertices_ >= minVertices) {
        // The set without planes holds everywhere; it stands as the child of a branch that it has not.
        root.members.swap(members);
        root.children.assign(1, {0, 0, numVertices_});
    } else {
        root.children.clear();
    }
}

/// Fills lists_ with the planes that enough vertices share, as long as the vertices lie on enough such planes.
void FaceWalk::dropIdlePlanes() {
    std::vector<std::uint32_t> numOn(numPlanes_, 0);
    for (const std::uint32_t plane : all_.planes)
        ++numOn[plane];
    lists_.begin.clear();
    lists_.planes.clear();
    lists_.begin.push_back(0);
    for (std::size_t v = 0; v < numVertices_; ++v) {
        const std::size_t first = lists_.planes.size();
        folded_[v] = 0;
        for (std::uint32_t i = all_.begin[v]; i < all_.begin[v + 1]; ++i) {
            const std::uint32_t plane = all_.planes[i];
            if (numOn[plane] < minVertices_) continue;
            lists_.planes.push_back(plane);
            folded_[v] |= foldedBit(plane);
        }
        if (lists_.planes.size() - first < setSize_) lists_.planes.resize(first);
        lists_.begin.push_back(static_cast<std::uint32_t>(lists_.planes.size()));
    }
}

/// Goes on to the next branch whose children complete the set.
/// @return its level, null when there is none
FaceWalk::Level* FaceWalk::nextLastLevel() {
    while (depth_ > 0) {
        Level& level = levels_[depth_ - 1];
        if (level.next == level.children.size()) {
            --depth_;
            continue;
        }
        if (depth_ >= setSize_) {
            level.next = level.children.size();
            return &level;
        }
        const Child child = level.children[level.next++];
        const std::size_t missing = setSize_ - depth_;
        if (wasCovered(level, child, missing)) continue;
        Level& deeper = levels_[depth_++];
        deeper.foldedBranch = level.foldedBranch | foldedBit(child.plane);
        expand(membersOf(level, child), missing, deeper);
    }
    return nullptr;
}

/// Finds the planes by which a branch that lacks `missing` planes can go on, and the vertices on each.
void FaceWalk::expand(std::span<const Member> branch, std::size_t missing, Level& level) {
    const std::uint32_t* const planes = lists_.planes.data();
    std::size_t lowest = numPlanes_;
    std::size_t highest = 0;
    for (const Member& member : branch) {
        const std::size_t end = lists_.begin[member.vertex + 1];
        for (std::size_t i = member.later; i + missing <= end; ++i) {
            ++places_[planes[i]];
            lowest = std::min<std::size_t>(lowest, planes[i]);
            highest = std::max<std::size_t>(highest, planes[i]);
        }
    }

    constexpr std::size_t kIdle = std::numeric_limits<std::size_t>::max();
    level.next = 0;
    level.children.clear();
    std::size_t total = 0;
    for (std::size_t plane = lowest; plane <= highest; ++plane) {
        const std::size_t count = places_[plane];
        places_[plane] = count < minVertices_ ? kIdle : total;
        if (count < minVertices_) continue;
        level.children.push_back({static_cast<std::uint32_t>(plane), total, total + count});
        total += count;
    }

    const bool needsMembers = missing > 1 || !isCounting_;
    if (needsMembers && level.members.size() < total) level.members.resize(total);
    for (std::size_t m = 0; needsMembers && m < branch.size(); ++m) {
        const Member member = branch[m];
        const std::size_t end = lists_.begin[member.vertex + 1];
        for (std::size_t i = member.later; i + missing <= end; ++i) {
            std::size_t& place = places_[planes[i]];
            if (place != kIdle) level.members[place++] = {member.vertex, static_cast<std::uint32_t>(i + 1)};
        }
    }
    for (std::size_t plane = lowest; plane <= highest; ++plane)
        places_[plane] = 0;
}

/// Whether all that the branch can lead to has been visited. Where planes are redundant, many sets of them hold at the
/// same vertices; what follows from such a branch depends only on its vertices, on how many planes it lacks and on the
/// plane behind which it looks for them. Without this a few planes through one face would multiply its work by the
/// number of ways to choose among them.
bool FaceWalk::wasCovered(std::span<const Member> members, std::uint64_t foldedBranch, std::uint32_t plane,
                          std::size_t missing) {
    std::uint64_t others = ~(foldedBranch | foldedBit(plane));
    for (std::size_t i = 0; i < members.size() && others != 0; ++i)
        others &= folded_[members[i].vertex];
    // Another branch with these vertices would need a plane that they share and this branch lacks.
    if (others == 0) return false;

    BranchKey key{mixBits(missing), mixBits(~missing)};
    for (const Member& member : members) {
        key.first = mixBits(key.first ^ member.vertex);
        key.second = mixBits(key.second + member.vertex);
    }
    if (const auto known = covered_.find(key); known != covered_.end()) {
        if (known->second <= plane) return true;
        known->second = plane;
    } else if (covered_.size() < kMostCovered) {
        covered_.emplace(key, plane);
    }
    return false;
}

}  // namespace reisti
