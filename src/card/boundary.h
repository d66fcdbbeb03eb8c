#pragma once

#include <QString>
#include <exception>

namespace etq {

class Context;

// Where the window tells a failure of the logic: a critical message box titled `title` (or the
// failure's own title, for the few that have always had one) with the failure's description.
// A failure the window has always passed over without a word is written to the log instead.
void reportFailure(Context& context, const std::exception& failure, const QString& title);

// Runs `work` at a boundary: true when it ran to its end, false after a failure was reported
// as above.
template <class Work>
bool reportFailures(Context& context, const QString& title, Work&& work) {
    try {
        work();
        return true;
    } catch (const std::exception& e) {
        reportFailure(context, e, title);
        return false;
    }
}

}  // namespace etq
