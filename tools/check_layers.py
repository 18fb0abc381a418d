#!/usr/bin/env python3
"""Holds the layers apart: every #include "…" of a source file must lead to a folder that its own folder may see."""
import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parent.parent / "src"

FOUNDATION = {"Foundation", "Foundation/archive", "Foundation/json", "Foundation/text"}
CORE = FOUNDATION | {"platform", "library", "import", "content", "content/scripts", "input", "engine"}
X11 = {"ports/x11", "ports/x11/clipboard", "ports/x11/keyboard", "ports/x11/watchdog", "ports/x11/windows"}
PORT = FOUNDATION | {"platform"}
WINDOWS = {"app/qt", "app/ranking", "app/status", "app/preferences", "app/search", "app/editor", "app/form", "app/windows", "app/session"}

# Folder -> the folders whose headers it may include, besides its own. Lower layers never see higher ones. A folder that
# is not named here belongs to the one that it lies in.
MAY_SEE = {
    "Foundation": set(),
    "Foundation/text": {"Foundation"},
    "Foundation/json": {"Foundation"},
    "Foundation/archive": {"Foundation", "Foundation/text"},
    "platform": {"Foundation", "Foundation/archive", "Foundation/text"},
    "ports/posix": PORT,
    "ports/simulated": PORT,
    "ports/dbus": PORT | {"ports/posix"},
    "ports/atspi": PORT | {"ports/posix", "ports/dbus"},
    "ports/x11": PORT | {"ports/posix"},
    "ports/x11/windows": PORT | {"ports/posix", "ports/x11"},
    "ports/x11/clipboard": PORT | {"ports/posix", "ports/x11"},
    "ports/x11/keyboard": PORT | {"ports/posix", "ports/x11"},
    "ports/x11/watchdog": PORT | {"ports/posix", "ports/x11", "ports/x11/clipboard", "ports/x11/keyboard"},
    "library": FOUNDATION | {"platform"},
    "import": FOUNDATION | {"platform", "library", "content"},
    "content/scripts": {"Foundation", "platform"},
    "content": FOUNDATION | {"platform", "library", "content/scripts"},
    "input": FOUNDATION | {"platform", "library", "content"},
    "engine": FOUNDATION | {"platform", "library", "content", "content/scripts", "input"},
    "app": CORE,
    "app/linux": CORE | X11 | {"app", "ports/posix", "ports/dbus", "ports/atspi"},
    "app/ranking": CORE,
    "app/editing": CORE,
    "app/qt": CORE | {"app", "ports/posix"},
    "app/status": CORE | {"app", "app/qt"},
    "app/preferences": CORE | {"app", "app/qt"},
    "app/search": CORE | {"app", "app/qt", "app/ranking"},
    "app/editor": CORE | {"app", "app/qt", "app/editing", "app/search", "app/preferences"},
    "app/form": CORE | {"app", "app/qt"},
    "app/form/helper": CORE | {"app", "app/qt", "app/form", "app/status"},
    "app/windows": CORE | {"app", "app/qt"},
    "app/session": CORE | {"app", "app/qt", "ports/posix"},
    "scenario": CORE | {"app", "ports/simulated", "ports/posix"},
    "app/cli": CORE | X11 | {"app", "app/linux", "scenario", "ports/posix", "ports/dbus", "ports/atspi"} | WINDOWS,
}
# Foreign headers by folder; everything else that is included with <…> is the standard library's or the system's.
FOREIGN = re.compile(r"^(unicode/|Q[A-Z]|xcb/|X11/|xkbcommon/|atspi|dbus|expat|sqlite3|CLI/|glib|nlohmann/|canberra|yaml-cpp/|libxml/|md4c)")
# Folder, with those inside it -> what of these it may include; the first entry holds everywhere.
MAY_USE = {
    "": ("unicode/",),
    "ports/x11": ("xcb/", "X11/", "xkbcommon/"),
    "ports/atspi": ("dbus",),
    "ports/dbus": ("dbus",),
    "ports/posix": ("canberra", "sqlite3"),
    "Foundation/archive": ("expat",),
    "Foundation/json": ("nlohmann/",),
    "Foundation/text": ("libxml/", "md4c"),
    "import": ("expat", "nlohmann/", "yaml-cpp/"),
    "library": ("nlohmann/",),
    "scenario": ("nlohmann/",),
    "app/linux": ("xcb/",),
    "app/qt": ("Q",),
    "app/status": ("Q", "xcb/"),
    "app/preferences": ("Q", "nlohmann/"),
    "app/search": ("Q",),
    "app/editor": ("Q",),
    "app/form": ("Q", "nlohmann/"),
    "app/windows": ("Q",),
    "app/session": ("Q",),
    "app/cli": ("CLI/", "nlohmann/", "xcb/", "Q"),
}

INCLUDE = re.compile(r'^\s*#\s*include\s+(["<])([^">]+)[">]')


def folder_of(path: str) -> str:
    parts = path.split("/")[:-1]
    while parts and "/".join(parts) not in MAY_SEE:
        parts.pop()
    return "/".join(parts)


def foreign_headers_for(folder: str) -> tuple:
    return sum((use for where, use in MAY_USE.items() if not where or (folder + "/").startswith(where + "/")), ())


def faults_in(file: pathlib.Path):
    own = folder_of(file.relative_to(ROOT).as_posix())
    if not own:
        yield f"{file}: this folder is in no layer; name it in tools/check_layers.py"
        return
    for number, line in enumerate(file.read_text(encoding="utf-8").splitlines(), 1):
        found = INCLUDE.match(line)
        if not found:
            continue
        kind, target = found.groups()
        where = f"{file.relative_to(ROOT.parent)}:{number}"
        if kind == "<":
            if FOREIGN.match(target) and not target.startswith(foreign_headers_for(own)):
                yield f"{where}: <{target}> belongs to the ports and the application"
            continue
        if target.endswith(".moc"):  # made by the build, of the file itself
            continue
        seen = folder_of(target)
        if not (ROOT / target).exists():
            yield f'{where}: "{target}" does not exist under src/'
        elif seen != own and seen not in MAY_SEE[own]:
            yield f'{where}: {own} must not see {seen} ("{target}")'


def main() -> int:
    files = sorted(p for p in ROOT.rglob("*") if p.suffix in {".h", ".cpp"})
    faults = [fault for file in files for fault in faults_in(file)]
    print("\n".join(faults) if faults else f"layers: {len(files)} files keep to them")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
