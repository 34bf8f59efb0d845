// Diagnostic trace of the matrix package.
#ifndef REISTI_MATRIX_TRACE_H
#define REISTI_MATRIX_TRACE_H

#include <string>

namespace qan {

// Appends "text : value" as a line to trace.txt in the current directory, which the first call of the process empties.
// A file that cannot be written is no error: the lines are lost. Safe from several threads at once; lines stay whole.
void matrix_trace(const std::string& text, int value);

}  // namespace qan

#endif
