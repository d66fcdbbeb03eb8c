#include "platform/qt_messages.h"

#include <QMessageBox>

namespace etq {

MsgAnswer QtMessageSink::show(const Message& message) {
    QMessageBox box(parent_);
    box.setWindowTitle(message.title);
    box.setText(message.text);
    box.setLayoutDirection(Qt::RightToLeft);
    switch (message.icon) {
        case MsgIcon::Critical:
            box.setIcon(QMessageBox::Critical);
            break;
        case MsgIcon::Question:
            box.setIcon(QMessageBox::Question);
            break;
        case MsgIcon::Exclamation:
            box.setIcon(QMessageBox::Warning);
            break;
        case MsgIcon::Information:
            box.setIcon(QMessageBox::Information);
            break;
        case MsgIcon::None:
            break;
    }
    if (message.buttons == MsgButtons::YesNo) {
        box.setStandardButtons(QMessageBox::Yes | QMessageBox::No);
        return box.exec() == QMessageBox::Yes ? MsgAnswer::Yes : MsgAnswer::No;
    }
    box.exec();
    return MsgAnswer::Ok;
}

}  // namespace etq
