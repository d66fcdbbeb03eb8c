#include "import/host_layouts.h"

#include <algorithm>

namespace etq::host {

namespace {

PlacedField place(const HostField& field, int shift, const QByteArray& suffix) {
    return {QByteArray(field.name.data(), qsizetype(field.name.size())) + suffix, field.type,
            field.offset + shift, field.width, field.decimals};
}

}  // namespace

QList<PlacedField> placedFields(const HostLayout& layout) {
    QList<PlacedField> placed;
    for (const HostField& field : layout.fields)
        placed.append(place(field, 0, {}));
    for (const HostRepeat& repeat : layout.repeats)
        for (int n = 1; n <= repeat.count; ++n)
            for (const HostField& field : repeat.fields)
                placed.append(place(field, repeat.entryOffset(n), QByteArray::number(n)));
    std::stable_sort(placed.begin(), placed.end(), [](const PlacedField& a, const PlacedField& b) {
        return a.offset < b.offset;
    });
    return placed;
}

int layoutEnd(const HostLayout& layout) {
    int end = 1;
    for (const HostField& field : layout.fields)
        end = std::max(end, field.end());
    for (const HostRepeat& repeat : layout.repeats)
        for (const HostField& field : repeat.fields)
            end = std::max(end, repeat.of(repeat.count, field).end());
    return end;
}

void requireLayout(const DbfFile& file, const HostLayout& layout) {
    file.requireRecordLength(
        layoutEnd(layout), QString::fromLatin1(layout.what.data(), qsizetype(layout.what.size())));
}

}  // namespace etq::host
