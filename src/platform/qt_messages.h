#pragma once

#include <QPointer>
#include <QWidget>

#include "platform/messages.h"

namespace etq {

// Shows the component's messages in modal message boxes over a parent window.
class QtMessageSink : public MessageSink {
  public:
    explicit QtMessageSink(QWidget* parent = nullptr) : parent_(parent) {}
    MsgAnswer show(const Message& message) override;

  private:
    QPointer<QWidget> parent_;
};

}  // namespace etq
