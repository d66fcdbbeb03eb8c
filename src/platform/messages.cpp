#include "platform/messages.h"

#include <QTextStream>

namespace etq {

namespace {
MessageSink* g_sink = nullptr;

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

MessageSink& messages() {
    static StderrMessageSink fallback;
    return g_sink ? *g_sink : fallback;
}

void setMessageSink(MessageSink* sink) {
    g_sink = sink;
}

void showCritical(const QString& text, const QString& title) {
    messages().show({text, title, MsgIcon::Critical, MsgButtons::Ok});
}

MsgAnswer askYesNo(const QString& text, const QString& title, MsgIcon icon) {
    return messages().show({text, title, icon, MsgButtons::YesNo});
}

}  // namespace etq
