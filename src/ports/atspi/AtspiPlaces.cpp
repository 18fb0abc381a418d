#include "ports/atspi/AtspiPlaces.h"

#include "ports/atspi/AtspiText.h"

namespace plume {

FocusedPlaces placesOf(AtspiBus& bus, const AtspiFocused& focused) {
    FocusedPlaces places;
    if (!focused.part) return places;
    AtspiTextReader reader(bus, focused.part, {});
    if (const auto range = reader.selectedRange()) places.caret = reader.bounds(*range);
    places.elementName = focused.part.program + focused.part.path;
    places.element = screenBounds(bus, focused.part);
    if (const AtspiPart window = topLevelOf(bus, focused.part)) places.window = screenBounds(bus, window);
    return places;
}

}  // namespace plume
