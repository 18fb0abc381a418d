// The text of one expansion, with everything in it that is not text.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <variant>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/text/AttributedString.h"
#include "content/SnippetAbbreviationVariable.h"
#include "content/SnippetFieldVariable.h"
#include "content/SnippetKeyVariable.h"

namespace plume {

class PLScript;

// A stretch of the text, which may be empty, and the key behind it; null behind the last one.
struct DeliveryStep {
    Range text;
    std::shared_ptr<SnippetKeyVariable> key;
};

// Made by the parser, filled by the form and the scripts, delivered by the input service; one thread at a time has it.
class SnippetExpandedContent {
  public:
    using Content = std::variant<std::u16string, AttributedString>;

    SnippetExpandedContent() = default;
    explicit SnippetExpandedContent(Content aContent) : content(std::move(aContent)) {}

    Content content;  // plain for plain snippets and scripts, rich for rich-text snippets
    std::shared_ptr<Snippet> originalSnippet;
    std::vector<std::shared_ptr<SnippetVariable>> variables;
    std::vector<std::shared_ptr<PLScript>> scripts;
    // For each of `scripts`, how many of `variables` were listed before its placeholder: where several things stand at
    // one location, this says what comes first.
    std::vector<std::size_t> variablesBeforeScripts;
    std::u16string suffix;

    bool isRich() const { return std::holds_alternative<AttributedString>(content); }
    const std::u16string& string() const;
    void setContent(Content aContent) { content = std::move(aContent); }

    // The variables of one kind, in list order.
    std::vector<std::shared_ptr<SnippetFieldVariable>> fields() const;
    std::vector<std::shared_ptr<SnippetKeyVariable>> keys() const;
    std::vector<std::shared_ptr<SnippetAbbreviationVariable>> abbreviations() const;

    bool hasCaret() const;
    bool hasCaretLocationOrKeys() const;
    bool hasCaretLocationOrArrowKeys() const;
    bool hasCaretOrFields() const;
    bool hasDelayedKey() const;

    // Signed: -1 stands for the missing caret, and keys may be located past it.
    std::int64_t caretLocation() const;
    std::int64_t caretDistanceFromEnding() const;
    std::int64_t caretDistanceFromEndingIgnoreKeys() const;

    // In which order text and keys are delivered. A key located before its predecessor brings the text back to its
    // place, so that what follows is delivered again. That has an end: beyond ExpansionContext::MaximumLength units in
    // all, keys come without text.
    std::vector<DeliveryStep> deliverySteps() const;
    // The text for placing on a clipboard: Return and Tab keys become spaces, other keys nothing.
    std::u16string copyString() const;
    // Appends the suffix, unstyled; variables keep their places.
    void applySuffix();
};

}  // namespace plume
