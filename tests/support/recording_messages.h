#pragma once

#include <QList>

#include "platform/messages.h"

namespace etq::test {

// Keeps every message instead of showing it, and answers questions with a chosen answer. A test
// gives it to its context.
class RecordingMessages : public MessageSink {
  public:
    explicit RecordingMessages(MsgAnswer answer = MsgAnswer::Yes) : answer_(answer) {}

    MsgAnswer show(const Message& message) override {
        shown.append(message);
        if (message.buttons == MsgButtons::YesNo) return answer_;
        return MsgAnswer::Ok;
    }

    QList<Message> shown;

  private:
    MsgAnswer answer_;
};

}  // namespace etq::test
