#include "import/scan_ranges.h"

#include "document_fixture.h"
#include "jet/error.h"

namespace etq::test {
namespace {

// Positions count from 1: FromIndx is the first record the next scan reads.
TEST(ScanPosition, NextStartCountsFromOneAndRestartsPastTheEnd) {
    struct Case {
        qint64 nextStart, recordCount, first;
    };
    const Case cases[] = {
        {0, 10, 0},
        {1, 10, 0},
        {-4, 10, 0},  // from the first record
        {5, 10, 4},
        {10, 10, 9},   // record 5 is index 4
        {11, 10, 10},  // just past the last record: nothing new
        {12, 10, 0},
        {500, 10, 0},  // the file was packed or rebuilt: all again
        {40001, 50000, 40000},
    };
    for (const Case& c : cases)
        EXPECT_EQ(firstRecordToScan(c.nextStart, c.recordCount), c.first)
            << c.nextStart << " of " << c.recordCount;
    const ScanPosition after = positionAfterScan(40000);
    EXPECT_EQ(after.lastRecord, 40000);
    EXPECT_EQ(after.nextStart, 40001);
    EXPECT_EQ(firstRecordToScan(after.nextStart, 40000 + 3), 40000);
}

class ScanRangesTest : public DocumentTest {
  protected:
    QString docDb() const { return path(db::kDocDatabaseFile); }
    QStringList stored() const {
        return rows(db::kDocDatabaseFile,
                    "SELECT WizFileID, LastIndx, FromIndx FROM tWizFileRanges ORDER BY WizFileID");
    }
};

TEST_F(ScanRangesTest, RowsOfTheQueryEditsWrittenThroughAndResetAll) {
    const QList<ScanRangeRow> delivered = readScanRanges(docDb());
    ASSERT_EQ(delivered.size(), 7);
    EXPECT_EQ(delivered[0], (ScanRangeRow{QStringLiteral("תעודת משלוח"), 0, 0}));
    EXPECT_EQ(delivered[6].description, QStringLiteral("העברה בין מחסנים"));

    writeScanRange(docDb(), 0, NextStartColumn, 41);
    writeScanRange(docDb(), 0, LastRecordColumn, 40);
    writeScanRange(docDb(), 6, NextStartColumn, 3);
    EXPECT_EQ(stored(),
              (QStringList{"1|40|41", "2|0|0", "3|0|0", "4|0|0", "5|0|0", "6|0|0", "12|0|3"}));
    EXPECT_EQ(readScanRanges(docDb())[0], (ScanRangeRow{QStringLiteral("תעודת משלוח"), 40, 41}));
    EXPECT_THROW(writeScanRange(docDb(), 7, NextStartColumn, 1), jet::JetError);
    EXPECT_THROW(writeScanRange(docDb(), 1, NextStartColumn, "next week"), jet::JetError);
    EXPECT_THROW(writeScanRange(docDb(), 1, NextStartColumn, 5e9), jet::JetError);

    // The reset keeps the last scan's end; only where the next scan starts goes back.
    EXPECT_EQ(resetScanRanges(docDb()), 7);
    EXPECT_EQ(stored(),
              (QStringList{"1|40|0", "2|0|0", "3|0|0", "4|0|0", "5|0|0", "6|0|0", "12|0|0"}));
    for (const ScanRangeRow& row : readScanRanges(docDb()))
        EXPECT_EQ(row.nextStart, 0);
}

}  // namespace
}  // namespace etq::test
