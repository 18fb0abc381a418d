// How the applications of a platform are typed to: what holds for all that nobody has named, and rows for the others.
//
// A value; made once and then only read, from any thread. The file's form is told in docs/applications.md.
#pragma once

#include <map>
#include <string>
#include <string_view>

#include "Foundation/Result.h"
#include "Foundation/json/JsonNode.h"
#include "input/delivery/ApplicationRow.h"
#include "input/delivery/ContextInputSetting.h"

namespace plume {

// Rows by identifier. Letter case makes no difference; a row whose identifier ends with "*" holds for all that begin
// so.
class ApplicationRows {
  public:
    // Null when no row fits. The longest beginning counts, and the whole identifier before all beginnings.
    const ContextInputSetting* find(std::u16string_view identifier) const;

  private:
    friend class ApplicationTable;
    std::map<std::u16string, ContextInputSetting, std::less<>> byIdentifier_;
    std::map<std::u16string, ContextInputSetting, std::less<>> byBeginning_;
};

class ApplicationTable {
  public:
    // Knows nothing of any application.
    ApplicationTable() = default;
    // A whole file. The error names it, the place in it and what was expected.
    static Result<ApplicationTable> read(std::string_view text, const std::string& fileName);

    // Rows of somebody else's, who may name this table's families. An error as above.
    Result<ApplicationRows> readRows(std::string_view text, const std::string& fileName) const;

    const ContextInputSetting* find(std::u16string_view identifier) const { return rows_.find(identifier); }
    const ContextInputSetting& otherwise() const { return otherwise_; }

  private:
    ApplicationRows rowsFrom(const JsonNode& node) const;
    static ApplicationTable readFrom(const JsonNode& node);

    ContextInputSetting otherwise_;
    ApplicationFamilies families_;
    ApplicationRows rows_;
};

}  // namespace plume
