// Appending rows several at a time: stored as a recordset stores them, refused as a recordset
// refuses them, duplicate keys failing or passed over.
#include "jet/row_appender.h"

#include <functional>

#include "jet/connection.h"
#include "jet_fixture.h"

namespace etq::jet::test {
namespace {

const QStringList kFields{"ItemKey",    "ItemName", "ItemSort",   "Copies",
                          "PrintLabel", "Price",    "LastUpdate", "Counter"};

class RowAppenderTest : public JetTest {
  protected:
    void SetUp() override {
        db = create("a.kdb");
        db.createTable({"tItems",
                        {text("ItemKey", 20), text("ItemName", 100),
                         field("ItemSort", FieldType::Integer), field("Copies", FieldType::Byte),
                         field("PrintLabel", FieldType::Boolean), field("Price", FieldType::Double),
                         field("LastUpdate", FieldType::Date), field("Counter", FieldType::Long)},
                        {"ItemKey"}});
    }
    QStringList keys() { return rows(db, "SELECT ItemKey FROM tItems ORDER BY ItemKey"); }
    // Whether the stored values (types included) of two rows are the same but for their keys.
    bool storedAlike(const QString& a, const QString& b) {
        detail::Stmt s = db.connection().prepare(
            QString("SELECT count(*) FROM (SELECT ItemName, typeof(ItemName), ItemSort, "
                    "typeof(ItemSort), Copies, PrintLabel, typeof(PrintLabel), Price, "
                    "typeof(Price), LastUpdate, typeof(LastUpdate), Counter FROM tItems "
                    "WHERE ItemKey IN ('%1', '%2') GROUP BY 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12)")
                .arg(a, b),
            false);
        return s.step() && s.column(0).toInt() == 1;
    }
    Database db;
};

TEST_F(RowAppenderTest, RowsAreStoredAsARecordsetStoresThem) {
    Recordset rs = db.openRecordset("tItems");
    rs.addNew();
    const QVariant values[] = {"A", QStringLiteral("שם"), -32768,    255, true,
                               2.5, QDate(2025, 3, 10),   2147483647};
    for (int i = 0; i < kFields.size(); ++i)
        rs.setValue(i, values[i]);
    rs.update();

    RowAppender rows(db, "titems", kFields);  // names as the engine finds them
    // The typed setters,
    rows.setText(0, "B");
    rows.setText(1, QStringLiteral("שם"));
    rows.setNumber(2, -32768);
    rows.setNumber(3, 255);
    rows.setYesNo(4, true);
    rows.setDouble(5, 2.5);
    rows.setDate(6, QDate(2025, 3, 10));
    rows.setNumber(7, 2147483647);
    rows.addRow();
    // values of other types, converted as a recordset converts them,
    for (int i = 0; i < kFields.size(); ++i)
        rows.setValue(i, values[i]);
    rows.setText(0, "C");
    rows.setText(2, "-32768");
    rows.setDouble(3, 255);
    rows.setNumber(4, 1);
    rows.setNumber(5, 5);
    rows.setValue(6, QDateTime(QDate(2025, 3, 10), QTime(0, 0)));
    rows.addRow();
    // and a row of nothing but its key.
    rows.setText(0, "D");
    rows.setDate(6, QDate());
    rows.addRow();
    EXPECT_EQ(rows.pendingRows(), 3);
    EXPECT_EQ(rows.write(), 3);
    EXPECT_EQ(rows.pendingRows(), 0);

    EXPECT_TRUE(storedAlike("A", "B"));
    EXPECT_EQ(this->rows(db, "SELECT * FROM tItems ORDER BY ItemKey"),
              (QStringList{QStringLiteral("A|שם|-32768|255|True|2.5|10/03/2025|2147483647"),
                           QStringLiteral("B|שם|-32768|255|True|2.5|10/03/2025|2147483647"),
                           QStringLiteral("C|שם|-32768|255|True|5|10/03/2025|2147483647"),
                           "D|Null|Null|Null|Null|Null|Null|Null"}));
}

TEST_F(RowAppenderTest, ValuesARecordsetRefusesAreRefusedWithTheSameError) {
    RowAppender rows(db, "tItems", kFields);
    struct Case {
        const char* what;
        std::function<void()> set;
        int error;
    };
    const Case cases[] = {
        {"text too long", [&] { rows.setText(1, QString(101, u'x')); }, err::kTooLong},
        {"empty text", [&] { rows.setText(1, ""); }, err::kZeroLength},
        {"byte", [&] { rows.setNumber(3, 256); }, err::kOverflow},
        {"negative byte", [&] { rows.setNumber(3, -1); }, err::kOverflow},
        {"integer", [&] { rows.setNumber(2, 32768); }, err::kOverflow},
        {"long", [&] { rows.setDouble(7, 2147483648.0); }, err::kOverflow},
        {"no number", [&] { rows.setText(5, "abc"); }, err::kConversion},
        {"no field", [&] { rows.setNumber(8, 1); }, err::kItemNotFound},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        EXPECT_JET_ERROR(c.error, c.set());
    }
    EXPECT_JET_ERROR(err::kItemNotFound, RowAppender(db, "tItems", {"ItemKey", "Nothing"}));
    EXPECT_JET_ERROR(err::kTableNotFound, RowAppender(db, "tNothing", {"ItemKey"}));
    rows.addRow();  // no key
    EXPECT_JET_ERROR(err::kNullKey, rows.write());
    EXPECT_EQ(rows.pendingRows(), 0);
}

TEST_F(RowAppenderTest, DuplicateKeysFailTheWriteOrArePassedOver) {
    db.execute("INSERT INTO tItems (ItemKey) VALUES ('A')");
    auto add = [](RowAppender& rows, const QStringList& keys) {
        for (const QString& key : keys) {
            rows.setText(0, key);
            rows.addRow();
        }
    };
    RowAppender strict(db, "tItems", {"ItemKey"});
    add(strict, {"B", "a", "C"});  // keys compare without regard to case
    EXPECT_JET_ERROR(err::kDuplicateKey, strict.write());
    EXPECT_EQ(keys(), QStringList{"A"});  // none of the write's rows

    RowAppender lenient(db, "tItems", {"ItemKey", "Copies"}, RowAppender::SkipDuplicateKeys);
    add(lenient, {"B", "a", "C", "D", "d"});
    EXPECT_EQ(lenient.write(), 3);
    EXPECT_EQ(keys(), (QStringList{"A", "B", "C", "D"}));
    // A broken rule is no duplicate: it still fails.
    lenient.addRow();
    EXPECT_JET_ERROR(err::kNullKey, lenient.write());
}

TEST_F(RowAppenderTest, MoreRowsThanOneStatementTakes) {
    RowAppender rows(db, "tItems", kFields);
    for (int i = 0; i < 9000; ++i) {  // 72,000 values: three statements
        rows.setText(0, QString::number(i));
        rows.setNumber(7, i);
        rows.addRow();
    }
    EXPECT_EQ(rows.write(), 9000);
    EXPECT_EQ(this->rows(db, "SELECT Count(*), Sum(Counter) FROM tItems"),
              QStringList{"9000|40495500"});
}

}  // namespace
}  // namespace etq::jet::test
