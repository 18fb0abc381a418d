// An ordered group of snippets with the settings that say when and where they expand.
//
// Groups are shared by std::shared_ptr and own their snippets. All operations belong to the thread that owns the
// library. Whoever keeps something derived from the snippets (an index) observes the group.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/CharacterSet.h"
#include "Foundation/Date.h"
#include "Foundation/Uuid.h"
#include "Foundation/archive/KeyedCoding.h"
#include "library/PLFunctionAvailability.h"
#include "library/Snippet.h"

namespace plume {

// What must stand before the abbreviation.
enum class ExpandAfter : std::int32_t { Delimiter = 0, Whitespace = 1, Anything = 2, Digits = 3 };
// When the abbreviation expands.
enum class ExpandTrigger : std::int32_t {
    Immediately = 0,
    DelimiterKept = 1,
    DelimiterSwallowed = 2,
    Never = 3,
    HotKey = 4
};

// Told of a change right after it, on the thread that made it. Observers are not owned.
class SnippetGroupObserver {
  public:
    virtual ~SnippetGroupObserver() = default;
    // `snippet`, whose parentGroup is the group, has another abbreviation than `previous`. It need not stand in
    // `items`: duplicates name the group of their original before they are added to one.
    virtual void abbreviationChanged(SnippetGroup& group, Snippet& snippet,
                                     const std::optional<std::u16string>& previous) = 0;
    // `items` [first, first + count) are new, all others unchanged.
    virtual void itemsAdded(SnippetGroup& group, std::size_t first, std::size_t count) = 0;
    // `snippet` stood in `items` at `index` and is gone from there, all others unchanged; its parentGroup is set
    // already.
    virtual void itemRemoved(SnippetGroup& group, Snippet& snippet, std::size_t index) = 0;
    // `abbreviationPrefix`, `expandTrigger` or `delimiters` changed.
    virtual void matchingSettingsChanged(SnippetGroup& group) = 0;
};

class SnippetGroup final : public KeyedCodable, public std::enable_shared_from_this<SnippetGroup> {
  public:
    using Text = std::optional<std::u16string>;

    static std::shared_ptr<SnippetGroup> make();
    // Reads an archived group with its snippets; nothing that the archive holds or lacks makes it fail.
    static std::shared_ptr<SnippetGroup> makeWithCoder(const KeyedDecoder& coder);
    SnippetGroup(const SnippetGroup&) = delete;
    SnippetGroup& operator=(const SnippetGroup&) = delete;

    // Nothing when an archive held a string that is no UUID.
    const std::optional<Uuid>& uuid() const { return uuid_; }
    const std::optional<Date>& dateCreated() const { return dateCreated_; }

    const Text& name() const { return name_; }
    void setName(Text name) { name_ = std::move(name); }

    // Never holds null: adding one does nothing. Adding makes the group the snippet's parentGroup, but does not take
    // the snippet from the list of another group.
    const std::vector<std::shared_ptr<Snippet>>& items() const { return items_; }
    void addItem(const std::shared_ptr<Snippet>& snippet);
    void addItems(const std::vector<std::shared_ptr<Snippet>>& snippets);
    // An index past the end appends.
    void insertItem(const std::shared_ptr<Snippet>& snippet, std::size_t index);
    // From every place, should there be several. No error when the snippet is not listed. The parentGroup of a listed
    // one is cleared when it is this group.
    void removeItem(const std::shared_ptr<Snippet>& snippet);
    // All of them in place of those that are there.
    void replaceItems(const std::vector<std::shared_ptr<Snippet>>& snippets);

    ExpandAfter expandAfter() const { return expandAfter_; }
    void setExpandAfter(ExpandAfter value) { expandAfter_ = value; }
    // Nil stands for the default delimiters.
    const std::optional<CharacterSet>& expandAfterDelimiters() const { return expandAfterDelimiters_; }
    void setExpandAfterDelimiters(std::optional<CharacterSet> set) { expandAfterDelimiters_ = std::move(set); }
    ExpandTrigger expandTrigger() const { return expandTrigger_; }
    void setExpandTrigger(ExpandTrigger value);
    // Nil stands for the default delimiters.
    const std::optional<CharacterSet>& delimiters() const { return delimiters_; }
    void setDelimiters(std::optional<CharacterSet> set);
    CaseSensitivity caseSensitivity() const { return caseSensitivity_; }
    void setCaseSensitivity(CaseSensitivity value) { caseSensitivity_ = value; }
    bool showInMenuBar() const { return showInMenuBar_; }
    void setShowInMenuBar(bool value) { showInMenuBar_ = value; }
    bool suggestAbbreviations() const { return suggestAbbreviations_; }
    void setSuggestAbbreviations(bool value) { suggestAbbreviations_ = value; }
    const Text& abbreviationPrefix() const { return abbreviationPrefix_; }
    void setAbbreviationPrefix(Text prefix);
    bool hasAbbreviationPrefix() const;
    PLFunctionAvailability& availability() { return availability_; }
    const PLFunctionAvailability& availability() const { return availability_; }
    bool resetFormatting() const { return resetFormatting_; }
    void setResetFormatting(bool value) { resetFormatting_ = value; }

    // A new group with the name, the prefix and the settings, and duplicates of the snippets when asked for.
    std::shared_ptr<SnippetGroup> copySnippetGroup(bool withItems) const;
    void copySettingsFromGroup(const SnippetGroup& other);
    // The same group as it is now, identity included, without its snippets.
    std::shared_ptr<SnippetGroup> snapshot() const;
    // All that copySettingsFromGroup() copies, the name and the prefix are equal.
    bool hasSameSettings(const SnippetGroup& other) const;
    // Makes them so.
    void takeSettings(const SnippetGroup& other);

    // The first snippet with exactly this abbreviation, the prefix not considered; null when there is none.
    std::shared_ptr<Snippet> findSnippetWithAbbreviation(std::u16string_view abbreviation) const;

    // Typed Return arrives as U+000D: a set with line feed gets that instead.
    static std::optional<CharacterSet> replaceNewlineCharacterByCarriageReturnCharacter(
        const std::optional<CharacterSet>& set);

    // Observers may come and go while they are told of a change.
    void addGroupObserver(SnippetGroupObserver* observer);
    void removeGroupObserver(SnippetGroupObserver* observer);

    std::string_view archiveClassName() const override { return "SnippetGroup"; }
    void encodeWithCoder(KeyedEncoder& coder) const override;

  private:
    friend class Snippet;
    SnippetGroup();
    void readAvailability(const KeyedDecoder& coder);
    void encodeAvailability(KeyedEncoder& coder) const;
    // From a snippet whose parentGroup this is, whether it is listed or not.
    void snippetAbbreviationChanged(Snippet& snippet, const Text& previous);
    void notifyMatchingSettingsChanged();
    void notifyObservers(const std::function<void(SnippetGroupObserver&)>& tell);

    std::optional<Uuid> uuid_;
    std::optional<Date> dateCreated_;
    Text name_;
    std::vector<std::shared_ptr<Snippet>> items_;
    ExpandAfter expandAfter_ = ExpandAfter::Delimiter;
    std::optional<CharacterSet> expandAfterDelimiters_;
    ExpandTrigger expandTrigger_ = ExpandTrigger::Immediately;
    std::optional<CharacterSet> delimiters_;
    CaseSensitivity caseSensitivity_ = CaseSensitivity::CaseSensitive;
    bool showInMenuBar_ = true;
    bool suggestAbbreviations_ = true;
    Text abbreviationPrefix_;
    PLFunctionAvailability availability_;
    bool resetFormatting_ = false;
    std::vector<SnippetGroupObserver*> observers_;
};

}  // namespace plume
