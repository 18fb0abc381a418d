// Labels as all windows have them. What they show is text of whatever origin: nothing in it is markup.
//
// On the main thread; whoever puts them into a layout gives them an owner.
#pragma once

#include <QString>

class QLabel;

namespace plume {

// Broken into lines as the place demands; a long word makes no window wide.
QLabel* makeTextLabel(const QString& text = {});
// A text that helps with what stands beside it, and steps back.
QLabel* makeHelpLabel(const QString& text);
// The heading of a window.
QLabel* makeHeading(const QString& text);
// The heading of a part of it.
QLabel* makeSectionTitle(const QString& text);

// A path that can be broken into lines behind its slashes.
QString breakable(QString path);

}  // namespace plume
