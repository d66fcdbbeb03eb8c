#pragma once

#include <QString>

namespace etq {

// The component's message boxes. A run's Context holds the sink in use: the windows give it a
// box that shows them, a headless run writes them on stderr and answers with the default.
enum class MsgIcon { None, Critical, Question, Exclamation, Information };
enum class MsgButtons { Ok, YesNo };
enum class MsgAnswer { Ok, Yes, No };

struct Message {
    QString text;
    QString title;
    MsgIcon icon = MsgIcon::None;
    MsgButtons buttons = MsgButtons::Ok;
};

class MessageSink {
  public:
    virtual ~MessageSink() = default;
    virtual MsgAnswer show(const Message& message) = 0;
};

// Writes the message on stderr; a question is answered with `answer` (Yes unless told).
class StderrMessageSink : public MessageSink {
  public:
    explicit StderrMessageSink(MsgAnswer answer = MsgAnswer::Yes) : answer_(answer) {}
    MsgAnswer show(const Message& message) override;

  private:
    MsgAnswer answer_;
};

// Shorthand for the most common report: the failure's text, the critical icon and a title.
void showCritical(MessageSink& sink, const QString& text, const QString& title);
MsgAnswer askYesNo(MessageSink& sink, const QString& text, const QString& title,
                   MsgIcon icon = MsgIcon::Question);

}  // namespace etq
