#pragma once

#include <QString>
#include <vector>

#include "support/recording_messages.h"
#include "support/test_env.h"

namespace etq::test {

// Writes a dBASE III file with one character field and no records.
void writeEmptyDbf(const QString& path, const QByteArray& fieldName, int fieldLength);

}  // namespace etq::test
