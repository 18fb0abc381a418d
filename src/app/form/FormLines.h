// A snippet's text as a form of plain controls shows it: lines of text, fields and the names of scripts.
//
// Pure; from any thread. Of a long text there is what stands near its fields.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "content/SnippetExpandedContent.h"

namespace plume {

struct FormPiece {
    enum class Kind : std::uint8_t {
        Text,
        Field,    // `field` is its index
        Script,   // `text` is the name of a script whose output comes here
        Omitted,  // of a text that is too long to be shown
    };

    Kind kind = Kind::Text;
    std::u16string text;
    SharedAttributes attributes;
    std::size_t field = 0;

    bool operator==(const FormPiece&) const = default;
};

using FormLine = std::vector<FormPiece>;

std::vector<FormLine> formLines(const SnippetExpandedContent& content);

}  // namespace plume
