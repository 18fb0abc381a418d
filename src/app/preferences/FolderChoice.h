// A choice of folders: the usual one, those that cloud services keep in the home folder, and any other.
//
// Main thread. Tells what the user chooses, and shows what it is given.
#pragma once

#include <QWidget>
#include <string>

class QComboBox;
class QLabel;

namespace plume {

class FolderChoice final : public QWidget {
    Q_OBJECT
  public:
    enum class Offers { DefaultToo, FoldersOnly };

    explicit FolderChoice(Offers offers, QWidget* parent = nullptr);

    // An empty path: none is chosen yet.
    void setFolder(const std::u16string& path, bool isDefault = false);
    void setName(const QString& name);

  Q_SIGNALS:
    void chosen(const std::u16string& path);
    void defaultChosen();

  protected:
    void resizeEvent(QResizeEvent* event) override;

  private:
    void take(int index);
    void chooseOther();
    void showState();
    void showPath();

    QComboBox* box_;
    QLabel* path_;
    QString folder_;
    bool isDefault_ = false;
};

}  // namespace plume
