// Opening a host file from a record on: what an incremental scan reads of a long file.
#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>
#include <limits>

#include "import/dbf_file.h"
#include "samples/host_records.h"

namespace etq {
namespace {

namespace h = host;

class DbfFileFromRecordTest : public ::testing::Test {
  protected:
    void SetUp() override {
        QList<demo::AccountRecord> accounts;
        for (int i = 0; i < 10; ++i) {
            demo::AccountRecord account;
            account.key = QString::number(20001 + i);
            account.name = QStringLiteral("לקוח %1").arg(i);
            accounts.append(account);
        }
        accounts[8].deleted = true;
        demo::writeHostFile(path, accounts);
    }
    QTemporaryDir dir;
    const QString path = dir.filePath("ocrd.dbf");
};

TEST_F(DbfFileFromRecordTest, ReadsTheRecordsFromTheFirstOnAsTheWholeFileHasThem) {
    const DbfFile whole(path);
    struct Case {
        qint64 first, firstRead;
    };
    for (const Case c : {Case{0, 0}, Case{7, 7}, Case{9, 9}, Case{10, 10}, Case{11, 10},
                         Case{std::numeric_limits<qint64>::max(), 10}, Case{-5, 0}}) {
        SCOPED_TRACE(c.first);
        const DbfFile tail(path, c.first);
        EXPECT_EQ(tail.recordCount(), 10);
        EXPECT_EQ(tail.firstRecord(), c.firstRead);
        EXPECT_EQ(tail.headerLength(), whole.headerLength());
        EXPECT_EQ(tail.fields().size(), whole.fields().size());
        for (qint64 i = c.firstRead; i < 10; ++i) {
            EXPECT_EQ(tail.record(i), whole.record(i));
            EXPECT_EQ(tail.text(i, h::ocrd::kName), whole.text(i, h::ocrd::kName));
            EXPECT_EQ(tail.isDeleted(i), i == 8);
        }
        if (c.firstRead > 0) {
            EXPECT_THROW(tail.record(c.firstRead - 1), DbfError);
        }
        EXPECT_THROW(tail.record(10), DbfError);
    }
}

TEST_F(DbfFileFromRecordTest, ACutFileFailsAsWhenReadWhole) {
    QFile file(path);
    ASSERT_TRUE(file.resize(file.size() - 50));  // into the last record
    EXPECT_THROW(DbfFile(path, 9), DbfError);
    EXPECT_THROW(DbfFile(path, 10), DbfError);
    ASSERT_TRUE(file.resize(40));  // into the field descriptors
    EXPECT_THROW(DbfFile(path, 0), DbfError);
    ASSERT_TRUE(file.resize(20));
    EXPECT_THROW(DbfFile(path, 0), DbfError);
    EXPECT_THROW(DbfFile(dir.filePath("none.dbf"), 0), DbfError);
}

}  // namespace
}  // namespace etq
