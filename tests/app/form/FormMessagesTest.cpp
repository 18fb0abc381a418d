#include "app/form/FormMessages.h"

#include <gtest/gtest.h>

#include <QList>
#include <limits>

namespace plume {
namespace {

template <class Message>
Message orderBack(const Message& order) {
    const QByteArray line = lineOf(FormOrder(order));
    EXPECT_EQ(line.indexOf('\n'), line.size() - 1);
    const auto read = orderIn(line);
    return read && std::holds_alternative<Message>(*read) ? std::get<Message>(*read) : Message{};
}

template <class Message>
Message reportBack(const Message& report) {
    const QByteArray line = lineOf(FormReport(report));
    EXPECT_EQ(line.indexOf('\n'), line.size() - 1);
    const auto read = reportIn(line);
    return read && std::holds_alternative<Message>(*read) ? std::get<Message>(*read) : Message{};
}

TEST(FormMessages, TextsArriveAsTheyWere) {
    const QString odd = QString::fromUtf8("a\nb\r\n\"c\" \\ </script> \u2028 \xf0\x9f\x98\x80 \x01");
    const PrepareForm order = orderBack(PrepareForm{7, odd, odd + u'1', true, odd + u'2', odd + u'3', odd + u'4'});
    EXPECT_EQ(order.form, 7);
    EXPECT_EQ(order.page, odd);
    EXPECT_EQ(order.title, odd + u'1');
    EXPECT_TRUE(order.isPaper);
    EXPECT_EQ(order.hint, odd + u'2');
    EXPECT_EQ(order.insertLabel, odd + u'3');
    EXPECT_EQ(order.cancelLabel, odd + u'4');
    const FormFilled report = reportBack(FormFilled{7, 3, odd, 2, true});
    EXPECT_EQ(report.form, 7);
    EXPECT_EQ(report.field, 3);
    EXPECT_EQ(report.value, odd);
    EXPECT_EQ(report.choice, 2);
    EXPECT_TRUE(report.isUnreadable);
}

TEST(FormMessages, PlacesMayLieLeftOfTheScreenAndLackASize) {
    for (const auto kind : {CaretPlace::Kind::Unknown, CaretPlace::Kind::Field, CaretPlace::Kind::Caret}) {
        const CaretPlace caret{kind, {{-20.5, 30}, {0, 18}}};
        const FormPlace sized = orderBack(ShowForm{1, {caret, Size{640, 480}}}).place;
        EXPECT_EQ(sized.caret, caret);
        ASSERT_TRUE(sized.size);
        EXPECT_EQ(sized.size->width, 640);
        EXPECT_EQ(sized.size->height, 480);
        EXPECT_FALSE(orderBack(ShowForm{1, {caret, std::nullopt}}).place.size);
    }
}

TEST(FormMessages, UpdatesTellOnlyWhatHasChanged) {
    const std::vector<ShownField> fields = {
        {0, QStringLiteral(""), {}, true, {}}, {199, {}, 4, {}, QStringLiteral("No.")}, {2, {}, {}, false, {}}};
    const UpdateForm order = orderBack(UpdateForm{9, fields, QStringLiteral("3")});
    EXPECT_EQ(order.fields, fields);
    EXPECT_EQ(order.length, QStringLiteral("3"));
    EXPECT_FALSE(orderBack(UpdateForm{9, {}, {}}).length);
}

TEST(FormMessages, ReportsArriveAsTheyWere) {
    EXPECT_EQ(reportBack(FormShown{7, std::numeric_limits<std::uint32_t>::max()}).window,
              std::numeric_limits<std::uint32_t>::max());
    EXPECT_TRUE(reportBack(FormSelected{7, 1, true}).selected);
    EXPECT_EQ(reportBack(FormAccepted{7}).form, 7);
    EXPECT_EQ(reportBack(FormCancelled{8}).form, 8);
    EXPECT_EQ(reportBack(FormSized{8, {420, 200.5}}).size.height, 200.5);
    EXPECT_EQ(orderBack(CloseForm{6}).form, 6);
}

TEST(FormMessages, WhatIsOfTheWrongShapeIsNothing) {
    for (const char* line : {"",
                             "{",
                             "null",
                             "[]",
                             "\"ready\"",
                             R"({"event":"ready"} x)",
                             R"({"event":7})",
                             R"({"event":"Ready"})",
                             R"({"event":"shown","form":7})",
                             R"({"event":"shown","form":7,"window":-1})",
                             R"({"event":"shown","form":7,"window":4294967296})",
                             R"({"event":"shown","form":"7","window":1})",
                             R"({"event":"filled","form":7,"field":-1,"value":""})",
                             R"({"event":"filled","form":7,"field":0.5,"value":""})",
                             R"({"event":"filled","form":7,"field":0,"value":1})",
                             R"({"event":"filled","form":1e300,"field":0,"value":""})",
                             R"({"event":"filled","form":7,"field":0,"value":"","choice":"a"})",
                             R"({"event":"selected","form":7,"field":0,"selected":1})",
                             R"({"event":"accepted"})",
                             R"({"event":"sized","form":7,"size":[1]})",
                             R"({"event":"sized","form":7,"size":[0,-4]})",
                             R"({"event":"sized","form":7,"size":["1","1"]})",
                             "{\"event\":\"accepted\",\"form\":1,\"x\":\"\xff\"}"}) {
        EXPECT_FALSE(reportIn(line)) << line;
    }
    for (const char* line :
         {R"({"do":"prepare","form":1,"page":"","title":"","hint":""})", R"({"do":"show","form":1})",
          R"({"do":"show","form":1,"place":{"kind":"there","x":0,"y":0,"width":0,"height":0}})",
          R"({"do":"show","form":1,"place":{"kind":"caret","x":0,"y":0,"width":0}})",
          R"({"do":"update","form":1,"fields":{}})", R"({"do":"update","form":1,"fields":[3]})",
          R"({"do":"update","form":1,"fields":[{"index":0,"selected":"yes"}]})", R"({"do":"explode","form":1})"}) {
        EXPECT_FALSE(orderIn(line)) << line;
    }
}

TEST(MessageLines, ComeOutAsTheyWereHoweverTheyArrive) {
    const QByteArray stream = "one\n\ntwo two\nthree\nrest";
    for (qsizetype piece = 1; piece <= stream.size(); ++piece) {
        MessageLines lines;
        QList<QByteArray> read;
        for (qsizetype at = 0; at < stream.size(); at += piece) {
            lines.append(stream.mid(at, piece));
            while (auto line = lines.next()) read.push_back(*line);
        }
        EXPECT_EQ(read, (QList<QByteArray>{"one", "", "two two", "three"})) << piece;
        EXPECT_FALSE(lines.isTooLong());
    }
}

TEST(MessageLines, ALineThatIsTooLongIsTheLast) {
    const QByteArray most(MessageLines::LongestLine, 'x');
    MessageLines whole;
    whole.append(most + '\n');
    EXPECT_EQ(whole.next(), most);
    for (const char* end : {"", "\n", "\nnext\n"}) {
        MessageLines lines;
        lines.append("before\n" + most + 'x' + end);
        EXPECT_EQ(lines.next(), "before");
        EXPECT_FALSE(lines.next());
        EXPECT_FALSE(lines.next());
        EXPECT_TRUE(lines.isTooLong());
    }
}

}  // namespace
}  // namespace plume
