// What the tests of the library's records share.
#pragma once

#include <chrono>
#include <memory>
#include <string>
#include <utility>

#include "Foundation/Date.h"
#include "Foundation/text/AttributedString.h"
#include "Foundation/text/TextAttributes.h"
#include "library/Snippet.h"

namespace plume::test {

// A calendar that stands still until told otherwise.
class StoppedDate {
  public:
    Date now() const { return now_; }
    void pass(std::chrono::seconds time) { now_ += time; }

  private:
    Date now_{std::chrono::seconds(1'700'000'000)};
    ScopedDateSource source_{[this] { return now_; }};
};

inline SharedAttributes bold() {
    auto attributes = std::make_shared<TextAttributes>();
    attributes->font = FontAttribute{u"Helvetica", 12, true, false};
    return attributes;
}

// "plain bold" with its second word in bold.
inline AttributedString richText() {
    AttributedString text(u"plain ");
    text.append(u"bold", bold());
    return text;
}

inline std::shared_ptr<Snippet> snippet(std::u16string abbreviation, std::u16string content = u"content") {
    return std::make_shared<Snippet>(std::move(abbreviation), std::move(content));
}

}  // namespace plume::test
