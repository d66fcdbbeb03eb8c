#pragma once

#include <QHash>
#include <QWidget>
#include <memory>
#include <vector>

#include "surface/surface.h"

class QTabWidget;

namespace etq {

class CardController;
class Context;
class LabelDesignerWindow;
struct ControlSpec;
class QtFileChooser;

// The control's window: the tab strip MainTab with its eight tabs, the message line Message1
// and the progress bar below it. Every control is a widget whose objectName is its name
// ("OptOLE(3)" for array elements), carrying its English caption in the property "Tag". The
// surface reads right to left. Clicks and changes go to the card's CardController.
class BoundGridModel;

class MainCard : public QWidget, public Surface {
    Q_OBJECT

  public:
    // The control in the run's context (not owned), which the window's message boxes and page
    // viewer are given by its maker.
    explicit MainCard(Context& context, QWidget* parent = nullptr);
    ~MainCard() override;

    CardController& controller() { return *controller_; }

    // The start-up sequence, with the hosting page's SettingID.
    void InitProperties(const QString& settingId = {});

    int elementCount(const QString& name) const override;
    QTabWidget* mainTab() const { return mainTab_; }

    // The label designer as cmdLabDesign opens it, on the run's definition, with the first item
    // the label tab's settings mark in the database folder in its preview.
    std::unique_ptr<LabelDesignerWindow> makeLabelDesigner(const QString& databaseFolder);

  protected:
    Control* find(const QString& name, int index) const override;

  private:
    class WidgetControl;

    void buildControls();
    QWidget* makeWidget(const ControlSpec& spec, QWidget* parent);
    void connectEvents(QWidget* widget, const QString& name, int index);
    void connectDocTypeGrid();
    void connectItemSelection();
    void connectDocumentWindows();
    void connectLabelDesigner();

    QTabWidget* mainTab_ = nullptr;
    std::vector<std::unique_ptr<WidgetControl>> controls_;
    QHash<QString, WidgetControl*> byName_;
    std::unique_ptr<QtFileChooser> chooser_;
    std::unique_ptr<CardController> controller_;
    BoundGridModel* docTypes_ = nullptr;
};

}  // namespace etq
