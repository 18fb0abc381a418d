#!/usr/bin/env python3
"""Holds the layers apart: every #include "…" of a source file must lead to a folder that its own folder may see."""
import pathlib
import re
import sys

ROOT = pathlib.Path(__file__).resolve().parent.parent / "src"

# Folder -> the folders whose headers it may include, besides its own. Lower layers never see higher ones.
MAY_SEE = {
    "Foundation": set(),
    "platform": {"Foundation"},
    "library": {"Foundation", "platform"},
    "content": {"Foundation", "platform", "library"},
    "input": {"Foundation", "platform", "library", "content"},
    "engine": {"Foundation", "platform", "library", "content", "input"},
    "platform/simulated": {"Foundation", "platform", "input"},
    "platform/desktop": {"Foundation", "platform"},
    "platform/x11": {"Foundation", "platform", "platform/desktop", "input"},
    "app": {"Foundation", "platform", "library", "content", "input", "engine", "platform/simulated",
            "platform/desktop", "platform/x11"},
}
# Foreign headers by folder; everything else that is included with <…> is the standard library's or the system's.
FOREIGN = re.compile(r"^(unicode/|Q[A-Z]|xcb/|X11/|xkbcommon/|atspi|dbus|expat|sqlite3|CLI/|glib|nlohmann/|canberra)")
# Folder -> what of these it may include; the first entry holds everywhere.
MAY_USE = {
    "": ("unicode/",),
    "platform/x11": ("xcb/", "X11/", "xkbcommon/"),
    "platform/desktop": ("canberra", "dbus"),
    "app": ("CLI/", "nlohmann/", "xcb/"),
}

INCLUDE = re.compile(r'^\s*#\s*include\s+(["<])([^">]+)[">]')


def folder_of(path: str) -> str:
    parts = path.split("/")[:-1]
    while parts and "/".join(parts) not in MAY_SEE:
        parts.pop()
    return "/".join(parts)


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
            if FOREIGN.match(target) and not target.startswith(MAY_USE[""] + MAY_USE.get(own, ())):
                yield f"{where}: <{target}> belongs to the ports and the application"
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
