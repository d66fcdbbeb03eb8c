#pragma once

#include <QString>
#include <vector>

#include "platform/messages.h"

namespace etq::test {

// Empties the settings folder of this test run and restores the plain application name, the
// default connection parameters and Hebrew.
void resetSettings();

// The INI file the store keeps for an application name.
QString settingsFile(const QString& application);

// Writes a dBASE III file with one character field and no records.
void writeEmptyDbf(const QString& path, const QByteArray& fieldName, int fieldLength);

// Keeps every message shown and answers questions with a chosen answer.
class RecordingSink : public MessageSink {
  public:
    explicit RecordingSink(MsgAnswer answer = MsgAnswer::Yes);
    ~RecordingSink() override;
    MsgAnswer show(const Message& message) override;

    std::vector<Message> shown;

  private:
    MsgAnswer answer_;
};

}  // namespace etq::test
