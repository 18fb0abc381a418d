#include "app/editor/GroupEditor.h"

#include <QCheckBox>
#include <QFormLayout>
#include <QFrame>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QScrollArea>
#include <QSignalBlocker>
#include <QVBoxLayout>
#include <algorithm>

#include "app/editor/CaseReset.h"
#include "app/editor/ChoiceBox.h"
#include "app/editor/DelimitersEdit.h"
#include "app/editor/GroupEffect.h"
#include "app/editor/InputSourcesEdit.h"
#include "app/editor/TypedLine.h"
#include "app/preferences/ApplicationList.h"
#include "app/qt/Labels.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr int WidestForm = 100;  // characters
constexpr int NarrowestChoice = 16;
constexpr int EffectLines = 2;

QLabel* makeEffect() {
    QLabel* label = makeTextLabel();
    // One line more is kept free for it, so that the fields seldom move.
    label->setMinimumHeight(label->fontMetrics().lineSpacing() * EffectLines);
    label->setAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    return label;
}

// A frame that tells it from the fields.
QWidget* framed(QLabel* effect) {
    auto* frame = new QFrame;
    frame->setFrameShape(QFrame::StyledPanel);
    frame->setBackgroundRole(QPalette::AlternateBase);
    frame->setAutoFillBackground(true);
    auto* layout = new QVBoxLayout(frame);
    layout->addWidget(effect);
    return frame;
}

bool isOneOf(std::int64_t option, std::int64_t first, std::int64_t second) {
    return option == first || option == second;
}

}  // namespace

GroupEditor::GroupEditor(GroupEditorServices services, QWidget* parent)
    : QWidget(parent),
      services_(std::move(services)),
      programs_(services_.applications),
      effect_(makeEffect()),
      area_(new QScrollArea) {
    auto* fields = new QWidget;
    fields->setMaximumWidth(fontMetrics().averageCharWidth() * WidestForm);
    form_ = new QFormLayout(fields);
    form_->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    form_->setLabelAlignment(Qt::AlignLeft | Qt::AlignTop);
    form_->setFormAlignment(Qt::AlignLeft | Qt::AlignTop);
    addNames();
    addExpansion();
    addNewSnippets();
    addWhere();

    area_->setWidget(fields);
    area_->setWidgetResizable(true);
    area_->setFrameShape(QFrame::NoFrame);
    area_->setFocusPolicy(Qt::NoFocus);
    area_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(framed(effect_));
    layout->addWidget(area_, 1);
    show(nullptr);
}

// What loses the keyboard when it goes with the editor would tell so.
GroupEditor::~GroupEditor() {
    for (QWidget* control : findChildren<QWidget*>()) control->disconnect(this);
}

void GroupEditor::show(const std::shared_ptr<SnippetGroup>& group) {
    if (group == group_ && group) return refresh();
    finish();
    group_ = group;
    area_->setEnabled(group != nullptr);
    if (group && services_.inputSources) inputSources_->setKnown(services_.inputSources());
    refresh();
}

void GroupEditor::refresh() {
    static const std::shared_ptr<SnippetGroup> nothing = SnippetGroup::make();
    const SnippetGroup& shown = group_ ? *group_ : *nothing;
    showValues(shown);
    showWhatMatters(shown);
}

void GroupEditor::finish() {
    for (auto* line : findChildren<TypedLine*>()) line->finish();
}

void GroupEditor::showValues(const SnippetGroup& group) {
    for (const auto& showValue : shows_) showValue(group);
}

// Fields that mean nothing now are out of the way; what is in them is kept.
void GroupEditor::showWhatMatters(const SnippetGroup& group) {
    const std::int64_t availability = group.availability().availability;
    const bool hasList =
        isOneOf(availability, PLFunctionAvailability::ExceptListed, PLFunctionAvailability::OnlyListed);
    const bool isOnDelimiter = group.expandTrigger() == ExpandTrigger::DelimiterKept ||
                               group.expandTrigger() == ExpandTrigger::DelimiterSwallowed;
    form_->setRowVisible(before_, group.expandAfter() == ExpandAfter::Delimiter);
    form_->setRowVisible(behind_, isOnDelimiter);
    form_->setRowVisible(applications_, hasList);
    applications_->setTitle(availability == PLFunctionAvailability::OnlyListed ? tr("Enabled") : tr("Ignored"));
    reset_->setEnabled(!group.items().empty());
    if (!group_) return effect_->clear();
    effect_->setText(effectOf(
        group, [this](const std::u16string& identifier) { return programs_.nameOf(identifier); },
        [this](const std::u16string& identifier) { return inputSources_->nameOf(identifier); }));
}

// It may have been deleted while one typed.
bool GroupEditor::isListed() const {
    const SnippetGroups& groups = services_.editor.groups();
    return group_ && std::find(groups.begin(), groups.end(), group_) != groups.end();
}

void GroupEditor::change(const Change& change) {
    if (!isListed()) return;
    services_.editor.changeSettings(group_, change);
    if (group_) showWhatMatters(*group_);
}

void GroupEditor::askForReset() {
    finish();
    askForCaseReset(this, group_->caseSensitivity(), [this, asked = group_](CaseSensitivity value) {
        if (asked == group_ && isListed()) services_.editor.resetSnippetCaseSensitivity(group_, value);
    });
}

// ---- Fields ----

void GroupEditor::addNames() {
    auto* name = new TypedLine;
    addField(tr("Name:"), name);
    shows_.emplace_back([name](const SnippetGroup& group) { name->showText(group.name().value_or(u"")); });
    connect(name, &TypedLine::edited, this, [this](const std::u16string& text) {
        if (isListed()) services_.editor.setName(group_, text);
    });
    auto* prefix = new TypedLine;
    prefix->setPlaceholderText(tr("Optional: typed before every abbreviation"));
    addField(tr("Prefix:"), prefix);
    shows_.emplace_back(
        [prefix](const SnippetGroup& group) { prefix->showText(group.abbreviationPrefix().value_or(u"")); });
    connect(prefix, &TypedLine::edited, this, [this](const std::u16string& text) {
        change([&](SnippetGroup& group) {
            group.setAbbreviationPrefix(text.empty() ? std::nullopt : SnippetGroup::Text(text));
        });
    });
}

void GroupEditor::addExpansion() {
    addHeading(tr("Expansion"));
    addChoice(
        tr("Expands behind:"), {tr("A delimiter"), tr("White space"), tr("Anything, even a letter"), tr("A number")},
        [](const SnippetGroup& group) { return static_cast<std::int64_t>(group.expandAfter()); },
        [](SnippetGroup& group, std::int64_t value) { group.setExpandAfter(static_cast<ExpandAfter>(value)); });
    before_ = addDelimiters(
        tr("Delimiters before it:"), [](const SnippetGroup& group) { return group.expandAfterDelimiters(); },
        [](SnippetGroup& group, const auto& set) { group.setExpandAfterDelimiters(set); });
    addChoice(
        tr("Expands:"),
        {tr("At once, with its last character"), tr("With a delimiter, which stays"),
         tr("With a delimiter, which is left out"), tr("Never by typing"), tr("With the hot key that expands")},
        [](const SnippetGroup& group) { return static_cast<std::int64_t>(group.expandTrigger()); },
        [](SnippetGroup& group, std::int64_t value) { group.setExpandTrigger(static_cast<ExpandTrigger>(value)); });
    behind_ = addDelimiters(
        tr("Delimiters behind it:"), [](const SnippetGroup& group) { return group.delimiters(); },
        [](SnippetGroup& group, const auto& set) { group.setDelimiters(set); });
    addCheckBox(
        tr("Offer as suggestions"), [](const SnippetGroup& group) { return group.suggestAbbreviations(); },
        [](SnippetGroup& group, bool value) { group.setSuggestAbbreviations(value); });
    addCheckBox(
        tr("List in the menu"), [](const SnippetGroup& group) { return group.showInMenuBar(); },
        [](SnippetGroup& group, bool value) { group.setShowInMenuBar(value); });
    addCheckBox(
        tr("Reset the formatting behind a formatted text"),
        [](const SnippetGroup& group) { return group.resetFormatting(); },
        [](SnippetGroup& group, bool value) { group.setResetFormatting(value); });
}

void GroupEditor::addNewSnippets() {
    addHeading(tr("Letter case"));
    ChoiceBox* box = addChoice(
        tr("New snippets:"), caseSensitivityNames(),
        [](const SnippetGroup& group) { return static_cast<std::int64_t>(group.caseSensitivity()); },
        [](SnippetGroup& group, std::int64_t value) { group.setCaseSensitivity(static_cast<CaseSensitivity>(value)); });
    box->setAccessibleName(tr("Letter case of new snippets"));
    reset_ = new QPushButton(tr("Reset…"));
    reset_->setAccessibleName(tr("Reset the letter case of all snippets"));
    auto* row = new QHBoxLayout;
    row->addWidget(reset_);
    row->addStretch(1);
    auto* name = new QLabel(tr("All snippets:"));
    name->setBuddy(reset_);
    form_->addRow(name, row);
    connect(reset_, &QPushButton::clicked, this, &GroupEditor::askForReset);
}

void GroupEditor::addWhere() {
    addHeading(tr("Where"));
    addPrograms();
    addKeyboards();
}

void GroupEditor::addPrograms() {
    addChoice(
        tr("Programs:"),
        {tr("In all programs"), tr("In all programs except those below"), tr("Only in the programs below")},
        [](const SnippetGroup& group) { return group.availability().availability; },
        [](SnippetGroup& group, std::int64_t value) { group.availability().availability = value; });
    applications_ = new ApplicationList(services_.applications, programs_);
    form_->addRow(QString(), applications_);
    shows_.emplace_back([list = applications_](const SnippetGroup& group) {
        list->setIdentifiers(group.availability().applications.value_or(ApplicationList::Identifiers()));
    });
    connect(applications_, &ApplicationList::edited, this, [this](const ApplicationList::Identifiers& identifiers) {
        change([&](SnippetGroup& group) { group.availability().applications = identifiers; });
    });
}

void GroupEditor::addKeyboards() {
    inputSources_ = new InputSourcesEdit;
    addField(tr("Keyboard layouts:"), inputSources_);
    shows_.emplace_back([edit = inputSources_](const SnippetGroup& group) {
        const PLFunctionAvailability& where = group.availability();
        edit->setSources(where.inputMethodsOption, where.inputMethods.value_or(InputSourcesEdit::Identifiers()));
    });
    connect(inputSources_, &InputSourcesEdit::optionChanged, this, [this](std::int64_t option) {
        change([&](SnippetGroup& group) { group.availability().inputMethodsOption = option; });
    });
    connect(inputSources_, &InputSourcesEdit::identifiersChanged, this,
            [this](const InputSourcesEdit::Identifiers& identifiers) {
                change([&](SnippetGroup& group) { group.availability().inputMethods = identifiers; });
            });
}

void GroupEditor::addHeading(const QString& text) {
    QLabel* heading = makeSectionTitle(text);
    heading->setContentsMargins(0, fontMetrics().height() / 2, 0, 0);
    form_->addRow(heading);
}

void GroupEditor::addField(const QString& label, QWidget* field) {
    auto* name = new QLabel(label);
    name->setBuddy(field);
    // Level with the field's first line, however high the row is.
    const QWidget* control = field->focusProxy() ? field->focusProxy() : field;
    name->setFixedHeight(control->sizeHint().height());
    form_->addRow(name, field);
    QString words = label;
    words.remove(QLatin1Char(':'));
    if (field->accessibleName().isEmpty()) field->setAccessibleName(words);
}

ChoiceBox* GroupEditor::addChoice(const QString& label, const QStringList& choices,
                                  const std::function<std::int64_t(const SnippetGroup&)>& value,
                                  const std::function<void(SnippetGroup&, std::int64_t)>& set) {
    auto* box = new ChoiceBox(choices);
    box->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    box->setMinimumContentsLength(NarrowestChoice);
    addField(label, box);
    shows_.emplace_back([box, value](const SnippetGroup& group) { box->showValue(value(group)); });
    connect(box, &ChoiceBox::chosen, this,
            [this, set](std::int64_t chosen) { change([&](SnippetGroup& group) { set(group, chosen); }); });
    return box;
}

DelimitersEdit* GroupEditor::addDelimiters(const QString& label,
                                           const std::function<std::optional<CharacterSet>(const SnippetGroup&)>& value,
                                           const std::function<void(SnippetGroup&, std::optional<CharacterSet>)>& set) {
    auto* edit = new DelimitersEdit(label);
    addField(label, edit);
    shows_.emplace_back([edit, value](const SnippetGroup& group) { edit->setDelimiters(value(group)); });
    connect(edit, &DelimitersEdit::changed, this, [this, set](const std::optional<CharacterSet>& delimiters) {
        change([&](SnippetGroup& group) { set(group, delimiters); });
    });
    return edit;
}

void GroupEditor::addCheckBox(const QString& label, const std::function<bool(const SnippetGroup&)>& value,
                              const std::function<void(SnippetGroup&, bool)>& set) {
    auto* box = new QCheckBox(label);
    form_->addRow(QString(), box);
    shows_.emplace_back([box, value](const SnippetGroup& group) {
        const QSignalBlocker quiet(box);
        box->setChecked(value(group));
    });
    connect(box, &QCheckBox::toggled, this,
            [this, set](bool isOn) { change([&](SnippetGroup& group) { set(group, isOn); }); });
}

}  // namespace plume
