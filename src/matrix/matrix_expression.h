// Trees of matrix operations that are evaluated on demand, and can be multiplied by a matrix without being evaluated.
//
// Nodes never change and are shared: one subtree may stand in several trees. Nothing is checked while a tree is built;
// dimensions that do not fit, and rows and columns that do not exist, surface when a value is asked for.
#ifndef REISTI_MATRIX_MATRIX_EXPRESSION_H
#define REISTI_MATRIX_MATRIX_EXPRESSION_H

#include <iosfwd>
#include <memory>

#include "matrix/matrix_new.h"

namespace qan::matrix_library::expressions {

class ExpressionNode {
  public:
    ExpressionNode(int rows, int columns) : rows_(rows), columns_(columns) {}
    ExpressionNode(const ExpressionNode&) = delete;
    ExpressionNode& operator=(const ExpressionNode&) = delete;
    virtual ~ExpressionNode() = default;

    virtual matrix<double> MultiplyOnRight(const matrix<double>& m) const = 0;  // value * m
    virtual matrix<double> MultiplyOnLeft(const matrix<double>& m) const = 0;   // m * value
    virtual matrix<double> Evaluate() const = 0;
    virtual std::ostream& ToString(std::ostream& os, int depth) const = 0;

    // Of the value.
    int rowCount() const { return rows_; }
    int colCount() const { return columns_; }

  private:
    int rows_;
    int columns_;
};

using Expression = std::shared_ptr<const ExpressionNode>;

// Leaves, which hold a copy of the matrix.
Expression M_(const matrix<double>& value);
Expression M_(const Smatrix<double>& value);
Expression M_(const Dmatrix<double>& value);
Expression M_(const UTmatrix<double>& value);

Expression Mult(const Expression& a, const Expression& b);
Expression operator*(const Expression& a, const Expression& b);
Expression Add(const Expression& a, const Expression& b);
Expression operator+(const Expression& a, const Expression& b);
Expression Sub(const Expression& a, const Expression& b);
Expression operator-(const Expression& a, const Expression& b);
Expression Transpose(const Expression& a);
// a with row r or column c set to zero.
Expression ZeroRow(const Expression& a, int r);
Expression ZeroColumn(const Expression& a, int c);

matrix<double> Evaluate(const Expression& e);
matrix<double> MultiplyOnRight(const Expression& e, const matrix<double>& m);  // e * m
matrix<double> MultiplyOnLeft(const matrix<double>& m, const Expression& e);   // m * e
int RowCount(const Expression& e);
int ColumnCount(const Expression& e);

// One row or column of the value, which is not formed for it.
matrix<double> GetRow(const Expression& e, int row);
matrix<double> GetColumn(const Expression& e, int column);

// For debugging.
std::ostream& operator<<(std::ostream& os, const Expression& e);
std::ostream& showMatrix(std::ostream& os, const double& x);

}  // namespace qan::matrix_library::expressions

#endif
