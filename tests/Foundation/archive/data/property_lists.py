#!/usr/bin/env python3
"""Holds Plume's property lists against those of Python's plistlib.
    property_lists.py write DIR   writes sample.binary, sample.xml and sample.utf16
    property_lists.py check DIR   fails unless ours.binary and ours.xml hold the same sample
"""
import datetime
import pathlib
import plistlib
import sys

SAMPLE = {
    "array": [True, False, 0, 255, 256, 70000, 2**40, -1, -(2**63), 2**63 - 1, 0.5, -1e300],
    "data": bytes(range(256)),
    "date": datetime.datetime(2024, 2, 29, 12, 30, 59),
    "empty": [{}, [], "", b""],
    "text": "plain & <b> \"quoted\"\n",
    "Ünicode 日本": "naïve 😀",
    "long": "x" * 70000,
    "same": ["twice", "twice"],
    "far": datetime.datetime(1, 1, 1),
}


def main():
    folder = pathlib.Path(sys.argv[2])
    if sys.argv[1] == "write":
        xml = plistlib.dumps(SAMPLE)
        (folder / "sample.binary").write_bytes(plistlib.dumps(SAMPLE, fmt=plistlib.FMT_BINARY))
        (folder / "sample.xml").write_bytes(xml)
        (folder / "sample.utf16").write_bytes(xml.decode().replace("UTF-8", "UTF-16").encode("utf-16"))
        return
    for name in ("ours.binary", "ours.xml"):
        read = plistlib.loads((folder / name).read_bytes())
        assert read == SAMPLE, f"{name}: {read}"
        assert [type(v) for v in read["array"]] == [type(v) for v in SAMPLE["array"]], name


main()
