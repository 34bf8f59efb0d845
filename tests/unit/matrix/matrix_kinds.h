#ifndef REISTI_TESTS_UNIT_MATRIX_MATRIX_KINDS_H
#define REISTI_TESTS_UNIT_MATRIX_MATRIX_KINDS_H

#include <algorithm>
#include <array>
#include <cctype>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <string>
#include <string_view>
#include <vector>

#include "matrix/matrix_library.h"
#include "support/failure_text.h"
#include "support/plain_matrix.h"
#include "support/scale.h"

namespace reisti::test {

using Dense = qan::matrix_library::matrix<double>;
using Diagonal = qan::matrix_library::Dmatrix<double>;
using Upper = qan::matrix_library::UTmatrix<double>;
using Symmetric = qan::matrix_library::Smatrix<double>;
using Vec = std::vector<double>;

using qan::allege::AllegeException;
using qan::matrix_library::MatrixException;
using qan::matrix_library::MatrixSingular;

/// The value of a matrix of any kind, read element by element through the const accessor.
template <class Kind>
PlainMatrix plain(const Kind& m) {
    PlainMatrix result(m.rowCount(), m.colCount());
    for (int i = 0; i < result.rows; ++i)
        for (int j = 0; j < result.cols; ++j)
            result(i, j) = m(i, j);
    return result;
}

inline Dense dense(const PlainMatrix& source) {
    Dense result(source.rows, source.cols, 0.0);
    for (int i = 0; i < source.rows; ++i)
        for (int j = 0; j < source.cols; ++j)
            result(i, j) = source(i, j);
    return result;
}

/// The diagonal of `source`.
inline Diagonal diagonal(const PlainMatrix& source) {
    Diagonal result;
    result.resize(source.rows, 0.0);
    for (int i = 0; i < source.rows; ++i)
        result(i, i) = source(i, i);
    return result;
}
inline Diagonal diagonal(const Vec& elements) {
    Diagonal result;
    result.resize(static_cast<int>(elements.size()), 0.0);
    for (int i = 0; i < result.rowCount(); ++i)
        result(i, i) = elements[static_cast<std::size_t>(i)];
    return result;
}

/// The upper triangle of `source`.
inline Upper upper(const PlainMatrix& source) {
    Upper result(source.rows, 0.0);
    for (int i = 0; i < source.rows; ++i)
        for (int j = i; j < source.cols; ++j)
            result(i, j) = source(i, j);
    return result;
}

/// The lower triangle of `source`, mirrored.
inline Symmetric symmetric(const PlainMatrix& source) {
    Symmetric result(source.rows, 0.0);
    for (int i = 0; i < source.rows; ++i)
        for (int j = 0; j <= i; ++j)
            result(i, j) = source(i, j);
    return result;
}

/// One function template for typed tests over the kinds. A square kind takes what it stores from `source`.
template <class Kind>
Kind make(const PlainMatrix& source);
template <>
inline Dense make<Dense>(const PlainMatrix& source) {
    return dense(source);
}
template <>
inline Diagonal make<Diagonal>(const PlainMatrix& source) {
    return diagonal(source);
}
template <>
inline Upper make<Upper>(const PlainMatrix& source) {
    return upper(source);
}
template <>
inline Symmetric make<Symmetric>(const PlainMatrix& source) {
    return symmetric(source);
}

template <class Kind>
constexpr bool kIsDense = std::is_same_v<Kind, Dense>;

/// Accepts "assertion failed: (EXPRESSION) STEM.<extension>: <line>", where STEM is one of `stems`.
inline bool isAssertionTextFrom(std::string_view text, const std::string& expression,
                                const std::vector<std::string>& stems) {
    const std::string opening = "assertion failed: (" + expression + ") ";
    if (text.substr(0, opening.size()) != opening) return false;
    text.remove_prefix(opening.size());
    const auto stem = std::find_if(stems.begin(), stems.end(), [&](const std::string& candidate) {
        return text.substr(0, candidate.size() + 1) == candidate + ".";
    });
    if (stem == stems.end()) return false;
    text.remove_prefix(stem->size() + 1);
    const auto takeAll = [&text](auto belongs) {
        std::size_t length = 0;
        while (length < text.size() && belongs(text[length]))
            ++length;
        text.remove_prefix(length);
        return length > 0;
    };
    if (!takeAll([](char c) { return std::islower(static_cast<unsigned char>(c)) != 0; })) return false;
    if (text.substr(0, 2) != ": ") return false;
    text.remove_prefix(2);
    return takeAll([](char c) { return std::isdigit(static_cast<unsigned char>(c)) != 0; }) && text.empty();
}

/// An assertion of which the source file is fixed, too.
MATCHER_P2(IsAssertion, expression, stem, "is the text of a failed assertion (" + std::string(expression) + ")") {
    return isAssertionTextFrom(arg, expression, {stem});
}

/// An assertion that may stand in any source file of the package.
MATCHER_P(IsAssertion, expression, "is the text of a failed assertion (" + std::string(expression) + ")") {
    return isAssertionTextFrom(arg, expression,
                               {"src/matrix/matrix_impl", "src/matrix/matrix_new", "src/matrix/matrix_symmetric_impl",
                                "src/matrix/matrix_upper_impl", "src/matrix/matrix_expression",
                                "src/matrix/matrix_functions", "src/matrix/matrix_ludecomposition"});
}

/// Debug and sanitizer builds may reject arguments that release builds do not look at.
constexpr bool uncheckedArgumentsMayBeAsserted() {
#if !defined(NDEBUG) || defined(__SANITIZE_ADDRESS__)
    return true;
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
    return true;
#else
    return false;
#endif
#else
    return false;
#endif
}

}  // namespace reisti::test

#endif
