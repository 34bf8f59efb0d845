#include "matrix/matrix_expression.h"

#include <algorithm>
#include <ostream>
#include <utility>

#include "matrix/matrix_products.h"

namespace qan::matrix_library::expressions {

namespace {

void ClearRow(matrix<double>& m, int row) {
    QAN_ALLEGE(row >= 0 && row < m.rowCount());
    std::fill_n(m.data() + std::ptrdiff_t{row} * m.colCount(), m.colCount(), 0.0);
}

void ClearColumn(matrix<double>& m, int column) {
    QAN_ALLEGE(column >= 0 && column < m.colCount());
    for (int i = 0; i < m.rowCount(); ++i) {
        m(i, column) = 0.0;
    }
}

template <typename Kind>
class ValueNode : public ExpressionNode {
  public:
    explicit ValueNode(const Kind& value) : ExpressionNode(value.rowCount(), value.colCount()), value_(value) {}

    matrix<double> MultiplyOnRight(const matrix<double>& m) const override { return value_ * m; }
    matrix<double> MultiplyOnLeft(const matrix<double>& m) const override { return m * value_; }
    matrix<double> Evaluate() const override { return value_; }
    std::ostream& ToString(std::ostream& os, int) const override {
        return os << "< Matrix " << value_.rowCount() << " by " << value_.colCount() << ">";
    }

  private:
    Kind value_;
};

// An operation on two subtrees, with the left one's rows and the right one's columns.
class BinaryNode : public ExpressionNode {
  public:
    BinaryNode(Expression left, Expression right)
        : ExpressionNode(left->rowCount(), right->colCount()), left_(std::move(left)), right_(std::move(right)) {}

  protected:
    const ExpressionNode& left() const { return *left_; }
    const ExpressionNode& right() const { return *right_; }

    std::ostream& write(std::ostream& os, const char* sign, int depth) const {
        os << "( ";
        left_->ToString(os, depth) << sign;
        return right_->ToString(os, depth) << ")";
    }

  private:
    Expression left_;
    Expression right_;
};

class MultNode : public BinaryNode {
  public:
    using BinaryNode::BinaryNode;

    matrix<double> MultiplyOnRight(const matrix<double>& m) const override {
        return left().MultiplyOnRight(right().MultiplyOnRight(m));
    }
    matrix<double> MultiplyOnLeft(const matrix<double>& m) const override {
        return right().MultiplyOnLeft(left().MultiplyOnLeft(m));
    }
    matrix<double> Evaluate() const override { return left().Evaluate() * right().Evaluate(); }
    std::ostream& ToString(std::ostream& os, int depth) const override { return write(os, " * ", depth); }
};

class AddNode : public BinaryNode {
  public:
    using BinaryNode::BinaryNode;

    matrix<double> MultiplyOnRight(const matrix<double>& m) const override {
        const matrix<double> added = right().MultiplyOnRight(m);
        return sum(left().MultiplyOnRight(m), added);
    }
    matrix<double> MultiplyOnLeft(const matrix<double>& m) const override {
        const matrix<double> added = right().MultiplyOnLeft(m);
        return sum(left().MultiplyOnLeft(m), added);
    }
    matrix<double> Evaluate() const override {
        const matrix<double> added = right().Evaluate();
        return sum(left().Evaluate(), added);
    }
    std::ostream& ToString(std::ostream& os, int depth) const override { return write(os, " + ", depth); }

  private:
    static matrix<double> sum(matrix<double> a, const matrix<double>& b) {
        a += b;
        return a;
    }
};

class SubNode : public BinaryNode {
  public:
    using BinaryNode::BinaryNode;

    matrix<double> MultiplyOnRight(const matrix<double>& m) const override {
        return difference(left().MultiplyOnRight(m), right().MultiplyOnRight(m));
    }
    matrix<double> MultiplyOnLeft(const matrix<double>& m) const override {
        return difference(left().MultiplyOnLeft(m), right().MultiplyOnLeft(m));
    }
    matrix<double> Evaluate() const override { return difference(left().Evaluate(), right().Evaluate()); }
    std::ostream& ToString(std::ostream& os, int depth) const override { return write(os, " - ", depth); }

  private:
    static matrix<double> difference(matrix<double> a, const matrix<double>& b) {
        a -= b;
        return a;
    }
};

class TransposeNode : public ExpressionNode {
  public:
    explicit TransposeNode(Expression child)
        : ExpressionNode(child->colCount(), child->rowCount()), child_(std::move(child)) {}

    matrix<double> MultiplyOnRight(const matrix<double>& m) const override {
        return child_->MultiplyOnLeft(m.transpose()).transpose();
    }
    matrix<double> MultiplyOnLeft(const matrix<double>& m) const override {
        return child_->MultiplyOnRight(m.transpose()).transpose();
    }
    matrix<double> Evaluate() const override { return child_->Evaluate().transpose(); }
    std::ostream& ToString(std::ostream& os, int depth) const override {
        os << "( ";
        return child_->ToString(os, depth + 1) << " transpose ) ";
    }

  private:
    Expression child_;
};

class ZeroRowNode : public ExpressionNode {
  public:
    ZeroRowNode(Expression child, int row)
        : ExpressionNode(child->rowCount(), child->colCount()), child_(std::move(child)), row_(row) {}

    matrix<double> MultiplyOnRight(const matrix<double>& m) const override {
        matrix<double> product = child_->MultiplyOnRight(m);
        ClearRow(product, row_);
        return product;
    }
    matrix<double> MultiplyOnLeft(const matrix<double>& m) const override {
        matrix<double> factor(m);
        ClearColumn(factor, row_);
        return child_->MultiplyOnLeft(factor);
    }
    matrix<double> Evaluate() const override {
        matrix<double> value = child_->Evaluate();
        ClearRow(value, row_);
        return value;
    }
    std::ostream& ToString(std::ostream& os, int depth) const override {
        os << "(zero row : " << row_ << " ";
        return child_->ToString(os, depth + 1) << ")";
    }

  private:
    Expression child_;
    int row_;
};

class ZeroColumnNode : public ExpressionNode {
  public:
    ZeroColumnNode(Expression child, int column)
        : ExpressionNode(child->rowCount(), child->colCount()), child_(std::move(child)), column_(column) {}

    matrix<double> MultiplyOnRight(const matrix<double>& m) const override {
        matrix<double> factor(m);
        ClearRow(factor, column_);
        return child_->MultiplyOnRight(factor);
    }
    matrix<double> MultiplyOnLeft(const matrix<double>& m) const override {
        matrix<double> product = child_->MultiplyOnLeft(m);
        ClearColumn(product, column_);
        return product;
    }
    matrix<double> Evaluate() const override {
        matrix<double> value = child_->Evaluate();
        ClearColumn(value, column_);
        return value;
    }
    std::ostream& ToString(std::ostream& os, int depth) const override {
        os << "(zero column : " << column_ << " ";
        return child_->ToString(os, depth + 1) << ")";
    }

  private:
    Expression child_;
    int column_;
};

}  // namespace

Expression M_(const matrix<double>& value) {
    return std::make_shared<ValueNode<matrix<double>>>(value);
}
Expression M_(const Smatrix<double>& value) {
    return std::make_shared<ValueNode<Smatrix<double>>>(value);
}
Expression M_(const Dmatrix<double>& value) {
    return std::make_shared<ValueNode<Dmatrix<double>>>(value);
}
Expression M_(const UTmatrix<double>& value) {
    return std::make_shared<ValueNode<UTmatrix<double>>>(value);
}

Expression Mult(const Expression& a, const Expression& b) {
    return std::make_shared<MultNode>(a, b);
}
Expression operator*(const Expression& a, const Expression& b) {
    return Mult(a, b);
}
Expression Add(const Expression& a, const Expression& b) {
    return std::make_shared<AddNode>(a, b);
}
Expression operator+(const Expression& a, const Expression& b) {
    return Add(a, b);
}
Expression Sub(const Expression& a, const Expression& b) {
    return std::make_shared<SubNode>(a, b);
}
Expression operator-(const Expression& a, const Expression& b) {
    return Sub(a, b);
}
Expression Transpose(const Expression& a) {
    return std::make_shared<TransposeNode>(a);
}
Expression ZeroRow(const Expression& a, int r) {
    return std::make_shared<ZeroRowNode>(a, r);
}
Expression ZeroColumn(const Expression& a, int c) {
    return std::make_shared<ZeroColumnNode>(a, c);
}

matrix<double> Evaluate(const Expression& e) {
    return e->Evaluate();
}
matrix<double> MultiplyOnRight(const Expression& e, const matrix<double>& m) {
    return e->MultiplyOnRight(m);
}
matrix<double> MultiplyOnLeft(const matrix<double>& m, const Expression& e) {
    return e->MultiplyOnLeft(m);
}
int RowCount(const Expression& e) {
    return e->rowCount();
}
int ColumnCount(const Expression& e) {
    return e->colCount();
}

matrix<double> GetRow(const Expression& e, int row) {
    const int M = RowCount(e);
    QAN_ALLEGE(row >= 0 && row < M);
    matrix<double> unit(1, M, 0.0);
    unit(0, row) = 1.0;
    return e->MultiplyOnLeft(unit);
}

matrix<double> GetColumn(const Expression& e, int column) {
    const int N = ColumnCount(e);
    QAN_ALLEGE(column >= 0 && column < N);
    matrix<double> unit(N, 1, 0.0);
    unit(column, 0) = 1.0;
    return e->MultiplyOnRight(unit);
}

std::ostream& operator<<(std::ostream& os, const Expression& e) {
    return e->ToString(os, 0);
}

std::ostream& showMatrix(std::ostream& os, const double& x) {
    return os << "<Value: " << x << ">";
}

}  // namespace qan::matrix_library::expressions
