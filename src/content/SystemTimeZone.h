// The time zone that the computer is in, for as long as the program runs.
//
// ICU asks for it once and stays with it; a computer that travels would be told the time of where it came from.
#pragma once

#include <sys/stat.h>

#include <mutex>
#include <optional>
#include <string>
#include <utility>

namespace plume {

class SystemTimeZone {
  public:
    // The file that says the zone, or a link to it.
    explicit SystemTimeZone(std::string file = "/etc/localtime") : file_(std::move(file)) {}

    // Makes the computer's zone of now ICU's default one. Two looks at the file when nothing has changed, a millisecond
    // or so (where the file is no link: a tenth of a second) when it has. From any thread. A process has one that does
    // this, since the default is the whole process's.
    void follow();

  private:
    // What changes when another zone is chosen: of the file itself, and of what it links to in the end.
    struct FileState {
        struct Node {
            dev_t device = 0;
            ino_t number = 0;
            time_t seconds = 0;
            long nanoseconds = 0;
            bool operator==(const Node&) const = default;
        };
        Node file;
        Node target;
        bool operator==(const FileState&) const = default;
    };
    FileState look() const;

    const std::string file_;
    std::mutex mutex_;
    std::optional<FileState> seen_;  // nothing: never looked
};

}  // namespace plume
