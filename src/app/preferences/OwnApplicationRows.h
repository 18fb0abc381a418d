// The user's own rows of how programs are typed to, with the choices that most people need.
//
// What a row says besides stays as it is. A plain value; errors name what is wrong in the text.
#pragma once

#include <cstddef>
#include <nlohmann/json.hpp>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Result.h"

namespace plume {

class OwnApplicationRows {
  public:
    enum class Insertion { Automatic, Typed, Pasted };
    // Keys of a row that hold seconds.
    static constexpr const char* BeforePasting = "pastingDelay";
    static constexpr const char* AfterPasting = "afterPastingDelay";
    static constexpr const char* AfterErasing = "afterErasingDelay";

    // `builtIn`: the rows that Plume comes with, which say what holds where an own row is silent. `own`: a JSON object;
    // an empty text is none.
    static Result<OwnApplicationRows> read(std::string_view builtIn, std::string_view own);

    std::vector<std::string> names() const;
    bool has(const std::string& name) const { return own_.contains(name); }
    // Begins with what Plume knows of the program. Returns the name of the row, which is another one when there is one
    // that differs in letter case alone.
    std::string add(const std::string& name);
    void remove(const std::string& name) { own_.erase(name); }
    // JSON, as it is stored.
    std::string text() const { return own_.dump(); }

    // ---- A row that is there ----
    Insertion insertion(const std::string& name) const;
    void setInsertion(const std::string& name, Insertion insertion);
    // Such as "Control+V", several with spaces between; empty: as usual.
    std::string pasteKeys(const std::string& name) const;
    void setPasteKeys(const std::string& name, const std::string& keys);
    double seconds(const std::string& name, const char* key) const;
    void setSeconds(const std::string& name, const char* key, double seconds);

    // ---- The rows that Plume comes with ----
    struct BuiltIn {
        std::string name;
        std::string family;
    };
    std::vector<BuiltIn> builtInRows() const;

  private:
    using Json = nlohmann::ordered_json;

    const Json* builtInRow(const std::string& name) const;
    // What holds for a row by its own word, its families' or everybody's; null: nobody says anything.
    const Json* find(const Json& row, const char* key) const;
    // The same without the row itself.
    const Json* inherited(const Json& row, const char* key) const;
    void setFlag(const std::string& name, const char* flag, bool on);

    Json builtIn_;
    Json own_ = Json::object();
};

}  // namespace plume
