// plume-form: draws the forms of snippets with fields as pages. Plume starts it, and speaks to it over standard input
// and output.
#include <sys/resource.h>
#include <unistd.h>

#include <QApplication>
#include <QLibraryInfo>
#include <QLocale>
#include <QTranslator>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/UserLocale.h"
#include "app/form/helper/FormHost.h"
#include "app/form/helper/FormScheme.h"
#include "app/form/helper/HostPipe.h"
#include "app/qt/ColorScheme.h"
#include "app/status/StatusIcons.h"

namespace {

// What is typed into forms is not for files.
void keepNoCores() {
    const rlimit none{0, 0};
    setrlimit(RLIMIT_CORE, &none);
}

void setEnvironment() {
    // Nobody looks into pages, and nobody else says how they are drawn.
    for (const char* const name : {"QTWEBENGINE_REMOTE_DEBUGGING", "QTWEBENGINE_CHROMIUM_FLAGS"}) qunsetenv(name);
    // What draws pages refuses to do so for root, in tests say, inside its sandbox.
    if (geteuid() == 0) qputenv("QTWEBENGINE_DISABLE_SANDBOX", "1");
    qputenv("QT_QUICK_BACKEND", "software");
}

// Numbers are shown with the user's decimal sign.
std::string languageOfNumbers() {
    std::string name = plume::userLocale(plume::LocaleCategory::Numbers);
    name = name.substr(0, name.find('@'));
    if (name == "en_US_POSIX") return "en-US";
    for (char& c : name) {
        if (c == '_') c = '-';
    }
    return name;
}

std::vector<std::string> arguments(const char* program, bool isAccessible) {
    std::vector<std::string> all = {program,
                                    "--webEngineArgs",
                                    "--lang=" + languageOfNumbers(),
                                    "--disable-gpu",
                                    "--renderer-process-limit=1",
                                    "--js-flags=--jitless",
                                    "--disable-logging",
                                    "--disable-breakpad",
                                    "--disable-background-networking",
                                    "--no-pings",
                                    "--host-resolver-rules=MAP * ~NOTFOUND"};
    if (isAccessible) all.emplace_back("--force-renderer-accessibility");
    return all;
}

void installTexts(QApplication& application) {
    for (const char* const name : {"qtbase", "qtwebengine"}) {
        auto* const translator = new QTranslator(&application);
        if (translator->load(QLocale::system(), QLatin1String(name), QStringLiteral("_"),
                             QLibraryInfo::path(QLibraryInfo::TranslationsPath))) {
            QApplication::installTranslator(translator);
        }
    }
}

}  // namespace

int main(int argc, char** argv) {
    keepNoCores();
    plume::HostPipe pipe;
    setEnvironment();
    plume::FormScheme::announce();
    std::vector<std::string> texts = arguments(argv[0], argc > 1 && std::string_view(argv[1]) == "--accessible");
    std::vector<char*> words;
    words.reserve(texts.size() + 1);
    for (std::string& text : texts) words.push_back(text.data());
    int count = static_cast<int>(words.size());
    words.push_back(nullptr);

    QApplication application(count, words.data());
    QApplication::setApplicationName(QStringLiteral("plume-form"));
    QGuiApplication::setDesktopFileName(QStringLiteral("org.plume.Plume"));
    QApplication::setWindowIcon(plume::applicationIcon());
    QApplication::setQuitOnLastWindowClosed(false);
    installTexts(application);
    const auto scheme = plume::followColorScheme();
    const plume::FormHost host(pipe);
    return QApplication::exec();
}
