#!/usr/bin/env python3
"""Holds the translations in data/translations to the texts in the sources.

Every text is translated, none is left over, and what programs and fingers look for in it is in its translation too:
placeholders, line ends, "…", a mnemonic of its own. Ends with status 1 and a sentence for each fault.
"""

import argparse
import collections
import pathlib
import re
import subprocess
import sys
import tempfile
import xml.etree.ElementTree as ElementTree

Message = collections.namedtuple("Message", "context source comment counts forms finished")

# Whose texts stand in more than one window or menu. Their tests see to the mnemonics.
SEVERAL_WINDOWS = {"plume::ImportWindow", "plume::MacrosWindowController", "plume::PreferencesWindow", "plume::StatusMenu"}

PLACEHOLDERS = re.compile(r"%(?:\d|n|@)|\(\*[^)]*\)")
MNEMONIC = re.compile(r"&([^&\s])")


def text_of(element):
    """The element's text, in which line ends may be written as elements."""
    if element is None:
        return ""
    text = element.text or ""
    for child in element:
        if child.tag == "byte":
            text += chr(int(child.get("value")[1:], 16))
        text += child.tail or ""
    return text


def messages_in(path):
    for context in ElementTree.parse(path).getroot().iter("context"):
        for message in context.iter("message"):
            translation = message.find("translation")
            counts = message.get("numerus") == "yes"
            forms = translation.findall("numerusform") if counts else [translation]
            yield Message(
                context.findtext("name"),
                text_of(message.find("source")),
                message.findtext("comment") or "",
                counts,
                [text_of(form) for form in forms],
                translation.get("type") is None,
            )


def key_of(message):
    return message.context, message.source, message.comment, message.counts


def texts_in_sources(root, lupdate):
    with tempfile.TemporaryDirectory() as folder:
        fresh = pathlib.Path(folder) / "fresh.ts"
        source = root / "src"
        command = [lupdate, "-silent", "-locations", "none", "-I", source, source, "-ts", fresh]
        subprocess.run(command, check=True)
        return {key_of(message) for message in messages_in(fresh)}


def end_of(text):
    return re.search(r"[\s\u202f]*[:.…?]?$", text).group().replace("\u202f", "")


def faults_of(message):
    if not message.finished or not all(message.forms):
        yield "is not translated"
        return
    for form in message.forms:
        if sorted(PLACEHOLDERS.findall(form)) != sorted(PLACEHOLDERS.findall(message.source)):
            yield "has other placeholders"
        if re.findall(r"[\r\n]", form) != re.findall(r"[\r\n]", message.source):
            yield "has other line ends"
        if form.startswith(" ") != message.source.startswith(" ") or end_of(form) != end_of(message.source):
            yield "begins or ends differently"
        if len(MNEMONIC.findall(form)) != len(MNEMONIC.findall(message.source)):
            yield "has a mnemonic too many or too few"


def shared_mnemonics(messages):
    taken = {}
    for message in messages:
        for letter in MNEMONIC.findall(message.forms[0]) if message.forms else []:
            if message.context in SEVERAL_WINDOWS:
                continue
            other = taken.setdefault((message.context, letter.lower()), message)
            if other is not message:
                yield f"{message.context}: '{message.forms[0]}' and '{other.forms[0]}' share a mnemonic"


def check(path, expected):
    messages = list(messages_in(path))
    there = {key_of(message) for message in messages}
    for context, source, *_ in sorted(expected - there):
        yield f"{context}: '{source}' is missing: build plume_update_translations, then translate it"
    for context, source, *_ in sorted(there - expected):
        yield f"{context}: '{source}' is no text any more: build plume_update_translations"
    for message in messages:
        for fault in faults_of(message):
            yield f"{message.context}: the translation of '{message.source}' {fault}"
    yield from shared_mnemonics(messages)


STRING = r'"(?:[^"\\\n]|\\.)*"'


def strings_in(root):
    """The strings of the sources, pieces that stand behind each other as one."""
    for path in (root / "src").rglob("*.cpp"):
        if path.name != "Sentences.cpp":
            for strings in re.findall(rf"{STRING}(?:\s*{STRING})*", path.read_text(encoding="utf-8")):
                yield "".join(piece[1:-1] for piece in re.findall(STRING, strings)).replace('\\"', '"')


def is_said(words, strings):
    """Whether the words stand in one string, or go on from the end of one at the start of another."""
    if any(words in string for string in strings):
        return True
    return any(
        any(string.endswith(words[:end]) for string in strings)
        and any(string.startswith(words[end:]) for string in strings)
        for end in range(1, len(words))
    )


def unknown_sentences(root, expected):
    """Those that windows would know, but that nobody says any more."""
    strings = list(strings_in(root))
    for context, source, *_ in sorted(expected):
        if context == "Sentences" and not all(is_said(words, strings) for words in re.split(r"%\d", source)):
            yield f"Sentences.cpp: nobody says '{source}'"


def main():
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--lupdate", default="lupdate")
    arguments = parser.parse_args()
    root = pathlib.Path(__file__).resolve().parent.parent
    expected = texts_in_sources(root, arguments.lupdate)
    files = sorted((root / "data" / "translations").glob("plume_*.ts"))
    faults = [f"{path.name}: {fault}" for path in files for fault in check(path, expected)]
    faults += unknown_sentences(root, expected)
    print("\n".join(faults) or f"{len(expected)} texts in {len(files)} languages.")
    return 1 if faults or not files else 0


if __name__ == "__main__":
    sys.exit(main())
