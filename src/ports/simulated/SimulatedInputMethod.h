// An input method on the simulated desktop: small letters are composed, and a space puts the word that they stand for.
#pragma once

#include <map>
#include <optional>
#include <string>
#include <utility>

namespace plume {

class SimulatedInputMethod {
  public:
    // What programs get by one key.
    struct Outcome {
        std::u16string text;
        bool keyPasses = false;  // behind the text
    };

    // Words by their letters; letters that stand for none stay as they are. Without any words nothing is composed.
    void setWords(std::map<std::u16string, std::u16string> words) { words_ = std::move(words); }
    bool takesText() const { return !words_.empty(); }
    bool isComposing() const { return !letters_.empty(); }

    // The user presses a key that produces this.
    Outcome press(char16_t produced) {
        if (produced >= u'a' && produced <= u'z') {
            letters_ += produced;
            return {};
        }
        if (!isComposing()) return {{}, true};
        if (produced == u'\b') {
            letters_.pop_back();
            return {};
        }
        const auto word = words_.find(letters_);
        const std::u16string letters = std::exchange(letters_, {});
        return {word == words_.end() ? letters : word->second, produced != u' '};
    }

  private:
    std::map<std::u16string, std::u16string> words_;
    std::u16string letters_;  // that are being composed
};

}  // namespace plume
