// RTF as it is put together: control words, groups and text in 7 bits.
//
// Internal to the RTF writer; one writer, one thread.
#pragma once

#include <string>
#include <string_view>

namespace plume {

class RTFOutput {
  public:
    void openGroup();
    void closeGroup();
    void control(std::string_view word);
    void control(std::string_view word, int number);
    // "\*" before a word that not every reader knows.
    void ignorableControl(std::string_view word);
    void text(std::u16string_view text);
    // A byte in hexadecimal, as "\'ac".
    void byte(unsigned char byte);
    void append(const RTFOutput& other);
    void newline();

    const std::string& bytes() const { return bytes_; }

  private:
    void unit(char16_t unit);
    void literal(char character);

    std::string bytes_;
    bool needsDelimiter_ = false;  // a control word is still open for more letters or digits
};

}  // namespace plume
