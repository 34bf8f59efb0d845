#ifndef REISTI_CLI_COMPONENT_H
#define REISTI_CLI_COMPONENT_H

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace cli {

/// A mixture component with its bounds in the units of the total.
struct Component {
    std::string name;
    double lower = 0;
    double upper = 1;
};

/// Reads "name", "name=low:high", "name=low:" or "name=:high"; a missing bound is 0 or the total. Throws UsageError.
Component parseComponent(std::string_view text, double total);

/// How often each kind of point is run.
struct Replicates {
    std::uint32_t vertex = 1;
    std::uint32_t center = 1;
    std::uint32_t axial = 1;
    /// Entry t-2 for the points of type t = 2..q-1.
    std::vector<std::uint32_t> types;
};

/// Reads "vertex=2,center=3,axial=1,2=1" for q components. Throws UsageError.
Replicates parseReplicates(const std::string& text, std::size_t q);

}  // namespace cli

#endif
