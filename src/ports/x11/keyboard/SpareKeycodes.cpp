#include "ports/x11/keyboard/SpareKeycodes.h"

#include <algorithm>

namespace plume {

void SpareKeycodes::reset(const std::vector<xcb_keycode_t>& keycodes) {
    std::vector<Loan> loans;
    for (const xcb_keycode_t keycode : keycodes) {
        const auto before = std::ranges::find(loans_, keycode, &Loan::keycode);
        loans.push_back({keycode, 0, before == loans_.end() ? -Never : before->lastUse, true});
    }
    loans_ = std::move(loans);
}

xcb_keycode_t SpareKeycodes::take(char32_t character, double now) {
    auto loan = std::ranges::find(loans_, character, &Loan::character);
    if (loan == loans_.end()) {
        loan = std::ranges::min_element(loans_, {}, &Loan::lastUse);
        if (loan == loans_.end() || !isFree(*loan, now)) return 0;
        loan->character = character;
        loan->written = false;
    }
    loan->lastUse = now;
    return loan->keycode;
}

void SpareKeycodes::extend(double since, double now) {
    for (Loan& loan : loans_) {
        if (loan.lastUse >= since) loan.lastUse = now;
    }
}

bool SpareKeycodes::canTake(const std::set<char32_t>& characters, double now) const {
    std::size_t missing = characters.size();
    std::size_t free = 0;
    for (const Loan& loan : loans_) {
        if (characters.contains(loan.character)) {
            --missing;
        } else if (isFree(loan, now)) {
            ++free;
        }
    }
    return missing <= free;
}

double SpareKeycodes::nextFree() const {
    const auto loan = std::ranges::min_element(loans_, {}, &Loan::lastUse);
    return loan == loans_.end() ? Never : loan->lastUse + Rest;
}

}  // namespace plume
