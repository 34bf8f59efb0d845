#include "support/plain_extreme_vertices_run.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <map>
#include <string>
#include <utility>

#include "reisti/reisti.h"
#include "ruv/ruv.h"

namespace reisti::test {

namespace {

double sumOf(const std::vector<double>& values) {
    double sum = 0.0;
    for (const double v : values)
        sum += v;
    return sum;
}

// The pipeline of one run. Each function is one stage; the outcome is the record.
class Pipeline {
  public:
    explicit Pipeline(const PlainRequest& request)
        : ask_(request), q_(request.lower.size()), total_(request.amounts.empty() ? 1.0 : request.amounts[0]) {
        out_.lower = ask_.lower;
        out_.upper = ask_.upper;
        for (const PlainConstraint& constraint : ask_.constraints)
            out_.statuses.push_back(constraint.status);
    }

    PlainOutcome run() {
        out_.code = checkRequest();
        if (out_.code == 0) out_.code = findPoints();
        if (out_.code == 0) out_.code = countRuns();
        if (out_.code != 0) return out_;
        appendBaseRuns();
        appendCenter();
        appendAxial();
        replicateClasses();
        replicateDesign();
        crossWithAmounts();
        crossWithProcess();
        rescale();
        randomize();
        summarize();
        return out_;
    }

  private:
    std::int32_t checkRequest();
    std::int32_t findPoints();
    std::int32_t countRuns();
    void appendBaseRuns();
    void appendCenter();
    void appendAxial();
    void replicateClasses();
    void replicateDesign();
    void crossWithAmounts();
    void crossWithProcess();
    void rescale();
    void randomize();
    void summarize();

    std::size_t numVertices() const { return region_.points.size(); }
    bool centerIsAppended() const {
        return ask_.centerPoint && static_cast<std::size_t>(ask_.degree) % q_ != 0 && numVertices() > 0;
    }
    std::vector<double> meanOfVertices() const;
    std::uint32_t replicatesOf(std::int32_t type) const;
    std::uint64_t numSettings() const { return (std::uint64_t{1} << ask_.numProcessVariables) / ask_.processFraction; }
    void append(std::int32_t type, const std::vector<double>& proportions) {
        PlainRun run;
        run.pointType = type;
        run.proportions = proportions;
        out_.runs.push_back(run);
    }

    const PlainRequest& ask_;
    std::size_t q_;
    double total_;
    PlainOutcome out_;
    PlainRegion region_;
    Table points_;
    std::vector<int> types_;
};

bool fractionAllowed(std::uint32_t p, std::uint32_t f) {
    switch (p) {
        case 0:
            return true;
        case 1:
        case 2:
            return f == 1;
        case 3:
        case 4:
            return f == 1 || f == 2;
        case 5:
            return f == 1 || f == 2 || f == 4;
        case 6:
            return f == 1 || f == 2 || f == 4 || f == 8;
        default:
            return f == 1 || f == 2 || f == 4 || f == 8 || f == 16;
    }
}

std::int32_t Pipeline::checkRequest() {
    if (static_cast<std::uint32_t>(ask_.degree) > q_) return des_ErrorDegree;
    if (ask_.amounts.size() >= 2 && ask_.numProcessVariables >= 1) return des_ErrorAmountsAndProcess;
    if (!fractionAllowed(ask_.numProcessVariables, ask_.processFraction)) return des_ErrorProcessFraction;
    for (double& bound : out_.lower)
        bound /= total_;
    for (double& bound : out_.upper)
        bound /= total_;
    const std::int32_t code = plainCheckBounds(out_.lower, out_.upper, out_.boundsAdjusted);
    if (code != 0) return code;
    for (std::size_t j = 0; j < q_; ++j)
        if (!std::isfinite(out_.lower[j]) || !std::isfinite(out_.upper[j])) return des_ErrorNotANumber;
    return 0;
}

std::int32_t Pipeline::findPoints() {
    region_.lower = out_.lower;
    region_.upper = out_.upper;
    region_.constraints = ask_.constraints;
    region_.total = total_;
    region_.boundsChanged = out_.boundsAdjusted;
    plainExtremeVertices(region_);
    out_.lower = region_.lower;
    out_.upper = region_.upper;
    out_.boundsAdjusted = region_.boundsChanged;
    for (std::size_t c = 0; c < region_.constraints.size(); ++c)
        out_.statuses[c] = region_.constraints[c].status;

    const int numPlanes = static_cast<int>(region_.planes.size());
    const int limit = ask_.maxPoints >= 1 ? ask_.maxPoints : 2147483647;
    const PlainCentroids found =
        plainFaceCentroids(region_.points, region_.slack, numPlanes, static_cast<int>(q_), ask_.degree, limit);
    if (!found.withinLimit) return des_ErrorTooManyPoints;
    points_ = found.points;
    types_ = found.types;
    types_.resize(points_.size(), 1);
    out_.boundaryCounts = plainBoundaryCounts(out_.lower, out_.upper);
    return 0;
}

std::uint32_t Pipeline::replicatesOf(std::int32_t type) const {
    if (type == -1) return ask_.axialReplicates;
    if (type == 0) return ask_.centerReplicates;
    if (type == 1) return ask_.vertexReplicates;
    return ask_.typeReplicates.empty() ? 1 : ask_.typeReplicates[static_cast<std::size_t>(type - 2)];
}

std::int32_t Pipeline::countRuns() {
    out_.pointsPerType.assign(q_, 0);
    for (const int type : types_) {
        if (type == 0)
            out_.numCenterPoints = 1;
        else
            ++out_.pointsPerType[static_cast<std::size_t>(type - 1)];
    }
    if (centerIsAppended()) out_.numCenterPoints = 1;
    if (ask_.axialPoints) out_.numAxialPoints = static_cast<std::uint32_t>(numVertices());

    long double runs = 0.0L;
    for (std::size_t t = 0; t < q_; ++t)
        if (out_.pointsPerType[t] > 0)
            runs += static_cast<long double>(out_.pointsPerType[t]) * replicatesOf(static_cast<std::int32_t>(t + 1));
    runs += static_cast<long double>(out_.numCenterPoints) * ask_.centerReplicates;
    runs += static_cast<long double>(out_.numAxialPoints) * ask_.axialReplicates;
    runs *= ask_.designReplicates;
    if (!ask_.amounts.empty()) runs *= static_cast<long double>(ask_.amounts.size());
    if (ask_.numProcessVariables > 0) runs *= static_cast<long double>(numSettings());
    return runs > 4294967295.0L ? des_ErrorOutOfMemory : 0;
}

void Pipeline::appendBaseRuns() {
    for (std::size_t r = 0; r < points_.size(); ++r)
        append(types_[r], points_[r]);
}

std::vector<double> Pipeline::meanOfVertices() const {
    std::vector<double> mean(q_, 0.0);
    for (std::size_t j = 0; j < q_; ++j) {
        for (std::size_t r = 0; r < numVertices(); ++r)
            mean[j] += points_[r][j];
        mean[j] /= static_cast<double>(numVertices());
    }
    return mean;
}

void Pipeline::appendCenter() {
    if (centerIsAppended()) append(0, meanOfVertices());
}

void Pipeline::appendAxial() {
    if (!ask_.axialPoints) return;
    const std::vector<double> mean = meanOfVertices();
    for (std::size_t i = 0; i < numVertices(); ++i) {
        std::vector<double> x(q_);
        for (std::size_t j = 0; j < q_; ++j)
            x[j] = (mean[j] + points_[i][j]) * 0.5;
        append(-1, x);
    }
}

void Pipeline::replicateClasses() {
    // A class that is run no times loses its points; what remains is the set of distinct runs.
    std::vector<PlainRun> distinct;
    for (const PlainRun& run : out_.runs)
        if (replicatesOf(run.pointType) > 0) distinct.push_back(run);
    out_.runs = distinct;

    std::vector<std::int32_t> classes;
    for (std::size_t t = 1; t <= q_; ++t)
        classes.push_back(static_cast<std::int32_t>(t));
    classes.push_back(0);
    classes.push_back(-1);
    for (const std::int32_t type : classes) {
        for (const PlainRun& run : distinct) {
            if (run.pointType != type) continue;
            for (std::uint32_t copy = 1; copy < replicatesOf(type); ++copy)
                append(type, run.proportions);
        }
    }
}

void Pipeline::replicateDesign() {
    const std::vector<PlainRun> once = out_.runs;
    out_.runs.clear();
    for (std::uint32_t copy = 0; copy < ask_.designReplicates; ++copy)
        out_.runs.insert(out_.runs.end(), once.begin(), once.end());
}

void Pipeline::crossWithAmounts() {
    if (ask_.amounts.empty()) return;
    const std::vector<PlainRun> once = out_.runs;
    out_.runs.clear();
    for (const double amount : ask_.amounts) {
        for (PlainRun run : once) {
            run.amount = amount;
            out_.runs.push_back(run);
        }
    }
}

// Words that define the added factors of a fraction of 2^p in n runs.
std::vector<std::string> generatorWords(std::uint32_t p, std::uint64_t n) {
    static const std::map<std::pair<std::uint32_t, std::uint64_t>, std::vector<std::string>> words = {
        {{3, 4}, {"AB"}},
        {{4, 8}, {"ABC"}},
        {{5, 8}, {"AB", "AC"}},
        {{5, 16}, {"ABCD"}},
        {{6, 8}, {"AB", "AC", "BC"}},
        {{6, 16}, {"ABC", "BCD"}},
        {{6, 32}, {"ABCDE"}},
        {{7, 8}, {"AB", "AC", "BC", "ABC"}},
        {{7, 16}, {"ABC", "BCD", "ACD"}},
        {{7, 32}, {"ABCD", "ABDE"}},
        {{7, 64}, {"ABCDEF"}},
    };
    return words.at({p, n});
}

// The levels of setting k: basic factors count in binary, the first fastest; added ones are signed products of them.
std::vector<std::int32_t> levelsOf(std::uint64_t k, std::uint32_t p, std::uint32_t fraction, std::uint32_t index) {
    std::uint32_t added = 0;
    while ((std::uint32_t{1} << added) < fraction)
        ++added;
    std::vector<std::int32_t> levels;
    for (std::uint32_t i = 0; i < p - added; ++i)
        levels.push_back((k >> i) % 2 == 0 ? -1 : 1);
    if (added == 0) return levels;
    const std::vector<std::string> words = generatorWords(p, (std::uint64_t{1} << p) / fraction);
    for (std::uint32_t j = 0; j < added; ++j) {
        const std::uint32_t width = std::uint32_t{1} << j;
        const std::uint32_t group = index / width + (index % width != 0 ? 1 : 0);
        std::int32_t level = index == fraction || group % 2 == 0 ? 1 : -1;
        for (const char letter : words[j])
            level *= levels[static_cast<std::size_t>(letter - 'A')];
        levels.push_back(level);
    }
    return levels;
}

void Pipeline::crossWithProcess() {
    if (ask_.numProcessVariables == 0) return;
    const std::vector<PlainRun> once = out_.runs;
    out_.runs.clear();
    for (std::uint64_t k = 0; k < numSettings(); ++k) {
        for (PlainRun run : once) {
            run.processLevels = levelsOf(k, ask_.numProcessVariables, ask_.processFraction, ask_.fractionIndex);
            out_.runs.push_back(run);
        }
    }
}

void Pipeline::rescale() {
    const double lowerSum = sumOf(out_.lower);
    const std::size_t numAmounts = ask_.amounts.size();
    for (PlainRun& run : out_.runs) {
        for (std::size_t j = 0; j < q_; ++j) {
            double& x = run.proportions[j];
            if (ask_.outputUnits == des_UnitsPseudo) {
                x = (x - out_.lower[j]) / (1 - lowerSum);
                if (x < 0) x = 0.0;
            } else if (ask_.outputUnits == des_UnitsAmount && numAmounts != 0) {
                x *= numAmounts == 1 ? total_ : run.amount;
            }
        }
        if (ask_.outputUnits != des_UnitsPseudo) continue;
        const double sum = sumOf(run.proportions);
        if (sum == 1.0) continue;
        for (double& x : run.proportions)
            x /= sum;
    }
    if (numAmounts == 0) return;
    for (double& bound : out_.lower)
        bound *= total_;
    for (double& bound : out_.upper)
        bound *= total_;
}

void Pipeline::randomize() {
    const std::size_t n = out_.runs.size();
    for (std::size_t i = 0; i < n; ++i)
        out_.runs[i].runOrder = static_cast<std::uint32_t>(i + 1);
    if (!ask_.randomize || n == 0) return;
    std::vector<double> keys(n);
    std::int32_t status = 0;
    ruv_ISampler* sampler = ruv_MakeISampler(&status, ruv_KindMersenneTwister64, ask_.seed);
    ruv_GetUniformSample(sampler, keys.data(), static_cast<std::uint32_t>(n), 0.0, 1.0);
    ruv_DeleteISampler(&sampler);
    for (std::size_t i = 0; i < n; ++i) {
        const auto smaller = std::count_if(keys.begin(), keys.end(), [&](double key) { return key < keys[i]; });
        out_.runs[i].runOrder = static_cast<std::uint32_t>(smaller + 1);
    }
}

void Pipeline::summarize() {
    const double lowerSum = sumOf(out_.lower);
    for (std::size_t j = 0; j < q_; ++j) {
        out_.scaledLower.push_back(out_.lower[j] / total_);
        out_.scaledUpper.push_back(out_.upper[j] / total_);
        out_.pseudoLower.push_back(0.0);
        out_.pseudoUpper.push_back((out_.scaledUpper[j] - out_.scaledLower[j]) / (1 - lowerSum / total_));
    }
}

std::uint32_t binomial(std::size_t n, std::size_t k) {
    std::vector<std::uint32_t> row(n + 1, 0);
    row[0] = 1;
    for (std::size_t i = 1; i <= n; ++i)
        for (std::size_t j = i; j >= 1; --j)
            row[j] += row[j - 1];
    return k <= n ? row[k] : 0;
}

}  // namespace

int plainEqualWithinFuzz(double a, double b, double scale) {
    const double larger = std::isnan(a) || std::fabs(b) > std::fabs(a) ? std::fabs(b) : std::fabs(a);
    const double tolerance = larger * 1e-12 + (scale != 0 ? scale * 1e-14 : 1e-30);
    if (tolerance >= std::fabs(a - b)) return 0;
    return b > a ? -1 : 1;
}

std::int32_t plainCheckBounds(std::vector<double>& lower, std::vector<double>& upper, bool& adjusted) {
    adjusted = false;
    const double lowerSum = sumOf(lower);
    const double upperSum = sumOf(upper);
    if (plainEqualWithinFuzz(lowerSum, 1.0, 0.0) != -1) return des_ErrorLowerBoundSum;
    if (plainEqualWithinFuzz(upperSum, 1.0, 0.0) != 1) return des_ErrorUpperBoundSum;
    const double room = 1 - lowerSum;
    const double excess = upperSum - 1;
    for (std::size_t i = 0; i < lower.size(); ++i) {
        const double givenUpper = upper[i];
        if (plainEqualWithinFuzz(givenUpper, 1.0, 0.0) == 1) return des_ErrorUpperBound;
        const double range = givenUpper - lower[i];
        if (range <= givenUpper * 1e-5) return des_ErrorEmptyRange;
        if (plainEqualWithinFuzz(range, room, 1.0) == 1) {
            upper[i] = lower[i] + room;
            adjusted = true;
        }
        if (plainEqualWithinFuzz(range, excess, 1.0) == 1) {
            lower[i] = givenUpper - excess;
            adjusted = true;
        }
    }
    return 0;
}

std::vector<std::uint32_t> plainBoundaryCounts(const std::vector<double>& lower, const std::vector<double>& upper) {
    const std::size_t q = lower.size();
    const double room = 1 - sumOf(lower);
    const double excess = sumOf(upper) - 1;
    const double reach = room <= excess ? room : excess;

    // Entry k counts the subsets of k ranges that sum to less than the reach, or to just the reach.
    std::vector<std::uint32_t> less(q + 1, 0);
    std::vector<std::uint32_t> equal(q + 1, 0);
    for (std::uint64_t set = 1; set < (std::uint64_t{1} << q); ++set) {
        double sum = 0.0;
        std::size_t k = 0;
        for (std::size_t j = 0; j < q; ++j) {
            if ((set >> j) % 2 == 0) continue;
            sum += upper[j] - lower[j];
            ++k;
        }
        const int order = plainEqualWithinFuzz(reach, sum, 1.0);
        if (order == 0) ++equal[k];
        if (order == 1) ++less[k];
    }

    // Negative terms are added modulo 2^32.
    std::vector<std::uint32_t> counts(q, 0);
    counts[q - 1] = 1;
    for (std::size_t d = 1; d + 2 <= q; ++d) {
        counts[d] = binomial(q, d + 1);
        for (std::size_t k = 1; k + d + 1 <= q; ++k)
            counts[d] += less[k] * binomial(q - k, d + 1);
        for (std::size_t k = d + 1; k <= q; ++k)
            counts[d] -= (less[k] + equal[k]) * binomial(k, d + 1);
    }
    counts[0] = static_cast<std::uint32_t>(q);
    for (std::size_t k = 1; k <= q; ++k)
        counts[0] += less[k] * static_cast<std::uint32_t>(q - 2 * k) - equal[k] * static_cast<std::uint32_t>(k - 1);
    return counts;
}

PlainOutcome plainExtremeVerticesRun(const PlainRequest& request) {
    return Pipeline(request).run();
}

}  // namespace reisti::test
