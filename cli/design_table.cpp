#include "design_table.h"

#include <algorithm>
#include <fmt/format.h>
#include <nlohmann/json.hpp>
#include <string_view>

#include "numbers.h"
#include "usage_error.h"

namespace cli {

namespace {

constexpr std::size_t kPageWidth = 80;
constexpr std::string_view kGap = "  ";

template <class... Visitors>
struct Overloaded : Visitors... {
    using Visitors::operator()...;
};
template <class... Visitors>
Overloaded(Visitors...) -> Overloaded<Visitors...>;

std::string cellText(const Cell& cell, char decimalMark, std::string (*formatReal)(double, char)) {
    return std::visit(Overloaded{[](std::monostate) { return std::string(); },
                                 [](std::int64_t value) { return fmt::format("{}", value); },
                                 [&](double value) { return formatReal(value, decimalMark); },
                                 [](const std::string& word) { return word; }},
                      cell);
}

/// Characters that a terminal shows: UTF-8 continuation bytes take no place of their own.
std::size_t displayWidth(std::string_view text) {
    return static_cast<std::size_t>(
        std::count_if(text.begin(), text.end(), [](char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; }));
}

struct ShownColumn {
    const Column* column;
    std::size_t width;
    bool isText;
};

ShownColumn measure(const Column& column, const DesignTable& table, char decimalMark) {
    ShownColumn shown{&column, std::max(displayWidth(column.name), displayWidth(column.unit)), false};
    for (const std::size_t run : table.rows) {
        const Cell cell = column.cell(run);
        shown.isText = shown.isText || std::holds_alternative<std::string>(cell);
        shown.width = std::max(shown.width, displayWidth(cellText(cell, decimalMark, formatShort)));
    }
    return shown;
}

/// Breaks the columns into panels that fit the page, each led by the key columns.
std::vector<std::vector<ShownColumn>> layOutPanels(const std::vector<ShownColumn>& columns) {
    std::vector<ShownColumn> keys;
    std::copy_if(columns.begin(), columns.end(), std::back_inserter(keys),
                 [](const ShownColumn& shown) { return shown.column->isKey; });
    const auto widthOf = [](const std::vector<ShownColumn>& panel) {
        std::size_t width = 0;
        for (const ShownColumn& shown : panel)
            width += shown.width + kGap.size();
        return width;
    };
    std::vector<std::vector<ShownColumn>> panels{keys};
    for (const ShownColumn& shown : columns) {
        if (shown.column->isKey) continue;
        const bool fits = widthOf(panels.back()) + shown.width <= kPageWidth;
        if (!fits && panels.back().size() > keys.size()) panels.push_back(keys);
        panels.back().push_back(shown);
    }
    return panels;
}

void writeField(std::string& line, const ShownColumn& shown, const std::string& text) {
    if (!line.empty()) line += kGap;
    const std::string padding(shown.width - displayWidth(text), ' ');
    line += shown.isText ? text + padding : padding + text;
}

void endLine(std::ostream& out, std::string& line) {
    line.erase(line.find_last_not_of(' ') + 1);
    out << line << '\n';
    line.clear();
}

void writePanel(std::ostream& out, const std::vector<ShownColumn>& panel, const DesignTable& table, char decimalMark) {
    std::string line;
    for (const ShownColumn& shown : panel)
        writeField(line, shown, shown.column->name);
    endLine(out, line);
    if (std::any_of(panel.begin(), panel.end(), [](const ShownColumn& s) { return !s.column->unit.empty(); })) {
        for (const ShownColumn& shown : panel)
            writeField(line, shown, shown.column->unit);
        endLine(out, line);
    }
    for (const std::size_t run : table.rows) {
        for (const ShownColumn& shown : panel) {
            writeField(line, shown, cellText(shown.column->cell(run), decimalMark, formatShort));
        }
        endLine(out, line);
    }
}

std::string csvField(const std::string& text) {
    if (text.find_first_of(",\"\r\n") == std::string::npos) return text;
    std::string field = "\"";
    for (const char c : text) {
        if (c == '"') field += '"';
        field += c;
    }
    return field + '"';
}

nlohmann::ordered_json jsonValue(const Cell& cell) {
    return std::visit(Overloaded{[](std::monostate) { return nlohmann::ordered_json(nullptr); },
                                 [](const auto& value) { return nlohmann::ordered_json(value); }},
                      cell);
}

/// Names typed on the command line may hold any bytes; JSON text is UTF-8, so broken ones are replaced.
std::string dumped(const nlohmann::ordered_json& value, int indent) {
    return value.dump(indent, ' ', false, nlohmann::ordered_json::error_handler_t::replace);
}

}  // namespace

void addColumn(DesignTable& table, Column column) {
    const auto same = [&column](const Column& other) { return other.name == column.name; };
    if (std::any_of(table.columns.begin(), table.columns.end(), same)) {
        throw UsageError(fmt::format("\"{}\"", column.name), "two columns of the design would have this name");
    }
    table.columns.push_back(std::move(column));
}

void writeText(std::ostream& out, const DesignTable& table, char decimalMark) {
    std::vector<ShownColumn> columns;
    columns.reserve(table.columns.size());
    for (const Column& column : table.columns)
        columns.push_back(measure(column, table, decimalMark));
    bool isFirst = true;
    for (const std::vector<ShownColumn>& panel : layOutPanels(columns)) {
        if (!isFirst) out << '\n';
        isFirst = false;
        writePanel(out, panel, table, decimalMark);
    }
}

void writeCsv(std::ostream& out, const DesignTable& table, char decimalMark) {
    const auto writeLine = [&](auto&& textOf) {
        std::string line;
        for (const Column& column : table.columns) {
            if (&column != &table.columns.front()) line += ',';
            line += csvField(textOf(column));
        }
        out << line << "\r\n";
    };
    writeLine([](const Column& column) { return column.name; });
    for (const std::size_t run : table.rows) {
        writeLine([&](const Column& column) { return cellText(column.cell(run), decimalMark, formatExact); });
    }
}

void writeJson(std::ostream& out, const DesignTable& table, const nlohmann::ordered_json& head) {
    std::string opening = dumped(head, 2);
    opening.resize(opening.rfind("\n}"));
    out << opening << ",\n  \"runs\": [";
    bool isFirst = true;
    for (const std::size_t run : table.rows) {
        nlohmann::ordered_json object = nlohmann::ordered_json::object();
        for (const Column& column : table.columns)
            object[column.name] = jsonValue(column.cell(run));
        out << (isFirst ? "\n    " : ",\n    ") << dumped(object, -1);
        isFirst = false;
    }
    out << (isFirst ? "]\n}\n" : "\n  ]\n}\n");
}

}  // namespace cli
