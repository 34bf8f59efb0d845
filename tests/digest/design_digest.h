#ifndef REISTI_TESTS_DIGEST_DESIGN_DIGEST_H
#define REISTI_TESTS_DIGEST_DESIGN_DIGEST_H

// A thousand designs of all kinds, each reduced to one number that changes with any bit of what a host gets back. They
// are made through the public header alone, by integer draws of our own, so that every compiler, processor and way of
// linking asks for the same designs.

#include <cstdint>

namespace reisti::test {

inline constexpr std::uint32_t DIGEST_DESIGNS = 1000;
inline constexpr std::uint32_t DIGEST_FAMILIES = 4;

struct DesignDigest {
    std::int32_t code = 0;
    std::uint32_t numRuns = 0;
    std::uint64_t digest = 0;  ///< of the code and, on success, of every output of the record and of every run

    bool operator==(const DesignDigest&) const = default;
};

/// Builds design `number` of the thousand; designs are dealt to the families in turn.
DesignDigest digestOfDesign(std::uint32_t number);

/// Name of the family that design `number` belongs to.
const char* familyOfDesign(std::uint32_t number);

}  // namespace reisti::test

#endif
