#include "app/form/FormMessages.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <cmath>
#include <limits>
#include <utility>

namespace plume {

namespace {

// ---- Writing ----

QByteArray lineOf(const QJsonObject& object) {
    return QJsonDocument(object).toJson(QJsonDocument::Compact) + '\n';
}

QString nameOf(CaretPlace::Kind kind) {
    switch (kind) {
        case CaretPlace::Kind::Caret:
            return QStringLiteral("caret");
        case CaretPlace::Kind::Field:
            return QStringLiteral("field");
        case CaretPlace::Kind::Unknown:
            break;
    }
    return QStringLiteral("unknown");
}

QJsonObject objectOf(const CaretPlace& place) {
    const auto& [origin, size] = place.rectangle;
    return {
        {"kind", nameOf(place.kind)}, {"x", origin.x}, {"y", origin.y}, {"width", size.width}, {"height", size.height}};
}

QJsonObject objectOf(const ShownField& field) {
    QJsonObject object{{"index", static_cast<qint64>(field.index)}};
    if (field.value) object["value"] = *field.value;
    if (field.choice) object["choice"] = static_cast<qint64>(*field.choice);
    if (field.selected) object["selected"] = *field.selected;
    if (field.problem) object["problem"] = *field.problem;
    return object;
}

QJsonObject orderOf(const char* what, FormNumber form) {
    return {{"do", what}, {"form", static_cast<qint64>(form)}};
}

QJsonObject reportOf(const char* what, FormNumber form) {
    return {{"event", what}, {"form", static_cast<qint64>(form)}};
}

QJsonObject objectOf(const PrepareForm& order) {
    QJsonObject object = orderOf("prepare", order.form);
    object["page"] = order.page;
    object["title"] = order.title;
    object["paper"] = order.isPaper;
    object["hint"] = order.hint;
    object["insert"] = order.insertLabel;
    object["cancel"] = order.cancelLabel;
    return object;
}

QJsonObject objectOf(const ShowForm& order) {
    QJsonObject object = orderOf("show", order.form);
    object["place"] = objectOf(order.place.caret);
    if (order.place.size) object["size"] = QJsonArray{order.place.size->width, order.place.size->height};
    return object;
}

QJsonObject objectOf(const CloseForm& order) {
    return orderOf("close", order.form);
}

QJsonObject objectOf(const FormsReady& /*report*/) {
    return {{"event", "ready"}};
}

QJsonObject objectOf(const FormShown& report) {
    QJsonObject object = reportOf("shown", report.form);
    object["window"] = static_cast<qint64>(report.window);
    return object;
}

QJsonObject objectOf(const FormFilled& report) {
    QJsonObject object = reportOf("filled", report.form);
    object["field"] = static_cast<qint64>(report.field);
    object["value"] = report.value;
    if (report.choice) object["choice"] = static_cast<qint64>(*report.choice);
    if (report.isUnreadable) object["unreadable"] = true;
    return object;
}

QJsonObject objectOf(const FormSelected& report) {
    QJsonObject object = reportOf("selected", report.form);
    object["field"] = static_cast<qint64>(report.field);
    object["selected"] = report.selected;
    return object;
}

QJsonObject objectOf(const FormAccepted& report) {
    return reportOf("accepted", report.form);
}

QJsonObject objectOf(const FormCancelled& report) {
    return reportOf("cancelled", report.form);
}

QJsonObject objectOf(const FormStayed& report) {
    return reportOf("stayed", report.form);
}

QJsonObject objectOf(const FormSized& report) {
    QJsonObject object = reportOf("sized", report.form);
    object["size"] = QJsonArray{report.size.width, report.size.height};
    return object;
}

// ---- Reading ----

// Takes an object's members, and remembers whether all were there and of the right kind.
class Members {
  public:
    explicit Members(QJsonObject object) : object_(std::move(object)) {}

    bool areRight() const { return areRight_; }
    bool has(const char* name) const { return object_.contains(QLatin1String(name)); }

    QString text(const char* name) { return take(name, &QJsonValue::isString).toString(); }
    bool truth(const char* name) { return take(name, &QJsonValue::isBool).toBool(); }
    double number(const char* name) { return take(name, &QJsonValue::isDouble).toDouble(); }
    QJsonArray list(const char* name) { return take(name, &QJsonValue::isArray).toArray(); }
    Members members(const char* name) { return Members(take(name, &QJsonValue::isObject).toObject()); }

    // A whole number that is not negative.
    std::int64_t count(const char* name, double largest = 1e15) {
        const double value = number(name);
        const bool isCount = value >= 0 && value <= largest && value == std::floor(value);
        areRight_ = areRight_ && isCount;
        return isCount ? static_cast<std::int64_t>(value) : 0;
    }

    Size size(const char* name) {
        const QJsonArray sides = list(name);
        const Size size{sides.at(0).toDouble(), sides.at(1).toDouble()};
        require(sides.size() == 2 && size.width >= 1 && size.height >= 1);
        return size;
    }

    void require(bool isRight) { areRight_ = areRight_ && isRight; }

  private:
    QJsonValue take(const char* name, bool (QJsonValue::*isOfKind)() const) {
        QJsonValue value = object_.value(QLatin1String(name));
        require((value.*isOfKind)());
        return value;
    }

    QJsonObject object_;
    bool areRight_ = true;
};

FormPlace placeIn(Members& members) {
    Members place = members.members("place");
    const QString kind = place.text("kind");
    FormPlace result;
    for (const auto each : {CaretPlace::Kind::Unknown, CaretPlace::Kind::Field, CaretPlace::Kind::Caret}) {
        if (nameOf(each) == kind) result.caret.kind = each;
    }
    result.caret.rectangle = {{place.number("x"), place.number("y")}, {place.number("width"), place.number("height")}};
    members.require(place.areRight() && nameOf(result.caret.kind) == kind);
    if (members.has("size")) result.size = members.size("size");
    return result;
}

ShownField shownFieldIn(Members& members) {
    ShownField field{.index = members.count("index"), .value = {}, .choice = {}, .selected = {}, .problem = {}};
    if (members.has("value")) field.value = members.text("value");
    if (members.has("choice")) field.choice = members.count("choice");
    if (members.has("selected")) field.selected = members.truth("selected");
    if (members.has("problem")) field.problem = members.text("problem");
    return field;
}

UpdateForm updateIn(Members& members) {
    UpdateForm order{members.count("form"), {}, {}};
    for (const auto& each : members.list("fields")) {
        Members field(each.toObject());
        order.fields.push_back(shownFieldIn(field));
        members.require(field.areRight());
    }
    if (members.has("length")) order.length = members.text("length");
    return order;
}

FormFilled filledIn(Members& members) {
    FormFilled report{members.count("form"), members.count("field"), members.text("value"), {}, false};
    if (members.has("choice")) report.choice = members.count("choice");
    if (members.has("unreadable")) report.isUnreadable = members.truth("unreadable");
    return report;
}

Members membersOf(const QByteArray& line) {
    return Members(QJsonDocument::fromJson(line).object());
}

std::optional<FormOrder> orderOf(const QString& what, Members& members) {
    if (what == QLatin1String("prepare")) {
        return PrepareForm{members.count("form"), members.text("page"),   members.text("title"), members.truth("paper"),
                           members.text("hint"),  members.text("insert"), members.text("cancel")};
    }
    if (what == QLatin1String("show")) return ShowForm{members.count("form"), placeIn(members)};
    if (what == QLatin1String("update")) return updateIn(members);
    if (what == QLatin1String("close")) return CloseForm{members.count("form")};
    return std::nullopt;
}

std::optional<FormReport> reportOf(const QString& what, Members& members) {
    constexpr double LargestWindow = std::numeric_limits<std::uint32_t>::max();
    if (what == QLatin1String("ready")) return FormsReady{};
    if (what == QLatin1String("shown")) {
        return FormShown{members.count("form"), static_cast<std::uint32_t>(members.count("window", LargestWindow))};
    }
    if (what == QLatin1String("filled")) return filledIn(members);
    if (what == QLatin1String("selected")) {
        return FormSelected{members.count("form"), members.count("field"), members.truth("selected")};
    }
    if (what == QLatin1String("accepted")) return FormAccepted{members.count("form")};
    if (what == QLatin1String("cancelled")) return FormCancelled{members.count("form")};
    if (what == QLatin1String("stayed")) return FormStayed{members.count("form")};
    if (what == QLatin1String("sized")) return FormSized{members.count("form"), members.size("size")};
    return std::nullopt;
}

}  // namespace

QJsonObject objectOf(const UpdateForm& order) {
    QJsonObject object = orderOf("update", order.form);
    QJsonArray fields;
    for (const ShownField& field : order.fields) fields.append(objectOf(field));
    object["fields"] = fields;
    if (order.length) object["length"] = *order.length;
    return object;
}

QByteArray lineOf(const FormOrder& order) {
    return lineOf(std::visit([](const auto& each) { return objectOf(each); }, order));
}

QByteArray lineOf(const FormReport& report) {
    return lineOf(std::visit([](const auto& each) { return objectOf(each); }, report));
}

std::optional<FormOrder> orderIn(const QByteArray& line) {
    Members members = membersOf(line);
    auto order = orderOf(members.text("do"), members);
    return members.areRight() ? order : std::nullopt;
}

std::optional<FormReport> reportIn(const QByteArray& line) {
    Members members = membersOf(line);
    auto report = reportOf(members.text("event"), members);
    return members.areRight() ? report : std::nullopt;
}

void MessageLines::append(const QByteArray& bytes) {
    // What has been read is dropped once it is the larger part, so that many short lines do not cost a copy each.
    if (begin_ > rest_.size() / 2) {
        rest_.remove(0, begin_);
        searched_ -= begin_;
        begin_ = 0;
    }
    rest_.append(bytes);
}

std::optional<QByteArray> MessageLines::next() {
    const qsizetype end = rest_.indexOf('\n', searched_);
    isTooLong_ = isTooLong_ || (end < 0 ? rest_.size() : end) - begin_ > LongestLine;
    searched_ = end < 0 ? rest_.size() : end + 1;
    if (isTooLong_ || end < 0) return std::nullopt;
    QByteArray line = rest_.mid(begin_, end - begin_);
    begin_ = searched_;
    return line;
}

}  // namespace plume
