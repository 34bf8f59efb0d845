#ifndef REISTI_TESTS_SUPPORT_PLAIN_PROCESS_H
#define REISTI_TESTS_SUPPORT_PLAIN_PROCESS_H

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

/// Two-level settings of process variables, column by column.
namespace reisti::test {

/// Rows of levels -1 and +1, first column fastest, then the added columns: products of base columns times a sign each.
std::vector<std::vector<std::int32_t>> plainTwoLevelRuns(std::uint32_t numBaseFactors,
                                                         const std::vector<std::string>& generators,
                                                         const std::vector<std::int32_t>& signs);

/// The base factor that a letter of a generator names, 0-based: A, B, .. H, J, .. (there is no I).
std::size_t factorOfLetter(char letter);

/// Whether the fraction is one of those offered for so many process variables.
bool plainFractionAllowed(std::uint32_t numProcessVariables, std::uint32_t fraction);

/// The sign of added column j (0-based) in fraction number `fractionIndex` of `fraction`.
std::int32_t plainColumnSign(std::uint32_t j, std::uint32_t fraction, std::uint32_t fractionIndex);

/// The settings of the process variables in order; nothing when there is no such fraction.
std::optional<std::vector<std::vector<std::int32_t>>> plainProcessSettings(std::uint32_t numProcessVariables,
                                                                           std::uint32_t fraction,
                                                                           std::uint32_t fractionIndex);

}  // namespace reisti::test

#endif
