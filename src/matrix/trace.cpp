#include "matrix/trace.h"

#include <fstream>
#include <mutex>

namespace qan {

void matrix_trace(const std::string& text, int value) {
    static std::ofstream stream("trace.txt", std::ios::trunc);
    static std::mutex oneLineAtATime;
    // Built first, so that a locale with digit grouping cannot change the number; flushed, so that a crash keeps the
    // line.
    const std::string line = text + " : " + std::to_string(value) + '\n';
    const std::lock_guard lock(oneLineAtATime);
    stream << line << std::flush;
}

}  // namespace qan
