"""A strict reader of FBX bytes for tests. It shares nothing with the code that writes them.

A record is (name, properties, children); children is empty where there is no list. Text keeps "name\\0\\1class" of
binary files; ASCII names are brought to that form.
"""

import struct
import zlib

SCALARS = {"Y": "<h", "C": "<?", "I": "<i", "F": "<f", "D": "<d", "L": "<q"}
ARRAYS = {"f": "f", "d": "d", "i": "i", "l": "q", "b": "?"}
FOOTER_MAGIC = bytes([0xF8, 0x5A, 0x8C, 0x6A, 0xDE, 0xF5, 0xD9, 0x7E, 0xEC, 0xE9, 0x0C, 0xE3, 0x75, 0x8F, 0x29, 0x0B])


class Malformed(Exception):
    pass


def require(condition, text):
    if not condition:
        raise Malformed(text)


def _property(data, at):
    kind = chr(data[at])
    at += 1
    if kind in SCALARS:
        return struct.unpack_from(SCALARS[kind], data, at)[0], at + struct.calcsize(SCALARS[kind])
    if kind in "SR":
        size = struct.unpack_from("<I", data, at)[0]
        raw = data[at + 4:at + 4 + size]
        return raw.decode("utf-8") if kind == "S" else raw, at + 4 + size
    require(kind in ARRAYS, "property type %r" % kind)
    count, encoding, size = struct.unpack_from("<III", data, at)
    raw = data[at + 12:at + 12 + size]
    require(encoding in (0, 1), "array encoding %d" % encoding)
    if encoding:
        raw = zlib.decompress(raw)
    require(len(raw) == count * struct.calcsize("<" + ARRAYS[kind]), "array of another size than it says")
    return list(struct.unpack("<%d%s" % (count, ARRAYS[kind]), raw)), at + 12 + size


def _record(data, at, limit, head):
    """The record at a place and the place behind it, or None for the mark that ends a list."""
    end, count, size = struct.unpack_from(head, data, at)
    name_length = data[at + struct.calcsize(head)]
    at += struct.calcsize(head) + 1
    if end == 0:
        require(count == size == name_length == 0, "a list's end that is not all zero")
        return None, at
    require(end <= limit, "a record that reaches beyond its parent")
    name = data[at:at + name_length].decode("ascii")
    at += name_length
    properties_end = at + size
    properties = []
    for _ in range(count):
        value, at = _property(data, at)
        properties.append(value)
    require(at == properties_end, name + ": properties of another size than it says")
    children = []
    while at < end:
        child, at = _record(data, at, end, head)
        if child is None:
            require(at == end, name + ": something behind the end of its list")
            break
        require(at < end, name + ": list without an end")
        children.append(child)
    require(at == end, name + ": ends elsewhere than it says")
    return (name, properties, children), at


def parse_binary(data):
    """Version and top records."""
    require(data[:23] == b"Kaydara FBX Binary  \x00\x1a\x00", "magic")
    version = struct.unpack_from("<I", data, 23)[0]
    head = "<QQQ" if version >= 7500 else "<III"
    records, at = [], 27
    while True:
        record, at = _record(data, at, len(data), head)
        if record is None:
            break
        records.append(record)
    footer = data[at + 16:]
    padding = 16 - (at + 16) % 16 + 4
    require(footer[:padding] == bytes(padding), "padding of the footer")
    require(struct.unpack_from("<I", footer, padding)[0] == version, "version in the footer")
    require(footer[padding + 4:] == bytes(120) + FOOTER_MAGIC, "end of the footer")
    return version, records


def _ascii_value(text):
    if text[0] == '"':
        text = text[1:-1]
        if "::" in text:
            class_name, name = text.split("::", 1)
            return name + "\x00\x01" + class_name
        return text
    if text in "TF":
        return text == "T"
    return float(text) if any(c in text for c in ".en") else int(text)


def _ascii_records(lines):
    records = []
    while lines:
        line = lines.pop().strip()
        if line == "}":
            return records
        if not line or line[0] == ";":
            continue
        name, rest = line.split(":", 1)
        rest = rest.strip()
        opens = rest.endswith("{")
        rest = rest.rstrip("{").strip()
        if rest.startswith("*"):
            text = ""
            while (line := lines.pop().strip()) != "}":
                text += line
            values = [_ascii_value(value) for value in text[2:].split(",") if value.strip()]
            require(len(values) == int(rest[1:]), name + ": array of another length than it says")
            records.append((name, [values], []))
            continue
        properties = [_ascii_value(value.strip()) for value in rest.split(", ")] if rest else []
        records.append((name, properties, _ascii_records(lines) if opens else []))
    return records


def parse_ascii(data):
    return _ascii_records(data.decode("utf-8").split("\n")[::-1])


def children(record, name):
    return [child for child in record[2] if child[0] == name]


def child(record, name):
    found = children(record, name)
    require(len(found) == 1, "%s holds %d times %s" % (record[0], len(found), name))
    return found[0]
