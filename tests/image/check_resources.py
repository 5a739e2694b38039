#!/usr/bin/env python3
"""Checks the resources of a built DLL: the setup dialog with its controls
(ids and kinds, in order), the two bitmaps of the object's picture, and the
version that Windows shows in the file's properties.

usage: check_resources.py LIBRARY.dll VERSION
"""
import struct
import sys

RT_BITMAP, RT_DIALOG, RT_VERSION = 2, 5, 16
SETUP_DIALOG = 20003
NO_ID = 65535
# The setup dialog's controls in template order: id and kind.
CONTROLS = [
    (2, "push"), (1, "default"), (20004, "push"), (NO_ID, "group"), (NO_ID, "static"),
    (1001, "edit"), (NO_ID, "static"), (1002, "edit"), (NO_ID, "static"),
    (1003, "edit"), (NO_ID, "static"), (1004, "edit"), (NO_ID, "static"), (NO_ID, "group"),
    (1005, "edit"), (1006, "edit"), (1007, "edit"), (1008, "edit"),
    (NO_ID, "static"), (NO_ID, "static"), (NO_ID, "static"), (NO_ID, "static"),
    (1009, "edit"), (1010, "edit"), (NO_ID, "static"), (NO_ID, "static"),
    (1011, "edit"), (NO_ID, "static"), (1012, "autocheck"),
]
BUTTON_KINDS = {0: "push", 1: "default", 3: "autocheck", 7: "group"}
PICTURE_IDS = (400, 401)
PICTURE_SIZE = 2088


def resources(image):
    """{(type, id): data} of every resource with integer type and id."""
    (pe,) = struct.unpack_from("<I", image, 0x3C)
    sections, optional_size = struct.unpack_from("<2xH12xH", image, pe + 4)
    optional = pe + 24
    magic = struct.unpack_from("<H", image, optional)[0]
    directories = optional + (96 if magic == 0x10B else 112)
    root_rva = struct.unpack_from("<I", image, directories + 2 * 8)[0]
    table = optional + optional_size
    # Each section: its size and address in memory, and where it lies in the file.
    spans = [struct.unpack_from("<8xII4xI", image, table + 40 * i) for i in range(sections)]

    def offset(rva):
        for size, start, raw in spans:
            if start <= rva < start + size:
                return rva - start + raw
        sys.exit(f"RVA {rva:#x} lies in no section")

    root = offset(root_rva)

    def entries(directory):
        named, ids = struct.unpack_from("<12xHH", image, root + directory)
        for i in range(named + ids):
            name, target = struct.unpack_from("<II", image, root + directory + 16 + 8 * i)
            if not name & 0x80000000:
                yield name, target

    found = {}
    for type_id, types in entries(0):
        for name_id, names in entries(types & 0x7FFFFFFF):
            for _, leaf in entries(names & 0x7FFFFFFF):
                rva, size = struct.unpack_from("<II", image, root + leaf)
                start = offset(rva)
                found[(type_id, name_id)] = image[start:start + size]
    return found


def dialog_controls(template):
    """(id, kind) of each control of a classic dialog template."""
    style, _, count = struct.unpack_from("<IIH", template, 0)
    at = 18

    def skip_name(at):
        if struct.unpack_from("<H", template, at)[0] == 0xFFFF:
            return at + 4
        while struct.unpack_from("<H", template, at)[0] != 0:
            at += 2
        return at + 2

    at = skip_name(skip_name(skip_name(at)))  # menu, class, caption
    if style & 0x40:  # DS_SETFONT: point size and typeface
        at = skip_name(at + 2)
    controls = []
    for _ in range(count):
        at = (at + 3) & ~3
        item_style, _, _, _, _, _, item_id = struct.unpack_from("<IIhhhhH", template, at)
        at += 18
        marker, atom = struct.unpack_from("<HH", template, at)
        if marker != 0xFFFF:
            sys.exit(f"control {item_id}: its class is a name, not one of the system's")
        kind = {0x81: "edit", 0x82: "static"}.get(atom) or BUTTON_KINDS.get(item_style & 0xF, "button?")
        controls.append((item_id, kind if atom in (0x80, 0x81, 0x82) else f"class {atom:#x}"))
        at = skip_name(skip_name(at))  # class, text
        at += 2 + struct.unpack_from("<H", template, at)[0]
    return controls


def version_blocks(data, at, end, path="", found=None):
    """{"VS_VERSION_INFO/StringFileInfo/...": value bytes} of every block of a
    version resource: each block is its length, its value's length and kind,
    a key, then its value and its children, each 32-bit aligned."""
    found = {} if found is None else found
    while at + 6 <= end:
        length, value_length, kind = struct.unpack_from("<3H", data, at)
        if length == 0:
            break
        key_end = at + 6
        while data[key_end:key_end + 2] not in (b"\0\0", b""):
            key_end += 2
        key = path + data[at + 6:key_end].decode("utf-16-le")
        value_at = (key_end + 5) & ~3
        value_end = value_at + value_length * (2 if kind == 1 else 1)
        found[key] = data[value_at:value_end]
        version_blocks(data, (value_end + 3) & ~3, at + length, key + "/", found)
        at = (at + length + 3) & ~3
    return found


def version_info(resource):
    """The fixed file version as "a.b.c.d", and the US English version strings by key."""
    blocks = version_blocks(resource, 0, len(resource))
    fixed = blocks.get("VS_VERSION_INFO", b"")
    if len(fixed) < 16 or struct.unpack_from("<I", fixed)[0] != 0xFEEF04BD:
        return None, {}
    high, low = struct.unpack_from("<II", fixed, 8)
    prefix = "VS_VERSION_INFO/StringFileInfo/040904B0/"
    strings = {key[len(prefix):]: value.decode("utf-16-le").rstrip("\0")
               for key, value in blocks.items() if key.startswith(prefix)}
    return f"{high >> 16}.{high & 0xFFFF}.{low >> 16}.{low & 0xFFFF}", strings


def main(path, version):
    with open(path, "rb") as f:
        found = resources(f.read())
    failures = []
    parts = (version.split(".") + ["0"] * 4)[:4]
    fixed, strings = version_info(found.get((RT_VERSION, 1), b""))
    if fixed != ".".join(parts) or strings.get("FileVersion") != version or strings.get("ProductVersion") != version:
        failures.append(f"version resource: {fixed}, file {strings.get('FileVersion')}, product "
                        f"{strings.get('ProductVersion')}; expected {'.'.join(parts)} and {version}")
    dialog = found.get((RT_DIALOG, SETUP_DIALOG))
    if dialog is None:
        failures.append(f"no dialog {SETUP_DIALOG}")
    elif dialog_controls(dialog) != CONTROLS:
        failures.append(f"dialog {SETUP_DIALOG} controls are\n  {dialog_controls(dialog)}\nexpected\n  {CONTROLS}")
    for picture in PICTURE_IDS:
        bitmap = found.get((RT_BITMAP, picture))
        if bitmap is None:
            failures.append(f"no bitmap {picture}")
            continue
        width, height, _, bits = struct.unpack_from("<iiHH", bitmap, 4)
        if (len(bitmap), width, height, bits) != (PICTURE_SIZE, 32, 32, 8):
            failures.append(f"bitmap {picture}: {len(bitmap)} bytes, {width} x {height} x {bits}; "
                            f"expected {PICTURE_SIZE} bytes, 32 x 32 x 8")
    if failures:
        sys.exit(f"{path}:\n" + "\n".join(failures))
    print(f"dialog {SETUP_DIALOG} with {len(CONTROLS)} controls, bitmaps {PICTURE_IDS} and version {version} present")


if __name__ == "__main__":
    main(sys.argv[1], sys.argv[2])
