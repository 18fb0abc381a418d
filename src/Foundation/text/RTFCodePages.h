// The code pages that the bytes of RTF documents are written in.
//
// Internal to the RTF reader; one reader, one thread.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <string_view>

#include <unicode/ucnv.h>

namespace plume {

inline constexpr int RTFLatinCodePage = 1252;

// Converts the bytes of documents to text. Converters are opened when first needed and kept.
class RTFCodePages {
  public:
    // The page that a font's character set number stands for; 0 when the document's own page holds.
    static int codePageOfCharacterSet(int characterSet);
    static bool isKnown(int codePage);

    // Bytes that the page cannot convert become U+FFFD; an unknown page is taken for Latin.
    void appendText(int codePage, std::string_view bytes, std::u16string& text);

  private:
    struct Close {
        void operator()(UConverter* converter) const { ucnv_close(converter); }
    };
    UConverter* converterFor(int codePage);
    std::map<int, std::unique_ptr<UConverter, Close>> converters_;
};

}  // namespace plume
