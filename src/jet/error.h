#pragma once

#include <QString>
#include <exception>

namespace etq::jet {

// The engine's error numbers: the ones the component's routines test for or show.
namespace err {
constexpr int kGeneric = 3000;
constexpr int kInvalidArgument = 3001;
constexpr int kAlreadyExists = 3010;  // a table of that name is there already
constexpr int kObjectExists = 3012;   // a query (or other object) of that name
constexpr int kNoCurrentRecord = 3021;
constexpr int kDuplicateKey = 3022;
constexpr int kFileNotFound = 3024;
constexpr int kReadOnly = 3027;
constexpr int kBadPath = 3044;
constexpr int kCannotOpen = 3051;
constexpr int kNullKey = 3058;
constexpr int kUnknownField = 3061;  // a statement names a field no table has
constexpr int kTableNotFound = 3078;
constexpr int kUnknownFunction = 3085;
constexpr int kUpdateWithoutEdit = 3020;
constexpr int kSyntax = 3075;
constexpr int kTooLong = 3163;
constexpr int kRecordDeleted = 3167;
constexpr int kFieldNotUpdatable = 3164;
constexpr int kDatabaseExists = 3204;
constexpr int kLocked = 3218;
constexpr int kItemNotFound = 3265;  // a recordset or definition has no such field
constexpr int kZeroLength = 3315;
constexpr int kUnrecognizedFormat = 3343;
constexpr int kOverflow = 3349;
constexpr int kClosed = 3420;
constexpr int kConversion = 3421;
constexpr int kTypeMismatch = 3464;
}  // namespace err

// A failure of the database engine: a number the callers may test (3022 for a duplicate key)
// and a description the message boxes show.
class JetError : public std::exception {
  public:
    JetError(int number, QString description);

    int number() const { return number_; }
    const QString& description() const { return description_; }
    const char* what() const noexcept override { return utf8_.constData(); }

  private:
    int number_;
    QString description_;
    QByteArray utf8_;
};

[[noreturn]] void fail(int number, const QString& description);

}  // namespace etq::jet
