// The settings that travel with a library.
#pragma once

#include <array>

#include "Foundation/archive/PropertyList.h"
#include "platform/UserDefaults.h"

namespace plume {

inline constexpr std::array<const char*, 13> PreferencesOfLibrary = {"CapitalizeNewSentences",
                                                                     "CorrectDoubleCapitals",
                                                                     "AutoCorrectIn",
                                                                     "AutoCorrectApplications",
                                                                     "CapitalizationExcludedAbbreviations",
                                                                     "DoubleCapitalsCorrectionExclusion",
                                                                     "UseClipboard",
                                                                     "UseClipboardIn",
                                                                     "UseClipboardApplications",
                                                                     "RestoreClipboardDelay",
                                                                     "LongTextLength",
                                                                     "UseClipboardForLongText",
                                                                     "RestoreClipboard"};

// Each that has a value, be it a registered one.
inline PropertyList::Dictionary preferencesOfLibrary(const UserDefaults& settings) {
    PropertyList::Dictionary preferences;
    for (const char* key : PreferencesOfLibrary) {
        if (auto value = settings.objectForKey(key)) preferences.emplace(key, *std::move(value));
    }
    return preferences;
}

}  // namespace plume
