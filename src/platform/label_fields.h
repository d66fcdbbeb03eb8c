#pragma once

#include <QStringView>
#include <span>

namespace etq {

// The 41 label field slots. Slot i is element i of three control arrays of the label data tab:
// `ChkFldSend(i)` (is the field sent; its tooltip names the field), `LblFldName(i)` (caption:
// the label variable that receives the value; tag: the format tag) and `LblFldDesc(i)`
// (caption: the Hebrew description; tag: the result column of the label query). The label
// query, the print engine and the built-in label page all walk this one table.
struct LabelFieldSlot {
    int slot;
    QStringView toolTip;      // empty: the box has no tooltip
    QStringView variable;     // LblFldName caption
    QStringView formatTag;    // LblFldName tag: "1" plain, "2" price, "3" date; empty = plain
    QStringView column;       // LblFldDesc tag
    QStringView description;  // LblFldDesc caption
};

inline constexpr int kLabelFieldCount = 41;

std::span<const LabelFieldSlot, kLabelFieldCount> labelFieldSlots();

// How a slot's value is turned into text for the label.
enum class FieldFormat { Plain, Price, Date };
FieldFormat fieldFormat(QStringView formatTag);

}  // namespace etq
