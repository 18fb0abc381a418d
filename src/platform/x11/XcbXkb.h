// xcb's header of the XKB extension, which names fields with a word that C++ keeps for itself.
#pragma once

#define explicit explicit_
#include <xcb/xkb.h>
#undef explicit
