#ifndef REISTI_MIXTURE_FACE_WALK_H
#define REISTI_MIXTURE_FACE_WALK_H

#include <cstddef>
#include <cstdint>
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
    /// @param slack [numVertices][numPlanes]
    FaceWalk(const double* slack, std::size_t numVertices, std::size_t numPlanes);

    /// The vertices of a face, ascending.
    using Vertices = std::vector<std::uint32_t>;

    /// Calls visit(vertices) for every set of setSize planes that at least minVertices vertices share, until it returns
    /// false. A set that holds at exactly the vertices of an earlier one may be left out.
    /// @return false when visit did
    template <typename Visit>
    bool walk(std::size_t setSize, std::size_t minVertices, Visit&& visit) {
        begin(setSize, minVertices);
        while (next())
            if (!visit(face_)) return false;
        return true;
    }

  private:
    /// A vertex on all planes of a branch, and where in its list of planes those behind the branch begin.
    struct Member {
        std::uint32_t vertex;
        std::uint32_t later;
    };

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

    void begin(std::size_t setSize, std::size_t minVertices);
    void dropIdlePlanes();
    bool next();
    void expand(const Member* first, const Member* last, std::size_t missing, Level& level);
    bool wasCovered(const Level& level, const Child& child, std::size_t missing);

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
    bool isWholeRegionDue_ = false;
    std::size_t depth_ = 0;  // levels in use; the branch of level i has i planes
    std::vector<Level> levels_;
    std::vector<std::size_t> places_;  // by plane: what expand() counts, all zeros between two calls
    Vertices face_;
    std::unordered_map<BranchKey, std::uint32_t, BranchKeyHash> covered_;
};

}  // namespace reisti

#endif
