#ifndef REISTI_CLI_DESIGN_TABLE_H
#define REISTI_CLI_DESIGN_TABLE_H

#include <cstddef>
#include <cstdint>
#include <functional>
#include <nlohmann/json_fwd.hpp>
#include <ostream>
#include <string>
#include <variant>
#include <vector>

namespace cli {

/// One value of a design: nothing yet (a response), a count or code, a real number, a word.
using Cell = std::variant<std::monostate, std::int64_t, double, std::string>;

struct Column {
    std::string name;
    std::string unit;
    /// Leads every panel of a table that is too wide for one.
    bool isKey = false;
    std::function<Cell(std::size_t)> cell;
};

/// A finished design as it is shown. Cells are made as they are asked for: a design of a million runs is never held as
/// text.
struct DesignTable {
    std::vector<Column> columns;
    /// Index of the run in each row, in the order of the rows.
    std::vector<std::size_t> rows;
};

/// Adds a column; two columns of one name could not be told apart in the output, so that is a UsageError.
void addColumn(DesignTable& table, Column column);

/// Aligned columns for people, in panels of at most 80 characters.
void writeText(std::ostream& out, const DesignTable& table, char decimalMark);

/// RFC 4180: a header line, CRLF line ends, quotes where a field needs them.
void writeCsv(std::ostream& out, const DesignTable& table, char decimalMark);

/// One object: the members of `head`, then "runs", an array with one object for each row.
void writeJson(std::ostream& out, const DesignTable& table, const nlohmann::ordered_json& head);

}  // namespace cli

#endif
