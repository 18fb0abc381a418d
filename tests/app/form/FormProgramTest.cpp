// The program that draws forms itself, on a display that nobody sees.
#include <gtest/gtest.h>

#include <QCoreApplication>
#include <QDeadlineTimer>
#include <QProcess>
#include <QTimer>
#include <memory>
#include <optional>
#include <vector>

#include "app/form/FormMessages.h"

namespace plume {
namespace {

const QString Page = QStringLiteral(
    R"(Dear <input id="0" placeholder="Name" name="Name" autofocus="autofocus" type="text" value="Ada" size="20" )"
    R"(onkeypress="return handleKeyUpEvent(event);" />)");

class FormProgramTest : public testing::Test {
  protected:
    FormProgramTest() {
        process_.setStandardErrorFile(QProcess::nullDevice());
        process_.start(QCoreApplication::applicationDirPath() + QStringLiteral("/plume-form"), QStringList());
    }
    ~FormProgramTest() override {
        process_.kill();
        process_.waitForFinished();
    }

    void send(const FormOrder& order) { process_.write(lineOf(order)); }
    void prepare(FormNumber form, const QString& page = Page) {
        send(PrepareForm{form, page, QStringLiteral("Title"), false, QStringLiteral("Hint"), {}, {}});
        send(UpdateForm{form, {}, QStringLiteral("8 characters")});
    }

    template <class Condition>
    bool waitFor(Condition isMet) {
        const QDeadlineTimer limit(20'000);
        QTimer wake;
        wake.start(10);
        while (!isMet() && !limit.hasExpired()) {
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
            lines_.append(process_.readAllStandardOutput());
            while (const auto line = lines_.next()) {
                const auto report = reportIn(*line);
                EXPECT_TRUE(report) << line->toStdString();
                if (report) reports_.push_back(*report);
            }
        }
        return isMet();
    }

    // What it has said of this kind about the form.
    template <class Report>
    std::optional<Report> said(FormNumber form) const {
        for (const FormReport& each : reports_) {
            const auto* report = std::get_if<Report>(&each);
            if (report && report->form == form) return *report;
        }
        return std::nullopt;
    }
    bool isShown(FormNumber form) {
        return waitFor([&] { return said<FormShown>(form).has_value(); });
    }

    QProcess process_;
    MessageLines lines_;
    std::vector<FormReport> reports_;
};

TEST_F(FormProgramTest, ShowsFormsInTheSizeThatTheyNeedOrHad) {
    prepare(1);
    send(ShowForm{1, {}});
    ASSERT_TRUE(isShown(1));
    ASSERT_TRUE(std::holds_alternative<FormsReady>(reports_.front()));
    const auto natural = said<FormSized>(1);
    ASSERT_TRUE(natural);
    EXPECT_GE(natural->size.width, 420);
    EXPECT_LE(natural->size.width, 640);
    EXPECT_LT(natural->size.height, 200);

    prepare(2, Page + QStringLiteral("<br>x").repeated(2000));
    send(ShowForm{2, {}});
    prepare(3);
    send(ShowForm{3, {{}, Size{500, 300}}});
    ASSERT_TRUE(isShown(2));
    ASSERT_TRUE(isShown(3));
    // More than fits on a screen scrolls.
    EXPECT_GT(said<FormSized>(2)->size.height, 300);
    EXPECT_LT(said<FormSized>(2)->size.height, 800);
    EXPECT_EQ(said<FormSized>(3)->size.width, 500);
    EXPECT_EQ(said<FormSized>(3)->size.height, 300);
}

TEST_F(FormProgramTest, SurvivesWhatIsNoOrderAndEndsWithItsInput) {
    process_.write("nonsense\n{}\n\n{\"do\":\"show\"}\n");
    for (const FormNumber missing : {7, 8}) {
        send(ShowForm{missing, {}});
        send(CloseForm{missing});
    }
    send(UpdateForm{9, {{0, QStringLiteral("x"), {}, {}, {}}}, {}});
    prepare(1);
    send(UpdateForm{1, {{900, QStringLiteral("x"), 3, true, QStringLiteral("y")}, {0, {}, 3, true, {}}}, {}});
    send(ShowForm{1, {}});
    ASSERT_TRUE(isShown(1));
    process_.closeWriteChannel();
    ASSERT_TRUE(waitFor([&] { return process_.state() == QProcess::NotRunning; }));
    EXPECT_EQ(process_.exitStatus(), QProcess::NormalExit);
    EXPECT_EQ(process_.exitCode(), 0);
}

TEST_F(FormProgramTest, PagesFarOverTwoMegabytesAreShown) {
    prepare(1, Page + QStringLiteral("<!--") + QString(6'000'000, QLatin1Char('x')) + QStringLiteral("-->"));
    send(ShowForm{1, {}});
    EXPECT_TRUE(isShown(1));
}

}  // namespace
}  // namespace plume
