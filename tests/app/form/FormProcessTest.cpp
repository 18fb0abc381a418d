// Plume's side of the program that draws forms, against programs that do all that such a program might do.
#include "app/form/FormProcess.h"

#include <gtest/gtest.h>
#include <sys/types.h>

#include <QCoreApplication>
#include <QDeadlineTimer>
#include <QFile>
#include <QTemporaryDir>
#include <QTimer>
#include <algorithm>
#include <csignal>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

namespace plume {
namespace {

constexpr const char* Ready = R"(echo '{"event":"ready"}')";

std::shared_ptr<SnippetFieldVariable> variable(std::u16string name, FieldType type, std::u16string value,
                                               bool isOptional = false) {
    auto made = std::make_shared<SnippetFieldVariable>();
    made->name = std::move(name);
    made->type = type;
    made->value = std::move(value);
    made->isOptional = isOptional;
    return made;
}

// Takes events as fast as they come, for ten seconds at most.
template <class Condition>
bool waitFor(Condition isMet) {
    const QDeadlineTimer limit(10'000);
    QTimer wake;
    wake.start(10);
    while (!isMet() && !limit.hasExpired()) QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    return isMet();
}

// A form of all kinds of fields, and a program for it that a script stands for.
class FormProcessTest : public testing::Test {
  protected:
    FormProcessTest() {
        content_.variables = {
            variable(u"Name", FieldType::Singleline, u"Ada"), variable(u"Price", FieldType::Number, u"1,5"),
            variable(u"Colour", FieldType::PopupMenu, u"red\r\ngreen\r\nblue"),
            variable(u"Remark", FieldType::Multiline, u"", true), variable(u"Name", FieldType::Singleline, u"Ada")};
        model_ = std::make_unique<FormModel>(content_, "de_DE");
    }

    // The lines of a shell's script.
    void start(const std::vector<std::string>& script) {
        QFile file(path("program"));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write("#!/bin/sh\ncd '" + folder_.path().toUtf8() + "'\n");
        for (const std::string& line : script) file.write(QByteArray::fromStdString(line) + '\n');
        file.close();
        file.setPermissions(QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
        process_ = std::make_unique<FormProcess>(path("program").toStdString(), listener());
    }

    FormProcess::Listener listener() {
        return {.runs = [this](std::int64_t process) { runs_.push_back(process); },
                .lost =
                    [this](const std::string& reason) {
                        losses_.push_back(reason);
                        form_.reset();
                    }};
    }

    void makeForm() { form_ = process_->makeForm(*model_, content_, u"Title", events()); }

    FormSurface::Events events() {
        return {.shown = [this](std::uint32_t window) { heard_.push_back("shown " + std::to_string(window)); },
                .filled =
                    [this](std::size_t field, const std::u16string& value) {
                        heard_.push_back("filled " + std::to_string(field) + " " +
                                         QString::fromStdU16String(value).toStdString());
                        ASSERT_TRUE(model_->fill(field, value));
                        form_->update();
                    },
                .selected =
                    [this](std::size_t field, bool selected) {
                        heard_.push_back((selected ? "selected " : "unselected ") + std::to_string(field));
                        model_->setSelected(field, selected);
                        form_->update();
                    },
                .accepted =
                    [this] {
                        heard_.emplace_back("accepted");
                        form_.reset();
                    },
                .cancelled =
                    [this] {
                        heard_.emplace_back("cancelled");
                        form_.reset();
                    }};
    }

    QString path(const char* name) const { return folder_.filePath(QLatin1String(name)); }

    // What the program has kept of what it was told, in the file "told".
    std::vector<FormOrder> told() const {
        std::vector<FormOrder> orders;
        QFile file(path("told"));
        if (!file.open(QIODevice::ReadOnly)) return orders;
        for (const QByteArray& line : file.readAll().split('\n')) {
            const auto order = orderIn(line);
            if (order) orders.push_back(*order);
        }
        return orders;
    }
    template <class Order>
    std::vector<Order> toldOf() const {
        std::vector<Order> found;
        for (const FormOrder& each : told()) {
            if (const auto* order = std::get_if<Order>(&each)) found.push_back(*order);
        }
        return found;
    }

    bool heard(std::size_t count) {
        return waitFor([&] { return heard_.size() >= count; });
    }
    bool isLost() {
        return waitFor([&] { return !losses_.empty(); });
    }

    QTemporaryDir folder_;
    SnippetExpandedContent content_;
    std::unique_ptr<FormModel> model_;
    std::vector<std::string> heard_;
    std::vector<std::string> losses_;
    std::vector<std::int64_t> runs_;
    std::unique_ptr<FormProcess> process_;
    std::unique_ptr<FormSurface> form_;
};

TEST_F(FormProcessTest, TellsThePageWhatItDoesNotShowYet) {
    start({Ready, "for i in 1 2; do read -r line; echo \"$line\" >> told; done",
           R"(echo '{"event":"filled","form":1,"field":0,"value":"Bob"}')", "read -r line; echo \"$line\" >> told",
           R"(echo '{"event":"filled","form":1,"field":1,"value":"2.25"}')",
           R"(echo '{"event":"filled","form":1,"field":2,"value":"blue","choice":2}')",
           R"(echo '{"event":"filled","form":1,"field":3,"value":"x"}')", "exec cat >> told"});
    makeForm();
    ASSERT_TRUE(heard(4));
    EXPECT_EQ(heard_, (std::vector<std::string>{"filled 0 Bob", "filled 1 2,25", "filled 2 blue", "filled 3 x"}));
    ASSERT_TRUE(waitFor([&] { return toldOf<UpdateForm>().size() >= 3; }));

    const auto prepared = toldOf<PrepareForm>();
    ASSERT_EQ(prepared.size(), 1U);
    EXPECT_EQ(prepared[0].title, QStringLiteral("Title"));
    EXPECT_TRUE(prepared[0].page.contains(QStringLiteral("<select")));
    const auto updates = toldOf<UpdateForm>();
    ASSERT_EQ(updates[0].fields.size(), 5U);
    EXPECT_EQ(updates[0].fields[1].value, QStringLiteral("1.5"));
    EXPECT_EQ(updates[0].fields[2].choice, 0);
    EXPECT_FALSE(updates[0].fields[2].value);
    EXPECT_EQ(updates[0].fields[3].selected, false);
    // Field 0 is shown as it was typed; its namesake follows.
    ASSERT_EQ(updates[1].fields.size(), 1U);
    EXPECT_EQ(updates[1].fields[0].index, 4);
    EXPECT_EQ(updates[1].fields[0].value, QStringLiteral("Bob"));
    // The number and the menu show what they were given. What is typed into is ticked.
    const auto& ticked = updates.back().fields;
    ASSERT_EQ(ticked.size(), 1U);
    EXPECT_EQ(ticked[0].index, 3);
    EXPECT_EQ(ticked[0].selected, true);
    EXPECT_FALSE(ticked[0].value);
    EXPECT_TRUE(losses_.empty());
}

TEST_F(FormProcessTest, SaysOfANumberThatItIsNone) {
    start({Ready, "for i in 1 2; do read -r line; done",
           R"(echo '{"event":"filled","form":1,"field":1,"value":"","unreadable":true}')",
           "read -r line; echo \"$line\" >> told", R"(echo '{"event":"filled","form":1,"field":1,"value":"3"}')",
           "exec cat >> told"});
    makeForm();
    ASSERT_TRUE(waitFor([&] { return toldOf<UpdateForm>().size() >= 2; }));
    const auto updates = toldOf<UpdateForm>();
    EXPECT_FALSE(updates[0].fields.at(0).problem.value_or(QString()).isEmpty());
    EXPECT_EQ(updates[1].fields.at(0).problem, QString());
}

TEST_F(FormProcessTest, FormsComeAndGo) {
    start({Ready, R"(read -r line; echo '{"event":"sized","form":1,"size":[500,300]}')",
           R"(echo '{"event":"shown","form":1,"window":77}')", R"(echo '{"event":"accepted","form":1}')",
           R"(echo '{"event":"accepted","form":1}')", R"(echo '{"event":"filled","form":9,"field":900,"value":""}')",
           "exec cat >> told"});
    makeForm();
    form_->show({{}, Size{500, 300}});
    ASSERT_TRUE(heard(2));
    EXPECT_EQ(heard_, (std::vector<std::string>{"shown 77", "accepted"}));
    ASSERT_TRUE(waitFor([&] { return toldOf<CloseForm>().size() == 1; }));
    EXPECT_EQ(toldOf<ShowForm>().size(), 1U);
    // What it says of forms that are gone, or never were, is late.
    EXPECT_TRUE(losses_.empty());
    EXPECT_EQ(runs_.size(), 1U);
    makeForm();
    ASSERT_TRUE(waitFor([&] { return toldOf<PrepareForm>().size() == 1; }));
    EXPECT_EQ(toldOf<PrepareForm>()[0].form, 2);
    EXPECT_EQ(runs_.size(), 1U);
}

TEST_F(FormProcessTest, KnowsTheSizeThatTheWindowHas) {
    start({Ready, R"(echo '{"event":"sized","form":1,"size":[500,300]}')",
           R"(echo '{"event":"shown","form":1,"window":77}')", "exec sleep 100"});
    makeForm();
    EXPECT_FALSE(form_->size());
    ASSERT_TRUE(heard(1));
    ASSERT_TRUE(form_->size());
    EXPECT_EQ(form_->size()->width, 500);
}

TEST_F(FormProcessTest, APageThatEndsOrTalksNonsenseLosesItsFormsOnce) {
    const std::string never = "exec sleep 100";
    const std::vector<std::vector<std::string>> programs = {
        {"exit 3"},
        {"kill -9 $$"},
        {Ready, "read -r line", "exit 0"},
        {Ready, "read -r line", "kill -SEGV $$"},
        {"echo nonsense", never},
        {Ready, R"(echo '{"event":"shown","form":1,"window":"1"}')", never},
        {Ready, "head -c 70000000 /dev/zero | tr '\\0' x", never},
        {Ready, R"(echo '{"event":"filled","form":1,"field":5,"value":""}')", never},
        {Ready, R"(echo '{"event":"filled","form":1,"field":2,"value":"pink"}')", never},
        {Ready, R"(echo '{"event":"filled","form":1,"field":2,"value":"pink","choice":3}')", never},
        {Ready, R"(echo '{"event":"selected","form":1,"field":0,"selected":true}')", never},
        {R"(echo '{"event":"shown","form":1,"window":1}')", never}};
    for (const auto& program : programs) {
        losses_.clear();
        runs_.clear();
        start(program);
        makeForm();
        ASSERT_TRUE(isLost()) << program[std::min<std::size_t>(1, program.size() - 1)];
        QCoreApplication::processEvents();
        EXPECT_EQ(losses_.size(), 1U) << losses_[0];
        ASSERT_EQ(runs_.size(), 2U);
        EXPECT_GT(runs_[0], 0);
        EXPECT_EQ(runs_[1], 0);
    }
    EXPECT_TRUE(heard_.empty());
}

TEST_F(FormProcessTest, AProgramThatIsNotThereIsLostAndNotWaitedFor) {
    process_ = std::make_unique<FormProcess>(path("missing").toStdString(), listener());
    EXPECT_FALSE(process_->exists());
    makeForm();
    ASSERT_TRUE(form_);
    form_->show({});
    ASSERT_TRUE(isLost());
    EXPECT_EQ(losses_.size(), 1U);
}

TEST_F(FormProcessTest, AProgramThatDoesNotListenHoldsNobodyUp) {
    start({Ready, "exec sleep 1000"});
    const std::u16string title(8'000'000, u'x');
    makeForm();
    ASSERT_TRUE(waitFor([&] { return !runs_.empty(); }));
    // More than a pipe holds, and at last more than anyone should keep for it.
    std::vector<std::unique_ptr<FormSurface>> forms;
    for (int i = 0; i < 20; ++i) forms.push_back(process_->makeForm(*model_, content_, title, {}));
    ASSERT_TRUE(isLost());
    EXPECT_EQ(losses_.size(), 1U);
    for (const auto& form : forms) form->update();
}

TEST_F(FormProcessTest, AProgramThatHasClosedItsEarsIsLost) {
    start({Ready, "exec <&-", "exec sleep 1000"});
    form_ = process_->makeForm(*model_, content_, std::u16string(1'000'000, u'x'), events());
    ASSERT_TRUE(isLost());
    EXPECT_EQ(losses_.size(), 1U);
}

TEST_F(FormProcessTest, KillingItEndsIt) {
    start({"exec sleep 1000"});
    makeForm();
    ASSERT_TRUE(waitFor([&] { return !runs_.empty(); }));
    const auto number = static_cast<pid_t>(runs_[0]);
    process_->kill();
    EXPECT_EQ(losses_.size(), 1U);
    EXPECT_TRUE(waitFor([&] { return ::kill(number, 0) != 0; }));
    process_->kill();
    EXPECT_EQ(losses_.size(), 1U);
}

TEST_F(FormProcessTest, AnIdleProgramMayEndAndIsStartedAnew) {
    start({Ready, "while read -r line; do case \"$line\" in *close*) exit 0;; esac; done"});
    for (const std::size_t round : {1U, 2U}) {
        makeForm();
        form_.reset();
        ASSERT_TRUE(waitFor([&] { return runs_.size() == 2 * round; }));
        EXPECT_EQ(runs_.back(), 0);
    }
    EXPECT_TRUE(losses_.empty());
}

TEST_F(FormProcessTest, AFormMayBeMadeWhileOthersAreLost) {
    start({"[ -e again ] || { touch again; exit 1; }", Ready, R"(echo '{"event":"shown","form":2,"window":5}')",
           "exec sleep 1000"});
    FormProcess::Listener again = listener();
    again.lost = [this](const std::string& reason) {
        losses_.push_back(reason);
        makeForm();
    };
    process_ = std::make_unique<FormProcess>(path("program").toStdString(), again);
    makeForm();
    ASSERT_TRUE(heard(1));
    EXPECT_EQ(heard_.back(), "shown 5");
    EXPECT_EQ(losses_.size(), 1U);
}

}  // namespace
}  // namespace plume
