// etiquon-cli import-items on the demo company.
#include <QProcess>

#include "import_fixture.h"
#include "platform/captions.h"
#include "samples/demo_company.h"

namespace etq::test {
namespace {

using ImportCliTest = ImportTest;

// The command line on the demo company: the final message on stdout, nothing else.
TEST_F(ImportCliTest, CommandLineRunsOnTheDemoCompany) {
    demo::writeDemoCompany(company(), {.items = 120, .seed = 4});
    QProcess cli;
    const QStringList common{"import-items", "--company", company(), "--db", folder()};
    cli.start(ETIQUON_CLI, common + QStringList{"--price-lists", "--special-prices",
                                                "--price-field", "2", "--from", "10100"});
    ASSERT_TRUE(cli.waitForFinished(60000));
    EXPECT_EQ(cli.exitCode(), 0) << cli.readAllStandardError().toStdString();
    EXPECT_EQ(QString::fromUtf8(cli.readAllStandardOutput()).trimmed(), GetCaption(38, 0));
    EXPECT_TRUE(cli.readAllStandardError().isEmpty());
    // Keys 10100 to 10119, but for 10110 (deleted) and the lettered KT-1116 in its place.
    EXPECT_EQ(rows(db::kItemDatabaseFile,
                   "SELECT min(ItemKey), count(*) FROM tItems WHERE ItemKey < 'A'"),
              QStringList{"10100|18"});
    EXPECT_FALSE(rows(db::kItemDatabaseFile, "SELECT ItemKey FROM tPriceList").isEmpty());
    EXPECT_FALSE(rows(db::kItemDatabaseFile, "SELECT ItemKey FROM tAlterPrices").isEmpty());

    // A damaged item file stops the run with the reader's message and a failure code.
    QFile::resize(company() + "/oitm.dbf", 1000);
    cli.start(ETIQUON_CLI, common);
    ASSERT_TRUE(cli.waitForFinished(60000));
    EXPECT_EQ(cli.exitCode(), 1);
    const QString err = QString::fromUtf8(cli.readAllStandardError());
    EXPECT_TRUE(err.contains(company() + "/oitm.dbf")) << err.toStdString();
    EXPECT_TRUE(cli.readAllStandardOutput().isEmpty());
}

}  // namespace
}  // namespace etq::test
