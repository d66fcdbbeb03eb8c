// An import routine that reached up for the card's dispatch: must not build.
#include "card/card_controller.h"
#include "import/item_import.h"
