// The regions that are measured, read from the text files in regions/, which scripts/bench-vertices-peers reads too.
#ifndef REISTI_BENCH_VERTICES_REGIONS_H
#define REISTI_BENCH_VERTICES_REGIONS_H

#include <cstddef>
#include <cstdint>
#include <fstream>
#include <limits>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include "matrix/matrix_library.h"
#include "mixture/extreme_vertex_util.h"
#include "mixture/face_centroids.h"
#include "reisti/reisti.h"

namespace bench {

class Region {
  public:
    explicit Region(const std::string& path) {
        std::ifstream file(path);
        if (!file) throw std::runtime_error("cannot read " + path);
        for (std::string line; std::getline(file, line);)
            readLine(line);
    }

    int numComponents() const { return static_cast<int>(lower.size()); }

    /// The constraints as the interface takes them; they point into this region.
    std::vector<des_MixtureDesignLinearConstraint> constraints() const {
        std::vector<des_MixtureDesignLinearConstraint> records;
        for (std::size_t c = 0; c < coefficients.size(); ++c)
            records.push_back({isLower[c], side[c], 0, side[c], coefficients[c].data(), 0});
        return records;
    }

    std::vector<double> lower;
    std::vector<double> upper;

  private:
    void readLine(const std::string& line) {
        std::istringstream words(line);
        std::string kind;
        words >> kind;
        double number = 0.0;
        if (kind == "component") {
            double most = 0.0;
            words >> number >> most;
            lower.push_back(number);
            upper.push_back(most);
        } else if (kind == "constraint") {
            std::string relation;
            words >> relation >> number;
            isLower.push_back(relation == ">=" ? 1 : 0);
            side.push_back(number);
            coefficients.emplace_back();
            while (words >> number)
                coefficients.back().push_back(number);
        }
    }

    std::vector<std::uint8_t> isLower;
    std::vector<double> side;
    std::vector<std::vector<double>> coefficients;
};

/// Vertices and centroids of a region, found without the C interface.
class Enumeration {
  public:
    void run(const Region& region, int degree) {
        const int q = region.numComponents();
        std::vector<double> lower = region.lower;
        std::vector<double> upper = region.upper;
        std::vector<des_MixtureDesignLinearConstraint> constraints = region.constraints();
        reisti::CmExtremeVertexUtil util;
        if (degree < 2 && constraints.empty()) {
            util.mGenerateVertices(q, lower.data(), upper.data(), &numVertices, points);
            return;
        }
        std::uint8_t changed = 0;
        int numPlanes = 0;
        util.mExtremeVertex(q, static_cast<int>(constraints.size()), 1.0, lower.data(), upper.data(),
                            constraints.data(), &changed, &numVertices, &numPlanes, points, slack);
        std::vector<int> types(numVertices, 1);
        reisti::mCalculateCentroidsControl(numPlanes, numCentroids, degree, q, static_cast<int>(numVertices), slack,
                                           points, types, std::numeric_limits<int>::max());
    }

    unsigned int numVertices = 0;
    int numCentroids = 0;
    qan::matrix_library::matrix<double> points;
    qan::matrix_library::matrix<double> slack;
};

}  // namespace bench

#endif
