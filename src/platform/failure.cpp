#include "platform/failure.h"

namespace etq {

Failure::Failure(QString description)
    : description_(std::move(description)), utf8_(description_.toUtf8()) {}

QString describe(const std::exception& failure) {
    if (const auto* ours = dynamic_cast<const Failure*>(&failure)) return ours->description();
    // The engine's errors, like every other exception here, carry their text as UTF-8.
    return QString::fromUtf8(failure.what());
}

bool isQuietInWindow(const std::exception& failure) {
    const auto* ours = dynamic_cast<const Failure*>(&failure);
    return ours && ours->quietInWindow();
}

}  // namespace etq
