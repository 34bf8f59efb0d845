#include <climits>
#include <cstddef>
#include <cstdint>
#include <new>

#include "matrix/matrix_dimensions.h"
#include "support/failing_new.h"
#include "unit/matrix/matrix_kinds.h"

// Sizes are 32-bit. A shape whose element count does not fit, or a negative one, is refused before anything is
// allocated.

namespace reisti::test {
namespace {

constexpr std::ptrdiff_t kRoomForAMessage = 4096;

/// Runs `action`, which must throw a MatrixException, and returns the most bytes that it held at any moment.
template <class Action>
std::ptrdiff_t peakBytesOfRefusal(Action action) {
    AllocationWatch watch;
    bool refused = false;
    try {
        action();
    } catch (const MatrixException& refusal) {
        refused = refusal.what()[0] != '\0';
    } catch (const std::bad_alloc&) {
        refused = false;
    }
    watch.stop();
    EXPECT_TRUE(refused) << "a MatrixException with a text was expected";
    return watch.counts().peakBytes;
}

struct Shape {
    const char* name;
    int rows;
    int cols;
};

class ImpossibleShape : public testing::TestWithParam<Shape> {};

TEST_P(ImpossibleShape, IsNotConstructed) {
    const Shape& shape = GetParam();
    EXPECT_LE(peakBytesOfRefusal([&] { static_cast<void>(Dense(shape.rows, shape.cols, 1.0)); }), kRoomForAMessage);
}

TEST_P(ImpossibleShape, IsNotResizedTo) {
    const Shape& shape = GetParam();
    Dense m(Vec{1, 2, 3, 4}, 2);
    EXPECT_LE(peakBytesOfRefusal([&] { m.resize(shape.rows, shape.cols, 1.0); }), kRoomForAMessage);
    EXPECT_LE(peakBytesOfRefusal([&] { m.ResizeStorage(shape.rows, shape.cols, 1.0); }), kRoomForAMessage);
    EXPECT_LE(peakBytesOfRefusal([&] { m.Initialize(shape.rows, shape.cols, 1.0); }), kRoomForAMessage);
    EXPECT_EQ(plain(m), (PlainMatrix{{1, 2}, {3, 4}}));
    EXPECT_EQ(m.size(), 4);
}

INSTANTIATE_TEST_SUITE_P(Shapes, ImpossibleShape,
                         testing::Values(Shape{"JustTooLarge", 46341, 46341}, Shape{"TwoToThe31", 65536, 32768},
                                         Shape{"WrapsToZero", 65536, 65536}, Shape{"WrapsToASmallCount", 65537, 65537},
                                         Shape{"Largest", INT_MAX, INT_MAX}, Shape{"NegativeRows", -1, 2},
                                         Shape{"NegativeCols", 2, -1}, Shape{"BothNegative", -2, -3},
                                         Shape{"NegativeTimesZero", -1, 0}, Shape{"Smallest", INT_MIN, INT_MIN}),
                         [](const auto& caseInfo) { return std::string(caseInfo.param.name); });

TEST(PossibleShape, HugeCountsWithoutElementsAreFine) {
    const Dense m(INT_MAX, 0, 1.0);
    EXPECT_EQ(m.rowCount(), INT_MAX);
    EXPECT_TRUE(m.empty());
    const Dense wide(0, INT_MAX, 1.0);
    EXPECT_EQ(wide.colCount(), INT_MAX);
}

TEST(ImpossibleVectorShape, NegativeColumnCountIsRefused) {
    EXPECT_THROW(static_cast<void>(Dense(Vec{1, 2, 3}, -1)), MatrixException);
    EXPECT_THROW(static_cast<void>(Dense(Vec{1, 2, 3}, INT_MIN)), MatrixException);
}

TEST(ImpossibleVectorShape, LengthBeyondTheRangeOfIntIsNoDimension) {
    using qan::matrix_library::toDimension;
    EXPECT_EQ(toDimension(std::size_t{INT_MAX}), INT_MAX);
    EXPECT_THROW(toDimension(std::size_t{INT_MAX} + 1), MatrixException);
    EXPECT_THROW(toDimension(SIZE_MAX), MatrixException);
}

class ImpossibleOrder : public testing::TestWithParam<int> {};

TEST_P(ImpossibleOrder, IsRefusedByThePackedKinds) {
    const int order = GetParam();
    EXPECT_LE(peakBytesOfRefusal([&] { static_cast<void>(Symmetric(order, 1.0)); }), kRoomForAMessage);
    EXPECT_LE(peakBytesOfRefusal([&] { static_cast<void>(Upper(order, 1.0)); }), kRoomForAMessage);
    Symmetric s(2, 3.0);
    Upper u(2, 3.0);
    EXPECT_LE(peakBytesOfRefusal([&] { s.resize(order, 1.0); }), kRoomForAMessage);
    EXPECT_LE(peakBytesOfRefusal([&] { u.resize(order, 1.0); }), kRoomForAMessage);
    EXPECT_EQ(plain(s), plain(Symmetric(2, 3.0)));
    EXPECT_EQ(plain(u), plain(Upper(2, 3.0)));
}

INSTANTIATE_TEST_SUITE_P(Orders, ImpossibleOrder, testing::Values(65536, 92682, 131071, INT_MAX, -1, -2, INT_MIN));

TEST(ImpossibleOrderOfADiagonal, NegativeIsRefused) {
    Diagonal d = diagonal(Vec{1, 2});
    for (const int order : {-1, INT_MIN})
        EXPECT_LE(peakBytesOfRefusal([&] { d.resize(order, 1.0); }), kRoomForAMessage);
    EXPECT_EQ(plain(d), (PlainMatrix{{1, 0}, {0, 2}}));
}

TEST(ImpossibleResult, OfAProductIsRefused) {
    const Dense tall(50000, 1, 1.0);
    const Dense wide(1, 50000, 1.0);
    EXPECT_LE(peakBytesOfRefusal([&] { static_cast<void>(tall * wide); }), kRoomForAMessage);
    EXPECT_LE(peakBytesOfRefusal([&] { static_cast<void>(qan::matrix_library::SlowMatrixMultiply(tall, wide)); }),
              kRoomForAMessage);
    Dense c(2, 2, 3.0);
    EXPECT_LE(peakBytesOfRefusal([&] { qan::matrix_library::multiplyLeftTranspose(wide, wide, c); }), kRoomForAMessage);
    EXPECT_LE(peakBytesOfRefusal([&] { qan::matrix_library::multiplyRightTranspose(tall, tall, c); }),
              kRoomForAMessage);
    EXPECT_EQ(plain(c), plain(Dense(2, 2, 3.0)));
    Dense left = tall;
    const std::ptrdiff_t afterACopy = kRoomForAMessage + 8 * 50000;
    EXPECT_LE(peakBytesOfRefusal([&] { left *= wide; }), afterACopy);
    EXPECT_EQ(left.rowCount(), 50000);
    EXPECT_EQ(left.colCount(), 1);
}

TEST(ImpossibleResult, OfADenseCopyIsRefused) {
    Diagonal d;
    d.resize(50000, 1.0);
    EXPECT_LE(peakBytesOfRefusal([&] { static_cast<void>(Dense(d)); }), kRoomForAMessage);
    Dense m(1, 1, 7.0);
    EXPECT_LE(peakBytesOfRefusal([&] { m = d; }), kRoomForAMessage);
    EXPECT_EQ(plain(m), (PlainMatrix{{7}}));
}

TEST(ImpossibleResult, OfASubmatrixIsRefused) {
    const Dense m(3, 3, 1.0);
    EXPECT_LE(peakBytesOfRefusal([&] { static_cast<void>(m.getSubmatrix(0, 0, -1, 2)); }), kRoomForAMessage);
    EXPECT_LE(peakBytesOfRefusal([&] { static_cast<void>(m.getSubmatrix(0, 0, 2, -1)); }), kRoomForAMessage);
}

TEST(ImpossibleResult, OfAnExpressionIsRefusedOnlyWhenItIsFormed) {
    namespace ex = qan::matrix_library::expressions;
    const auto product = ex::Mult(ex::M_(Dense(50000, 1, 1.0)), ex::M_(Dense(1, 50000, 1.0)));
    EXPECT_EQ(ex::RowCount(product), 50000);
    EXPECT_THROW(static_cast<void>(ex::Evaluate(product)), MatrixException);
    EXPECT_EQ(ex::GetColumn(product, 49999).rowCount(), 50000);
}

}  // namespace
}  // namespace reisti::test
