#include "platform/log.h"

namespace etq::log {

Q_LOGGING_CATEGORY(card, "etiquon.card", QtInfoMsg)
Q_LOGGING_CATEGORY(settings, "etiquon.settings", QtInfoMsg)
Q_LOGGING_CATEGORY(import, "etiquon.import", QtInfoMsg)
Q_LOGGING_CATEGORY(print, "etiquon.print", QtInfoMsg)

}  // namespace etq::log
