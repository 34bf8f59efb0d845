#include <climits>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

using qan::matrix_library::DotProduct;
using qan::matrix_library::KTimesColumn;
using qan::matrix_library::KTimesColumnPlusColumn;
using qan::matrix_library::KTimesColumnPlusVector;

const char* const kTooMany = "matrix::number of products greater than dimension";

Dense sample() {
    return dense({{1, 2, 3}, {4, 5, 6}, {7, 8, 9}, {10, 11, 12}});
}

TEST(DotProduct, OfTwoColumnsSumsTheFirstRows) {
    const Dense m = sample();
    EXPECT_EQ(DotProduct(m, 0, 1, 1), 2.0);
    EXPECT_EQ(DotProduct(m, 0, 1, 3), 2.0 + 20.0 + 56.0);
    EXPECT_EQ(DotProduct(m, 2, 2, 4), 9.0 + 36.0 + 81.0 + 144.0);
}

TEST(DotProduct, OfAColumnAndAVectorSumsTheFirstRows) {
    const Dense m = sample();
    const Vec v{1, 10, 100, 1000};
    EXPECT_EQ(DotProduct(m, 1, v, 2), 2.0 + 50.0);
    EXPECT_EQ(DotProduct(m, 1, v, 4), 2.0 + 50.0 + 800.0 + 11000.0);
}

TEST(DotProduct, OfNoRowsIsZero) {
    const Dense m = sample();
    for (const int count : {0, -1, INT_MIN}) {
        EXPECT_EQ(DotProduct(m, 0, 1, count), 0.0);
        EXPECT_EQ(DotProduct(m, 0, Vec{}, count), 0.0);
    }
}

TEST(DotProduct, OfMoreRowsThanThereAreIsRefused) {
    const Dense m = sample();
    const Vec v{1, 2, 3, 4, 5};
    for (const int count : {5, INT_MAX}) {
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(DotProduct(m, 0, 1, count)); }), kTooMany);
        EXPECT_EQ(messageOf<MatrixException>([&] { static_cast<void>(DotProduct(m, 0, v, count)); }), kTooMany);
    }
}

TEST(DotProduct, StaysWithinTheRoundingOfItsTerms) {
    UniformNumbers random(71);
    for (int trial = 0; trial < scaled(200); ++trial) {
        const int rows = random.integer(1, 60);
        const PlainMatrix source = random.matrix(rows, 2);
        long double exact = 0.0L;
        long double magnitudes = 0.0L;
        for (int i = 0; i < rows; ++i) {
            exact += static_cast<long double>(source(i, 0)) * source(i, 1);
            magnitudes += std::fabs(static_cast<long double>(source(i, 0)) * source(i, 1));
        }
        const double bound = static_cast<double>(magnitudes) * (rows + 1) * kEpsilon;
        EXPECT_NEAR(DotProduct(dense(source), 0, 1, rows), static_cast<double>(exact), bound);
        EXPECT_NEAR(DotProduct(dense(source), 0, plainColumn(source, 1).cells, rows), static_cast<double>(exact),
                    bound);
    }
}

TEST(KTimesColumnPlusVector, AddsToTheFirstElements) {
    Dense m = sample();
    Vec v{100, 200, 300, 400};
    KTimesColumnPlusVector(m, 2.0, 1, v, 3);
    EXPECT_EQ(v, (Vec{104, 210, 316, 400}));
    EXPECT_EQ(plain(m), plain(sample()));
}

TEST(KTimesColumnPlusVector, OfNoRowsChangesNothing) {
    Dense m = sample();
    Upper u(3, 1.0);
    Vec v{100, 200, 300, 400};
    for (const int count : {0, -1}) {
        KTimesColumnPlusVector(m, 2.0, 1, v, count);
        KTimesColumnPlusVector(u, 2.0, 1, v, count);
    }
    EXPECT_EQ(v, (Vec{100, 200, 300, 400}));
}

TEST(KTimesColumnPlusVector, OfMoreRowsThanThereAreIsRefusedBeforeAnyWrite) {
    Dense m = sample();
    Upper u(3, 1.0);
    Vec v{1, 2, 3, 4, 5};
    EXPECT_EQ(messageOf<MatrixException>([&] { KTimesColumnPlusVector(m, 2.0, 1, v, 5); }), kTooMany);
    EXPECT_EQ(messageOf<MatrixException>([&] { KTimesColumnPlusVector(u, 2.0, 1, v, 4); }), kTooMany);
    EXPECT_EQ(v, (Vec{1, 2, 3, 4, 5}));
}

TEST(KTimesColumnPlusVector, OfAnUpperReadsItsColumnWithZerosBelowTheDiagonal) {
    Upper u(3, Vec{1, 2, 3, 4, 5, 6});
    Vec v{10, 20, 30};
    KTimesColumnPlusVector(u, 2.0, 1, v, 3);
    EXPECT_EQ(v, (Vec{14, 28, 30}));
    KTimesColumnPlusVector(u, 1.0, 2, v, 2);
    EXPECT_EQ(v, (Vec{17, 33, 30}));
    KTimesColumnPlusVector(u, 1.0, 0, v, 3);
    EXPECT_EQ(v, (Vec{18, 33, 30}));
}

const PlainMatrix kSymmetricSample{{1, 2, 4}, {2, 3, 5}, {4, 5, 6}};

TEST(KTimesColumn, ScalesTheColumnAndItsMirrorImageOnce) {
    Symmetric s = symmetric(kSymmetricSample);
    KTimesColumn(s, 10.0, 1, 3);
    EXPECT_EQ(plain(s), (PlainMatrix{{1, 20, 4}, {20, 30, 50}, {4, 50, 6}}));
}

TEST(KTimesColumn, StopsAtTheCount) {
    Symmetric s = symmetric(kSymmetricSample);
    KTimesColumn(s, 10.0, 2, 2);
    EXPECT_EQ(plain(s), (PlainMatrix{{1, 2, 40}, {2, 3, 50}, {40, 50, 6}}));
    KTimesColumn(s, 10.0, 2, 0);
    KTimesColumn(s, 10.0, 2, -3);
    EXPECT_EQ(plain(s), (PlainMatrix{{1, 2, 40}, {2, 3, 50}, {40, 50, 6}}));
}

TEST(KTimesColumn, OfMoreRowsThanThereAreIsRefused) {
    Symmetric s = symmetric(kSymmetricSample);
    EXPECT_EQ(messageOf<MatrixException>([&] { KTimesColumn(s, 10.0, 0, 4); }), kTooMany);
    EXPECT_EQ(messageOf<MatrixException>([&] { KTimesColumn(s, 10.0, 0, INT_MAX); }), kTooMany);
    EXPECT_EQ(plain(s), kSymmetricSample);
}

TEST(KTimesColumnPlusColumn, AddsAMultipleOfOneColumnToAnother) {
    Symmetric s = symmetric(kSymmetricSample);
    // The diagonal of the target is read through the target's own mirrored element, updated just before.
    KTimesColumnPlusColumn(s, 10.0, 0, 2, 2);
    EXPECT_EQ(plain(s), (PlainMatrix{{1, 2, 14}, {2, 3, 25}, {14, 25, 6}}));
    KTimesColumnPlusColumn(s, 1.0, 2, 0, 1);
    EXPECT_EQ(s(0, 0), 15.0);
}

TEST(KTimesColumnPlusColumn, ReadsWhatItHasJustWrittenWhereTheColumnsCross) {
    Symmetric s = symmetric(kSymmetricSample);
    KTimesColumnPlusColumn(s, 10.0, 0, 2, 3);
    // s(0,2) = 4 + 10 s(0,0) = 14, s(1,2) = 5 + 10 s(1,0) = 25, s(2,2) = 6 + 10 s(2,0) with s(2,0) = 14 already.
    EXPECT_EQ(plain(s), (PlainMatrix{{1, 2, 14}, {2, 3, 25}, {14, 25, 146}}));
}

TEST(KTimesColumnPlusColumn, OfMoreRowsThanThereAreIsRefused) {
    Symmetric s = symmetric(kSymmetricSample);
    EXPECT_EQ(messageOf<MatrixException>([&] { KTimesColumnPlusColumn(s, 10.0, 0, 1, 4); }), kTooMany);
    EXPECT_EQ(plain(s), kSymmetricSample);
    KTimesColumnPlusColumn(s, 10.0, 0, 1, 0);
    EXPECT_EQ(plain(s), kSymmetricSample);
}

}  // namespace
}  // namespace reisti::test
