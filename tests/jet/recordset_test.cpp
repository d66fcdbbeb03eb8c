// Recordsets: walking, finding, and editing rows of tables and of joined queries.
#include "jet_fixture.h"

namespace etq::jet::test {
namespace {

class RecordsetTest : public JetTest {
  protected:
    void SetUp() override {
        db = create("a.kdb");
        db.createTable({"tItems",
                        {text("ItemKey", 20), text("ItemName", 100),
                         field("Copies", FieldType::Byte), field("PrintLabel", FieldType::Boolean),
                         field("Price", FieldType::Double), field("LastUpdate", FieldType::Date)},
                        {"ItemKey"}});
        db.createTable({"tLines",
                        {field("HeadNumber", FieldType::Long), field("LineNum", FieldType::Integer),
                         text("ItemKey", 20), field("Copies", FieldType::Integer),
                         field("Include", FieldType::Boolean)},
                        {"HeadNumber", "LineNum"}});
        db.execute(
            "INSERT INTO tItems (ItemKey, ItemName, Copies, PrintLabel) VALUES ('100', 'Soap', 1, False), ('2', 'Brush', 1, True), ('ab''c', 'Quote', 0, False)");
        db.execute(
            "INSERT INTO tLines VALUES (7, 1, '100', 3, True), (7, 2, '2', 1, True), (8, 1, 'none', 1, True)");
    }
    Database db;
};

TEST_F(RecordsetTest, WalksRowsWithBofAndEof) {
    Recordset empty = db.openRecordset("SELECT * FROM tItems WHERE (1<0)");
    EXPECT_TRUE(empty.bof());
    EXPECT_TRUE(empty.eof());
    EXPECT_EQ(empty.recordCount(), 0);
    EXPECT_JET_ERROR(err::kNoCurrentRecord, empty.moveLast());
    EXPECT_JET_ERROR(err::kNoCurrentRecord, empty.value("ItemKey"));

    Recordset rs = db.openRecordset("tItems");
    EXPECT_FALSE(rs.bof());
    EXPECT_EQ(rs.value("ItemKey").toString(), "100");
    rs.moveLast();
    EXPECT_EQ(rs.recordCount(), 3);
    rs.moveNext();
    EXPECT_TRUE(rs.eof());
    EXPECT_JET_ERROR(err::kNoCurrentRecord, rs.moveNext());
    rs.moveFirst();
    rs.movePrevious();
    EXPECT_TRUE(rs.bof());
}

TEST_F(RecordsetTest, ValuesComeInTheirFieldTypes) {
    db.execute("UPDATE tItems SET Price = 12.5, LastUpdate = 45658.5 WHERE ItemKey = '2'");
    Recordset rs = db.openRecordset("tItems");
    rs.findFirst("ItemKey=\"2\"");
    EXPECT_EQ(rs.value("PrintLabel"), QVariant(true));
    EXPECT_EQ(rs.value("Copies").typeId(), QMetaType::Int);
    EXPECT_EQ(rs.value("Price").toDouble(), 12.5);
    EXPECT_EQ(rs.value("LastUpdate").toDateTime(),
              QDateTime(QDate(2025, 1, 1), QTime(12, 0), Qt::UTC));
    EXPECT_TRUE(rs.value("itemname").isValid());  // field names without regard to case
}

TEST_F(RecordsetTest, FindFirstFindsOrSetsNoMatchAndKeepsThePosition) {
    Recordset rs = db.openRecordset("tItems");
    rs.moveLast();
    rs.findFirst("ItemKey=\"2\"");
    ASSERT_FALSE(rs.noMatch());
    EXPECT_EQ(rs.value("ItemName").toString(), "Brush");
    rs.findFirst("ItemKey=\"missing\"");
    EXPECT_TRUE(rs.noMatch());
    EXPECT_EQ(rs.value("ItemName").toString(), "Brush");
    rs.findFirst("ItemKey='AB''C'");  // texts compare without regard to case
    EXPECT_FALSE(rs.noMatch());
    EXPECT_EQ(rs.value("ItemName").toString(), "Quote");
    rs.findFirst("Copies = 1");
    rs.findNext("Copies = 1");
    EXPECT_EQ(rs.value("ItemKey").toString(), "2");
    rs.findNext("Copies = 1");
    EXPECT_TRUE(rs.noMatch());

    Recordset query = db.openRecordset("SELECT ItemKey, ItemName FROM tItems ORDER BY ItemName");
    query.findFirst("ItemName Like 's*'");
    EXPECT_EQ(query.value("ItemKey").toString(), "100");
    query.findFirst("ItemKey=\"2\" And ItemName <> 'x'");
    EXPECT_EQ(query.absolutePosition(), 0);
}

TEST_F(RecordsetTest, AddEditDeleteAndTheUpsertOfTheImport) {
    Recordset rs = db.openRecordset("tItems");
    // The import's way: find by key, edit when found, add otherwise.
    for (const char* key : {"2", "300"}) {
        rs.findFirst(QString("ItemKey=\"%1\"").arg(key));
        if (rs.noMatch()) {
            rs.addNew();
            rs.setValue("ItemKey", key);
        } else {
            rs.edit();
        }
        rs.setValue("Copies", 4);
        rs.update();
    }
    EXPECT_EQ(rows(db, "SELECT ItemKey, Copies FROM tItems ORDER BY ItemKey"),
              QStringList({"100|1", "2|4", "300|4", "ab'c|0"}));
    rs.findFirst("ItemKey=\"300\"");
    EXPECT_FALSE(rs.noMatch());  // added rows are found again

    EXPECT_JET_ERROR(err::kUpdateWithoutEdit, rs.setValue("Copies", 1));
    rs.edit();
    rs.setValue("ItemName", "Item");
    EXPECT_EQ(rs.value("ItemName").toString(), "Item");
    rs.cancelUpdate();
    EXPECT_TRUE(rs.value("ItemName").isNull());

    rs.findFirst("ItemKey=\"100\"");
    rs.deleteRecord();
    EXPECT_JET_ERROR(err::kRecordDeleted, rs.value("ItemKey"));
    rs.moveNext();
    EXPECT_EQ(rs.value("ItemKey").toString(), "2");
    EXPECT_EQ(rows(db, "SELECT Count(*) FROM tItems"), QStringList{"3"});
}

TEST_F(RecordsetTest, AFailedUpdateKeepsTheEditPendingAndWritesNothing) {
    Recordset rs = db.openRecordset("tItems");
    rs.addNew();
    rs.setValue("ItemKey", "2");
    EXPECT_JET_ERROR(err::kDuplicateKey, rs.update());
    EXPECT_EQ(rs.editMode(), Recordset::Adding);
    rs.setValue("ItemKey", "3");
    rs.update();
    EXPECT_EQ(rs.recordCount(), 4);
}

TEST_F(RecordsetTest, AJoinedQueryWritesItsBaseTables) {
    Recordset rs = db.openRecordset(
        "SELECT tLines.LineNum, tLines.ItemKey, tItems.ItemName, tLines.Copies, tLines.Include, (tLines.Copies + 1) AS More FROM (tLines Inner Join tItems On tItems.ItemKey = tLines.ItemKey) ORDER BY tLines.HeadNumber, tLines.LineNum");
    ASSERT_EQ(rs.recordCount(), 2);  // the line whose item is missing does not show
    EXPECT_TRUE(rs.isUpdatable(rs.fieldIndex("Copies")));
    EXPECT_FALSE(rs.isUpdatable(rs.fieldIndex("More")));
    rs.moveLast();
    rs.edit();
    rs.setValue("Copies", 9);
    rs.setValue("Include", false);
    rs.setValue("ItemName", "Hair brush");
    EXPECT_JET_ERROR(err::kFieldNotUpdatable, rs.setValue("More", 1));
    rs.update();
    EXPECT_EQ(rs.value("Copies").toInt(), 9);
    EXPECT_EQ(rows(db, "SELECT Copies, Include FROM tLines WHERE HeadNumber = 7 AND LineNum = 2"),
              QStringList{"9|False"});
    EXPECT_EQ(rows(db, "SELECT ItemName FROM tItems WHERE ItemKey = '2'"),
              QStringList{"Hair brush"});

    rs.moveFirst();
    rs.deleteRecord();  // a row of a join goes from the first table of the join
    EXPECT_EQ(rows(db, "SELECT Count(*) FROM tLines"), QStringList{"2"});
    EXPECT_EQ(rows(db, "SELECT Count(*) FROM tItems"), QStringList{"3"});
}

TEST_F(RecordsetTest, AQueryWithNoRowsTakesANewRowForItsTable) {
    Recordset rs = db.openRecordset("Select ItemKey, ItemName From tItems Where (1<0)");
    rs.addNew();
    rs.setValue("ItemKey", "?");
    rs.setValue("ItemName", "?");
    rs.update();
    EXPECT_EQ(rs.recordCount(), 1);
    EXPECT_EQ(rows(db, "SELECT ItemName FROM tItems WHERE ItemKey = '?'"), QStringList{"?"});
}

TEST_F(RecordsetTest, GroupedRowsCannotBeWritten) {
    Recordset rs =
        db.openRecordset("SELECT HeadNumber, Sum(Copies) AS Total FROM tLines GROUP BY HeadNumber");
    EXPECT_FALSE(rs.isUpdatable(0));
    rs.edit();
    EXPECT_JET_ERROR(err::kFieldNotUpdatable, rs.setValue("HeadNumber", 1));
}

}  // namespace
}  // namespace etq::jet::test
