// Assertions that stay on in release builds: a broken assumption inside the matrix package must not become a wrong
// design.
#ifndef REISTI_MATRIX_ALLEGE_H
#define REISTI_MATRIX_ALLEGE_H

#include <stdexcept>
#include <string>

namespace qan::allege {

// A failed assertion; the message quotes the test and where it stands.
class AllegeException : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

// Throws AllegeException with "assertion failed: (expression) file: line".
[[noreturn]] void AllegeFailure(const std::string& expression, const std::string& file, int line);

}  // namespace qan::allege

// The message quotes the test as it is written here.
#define QAN_ALLEGE(test) QAN_ALLEGE_AS(test, #test)

// For tests whose quoted text callers know in a form that the formatter would not leave alone. Keep both on one line:
// compilers differ in the line that they give to a longer call.
#define QAN_ALLEGE_AS(test, text) \
    ((test) ? static_cast<void>(0) : ::qan::allege::AllegeFailure((text), __FILE__, __LINE__))

#endif
