#include "jet/error.h"

namespace etq::jet {

JetError::JetError(int number, QString description)
    : number_(number), description_(std::move(description)), utf8_(description_.toUtf8()) {}

void fail(int number, const QString& description) {
    throw JetError(number, description);
}

}  // namespace etq::jet
