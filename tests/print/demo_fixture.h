#pragma once

// The main job as the end-to-end tests run it: tools/demo.sh on the built programs, in a folder
// of the test's own, then the command line on the demo's settings (SettingID 90).
#include <gtest/gtest.h>

#include <QProcessEnvironment>
#include <QTemporaryDir>

#include "jet/database.h"
#include "jet/recordset.h"
#include "support/process_run.h"
#include "support/qt_print.h"
#include "support/test_env.h"

namespace etq::print::test {

class DemoTest : public ::testing::Test {
  protected:
    void SetUp() override {
        env = QProcessEnvironment::systemEnvironment();
        env.remove("DISPLAY");  // print only; never open a browser from a test
        env.remove("WAYLAND_DISPLAY");
        env.insert("ETIQUON_BUILD_DIR", ETIQUON_BUILD_DIR);
        env.insert("ETIQUON_DEMO_DIR", work.path());
    }
    etq::test::ProcessResult runDemo() {
        return etq::test::runProcess(
            "bash", {etq::test::sourceDir() + "/tools/demo.sh", "--no-build"}, env);
    }
    etq::test::ProcessResult cli(const QStringList& args) {
        return etq::test::runProcess(QString(ETIQUON_BUILD_DIR) + "/src/app/etiquon-cli",
                                     QStringList{"--setting-id", "90"} + args, env);
    }
    // A column of the marked items, in item key order.
    QStringList marked(const char* column) {
        jet::Database items = jet::Database::open(work.path() + "/db/etqnitm.kdb");
        QStringList values;
        jet::Recordset rs = items.openRecordset(
            QString("SELECT %1 FROM tItems WHERE PrintLabel = True ORDER BY ItemKey").arg(column));
        for (; !rs.eof(); rs.moveNext())
            values << rs.value(0).toString();
        return values;
    }
    static QString lastLine(const QString& text) {
        return text.trimmed().split(u'\n').last().trimmed();
    }
    // What zbarimg reads from an image: one barcode's text, or nothing.
    static QString decode(const QString& image) {
        return etq::test::runProcess("zbarimg", {"-q", "--raw", image}).out.trimmed();
    }

    QTemporaryDir work;
    QProcessEnvironment env;
};

}  // namespace etq::print::test
