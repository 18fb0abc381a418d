// What launchers ask for on the session bus is what the command line does.
#include "app/session/SessionAdaptors.h"

#include <gtest/gtest.h>

#include <fstream>
#include <map>
#include <string>

namespace plume {
namespace {

// The values of a desktop file, each by its group and key.
std::map<std::string, std::string> valuesOf(const char* path) {
    std::map<std::string, std::string> values;
    std::ifstream file(path);
    std::string group;
    for (std::string line; std::getline(file, line);) {
        if (line.starts_with('[')) group = line.substr(1, line.find(']') - 1);
        const std::size_t equals = line.find('=');
        if (equals != std::string::npos) values[group + "/" + line.substr(0, equals)] = line.substr(equals + 1);
    }
    return values;
}

class SessionAdaptorsTest : public testing::Test {
  protected:
    // The bus of whoever runs the tests is left alone.
    static void SetUpTestSuite() { qputenv("DBUS_SESSION_BUS_ADDRESS", "unix:path=/nowhere"); }

    // The command that the service is asked to perform.
    std::string commandOf(const std::string& action) {
        command_ = "plume";
        service_.findChild<LauncherAdaptor*>()->ActivateAction(QString::fromStdString(action), {}, {});
        return command_;
    }

  private:
    std::string command_;
    SessionService service_{[this](const std::vector<std::string>& words) {
        for (const std::string& word : words) command_ += " " + word;
        return CommandReply();
    }};
};

// Launchers that know the bus call an action by its name, others run its command.
TEST_F(SessionAdaptorsTest, ActionsDoWhatTheirCommandsDo) {
    auto values = valuesOf("data/org.plume.Plume.desktop");
    const QStringList actions = QString::fromStdString(values["Desktop Entry/Actions"]).split(';', Qt::SkipEmptyParts);
    EXPECT_TRUE(actions.contains("quick-search"));
    for (const QString& each : actions) {
        const std::string action = each.toStdString();
        const std::string group = "Desktop Action " + action;
        EXPECT_EQ(commandOf(action), values[group + "/Exec"]);
        for (const char* name : {"/Name", "/Name[de]", "/Name[fr]"}) EXPECT_NE(values[group + name], "") << group;
    }
}

}  // namespace
}  // namespace plume
