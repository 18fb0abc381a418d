#include "app/preferences/ProgramCatalog.h"

#include <QApplication>
#include <QStyle>

#include "Foundation/Strings.h"
#include "app/qt/Text.h"

namespace plume {

const std::vector<InstalledProgram>& ProgramCatalog::installed() {
    if (isAsked_) return installed_;
    isAsked_ = true;
    if (services_.installedPrograms) installed_ = services_.installedPrograms();
    for (std::size_t i = 0; i < installed_.size(); ++i) places_.emplace(lowercased(installed_[i].identifier), i);
    return installed_;
}

const InstalledProgram* ProgramCatalog::find(const std::u16string& identifier) {
    installed();
    const auto found = places_.find(lowercased(identifier));
    return found == places_.end() ? nullptr : &installed_[found->second];
}

QString ProgramCatalog::nameOf(const std::u16string& identifier) {
    if (const InstalledProgram* program = find(identifier); program && !program->name.empty()) {
        return toQString(program->name);
    }
    const auto learnt = learnt_.find(lowercased(identifier));
    return toQString(learnt == learnt_.end() ? identifier : learnt->second);
}

QIcon ProgramCatalog::iconOf(const std::u16string& identifier) {
    const InstalledProgram* program = find(identifier);
    const QString name = program ? QString::fromStdString(program->icon) : QString();
    QIcon icon = name.startsWith(u'/') ? QIcon(name) : QIcon::fromTheme(name);
    return icon.isNull() ? QApplication::style()->standardIcon(QStyle::SP_FileIcon) : icon;
}

void ProgramCatalog::learn(const std::u16string& identifier, const std::u16string& name) {
    if (!name.empty()) learnt_.insert_or_assign(lowercased(identifier), name);
}

}  // namespace plume
