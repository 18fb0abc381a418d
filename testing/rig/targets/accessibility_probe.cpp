// Prints, one JSON object a line, what assistive programs see of one program's editable texts: role, name and text.
// Arguments: the program's name, and how many milliseconds to wait until it has such a text.

#include <atspi/atspi.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

// libatspi does not free all it allocates: leaks are not looked for in this program.
extern "C" const char* __asan_default_options();
const char* __asan_default_options() {
    return "detect_leaks=0";
}

namespace {

using nlohmann::json;

template <typename Object>
std::shared_ptr<Object> ownObject(Object* object) {
    return std::shared_ptr<Object>(object, [](Object* owned) {
        if (owned != nullptr) g_object_unref(owned);
    });
}

using Accessible = std::shared_ptr<AtspiAccessible>;

std::string takeString(char* string) {
    const std::unique_ptr<char, void (*)(void*)> owner(string, g_free);
    return string != nullptr ? string : "";
}

bool hasState(const Accessible& accessible, AtspiStateType state) {
    const auto states = ownObject(atspi_accessible_get_state_set(accessible.get()));
    return states && atspi_state_set_contains(states.get(), state) != 0;
}

void collectTexts(const Accessible& accessible, int depth, std::vector<json>& found) {
    const auto text = ownObject(atspi_accessible_get_text_iface(accessible.get()));
    if (text && hasState(accessible, ATSPI_STATE_EDITABLE)) {
        found.push_back({{"role", takeString(atspi_accessible_get_role_name(accessible.get(), nullptr))},
                         {"name", takeString(atspi_accessible_get_name(accessible.get(), nullptr))},
                         {"focused", hasState(accessible, ATSPI_STATE_FOCUSED)},
                         {"text", takeString(atspi_text_get_text(text.get(), 0, -1, nullptr))}});
    }
    constexpr int deepest = 12;
    const int children = depth < deepest ? atspi_accessible_get_child_count(accessible.get(), nullptr) : 0;
    for (int i = 0; i < children; ++i) {
        const auto child = ownObject(atspi_accessible_get_child_at_index(accessible.get(), i, nullptr));
        if (child) collectTexts(child, depth + 1, found);
    }
}

std::vector<json> textsOf(const std::string& program) {
    std::vector<json> found;
    const auto desktop = ownObject(atspi_get_desktop(0));
    const int applications = atspi_accessible_get_child_count(desktop.get(), nullptr);
    for (int i = 0; i < applications; ++i) {
        const auto application = ownObject(atspi_accessible_get_child_at_index(desktop.get(), i, nullptr));
        if (!application || takeString(atspi_accessible_get_name(application.get(), nullptr)) != program) continue;
        collectTexts(application, 0, found);
    }
    return found;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 3 || atspi_init() != 0) return 2;
    const auto end = std::chrono::steady_clock::now() + std::chrono::milliseconds(std::atoi(argv[2]));
    auto texts = textsOf(argv[1]);
    while (texts.empty() && std::chrono::steady_clock::now() < end) {
        g_usleep(10'000);  // programs do not announce when they are complete
        atspi_accessible_clear_cache(ownObject(atspi_get_desktop(0)).get());
        texts = textsOf(argv[1]);
    }
    for (const auto& text : texts) std::puts(text.dump().c_str());
    return texts.empty() ? 1 : 0;
}
