#include "app/editor/FormatBar.h"

#include <QActionGroup>
#include <QColorDialog>
#include <QComboBox>
#include <QFile>
#include <QFileDialog>
#include <QFileInfo>
#include <QFontComboBox>
#include <QImageReader>
#include <QInputDialog>
#include <QLineEdit>
#include <QMenu>
#include <QPixmap>
#include <QSignalBlocker>
#include <QToolButton>
#include <algorithm>
#include <memory>
#include <utility>

#include "app/editor/ContentEdit.h"
#include "app/qt/Messages.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr int Sizes[] = {8, 9, 10, 11, 12, 14, 16, 18, 20, 24, 28, 36, 48, 72};
constexpr double LargestSize = 400;
constexpr qint64 LargestPicture = qint64{16} * 1024 * 1024;

struct NamedColor {
    const char* name;
    ColorAttribute color;
};
constexpr NamedColor NamedColors[] = {
    {QT_TRANSLATE_NOOP("plume::FormatBar", "Red"), {0.8, 0.1, 0.1, 1}},
    {QT_TRANSLATE_NOOP("plume::FormatBar", "Orange"), {0.95, 0.6, 0.1, 1}},
    {QT_TRANSLATE_NOOP("plume::FormatBar", "Yellow"), {1, 0.9, 0.3, 1}},
    {QT_TRANSLATE_NOOP("plume::FormatBar", "Green"), {0.2, 0.65, 0.3, 1}},
    {QT_TRANSLATE_NOOP("plume::FormatBar", "Blue"), {0.15, 0.4, 0.85, 1}},
    {QT_TRANSLATE_NOOP("plume::FormatBar", "Purple"), {0.55, 0.25, 0.7, 1}},
    {QT_TRANSLATE_NOOP("plume::FormatBar", "Gray"), {0.5, 0.5, 0.5, 1}},
};

QColor asQColor(const ColorAttribute& color) {
    const auto part = [](double value) { return static_cast<float>(std::clamp(value, 0.0, 1.0)); };
    return QColor::fromRgbF(part(color.red), part(color.green), part(color.blue), part(color.alpha));
}

QIcon swatch(const ColorAttribute& color, int side) {
    QPixmap picture(side, side);
    picture.fill(asQColor(color));
    return QIcon(picture);
}

// The text's own size where it says none.
double shownSize(const FontAttribute& font, const ContentEdit& edit) {
    return font.size > 0 ? font.size : edit.font().pointSizeF();
}

bool isBold(const TextAttributes& look) {
    return look.font && look.font->bold;
}
bool isItalic(const TextAttributes& look) {
    return look.font && look.font->italic;
}

}  // namespace

FormatBar::FormatBar(ContentEdit& edit) : edit_(edit) {
    setWindowTitle(tr("Format"));
    setToolButtonStyle(Qt::ToolButtonTextOnly);
    addFontControls();
    addLookActions();
    addSeparator();
    addParagraphActions();
    addSeparator();
    addInsertActions();
    connect(&edit_, &ContentEdit::lookChanged, this, &FormatBar::showState);
    showState();
}

// ---- Controls ----

void FormatBar::addFontControls() {
    family_ = new QFontComboBox;
    family_->setAccessibleName(tr("Font"));
    family_->setToolTip(tr("Font"));
    family_->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    constexpr int FamilyLetters = 12;
    family_->setMinimumContentsLength(FamilyLetters);
    addWidget(family_);
    connect(family_, &QComboBox::textActivated, this, [this](const QString& family) {
        changeFont([name = fromQString(family)](FontAttribute& font) { font.family = name; });
    });
    size_ = new QComboBox;
    size_->setEditable(true);
    size_->setInsertPolicy(QComboBox::NoInsert);
    size_->setAccessibleName(tr("Font size"));
    size_->setToolTip(tr("Font size"));
    constexpr int SizeLetters = 4;
    size_->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    size_->setMinimumContentsLength(SizeLetters);
    for (const int size : Sizes) size_->addItem(QString::number(size));
    addWidget(size_);
    connect(size_, &QComboBox::textActivated, this, &FormatBar::setSize);
    connect(size_->lineEdit(), &QLineEdit::returnPressed, this, [this] { setSize(size_->currentText()); });
}

QAction* FormatBar::addCommand(const QString& name, const QString& sign, const QKeySequence& shortcut) {
    auto* const action = new QAction(name, this);
    action->setIconText(sign);
    action->setShortcut(shortcut);
    action->setShortcutContext(Qt::WidgetShortcut);
    const QString keys = shortcut.toString(QKeySequence::NativeText);
    action->setToolTip(keys.isEmpty() ? name : QStringLiteral("%1 (%2)").arg(name, keys));
    addAction(action);
    widgetForAction(action)->setFocusPolicy(Qt::TabFocus);
    // Those that look at the sign alone do not say what it is.
    static_cast<QToolButton*>(widgetForAction(action))->setAccessibleName(name);
    if (!shortcut.isEmpty()) edit_.addAction(action);
    return action;
}

QAction* FormatBar::addToggle(const QString& name, const QString& sign, const QKeySequence& shortcut) {
    QAction* const action = addCommand(name, sign, shortcut);
    action->setCheckable(true);
    return action;
}

QMenu* FormatBar::addMenuButton(const QString& name, const QString& sign) {
    auto* const button = new QToolButton;
    button->setText(sign);
    button->setToolTip(name);
    button->setAccessibleName(name);
    button->setPopupMode(QToolButton::InstantPopup);
    button->setFocusPolicy(Qt::TabFocus);
    auto* const menu = new QMenu(button);
    button->setMenu(menu);
    addWidget(button);
    return menu;
}

void FormatBar::setSignFont(QAction* action, const std::function<void(QFont& font)>& change) {
    QFont font = this->font();
    change(font);
    widgetForAction(action)->setFont(font);
}

void FormatBar::addLookActions() {
    bold_ = addToggle(tr("Bold"), tr("B", "sign for bold"), QKeySequence::Bold);
    setSignFont(bold_, [](QFont& font) { font.setBold(true); });
    italic_ = addToggle(tr("Italic"), tr("I", "sign for italic"), QKeySequence::Italic);
    setSignFont(italic_, [](QFont& font) { font.setItalic(true); });
    underline_ = addToggle(tr("Underline"), tr("U", "sign for underline"), QKeySequence::Underline);
    setSignFont(underline_, [](QFont& font) { font.setUnderline(true); });
    strike_ = addToggle(tr("Strikethrough"), tr("S", "sign for strikethrough"));
    setSignFont(strike_, [](QFont& font) { font.setStrikeOut(true); });
    connect(bold_, &QAction::triggered, this,
            [this](bool isOn) { changeFont([isOn](FontAttribute& font) { font.bold = isOn; }); });
    connect(italic_, &QAction::triggered, this,
            [this](bool isOn) { changeFont([isOn](FontAttribute& font) { font.italic = isOn; }); });
    connect(underline_, &QAction::triggered, this, [this](bool isOn) {
        edit_.changeAttributes([isOn](TextAttributes& look) { look.underlineStyle = isOn ? 1 : 0; });
    });
    connect(strike_, &QAction::triggered, this, [this](bool isOn) {
        edit_.changeAttributes([isOn](TextAttributes& look) { look.strikethroughStyle = isOn ? 1 : 0; });
    });
    addColorMenu(tr("Text color"), tr("Color"), &TextAttributes::foregroundColor);
    addColorMenu(tr("Background color"), tr("Marker"), &TextAttributes::backgroundColor);
}

void FormatBar::addColorMenu(const QString& name, const QString& sign, Color color) {
    QMenu* const menu = addMenuButton(name, sign);
    menu->addAction(tr("None", "color"), this, [this, color] { setColor(color, std::nullopt); });
    menu->addSeparator();
    const int side = fontMetrics().height();
    for (const NamedColor& each : NamedColors) {
        menu->addAction(swatch(each.color, side), tr(each.name), this,
                        [this, color, value = each.color] { setColor(color, value); });
    }
    menu->addSeparator();
    menu->addAction(tr("Other…", "color"), this, [this, color] { chooseColor(color); });
}

void FormatBar::addParagraphActions() {
    bullets_ = addToggle(tr("Bulleted list"), QStringLiteral("\u2022 \u2014"));
    numbers_ = addToggle(tr("Numbered list"), QStringLiteral("1. \u2014"));
    connect(bullets_, &QAction::triggered, this, [this] { edit_.toggleList(ListMarker::Bullets); });
    connect(numbers_, &QAction::triggered, this, [this] { edit_.toggleList(ListMarker::Numbers); });
    addAlignments();
}

void FormatBar::addAlignments() {
    QMenu* const menu = addMenuButton(tr("Alignment"), tr("Align"));
    auto* const group = new QActionGroup(menu);
    const std::pair<TextAlignment, QString> choices[] = {
        {TextAlignment::Left, tr("Left")},
        {TextAlignment::Right, tr("Right")},
        {TextAlignment::Center, tr("Centered")},
        {TextAlignment::Justified, tr("Justified")},
    };
    for (const auto& [alignment, name] : choices) {
        QAction* const action = menu->addAction(name, this, [this, chosen = alignment] {
            edit_.changeStyle([chosen](ParagraphStyle& style) { style.alignment = chosen; });
        });
        action->setCheckable(true);
        group->addAction(action);
        alignments_.append(action);
    }
}

void FormatBar::addInsertActions() {
    QAction* const link = addCommand(tr("Link…"), tr("Link"), QKeySequence(Qt::CTRL | Qt::Key_K));
    connect(link, &QAction::triggered, this, &FormatBar::askForLink);
    QAction* const picture = addCommand(tr("Picture…"), tr("Picture"));
    connect(picture, &QAction::triggered, this, &FormatBar::choosePicture);
    QAction* const clear = addCommand(tr("Clear formatting"), tr("Clear"), QKeySequence(Qt::CTRL | Qt::Key_Backslash));
    connect(clear, &QAction::triggered, this, &FormatBar::clearFormats);
}

// ---- Changes ----

void FormatBar::changeFont(const std::function<void(FontAttribute& font)>& change) {
    edit_.changeAttributes([&change](TextAttributes& look) {
        FontAttribute font = look.font.value_or(FontAttribute{u"", 0, false, false});
        change(font);
        const bool saysSomething = font != FontAttribute{u"", 0, false, false};
        look.font = saysSomething ? std::optional(std::move(font)) : std::nullopt;
    });
}

void FormatBar::setSize(const QString& text) {
    bool isNumber = false;
    const double size = locale().toDouble(text, &isNumber);
    if (isNumber && size >= 1 && size <= LargestSize) {
        changeFont([size](FontAttribute& font) { font.size = size; });
    }
    showState();
}

void FormatBar::setColor(Color color, const std::optional<ColorAttribute>& value) {
    edit_.changeAttributes([color, &value](TextAttributes& look) { look.*color = value; });
}

void FormatBar::chooseColor(Color color) {
    auto* const dialog = new QColorDialog(this);
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    const TextAttributes look = edit_.attributesAtCaret();
    if (look.*color) dialog->setCurrentColor(asQColor(*(look.*color)));
    connect(dialog, &QColorDialog::colorSelected, this, [this, color](const QColor& chosen) {
        setColor(color, ColorAttribute{chosen.redF(), chosen.greenF(), chosen.blueF(), chosen.alphaF()});
    });
    dialog->open();
}

void FormatBar::askForLink() {
    auto* const dialog = new QInputDialog(this);
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    dialog->setWindowTitle(tr("Link"));
    dialog->setLabelText(tr("Address (empty for no link):"));
    dialog->setTextValue(toQString(edit_.attributesAtCaret().link.value_or(u"https://")));
    connect(dialog, &QInputDialog::textValueSelected, this, &FormatBar::setLink);
    dialog->open();
}

void FormatBar::setLink(const QString& address) {
    const std::u16string link = fromQString(address.trimmed());
    const std::optional<std::u16string> value =
        link.empty() || link == u"https://" ? std::nullopt : std::optional(link);
    const auto change = [&value](TextAttributes& look) { look.link = value; };
    if (edit_.textCursor().hasSelection() || !value) return edit_.changeAttributes(change);
    // Without a selection the address is its own text.
    TextAttributes look = edit_.attributesAtCaret();
    change(look);
    edit_.insertRich(AttributedString(link, std::make_shared<const TextAttributes>(std::move(look))));
}

void FormatBar::choosePicture() {
    auto* const dialog = new QFileDialog(this, tr("Picture"));
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    dialog->setFileMode(QFileDialog::ExistingFile);
    dialog->setNameFilter(tr("Pictures (*.png *.jpg *.jpeg *.gif *.bmp *.webp *.svg)"));
    connect(dialog, &QFileDialog::fileSelected, this, [this](const QString& path) {
        QFile file(path);
        const bool isRead = file.open(QIODevice::ReadOnly) && file.size() <= LargestPicture;
        const QByteArray bytes = isRead ? file.readAll() : QByteArray();
        if (isRead && !QImageReader(path).read().isNull()) return insertPicture(QFileInfo(path).fileName(), bytes);
        tell(this, tr("The picture cannot be inserted."),
             file.size() > LargestPicture ? tr("Pictures may have up to 16 MB.")
                                          : tr("The file cannot be read as a picture."));
    });
    dialog->open();
}

void FormatBar::insertPicture(const QString& fileName, const QByteArray& bytes) {
    TextAttributes look = edit_.attributesAtCaret();
    look.attachment =
        std::make_shared<const TextAttachment>(TextAttachment{fromQString(fileName), bytes.toStdString(), {}});
    edit_.insertRich(AttributedString(u"\uFFFC", std::make_shared<const TextAttributes>(std::move(look))));
}

// Links and files say more than how something looks.
void FormatBar::clearFormats() {
    edit_.changeAttributes([](TextAttributes& look) {
        TextAttributes plain;
        plain.link = std::move(look.link);
        plain.toolTip = std::move(look.toolTip);
        plain.paragraphStyle = std::move(look.paragraphStyle);
        plain.attachment = std::move(look.attachment);
        look = std::move(plain);
    });
}

// ---- State ----

void FormatBar::showState() {
    const TextAttributes look = edit_.attributesAtCaret();
    const ParagraphStyle style = edit_.styleAtCaret();
    const FontAttribute font = look.font.value_or(FontAttribute{u"", 0, false, false});
    const QString family = font.family.empty() ? edit_.font().family() : toQString(font.family);
    const QSignalBlocker familyQuiet(family_);
    const QSignalBlocker sizeQuiet(size_);
    if (family_->currentText() != family) family_->setEditText(family);
    size_->setEditText(locale().toString(shownSize(font, edit_), 'g', QLocale::FloatingPointShortest));
    bold_->setChecked(isBold(look));
    italic_->setChecked(isItalic(look));
    underline_->setChecked(look.underlineStyle != 0);
    strike_->setChecked(look.strikethroughStyle != 0);
    const std::u16string marker = style.textLists.empty() ? std::u16string() : style.textLists.back().markerFormat;
    bullets_->setChecked(marker == ListMarker::Bullets);
    numbers_->setChecked(marker == ListMarker::Numbers);
    for (int i = 0; i < alignments_.size(); ++i) alignments_[i]->setChecked(i == static_cast<int>(style.alignment));
}

}  // namespace plume
