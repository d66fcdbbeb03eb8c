#include "platform/settings_keys.h"

#include "platform/user_paths.h"

namespace etq {

namespace {

using T = TransferKind;

constexpr SettingKey kKeys[] = {
    {1, u"GeneralParams", u"CompanyName", u"txtCompanyName", -1, false, T::Text,
     u"Corvan Information Systems"},
    {1, u"GeneralParams", u"OptOLE0", u"OptOLE", 0, false, T::Value, u"False"},
    {1, u"GeneralParams", u"OptOLE1", u"OptOLE", 1, false, T::Value, u"False"},
    {1, u"GeneralParams", u"OptOLE2", u"OptOLE", 2, false, T::Value, u"False"},
    {1, u"GeneralParams", u"OptOLE3", u"OptOLE", 3, false, T::Value, u"True"},
    {1, u"GeneralParams", u"OptOLE4", u"OptOLE", 4, false, T::Value, u"False"},
    {1, u"GeneralParams", u"OptOLE5", u"OptOLE", 5, false, T::Value, u"False"},
    {1, u"GeneralParams", u"LabelName", u"txtLabelName", -1, false, T::Text, u"",
     PathDefault::HomeLabelFile},
    {1, u"GeneralParams", u"DBPath", u"txtDBPath", -1, false, T::Text, u"",
     PathDefault::DataFolder},
    {1, u"GeneralParams", u"LabelNameHead", u"txtLabelNameHead", -1, false, T::Text, u"",
     PathDefault::HomeLabelFile},
    {1, u"GeneralParams", u"OptPrinter0", u"OptPrinter", 0, false, T::Value, u"False"},
    {1, u"GeneralParams", u"OptPrinter1", u"OptPrinter", 1, false, T::Value, u"True"},
    {1, u"GeneralParams", u"LabelSoftware", u"txtLabelSoftware", -1, false, T::Text, u""},
    // The printer is kept by name; "-1" names none, so nothing is selected.
    {1, u"GeneralParams", u"DefPrinter", u"cmbPrinter", -1, false, T::Text, u"-1"},
    // The built-in labels: 0 the page in the browser, 1 a PDF sent straight to the printer.
    {1, u"GeneralParams", u"PrintMode", u"cmbPrintMode", -1, false, T::ListIndex, u"0"},

    {2, u"ImportItems", u"ItemNameType", u"CmbItemNameType", -1, false, T::ListIndex, u"0"},
    {2, u"ImportItems", u"PriceField", u"cmbPriceField", -1, false, T::ListIndex, u"0"},
    {2, u"ImportItems", u"Copies", u"txtCopies", -1, false, T::Text, u"1"},
    {2, u"ImportItems", u"ImportAlterPrices", u"ChkImportAlterPrices", -1, false, T::Value, u"0"},
    {2, u"ImportItems", u"CleanItems", u"ChkClean", -1, false, T::Value, u"0"},
    {2, u"ImportItems", u"FromItemKey", u"txtFromItemKey", -1, false, T::Text, u""},
    {2, u"ImportItems", u"ToItemKey", u"txtToItemKey", -1, false, T::Text, u""},
    {2, u"ImportItems", u"ReadPriceList", u"chkReadPriceList", -1, false, T::Value, u"0"},
    {2, u"ImportItems", u"UseItmQGrp", u"chkItmQGrp", -1, false, T::Value, u"0"},
    {2, u"ImportItems", u"ItmQGrpBy", u"cmbItmQGrpBy", -1, false, T::ListIndex, u"0"},
    {2, u"ImportItems", u"ItmQGrp", u"cmbItmQGrp", -1, false, T::ListIndex, u"0"},
    {2, u"ImportItems", u"UseItmBelong", u"chkItmBelong", -1, false, T::Value, u"0"},
    {2, u"ImportItems", u"ItmBelong", u"cmbItmBelong", -1, false, T::ListIndex, u"0"},

    {3, u"LabelVars", u"FldSend", u"ChkFldSend", -1, true, T::Value, u"0", PathDefault::None, 41},
    {3, u"LabelVars", u"PrintDelay", u"txtPrintDelay", -1, false, T::Text, u"0"},
    {3, u"LabelVars", u"PriceFormat", u"txtPriceFormat", -1, false, T::Text, u"0.00"},

    {4, u"LabelByItems", u"FromItem", u"txtFromItem", -1, false, T::Text, u""},
    {4, u"LabelByItems", u"ToItem", u"txtToItem", -1, false, T::Text, u""},
    {4, u"LabelByItems", u"UseAccountKey", u"ChkUseAccountKey", -1, false, T::Value, u"0"},
    {4, u"LabelByItems", u"AccountKey", u"txtAccountKey", -1, false, T::Text, u""},

    {5, u"LabelByDocs", u"FromDate", u"txtFromDate", -1, false, T::Text, u"01/01/1980"},
    {5, u"LabelByDocs", u"ToDate", u"txtToDate", -1, false, T::Text, u"01/01/2025"},
    {5, u"LabelByDocs", u"FromDocNum", u"txtFromDocNum", -1, false, T::Text, u""},
    {5, u"LabelByDocs", u"ToDocNum", u"txtToDocNum", -1, false, T::Text, u""},
    {5, u"LabelByDocs", u"ReadDocItems", u"chkReadDocItems", -1, false, T::Value, u"0"},
    {5, u"LabelByDocs", u"PrintHeadLabel", u"chkPrintHeadLabel", -1, false, T::Value, u"0"},
    {5, u"LabelByDocs", u"OnlyLine0", u"chkOnlyLine0", -1, false, T::Value, u"0"},
    {5, u"LabelByDocs", u"UseFastWay", u"chkUseFastWay", -1, false, T::Value, u"0"},

    {6, u"ByDocsDef", u"AddressFrom", u"cmbAddressFrom", -1, false, T::ListIndex, u"0"},
    {6, u"ByDocsDef", u"Line0From", u"cmbLine0From", -1, false, T::ListIndex, u"0"},
    {6, u"ByDocsDef", u"Line0Copies", u"txtLine0Copies", -1, false, T::Text, u"1"},
    {6, u"ByDocsDef", u"cmbCopiesAt", u"cmbCopiesAt", -1, false, T::ListIndex, u"0"},
    {6, u"ByDocsDef", u"AddressSeperator", u"cmbAddressSeperator", -1, false, T::ListIndex, u"0"},
    {6, u"ByDocsDef", u"UseDeliverLog", u"chkUseDeliverLog", -1, false, T::Value, u"0"},

    {11, u"EditItems", u"ItmSearchBy", u"cmbItmSearchBy", -1, false, T::ListIndex, u"0"},
    {11, u"EditItems", u"ItmSortBy", u"cmbItmSortBy", -1, false, T::ListIndex, u"0"},
    {11, u"EditItems", u"ItmSortOrder", u"cmbItmSortOrder", -1, false, T::ListIndex, u"0"},

    {12, u"AlterItems", u"AltSearchBy0", u"cmbAltSearchBy", 0, false, T::ListIndex, u"0"},
    {12, u"AlterItems", u"AltSearchBy1", u"cmbAltSearchBy", 1, false, T::ListIndex, u"1"},
    {12, u"AlterItems", u"AltSortBy", u"cmbAltSortBy", -1, false, T::ListIndex, u"0"},
    {12, u"AlterItems", u"AltSortOrder", u"cmbAltSortOrder", -1, false, T::ListIndex, u"0"},

    // The connection parameters: read at start-up; only ConnServer and ConnDataBase are
    // ever written, by the connection dialog.
    {0, u"Params", u"ConnServer", u"", -1, false, T::Text, u"server"},
    {0, u"Params", u"ConnUID", u"", -1, false, T::Text, u"sa"},
    {0, u"Params", u"ConnPWD", u"", -1, false, T::Text, u""},
    {0, u"Params", u"ConnDataBase", u"", -1, false, T::Text, u"corvan02"},
    // The ODBC driver of the SQL Server source, as the driver manager names it (odbcinst.ini).
    {0, u"Params", u"ConnDriver", u"", -1, false, T::Text, u"FreeTDS"},
    // The language of messages and dialogs: "1" English, anything else Hebrew.
    {0, u"Params", u"Language", u"", -1, false, T::Text, u"0"},
};

}  // namespace

std::span<const SettingKey> settingKeys() {
    return kKeys;
}

QString defaultValue(const SettingKey& key) {
    switch (key.pathDefault) {
        case PathDefault::DataFolder:
            return userDataFolder();
        case PathDefault::HomeLabelFile:
            return defaultLabelFile();
        case PathDefault::None:
            break;
    }
    return key.defaultText.toString();
}

const SettingKey* findSettingKey(QStringView section, QStringView key, int* element) {
    for (const SettingKey& entry : kKeys) {
        if (entry.section != section) continue;
        if (!entry.perElement && entry.key == key) return &entry;
        if (entry.perElement && key.startsWith(entry.key) && key.size() == entry.key.size() + 2) {
            bool ok = false;
            const int i = key.mid(entry.key.size()).toInt(&ok);
            if (ok && i >= 0 && i < entry.elements) {
                if (element) *element = i;
                return &entry;
            }
        }
    }
    return nullptr;
}

const SettingKey* findSettingKeyOfControl(QStringView control, int index) {
    for (const SettingKey& entry : kKeys) {
        if (entry.control != control) continue;
        if (entry.perElement ? index >= 0 && index < entry.elements : entry.index == index)
            return &entry;
    }
    return nullptr;
}

QString settingDefault(QStringView section, QStringView key) {
    const SettingKey* entry = findSettingKey(section, key);
    return entry ? defaultValue(*entry) : QString();
}

QString elementKey(const SettingKey& entry, int element) {
    return entry.key.toString() + QStringLiteral("%1").arg(element, 2, 10, QLatin1Char('0'));
}

}  // namespace etq
