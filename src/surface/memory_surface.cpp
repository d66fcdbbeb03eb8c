#include "surface/memory_surface.h"

#include "surface/surface_controls.h"

namespace etq {

namespace {
constexpr int kProgressFrameWidth = 600;
}

class MemorySurface::MemoryControl : public Control {
  public:
    MemoryControl(MemorySurface& surface, const ControlSpec& spec)
        : surface_(surface),
          name_(spec.name.toString()),
          index_(spec.index),
          kind_(spec.kind),
          tab_(spec.tab),
          container_(spec.container.toString()),
          caption_(spec.caption.toString()),
          tag_(spec.tag.toString()),
          toolTip_(spec.toolTip.toString()) {
        if (kind_ == ControlKind::Shape && container_.isEmpty()) width_ = kProgressFrameWidth;
    }

    const QString& name() const { return name_; }
    int index() const { return index_; }
    const QString& container() const { return container_; }

    ControlKind kind() const override { return kind_; }
    int tab() const override { return tab_; }

    QString text() const override { return text_; }
    void setText(const QString& text) override {
        if (text == text_) return;
        text_ = text;
        surface_.notifyChanged(name_, index_);
    }
    QString caption() const override { return caption_; }
    void setCaption(const QString& caption) override { caption_ = caption; }
    int state() const override { return state_; }
    void setState(int state) override {
        state_ = state;
        if (kind_ == ControlKind::OptionButton && state != 0) surface_.clearOtherOptions(*this);
    }
    int listIndex() const override { return listIndex_; }
    void setListIndex(int index) override { listIndex_ = index; }
    int listCount() const override { return int(items_.size()); }
    QString itemText(int i) const override { return items_[size_t(i)].first; }
    int itemData(int i) const override { return items_[size_t(i)].second; }
    void addItem(const QString& text, int data) override { items_.emplace_back(text, data); }
    void clearList() override {
        items_.clear();
        listIndex_ = -1;
    }
    int currentTab() const override { return currentTab_; }
    void setCurrentTab(int tab) override {
        if (tab == currentTab_) return;
        currentTab_ = tab;
        surface_.notifyChanged(name_, index_);
    }
    int tabCount() const override { return kind_ == ControlKind::TabStrip ? kTabCount : 0; }

    bool visible() const override { return visible_; }
    void setVisible(bool visible) override { visible_ = visible; }
    QString tag() const override { return tag_; }
    void setTag(const QString& tag) override { tag_ = tag; }
    QString toolTip() const override { return toolTip_; }
    void setToolTip(const QString& toolTip) override { toolTip_ = toolTip; }
    int width() const override { return width_; }
    void setWidth(int width) override {
        width_ = width;
        if (surface_.widthWatcher_) surface_.widthWatcher_(name_, width);
    }
    void setFocus() override {}

  private:
    MemorySurface& surface_;
    QString name_;
    int index_;
    ControlKind kind_;
    int tab_;
    QString container_;
    QString caption_;
    QString tag_;
    QString toolTip_;
    QString text_;
    int state_ = 0;
    int listIndex_ = -1;
    std::vector<std::pair<QString, int>> items_;
    int currentTab_ = 0;
    bool visible_ = true;
    int width_ = 0;
};

MemorySurface::MemorySurface() {
    for (const ControlSpec& spec : surfaceControls()) {
        controls_.push_back(std::make_unique<MemoryControl>(*this, spec));
        byName_.insert(elementName(spec.name.toString(), spec.index), controls_.back().get());
    }
    for (const DesignList& list : designLists()) {
        MemoryControl* combo = byName_.value(list.control.toString());
        for (const QString& item : list.items.toString().split(u';'))
            combo->addItem(item, 0);
    }
}

MemorySurface::~MemorySurface() = default;

int MemorySurface::elementCount(const QString& name) const {
    int count = 0;
    for (const auto& c : controls_)
        if (c->name() == name && c->index() >= 0) ++count;
    return count;
}

Control* MemorySurface::find(const QString& name, int index) const {
    return byName_.value(elementName(name, index));
}

// Option buttons of one frame exclude each other, as they do on the window.
void MemorySurface::clearOtherOptions(const MemoryControl& selected) {
    for (const auto& c : controls_) {
        if (c.get() != &selected && c->kind() == ControlKind::OptionButton &&
            c->container() == selected.container())
            c->setState(0);
    }
}

}  // namespace etq
