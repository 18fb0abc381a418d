// Text to be read, with controls in its lines: broken into lines and scrolled together.
//
// On the main thread. The text never takes the focus; its controls do, and the one that takes it is scrolled to.
#pragma once

#include <QTextEdit>
#include <QTextObjectInterface>
#include <cstddef>
#include <vector>

namespace plume {

// A control, with whatever belongs to it, that can stand in a line of text.
class InlineWidget : public QWidget {
    Q_OBJECT
  public:
    // There is so much room for it in a line.
    virtual void setRoom(int width) = 0;
    // From its upper edge to the line that its text stands on, which is in its middle.
    int baseline() const;

    // It wants another size now.
    Q_SIGNAL void resized();

  protected:
    bool event(QEvent* event) override;
};

class InlineText final : public QTextEdit, private QTextObjectInterface {
    Q_OBJECT
    Q_INTERFACES(QTextObjectInterface)
  public:
    InlineText();

    void appendText(const QString& text, const QTextCharFormat& format = {});
    void appendLineBreak();
    // Owns it from here on.
    void appendWidget(InlineWidget* widget);

    // In one line for each of its own.
    int idealWidth() const;
    int heightForWidth(int width) const override;
    // Scrolls until it can be seen.
    void reveal(const QWidget& inner);

    QSize sizeHint() const override;

  protected:
    void resizeEvent(QResizeEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void changeEvent(QEvent* event) override;
    void scrollContentsBy(int dx, int dy) override;

  private:
    struct Placed {
        InlineWidget* widget;
        int position;  // in the document
        QSize size;    // that the layout knows
    };

    // What the layout asks: widgets take this room, and draw themselves.
    QSizeF intrinsicSize(QTextDocument* shown, int position, const QTextFormat& format) override;
    void drawObject(QPainter* /*painter*/, const QRectF& /*rectangle*/, QTextDocument* /*shown*/, int /*position*/,
                    const QTextFormat& /*format*/) override {}

    void layOutAgain(std::size_t index);
    void placeSoon();
    Q_INVOKABLE void placeWidgets();

    std::vector<Placed> placed_;
    bool isPlacedSoon_ = false;
};

}  // namespace plume
