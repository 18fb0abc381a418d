#include "content/PlaceholderScanner.h"

#include <iterator>
#include <optional>
#include <utility>
#include <vector>

#include "content/PlaceholderKinds.h"
#include "content/ScannedText.h"
#include "content/SnippetDateTimeVariable.h"

namespace plume {

namespace {

template <class Text>
class PlaceholderScanner {
  public:
    PlaceholderScanner(ExpansionContext& context, Text text) : context_(context), text_(std::move(text)) {}

    std::shared_ptr<SnippetExpandedContent> expand() {
        while (expandNextPlaceholder()) {
        }
        if (context_.isExhausted()) return nullptr;
        auto content = std::make_shared<SnippetExpandedContent>(text_.finish());
        content->variables = std::move(variables_);
        return content;
    }

  private:
    // False at the end of the text.
    bool expandNextPlaceholder() {
        const std::u16string_view rest = text_.rest();
        const std::size_t opening = rest.find(OpeningMarker);
        const std::size_t closing = opening == std::u16string_view::npos ? opening : rest.find(ClosingMarker, opening);
        if (closing == std::u16string_view::npos) {  // also: no opening marker further on can ever be closed
            text_.keep(rest.size());
            return false;
        }
        text_.keep(opening);
        expandPlaceholder(rest.substr(opening + 1, closing - opening - 1));
        return !context_.isExhausted();
    }

    // The rest starts with the placeholder of this body.
    void expandPlaceholder(std::u16string_view body) {
        const std::size_t length = body.size() + 2;
        attributes_ = text_.attributes();
        std::shared_ptr<SnippetVariable> variable = parseVariable(body);
        if (variable) {
            variable->location = text_.location();
            variable->attributes = attributes_;
        } else {
            variable = parseSign(body, text_.location());
        }
        if (!variable) {
            text_.keep(length);
            return;
        }
        if (!context_.takeReplacement()) return;
        text_.drop(length);
        replaceBy(std::move(variable));
    }

    // A kind that has no branch here is not text: it is recorded for the form and for the delivery.
    void replaceBy(std::shared_ptr<SnippetVariable> variable) {
        if (auto nested = std::dynamic_pointer_cast<SnippetAbbreviationVariable>(variable)) {
            replaceByNested(std::move(nested));
        } else if (const auto* moment = dynamic_cast<const SnippetDateTimeVariable*>(variable.get())) {
            replaceByMoment(*moment);
        } else if (const auto* clipboard = dynamic_cast<const SnippetClipboardVariable*>(variable.get())) {
            replaceByClipboard(*clipboard);
        } else {
            variables_.push_back(std::move(variable));
        }
    }

    void replaceByMoment(const SnippetDateTimeVariable& moment) {
        context_.settleTimeZone();
        const std::u16string value = moment.value(context_.environment());
        if (!context_.takeUnits(value.size())) return;
        if (Text::OptionalDatesBecomeFields && moment.isOptional) {
            addField(moment).value = value;
        } else {
            text_.write(value, attributes_);
        }
    }

    void replaceByClipboard(const SnippetClipboardVariable& clipboard) {
        ClipboardValue value = Text::clipboardValue(clipboard, context_);
        if (!clipboard.isOptional) {
            text_.write(value, attributes_);
            return;
        }
        SnippetFieldVariable& field = addField(clipboard);
        field.isReadonly = true;
        field.value = value.richText ? value.richText->string() : std::move(value.text);
        field.richTextValue = std::move(value.richText);
    }

    void replaceByNested(std::shared_ptr<SnippetAbbreviationVariable> variable) {
        const std::shared_ptr<Snippet> nested = context_.nestedSnippet(*variable);
        if (!nested || !context_.takeUnits(nested->contentLength())) return;
        if (variable->isOptional && nested->isSimpleSnippet() && !nested->isScript()) {
            SnippetFieldVariable& field = addField(*variable);
            field.value = nested->plainTextContent();
            if (context_.snippet().contentType() == ContentType::RichText) {
                field.richTextValue = nested->richTextContent();
            }
        } else if (nested->isScript()) {
            variable->snippet = nested;
            if (variable->isOptional) addTickFor(variable);
            replaceByScript(std::move(variable));
        } else if (nested->contentType() == ContentType::PlainText || nested->contentType() == ContentType::RichText) {
            text_.putBack(*nested, attributes_);
        }
    }

    void replaceByScript(std::shared_ptr<SnippetAbbreviationVariable> variable) {
        if (!context_.enterScript()) return;
        const auto& content = variable->snippet->richTextContent();
        const auto script = expandPlainText(context_, content ? content->string() : std::u16string_view());
        context_.leaveScript();
        if (!script || !context_.takeUnits(script->string().size())) return;

        for (const auto& inner : script->variables) inner->location += text_.location();
        variable->innerVariables = script->variables.size();
        variable->scriptLength = script->string().size();
        variable->isAppleScript = variable->snippet->contentType() == ContentType::AppleScript;
        variables_.push_back(std::move(variable));
        std::move(script->variables.begin(), script->variables.end(), std::back_inserter(variables_));
        text_.write(script->string(), attributes_);
    }

    // The form shows the script's name with it.
    void addTickFor(const std::shared_ptr<SnippetAbbreviationVariable>& script) {
        SnippetFieldVariable& field = addField(*script);
        field.isReadonly = true;
        field.value = script->snippet->label().value_or(u"");
        if (field.value->empty()) field.value = script->snippet->abbreviation();
        field.script = script;
    }

    // A field in the place of an optional placeholder.
    SnippetFieldVariable& addField(const SnippetVariable& variable) {
        auto field = std::make_shared<SnippetFieldVariable>();
        field->location = variable.location;
        field->isOptional = variable.isOptional;
        field->isSelected = variable.isSelected;
        field->attributes = variable.attributes;
        SnippetFieldVariable& result = *field;
        variables_.push_back(std::move(field));
        return result;
    }

    ExpansionContext& context_;
    Text text_;
    SharedAttributes attributes_;  // of the opening marker of the placeholder that is being replaced
    std::vector<std::shared_ptr<SnippetVariable>> variables_;
};

}  // namespace

std::shared_ptr<SnippetExpandedContent> expandPlainText(ExpansionContext& context, std::u16string_view text) {
    return PlaceholderScanner(context, PlainScannedText(text)).expand();
}

std::shared_ptr<SnippetExpandedContent> expandRichText(ExpansionContext& context, const AttributedString& text) {
    return PlaceholderScanner(context, RichScannedText(text)).expand();
}

}  // namespace plume
