#include "app/editor/CaseReset.h"

#include <QCoreApplication>
#include <QDialogButtonBox>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

#include "app/editor/ChoiceBox.h"
#include "app/qt/Labels.h"

namespace plume {

namespace {

constexpr int SheetWidth = 24;  // heights of a line

class CaseTexts {
    Q_DECLARE_TR_FUNCTIONS(CaseReset)
};

}  // namespace

QStringList caseSensitivityNames() {
    return {CaseTexts::tr("Typed exactly as it is written"), CaseTexts::tr("Typed in capitals or not"),
            CaseTexts::tr("Typed in capitals or not, and the text adapts")};
}

QDialog* askForCaseReset(QWidget* parent, CaseSensitivity suggested,
                         const std::function<void(CaseSensitivity value)>& chosen) {
    auto* sheet = new QDialog(parent);
    sheet->setAttribute(Qt::WA_DeleteOnClose);
    sheet->setWindowTitle(CaseTexts::tr("Reset Case Sensitivity"));
    auto* values = new ChoiceBox(caseSensitivityNames());
    values->setAccessibleName(CaseTexts::tr("Case sensitivity of all snippets"));
    const int count = values->count();
    const auto value = static_cast<int>(suggested);
    values->setCurrentIndex(value >= 0 && value < count ? value : 0);
    auto* buttons = new QDialogButtonBox;
    buttons->addButton(CaseTexts::tr("Reset"), QDialogButtonBox::AcceptRole)->setDefault(true);
    buttons->addButton(CaseTexts::tr("Cancel"), QDialogButtonBox::RejectRole);
    auto* layout = new QVBoxLayout(sheet);
    layout->addWidget(makeSectionTitle(
        CaseTexts::tr("This will reset case sensitivity of all snippets in group to default setting.")));
    layout->addWidget(makeTextLabel(CaseTexts::tr("You can undo this action.")));
    layout->addWidget(values);
    layout->addStretch(1);
    layout->addWidget(buttons);
    QObject::connect(buttons, &QDialogButtonBox::accepted, sheet, &QDialog::accept);
    QObject::connect(buttons, &QDialogButtonBox::rejected, sheet, &QDialog::reject);
    QObject::connect(sheet, &QDialog::accepted, parent,
                     [values, chosen] { chosen(static_cast<CaseSensitivity>(values->value())); });
    const int width = SheetWidth * sheet->fontMetrics().height();
    sheet->resize(width, layout->heightForWidth(width));
    sheet->open();
    return sheet;
}

}  // namespace plume
