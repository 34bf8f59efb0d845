#include "util/math_routines.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>
#include <numeric>

namespace reisti {

namespace {

constexpr double kLargestDouble = std::numeric_limits<double>::max();

// Tolerances of equalWithinFuzz: relative to the greater magnitude, relative to the caller's scale, and absolute.
constexpr double kEqualRelativeFuzz = 1e-12;
constexpr double kScaleRelativeFuzz = 1e-14;
constexpr double kTinyAbsoluteFuzz = 1e-30;

constexpr double kLogSqrtTwoPi = 0.9189385332046727;

// Lanczos coefficients for g = 7 (Lanczos 1964), c8 down to c1: the order in which the series adds them.
constexpr double kLanczosSeries[] = {1.659470187408462e-7, 9.934937113930748e-6, -0.1385710331296526,
                                     12.50734324009056,    -176.6150291498386,   771.3234287757674,
                                     -1259.139216722289,   676.5203681218835};
constexpr double kLanczosConstant = 0.9999999999995183;
constexpr double kLanczosFirstShift = 7.0;  // the denominator of c8 is x + 7

int orderOf(double a, double b) {
    return b > a ? -1 : 1;
}

// Doubles, so that neither m + 1 nor a difference of two ints can overflow.
double logFactorial(double m) {
    if (m == 0.0 || m == 1.0) return 0.0;
    return LogGamma(m + 1.0);
}

// The nearest whole number to exp(logCount), as an int.
int countFromLog(double logCount) {
    double value = std::exp(logCount) + 0.5;
    if (logCount > MAX_EXPONENT) value = kLargestDouble;
    if (logCount < -MAX_EXPONENT) value = 0.5;
    const double whole = std::floor(value);
    if (std::isnan(whole)) return 0;
    constexpr int kMost = std::numeric_limits<int>::max();
    return whole >= static_cast<double>(kMost) ? kMost : static_cast<int>(whole);
}

}  // namespace

int mCompareWithFuzz(double a, double b, double /*ignored*/, double fuzz) {
    const double tolerance = std::max(std::fabs(a), std::fabs(b)) * fuzz;
    if (tolerance >= std::fabs(a - b)) return 0;
    return orderOf(a, b);
}

double mTransferSign(double magnitude, double sign) {
    return std::copysign(magnitude, sign);
}

double getFuzzMax(double x) {
    return x * kScaleRelativeFuzz;
}

int equalWithinFuzz(double a, double b, double scale) {
    const double absolute = scale != 0.0 ? getFuzzMax(scale) : kTinyAbsoluteFuzz;
    // fmax passes over a value that is not a number.
    const double tolerance = std::fmax(std::fabs(a), std::fabs(b)) * kEqualRelativeFuzz + absolute;
    if (tolerance >= std::fabs(a - b)) return 0;
    return orderOf(a, b);
}

double LogGamma(double x) {
    if (x == 1.0 || x == 2.0) return 0.0;
    // Smallest terms first: added after the large ones they would lose their digits.
    double series = 0.0;
    double denominator = x + kLanczosFirstShift;
    for (const double coefficient : kLanczosSeries) {
        series += coefficient / denominator;
        denominator -= 1.0;
    }
    series += kLanczosConstant;
    return std::log(series) + kLogSqrtTwoPi - (x + 6.5) + (x - 0.5) * std::log(x + 6.5);
}

double LogNChooseK(int n, int k) {
    if (n == 0) return 0.0;
    const double all = n;
    const double chosen = k;
    return logFactorial(all) - logFactorial(chosen) - logFactorial(all - chosen);
}

double Exponential(double x) {
    if (x > MAX_EXPONENT) return kLargestDouble;
    if (x < -MAX_EXPONENT) return 0.0;
    return std::exp(x);
}

int NChooseK(int n, int k) {
    return countFromLog(LogNChooseK(n, k));
}

int SubsetsOfNChooseK::Initialize(int n, int k) {
    n_ = n;
    k_ = k;
    handed_ = 0;
    current_.resize(static_cast<std::size_t>(std::max(k, 0)));
    std::iota(current_.begin(), current_.end(), 0);
    count_ = countFromLog(LogNChooseK(n, k));
    return count_;
}

void SubsetsOfNChooseK::NextSubset(std::vector<int>& out) {
    const int delivered = handed_;
    if (handed_ < std::numeric_limits<int>::max()) ++handed_;
    if (delivered >= count_) return;
    if (&out != &current_) out = current_;
    // The last subset has no successor, so it must not be advanced.
    if (handed_ == count_) return;
    advance();
}

void SubsetsOfNChooseK::advance() {
    // Position i can still grow while it is below its greatest value, n - (k - i). A count that rounding made too great
    // would carry the scan past the front; the last subset is then handed out again.
    const std::ptrdiff_t size = std::ssize(current_);
    std::ptrdiff_t i = size - 1;
    while (i >= 0 && current_[static_cast<std::size_t>(i)] >= n_ - (k_ - static_cast<int>(i)))
        --i;
    if (i < 0) return;
    const auto grown = current_.begin() + i;
    std::iota(grown, current_.end(), *grown + 1);
}

}  // namespace reisti
