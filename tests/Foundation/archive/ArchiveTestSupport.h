// What the tests of archives share.
#pragma once

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

namespace plume::test {

inline std::string bytesOfFile(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

// A folder of one test, that a script of tests/Foundation/archive/data/ works in as well.
class ScriptFolder {
  public:
    explicit ScriptFolder(std::string script) : script_(std::move(script)) {
        std::string name = (std::filesystem::temp_directory_path() / "plume-archive-XXXXXX").string();
        folder_ = mkdtemp(name.data());
    }
    ~ScriptFolder() { std::filesystem::remove_all(folder_); }
    ScriptFolder(const ScriptFolder&) = delete;
    ScriptFolder& operator=(const ScriptFolder&) = delete;

    // Runs the script; whether it was content. What is wrong stands in the test's output.
    bool run(const std::string& command) const {
        const std::string line =
            "python3 tests/Foundation/archive/data/" + script_ + " " + command + " '" + folder_.string() + "'";
        return std::system(line.c_str()) == 0;  // NOLINT(cert-env33-c): a script of the tests
    }
    std::string read(const std::string& name) const { return bytesOfFile(folder_ / name); }
    void write(const std::string& name, const std::string& bytes) const {
        std::ofstream(folder_ / name, std::ios::binary) << bytes;
    }

  private:
    std::string script_;
    std::filesystem::path folder_;
};

}  // namespace plume::test
