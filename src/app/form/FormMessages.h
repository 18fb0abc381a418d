// What Plume and the program that draws forms say to each other: one JSON object a line, UTF-8.
//
// Pure; from any thread. Each side takes what it reads for what a stranger might have written: a line is a message of
// the right shape, or nothing. Sizes are in Qt's pixels, fields are counted from 0.
#pragma once

#include <QByteArray>
#include <QJsonObject>
#include <QString>
#include <cstdint>
#include <optional>
#include <variant>
#include <vector>

#include "app/form/FormSurface.h"

namespace plume {

// Which form: never used twice, and small enough for a number of JSON.
using FormNumber = std::int64_t;

// What a field shows. What is absent stays as it is.
struct ShownField {
    std::int64_t index = 0;
    std::optional<QString> value;        // of a number field: with a point and without grouping
    std::optional<std::int64_t> choice;  // of a pop-up menu: which of its lines
    std::optional<bool> selected;
    std::optional<QString> problem;  // one sentence; empty: none

    bool operator==(const ShownField&) const = default;
};

// ---- To the program ----

struct PrepareForm {
    FormNumber form = 0;
    QString page;  // what goes into the page's template
    QString title;
    bool isPaper = false;  // the text has colours of its own, which need a light ground
    QString hint;
    QString insertLabel;  // of the buttons
    QString cancelLabel;
};

struct ShowForm {
    FormNumber form = 0;
    FormPlace place;
};

struct UpdateForm {
    FormNumber form = 0;
    std::vector<ShownField> fields;
    std::optional<QString> length;  // the live line
};

struct CloseForm {
    FormNumber form = 0;
};

using FormOrder = std::variant<PrepareForm, ShowForm, UpdateForm, CloseForm>;

QByteArray lineOf(const FormOrder& order);
std::optional<FormOrder> orderIn(const QByteArray& line);
// As it stands in its line: for the page, which shows it.
QJsonObject objectOf(const UpdateForm& order);

// ---- From the program ----

// It takes orders. The first that it says, and said once.
struct FormsReady {};

struct FormShown {
    FormNumber form = 0;
    std::uint32_t window = 0;
};

struct FormFilled {
    FormNumber form = 0;
    std::int64_t field = 0;
    QString value;
    std::optional<std::int64_t> choice;
    bool isUnreadable = false;  // what stands in a number field is no number, and the value is empty
};

struct FormSelected {
    FormNumber form = 0;
    std::int64_t field = 0;
    bool selected = false;
};

struct FormAccepted {
    FormNumber form = 0;
};

struct FormCancelled {
    FormNumber form = 0;
};

// A key came that ends forms elsewhere.
struct FormStayed {
    FormNumber form = 0;
};

struct FormSized {
    FormNumber form = 0;
    Size size;
};

using FormReport =
    std::variant<FormsReady, FormShown, FormFilled, FormSelected, FormAccepted, FormCancelled, FormStayed, FormSized>;

QByteArray lineOf(const FormReport& report);
std::optional<FormReport> reportIn(const QByteArray& line);

// Takes the lines out of a stream of bytes.
class MessageLines {
  public:
    static constexpr qsizetype LongestLine = qsizetype{64} << 20;

    void append(const QByteArray& bytes);
    // Without its end; nothing when none is complete, or one was longer than any that is meant.
    std::optional<QByteArray> next();
    // Then nothing more is read.
    bool isTooLong() const { return isTooLong_; }

  private:
    QByteArray rest_;
    qsizetype begin_ = 0;     // of the next line
    qsizetype searched_ = 0;  // no line ends between there and here
    bool isTooLong_ = false;
};

}  // namespace plume
