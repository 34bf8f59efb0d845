#ifndef REISTI_MIXTURE_PROCESS_VARIABLES_H
#define REISTI_MIXTURE_PROCESS_VARIABLES_H

#include <cstdint>

#include "reisti/reisti.h"

namespace reisti {

/// @return des_ErrorAmountsAndProcess when several amounts and process variables are asked for together, else 0
std::int32_t checkAmountsAgainstProcess(const des_MixtureDesign& design);

/// @return des_ErrorProcessFraction when the fraction cannot be run with so many process variables, else 0. With more
/// than 7 variables only crossWithProcessVariables() finds out whether the catalog has the fraction.
std::int32_t checkProcessFraction(const des_MixtureDesign& design);

/// Crosses the first `written` runs with every setting of the process variables: sets the levels of these runs to the
/// first setting and copies them once for each further one. Changes `written` to the number of all of them.
/// @return des_ErrorProcessFraction when the catalog has no such fraction, else 0; on the error nothing is changed
std::int32_t crossWithProcessVariables(des_MixtureDesign& design, std::uint32_t& written);

}  // namespace reisti

#endif
