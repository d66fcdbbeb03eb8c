#pragma once

#include <QLoggingCategory>

// The categories of the component's diagnostic log. A failure that the component passes over
// on purpose (where the user is not told) is written here, never dropped: QT_LOGGING_RULES
// ("etiquon.*.debug=true") shows it.
namespace etq::log {

Q_DECLARE_LOGGING_CATEGORY(card)      // etiquon.card: start-up and handlers that go on
Q_DECLARE_LOGGING_CATEGORY(settings)  // etiquon.settings: values that could not be moved
Q_DECLARE_LOGGING_CATEGORY(import)    // etiquon.import: the host readers and import runs
Q_DECLARE_LOGGING_CATEGORY(print)     // etiquon.print: the print routes

}  // namespace etq::log
