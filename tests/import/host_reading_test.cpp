#include "import/host_reading.h"

#include <gtest/gtest.h>

#include "support/qt_print.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>

#include "import/connection.h"

namespace etq {
namespace {

void touch(const QString& path) {
    QFile file(path);
    ASSERT_TRUE(file.open(QIODevice::WriteOnly)) << path.toStdString();
}

// A company folder copied from Windows names its files in upper case, or as someone typed
// them; the readers ask for the lower-case names the host package uses.
TEST(HostFilePath, FindsTheFileWhateverTheLetterCaseOfItsName) {
    struct Case {
        QStringList onDisk;
        QString asked;
        QString found;  // the name of the path returned
    };
    const Case cases[] = {
        {{"OITM.DBF"}, "oitm.dbf", "OITM.DBF"},
        {{"Oitm.dbf"}, "oitm.dbf", "Oitm.dbf"},
        {{"oitm.dbf"}, "oitm.dbf", "oitm.dbf"},
        {{"DLVNOTE.DBF", "invoice.dbf"}, "dlvnote.dbf", "DLVNOTE.DBF"},
        // The exact spelling wins; between other spellings the first in name order.
        {{"OITM.DBF", "oitm.dbf"}, "oitm.dbf", "oitm.dbf"},
        {{"Oitm.DBF", "OITM.DBF"}, "oitm.dbf", "OITM.DBF"},
        // Nothing that differs only in case: the name as asked, which does not exist.
        {{"oitm.dbf.bak", "xoitm.dbf"}, "oitm.dbf", "oitm.dbf"},
        {{}, "oitm.dbf", "oitm.dbf"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.onDisk.join(',').toStdString());
        QTemporaryDir dir;
        for (const QString& name : c.onDisk)
            touch(dir.filePath(name));
        EXPECT_EQ(hostread::hostFilePath(dir.path(), c.asked), dir.filePath(c.found));
    }
}

TEST(HostFilePath, LayoutsAndTheAccountsCheckFindUpperCaseNames) {
    QTemporaryDir dir;
    const QString company = dir.filePath("company");
    ASSERT_TRUE(QDir().mkpath(company));
    EXPECT_FALSE(companyFolderHasAccounts(dir.path(), "company"));
    touch(company + "/OCRD.DBF");
    touch(company + "/Oitm.Dbf");
    EXPECT_TRUE(companyFolderHasAccounts(dir.path(), "company"));
    EXPECT_EQ(hostread::hostFilePath(company, host::oitm::kLayout), company + "/Oitm.Dbf");
}

}  // namespace
}  // namespace etq
