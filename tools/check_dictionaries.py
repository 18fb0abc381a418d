#!/usr/bin/env python3
"""Checks the dictionaries of corrections: pairs of lines, each misspelling once, none of them a correction of another.

With --words, which takes a list of words, one a line, no misspelling of the given dictionaries may be in that list.
"""
import argparse
import pathlib
import sys
import unicodedata

FOLDER = pathlib.Path(__file__).resolve().parent.parent / "data" / "dictionaries"
LEAST_PAIRS = {"English": 600, "French": 300, "German": 300}


def dictionaries() -> list:
    return sorted(FOLDER.glob("AutoCorrect Dictionary (*)"))


def language_of(file: pathlib.Path) -> str:
    return file.name.partition("(")[2].rstrip(")")


def faults_in_line(line: str):
    if not line.strip():
        yield "expected a word, not an empty line"
    elif line != line.strip():
        yield f"blanks around “{line}”"
    if unicodedata.normalize("NFC", line) != line:
        yield f"“{line}” is not in the composed form"
    if any(unicodedata.category(letter).startswith("C") for letter in line):
        yield "a control character"


def faults_in_pairs(pairs: list, words: set):
    corrections = {correction for _, correction in pairs}
    places = {}
    for number, (misspelling, correction) in enumerate(pairs):
        line = 2 * number + 1
        key = misspelling.lower()
        if key in places:
            yield line, f"“{misspelling}” stands in line {places[key]} already"
        places.setdefault(key, line)
        if key == correction.lower():
            yield line, f"“{misspelling}” corrects nothing but case"
        if misspelling in corrections:
            yield line, f"“{misspelling}” is what another one is corrected to"
        if key in words:
            yield line, f"“{misspelling}” is a word"


def faults_in(file: pathlib.Path, words: set):
    lines = file.read_text(encoding="utf-8").split("\n")
    if lines[-1] == "":
        lines.pop()
    for number, line in enumerate(lines, 1):
        for fault in faults_in_line(line):
            yield f"{file.name}:{number}: {fault}"
    if len(lines) % 2:
        yield f"{file.name}:{len(lines)}: a last line alone; expected pairs"
    pairs = list(zip(lines[::2], lines[1::2]))
    for number, fault in faults_in_pairs(pairs, words):
        yield f"{file.name}:{number}: {fault}"
    least = LEAST_PAIRS.get(language_of(file), 1)
    if len(pairs) < least:
        yield f"{file.name}: {len(pairs)} pairs; expected at least {least}"


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.partition("\n")[0])
    parser.add_argument("files", nargs="*", type=pathlib.Path, help="instead of all in data/dictionaries")
    parser.add_argument("--words", action="append", default=[], type=pathlib.Path, help="a list of words")
    arguments = parser.parse_args()
    files = arguments.files or dictionaries()
    missing = [] if arguments.files else sorted(LEAST_PAIRS.keys() - {language_of(file) for file in files})
    words = {word.lower() for file in arguments.words for word in file.read_text(encoding="utf-8").split("\n") if word}
    faults = [f"no dictionary for {language}" for language in missing]
    faults += [fault for file in files for fault in faults_in(file, words)]
    print("\n".join(faults) if faults else f"dictionaries: {len(files)} are in order")
    return 1 if faults else 0


if __name__ == "__main__":
    sys.exit(main())
