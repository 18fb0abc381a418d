// Finding snippets in the library, and adapting a content's case to the case in which its abbreviation was typed.
//
// Stateless. The case operations may be called from any thread, the look-ups belong to the thread that owns the
// library.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/text/AttributedString.h"
#include "library/Snippet.h"
#include "library/SnippetGroup.h"

namespace plume {

// How an abbreviation was typed, named after what it does to the content.
enum class CaseClass : std::int64_t {
    Unspecific = 0,      // no letters, or a mixture that says nothing: the content stays
    Capitalised = 1,     // its first character becomes upper case
    UpperCase = 2,       // all of it becomes upper case
    LowerCase = 3,       // the content stays as written
    CapitaliseWords = 4  // the first letter of every word becomes upper case
};

class SnippetUtils {
  public:
    using Groups = std::vector<std::shared_ptr<SnippetGroup>>;

    // Flag bit 0: a mixture that starts in lower case always capitalises words; without it only when the last letter
    // is upper case. All other bits are ignored.
    static constexpr std::int64_t MixedCaseCapitalisesWords = 1;

    // Whatever letter is not lower case counts as upper case: combining marks and scripts without case too.
    static CaseClass caseOf(std::u16string_view typed, std::int64_t flags);

    // The content as it is to be sent for an abbreviation typed so. Upper-casing may lengthen it; attributes stay with
    // the characters that they were on.
    static std::u16string correctedCase(std::u16string_view content, std::u16string_view typed, std::int64_t flags);
    static AttributedString correctedCase(const AttributedString& content, std::u16string_view typed,
                                          std::int64_t flags);

    // The look-ups give the first match in library order, or null. When there is one and `parentGroup` is given, the
    // group that lists it is stored there; otherwise `parentGroup` is left alone.
    //
    // By exactly this abbreviation, prefixes not considered.
    static std::shared_ptr<Snippet> findSnippetByAbbreviation(std::u16string_view abbreviation, const Groups& groups,
                                                              std::shared_ptr<SnippetGroup>* parentGroup = nullptr);
    // As above, but with `checkPrefix` by the group's prefix followed by the abbreviation.
    static std::shared_ptr<Snippet> findSnippetByAbbreviation(std::u16string_view abbreviation, const Groups& groups,
                                                              bool checkPrefix,
                                                              std::shared_ptr<SnippetGroup>* parentGroup = nullptr);
    // Null also when `uuid` is none.
    static std::shared_ptr<Snippet> findSnippetByUUID(std::u16string_view uuid, const Groups& groups,
                                                      std::shared_ptr<SnippetGroup>* parentGroup = nullptr);
};

}  // namespace plume
