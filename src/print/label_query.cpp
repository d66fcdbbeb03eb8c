#include "print/label_query.h"

#include "db/db_values.h"

namespace etq {

namespace {

// The column a checked slot adds, in the three forms of the query. An empty form is the same as
// the account form. "{key}" stands for the quoted account key, "{name}" for the quoted company
// name.
struct SlotPiece {
    int slot;
    QStringView accountItem;   // item labels for one account
    QStringView plainItem;     // item labels without an account
    QStringView documentLine;  // document-line labels: the account of each document
};

// In the order the columns follow each other; slot 12 comes before slot 11. Slots 0 to 7, 27
// and 31 read columns that every query has.
constexpr SlotPiece kSlotPieces[] = {
    {8, u", 'NoSerial' AS SerialNum", u"", u", tTempDocLines.SerialNum"},
    {9, u", {key} As CardCode", u", 'NoCode' AS CardCode",
     u", tTempDocHeaders.AccountKey As CardCode"},
    {10, u", 'NoRef' AS Reference1", u"", u", tTempDocHeaders.Reference1"},
    {12,
     u", (Select AlterNum From tAlterKeys Where AccountKey = {key} And ItemKey = tItems.ItemKey) AS AlterKey",
     u", tItems.ItemKey As AlterKey",
     u", (Select AlterNum From tAlterKeys Where AccountKey = tTempDocHeaders.AccountKey And ItemKey = tItems.ItemKey) AS AlterKey"},
    {11,
     u", (Select Price From tAlterPrices Where AccountKey = {key} And ItemKey = tItems.ItemKey) AS SpecialPrice",
     u", tItems.Price AS SpecialPrice",
     u", (Select Price From tAlterPrices Where AccountKey = tTempDocHeaders.AccountKey And ItemKey = tItems.ItemKey) AS SpecialPrice"},
    {13,
     u", (Select AlterBar From tAlterKeys Where AccountKey = {key} And ItemKey = tItems.ItemKey) AS AlterBar",
     u", tItems.BarCode AS AlterBar",
     u", (Select AlterBar From tAlterKeys Where AccountKey = tTempDocHeaders.AccountKey And ItemKey = tItems.ItemKey) AS AlterBar"},
    {14,
     u", (Select Price From tAccountDef, tPriceList Where tAccountDef.AccountKey = {key} And tPriceList.ItemKey = tItems.ItemKey And tPriceList.PriceList = tAccountDef.PriceList) As ListPrice",
     u", tItems.Price AS ListPrice",
     u", (Select Price From tAccountDef, tPriceList Where tAccountDef.AccountKey = tTempDocHeaders.AccountKey And tPriceList.ItemKey = tTempDocLines.ItemKey And tPriceList.PriceList = tAccountDef.PriceList) As ListPrice"},
    {15, u", {key} As CardName", u", 'NoName' AS CardName", u", tTempDocHeaders.CardName"},
    {16, u", 'NoBlock' AS BlockNum", u"", u", tTempDocLines.BlockNum"},
    {17, u", 'NoStamp' AS StampNum", u"", u", tTempDocHeaders.StampNum"},
    {18, u", 'NoAddress' AS Address", u"", u", tTempDocHeaders.Address"},
    {19, u", 'NoPhone' AS Phone1", u"", u", tTempDocHeaders.Phone1"},
    {20, u", 'NoTrnsp' AS TrnspName", u"", u", tTempDocHeaders.TrnspName"},
    {21, u", 1 AS PackStart", u"", u""},
    {22, u", 'NoCity' AS City", u"", u", tTempDocHeaders.City"},
    {23, u", 'NoContact' AS CntctName", u"", u", tTempDocHeaders.CntctName"},
    {24, u", 'NoContact' AS CntctTel1", u"", u", tTempDocHeaders.CntctTel1"},
    {25, u", 'NoContact' AS CntctNotes1", u"", u", tTempDocHeaders.CntctNotes1"},
    {26, u", 'NoSymbol' AS SymbolHeb", u"",
     u", (Select SymbolHeb From tWizFiles Where WizFileID = tTempDocHeaders.WizFileID) AS SymbolHeb"},
    {28, u", 'NoDueDate' AS DocDueDate", u"", u", tTempDocHeaders.DocDueDate"},
    {29, u", '0' AS Comments", u"", u", tTempDocHeaders.Comments"},
    {30, u", tItems.SuppCatNum", u"", u""},
    {32, u", '0' AS CntctMobile", u"", u", tTempDocHeaders.CntctMobile"},
    {33, u", '0' AS NumAtCard", u"", u", tTempDocHeaders.NumAtCard"},
    {34, u", '0' AS Quantity", u"", u", tTempDocLines.Quantity"},
    {35, u", tItems.PurPackUn AS PPackUn", u"", u""},
    {36, u", tItems.SalPackUn AS SPackUn", u"", u""},
    // Item labels join no document line: these columns are empty for them, so that the
    // statement still runs.
    {37, u", Null AS LineBar", u"", u", tTempDocLines.CodeBars AS LineBar"},
    {38, u", Null AS LineVNum", u"", u", tTempDocLines.VendorNum AS LineVNum"},
    {39, u", Null AS LineLen1", u"", u", tTempDocLines.Length1 AS LineLen1"},
    {40, u", {name} As CompName", u"", u""},
};

constexpr QStringView kHead =
    u"SELECT tItems.ItemKey, tItems.ItemName, tItems.ItemSort, tItems.FName, tItems.BarCode, tItems.Local, tItems.Unit, tItems.Price, tItems.Coin, tCurrencies.WizSign AS CoinSign";
constexpr QStringView kFrom =
    u" FROM (tCurrencies INNER JOIN tItems ON tCurrencies.Currency = tItems.Coin)";

QStringView pieceFor(const SlotPiece& piece, bool documents, bool accountMode) {
    QStringView form = documents     ? piece.documentLine
                       : accountMode ? piece.accountItem
                                     : piece.plainItem;
    return form.isEmpty() ? piece.accountItem : form;
}

QString directionWord(quint8 order) {
    if (order == Ascending) return QStringLiteral("ASC");
    if (order == Descending) return QStringLiteral("DESC");
    return {};
}

}  // namespace

QString quotedText(const QString& text) {
    QString quoted = text;
    quoted.replace(u'\'', QLatin1String("''"));
    return u'\'' + quoted + u'\'';
}

QString ItemKeyRangeCondition(const QString& fromItem, const QString& toItem) {
    QString condition;
    if (!fromItem.isEmpty()) condition += QStringLiteral(" And ItemKey >= ") + quotedText(fromItem);
    if (!toItem.isEmpty()) condition += QStringLiteral(" And ItemKey <= ") + quotedText(toItem);
    return condition;
}

QString BuildLabelQuery(const LabelQueryInput& in) {
    const bool documents = in.queryType == DocumentLineLabels;
    const bool accountMode = in.useAccountKey && !in.accountKey.isEmpty();
    const QString key = quotedText(in.accountKey);
    QString sql = kHead.toString();

    if (documents) {
        sql += QStringLiteral(
            ", tTempDocHeaders.WizFileID, tTempDocHeaders.Number, tTempDocLines.Copies, (Select LabelName From tAccountDef Where tAccountDef.AccountKey = tTempDocHeaders.AccountKey) As AccountLabel");
    } else if (accountMode) {
        sql +=
            QStringLiteral(
                ", tItems.Copies, (Select LabelName From tAccountDef Where tAccountDef.AccountKey = ") +
            key + QStringLiteral(") As AccountLabel");
    } else {
        sql += QStringLiteral(", tItems.Copies, '' As AccountLabel");
    }

    for (const SlotPiece& piece : kSlotPieces) {
        if (!in.fieldChecks[size_t(piece.slot)]) continue;
        QString column = pieceFor(piece, documents, accountMode).toString();
        column.replace(QLatin1String("{key}"), key);
        column.replace(QLatin1String("{name}"), quotedText(db::RemoveQuoteChars(in.companyName)));
        sql += column;
    }

    sql += kFrom;
    if (documents) sql += QStringLiteral(" , tTempDocHeaders, tTempDocLines");
    sql += QStringLiteral(" WHERE (1 > 0)");
    const QString direction = directionWord(in.order);
    if (documents) {
        sql += QStringLiteral(
            " And tTempDocLines.WizFileID = tTempDocHeaders.WizFileID And tTempDocLines.HeadNumber = tTempDocHeaders.Number And tItems.Itemkey = tTempDocLines.Itemkey And (tTempDocHeaders.Include = True) And (tTempDocLines.Include = True)");
        sql += QStringLiteral(" ORDER BY tTempDocLines.WizFileID ") + direction +
               QStringLiteral(", tTempDocLines.HeadNumber ") + direction +
               QStringLiteral(", tTempDocLines.LineNum ") + direction;
    } else {
        sql += QStringLiteral(" And tItems.PrintLabel = True");
        sql += ItemKeyRangeCondition(in.fromItem, in.toItem);
        sql += QStringLiteral(" ORDER BY tItems.Itemkey ") + direction;
    }
    return sql;
}

}  // namespace etq
