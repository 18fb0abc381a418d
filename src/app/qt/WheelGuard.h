// The wheel and the controls that it would change.
#pragma once

class QWidget;

namespace plume {

// The wheel scrolls what lies around the control until the control has the focus.
void ignoreWheelWithoutFocus(QWidget& control);

}  // namespace plume
