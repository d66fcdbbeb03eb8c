#pragma once

#include <QStringList>
#include <QStringView>
#include <span>

#include "surface/surface.h"

namespace etq {

// One control of the surface: the table both surfaces are built from.
struct ControlSpec {
    QStringView name;
    int index = -1;  // element of a control array, -1 for a single control
    ControlKind kind;
    int tab;                // tab of MainTab, -1 outside the tab strip
    QStringView container;  // the frame (or shape) it sits in; empty: the tab page itself
    QStringView caption;    // Hebrew design caption
    QStringView tag;        // English caption; on the label data tab the slot's format or column
    QStringView toolTip;
    // Place in the container's grid; column 0 is the right-hand side (the surface reads right
    // to left).
    int row = 0;
    int column = 0;
    int rowSpan = 1;
    int columnSpan = 1;
};

inline constexpr int kTabCount = 8;

// Every control of the surface, tab by tab, then those outside the tab strip.
std::span<const ControlSpec> surfaceControls();
const ControlSpec* findControlSpec(QStringView name, int index);
int controlArraySize(QStringView name);

// The captions of the eight tabs of MainTab.
QStringList tabCaptions();

// The entries of the combo boxes whose lists are fixed by design, as "a;b;c".
struct DesignList {
    QStringView control;
    QStringView items;
};
std::span<const DesignList> designLists();

}  // namespace etq
