// Runs the built program as a shell would, in a home folder of its own and without a display.
#pragma once

#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace plume {

struct ProgramResult {
    int status = -1;
    std::string output;
    std::string error;
};

// One at a time: the environment of the test is changed for it.
class ProgramHome {
  public:
    ProgramHome();
    ~ProgramHome();
    ProgramHome(const ProgramHome&) = delete;
    ProgramHome& operator=(const ProgramHome&) = delete;

    // Waits at most 20 seconds.
    ProgramResult run(const std::vector<std::string>& arguments) const;
    // The same for another program, by its whole path.
    ProgramResult runOther(const std::string& program, const std::vector<std::string>& arguments) const;
    // Where the program is.
    static std::string program();
    // Gives the program a variable of its environment, or takes it away.
    void set(const std::string& name, const std::optional<std::string>& value);
    // Writes a file, below the home folder, and gives its path.
    std::string write(const std::string& name, const std::string& content) const;

  private:
    static void put(const std::string& name, const std::optional<std::string>& value);

    std::filesystem::path folder_;
    std::map<std::string, std::optional<std::string>> before_;
};

}  // namespace plume
