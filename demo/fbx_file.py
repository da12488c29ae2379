"""Writes FBX element trees as bytes: binary with 32- or 64-bit record offsets, or ASCII.

An element has a name, properties and child elements. The Python type of a property chooses its type in the file:

    bool         C   one byte (in ASCII the letter T or F)
    int          I   32-bit integer
    Int64        L   64-bit integer, used for object ids and times
    float        D   64-bit float
    str          S   UTF-8 text
    ObjectName   S   name and class, joined as each form of the format wants it
    bytes        R   raw bytes (left out in ASCII)
    array.array  an array of 64-bit or 32-bit floats (typecodes d, f) or of 32-bit or 64-bit integers (i, q)

Output depends on the tree alone: no clock, no random numbers.
"""

import array
import struct
import sys
import zlib

# Arrays of at least this many bytes are compressed; below it zlib's frame costs more than it saves.
COMPRESS_FROM_BYTES = 128

BINARY_MAGIC = b"Kaydara FBX Binary  \x00\x1a\x00"
# The format ties the footer to FileId and CreationTime; these three belong together and suit files without a real time.
CREATION_TIME = "1970-01-01 10:00:00:000"
FILE_ID = bytes.fromhex("28b32aebb624ccc2bfc8b02aa92bfcf1")
FOOTER_ID = bytes.fromhex("fabcab09d0c8d466b176fb831cf7267e")
FOOTER_MAGIC = bytes.fromhex("f85a8c6adef5d97eece90ce3758f290b")


class Int64(int):
    """An integer stored in 64 bits."""


class ObjectName:
    """The name of an object with its class: "Model::arm" in ASCII, "arm\\0\\1Model" in binary."""

    def __init__(self, name, class_name):
        self.name = name
        self.class_name = class_name

    def binary(self):
        return self.name + "\x00\x01" + self.class_name

    def ascii(self):
        return self.class_name + "::" + self.name


class Element:
    """One record. children is None for a record without a list, and may be empty for one with an empty list."""

    def __init__(self, name, *properties, children=None):
        self.name = name
        self.properties = properties
        self.children = children


def doubles(values):
    return array.array("d", values)


def integers(values):
    return array.array("i", values)


# ---- binary

def _little_endian(values):
    if sys.byteorder == "little":
        return values.tobytes()
    swapped = array.array(values.typecode, values)
    swapped.byteswap()
    return swapped.tobytes()


def _binary_property(value):
    if isinstance(value, bool):
        return b"C" + struct.pack("<B", value)
    if isinstance(value, Int64):
        return b"L" + struct.pack("<q", value)
    if isinstance(value, int):
        return b"I" + struct.pack("<i", value)
    if isinstance(value, float):
        return b"D" + struct.pack("<d", value)
    if isinstance(value, ObjectName):
        value = value.binary()
    if isinstance(value, str):
        text = value.encode("utf-8")
        return b"S" + struct.pack("<I", len(text)) + text
    if isinstance(value, bytes):
        return b"R" + struct.pack("<I", len(value)) + value
    if isinstance(value, array.array):
        code = {"d": b"d", "f": b"f", "i": b"i", "q": b"l"}[value.typecode]
        data = _little_endian(value)
        if len(data) < COMPRESS_FROM_BYTES:
            return code + struct.pack("<III", len(value), 0, len(data)) + data
        packed = zlib.compress(data, 6)
        return code + struct.pack("<III", len(value), 1, len(packed)) + packed
    raise TypeError("no FBX property type for %r" % (value,))


def _append_binary_record(out, element, head):
    start = len(out)
    name = element.name.encode("ascii")
    properties = b"".join(_binary_property(value) for value in element.properties)
    out += bytes(head.size)
    out.append(len(name))
    out += name
    out += properties
    if element.children is not None:
        for child in element.children:
            _append_binary_record(out, child, head)
        out += bytes(head.size + 1)
    head.pack_into(out, start, len(out), len(element.properties), len(properties))


def binary(elements, version):
    """The tree as a binary file; from version 7500 on the records hold 64-bit offsets."""
    head = struct.Struct("<QQQ" if version >= 7500 else "<III")
    out = bytearray(BINARY_MAGIC + struct.pack("<I", version))
    for element in elements:
        _append_binary_record(out, element, head)
    out += bytes(head.size + 1)
    out += FOOTER_ID
    out += bytes(16 - len(out) % 16)
    out += bytes(4) + struct.pack("<I", version) + bytes(120) + FOOTER_MAGIC
    return bytes(out)


# ---- ASCII

def _number(value):
    return "%d" % value if float(value).is_integer() and abs(value) < 1e15 else repr(float(value))


def _ascii_property(value):
    if isinstance(value, bool):
        return "T" if value else "F"
    if isinstance(value, int):
        return "%d" % value
    if isinstance(value, float):
        return _number(value)
    if isinstance(value, ObjectName):
        value = value.ascii()
    if isinstance(value, str):
        return '"' + value.replace('"', "&quot;") + '"'
    raise TypeError("no ASCII form for %r" % (value,))


def _append_ascii_array(lines, indent, name, values):
    lines.append("%s%s: *%d {" % (indent, name, len(values)))
    text = [_number(value) for value in values]
    rows = [",".join(text[first:first + 24]) for first in range(0, len(text), 24)] or [""]
    lines.append("%s\ta: %s" % (indent, (",\n").join(rows)))
    lines.append(indent + "}")


def _append_ascii_record(lines, element, depth):
    indent = "\t" * depth
    if len(element.properties) == 1 and isinstance(element.properties[0], array.array):
        _append_ascii_array(lines, indent, element.name, element.properties[0])
        return
    if any(isinstance(value, bytes) for value in element.properties):
        return
    head = "%s%s: %s" % (indent, element.name, ", ".join(_ascii_property(value) for value in element.properties))
    if element.children is None:
        lines.append(head)
        return
    lines.append(head + (" {" if element.properties else "{"))
    for child in element.children:
        _append_ascii_record(lines, child, depth + 1)
    lines.append(indent + "}")


def ascii_text(elements, version):
    """The tree as an ASCII file."""
    lines = ["; FBX %d.%d.%d project file" % (version // 1000, version // 100 % 10, version // 10 % 10),
             "; " + "-" * 52, ""]
    for element in elements:
        _append_ascii_record(lines, element, 0)
        lines.append("")
    return "\n".join(lines).encode("utf-8")
