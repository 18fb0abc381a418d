// A library and what was asked for, to try the icon's menu with.
#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "Foundation/Strings.h"
#include "app/status/StatusMenuServices.h"

namespace plume {

class MenuServices {
  public:
    StatusMenuServices services() {
        const auto note = [this](const char* what) { return [this, what] { asked.emplace_back(what); }; };
        return {.groups = [this]() -> const SnippetGroups& { return library; },
                .sendSnippetDirectly =
                    [this](const std::shared_ptr<Snippet>& snippet) {
                        sent.push_back(toUtf8(snippet->abbreviation().value_or(u"")));
                    },
                .fontSizeDelta = [this] { return fontSizeDelta; },
                .toggleEnabled = note("toggle"),
                .tryKeyboardAgain = note("keyboard"),
                .newSnippet = note("new"),
                .makeSnippetFromClipboard = note("clipboard"),
                .makeSnippetFromSelection = note("selection"),
                .searchSnippets = note("search"),
                .showMacrosWindow = note("edit"),
                .showPreferences = note("preferences"),
                .showReports = note("reports"),
                .showDecisions = note("decisions"),
                .showDiagnostics = note("diagnostics"),
                .importFile = note("import"),
                .exportLibrary = note("export"),
                .restore = note("restore"),
                .showWelcome = note("welcome"),
                .showAbout = note("about"),
                .quit = note("quit")};
    }

    SnippetGroup& addGroup(std::u16string name, std::size_t count = 0) {
        library.push_back(SnippetGroup::make());
        SnippetGroup& group = *library.back();
        group.setName(std::move(name));
        std::vector<std::shared_ptr<Snippet>> items;
        for (std::size_t i = 0; i < count; ++i) {
            const std::string number = std::to_string(i);
            const std::u16string digits(number.begin(), number.end());
            items.push_back(std::make_shared<Snippet>(u"s" + digits, u"content " + digits));
        }
        group.addItems(items);
        return group;
    }

    SnippetGroups library;
    std::vector<std::string> asked;
    std::vector<std::string> sent;  // by their abbreviations
    std::int64_t fontSizeDelta = 0;
};

}  // namespace plume
