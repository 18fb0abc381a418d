#include "app/search/QuickSearchModel.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include "app/FirstLine.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr std::size_t Digits = 10;

QList<Range> toList(const std::vector<Range>& ranges) {
    return {ranges.begin(), ranges.end()};
}

}  // namespace

void QuickSearchModel::setResults(std::vector<RankedSnippet> results, std::u16string query, const SearchRule& rule) {
    beginResetModel();
    results_ = std::move(results);
    query_ = std::move(query);
    rule_ = rule;
    const auto firstLoose = std::ranges::find_if(results_, &RankedSnippet::isLoose);
    dividerRow_ = firstLoose == results_.end() ? -1 : static_cast<int>(firstLoose - results_.begin());
    endResetModel();
}

void QuickSearchModel::setSelectorKeyModifier(std::int64_t modifier) {
    beginResetModel();
    selectorKeyModifier_ = modifier;
    endResetModel();
}

std::size_t QuickSearchModel::indexOf(int row) const {
    const bool isBelow = dividerRow_ >= 0 && row > dividerRow_;
    return static_cast<std::size_t>(isBelow ? row - 1 : row);
}

std::shared_ptr<Snippet> QuickSearchModel::snippetAt(int row) const {
    return row < 0 || isDivider(row) ? nullptr : snippetAtIndex(indexOf(row));
}

std::shared_ptr<Snippet> QuickSearchModel::snippetAtIndex(std::size_t index) const {
    return index < results_.size() ? results_[index].snippet : nullptr;
}

std::vector<std::shared_ptr<Snippet>> QuickSearchModel::firstSnippets(std::size_t count) const {
    std::vector<std::shared_ptr<Snippet>> snippets;
    for (const RankedSnippet& result : results_) {
        if (snippets.size() == count) break;
        snippets.push_back(result.snippet);
    }
    return snippets;
}

int QuickSearchModel::rowCount(const QModelIndex& parent) const {
    if (parent.isValid()) return 0;
    return static_cast<int>(results_.size()) + (dividerRow_ >= 0 ? 1 : 0);
}

Qt::ItemFlags QuickSearchModel::flags(const QModelIndex& index) const {
    if (!index.isValid()) return Qt::NoItemFlags;
    if (isDivider(index.row())) return Qt::ItemNeverHasChildren;
    return Qt::ItemIsSelectable | Qt::ItemIsEnabled | Qt::ItemNeverHasChildren;
}

QVariant QuickSearchModel::data(const QModelIndex& index, int role) const {
    if (!index.isValid()) return {};
    switch (role) {
        case SnippetRow::Role:
            return QVariant::fromValue(shownAt(index.row()));
        case Qt::DisplayRole:
            return isDivider(index.row()) ? tr("Similar") : shownAt(index.row()).abbreviation.text;
        case Qt::AccessibleTextRole:
            return isDivider(index.row()) ? tr("Similar") : shownAt(index.row()).spoken();
        default:
            return {};
    }
}

SnippetRow QuickSearchModel::shownAt(int row) const {
    SnippetRow shown;
    if (isDivider(row)) {
        shown.isDivider = true;
        shown.label.text = tr("Similar");
        return shown;
    }
    const std::size_t index = indexOf(row);
    const RankedSnippet& result = results_[index];
    const Snippet& snippet = *result.snippet;
    const auto& rich = snippet.richTextContent();
    const auto marked = [&](const std::u16string& text, std::int64_t field) -> MarkedText {
        const bool isSearched = (rule_.searchBy & field) != 0;
        return {inOneLine(text), isSearched ? toList(highlights(text, query_, rule_, result.isLoose)) : QList<Range>()};
    };
    shown.abbreviation = marked(snippet.abbreviationWithPrefix().value_or(u""), SearchRule::Abbreviation);
    shown.label = marked(snippet.label().value_or(u""), SearchRule::Label);
    shown.content = marked(rich ? firstLine(rich->string()) : std::u16string(), SearchRule::Content);
    shown.group = inOneLine(result.group->name().value_or(u""));
    const char16_t digit = index < Digits ? static_cast<char16_t>(u'0' + (index + 1) % Digits) : u'\0';
    shown.shortcut = digitShortcut(digit, selectorKeyModifier_);
    return shown;
}

}  // namespace plume
