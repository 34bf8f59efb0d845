#ifndef REISTI_TESTS_SUPPORT_PLAIN_MATRIX_H
#define REISTI_TESTS_SUPPORT_PLAIN_MATRIX_H

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <initializer_list>
#include <limits>
#include <ostream>
#include <random>
#include <vector>

namespace reisti::test {

/// A rectangle of doubles with the obvious loops, independent of the matrix package: the oracle of its tests.
struct PlainMatrix {
    int rows = 0;
    int cols = 0;
    std::vector<double> cells;

    PlainMatrix() = default;
    PlainMatrix(int rowCount, int colCount)
        : rows(rowCount),
          cols(colCount),
          cells(static_cast<std::size_t>(rowCount) * static_cast<std::size_t>(colCount)) {}
    PlainMatrix(std::initializer_list<std::initializer_list<double>> lines) : rows(static_cast<int>(lines.size())) {
        for (const auto& line : lines) {
            cols = static_cast<int>(line.size());
            cells.insert(cells.end(), line.begin(), line.end());
        }
    }

    double& operator()(int i, int j) { return cells[index(i, j)]; }
    double operator()(int i, int j) const { return cells[index(i, j)]; }

    /// Equality of values: -0 equals 0 and NaN equals nothing. See sameBits for the stricter comparison.
    bool operator==(const PlainMatrix&) const = default;

    std::size_t index(int i, int j) const {
        return static_cast<std::size_t>(i) * static_cast<std::size_t>(cols) + static_cast<std::size_t>(j);
    }
};

inline std::ostream& operator<<(std::ostream& os, const PlainMatrix& m) {
    os << m.rows << " by " << m.cols;
    const auto oldPrecision = os.precision(17);
    for (int i = 0; i < m.rows; ++i) {
        os << "\n  ";
        for (int j = 0; j < m.cols; ++j)
            os << m(i, j) << ' ';
    }
    os.precision(oldPrecision);
    return os;
}

/// Bit equality, except that any NaN matches any NaN: which payload survives an addition of two NaNs is the
/// processor's.
inline bool sameBits(double a, double b) {
    return std::memcmp(&a, &b, sizeof a) == 0 || (std::isnan(a) && std::isnan(b));
}
inline bool sameBits(const std::vector<double>& a, const std::vector<double>& b) {
    if (a.size() != b.size()) return false;
    for (std::size_t i = 0; i < a.size(); ++i)
        if (!sameBits(a[i], b[i])) return false;
    return true;
}
inline bool sameBits(const PlainMatrix& a, const PlainMatrix& b) {
    return a.rows == b.rows && a.cols == b.cols && sameBits(a.cells, b.cells);
}

inline PlainMatrix plainIdentity(int order) {
    PlainMatrix result(order, order);
    for (int i = 0; i < order; ++i)
        result(i, i) = 1.0;
    return result;
}

inline PlainMatrix plainTranspose(const PlainMatrix& a) {
    PlainMatrix result(a.cols, a.rows);
    for (int i = 0; i < a.rows; ++i)
        for (int j = 0; j < a.cols; ++j)
            result(j, i) = a(i, j);
    return result;
}

/// Each element accumulated from zero over ascending k; zeros are not skipped.
inline PlainMatrix plainProduct(const PlainMatrix& a, const PlainMatrix& b) {
    PlainMatrix result(a.rows, b.cols);
    for (int i = 0; i < a.rows; ++i) {
        for (int j = 0; j < b.cols; ++j) {
            double sum = 0.0;
            for (int k = 0; k < a.cols; ++k)
                sum += a(i, k) * b(k, j);
            result(i, j) = sum;
        }
    }
    return result;
}

inline PlainMatrix plainSum(const PlainMatrix& a, const PlainMatrix& b) {
    PlainMatrix result = a;
    for (std::size_t i = 0; i < result.cells.size(); ++i)
        result.cells[i] += b.cells[i];
    return result;
}

inline PlainMatrix plainDifference(const PlainMatrix& a, const PlainMatrix& b) {
    PlainMatrix result = a;
    for (std::size_t i = 0; i < result.cells.size(); ++i)
        result.cells[i] -= b.cells[i];
    return result;
}

inline PlainMatrix plainScaled(const PlainMatrix& a, double factor) {
    PlainMatrix result = a;
    for (double& cell : result.cells)
        cell *= factor;
    return result;
}

inline PlainMatrix plainColumn(const PlainMatrix& a, int j) {
    PlainMatrix result(a.rows, 1);
    for (int i = 0; i < a.rows; ++i)
        result(i, 0) = a(i, j);
    return result;
}

inline PlainMatrix plainRow(const PlainMatrix& a, int i) {
    PlainMatrix result(1, a.cols);
    for (int j = 0; j < a.cols; ++j)
        result(0, j) = a(i, j);
    return result;
}

/// A vector as a column.
inline PlainMatrix plainVector(const std::vector<double>& v) {
    PlainMatrix result(static_cast<int>(v.size()), 1);
    result.cells = v;
    return result;
}

inline double frobeniusNorm(const PlainMatrix& a) {
    double sum = 0.0;
    for (const double cell : a.cells)
        sum += cell * cell;
    return std::sqrt(sum);
}

inline double largestMagnitude(const PlainMatrix& a) {
    double largest = 0.0;
    for (const double cell : a.cells)
        largest = std::fmax(largest, std::fabs(cell));
    return largest;
}

constexpr double kEpsilon = std::numeric_limits<double>::epsilon();

/// Seeded uniform numbers that are the same with every standard library.
class UniformNumbers {
  public:
    explicit UniformNumbers(std::uint64_t seed) : engine_(seed) {}

    /// In [low, high).
    double between(double low, double high) {
        return low + (high - low) * (static_cast<double>(engine_() >> 11) * 0x1p-53);
    }
    /// In low .. high, both included.
    int integer(int low, int high) {
        return low + static_cast<int>(engine_() % (static_cast<std::uint64_t>(high - low) + 1));
    }
    PlainMatrix matrix(int rows, int cols) {
        PlainMatrix result(rows, cols);
        for (double& cell : result.cells)
            cell = between(-1.0, 1.0);
        return result;
    }
    /// Small whole numbers: sums and products of them are exact in any order.
    PlainMatrix integerMatrix(int rows, int cols) {
        PlainMatrix result(rows, cols);
        for (double& cell : result.cells)
            cell = integer(-9, 9);
        return result;
    }
    std::vector<double> vector(int length) { return matrix(length, 1).cells; }

  private:
    std::mt19937_64 engine_;
};

}  // namespace reisti::test

#endif
