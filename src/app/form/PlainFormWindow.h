// A form in a window of plain controls, for where pages cannot be drawn.
//
// On the main thread. Any of its events may destroy it.
#pragma once

#include <QDialog>
#include <cstdint>
#include <deque>
#include <functional>
#include <vector>

#include "app/FormModel.h"
#include "app/form/FormLines.h"
#include "app/form/FormSurface.h"
#include "content/SnippetExpandedContent.h"

class QLabel;

namespace plume {

class FieldControl;
class InlineText;

class PlainFormWindow final : public QDialog, public FormSurface {
    Q_OBJECT
  public:
    // The model and the content outlive it.
    PlainFormWindow(const FormModel& model, const SnippetExpandedContent& content, const std::u16string& title,
                    Events events);
    ~PlainFormWindow() override;

    void show(const FormPlace& place) override;
    void update() override;
    std::optional<Size> size() const override;

    // What Return and Escape do.
    void accept() override;
    void reject() override;

  protected:
    void keyPressEvent(QKeyEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    void paintEvent(QPaintEvent* event) override;

  private:
    struct Shown {
        FieldControl* control = nullptr;  // null: of a field that shows nothing
        bool isTold = true;               // what the user has typed last
    };

    enum class LineState : std::uint8_t { Empty, Begun, Full };

    QWidget* makeFoot();
    void fillText(const std::vector<FormLine>& lines);
    void addPiece(const FormPiece& piece, const std::vector<QString>& boxTexts, QString& before);
    void beginPiece(bool isLarge);
    void addField(std::size_t field, const QString& boxText, const QString& before);
    QString nameOf(std::size_t field) const;
    std::vector<QString> boxTexts() const;
    void connectField(std::size_t field);
    void focusFirst();
    QSize wantedSize(const QRect& room) const;

    void display(std::size_t field);
    void edited(std::size_t field);
    void tellFilled(std::size_t field);
    void end(std::function<void()> event);
    // Events are told from the event loop, in their order.
    void post(std::function<void()> event);
    Q_INVOKABLE void deliver();

    const FormModel& model_;
    Events events_;
    InlineText* text_;
    QLabel* hint_;
    QLabel* length_;
    std::vector<Shown> fields_;
    std::deque<std::function<void()>> posted_;
    LineState lineState_ = LineState::Empty;  // of the last line of text_
    bool isDrawn_ = false;
    bool isEnded_ = false;
};

}  // namespace plume
