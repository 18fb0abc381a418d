#include "testing/rig/targets/TerminalLine.h"

#include <algorithm>
#include <utility>

namespace plume::target {

namespace {

std::size_t lengthOfCharacter(char lead) {
    const auto byte = static_cast<unsigned char>(lead);
    return byte < 0xC0 ? 1 : byte < 0xE0 ? 2 : byte < 0xF0 ? 3 : 4;
}

}  // namespace

std::vector<std::string> splitCharacters(const std::string& text) {
    std::vector<std::string> characters;
    for (std::size_t i = 0; i < text.size(); i += characters.back().size()) {
        characters.push_back(text.substr(i, lengthOfCharacter(text[i])));
    }
    return characters;
}

void TerminalLine::read(const std::string& bytes) {
    unread_ += bytes;
    while (!unread_.empty() && takeOne()) {
    }
    flush();
}

bool TerminalLine::takeOne() {
    if (unread_.front() == '\x1b') return takeSequence();
    return takeCharacter();
}

bool TerminalLine::takeSequence() {
    if (unread_.size() < 2) return false;
    if (unread_[1] != '[' && unread_[1] != 'O') {  // a key with Alt
        unread_.erase(0, 2);
        return true;
    }
    const auto end =
        std::find_if(unread_.begin() + 2, unread_.end(), [](char byte) { return byte >= 0x40 && byte <= 0x7E; });
    if (end == unread_.end()) return false;
    const std::string sequence(unread_.begin() + 2, end + 1);
    unread_.erase(unread_.begin(), end + 1);
    flush();
    perform(sequence);
    return true;
}

bool TerminalLine::takeCharacter() {
    const std::size_t length = lengthOfCharacter(unread_.front());
    if (unread_.size() < length) return false;
    const std::string character = unread_.substr(0, length);
    unread_.erase(0, length);
    if (character == "\x7f" || character == "\b") {
        flush();
        if (caret_ > 0) remove(caret_ - 1);
    } else if (character == "\r") {
        insert("\n");
    } else if (length > 1 || static_cast<unsigned char>(character[0]) >= 0x20 || character == "\t" ||
               character == "\n") {
        insert(character);
    }
    return true;
}

void TerminalLine::perform(const std::string& sequence) {
    if (sequence == "201~") listener_.pasted();
    if (sequence == "D" && caret_ > 0) --caret_;
    if (sequence == "C" && caret_ < characters_.size()) ++caret_;
    if (sequence == "H") caret_ = 0;
    if (sequence == "F") caret_ = characters_.size();
    if (sequence == "3~" && caret_ < characters_.size()) remove(caret_);
}

void TerminalLine::insert(const std::string& text) {
    characters_.insert(characters_.begin() + static_cast<std::ptrdiff_t>(caret_), text);
    ++caret_;
    run_ += text;
}

void TerminalLine::remove(std::size_t from) {
    characters_.erase(characters_.begin() + static_cast<std::ptrdiff_t>(from));
    caret_ = from;
    listener_.changed(static_cast<int>(from), 1, "");
}

void TerminalLine::flush() {
    if (run_.empty()) return;
    const std::string run = std::exchange(run_, {});
    listener_.changed(static_cast<int>(caret_ - splitCharacters(run).size()), 0, run);
}

std::string TerminalLine::text() const {
    std::string text;
    for (const auto& character : characters_) text += character;
    return text;
}

void TerminalLine::setText(const std::string& text) {
    const int before = length();
    characters_ = splitCharacters(text);
    caret_ = characters_.size();
    listener_.changed(0, before, text);
}

}  // namespace plume::target
