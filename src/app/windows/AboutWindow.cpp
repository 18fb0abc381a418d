#include "app/windows/AboutWindow.h"

#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QStandardItemModel>
#include <QTreeView>
#include <QVBoxLayout>

#include "app/qt/Labels.h"
#include "app/qt/WindowPlaces.h"

namespace plume {

namespace {

struct Library {
    const char* name;
    const char* licence;
};

constexpr Library Libraries[] = {
    {"Qt", "LGPL-3.0"},
    {"ICU", "Unicode-3.0"},
    {"SQLite", "Public domain"},
    {"expat", "MIT"},
    {"libxml2", "MIT"},
    {"md4c", "MIT"},
    {"yaml-cpp", "MIT"},
    {"nlohmann/json", "MIT"},
    {"xkbcommon", "MIT"},
    {"XCB", "MIT"},
    {"D-Bus", "AFL-2.1 or GPL-2.0-or-later"},
    {"canberra", "LGPL-2.1-or-later"},
    {"CLI11", "BSD-3-Clause"},
};

QTreeView* makeLibraryList() {
    auto* list = new QTreeView;
    auto* model = new QStandardItemModel(list);
    model->setHorizontalHeaderLabels({AboutWindow::tr("Library"), AboutWindow::tr("License")});
    for (const Library& library : Libraries) {
        QList<QStandardItem*> row;
        for (const char* text : {library.name, library.licence}) {
            row.append(new QStandardItem(QString::fromUtf8(text)));
            row.back()->setEditable(false);
        }
        model->appendRow(row);
    }
    list->setModel(model);
    list->setRootIsDecorated(false);
    list->setUniformRowHeights(true);
    list->header()->setSectionResizeMode(0, QHeaderView::ResizeToContents);
    list->setAccessibleName(AboutWindow::tr("Libraries that Plume uses"));
    return list;
}

}  // namespace

AboutWindow::AboutWindow(const QString& version, WritableUserDefaults& settings) : SmallWindow(tr("About Plume")) {
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(makeHeading(QStringLiteral("Plume")));
    auto* versionLabel = makeTextLabel(tr("Version %1").arg(version));
    versionLabel->setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    versionLabel->setAccessibleName(tr("Version"));
    layout->addWidget(versionLabel);
    layout->addSpacing(layout->spacing());
    layout->addWidget(
        makeTextLabel(tr("Plume replaces the short abbreviations that you type by the texts that they "
                         "stand for, in every program.")));
    layout->addWidget(
        makeTextLabel(tr("Plume is free software under the Apache License 2.0; its file LICENSE has the "
                         "whole text.")));
    layout->addSpacing(layout->spacing());
    auto* caption = new QLabel(tr("Built with these &libraries:"));
    QTreeView* list = makeLibraryList();
    caption->setBuddy(list);
    layout->addWidget(caption);
    layout->addWidget(list, 1);
    auto* buttons = new QDialogButtonBox;
    buttons->addButton(tr("&Close"), QDialogButtonBox::RejectRole)->setDefault(true);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    layout->addWidget(buttons);
    const int em = fontMetrics().height();
    resize(28 * em, 31 * em);
    rememberPlace(*this, settings, "About");
}

}  // namespace plume
