#include "matrix/allege.h"

namespace qan::allege {

void AllegeFailure(const std::string& expression, const std::string& file, int line) {
    throw AllegeException("assertion failed: (" + expression + ") " + file + ": " + std::to_string(line));
}

}  // namespace qan::allege
