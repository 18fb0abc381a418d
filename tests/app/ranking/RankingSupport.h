// Random texts for tests of search: few letters, so that they find each other, and all that makes normalising hard.
#pragma once

#include <rapidcheck.h>

#include <string>
#include <vector>

namespace plume {

inline rc::Gen<std::u16string> randomText(int most) {
    const std::vector<std::u16string> pieces{
        u"a",      u"a",          u"b",          u"B",      u"A",      u"C",      u"1",      u" ",      u" ",
        u"-",      u";",          u"*",          u"?",      u"ss",     u"\u00DF", u"\u1E9E", u"\uFB01", u"fi",
        u"\u0301", u"\u00E4",     u"a\u0308",    u"\u0345", u"\u03B9", u"\u1FB3", u"\u212B", u"\u03C2", u"\u03A3",
        u"\u0130", u"\U0001F600", u"\U0001D400", u"\uFE0F", u"\u00A0", u"\u00A8", u"\u0E33", u"\uD55C", u"\u0149"};
    return rc::gen::exec([most, pieces] {
        const int count = *rc::gen::inRange(0, most + 1);
        std::u16string text;
        for (int i = 0; i < count; ++i) text += *rc::gen::elementOf(pieces);
        return text;
    });
}

}  // namespace plume
