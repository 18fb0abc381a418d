#!/usr/bin/env python3
"""Writes typed streams by the rules of their format, with a writer of its own.
    make_typed_streams.py write DIR
"""
import pathlib
import struct
import sys

NEW, NIL, END = b"\x84", b"\x85", b"\x86"
CHAINS = {
    "NSMutableAttributedString": ["NSAttributedString", "NSObject"], "NSAttributedString": ["NSObject"],
    "NSMutableString": ["NSString", "NSObject"], "NSString": ["NSObject"], "NSDictionary": ["NSObject"],
    "NSNumber": ["NSValue", "NSObject"], "NSFont": ["NSObject"], "NSColor": ["NSObject"], "NSURL": ["NSObject"],
    "NSParagraphStyle": ["NSObject"], "NSTextAttachment": ["NSObject"], "NSFileWrapper": ["NSObject"],
    "NSMutableData": ["NSData", "NSObject"], "NSNew": ["NSObject"],
}
VERSIONS = {"NSString": 1, "NSMutableString": 1, "NSFont": 30, "NSFileWrapper": 46}


class Ref:
    """An object that stands in several places."""

    def __init__(self, name, *groups):
        self.name, self.groups = name, groups


class Stream:
    def __init__(self, big=False):
        self.order = ">" if big else "<"
        signature = b"typedstream" if big else b"streamtyped"
        self.out = b"\x04" + bytes([len(signature)]) + signature + self.number(1000)
        self.strings, self.objects = [], []

    def number(self, n):
        if -110 <= n <= 127:
            return struct.pack("b", n)
        for head, size, code in ((b"\x81", 15, "h"), (b"\x82", 31, "i"), (b"\x87", 63, "q")):
            if -(1 << size) <= n < 1 << size:
                return head + struct.pack(self.order + code, n)

    def length(self, n):
        return bytes([n]) if n < 128 else b"\x81" + struct.pack(self.order + "H", n)

    def string(self, text):
        text = text.encode()
        if text in self.strings:
            return self.number(self.strings.index(text) - 110)
        self.strings.append(text)
        return NEW + self.length(len(text)) + text

    def classes(self, chain):
        if not chain:
            return NIL
        if chain[0] in self.objects:
            return self.number(self.objects.index(chain[0]) - 110)
        self.objects.append(chain[0])
        return NEW + self.string(chain[0]) + self.number(VERSIONS.get(chain[0], 0)) + self.classes(chain[1:])

    def object(self, ref):
        if ref is None:
            return NIL
        if ref in self.objects:
            return self.number(self.objects.index(ref) - 110)
        self.objects.append(ref)
        out = NEW + self.classes([ref.name] + CHAINS[ref.name])
        return out + b"".join(self.group(*group) for group in ref.groups) + END

    def group(self, types, *values):
        out = self.string(types)
        if types.startswith("[") and types.endswith("c]"):
            return out + values[0]
        for kind, value in zip(types, values):
            if kind == "@":
                out += self.object(value)
            elif kind == "+":
                out += self.length(len(value)) + value
            elif kind == "*":
                self.objects.append(("C string", value))
                out += NEW + self.string(value)
            elif kind in "cC":
                out += bytes([value & 255])
            elif kind in "fd" and value != int(value):
                out += b"\x83" + struct.pack(self.order + kind, value)
            else:
                out += self.number(int(value))
        return out

    def dump(self, root):
        return self.out + self.group("@", root)


def string(text, name="NSString"):
    return Ref(name, ("+", text.encode()))


def number(n):
    return Ref("NSNumber", ("*", "i"), ("i", n))


def font(name, size):
    blob = b"\x06\0\0\0" + struct.pack("<I", 2 * len(name)) + b"\xff\xfe" + name.encode("utf-16-le") + b"\0\0"
    return Ref("NSFont", ("i", len(blob)), ("[%dc]" % len(blob), blob), ("f", size), *[("c", 0)] * 4)


def color(r, g, b, a=1):
    return Ref("NSColor", ("c", 1), ("ffff", r, g, b, a))


def dictionary(entries):
    return Ref("NSDictionary", ("i", len(entries)), *[("@", x) for k, v in entries.items() for x in (string(k), v)])


def data(blob):
    return Ref("NSMutableData", ("i", len(blob)), ("[%dc]" % len(blob), blob))


def flat(entries):
    out = b"rtfd" + bytes(4) + struct.pack("<II", 3, len(entries))
    for name, _ in entries:
        out += struct.pack("<I", len(name)) + name
    files = [struct.pack("<II", 1, len(content)) + content for _, content in entries]
    return out + b"".join(struct.pack("<I", len(f)) for f in files) + b"".join(files)


def text(content, runs, name="NSMutableAttributedString"):
    """runs: (length, dictionary)"""
    groups, known = [("@", string(content, "NSMutableString"))], []
    for length, attributes in runs:
        new = attributes not in known
        if new:
            known.append(attributes)
        groups.append(("iI", known.index(attributes) + 1, length))
        if new:
            groups.append(("@", attributes))
    return Ref(name, *groups)


def main():
    folder = pathlib.Path(sys.argv[2])
    style = Ref("NSParagraphStyle", ("CC@S", 2, 0, None, 0))
    wrapper = Ref("NSFileWrapper", ("@", data(flat([(b"..", b"PNG!"), (b"__@UTF8PreferredName@__", b"a.png")]))))
    attachment = Ref("NSTextAttachment", ("c@", 1, wrapper))
    first = dictionary({"NSFont": font("Helvetica-Bold", 12.5), "NSColor": color(1, 0.5, 0), "NSUnderline": number(1),
                        "NSParagraphStyle": style})
    second = dictionary({"NSLink": Ref("NSURL", ("c", 0), ("@", string("http://x.org"))), "NSUnknown": Ref("NSNew", ("d", 0.5)),
                         "NSAttachment": attachment, "NSSuperScript": number(-1), "NSFont": font("Times-Roman", 300)})
    rich = text("é😀" + "x" * 300 + "\ufffc", [(3, first), (300, second), (1, first)])
    (folder / "rich").write_bytes(Stream().dump(rich))
    (folder / "rich.big").write_bytes(Stream(big=True).dump(rich))
    (folder / "plain").write_bytes(Stream().dump(text("plain", [(5, dictionary({}))], "NSAttributedString")))
    (folder / "string").write_bytes(Stream().dump(string("only text")))
    (folder / "other").write_bytes(Stream().dump(number(7)))


main()
