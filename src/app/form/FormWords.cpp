#include "app/form/FormWords.h"

#include <QCoreApplication>
#include <QLocale>
#include <QStringList>
#include <algorithm>
#include <limits>

namespace plume {

namespace {

class FormWords {
    Q_DECLARE_TR_FUNCTIONS(FormWords)
};

bool hasBoxes(const FormModel& model) {
    return std::any_of(model.fields().begin(), model.fields().end(),
                       [](const FormModel::Field& field) { return field.variable->isOptional && field.hasControl(); });
}

}  // namespace

QString wordsFor(FormModel::Problem problem) {
    switch (problem) {
        case FormModel::Problem::None:
            return {};
        case FormModel::Problem::NoNumber:
            return FormWords::tr("This is not a number.");
        case FormModel::Problem::UnreadableFormula:
            return FormWords::tr("This formula cannot be computed.");
        case FormModel::Problem::CircularFormula:
            return FormWords::tr("This formula depends on itself.");
        case FormModel::Problem::MissingNumber:
            return FormWords::tr("A number is missing that this is computed from.");
    }
    return {};
}

QString lengthLine(const FormModel& model) {
    const auto length = static_cast<qulonglong>(model.length());
    // Only for the choice between singular and plural.
    constexpr auto Most = static_cast<qulonglong>(std::numeric_limits<int>::max());
    const int count = static_cast<int>(std::min(length, Most));
    const QString shown = QLocale().toString(length);
    if (model.runsScripts()) {
        return count == 1 ? FormWords::tr("%1 character, and what the script adds").arg(shown)
                          : FormWords::tr("%1 characters, and what the script adds", "", count).arg(shown);
    }
    return count == 1 ? FormWords::tr("%1 character").arg(shown) : FormWords::tr("%1 characters", "", count).arg(shown);
}

QString hintLine(const FormModel& model) {
    QStringList hints = {FormWords::tr("Return inserts"), FormWords::tr("Ctrl+Return inserts from anywhere")};
    if (hasBoxes(model)) hints.push_back(FormWords::tr("Alt+letter takes a part or leaves it out"));
    hints.push_back(FormWords::tr("Esc cancels"));
    return hints.join(QStringLiteral(", "));
}

QString insertLabel() {
    return FormWords::tr("Insert");
}

QString cancelLabel() {
    return FormWords::tr("Cancel");
}

}  // namespace plume
