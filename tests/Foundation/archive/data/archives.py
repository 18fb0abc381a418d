#!/usr/bin/env python3
"""Checks a keyed archive of Plume's by the layout's rules, without any code of Plume's.
    archives.py check DIR    fails unless DIR/ours.archive keeps them
"""
import pathlib
import plistlib
import sys

STRING, DATA, REAL, INTEGER, BOOLEAN = str, bytes, float, int, bool
REFERENCE = plistlib.UID
# Class -> the rest of its chain, the keys that it must have, and those that it may have.
CLASSES = {
    "NSDate": ([], {"NS.time": REAL}, {}),
    "NSArray": ([], {"NS.objects": list}, {}),
    "NSMutableArray": (["NSArray"], {"NS.objects": list}, {}),
    "NSDictionary": ([], {"NS.keys": list, "NS.objects": list}, {}),
    "NSMutableDictionary": (["NSDictionary"], {"NS.keys": list, "NS.objects": list}, {}),
    "NSMutableData": (["NSData"], {"NS.data": DATA}, {}),
    "NSURL": ([], {"NS.base": REFERENCE, "NS.relative": REFERENCE}, {}),
    "NSCharacterSet": ([], {}, {"NSString": STRING, "NSBitmap": DATA}),
    "NSAttributedString": ([], {"NSString": REFERENCE}, {"NSAttributes": REFERENCE, "NSAttributeInfo": REFERENCE}),
    "NSFont": ([], {"NSName": REFERENCE, "NSSize": REAL, "NSfFlags": INTEGER}, {}),
    "NSColor": ([], {"NSColorSpace": INTEGER, "NSRGB": DATA}, {}),
    "NSParagraphStyle": ([], {"NSTabStops": REFERENCE}, {
        "NSAlignment": INTEGER, "NSFirstLineHeadIndent": REAL, "NSHeadIndent": REAL, "NSTailIndent": REAL,
        "NSLineSpacing": REAL, "NSLineHeightMultiple": REAL, "NSParagraphSpacing": REAL,
        "NSParagraphSpacingBefore": REAL, "NSTextLists": REFERENCE}),
    "NSTextTab": ([], {"NSLocation": REAL}, {}),
    "NSTextList": ([], {"NSMarkerFormat": REFERENCE}, {"NSStart": INTEGER}),
    "NSTextAttachment": ([], {"NSFileWrapper": REFERENCE}, {}),
    "NSFileWrapper": ([], {"NSFileWrapperData": REFERENCE}, {}),
    "Snippet": ([], {}, {
        "UUID": REFERENCE, "Abbreviation": REFERENCE, "Label": REFERENCE, "ContentType": INTEGER,
        "CaseSensitivity": INTEGER, "DateCreated": REFERENCE, "DateModified": REFERENCE, "LastTimeUsed": REFERENCE,
        "Note": REFERENCE, "Content": REFERENCE}),
    "SnippetGroup": ([], {}, {
        "UUID": REFERENCE, "DateCreated": REFERENCE, "Name": REFERENCE, "Items": REFERENCE, "ExpandAfter": INTEGER,
        "ExpandAfterDelimiters": REFERENCE, "ExpandTrigger": INTEGER, "Delimiters": REFERENCE,
        "CaseSensitivity": INTEGER, "ShowInMenuBar": BOOLEAN, "SuggestAbbreviations": BOOLEAN,
        "AbbreviationPrefix": REFERENCE, "EnabledIn": INTEGER, "Applications": REFERENCE,
        "InputMethodsOption": INTEGER, "InputMethods": REFERENCE, "ResetFormatting": BOOLEAN}),
}


class Archive:
    def __init__(self, path):
        archive = plistlib.loads(path.read_bytes())
        assert set(archive) == {"$version", "$archiver", "$top", "$objects"}
        assert archive["$version"] == 100000 and archive["$archiver"] == "NSKeyedArchiver"
        self.objects = archive["$objects"]
        assert self.objects[0] == "$null" and list(archive["$top"]) == ["root"]
        self.root = archive["$top"]["root"]
        self.seen = set()

    def check(self):
        assert self.class_of(self.at(self.root)) == "NSMutableDictionary"
        waiting = [self.root]
        while waiting:
            reference = waiting.pop()
            if reference.data in self.seen or reference.data == 0:
                continue
            self.seen.add(reference.data)
            value = self.at(reference)
            if isinstance(value, dict) and "$class" in value:
                waiting += self.check_object(value)
        bare = [(type(o), o) for o in self.objects if isinstance(o, (str, int, float, bytes))]
        assert len(bare) == len(set(bare)), "equal values are shared"
        descriptions = {i for i, o in enumerate(self.objects) if isinstance(o, dict) and "$classname" in o}
        assert self.seen | descriptions | {0} == set(range(len(self.objects))), "objects that nobody refers to"

    def at(self, reference):
        assert isinstance(reference, REFERENCE) and reference.data < len(self.objects), reference
        return self.objects[reference.data]

    def class_of(self, value):
        return self.at(value["$class"])["$classname"]

    def check_object(self, value):
        description = self.at(value["$class"])
        name = description["$classname"]
        assert name in CLASSES, name
        parents, needed, allowed = CLASSES[name]
        assert description["$classes"] == [name] + parents + ["NSObject"], description
        keys = set(value) - {"$class"}
        assert set(needed) <= keys <= set(needed) | set(allowed), (name, keys)
        references = []
        for key in keys:
            kind = needed.get(key) or allowed[key]
            assert type(value[key]) is kind, (name, key, value[key])
            references += [value[key]] if kind is REFERENCE else value[key] if kind is list else []
        if name == "NSAttributedString":
            self.check_text(value)
        if name in ("NSDictionary", "NSMutableDictionary"):
            assert len(value["NS.keys"]) == len(value["NS.objects"])
        if name == "NSColor":
            assert value["NSRGB"].endswith(b"\0") and len(value["NSRGB"][:-1].split(b" ")) in (3, 4)
        if name == "NSCharacterSet":
            assert len(keys) == 1 and len(value.get("NSBitmap", bytes(8192))) % 8193 < 8193
        return references

    def check_text(self, value):
        text = self.at(value["NSString"])
        units = len(text.encode("utf-16-le", "surrogatepass")) // 2
        if not units:
            assert set(value) == {"NSString", "$class"}
            return
        attributes = self.at(value["NSAttributes"])
        if "NSAttributeInfo" not in value:
            assert self.class_of(attributes) == "NSDictionary"
            return
        numbers, shift, number = [], 0, 0
        for byte in self.at(value["NSAttributeInfo"])["NS.data"]:
            number |= (byte & 127) << shift
            shift += 7
            if byte < 128:
                numbers.append(number)
                shift, number = 0, 0
        assert sum(numbers[::2]) == units and 0 not in numbers[::2]
        assert set(numbers[1::2]) == set(range(len(attributes["NS.objects"])))


Archive(pathlib.Path(sys.argv[2]) / "ours.archive").check()
