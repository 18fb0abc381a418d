// A program as people have it on their desktop, and the places in it that text can be typed into.
#pragma once

#include <filesystem>
#include <functional>
#include <map>
#include <string>
#include <vector>

#include "testing/real/Story.h"
#include "testing/rig/DesktopRig.h"

namespace plume::real {

// How the text of a place is read.
enum class Reading {
    Copying,  // select all, copy, and the clipboard
    Title,    // a page writes it into its title, and the program shows that as the title of its window
    Lines,    // Return hands it to a shell, which adds it to a file
    File,     // the program writes it into a file after every change
};

struct Place {
    std::string name = {};  // empty for a program with one place
    Reading reading = Reading::Copying;
    std::vector<Needs> offers = {};
    // What the program needs before it has done what a key says that types nothing. It tells nobody.
    rig::Milliseconds settling{0};
    // Gives it the focus. Empty: it has it.
    std::function<void(rig::DesktopRig&)> enter = {};
    // Makes it ready for the next story. Empty: select all and erase.
    std::function<void(rig::DesktopRig&)> clear = {};
    // What a program makes of a story by rules of its own, by the story's name.
    std::map<std::string, std::string> expected = {};
    // An address that is gone to before anything is played, and proposed from then on.
    std::string visited = {};
};

struct RealProgram {
    std::string name;
    std::string package;
    std::string windowClass;           // a part of its window's WM_CLASS
    std::vector<std::string> command;  // {} in it is the folder for the program's files
    std::vector<Place> places;
    std::map<std::string, std::string> files = {};  // for that folder, by name
    rig::Environment environment = {};              // "NAME=value"
    // Its folder is served on this machine, by HTTP: {port} in the command and in what is visited is where.
    bool isServed = false;
};

const std::vector<RealProgram>& realPrograms();

// The tables that make it up.
std::vector<RealProgram> editors();
std::vector<RealProgram> offices();
std::vector<RealProgram> browsers();
std::vector<RealProgram> terminals();
std::vector<RealProgram> others();

}  // namespace plume::real
