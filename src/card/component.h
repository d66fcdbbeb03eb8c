#pragma once

namespace etq {

class CardController;
class Surface;

// Connects the parts of the component to the control: the work behind its buttons and the lists
// and definitions it loads, in the controller's context. The window and the tests call it once,
// after making the controller and before InitProperties.
void connectParts(CardController& controller, Surface& surface);

}  // namespace etq
