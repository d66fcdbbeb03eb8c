// The SQL Server source over ODBC, against the real driver manager and a real driver: SQLite's
// ODBC driver reading a file that holds the host's OPLN and OSHP tables.
#include "import/sql_source.h"

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "import/connection.h"
#include "platform/failure.h"
#include "support/qt_print.h"
#include "support/sql_source_file.h"

namespace etq {
namespace {

class SqlSourceTest : public ::testing::Test {
  protected:
    QString file() const { return dir.filePath("host.db"); }
    QTemporaryDir dir;
};

TEST_F(SqlSourceTest, ConnectionTextBracesWhatCouldChangeIt) {
    EXPECT_EQ(BuildConnString("srv", "sa", "p;w}d", "corvan02", 1),
              "Driver={FreeTDS};Server={srv,1433};UID=sa;Database=corvan02;PWD={p;w}}d}");
    EXPECT_EQ(BuildConnString("db.local\\SAP", "sa", "", "co;mp", 1, "ODBC Driver 18"),
              "Driver={ODBC Driver 18};Server=db.local\\SAP;UID=sa;Database={co;mp};PWD=");
    EXPECT_EQ(BuildConnString("10.0.0.5,1500", "a}b", "x=1", "c", 1, "Fr}ee"),
              "Driver={Fr}}ee};Server={10.0.0.5,1500};UID={a}}b};Database=c;PWD={x=1}");
}

TEST_F(SqlSourceTest, PriceListsAndCarriersWithNamesOnly) {
    test::writeSqlSourceFile(file());
    const ConnParams params = test::sqlSourceParams(file());
    EXPECT_TRUE(sqlServerConnString(params).endsWith(";PWD={p;w}}d}"));
    const EntryList priceLists{{"מחירון בסיס", 1}, {"סיטונאי", 4}};
    EXPECT_EQ(ReadPriceLists(params), priceLists);
    const EntryList carriers{{"דואר ישראל", 3}, {"שליחויות צפון", 7}};
    EXPECT_EQ(ReadCarriers(params), carriers);
    EXPECT_NO_THROW(TestSqlServerConnection(params));
}

TEST_F(SqlSourceTest, TablesWithoutRowsGiveNothing) {
    test::writeSqlSourceFile(file(), false);
    EXPECT_EQ(ReadPriceLists(test::sqlSourceParams(file())), std::nullopt);
    EXPECT_EQ(ReadCarriers(test::sqlSourceParams(file())), std::nullopt);
}

TEST_F(SqlSourceTest, FailuresCarryTheDriversWords) {
    test::writeSqlSourceFile(file());
    struct Case {
        const char* what;
        ConnParams params;
        const char* said;
    };
    ConnParams wrongDriver = test::sqlSourceParams(file());
    wrongDriver.driver = "No Such Driver";
    ConnParams unreachable;  // FreeTDS, and nothing listens on port 1
    unreachable.server = "127.0.0.1,1";
    ConnParams noTables = test::sqlSourceParams(dir.filePath("empty.db"));
    const Case cases[] = {
        {"wrong driver", wrongDriver, "No Such Driver"},
        {"unreachable server", unreachable, "08001"},
        {"no such table", noTables, "OPLN"},
    };
    for (const Case& c : cases) {
        try {
            ReadPriceLists(c.params);
            ADD_FAILURE() << c.what << ": no failure";
        } catch (const QuietFailure& e) {
            EXPECT_TRUE(e.description().contains(c.said)) << c.what << ": " << e.what();
        }
    }
}

}  // namespace
}  // namespace etq
