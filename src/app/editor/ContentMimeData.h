// Contents on the clipboard and in drags: Plume's own type, which loses nothing, and what other programs read.
//
// On the main thread; whoever is given it owns it, as all data of this kind.
#pragma once

#include <QMimeData>
#include <optional>

#include "Foundation/text/AttributedString.h"

namespace plume {

class ContentMimeData final : public QMimeData {
    Q_OBJECT
  public:
    // A selection is offered whenever it changes, and rarely asked for: each type is written when somebody wants it.
    ContentMimeData(AttributedString content, bool isRich);

    QStringList formats() const override;
    bool hasFormat(const QString& type) const override;

  protected:
    QVariant retrieveData(const QString& type, QMetaType metaType) const override;

  private:
    AttributedString content_;
    bool isRich_;
};

bool holdsContent(const QMimeData& data);
// With placeholders as text. Without attributes and files unless it is to be rich; objects that came without their
// file are left out. Nothing when there is nothing to insert.
std::optional<AttributedString> contentFrom(const QMimeData& data, bool asRich);

}  // namespace plume
