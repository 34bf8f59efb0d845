#include "matrix/trace.h"

#include <fstream>

namespace qan {

void matrix_trace(const std::string& text, int value) {
    static std::ofstream stream("trace.txt", std::ios::trunc);
    // Built first, so that a locale with digit grouping cannot change the number; flushed, so that a crash keeps the
    // line.
    stream << text + " : " + std::to_string(value) + '\n' << std::flush;
}

}  // namespace qan
