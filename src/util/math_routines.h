// Numeric routines that several rooms share: fuzzy comparison of doubles, binomial counts through logarithms, and the
// enumeration of subsets. None of them reports an error.
#ifndef REISTI_UTIL_MATH_ROUTINES_H
#define REISTI_UTIL_MATH_ROUTINES_H

#include <bit>
#include <cstdint>
#include <vector>

namespace reisti {

// The largest argument for which exp is taken: the double next below 709.782712893384, the logarithm of the largest
// finite double, so that a last-digit error of exp cannot overflow. Computed by the compiler: it is there before any
// initializer runs.
inline constexpr double MAX_EXPONENT = std::bit_cast<double>(std::bit_cast<std::uint64_t>(709.782712893384) - 1);
static_assert(MAX_EXPONENT == 709.7827128933839);

// 0 when a and b differ by at most fuzz times the greater magnitude, else -1 (a smaller) or 1. With fuzz 0 the
// comparison is exact. The third argument is not read, and is meant not to be: every caller passes 0.0 there.
int mCompareWithFuzz(double a, double b, double ignored, double fuzz);

// The magnitude of the first argument with the sign bit of the second (negative zero counts as negative).
double mTransferSign(double magnitude, double sign);

// The absolute tolerance that belongs to values of about the size x.
double getFuzzMax(double x);

// Like mCompareWithFuzz with a relative tolerance of 1e-12 plus an absolute one: getFuzzMax(scale), or 1e-30 when scale
// is 0, which lets two zero or tiny values compare equal when no scale is known.
int equalWithinFuzz(double a, double b, double scale);

// The logarithm of the gamma function for x > 0 (not checked), exactly 0 at 1 and 2.
double LogGamma(double x);

// ln(n! / (k! (n - k)!)) for 0 <= k <= n (not checked); 0 when n is 0, whatever k is.
double LogNChooseK(int n, int k);

// exp(x), clamped to the largest finite double and to 0 beyond MAX_EXPONENT.
double Exponential(double x);

// The number of k-element subsets of n elements, exact for every count that fits when n is at most 3000. A count beyond
// the range of int saturates; arguments for which the logarithm has no value give 0.
int NChooseK(int n, int k);

// Hands out the k-element subsets of {0, ..., n - 1} in lexicographic order: Initialize, then as many calls of
// NextSubset as Initialize returned.
class SubsetsOfNChooseK {
  public:
    SubsetsOfNChooseK() = default;
    SubsetsOfNChooseK(const SubsetsOfNChooseK&) = default;
    SubsetsOfNChooseK(SubsetsOfNChooseK&&) = default;
    SubsetsOfNChooseK& operator=(const SubsetsOfNChooseK&) = default;
    SubsetsOfNChooseK& operator=(SubsetsOfNChooseK&&) = default;
    virtual ~SubsetsOfNChooseK() = default;

    // Starts over with these n and k; returns the number of subsets.
    int Initialize(int n, int k);

    // Writes the next subset, ascending, into out; leaves out alone once all have been delivered.
    void NextSubset(std::vector<int>& out);

  private:
    void advance();

    std::vector<int> current_;  // the subset to be delivered next, ascending
    int n_ = 0;
    int k_ = 0;
    int count_ = 0;
    int handed_ = 0;  // calls of NextSubset since Initialize
};

}  // namespace reisti

#endif
