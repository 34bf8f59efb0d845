#ifndef REISTI_MIXTURE_FACE_WALK_H
#define REISTI_MIXTURE_FACE_WALK_H

#include <cstddef>
#include <cstdint>
#include <span>
#include <unordered_map>
#include <vector>

namespace reisti {

/// A vertex lies on a face's plane when the plane's value there is at most this, absolutely.
inline constexpr double kOnFaceAbsolute = 1e-4;

/// Finds the vertices of the faces of a region from the values of its planes at its vertices.
///
/// For one number of planes at a time, all sets of so many planes that hold at enough vertices are visited in
/// lexicographic order, depth first over their ascending planes. A branch keeps only the vertices that lie on its
/// planes and on enough later ones to complete the set, and ends when they are too few. What a branch costs is the
/// number of vertices that it keeps.
class FaceWalk {
  public:
    /// A vertex on all planes of a branch, and where in its list of planes those behind the branch begin.
    struct Member {
        std::uint32_t vertex;
        std::uint32_t later;
    };

    /// @param q     number of components
    /// @param slack [numVertices][numPlanes]
    FaceWalk(std::size_t q, const double* slack, std::size_t numVertices, std::size_t numPlanes);

    /// Calls visit(members) for every set of setSize planes that at least minVertices vertices share, these ascending,
    /// until it returns false. A set that holds at exactly the vertices of an earlier one may be left out.
    /// @return false when visit did
    template <typename Visit>
    bool walk(std::size_t setSize, std::size_t minVertices, Visit&& visit) {
        begin(setSize, minVertices, false);
        while (Level* const last = nextLastLevel()) {
            for (const Child& child : last->children)
                if (!wasCovered(*last, child, 0) && !visit(membersOf(*last, child))) return false;
        }
        return true;
    }

    /// The number of sets that walk() visits, or more: sets with the same vertices may be counted each. Once the count
    /// has reached the limit, the rest is left out.
    std::size_t count(std::size_t setSize, std::size_t minVertices, std::size_t limit);

  private:
    /// The vertices that lie on one more plane: members [begin, end) of the level.
    struct Child {
        std::uint32_t plane;
        std::size_t begin;
        std::size_t end;
    };

    /// The ways to go on from the planes of a branch, by one plane each; those before `next` have been gone.
    struct Level {
        std::vector<Member> members;
        std::vector<Child> children;
        std::size_t next = 0;
        std::uint64_t foldedBranch = 0;  ///< bit p % 64 for each plane p of the branch
    };

    /// Vertices of a branch and the number of planes that it lacks, as 128 hashed bits.
    struct BranchKey {
        std::uint64_t first;
        std::uint64_t second;
        bool operator==(const BranchKey&) const = default;
    };
    struct BranchKeyHash {
        std::size_t operator()(const BranchKey& key) const { return static_cast<std::size_t>(key.first); }
    };

    static std::span<const Member> membersOf(const Level& level, const Child& child) {
        return {level.members.data() + child.begin, child.end - child.begin};
    }

    /// Whether a vertex lies on no more planes than it takes to make one.
    bool isSimple(std::uint32_t vertex) const { return lists_.begin[vertex + 1] - lists_.begin[vertex] < q_; }

    bool wasCovered(const Level& level, const Child& child, std::size_t missing) {
        // Planes through a simple vertex are independent: each set of them has vertices of its own.
        const std::span<const Member> members = membersOf(level, child);
        return !isSimple(members.front().vertex) && !isSimple(members.back().vertex) &&
               wasCovered(members, level.foldedBranch, child.plane, missing);
    }
    bool wasCovered(std::span<const Member> members, std::uint64_t foldedBranch, std::uint32_t plane,
                    std::size_t missing);

    void begin(std::size_t setSize, std::size_t minVertices, bool isCounting);
    void dropIdlePlanes();
    Level* nextLastLevel();
    void expand(std::span<const Member> branch, std::size_t missing, Level& level);

    std::size_t q_;
    std::size_t numVertices_;
    std::size_t numPlanes_;

    // The planes on which each vertex lies, ascending: those of vertex v from place begin[v] to before place
    // begin[v+1].
    struct PlaneLists {
        std::vector<std::uint32_t> begin;
        std::vector<std::uint32_t> planes;
    };
    PlaneLists all_;
    PlaneLists lists_;                   // without the planes that no set of this walk can hold
    std::vector<std::uint64_t> folded_;  // by vertex: bit p % 64 for each plane p of its list

    std::size_t setSize_ = 0;
    std::size_t minVertices_ = 0;
    bool isCounting_ = false;  // the vertices of complete sets are not looked at
    std::size_t depth_ = 0;    // levels in use; the branch of level i has i planes
    std::vector<Level> levels_;
    std::vector<std::size_t> places_;  // by plane: what expand() counts, all zeros between two calls
    std::unordered_map<BranchKey, std::uint32_t, BranchKeyHash> covered_;
};

}  // namespace reisti

#endif
