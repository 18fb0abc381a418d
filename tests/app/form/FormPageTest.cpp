#include "app/form/FormPage.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <map>
#include <set>

#include "library/Snippet.h"

namespace plume {
namespace {

using Variable = std::shared_ptr<SnippetVariable>;
using FieldVariable = std::shared_ptr<SnippetFieldVariable>;

FieldVariable fieldAt(std::size_t location, std::u16string name, FieldType type, std::u16string value) {
    auto variable = std::make_shared<SnippetFieldVariable>();
    variable->location = location;
    variable->name = std::move(name);
    variable->type = type;
    variable->value = std::move(value);
    return variable;
}

FieldVariable lineAt(std::size_t location, std::u16string name = u"N", std::u16string value = u"") {
    return fieldAt(location, std::move(name), FieldType::Singleline, std::move(value));
}

FieldVariable readOnly(FieldVariable field) {
    field->isReadonly = true;
    return field;
}

FieldVariable optional(FieldVariable field, bool isSelected) {
    field->isOptional = true;
    field->isSelected = isSelected;
    return field;
}

Variable scriptAt(std::size_t location, std::size_t length, const char16_t* label, const char16_t* abbreviation,
                  SharedAttributes attributes = nullptr) {
    auto script = std::make_shared<SnippetAbbreviationVariable>();
    script->location = location;
    script->scriptLength = length;
    script->attributes = std::move(attributes);
    script->snippet = std::make_shared<Snippet>();
    script->snippet->setLabel(std::u16string(label));
    script->snippet->setAbbreviation(std::u16string(abbreviation));
    return script;
}

SnippetExpandedContent contentOf(SnippetExpandedContent::Content text, std::vector<Variable> variables) {
    SnippetExpandedContent content(std::move(text));
    content.variables = std::move(variables);
    return content;
}

std::string pageOf(const SnippetExpandedContent& content) {
    return FormPage::generateHtml(content, FormModel(content, "en_US"));
}

template <class Change>
AttributedString looking(std::u16string text, Change change) {
    auto look = std::make_shared<TextAttributes>();
    change(*look);
    return AttributedString(std::move(text), look);
}

AttributedString bold(std::u16string text) {
    return looking(std::move(text), [](TextAttributes& look) { look.font = FontAttribute{u"", 0, true, false}; });
}

AttributedString linked(std::u16string text, std::u16string link) {
    return looking(std::move(text), [&](TextAttributes& look) { look.link = link; });
}

AttributedString joined(const std::vector<AttributedString>& pieces) {
    AttributedString text;
    for (const auto& piece : pieces) text.append(piece);
    return text;
}

// The control of a line named "N" that is not the first.
std::string lineControl(const std::string& id) {
    return "<input id=\"" + id +
           "\" placeholder=\"N\" name=\"N\" type=\"text\" size=\"30\" "
           "onkeypress=\"return handleKeyUpEvent(event);\" />";
}

TEST(FormPage, HasAControlOfItsOwnForEachKindOfField) {
    const auto sized = fieldAt(0, u"Note", FieldType::Multiline, u"\na\nb");
    sized->setWidth(12);
    sized->setHeight(3);
    const auto menu = fieldAt(0, u"Colour", FieldType::PopupMenu, u"Red\n\"Blue\" & <so>\n");
    menu->defaultIndex = 1;
    struct Case {
        const char* about;
        std::size_t index;
        FieldVariable field;
        const char* html;
    };
    const Case cases[] = {
        {"line", 1, lineAt(0, u"Name", u"Ada"),
         R"(<input id="1" placeholder="Name" name="Name" type="text" value="Ada" size="30" onkeypress="return handleKeyUpEvent(event);" />)"},
        {"the first one, without a name and a value", 0, lineAt(0, u""),
         R"(<input id="0" placeholder="" name="" autofocus="autofocus" type="text" size="30" onkeypress="return handleKeyUpEvent(event);" />)"},
        {"several lines, of which the first is empty", 1, sized,
         "<textarea id=\"1\" placeholder=\"Note\" name=\"Note\" cols=\"12\" rows=\"3\" "
         "onkeypress=\"return handleKeyUpEventAlt(event);\">\n\na\nb</textarea>"},
        {"number", 2, fieldAt(0, u"n", FieldType::Number, u"2"),
         R"(<input id="2" placeholder="n" name="n" type="number" onchange="window.SnippetController.onTextInputOnChange_(event.target.id);" size="30" onkeypress="return handleKeyUpEvent(event);" />)"},
        {"menu", 1, menu,
         R"(<select id="1" placeholder="Colour" name="Colour" onkeyup="return handleKeyUpEvent(event);"> <option value="Red">Red</option><option value="&quot;Blue&quot; &amp; &lt;so&gt;" selected="selected">&quot;Blue&quot; &amp; &lt;so&gt;</option><option value=""></option> </select>)"},
        {"empty menu", 1, optional(fieldAt(0, u"m", FieldType::PopupMenu, u""), true), ""},
        {"none of the four kinds", 1, fieldAt(0, u"m", static_cast<FieldType>(9), u"x"), ""},
        {"read-only", 0, readOnly(lineAt(0, u"Name", u"it's <b>")), R"(<span id="0" >it&#39;s &lt;b&gt;</span>)"},
        {"a number that cannot be read-only", 1, readOnly(fieldAt(0, u"n", FieldType::Number, u"")),
         R"(<input id="1" placeholder="n" name="n" type="number" onchange="window.SnippetController.onTextInputOnChange_(event.target.id);" size="30" onkeypress="return handleKeyUpEvent(event);" />)"},
        {"left out", 3, optional(readOnly(lineAt(0, u"P & S", u"x")), false),
         R"(<input type="checkbox" onchange="optionalFieldCheckboxOnChange(event);" id="optional3" > <label for="optional3"> P &amp; S </label> <span style="background-color: crimson; margin-top:50px; margin-bottom:50px; padding: 5px"> <span id="3" >x</span> </span>)"},
        {"several lines, ticked", 3, optional(fieldAt(0, u"N", FieldType::Multiline, u""), true),
         R"(<input type="checkbox" onchange="optionalFieldCheckboxOnChange(event);" id="optional3" checked> <label for="optional3"> N </label> <div style="background-color: limegreen;"> <textarea id="3" placeholder="N" name="N" cols="30" rows="5" onkeypress="return handleKeyUpEventAlt(event);"></textarea> </div>)"},
    };
    for (const Case& c : cases) {
        const auto content = contentOf(std::u16string(), {c.field});
        const FormModel model(content, "en_US");
        EXPECT_EQ(FormPage::generateHtmlTextInput(model.fields()[0], c.index), c.html) << c.about;
    }
}

TEST(FormPage, HasTheTextAroundTheControls) {
    const std::string first =
        R"(<input id="0" placeholder="N" name="N" autofocus="autofocus" type="text" size="30" onkeypress="return handleKeyUpEvent(event);" />)";
    const std::string script = R"(<img src="Script.png" alt="Script">)";
    const auto list = [](TextAttributes& look) { look.paragraphStyle.emplace().textLists = {{u"{disc}", 1}}; };
    const auto caret = std::make_shared<SnippetContentCaret>();
    const auto withoutLabel = std::make_shared<SnippetAbbreviationVariable>();
    withoutLabel->abbreviation = u"abbr";
    withoutLabel->scriptLength = 1;
    struct Case {
        const char* about;
        SnippetExpandedContent content;
        std::string html;
    };
    const Case cases[] = {
        {"nothing", contentOf(std::u16string(), {}), ""},
        {"plain text", contentOf(u"Dear , hi", {lineAt(5), caret, lineAt(9)}),
         "Dear&nbsp;" + first + ", hi" + lineControl("1")},
        {"several at one place, and beyond the end", contentOf(u"ab", {lineAt(1), lineAt(1), lineAt(9)}),
         "a" + first + lineControl("1") + "b" + lineControl("2")},
        {"what plain text has of markup", contentOf(u"a < b & \"c\"\n  d\n\n", {}),
         "a &lt; b &amp; &quot;c&quot;<br>&nbsp; d<br><br>"},
        {"line breaks on both sides", contentOf(u"a\n\n\nb\r\n", {lineAt(2)}), "a<br>" + first + "<br><br>b<br>"},
        {"a line break alone", contentOf(u"\n", {lineAt(0), lineAt(1)}), first + "<br>" + lineControl("1")},
        {"nested script", contentOf(u"aCODEb", {scriptAt(1, 4, u"Say <hi>", u"x")}), "a" + script + "Say &lt;hi&gt;b"},
        {"script without a label", contentOf(u"aCODEb", {scriptAt(1, 4, u"", u"x")}), "a" + script + "xb"},
        {"script without a snippet", contentOf(u"Cb", {withoutLabel}), script + "abbrb"},
        {"nested snippet that is no script", contentOf(u"ab", {scriptAt(1, 0, u"l", u"x")}), "ab"},
        {"field in a script", contentOf(u"aCODEb", {scriptAt(1, 4, u"l", u"x"), lineAt(3), lineAt(6)}),
         "a" + script + "l" + first + "b" + lineControl("1")},
        {"script in a script", contentOf(u"aCODEb", {scriptAt(1, 4, u"l", u"x"), scriptAt(2, 1, u"m", u"y")}),
         "a" + script + "l" + script + "mb"},
        {"rich text", contentOf(joined({bold(u"Dear"), AttributedString(u" , hi")}), {lineAt(5)}),
         "<b>Dear</b>&nbsp;" + first + ", hi"},
        {"rich line breaks on both sides", contentOf(bold(u"a\n\nb"), {lineAt(2)}),
         "<b>a</b><br>" + first + "<br><b>b</b>"},
        {"script that looks like its place",
         contentOf(bold(u"C"), {scriptAt(0, 1, u"l", u"x", bold(u"x").attributesAt(0))}), script + "<b>l</b>"},
        {"lines of a list", contentOf(looking(u"\t-\ta b\n\t-\tc\n", list), {lineAt(4)}),
         "<span style=\"white-space:pre\">\t</span>-<span style=\"white-space:pre\">\t</span>a" + first +
             "&nbsp;b<br><span style=\"white-space:pre\">\t</span>-<span style=\"white-space:pre\">\t</span>c<br>"},
        {"links",
         contentOf(joined({linked(u"a", u"https://x.org/\"<"), linked(u"b", u"javascript:alert(1)"),
                           linked(u"c", u"MAILTO:a@b"), linked(u"d", u" https:x"), linked(u"e", u"data:text/html,x")}),
                   {}),
         "<a href=\"https://x.org/&quot;&lt;\">a</a>b<a href=\"MAILTO:a@b\">c</a>de"},
    };
    for (const Case& c : cases) EXPECT_EQ(pageOf(c.content), c.html) << c.about;
}

TEST(FormPage, ShowsWhatTheFormHoldsNow) {
    const auto content =
        contentOf(std::u16string(), {lineAt(0, u"Name", u"stale"), readOnly(lineAt(0, u"Name", u"stale")),
                                     optional(fieldAt(0, u"Name", FieldType::Multiline, u""), false),
                                     fieldAt(0, u"Menu", FieldType::PopupMenu, u"Red\nGreen")});
    FormModel model(content, "en_US");
    ASSERT_TRUE(model.fill(2, u"new").ok());
    ASSERT_TRUE(model.fill(3, u"Green").ok());
    const std::string html = FormPage::generateHtml(content, model);
    EXPECT_EQ(html.find("stale"), std::string::npos);
    for (const char* part : {" value=\"new\"", "<span id=\"1\" >new</span>", ">new</textarea>",
                             "\"optional2\" checked>", "<option value=\"Green\" selected=\"selected\">"}) {
        EXPECT_NE(html.find(part), std::string::npos) << part;
    }
    model.setSelected(2, false);
    EXPECT_NE(FormPage::generateHtml(content, model).find("\"optional2\" >"), std::string::npos);
}

TEST(FormPage, HasPaperUnderTextWithColours) {
    const auto coloured = [](auto set) { return contentOf(joined({bold(u"a"), looking(u"b", set)}), {}); };
    EXPECT_FALSE(FormPage::needsPaper(contentOf(u"a", {})));
    EXPECT_FALSE(FormPage::needsPaper(contentOf(bold(u"a"), {})));
    EXPECT_TRUE(FormPage::needsPaper(coloured([](TextAttributes& look) { look.foregroundColor.emplace(); })));
    EXPECT_TRUE(FormPage::needsPaper(coloured([](TextAttributes& look) { look.backgroundColor.emplace(); })));
}

// ---- Pages read as a browser reads them ----

struct Element {
    std::string tag;
    std::map<std::string, std::string> attributes;
};

struct ReadPage {
    std::vector<Element> elements;
    std::string text;  // of the page, with "\n" for <br>, without what is in controls
    std::vector<std::string> inControls;
};

// Reads HTML that is well-formed; anything else fails the test.
class PageReader {
  public:
    explicit PageReader(std::string_view html) : rest_(html) {}

    ReadPage read() {
        while (!rest_.empty()) {
            if (rest_.front() == '<') {
                readTag();
            } else {
                (control_.empty() ? page_.text : page_.inControls.back()) += readText("<");
            }
        }
        RC_ASSERT(open_.empty());
        return std::move(page_);
    }

  private:
    void readTag() {
        take("<");
        if (rest_.starts_with("/")) {
            take("/");
            RC_ASSERT(!open_.empty());
            take(open_.back() + ">");
            if (open_.back() == control_) control_.clear();
            open_.pop_back();
            return;
        }
        Element element{name(), {}};
        while (rest_.starts_with(" ")) {
            take(" ");
            if (rest_.starts_with("/>") || rest_.starts_with(">")) break;
            const std::string attribute = name();
            std::string value;
            if (rest_.starts_with("=")) {
                take("=\"");
                value = readText("\"");
                take("\"");
            }
            RC_ASSERT(element.attributes.emplace(attribute, value).second);
        }
        if (rest_.starts_with("/")) take("/");
        take(">");
        open(std::move(element));
    }

    void open(Element element) {
        static const std::set<std::string> empty = {"input", "img", "br"};
        static const std::set<std::string> controls = {"textarea", "option", "label"};
        const bool isReadonly = element.tag == "span" && element.attributes.contains("id");
        if (element.tag == "br") page_.text += '\n';
        if (!empty.contains(element.tag)) open_.push_back(element.tag);
        if (controls.contains(element.tag) || isReadonly) {
            control_ = element.tag;
            page_.inControls.emplace_back();
        }
        page_.elements.push_back(std::move(element));
    }

    std::string name() {
        const std::size_t end = std::min(rest_.find_first_not_of("abcdefghijklmnopqrstuvwxyz"), rest_.size());
        RC_ASSERT(end > 0u);
        const std::string result(rest_.substr(0, end));
        rest_.remove_prefix(end);
        return result;
    }

    std::string readText(std::string_view ends) {
        static const std::map<std::string, std::string, std::less<>> entities = {
            {"amp", "&"}, {"lt", "<"}, {"gt", ">"}, {"quot", "\""}, {"#39", "'"}, {"#13", "\r"}, {"nbsp", " "}};
        std::string text;
        while (!rest_.empty() && ends.find(rest_.front()) == std::string_view::npos) {
            const char c = rest_.front();
            rest_.remove_prefix(1);
            RC_ASSERT(c != '<' && c != '>' && c != '\0' && c != '\r');
            if (c != '&') {
                text += c;
                continue;
            }
            const auto entity = entities.find(rest_.substr(0, rest_.find(';')));
            RC_ASSERT(entity != entities.end());
            text += entity->second;
            rest_.remove_prefix(entity->first.size() + 1);
        }
        return text;
    }

    void take(std::string_view expected) {
        RC_ASSERT(rest_.starts_with(expected));
        rest_.remove_prefix(expected.size());
    }

    std::string_view rest_;
    ReadPage page_;
    std::vector<std::string> open_;
    std::string control_;  // what encloses the text that is being read
};

// As far as HTML can hold it: without the control characters that browsers do not take, and with what stands for those
// that cannot be.
std::string inPage(std::u16string_view text) {
    return toUtf8(replacingAll(text, std::u16string_view(u"\0", 1), u"\ufffd"));
}

const std::u16string HostilePieces[] = {u"<script>alert(1)</script>",
                                        u"\" onclick=\"x",
                                        u"' onload='x",
                                        u"</textarea>",
                                        u"</span></select></option>",
                                        u"<!--",
                                        u"-->",
                                        u"&amp;",
                                        u"&",
                                        u"&#0;",
                                        u"&lt",
                                        u"javascript:x",
                                        u"\r",
                                        std::u16string(1, u'\0'),
                                        u"\xd800",
                                        u"\xdc00",
                                        u"\u2028",
                                        u"\u202e",
                                        u"\u05d0\u0627",
                                        u"\U0001f600",
                                        u"%1 %@ %n",
                                        u"`${x}`",
                                        u"]]>",
                                        u"=",
                                        u"/",
                                        u">",
                                        u" ",
                                        u"a"};

rc::Gen<std::u16string> hostileTexts() {
    const auto piece =
        rc::gen::elementOf(std::vector<std::u16string>(std::begin(HostilePieces), std::end(HostilePieces)));
    return rc::gen::map(rc::gen::container<std::vector<std::u16string>>(piece), [](const auto& pieces) {
        std::u16string text;
        for (const auto& each : pieces) text += each;
        return text;
    });
}

// An attribute's name, and what its value has to be; empty for any.
void expectOnlyWhatIsWritten(const ReadPage& page) {
    static const std::map<std::string, std::set<std::string>> written = {
        {"input",
         {"id", "placeholder", "name", "autofocus", "type", "value", "size", "onkeypress", "onchange", "checked"}},
        {"textarea", {"id", "placeholder", "name", "autofocus", "cols", "rows", "onkeypress"}},
        {"select", {"id", "placeholder", "name", "autofocus", "onkeyup"}},
        {"option", {"value", "selected"}},
        {"label", {"for"}},
        {"div", {"style"}},
        {"span", {"id", "style"}},
        {"img", {"src", "alt"}},
        {"b", {}},
        {"a", {"href"}},
        {"br", {}}};
    static const std::set<std::string> calls = {"return handleKeyUpEvent(event);", "return handleKeyUpEventAlt(event);",
                                                "optionalFieldCheckboxOnChange(event);",
                                                "window.SnippetController.onTextInputOnChange_(event.target.id);"};
    for (const Element& element : page.elements) {
        RC_ASSERT(written.contains(element.tag));
        for (const auto& [name, value] : element.attributes) {
            RC_ASSERT(written.at(element.tag).contains(name));
            if (name.starts_with("on")) RC_ASSERT(calls.contains(value));
            if (name == "href") RC_ASSERT(value.starts_with("https:"));
            if (name == "src") RC_ASSERT(value == "Script.png");
        }
    }
}

RC_GTEST_PROP(FormPage, HoldsNothingButWhatItWritesItself, ()) {
    const std::u16string before = *hostileTexts();
    const std::u16string after = *hostileTexts();
    const std::u16string name = *hostileTexts();
    const std::u16string value = *hostileTexts();
    const std::u16string label = u"l" + *hostileTexts();
    const auto type = *rc::gen::element(FieldType::Singleline, FieldType::Multiline, FieldType::PopupMenu);
    auto field = fieldAt(before.size(), name, type, value);
    field->isOptional = *rc::gen::arbitrary<bool>();
    field->isReadonly = *rc::gen::arbitrary<bool>();
    const auto link = *rc::gen::element<std::u16string>(u"", u"https:", u"javascript:") + *hostileTexts();
    SnippetExpandedContent::Content text = before + after;
    if (*rc::gen::arbitrary<bool>()) text = joined({linked(before, link), bold(after)});
    const auto content = contentOf(std::move(text), {field, scriptAt(before.size(), 0, u"", u""),
                                                     scriptAt(before.size() + after.size(), 1, label.c_str(), u"x")});
    const std::string html = pageOf(content);
    RC_ASSERT(fromStrictUtf8(html).has_value());

    const ReadPage page = PageReader(html).read();
    expectOnlyWhatIsWritten(page);
    for (const Element& element : page.elements) {
        if (!element.attributes.contains("placeholder")) continue;
        RC_ASSERT(element.attributes.at("name") == inPage(name));
        if (element.tag == "input" && !value.empty()) RC_ASSERT(element.attributes.at("value") == inPage(value));
    }
    const bool isMenu = type == FieldType::PopupMenu;
    if (field->isOptional && !(isMenu && value.empty())) {
        RC_ASSERT(page.inControls.front() == " " + inPage(name) + " ");
    }
    if (isMenu ? !value.empty() : type == FieldType::Multiline || field->isReadonly) {
        RC_ASSERT(page.inControls.back() == inPage(value));
    }
    // Line breaks may be written in three ways, and are one.
    const auto asLines = [](std::u16string all) {
        for (const char16_t* end : {u"\r", u"\u2028"}) all = replacingAll(all, end, u"\n");
        return inPage(all);
    };
    std::string shown = page.text;
    std::erase(shown, ' ');
    std::string expected = asLines(before) + asLines(after);
    std::erase(expected, ' ');
    RC_ASSERT(shown.starts_with(expected));
}

TEST(FormPage, TakesLongTexts) {
    const std::u16string text(std::size_t{1} << 20, u'<');
    const auto content = contentOf(text, {lineAt(text.size(), text, text), fieldAt(5, text, FieldType::PopupMenu, text),
                                          fieldAt(text.size(), u"", FieldType::Multiline, text)});
    EXPECT_EQ(pageOf(content).size() / (text.size() * 4), 9u) << "each time it is written once, not more";
}

}  // namespace
}  // namespace plume
