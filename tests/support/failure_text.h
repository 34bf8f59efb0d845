#ifndef REISTI_TESTS_SUPPORT_FAILURE_TEXT_H
#define REISTI_TESTS_SUPPORT_FAILURE_TEXT_H

#include <exception>
#include <string>
#include <typeinfo>

namespace reisti::test {

/// The message of the exception that `action` throws. An exception of another type, even of one derived from
/// `Exception`, and none at all give a text that equals no message.
template <class Exception, class Action>
std::string messageOf(Action&& action) {
    try {
        action();
    } catch (const Exception& caught) {
        if (typeid(caught) == typeid(Exception)) return caught.what();
        return std::string("[derived type] ") + caught.what();
    } catch (const std::exception& caught) {
        return std::string("[other type] ") + typeid(caught).name() + ": " + caught.what();
    }
    return "[nothing was thrown]";
}

}  // namespace reisti::test

#endif
