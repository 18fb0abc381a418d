#include "ports/x11/keyboard/KeymapCopy.h"

#include <X11/XKBlib.h>

#include <memory>

namespace plume {

namespace {

// Xlib, because its XCB counterpart cannot send a whole keymap; and Xlib ends the program at an error unless told
// otherwise, for all displays at once.
thread_local Display* copyingFor = nullptr;
thread_local bool failed = false;
XErrorHandler handlerBefore = nullptr;

int handleError(Display* display, XErrorEvent* error) {
    if (display != copyingFor) return handlerBefore ? handlerBefore(display, error) : 0;
    failed = true;
    return 0;
}

void surviveLoss(Display* /*display*/, void* /*data*/) {
    failed = true;
}

struct Close {
    void operator()(Display* display) const { XCloseDisplay(display); }
    void operator()(XkbDescPtr keymap) const { XkbFreeKeyboard(keymap, 0, True); }
};

class ErrorTrap {
  public:
    ErrorTrap() : before_(XSetErrorHandler(handleError)) {
        failed = false;
        handlerBefore = before_;
    }
    ~ErrorTrap() {
        XSetErrorHandler(before_);
        copyingFor = nullptr;
    }
    ErrorTrap(const ErrorTrap&) = delete;
    ErrorTrap& operator=(const ErrorTrap&) = delete;

    static void of(Display* display) {
        copyingFor = display;
        XSetIOErrorExitHandler(display, surviveLoss, nullptr);
    }

  private:
    XErrorHandler before_;
};

bool give(Display* display, XkbDescPtr keymap, std::uint16_t device) {
    keymap->device_spec = device;
    // The types and symbols first: all at once the server refuses. And all once more, because from the compatibility
    // map the server derives actions anew, which a Japanese layout has otherwise.
    return XkbSetMap(display, XkbKeyTypesMask | XkbKeySymsMask, keymap) != False &&
           XkbSetMap(display, XkbAllMapComponentsMask, keymap) != False &&
           XkbSetCompatMap(display, XkbAllCompatMask, keymap, False) != False &&
           XkbSetMap(display, XkbAllMapComponentsMask, keymap) != False;
}

}  // namespace

bool copyKeymap(const std::string& displayName, std::uint16_t from, std::span<const std::uint16_t> to) {
    const ErrorTrap errors;
    const std::unique_ptr<Display, Close> display(XOpenDisplay(displayName.c_str()));
    if (!display) return false;
    ErrorTrap::of(display.get());
    const std::unique_ptr<XkbDescRec, Close> keymap(XkbGetMap(display.get(), XkbAllMapComponentsMask, from));
    if (!keymap || XkbGetCompatMap(display.get(), XkbAllCompatMask, keymap.get()) != Success) return false;
    bool ok = true;
    for (const std::uint16_t device : to) ok = give(display.get(), keymap.get(), device) && ok;
    XSync(display.get(), False);
    return ok && !failed;
}

}  // namespace plume
