#ifndef REISTI_TESTS_SUPPORT_PLAIN_CONFERENCE_H
#define REISTI_TESTS_SUPPORT_PLAIN_CONFERENCE_H

// Conference matrices in the plainest formulation: the oracle for the tables of the library.

#include <cstddef>
#include <cstdint>
#include <map>
#include <set>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

namespace reisti::test::plain {

using SignMatrix = std::vector<std::vector<std::int32_t>>;

/// The orders from which designs are made, ascending.
inline const std::vector<std::uint32_t>& baseOrders() {
    static const std::vector<std::uint32_t> orders = {6, 8, 10, 12, 14, 16, 18, 20, 24, 26, 30, 32, 38, 42, 44, 48};
    return orders;
}

/// Smallest base order with at least `numFactors` columns.
inline std::uint32_t baseOrder(std::uint32_t numFactors) {
    for (const std::uint32_t order : baseOrders()) {
        if (order >= numFactors) return order;
    }
    throw std::out_of_range("no base order for so many factors");
}

inline std::uint32_t baseRunCount(std::uint32_t numFactors, bool hasCategorical) {
    return 2 * baseOrder(numFactors) + (hasCategorical ? 2 : 1);
}

/// Rows of the matrices that no rule defines, as sign strings separated by blanks; null for the other orders.
inline const char* storedSigns(std::uint32_t order) {
    switch (order) {
        case 8:
            return "0+++++++ +0+-+--+ +-0-+++- +++0-+-- +--+0+-+ ++---0++ ++-++-0- +-++--+0";
        case 10:
            return "0+++++++++ +0--+-+++- +-0-++-+-+ +--0-++-++ +++-0---++ +-++-0-++- ++-+--0+-+ +++--++0-- ++-+++--0- "
                   "+-+++-+--0";
        case 12:
            return "0+++++++++++ +0----+-++++ ++0++-+--+-- ++-0++----++ ++--0+-+++-- +++--0++--+- +--++-0++-+- "
                   "++++---0+--+ +-++-+--0++- +--+-+++-0-+ +-+-+--+-+0+ +-+-+++-+--0";
        case 16:
            return "0+++++++++++++++ +0--+-++-+--+-++ ++0--+-+-++--+-+ +++0--+--+++--+- +-++0--+--+++--+ "
                   "++-++0---+-+++-- +-+-++0---+-+++- +--+-++0---+-+++ ++++++++0------- +---+-+++0++-+-- "
                   "++---+-++-0++-+- +++---+-+--0++-+ +-++---+++--0++- ++-++---+-+--0++ +-+-++--++-+--0+ "
                   "+--+-++-+++-+--0";
        case 26:
            return "0+++++++++++++++++++++++++ +0++-+---+-++-+++----++--+ ++0+---++---+-++-+++-+-+-- "
                   "+++0--++-++---+-+--+--+++- +---0+-++++-+++-+-+----+-+ ++--+0-+-+-+---+--+++-++-+ "
                   "+--+--0-++++---+++++----++ +-++++-0--+------++--+++++ +-+-+-+-0+--+-++-+--+--+++ "
                   "++-++++-+0----+-+++-+-+--- +--++-++--0++++--+-+--+--+ ++---++---+0+---++-+++-+-+ "
                   "+++-+---+-++0+-+++----++-- +---+-----+-+0+++-+++++-+- +++++---+++--+0----+++---+ "
                   "+++--++-+---++-0--++--+-++ ++-++-+--+-+++--0-+--+-++- +-+---+++++++----0+-+++--- "
                   "+-+-++++-+---+-+++0+-+---- +-++-++---++-+++--+0+--+-- +----+--++-+-++--+-+0++++- "
                   "+++----+---+-++-+++-+0--++ ++-+-+-+-++-++-+-+--+-0-+- +-++++-++--++---+--++--0+- "
                   "+--+--+++----+-++---++++0+ ++--+++++-++--++-----+--+0";
        default:
            return nullptr;
    }
}

inline SignMatrix parseSigns(const std::string& text) {
    SignMatrix matrix;
    std::istringstream rows(text);
    for (std::string row; rows >> row;) {
        std::vector<std::int32_t> values;
        for (const char sign : row) {
            if (sign != '+' && sign != '-' && sign != '0') throw std::invalid_argument("not a sign: " + row);
            values.push_back(sign == '0' ? 0 : (sign == '+' ? 1 : -1));
        }
        matrix.push_back(values);
    }
    return matrix;
}

/// +1 for a nonzero square modulo the prime, -1 for a non-square, 0 for 0: by squaring every residue.
inline std::int32_t quadraticCharacter(std::int32_t value, std::int32_t prime) {
    std::set<std::int32_t> squares;
    for (std::int32_t x = 1; x < prime; ++x) {
        squares.insert(x * x % prime);
    }
    const std::int32_t residue = (value % prime + prime) % prime;
    if (residue == 0) return 0;
    return squares.count(residue) != 0 ? 1 : -1;
}

inline SignMatrix buildConferenceMatrix(std::uint32_t order) {
    if (const char* signs = storedSigns(order)) return parseSigns(signs);
    const std::int32_t coreSign = order == 30 || order == 38 || order == 42 ? -1 : 1;
    const auto prime = static_cast<std::int32_t>(order) - 1;
    SignMatrix matrix(order, std::vector<std::int32_t>(order, 1));
    matrix[0][0] = 0;
    for (std::int32_t a = 0; a < prime; ++a) {
        for (std::int32_t b = 0; b < prime; ++b) {
            matrix[static_cast<std::size_t>(a) + 1][static_cast<std::size_t>(b) + 1] =
                coreSign * quadraticCharacter(b - a, prime);
        }
    }
    return matrix;
}

/// The matrix of a base order, or of order 4.
inline const SignMatrix& conferenceMatrix(std::uint32_t order) {
    static const std::map<std::uint32_t, SignMatrix> matrices = [] {
        std::map<std::uint32_t, SignMatrix> built = {{4, buildConferenceMatrix(4)}};
        for (const std::uint32_t base : baseOrders()) {
            built[base] = buildConferenceMatrix(base);
        }
        return built;
    }();
    return matrices.at(order);
}

}  // namespace reisti::test::plain

#endif
