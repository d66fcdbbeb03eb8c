#include "print/barcode_images.h"

#include "jet/database.h"
#include "jet/recordset.h"
#include "platform/barcode_image.h"
#include "platform/user_paths.h"
#include "print/label_faces.h"

#include <algorithm>
#include <map>
#include <thread>

namespace etq {

namespace {

// The designer's list of symbologies, in list order, and the library's code for each.
// "CODE-128A" asks for subset A, which libzint cannot force: the library gives it automatic
// Code 128, which uses subset A wherever the data needs it and decodes to the same text.
constexpr BarTypeMapping kBarTypes[] = {
    {bar_type::Code39, false},           // "CODE-39"
    {bar_type::Code39, true},            // "CODE-39 Ascii"
    {bar_type::Code128, false},          // "CODE-128"
    {bar_type::Code128A, false},         // "CODE-128A"
    {bar_type::Code128B, false},         // "CODE-128B"
    {bar_type::Ean8, false},             // "EAN-8"
    {bar_type::Ean13, false},            // "EAN-13"
    {bar_type::Interleaved2of5, false},  // "Interleaved 2 of 5"
};

constexpr float kDefaultNarrowBar = 0.01f;
constexpr float kDefaultWideBarRatio = 2.2f;
constexpr int kResolution = 200;  // dots per inch
constexpr int kOn = -1;

int flag(bool on) {
    return on ? kOn : 0;
}

// Every setter, in the library's order, with the values the label passes.
void setUpInstance(const QString& text, LabelBarDef& barDef, BarcodeImage& instance) {
    instance.SetUnit(0);
    instance.SetBarType(barDef.BarType);
    instance.SetData(text);
    instance.SetDesc(text);
    if (barDef.DimX <= 0) barDef.DimX = kDefaultNarrowBar;
    instance.SetDimX(barDef.DimX);
    if (barDef.WideBarRatio <= 0) barDef.WideBarRatio = kDefaultWideBarRatio;
    instance.SetWideBarRatio(barDef.WideBarRatio);
    instance.SetBarHeight(barDef.BarHeight);
    instance.SetHoriAlign(1);
    instance.SetVertAlign(1);
    instance.SetRotation(0);
    instance.SetC128User(flag(barDef.C128User));
    instance.SetC39Ascii(flag(barDef.C39Ascii));
    instance.SetCheckDigit(flag(barDef.CheckDigit));
    instance.SetMatchDesc(0);
    instance.SetMatchFrame(0);
    instance.SetMultiLine(0);
    instance.SetShowDesc(flag(barDef.ShowDesc));
    instance.SetUPCEUser(0);
    instance.SetUserResoX(kResolution);
    instance.SetUserResoY(kResolution);
}

}  // namespace

QString BmpName(int fldId, qint32 recordNo) {
    return QStringLiteral("B%1%2.BMP")
        .arg(fldId, 2, 10, QLatin1Char('0'))
        .arg(recordNo, 5, 10, QLatin1Char('0'));
}

BarTypeMapping mapBarType(qint16 barType) {
    if (barType >= 0 && barType < qint16(std::size(kBarTypes))) return kBarTypes[barType];
    return {barType, false};
}

bool WriteBarcodeBitmap(const QString& text, const QString& fileName, LabelBarDef& barDef,
                        BarcodeImage& instance) {
    setUpInstance(text, barDef, instance);
    return instance.OutputBitmap(fileName);
}

bool MakeBarcodeVector(const QString& text, LabelBarDef& barDef, BarcodeImage& instance,
                       BarcodeVector& out) {
    setUpInstance(text, barDef, instance);
    return instance.OutputVector(out);
}

LabelBarDef mappedBarDef(LabelBarDef barDef) {
    const BarTypeMapping mapping = mapBarType(barDef.BarType);
    barDef.BarType = qint16(mapping.libraryCode);
    if (mapping.fullAscii) barDef.C39Ascii = true;
    return barDef;
}

BarcodeBatch collectBarcodes(const QString& folder, const QString& fieldName, int fldId,
                             const QString& dbName, const QString& sql, LabelBarDef barDef) {
    BarcodeBatch batch;
    batch.folder = folder;
    jet::Database db = jet::Database::open(dbName);
    jet::Recordset rs = db.openRecordset(sql);
    if (rs.bof() && rs.eof()) return batch;
    const int column = rs.fieldIndex(fieldName);
    if (column < 0)
        jet::fail(jet::err::kItemNotFound,
                  QStringLiteral("The label query has no column %1").arg(fieldName));

    batch.barDef = mappedBarDef(barDef);
    for (; !rs.eof(); rs.moveNext()) {
        ++batch.records;
        const QString text = barcodeText(rs.value(column), batch.barDef);
        if (!text.isEmpty()) batch.bitmaps.push_back({BmpName(fldId, batch.records), text});
    }
    return batch;
}

BarcodeRun writeBarcodes(const std::vector<BarcodeBatch>& batches, int threads) {
    // Every bitmap of every batch in one list; each worker takes a contiguous share of it, with
    // its own library instance and its own copy of each batch's setting.
    std::vector<std::pair<const BarcodeBatch*, const BarcodeBatch::Bitmap*>> all;
    for (const BarcodeBatch& batch : batches)
        for (const BarcodeBatch::Bitmap& bitmap : batch.bitmaps)
            all.emplace_back(&batch, &bitmap);
    std::vector<QString> errors(all.size());
    auto work = [&](size_t from, size_t to) {
        BarcodeImage instance;
        std::map<const BarcodeBatch*, LabelBarDef> settings;
        for (size_t i = from; i < to; ++i) {
            const auto [batch, bitmap] = all[i];
            auto setting = settings.try_emplace(batch, batch->barDef).first;
            if (!WriteBarcodeBitmap(bitmap->text, joinPath(batch->folder, bitmap->name),
                                    setting->second, instance))
                errors[i] = bitmap->name + QStringLiteral(": ") + instance.lastError();
        }
    };
    const size_t workers = std::clamp<size_t>(size_t(std::max(threads, 1)), 1, all.size() + 1);
    std::vector<std::thread> pool;
    for (size_t w = 1; w < workers; ++w)
        pool.emplace_back(work, all.size() * w / workers, all.size() * (w + 1) / workers);
    work(0, all.size() / workers);
    for (std::thread& t : pool)
        t.join();

    BarcodeRun run;
    for (const BarcodeBatch& batch : batches)
        run.records += batch.records;
    for (const QString& error : errors) {
        if (error.isEmpty())
            ++run.bitmaps;
        else
            run.refused.append(error);
    }
    return run;
}

BarcodeRun MakeBarcodeImages(const QString& folder, const QString& fieldName, int fldId,
                             const QString& dbName, const QString& sql, LabelBarDef barDef) {
    std::vector<BarcodeBatch> batch;
    batch.push_back(collectBarcodes(folder, fieldName, fldId, dbName, sql, barDef));
    return writeBarcodes(batch);
}

}  // namespace etq
