#include "input/delivery/ContextInputSetting.h"

#include <initializer_list>
#include <utility>

#include "input/delivery/ApplicationTable.h"

namespace plume {

namespace {

using enum InputFlag;

using SharedSetting = std::shared_ptr<ContextInputSetting>;

SharedSetting makeSetting(InputFlags flags, double pastingDelay = 0, double afterPastingDelay = 0,
                          std::uint64_t blockLength = 0) {
    auto setting = std::make_shared<ContextInputSetting>();
    setting->flags = flags;
    setting->pastingDelay = pastingDelay;
    setting->afterPastingDelay = afterPastingDelay;
    setting->blockLength = blockLength;
    return setting;
}

struct TableRow {
    std::initializer_list<const char16_t*> bundleIdentifiers;
    InputFlags flags;
    double pastingDelay = 0;
    double afterPastingDelay = 0;
    std::uint64_t blockLength = 0;
};

const TableRow NewLineRow = {
    {u"com.sublimetext", u"com.sublimetext.2", u"com.sublimetext.3", u"com.sublimetext.4", u"com.microsoft.Word",
     u"com.microsoft.Excel", u"com.barebones.textwrangler", u"com.barebones.bbedit"},
    UseClipboardIfHasNewLine};

const TableRow ParallelsRow = {
    {u"com.parallels.desktop.console"},
    DisableCapitalization | UseClipboard | Reactivate | AlternativePasting | DoNotRestoreClipboard};

const TableRow TableRows[] = {
    {{u"org.lyx.lyx", u"net.ichi2.anki", u"org.neooffice.NeoOffice", u"com.viber.osx", u"org.editra.Editra",
      u"com.transtex.texeditplus"},
     UseClipboard},
    {{u"com.apple.iBooksAuthor"}, DelayPasting},
    {{u"com.evernote.Evernote"}, IncludeHTMLData | ExcludeParagraphTag | UseClipboardIfHasNewLine},
    {{u"com.google.Chrome"}, IncludeHTMLData | UseClipboardIfHasNewLine, 0, 0.05},
    {{u"org.mozilla.firefox", u"com.postbox-inc.postbox", u"org.mozilla.thunderbird"},
     IncludeHTMLData | UseClipboardIfHasNewLine},
    {{u"com.operasoftware.Opera"}, IncludeHTMLData},
    {{u"com.apple.javajdk16.cmd"}, UseClipboard | UseControlKey},
    // Without UseClipboard: what is pasted there is pasted for another reason.
    {{u"com.teamviewer.TeamViewer"}, AlternativePasting | DelayPasting | UseControlKey | DoNotRestoreClipboard},
    {{u"com.2X.Client.Mac"}, UseClipboard | AlternativePasting | UseControlKey | DoNotRestoreClipboard},
    {{u"com.microsoft.rdc", u"com.p5sys.jump.mac.viewer.web"},
     UseClipboard | AlternativePasting | Reactivate | DoNotRestoreClipboard},
    {{u"com.microsoft.rdc.mac"},
     DisableCapitalization | UseClipboard | UseControlKey | UseVMHelper | AlternativePasting | DoNotSetModifier},
    {{u"net.sf.cord"}, UseClipboard | UseControlKey | Reactivate | DoNotRestoreClipboard},
    {{u"com.citrix.XenAppViewer"}, UseControlKey | UseClipboardIfHasNewLine},
    {{u"org.virtualbox.app.VirtualBoxVM"},
     DisableCapitalization | UseClipboard | AlternativePasting | UseControlKey | DelayPasting | DoNotRestoreClipboard,
     0.2},
    {{u"com.vmware.fusion"},
     DisableCapitalization | UseClipboard | UseVMHelper | DeleteAfterActivateVM | UseControlKey | AlternativePasting |
         ClickAtVM},
    {{u"wine", u"wine.bin"}, UseClipboard | UseControlKey},
    {{u"de.jinx.JollysFastVNC.Pro", u"de.jinx.JollysFastVNC"}, UseClipboard | UseControlKey | Reactivate},
    {{u"org.macosforge.xquartz.X11"}, UseClipboard | UseControlKey},
    {{u"de.ragtime.ragtime"}, {}, 0, 0, 5},
};

}  // namespace

std::shared_ptr<ContextInputSetting> ContextInputSetting::copy() const {
    auto setting = std::make_shared<ContextInputSetting>(*this);
    setting->bundleIdentifier.reset();
    return setting;
}

ContextInputSettings::ContextInputSettings()
    : newLine_(makeSetting(NewLineRow.flags)),
      fusionApp_(makeSetting(DisableCapitalization | UseClipboard | UseVMHelper | UseControlKey | AlternativePasting |
                             ClickAtVMHelper)),
      parallelsApp_(makeSetting(ParallelsRow.flags)),
      crossOverApp_(makeSetting(UseClipboard)),
      wineskinApp_(makeSetting(UseClipboard | UseControlKey | DoNotRestoreClipboard)),
      adobeApp_(makeSetting(UseClipboard)) {
    const auto add = [this](const TableRow& row, const SharedSetting& setting) {
        for (const char16_t* identifier : row.bundleIdentifiers) applications_[identifier] = setting;
    };
    for (const TableRow& row : TableRows) {
        add(row, makeSetting(row.flags, row.pastingDelay, row.afterPastingDelay, row.blockLength));
    }
    add(NewLineRow, newLine_);
    add(ParallelsRow, parallelsApp_);
}

void ContextInputSettings::set(const std::u16string& bundleIdentifier,
                               std::shared_ptr<const ContextInputSetting> setting) {
    applications_[bundleIdentifier] = std::move(setting);
}

void ContextInputSettings::setTable(std::shared_ptr<const ApplicationTable> table) {
    table_ = std::move(table);
    applications_.clear();
}

Result<void> ContextInputSettings::setOwnRows(std::string_view text, const std::string& fileName) {
    ownRows_.reset();
    if (text.empty()) return {};
    auto rows = (table_ ? *table_ : ApplicationTable()).readRows(text, fileName);
    if (!rows) return rows.error();
    ownRows_ = std::make_shared<const ApplicationRows>(std::move(rows).value());
    return {};
}

SharedSetting ContextInputSettings::entryOf(const std::u16string& bundleIdentifier) const {
    if (ownRows_) {
        if (const auto* own = ownRows_->find(bundleIdentifier)) return own->copy();
    }
    const auto found = applications_.find(bundleIdentifier);
    if (found != applications_.end()) return found->second->copy();
    if (!table_) return familyOf(bundleIdentifier);
    const auto* const row = table_->find(bundleIdentifier);
    return row ? row->copy() : nullptr;
}

SharedSetting ContextInputSettings::familyOf(std::u16string_view bundleIdentifier) const {
    if (bundleIdentifier.starts_with(u"com.vmware.proxyApp.")) return fusionApp_;
    if (bundleIdentifier.starts_with(u"com.codeweavers.CrossOverHelper.")) return crossOverApp_;
    if (bundleIdentifier.ends_with(u".wineskin.prefs")) return wineskinApp_;
    if (bundleIdentifier.starts_with(u"com.adobe.")) return adobeApp_;
    if (bundleIdentifier.starts_with(u"com.parallels.winapp.")) return parallelsApp_;
    if (bundleIdentifier.starts_with(u"com.jetbrains.")) return newLine_;
    return nullptr;
}

std::shared_ptr<ContextInputSetting> ContextInputSettings::resolve(
    const std::optional<std::u16string>& bundleIdentifier, bool& isKnown) {
    SharedSetting setting = bundleIdentifier ? entryOf(*bundleIdentifier) : nullptr;
    isKnown = setting != nullptr;
    if (!setting) setting = table_ ? table_->otherwise().copy() : std::make_shared<ContextInputSetting>();
    setting->bundleIdentifier = bundleIdentifier;
    return setting;
}

}  // namespace plume
