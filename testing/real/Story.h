#pragma once

#include <string>
#include <vector>

namespace plume::real {

// What a story asks of the place that it is played in.
enum class Needs { Nothing, Lines, Indentation, Password, Proposals };

// How it is typed.
enum class Typing { AtOnce, RollingOver, Slowly };

// What is done once it is typed, before the text is read.
enum class Then { Read, Undo, ReadClipboard };

// Something typed, and the text that must stand there afterwards.
struct Story {
    std::string name;
    std::string typed;
    std::string expected;
    Needs needs = Needs::Nothing;
    Typing typing = Typing::AtOnce;
    Then then = Then::Read;
};

// In a story's typed text: the Left key, and the way to the field before this one, where the user stays a while.
constexpr char LeftKey = '\x02';
constexpr char FieldBefore = '\x03';

// Played from the first to the last.
const std::vector<Story>& stories();

// The library that they are typed with, and the settings, as files: programs are asked to tell of their password
// fields, and the rows are the user's own, of applications.
std::string library();
std::string settings(const std::string& rows);

// What is on the clipboard while a story is played that looks after it.
extern const std::string CopiedBefore;

}  // namespace plume::real
