#include "ports/x11/keyboard/SpareKeycodes.h"

#include <algorithm>

namespace plume {

void SpareKeycodes::reset(const std::vector<xcb_keycode_t>& keycodes) {
    std::vector<Assignment> assignments;
    for (const xcb_keycode_t keycode : keycodes) {
        const auto before = std::ranges::find(assignments_, keycode, &Assignment::keycode);
        assignments.push_back({keycode, 0, before == assignments_.end() ? -Never : before->lastUse, true});
    }
    assignments_ = std::move(assignments);
}

xcb_keycode_t SpareKeycodes::take(char32_t character, double now) {
    auto assignment = std::ranges::find(assignments_, character, &Assignment::character);
    if (assignment == assignments_.end()) {
        assignment = std::ranges::min_element(assignments_, {}, &Assignment::lastUse);
        if (assignment == assignments_.end() || !isFree(*assignment, now)) return 0;
        assignment->character = character;
        assignment->written = false;
    }
    assignment->lastUse = now;
    return assignment->keycode;
}

void SpareKeycodes::extend(double since, double now) {
    for (Assignment& assignment : assignments_) {
        if (assignment.lastUse >= since) assignment.lastUse = now;
    }
}

bool SpareKeycodes::canTake(const std::set<char32_t>& characters, double now) const {
    std::size_t missing = characters.size();
    std::size_t free = 0;
    for (const Assignment& assignment : assignments_) {
        if (characters.contains(assignment.character)) {
            --missing;
        } else if (isFree(assignment, now)) {
            ++free;
        }
    }
    return missing <= free;
}

double SpareKeycodes::nextFree() const {
    const auto assignment = std::ranges::min_element(assignments_, {}, &Assignment::lastUse);
    return assignment == assignments_.end() ? Never : assignment->lastUse + Rest;
}

}  // namespace plume
