#include "platform/messages.h"

#include <QTextStream>

namespace etq {

namespace {

const char* iconWord(MsgIcon icon) {
    switch (icon) {
        case MsgIcon::Critical:
            return "error";
        case MsgIcon::Question:
            return "question";
        case MsgIcon::Exclamation:
            return "warning";
        case MsgIcon::Information:
            return "note";
        case MsgIcon::None:
            break;
    }
    return "message";
}
}  // namespace

MsgAnswer StderrMessageSink::show(const Message& message) {
    QTextStream err(stderr);
    err << iconWord(message.icon) << ": ";
    if (!message.title.isEmpty()) err << message.title << ": ";
    err << message.text;
    if (message.buttons == MsgButtons::YesNo)
        err << " [" << (answer_ == MsgAnswer::No ? "No" : "Yes") << "]";
    err << Qt::endl;
    if (message.buttons == MsgButtons::YesNo)
        return answer_ == MsgAnswer::No ? MsgAnswer::No : MsgAnswer::Yes;
    return MsgAnswer::Ok;
}

void showCritical(MessageSink& sink, const QString& text, const QString& title) {
    sink.show({text, title, MsgIcon::Critical, MsgButtons::Ok});
}

MsgAnswer askYesNo(MessageSink& sink, const QString& text, const QString& title, MsgIcon icon) {
    return sink.show({text, title, icon, MsgButtons::YesNo});
}

}  // namespace etq
