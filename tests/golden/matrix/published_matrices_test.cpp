#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <fstream>
#include <gtest/gtest.h>
#include <optional>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include "matrix/matrix_library.h"
#include "support/plain_matrix.h"

namespace reisti::test {
namespace {

using Dense = qan::matrix_library::matrix<double>;
using Symmetric = qan::matrix_library::Smatrix<double>;
using Upper = qan::matrix_library::UTmatrix<double>;

constexpr double kEigenvalueTolerance = 1e-12;  ///< relative to the largest magnitude
constexpr double kCholeskyTolerance = 1e-12;    ///< relative to the largest element

struct PublishedMatrix {
    PlainMatrix entries;
    double determinant = 0.0;
    bool luSucceeds = false;
    double relativeTolerance = 0.0;
    std::optional<int> choleskyFailedRow;
    std::optional<PlainMatrix> choleskyUpper;
    std::optional<PlainMatrix> inverse;
    std::vector<double> eigenvalues;
};

double readNumber(std::istream& in) {
    std::string word;
    if (!(in >> word)) throw std::runtime_error("a number is missing");
    char* end = nullptr;
    const double value = std::strtod(word.c_str(), &end);
    if (*end != '\0') throw std::runtime_error("not a number: " + word);
    return value;
}

PlainMatrix readSquare(std::istream& in, int order) {
    PlainMatrix result(order, order);
    for (double& cell : result.cells)
        cell = readNumber(in);
    return result;
}

PublishedMatrix readPublishedMatrix(const std::string& name) {
    const std::string path = std::string(REISTI_GOLDEN_DIR) + "/matrix/" + name + ".txt";
    std::ifstream file(path);
    if (!file) throw std::runtime_error("cannot read " + path);
    std::stringstream in;
    for (std::string line; std::getline(file, line);)
        if (line.empty() || line.front() != '#') in << line << '\n';

    PublishedMatrix result;
    int order = 0;
    for (std::string key; in >> key;) {
        if (key == "order")
            order = static_cast<int>(readNumber(in));
        else if (key == "entries")
            result.entries = readSquare(in, order);
        else if (key == "determinant")
            result.determinant = readNumber(in);
        else if (key == "relative_tolerance")
            result.relativeTolerance = readNumber(in);
        else if (key == "cholesky_failed_row")
            result.choleskyFailedRow = static_cast<int>(readNumber(in));
        else if (key == "cholesky_upper")
            result.choleskyUpper = readSquare(in, order);
        else if (key == "inverse")
            result.inverse = readSquare(in, order);
        else if (key == "lu_succeeds")
            result.luSucceeds = (in >> key, key == "yes");
        else if (key == "eigenvalues") {
            for (int i = 0; i < order; ++i)
                result.eigenvalues.push_back(readNumber(in));
        } else
            throw std::runtime_error("unknown word in " + path + ": " + key);
    }
    return result;
}

Dense denseOf(const PlainMatrix& source) {
    return Dense(source.cells, source.cols);
}

template <class Kind>
PlainMatrix plainOf(const Kind& m) {
    PlainMatrix result(m.rowCount(), m.colCount());
    for (int i = 0; i < result.rows; ++i)
        for (int j = 0; j < result.cols; ++j)
            result(i, j) = m(i, j);
    return result;
}

class PublishedMatrices : public testing::TestWithParam<std::string> {
  protected:
    const PublishedMatrix published = readPublishedMatrix(GetParam());
    const Dense entries = denseOf(published.entries);
    const bool symmetric = published.entries == plainTranspose(published.entries);
};

TEST_P(PublishedMatrices, HaveTheirDeterminant) {
    double det = -77.0;
    EXPECT_EQ(qan::matrix_library::determinant(entries, &det), published.luSucceeds);
    const double tolerance = published.relativeTolerance * std::fabs(published.determinant);
    EXPECT_NEAR(det, published.determinant, tolerance);
    if (symmetric) {
        EXPECT_EQ(qan::matrix_library::determinant(Symmetric(entries), &det), published.luSucceeds);
        EXPECT_NEAR(det, published.determinant, tolerance);
    }
}

TEST_P(PublishedMatrices, HaveTheirInverse) {
    Dense result(1, 1, 9.0);
    ASSERT_EQ(qan::matrix_library::inverse(entries, &result), published.luSucceeds);
    ASSERT_EQ(published.inverse.has_value(), published.luSucceeds);
    if (!published.luSucceeds) {
        EXPECT_TRUE(result.empty());
        return;
    }
    const double tolerance = published.relativeTolerance * largestMagnitude(*published.inverse);
    EXPECT_LE(largestMagnitude(plainDifference(plainOf(result), *published.inverse)), tolerance);
    if (symmetric && published.choleskyFailedRow == -1) {
        Symmetric viaCholesky(0, 0.0);
        ASSERT_TRUE(qan::matrix_library::inverse(Symmetric(entries), &viaCholesky));
        EXPECT_LE(largestMagnitude(plainDifference(plainOf(viaCholesky), *published.inverse)), tolerance);
    }
}

class PublishedSymmetricMatrices : public PublishedMatrices {};

TEST_P(PublishedSymmetricMatrices, HaveTheirCholeskyOutcome) {
    ASSERT_TRUE(published.choleskyFailedRow.has_value());
    int failedRow = -7;
    double pivot = 0.0;
    const Upper u = qan::matrix_library::CholeskyDecomp(qan::matrix_library::SmatrixToUTmatrix(Symmetric(entries)), 0,
                                                        &failedRow, &pivot);
    EXPECT_EQ(failedRow, *published.choleskyFailedRow);
    Upper result;
    EXPECT_EQ(qan::matrix_library::CholeskyDecomp(Symmetric(entries), &result), *published.choleskyFailedRow == -1);
    if (published.choleskyUpper) {
        EXPECT_LE(largestMagnitude(plainDifference(plainOf(u), *published.choleskyUpper)),
                  kCholeskyTolerance * largestMagnitude(*published.choleskyUpper));
    }
}

TEST_P(PublishedSymmetricMatrices, HaveTheirSpectrum) {
    std::vector<double> values;
    Dense vectors;
    ASSERT_EQ(qan::matrix_library::EigenSystems(entries, values, vectors), 0);
    ASSERT_EQ(values.size(), published.eigenvalues.size());
    double largest = 0.0;
    for (const double value : published.eigenvalues)
        largest = std::max(largest, std::fabs(value));
    for (std::size_t k = 0; k < values.size(); ++k)
        EXPECT_NEAR(values[k], published.eigenvalues[k], kEigenvalueTolerance * largest) << k;

    const PlainMatrix v = plainOf(vectors);
    PlainMatrix scaledVectors = v;
    for (int i = 0; i < v.rows; ++i)
        for (int j = 0; j < v.cols; ++j)
            scaledVectors(i, j) *= values[static_cast<std::size_t>(j)];
    EXPECT_LE(largestMagnitude(plainDifference(plainProduct(published.entries, v), scaledVectors)),
              kEigenvalueTolerance * largest);
}

std::string identifier(const testing::TestParamInfo<std::string>& caseInfo) {
    std::string name = caseInfo.param;
    std::replace(name.begin(), name.end(), '-', '_');
    return name;
}

const std::vector<std::string> kSymmetric{"hilbert-5", "hilbert-8", "pascal2-8", "rosser1-8", "wilson-4",
                                          "wilk21-21", "dif2-12",   "lehmer-5",  "minij-8"};

INSTANTIATE_TEST_SUITE_P(Symmetric, PublishedMatrices, testing::ValuesIn(kSymmetric), identifier);
INSTANTIATE_TEST_SUITE_P(Unsymmetric, PublishedMatrices, testing::Values("frank-8", "kahan-5", "clement1-8"),
                         identifier);
INSTANTIATE_TEST_SUITE_P(Symmetric, PublishedSymmetricMatrices, testing::ValuesIn(kSymmetric), identifier);

}  // namespace
}  // namespace reisti::test
