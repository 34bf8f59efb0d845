#include "constraint.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <fmt/format.h>
#include <system_error>

#include "numbers.h"
#include "usage_error.h"

namespace cli {

namespace {

struct LinearForm {
    std::vector<double> coefficients;
    double constant = 0;

    bool isNumber() const {
        return std::all_of(coefficients.begin(), coefficients.end(), [](double c) { return c == 0; });
    }
};

enum class Relation { kAtMost, kAtLeast };

bool isBlank(char c) {
    return c == ' ' || c == '\t';
}
bool isNameCharacter(char c) {
    const auto u = static_cast<unsigned char>(c);
    return (u >= '0' && u <= '9') || (u >= 'A' && u <= 'Z') || (u >= 'a' && u <= 'z') || u == '_' || u >= 0x80;
}
bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

class Parser {
  public:
    Parser(std::string_view text, const std::vector<std::string>& names) : text_(text), names_(names) {}

    Constraint parse() {
        std::vector<LinearForm> sides{parseSum()};
        std::vector<Relation> relations;
        while (!atEnd()) {
            if (relations.size() == 2) fail("more than two relations");
            relations.push_back(parseRelation());
            sides.push_back(parseSum());
        }
        if (relations.empty()) fail("there is no <= or >= in it");
        Constraint constraint = relations.size() == 1 ? oneSided(sides, relations[0]) : twoSided(sides, relations);
        constraint.text = text_;
        check(constraint);
        return constraint;
    }

  private:
    [[noreturn]] void fail(const std::string& problem) const {
        throw UsageError(fmt::format("--constraint \"{}\"", text_), problem);
    }

    void skipBlanks() {
        while (position_ < text_.size() && isBlank(text_[position_]))
            ++position_;
    }
    bool atEnd() {
        skipBlanks();
        return position_ == text_.size();
    }
    /// The next character that is not blank; 0 at the end.
    char peek() { return atEnd() ? '\0' : text_[position_]; }
    std::string_view rest() const { return text_.substr(position_); }

    Relation parseRelation() {
        const std::string_view operatorText = rest().substr(0, 2);
        if (operatorText == "<=" || operatorText == ">=" || operatorText == "=>") {
            position_ += 2;
            return operatorText == "<=" ? Relation::kAtMost : Relation::kAtLeast;
        }
        const char c = peek();
        if (c == '=') {
            fail("an equation leaves no region to work in; express one component through the others and leave it out");
        }
        if (c == '<' || c == '>') fail(fmt::format("use {}= instead of {}", c, c));
        fail(fmt::format("unexpected \"{}\"", rest()));
    }

    LinearForm parseSum() {
        LinearForm sum{std::vector<double>(names_.size(), 0.0)};
        bool isFirst = true;
        for (;;) {
            const char c = peek();
            double sign = 1;
            if (c == '+' || c == '-') {
                sign = c == '-' ? -1 : 1;
                ++position_;
            } else if (!isFirst) {
                return sum;
            }
            addProduct(sum, sign);
            isFirst = false;
        }
    }

    /// A product of numbers and at most one name.
    void addProduct(LinearForm& sum, double factor) {
        std::optional<std::size_t> name;
        for (;;) {
            const char c = peek();
            if (isDigit(c) || c == '.') {
                factor *= parseNumberHere();
            } else {
                const std::size_t index = parseName();
                if (name) fail("two components are multiplied; only linear constraints are known");
                name = index;
            }
            if (peek() != '*') break;
            ++position_;
        }
        (name ? sum.coefficients[*name] : sum.constant) += factor;
    }

    double parseNumberHere() {
        double value = 0;
        const auto [end, error] = std::from_chars(text_.data() + position_, text_.data() + text_.size(), value);
        if (error != std::errc{}) fail(fmt::format("\"{}\" does not begin with a number", rest()));
        position_ = static_cast<std::size_t>(end - text_.data());
        if (position_ < text_.size() && isNameCharacter(text_[position_])) {
            fail(fmt::format("a * is missing before \"{}\"", rest()));
        }
        return value;
    }

    /// The longest component name that stands here, so that names may hold blanks and signs.
    std::size_t parseName() {
        std::optional<std::size_t> best;
        for (std::size_t i = 0; i < names_.size(); ++i) {
            const std::string& name = names_[i];
            if (rest().substr(0, name.size()) != name) continue;
            const std::size_t end = position_ + name.size();
            if (isNameCharacter(name.back()) && end < text_.size() && isNameCharacter(text_[end])) continue;
            if (!best || name.size() > names_[*best].size()) best = i;
        }
        if (!best) failAtName();
        position_ += names_[*best].size();
        return *best;
    }

    [[noreturn]] void failAtName() const {
        if (rest().empty()) fail("a number or a component is missing at the end");
        std::size_t length = 0;
        while (length < rest().size() && isNameCharacter(rest()[length]))
            ++length;
        if (length == 0) fail(fmt::format("expected a number or a component at \"{}\"", rest()));
        fail(fmt::format("\"{}\" is not a component", rest().substr(0, length)));
    }

    /// Brings every component to one side, to that of the first one, and every number to the other.
    static Constraint oneSided(const std::vector<LinearForm>& sides, Relation relation) {
        const bool isSwapped = sides[0].isNumber();
        const LinearForm& left = isSwapped ? sides[1] : sides[0];
        const LinearForm& right = isSwapped ? sides[0] : sides[1];
        Constraint constraint;
        constraint.coefficients = left.coefficients;
        for (std::size_t j = 0; j < right.coefficients.size(); ++j) {
            constraint.coefficients[j] -= right.coefficients[j];
        }
        const double limit = right.constant - left.constant;
        const bool isUpper = (relation == Relation::kAtMost) != isSwapped;
        (isUpper ? constraint.upper : constraint.lower) = limit;
        return constraint;
    }

    Constraint twoSided(const std::vector<LinearForm>& sides, const std::vector<Relation>& relations) const {
        if (relations[0] != relations[1]) fail("the two relations point in different directions");
        if (!sides[0].isNumber() || !sides[2].isNumber()) {
            fail("the outer sides of a two-sided constraint have to be numbers");
        }
        Constraint constraint;
        constraint.coefficients = sides[1].coefficients;
        const bool isAscending = relations[0] == Relation::kAtMost;
        constraint.lower = sides[isAscending ? 0 : 2].constant - sides[1].constant;
        constraint.upper = sides[isAscending ? 2 : 0].constant - sides[1].constant;
        return constraint;
    }

    void check(const Constraint& constraint) const {
        const std::vector<double>& coefficients = constraint.coefficients;
        if (std::all_of(coefficients.begin(), coefficients.end(), [](double c) { return c == 0; })) {
            fail("no component is left in it");
        }
        const auto isFinite = [](double value) { return std::isfinite(value); };
        if (!std::all_of(coefficients.begin(), coefficients.end(), isFinite) ||
            !isFinite(constraint.lower.value_or(0)) || !isFinite(constraint.upper.value_or(0))) {
            fail("a number is too large");
        }
        if (constraint.lower && constraint.upper && *constraint.lower > *constraint.upper) {
            fail("the lower side is above the upper one");
        }
    }

    std::string_view text_;
    const std::vector<std::string>& names_;
    std::size_t position_ = 0;
};

}  // namespace

Constraint parseConstraint(std::string_view text, const std::vector<std::string>& names) {
    return Parser(text, names).parse();
}

}  // namespace cli
