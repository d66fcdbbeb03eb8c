#pragma once

class QWidget;

namespace etq {

class CardController;
class Surface;

// The buttons of the tables tab that open the editors, modally over `parent`, on the database
// folder the control took for its dialogs: cmdEditItems the item editor, cmdAlterKeys the
// alternate key window, cmdAccDef the account definition window with the label software kind
// the options select (none when it cannot be read, as the button passes over failures).
void connectEditors(CardController& controller, const Surface& surface, QWidget* parent);

}  // namespace etq
