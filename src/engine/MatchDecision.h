// What became of an abbreviation that was typed, for whoever wonders why it did or did not expand.
#pragma once

#include <cstdint>
#include <string>

#include "Foundation/Date.h"

namespace plume {

// A plain value. It names the snippet and its group; of what was typed it holds the abbreviation alone.
struct MatchDecision {
    enum class Outcome : std::uint8_t {
        Expanded,
        Offered,           // one of several, in a list
        Failed,            // the content could not be expanded, or would have changed nothing
        WrongApplication,  // the group is not for the program in front
        WrongInputSource,  // nor for the keyboard layout or input method
        WrongTextBefore,   // what must stand before the abbreviation does not: see `detail`
        WrongCase,         // the snippet minds capital letters
        WrongTrigger,      // the key after the abbreviation is a delimiter of other groups, not of this one
        SwitchedOff,       // Plume was switched off, or on again
        SwitchedOn,
        SecureInputBegan,  // a password field, or another program that holds the keyboard
        SecureInputEnded,
    };

    // The details of WrongTextBefore: what the group wants there, or "prefix" where part of its prefix stands there, so
    // that the prefix begins earlier. Nothing where the group's setting is none that Plume knows.
    static constexpr const char16_t* AfterDelimiter = u"delimiter";
    static constexpr const char16_t* AfterWhitespace = u"whitespace";
    static constexpr const char16_t* AfterDigits = u"digits";
    static constexpr const char16_t* AfterPrefix = u"prefix";

    Date time;
    Outcome outcome = Outcome::Expanded;
    std::u16string abbreviation = {};  // of the library, with its prefix; empty where no snippet is concerned
    std::u16string group = {};         // its name
    std::u16string application = {};   // the identifier of the program in front; empty when nobody knows
    std::u16string detail = {};        // what the group wants instead, where the outcome alone does not say it

    bool operator==(const MatchDecision&) const = default;
};

}  // namespace plume
