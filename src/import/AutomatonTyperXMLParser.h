// Libraries of Automaton: a stream of XML, whose contents are keyed archives in base 64.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Result.h"
#include "import/Remarks.h"
#include "library/Snippet.h"

namespace plume {

// A plain object for one file.
class AutomatonTyperXMLParser {
  public:
    // Fails with the line where the XML is wrong; what was read before it stays in `snippets`.
    Result<void> parse(std::string_view bytes);

    const std::vector<std::shared_ptr<Snippet>>& snippets() const { return snippets_; }
    Remarks& remarks() { return remarks_; }
    std::size_t tooMany() const { return tooMany_; }

    // What stands between "${" and "}" as a placeholder of today's syntax; the token itself when it is not known.
    static std::u16string convertAutomatonToken(std::u16string_view token);

  private:
    friend struct AutomatonEvents;
    void startElement(std::string_view name, const char* const* attributes);
    void endElement(std::string_view name);
    void characters(std::string_view text);
    void finishAttribute();
    void finishObject();
    void setExpansion();

    std::vector<std::shared_ptr<Snippet>> snippets_;
    std::shared_ptr<Snippet> current_;  // null outside of one
    std::size_t depth_ = 0;             // of objects within the current one
    std::string attribute_;             // empty outside of one
    std::string text_;                  // of the current attribute
    std::vector<std::string> losses_;   // of the current snippet
    std::size_t tooMany_ = 0;
    Remarks remarks_;
};

// A content with tokens "${…}", each of which becomes a placeholder.
std::u16string convertAutomatonExpansion(std::u16string_view text);

}  // namespace plume
