#include "support/random_regions.h"

#include <algorithm>
#include <cmath>
#include <iomanip>
#include <limits>
#include <sstream>
#include <utility>

namespace reisti::test {

namespace {

// The double that a user gets who types so many decimals.
double typed(double x, int decimals) {
    double unit = 1.0;
    for (int i = 0; i < decimals; ++i)
        unit *= 10.0;
    return std::round(x * unit) / unit;
}

}  // namespace

void RegionMaker::decimalBounds(std::size_t q, int decimals, std::vector<double>& lower, std::vector<double>& upper) {
    roundedBounds(q, lower, upper);
    for (std::size_t j = 0; j < q; ++j) {
        lower[j] = typed(lower[j], decimals);
        upper[j] = typed(upper[j], decimals);
    }
}

// Bounds around a random mixture, not rounded yet.
void RegionMaker::roundedBounds(std::size_t q, std::vector<double>& lower, std::vector<double>& upper) {
    std::vector<double> centre(q);
    double sum = 0.0;
    for (double& x : centre)
        sum += x = 0.02 + uniform();
    lower.assign(q, 0.0);
    upper.assign(q, 1.0);
    const double width = uniform() * 0.5;
    for (std::size_t j = 0; j < q; ++j) {
        const double middle = centre[j] / sum;
        lower[j] = std::max(0.0, middle - width * uniform());
        upper[j] = std::min(1.0, middle + width * uniform() + 0.01);
        if (oneIn(8)) lower[j] = 0.0;
        if (oneIn(12)) upper[j] = 1.0;
    }
}

void RegionMaker::nominalBounds(std::size_t q, double fraction, std::vector<double>& lower,
                                std::vector<double>& upper) {
    std::vector<double> centre(q);
    double sum = 0.0;
    for (double& x : centre)
        sum += x = 0.5 + uniform();
    lower.resize(q);
    upper.resize(q);
    for (std::size_t j = 0; j < q; ++j) {
        lower[j] = centre[j] / sum * (1.0 - fraction);
        upper[j] = centre[j] / sum * (1.0 + fraction);
    }
}

void RegionMaker::typicalBounds(std::size_t q, std::vector<double>& lower, std::vector<double>& upper) {
    lower.resize(q);
    upper.resize(q);
    double sum = 0.0;
    for (double& x : lower)
        sum += x = 0.1 * uniform();
    // With many components the lower bounds alone would fill the mixture.
    for (double& x : lower)
        x *= std::min(1.0, 0.5 / sum);
    for (double& x : upper)
        x = 0.2 + 0.4 * uniform();
}

void RegionMaker::nudgeByUlps(std::vector<double>& bounds) {
    for (double& x : bounds) {
        if (!oneIn(3)) continue;
        const double towards = oneIn(2) ? 2.0 : -1.0;
        for (std::uint64_t steps = 1 + below(3); steps > 0; --steps)
            x = std::nextafter(x, towards);
    }
}

void RegionMaker::besideTies(std::size_t q, std::vector<double>& lower, std::vector<double>& upper) {
    decimalBounds(q, oneIn(2) ? 1 : 2, lower, upper);
    const auto offset = [&] { return 2.5e-13 * (static_cast<double>(below(21)) - 10.0); };
    for (std::size_t j = 0; j < q; ++j) {
        if (oneIn(2)) lower[j] += offset();
        if (oneIn(2)) upper[j] += offset();
    }
}

void RegionMaker::withTinyComponents(std::size_t q, std::vector<double>& lower, std::vector<double>& upper) {
    decimalBounds(q, 1, lower, upper);
    for (std::size_t j = 0; j < q; ++j) {
        if (!oneIn(2)) continue;
        upper[j] = static_cast<double>(1 + below(9)) * std::pow(10.0, -4.0 - static_cast<double>(below(10)));
        lower[j] = oneIn(2) ? 0.0 : upper[j] * (1.0 - 1.5e-5 * std::pow(10.0, static_cast<double>(below(4))));
    }
}

void RegionMaker::tinyRegion(std::size_t q, std::vector<double>& lower, std::vector<double>& upper) {
    lower.assign(q, 0.0);
    upper.assign(q, 1.0);
    std::vector<double> centre(q);
    double sum = 0.0;
    for (double& x : centre)
        sum += x = 0.2 + uniform();
    for (std::size_t j = 0; j < q; ++j) {
        const double middle = centre[j] / sum;
        lower[j] = middle - 1e-5 * (1.0 + static_cast<double>(below(5)));
        upper[j] = middle + 1e-5 * (1.0 + static_cast<double>(below(5)));
    }
}

void RegionMaker::bounds(std::size_t q, std::vector<double>& lower, std::vector<double>& upper) {
    unsortedBounds(q, lower, upper);
    for (std::size_t j = 0; j < q; ++j)
        if (lower[j] > upper[j]) std::swap(lower[j], upper[j]);
}

void RegionMaker::unsortedBounds(std::size_t q, std::vector<double>& lower, std::vector<double>& upper) {
    switch (below(14)) {
        case 0:
        case 1:
            return decimalBounds(q, 2, lower, upper);
        case 2:
            return decimalBounds(q, 3, lower, upper);
        case 3:
            return decimalBounds(q, 1, lower, upper);
        case 4:
            decimalBounds(q, 2, lower, upper);
            nudgeByUlps(lower);
            nudgeByUlps(upper);
            return;
        case 5:
            return nominalBounds(q, 0.05 + 0.3 * uniform(), lower, upper);
        case 6:
            return typicalBounds(q, lower, upper);
        case 7:
            // Thirds and sixths as people type them.
            decimalBounds(q, 1, lower, upper);
            for (double& x : upper)
                if (oneIn(2)) x = typed(static_cast<double>(1 + below(5)) / 6.0, 5);
            for (double& x : lower)
                if (oneIn(4)) x = typed(1.0 / 6.0, 5);
            return;
        case 8: {
            // Ranges that nearly vanish, from those just accepted to those that planes' tolerances cannot see.
            decimalBounds(q, 2, lower, upper);
            const double ranges[] = {1.1e-5, 3e-5, 5e-5, 9.9e-5, 1.01e-4, 3e-4, 1e-3};
            for (std::size_t j = 0; j < q; ++j)
                if (oneIn(3)) lower[j] = upper[j] - ranges[below(7)];
            return;
        }
        case 9:
            return besideTies(q, lower, upper);
        case 10:
            return withTinyComponents(q, lower, upper);
        case 11:
            return tinyRegion(q, lower, upper);
        case 12:
            decimalBounds(q, 2, lower, upper);
            for (double& x : lower)
                if (oneIn(2)) x = -typed(0.6 * uniform(), 1);
            return;
        default:
            lower.assign(q, 0.0);
            upper.assign(q, 1.0);
            for (double& x : upper)
                if (oneIn(3)) x = typed(0.3 + 0.7 * uniform(), 1);
            return;
    }
}

std::vector<double> RegionMaker::inside(const std::vector<double>& lower, const std::vector<double>& upper) {
    std::vector<double> x(lower.size());
    double sum = 0.0;
    for (std::size_t j = 0; j < x.size(); ++j)
        sum += x[j] = lower[j] + (upper[j] - lower[j]) * uniform();
    // Moves every component towards the bounds on the side of the missing amount by the same share of its room.
    const std::vector<double>& goal = sum < 1.0 ? upper : lower;
    double goalSum = 0.0;
    for (const double bound : goal)
        goalSum += bound;
    const double share = goalSum != sum ? (1.0 - sum) / (goalSum - sum) : 0.0;
    for (std::size_t j = 0; j < x.size(); ++j)
        x[j] += share * (goal[j] - x[j]);
    return x;
}

std::vector<double> RegionMaker::coefficients(std::size_t q) {
    std::vector<double> c(q);
    const std::uint64_t kind = below(12);
    for (double& x : c) {
        if (kind < 5)
            x = static_cast<double>(below(6)) - 2.0;  // small whole numbers, many equal
        else if (kind < 7)
            x = static_cast<double>(below(2));  // sums of some components
        else if (kind < 9)
            x = typed(4.0 * uniform() - 2.0, 2);
        else
            x = 4.0 * uniform() - 2.0;
    }
    if (kind == 9)
        for (double& x : c)
            x *= 1e3;
    if (kind == 10)
        for (double& x : c)
            x *= 1e-3;
    if (kind == 11 && oneIn(4)) {
        const double scale = oneIn(2) ? 1e10 : 1e-7;
        for (double& x : c)
            x *= scale;
    }
    if (oneIn(10)) {
        // A bound in disguise.
        for (double& x : c)
            x = 0.0;
        c[below(q)] = oneIn(2) ? 1.0 : -1.0;
    }
    return c;
}

PlainConstraint RegionMaker::constraint(const std::vector<double>& lower, const std::vector<double>& upper,
                                        double total, const std::vector<PlainConstraint>& earlier) {
    if (!earlier.empty() && oneIn(8)) {
        PlainConstraint again = earlier[below(earlier.size())];
        if (oneIn(2)) {
            // The opposite half-space, or the opposite strip.
            for (double& x : again.coefficients)
                x = -x;
        }
        return again;
    }
    PlainConstraint made;
    made.status = static_cast<int>(below(5)) - 1;
    made.coefficients = coefficients(lower.size());
    const auto valueAt = [&](const std::vector<double>& x) {
        double sum = 0.0;
        for (std::size_t j = 0; j < x.size(); ++j)
            sum += made.coefficients[j] * x[j];
        return sum * total;
    };
    double low = valueAt(inside(lower, upper));
    double high = valueAt(inside(lower, upper));
    if (low > high) std::swap(low, high);
    const std::uint64_t kind = below(20);
    if (kind < 8) {
        low = typed(low, 2);
        high = typed(high, 2);
    } else if (kind == 8) {
        low = high;  // an equation
    } else if (kind == 9) {
        low = -1e3 * total;  // sides that never cut
        high = 1e3 * total;
    } else if (kind == 10) {
        high = low - 0.5 * total;  // nothing is left
    } else if (kind == 11) {
        low = 0.0;
    } else if (kind == 12) {
        high = std::numeric_limits<double>::infinity();
    } else if (kind == 13) {
        low = -std::numeric_limits<double>::infinity();
    }
    made.lower = low;
    made.upper = high;
    made.hasLower = !oneIn(3);
    made.hasUpper = !oneIn(3);
    return made;
}

std::string describe(const std::vector<double>& lower, const std::vector<double>& upper,
                     const std::vector<PlainConstraint>& constraints, double total) {
    std::ostringstream out;
    out << std::setprecision(17);
    const auto list = [&](const std::vector<double>& values) {
        out << '{';
        for (std::size_t j = 0; j < values.size(); ++j)
            out << (j > 0 ? ", " : "") << values[j];
        out << '}';
    };
    out << "lower ";
    list(lower);
    out << " upper ";
    list(upper);
    out << " total " << total;
    for (const PlainConstraint& c : constraints) {
        out << "\n  constraint {" << c.hasLower << ", " << c.lower << ", " << c.hasUpper << ", " << c.upper << ", ";
        list(c.coefficients);
        out << ", " << c.status << '}';
    }
    return out.str();
}

}  // namespace reisti::test
