#include <iostream>
#include <sstream>

#include "unit/matrix/matrix_kinds.h"

namespace reisti::test {
namespace {

using qan::matrix_library::operator<<;

/// Redirects the standard output stream for the life of the object.
class CapturedStandardOutput {
  public:
    CapturedStandardOutput() : old_(std::cout.rdbuf(text_.rdbuf())) {}
    ~CapturedStandardOutput() { std::cout.rdbuf(old_); }
    CapturedStandardOutput(const CapturedStandardOutput&) = delete;
    CapturedStandardOutput& operator=(const CapturedStandardOutput&) = delete;
    std::string text() const { return text_.str(); }

  private:
    std::ostringstream text_;
    std::streambuf* old_;
};

TEST(VectorStreaming, ElementsGoToStandardOutputAndBracketsToTheStream) {
    std::ostringstream os;
    const CapturedStandardOutput output;
    os << Vec{1, 2.5};
    EXPECT_EQ(os.str(), "[]");
    EXPECT_EQ(output.text(), "1, 2.5, ");
}

TEST(VectorStreaming, EmptyVectorWritesOnlyBrackets) {
    std::ostringstream os;
    const CapturedStandardOutput output;
    os << Vec{};
    EXPECT_EQ(os.str(), "[]");
    EXPECT_EQ(output.text(), "");
}

TEST(VectorStreaming, ToStandardOutputItselfReadsInOrder) {
    const CapturedStandardOutput output;
    std::cout << Vec{1, -2, 1e300};
    EXPECT_EQ(output.text(), "[1, -2, 1e+300, ]");
}

TEST(VectorStreaming, ReturnsTheGivenStream) {
    std::ostringstream os;
    const CapturedStandardOutput output;
    std::ostream& returned = (os << Vec{7});
    EXPECT_EQ(&returned, &os);
    os << Vec{} << "tail";
    EXPECT_EQ(os.str(), "[][]tail");
}

}  // namespace
}  // namespace reisti::test
