#include "import/host_layouts.h"

#include <gtest/gtest.h>

#include <QSet>

#include "samples/dbf_writer.h"

namespace etq {
namespace {

namespace h = host;

const h::HostLayout* const kLayouts[] = {&h::oitm::kLayout, &h::oitg::kLayout,    &h::oitb::kLayout,
                                         &h::opln::kLayout, &h::ocrn::kLayout,    &h::ospp::kLayout,
                                         &h::ocrd::kLayout, &h::stockdoc::kLayout};

// A typing slip in the tables (two fields over the same bytes, a field past the record, a name
// a dBASE header cannot hold) shows here before any reader reads the wrong bytes.
TEST(HostLayouts, FieldsFitTheirRecordsWithoutOverlapAndWithDistinctNames) {
    for (const h::HostLayout* layout : kLayouts) {
        SCOPED_TRACE(std::string(layout->what));
        QSet<QByteArray> names;
        int next = 1;
        for (const h::PlacedField& field : h::placedFields(*layout)) {
            EXPECT_GE(field.offset, next) << field.name.constData();
            EXPECT_GT(field.width, 0) << field.name.constData();
            EXPECT_LE(field.name.size(), 10) << field.name.constData();
            EXPECT_FALSE(names.contains(field.name)) << field.name.constData();
            names.insert(field.name);
            next = field.offset + field.width;
        }
        EXPECT_EQ(next, h::layoutEnd(*layout));
        EXPECT_LE(h::layoutEnd(*layout), layout->recordLength);

        int described = 1;
        for (const h::PlacedField& field : demo::describeRecord(*layout)) {
            EXPECT_EQ(field.offset, described) << field.name.constData();
            described += field.width;
        }
        EXPECT_EQ(described, layout->recordLength);
    }
}

TEST(HostLayouts, RepeatedEntriesAreNumberedFromOne) {
    const QList<h::PlacedField> fields = h::placedFields(h::stockdoc::kLayout);
    auto find = [&](const char* name) {
        for (const h::PlacedField& f : fields)
            if (f.name == name) return f.offset;
        return -1;
    };
    EXPECT_EQ(find("QTY1"), h::stockdoc::slot(1, h::stockdoc::line::kQuantity).offset);
    EXPECT_EQ(find("ITEMCODE10"), h::stockdoc::slot(10, h::stockdoc::line::kItemKey).offset);
    EXPECT_EQ(find("QTY11"), -1);
}

TEST(DbfRecord, RefusesValuesThatDoNotFitTheirField) {
    demo::DbfRecord record(h::oitb::kLayout.recordLength);
    EXPECT_THROW(record.setText(h::oitb::kName, QString(21, u'א')), std::invalid_argument);
    EXPECT_THROW(record.setNumber(h::oitb::kNumber, 12345), std::invalid_argument);
    EXPECT_THROW(record.setText({29, 2}, u"ab"), std::invalid_argument);
    EXPECT_THROW(record.setInt32({0, 4}, 1), std::invalid_argument);  // the deletion flag
    record.setText(h::oitb::kName, QString(20, u'א'));
    record.setNumber(h::oitb::kNumber, -123);
    EXPECT_EQ(record.bytes().mid(1, 4), "-123");
    record.setNumber(h::oitb::kNumber, 7);
    EXPECT_EQ(record.bytes().mid(1, 4), "   7");
}

}  // namespace
}  // namespace etq
