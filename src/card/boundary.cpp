#include "card/boundary.h"

#include "platform/context.h"
#include "platform/failure.h"
#include "platform/log.h"
#include "platform/messages.h"

namespace etq {

void reportFailure(Context& context, const std::exception& failure, const QString& title) {
    if (isQuietInWindow(failure)) {
        qCInfo(log::card) << "passed over:" << describe(failure);
        return;
    }
    const auto* ours = dynamic_cast<const Failure*>(&failure);
    const QString shownTitle = ours && !ours->title().isEmpty() ? ours->title() : title;
    showCritical(context.messages(), describe(failure), shownTitle);
}

}  // namespace etq
