#ifndef REISTI_DSD_CONFERENCE_MATRICES_H
#define REISTI_DSD_CONFERENCE_MATRICES_H

// Conference matrices, the base of every definitive screening design: square, zero diagonal, all other entries +1 or
// -1, columns mutually orthogonal; here normalized so that the first row and column are +1.

#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace reisti {

/// Orders of the base matrices from which designs are made, ascending.
inline constexpr std::array<std::uint32_t, 16> DSD_SIZES = {6,  8,  10, 12, 14, 16, 18, 20,
                                                            24, 26, 30, 32, 38, 42, 44, 48};

/// A matrix of the given order, row by row.
template <std::size_t order>
using ConferenceMatrix = std::array<std::int32_t, order * order>;

namespace conference {

/// The bordered quadratic-residue matrix on the integers modulo the prime order-1: entry (a+1, b+1) is coreSign times
/// the quadratic character of b - a. Source: R. E. A. C. Paley, J. Mathematics and Physics 12 (1933) 311-320.
template <std::size_t order>
constexpr ConferenceMatrix<order> fromQuadraticCharacter(std::int32_t coreSign) {
    constexpr std::size_t prime = order - 1;
    std::array<std::int32_t, prime> character{};
    for (std::size_t x = 1; x < prime; ++x)
        character[x] = -1;
    for (std::size_t x = 1; x < prime; ++x)
        character[x * x % prime] = 1;

    ConferenceMatrix<order> matrix{};
    for (std::size_t i = 1; i < order; ++i)
        matrix[i] = matrix[i * order] = 1;
    for (std::size_t a = 0; a < prime; ++a) {
        for (std::size_t b = 0; b < prime; ++b) {
            matrix[(a + 1) * order + b + 1] = coreSign * character[(b + prime - a) % prime];
        }
    }
    return matrix;
}

/// One string a row: + for 1, - for -1, 0 for 0.
template <std::size_t order>
constexpr ConferenceMatrix<order> fromSigns(const std::array<std::string_view, order>& rows) {
    ConferenceMatrix<order> matrix{};
    for (std::size_t i = 0; i < order; ++i) {
        for (std::size_t j = 0; j < order; ++j) {
            const char sign = rows[i][j];
            matrix[i * order + j] = sign == '0' ? 0 : (sign == '+' ? 1 : -1);
        }
    }
    return matrix;
}

template <std::size_t order>
constexpr bool hasZeroDiagonalAndUnitBorder(const ConferenceMatrix<order>& matrix) {
    for (std::size_t i = 0; i < order; ++i) {
        for (std::size_t j = 0; j < order; ++j) {
            const std::int32_t value = matrix[i * order + j];
            if (i == j ? value != 0 : (value != 1 && value != -1)) return false;
            if (i != j && (i == 0 || j == 0) && value != 1) return false;
        }
    }
    return true;
}

/// Counts agreeing signs column pair by column pair on bit masks: the plain sums of products would exceed the number of
/// steps that compilers grant to one constant expression.
template <std::size_t order>
constexpr bool hasOrthogonalColumns(const ConferenceMatrix<order>& matrix) {
    std::array<std::uint64_t, order> plus{};
    for (std::size_t i = 0; i < order; ++i) {
        for (std::size_t j = 0; j < order; ++j) {
            if (matrix[i * order + j] == 1) plus[j] |= std::uint64_t{1} << i;
        }
    }
    constexpr std::uint64_t all = (std::uint64_t{1} << order) - 1;
    for (std::size_t a = 0; a < order; ++a) {
        for (std::size_t b = a + 1; b < order; ++b) {
            const std::uint64_t shared = all & ~(std::uint64_t{1} << a) & ~(std::uint64_t{1} << b);
            if (2 * std::popcount((plus[a] ^ plus[b]) & shared) != static_cast<int>(order - 2)) return false;
        }
    }
    return true;
}

/// Core symmetric (sign 1) or antisymmetric (sign -1) behind the border.
template <std::size_t order>
constexpr bool hasCoreSymmetry(const ConferenceMatrix<order>& matrix, std::int32_t sign) {
    for (std::size_t i = 1; i < order; ++i) {
        for (std::size_t j = 1; j < order; ++j) {
            if (matrix[i * order + j] != sign * matrix[j * order + i]) return false;
        }
    }
    return true;
}

/// A conference matrix of order 2 modulo 4 is symmetric, one of order 0 modulo 4 skew.
template <std::size_t order>
constexpr bool isNormalizedConferenceMatrix(const ConferenceMatrix<order>& matrix) {
    return hasZeroDiagonalAndUnitBorder<order>(matrix) && hasOrthogonalColumns<order>(matrix) &&
           hasCoreSymmetry<order>(matrix, order % 4 == 2 ? 1 : -1);
}

// The rule gives other matrices than the published ones for these orders (or none: 9, 15 and 25 are no primes), so they
// are stored.
inline constexpr std::array<std::string_view, 8> SIGNS_8 = {
    "0+++++++", "+0+-+--+", "+-0-+++-", "+++0-+--", "+--+0+-+", "++---0++", "++-++-0-", "+-++--+0",
};
inline constexpr std::array<std::string_view, 10> SIGNS_10 = {
    "0+++++++++", "+0--+-+++-", "+-0-++-+-+", "+--0-++-++", "+++-0---++",
    "+-++-0-++-", "++-+--0+-+", "+++--++0--", "++-+++--0-", "+-+++-+--0",
};
inline constexpr std::array<std::string_view, 12> SIGNS_12 = {
    "0+++++++++++", "+0----+-++++", "++0++-+--+--", "++-0++----++", "++--0+-+++--", "+++--0++--+-",
    "+--++-0++-+-", "++++---0+--+", "+-++-+--0++-", "+--+-+++-0-+", "+-+-+--+-+0+", "+-+-+++-+--0",
};
inline constexpr std::array<std::string_view, 16> SIGNS_16 = {
    "0+++++++++++++++", "+0--+-++-+--+-++", "++0--+-+-++--+-+", "+++0--+--+++--+-",
    "+-++0--+--+++--+", "++-++0---+-+++--", "+-+-++0---+-+++-", "+--+-++0---+-+++",
    "++++++++0-------", "+---+-+++0++-+--", "++---+-++-0++-+-", "+++---+-+--0++-+",
    "+-++---+++--0++-", "++-++---+-+--0++", "+-+-++--++-+--0+", "+--+-++-+++-+--0",
};
inline constexpr std::array<std::string_view, 26> SIGNS_26 = {
    "0+++++++++++++++++++++++++", "+0++-+---+-++-+++----++--+", "++0+---++---+-++-+++-+-+--",
    "+++0--++-++---+-+--+--+++-", "+---0+-++++-+++-+-+----+-+", "++--+0-+-+-+---+--+++-++-+",
    "+--+--0-++++---+++++----++", "+-++++-0--+------++--+++++", "+-+-+-+-0+--+-++-+--+--+++",
    "++-++++-+0----+-+++-+-+---", "+--++-++--0++++--+-+--+--+", "++---++---+0+---++-+++-+-+",
    "+++-+---+-++0+-+++----++--", "+---+-----+-+0+++-+++++-+-", "+++++---+++--+0----+++---+",
    "+++--++-+---++-0--++--+-++", "++-++-+--+-+++--0-+--+-++-", "+-+---+++++++----0+-+++---",
    "+-+-++++-+---+-+++0+-+----", "+-++-++---++-+++--+0+--+--", "+----+--++-+-++--+-+0++++-",
    "+++----+---+-++-+++-+0--++", "++-+-+-+-++-++-+-+--+-0-+-", "+-++++-++--++---+--++--0+-",
    "+--+--+++----+-++---++++0+", "++--+++++-++--++-----+--+0",
};
}  // namespace conference

// No design size selects order 4; it completes the family.
inline constexpr ConferenceMatrix<4> DSD_4 = conference::fromQuadraticCharacter<4>(1);
inline constexpr ConferenceMatrix<6> DSD_6 = conference::fromQuadraticCharacter<6>(1);
inline constexpr ConferenceMatrix<8> DSD_8 = conference::fromSigns<8>(conference::SIGNS_8);
inline constexpr ConferenceMatrix<10> DSD_10 = conference::fromSigns<10>(conference::SIGNS_10);
inline constexpr ConferenceMatrix<12> DSD_12 = conference::fromSigns<12>(conference::SIGNS_12);
inline constexpr ConferenceMatrix<14> DSD_14 = conference::fromQuadraticCharacter<14>(1);
inline constexpr ConferenceMatrix<16> DSD_16 = conference::fromSigns<16>(conference::SIGNS_16);
inline constexpr ConferenceMatrix<18> DSD_18 = conference::fromQuadraticCharacter<18>(1);
inline constexpr ConferenceMatrix<20> DSD_20 = conference::fromQuadraticCharacter<20>(1);
inline constexpr ConferenceMatrix<24> DSD_24 = conference::fromQuadraticCharacter<24>(1);
inline constexpr ConferenceMatrix<26> DSD_26 = conference::fromSigns<26>(conference::SIGNS_26);
inline constexpr ConferenceMatrix<30> DSD_30 = conference::fromQuadraticCharacter<30>(-1);
inline constexpr ConferenceMatrix<32> DSD_32 = conference::fromQuadraticCharacter<32>(1);
inline constexpr ConferenceMatrix<38> DSD_38 = conference::fromQuadraticCharacter<38>(-1);
inline constexpr ConferenceMatrix<42> DSD_42 = conference::fromQuadraticCharacter<42>(-1);
inline constexpr ConferenceMatrix<44> DSD_44 = conference::fromQuadraticCharacter<44>(1);
inline constexpr ConferenceMatrix<48> DSD_48 = conference::fromQuadraticCharacter<48>(1);

static_assert(conference::isNormalizedConferenceMatrix<4>(DSD_4));
static_assert(conference::isNormalizedConferenceMatrix<6>(DSD_6));
static_assert(conference::isNormalizedConferenceMatrix<8>(DSD_8));
static_assert(conference::isNormalizedConferenceMatrix<10>(DSD_10));
static_assert(conference::isNormalizedConferenceMatrix<12>(DSD_12));
static_assert(conference::isNormalizedConferenceMatrix<14>(DSD_14));
static_assert(conference::isNormalizedConferenceMatrix<16>(DSD_16));
static_assert(conference::isNormalizedConferenceMatrix<18>(DSD_18));
static_assert(conference::isNormalizedConferenceMatrix<20>(DSD_20));
static_assert(conference::isNormalizedConferenceMatrix<24>(DSD_24));
static_assert(conference::isNormalizedConferenceMatrix<26>(DSD_26));
static_assert(conference::isNormalizedConferenceMatrix<30>(DSD_30));
static_assert(conference::isNormalizedConferenceMatrix<32>(DSD_32));
static_assert(conference::isNormalizedConferenceMatrix<38>(DSD_38));
static_assert(conference::isNormalizedConferenceMatrix<42>(DSD_42));
static_assert(conference::isNormalizedConferenceMatrix<44>(DSD_44));
static_assert(conference::isNormalizedConferenceMatrix<48>(DSD_48));

/// The table of an order, row by row; null when there is none.
const std::int32_t* conferenceMatrix(std::uint32_t order);

/// Order of the base matrix for a design: the smallest of DSD_SIZES with at least numFactors columns (48 for more).
std::uint32_t baseOrder(std::uint32_t numFactors);

/// Number of runs of one replicate: a foldover pair for each row and one centre run, two with categorical factors.
std::uint32_t baseRunCount(std::uint32_t numFactors, bool hasCategorical);

}  // namespace reisti

#endif
