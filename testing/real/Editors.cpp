#include "testing/real/RealProgram.h"

namespace plume::real {

namespace {

using rig::Key;

const std::vector<Needs> PlainText = {Needs::Lines, Needs::Indentation};
const std::string Indented = "several lines, indented";
// With an indentation that the program gave to the line of the abbreviation, and not to the snippet's lines.
const std::string IndentedOnce = "So\n    on\n    Jo Doe\n1 Sample Street\nSampletown";

RealProgram editor(const std::string& name, const std::string& windowClass, std::vector<std::string> command) {
    return {name, name, windowClass, std::move(command), {{.offers = PlainText}}, {{"text.txt", ""}}};
}

RealProgram indenting(RealProgram program) {
    program.places[0].expected[Indented] = IndentedOnce;
    return program;
}

// It is emptied by a command of its own: where Backspace finds nothing, Emacs may forget what is typed behind it.
RealProgram emacs() {
    constexpr const char* Start = R"((progn
  (setq make-backup-files nil auto-save-default nil inhibit-startup-screen t ring-bell-function 'ignore)
  (switch-to-buffer "story")
  (text-mode)
  (put 'erase-buffer 'disabled nil)
  (global-set-key [f2] 'erase-buffer)
  (electric-indent-local-mode 1)
  (setq-local indent-line-function 'indent-relative)
  (run-with-idle-timer 0.02 t
    (lambda () (let ((coding-system-for-write 'utf-8)) (write-region nil nil "{}/text" nil 'quiet)))))
)";
    Place place{.reading = Reading::File, .offers = {Needs::Lines}};
    place.clear = [](rig::DesktopRig& rig) {
        rig.keyboard().tap(Key::F2);
        rig.keyboard().sync();
    };
    return {"Emacs", "emacs-gtk", "Emacs", {"emacs", "-Q", "--load", "{}/start.el"}, {place}, {{"start.el", Start}}};
}

// It puts what it has pasted on the clipboard itself: then that is no longer Plume's to give back.
RealProgram copyingPastes(RealProgram program) {
    program.places[0].expected["clipboard"] = "bold and plain";
    return program;
}

RealProgram gvim() {
    constexpr const char* Start = R"(
set nocompatible encoding=utf-8 autoindent noswapfile guioptions=c noeol nofixeol belloff=all
autocmd TextChanged,TextChangedI,TextChangedP * call writefile(getline(1, '$'), '{}/text')
startinsert
)";
    Place place{.reading = Reading::File, .offers = PlainText};
    place.clear = [](rig::DesktopRig& rig) {
        rig.keyboard().tap(Key::Escape);
        rig.keyboard().type(":%d\ni");
    };
    return indenting(
        {"gvim", "vim-gtk3", "Gvim", {"gvim", "-f", "-u", "{}/start.vim"}, {place}, {{"start.vim", Start}}});
}

}  // namespace

std::vector<RealProgram> editors() {
    return {
        indenting(editor("gedit", "edit", {"gedit", "--standalone", "{}/text.txt"})),
        indenting(editor("gnome-text-editor", "ext", {"gnome-text-editor", "--standalone", "{}/text.txt"})),
        editor("mousepad", "ousepad", {"mousepad", "--disable-server", "{}/text.txt"}),
        indenting(editor("kate", "kate", {"kate", "--startanon", "{}/text.txt"})),
        indenting(editor("kwrite", "kwrite", {"kwrite", "{}/text.txt"})),
        indenting(editor("geany", "eany", {"geany", "--no-session", "--new-instance", "{}/text.txt"})),
        indenting(editor("featherpad", "eather", {"featherpad", "--standalone", "{}/text.txt"})),
        copyingPastes(editor("l3afpad", "3afpad", {"l3afpad", "{}/text.txt"})),
        emacs(),
        gvim(),
    };
}

}  // namespace plume::real
