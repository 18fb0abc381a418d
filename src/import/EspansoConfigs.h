// The folder config/ of espanso: which files of matches are active in which applications.
#pragma once

#include <filesystem>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "import/Remarks.h"
#include "import/YamlFile.h"
#include "library/PLFunctionAvailability.h"

namespace plume {

// `*` and `?` within a name, `**/` any folders, `[!_]` one of or none of some characters.
bool matchesGlob(std::string_view pattern, std::string_view path);

class EspansoConfig {
  public:
    // `fallback` holds for what the file does not say; null for the default one. Remarks tell which settings stay
    // behind.
    EspansoConfig(const std::filesystem::path& path, YamlValue::Pointer root, const EspansoConfig* fallback,
                  Remarks& remarks);

    bool includes(const std::filesystem::path& matchFile) const;
    // The applications in which it counts; empty when a list of applications cannot say it.
    const std::vector<std::u16string>& applications() const { return applications_; }
    // On other systems only.
    bool isForOtherSystems() const { return isForOtherSystems_; }
    std::optional<std::u16string> wordSeparators() const;

  private:
    std::vector<std::string> patterns(std::string_view key) const;
    void readFilters(Remarks& remarks);

    std::filesystem::path path_;
    YamlValue::Pointer root_;
    const EspansoConfig* fallback_;
    std::vector<std::u16string> applications_;
    bool isForOtherSystems_ = false;
    bool isEnabled_ = true;
};

// The applications that the keys filter_class, filter_exec and filter_title of a file name. What a list of applications
// cannot say is told in `remarks`.
std::vector<std::u16string> espansoApplications(const YamlValue& file, Remarks& remarks);

}  // namespace plume
