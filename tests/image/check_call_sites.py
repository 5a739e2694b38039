#!/usr/bin/env python3
"""Holds a DLL's imports to the PE loader's import tables: the tables hold
exactly the functions the DLL imports, and every call of a USER32, KERNEL32
or DRAVO2 import passes the argument bytes the tables give the function (as
Windows and the host define it), so that a wrong prototype in our own headers
shows.

The callee of a __stdcall or __thiscall call removes the arguments, and the
compiler, which keeps %esp where it wants it, re-adjusts %esp by the bytes it
believes were removed: the stack-frame information (.eh_frame) says so for
frames kept on %esp, and a following `sub $N,%esp` for frames kept on %ebp.

usage: check_call_sites.py OBJDUMP LIBRARY.dll TABLES_DIRECTORY
"""
import bisect
import pathlib
import re
import struct
import subprocess
import sys

CHECKED = ("kernel32.dll", "user32.dll", "dravo2.dll")
ROW = re.compile(r'(?:Stdcall|Thiscall|Cdecl)<(\d+)>\((?:"(\w+)"|(\d+)),|Data\("(\w+)"')


def import_tables(directory):
    """{dll (lower case): {name or ordinal: argument bytes}} from the loader's rows."""
    directory = pathlib.Path(directory)
    files = {m.group(1): p for p in directory.glob("*.cpp") if (m := re.search(r"ImportRow> (\w+)\(\)", p.read_text()))}
    tables = {}
    for dll, function in re.findall(r'\{"([\w.]+)", (\w+)\(\)\}', (directory / "import_tables.cpp").read_text()):
        rows = ROW.findall(files[function].read_text())
        if not rows:
            sys.exit(f"{files[function]}: no rows read")
        tables[dll.lower()] = {name or data or int(ordinal): int(size or 0) for size, name, ordinal, data in rows}
    return tables


def import_slots(image):
    """{address of an import's slot: (dll in lower case, name or ordinal)}."""
    (pe,) = struct.unpack_from("<I", image, 0x3C)
    sections, optional_size = struct.unpack_from("<2xH12xH", image, pe + 4)
    optional = pe + 24
    (base,) = struct.unpack_from("<I", image, optional + 28)
    (directory,) = struct.unpack_from("<I", image, optional + 96 + 8)
    spans = [struct.unpack_from("<8xII4xI", image, optional + optional_size + 40 * i) for i in range(sections)]

    def at(rva):
        return next(rva - start + raw for size, start, raw in spans if start <= rva < start + size)

    def text(rva):
        start = at(rva)
        return image[start:image.index(b"\0", start)].decode()

    slots = {}
    for descriptor in range(directory, 1 << 32, 20):
        lookup, _, _, name, first = struct.unpack_from("<5I", image, at(descriptor))
        if name == 0 and first == 0:
            return slots
        dll = text(name).lower()
        for i in range(1 << 20):
            (entry,) = struct.unpack_from("<I", image, at((lookup or first) + 4 * i))
            if entry == 0:
                break
            slots[base + first + 4 * i] = (dll, entry & 0xFFFF if entry >> 31 else text(entry + 2))


def objdump(tool, library, *options):
    return subprocess.run([tool, *options, library], check=True, capture_output=True, text=True).stdout


def frame_rows(tool, library):
    """Sorted (address, CFA rule, end of its function) of every stack-frame row."""
    rows, end = [], None
    for line in objdump(tool, library, "--dwarf=frames-interp").splitlines():
        fde = re.search(r"FDE .* pc=[0-9a-f]+\.\.([0-9a-f]+)", line)
        if fde:
            end = int(fde.group(1), 16)
        elif end is not None and (row := re.match(r"([0-9a-f]{8}) (\S+)", line)):
            rows.append((int(row.group(1), 16), row.group(2), end))
    rows.sort()
    return rows


def esp_offset(rows, address):
    """N when the frame's CFA at `address` is %esp + N, else None."""
    i = bisect.bisect_right(rows, (address, "\xff")) - 1
    if i < 0 or address >= rows[i][2] or not rows[i][1].startswith("esp+"):
        return None
    return int(rows[i][1][4:])


def bytes_after(instructions, i, rows):
    """What the caller at instructions[i] believes its callee removed: a number,
    "unseen" when the frame is torn down at once, or None when unreadable."""
    call, after = instructions[i][0], instructions[i + 1][0]
    before_offset, after_offset = esp_offset(rows, call), esp_offset(rows, after)
    if before_offset is not None and after_offset is not None:
        return before_offset - after_offset
    for _, text in instructions[i + 1:i + 16]:
        if adjust := re.fullmatch(r"sub\s+\$0x([0-9a-f]+),%esp", text):
            return int(adjust.group(1), 16)
        if text == "leave" or re.fullmatch(r"(lea|mov)\s+\S+,%esp", text):
            return "unseen"
        if "(%esp" in text or text.startswith(("push", "pop", "call")):
            return 0  # the stack is used again as it is
        if "%esp" in text or text.startswith(("ret", "j")):
            return None
    return None


ALIASES = {"eax": "ax|al|ah", "ebx": "bx|bl|bh", "ecx": "cx|cl|ch", "edx": "dx|dl|dh", "esi": "si", "edi": "di",
           "ebp": "bp"}


def register_calls(instructions, slots):
    """{index of a `call *%reg`: the imports loaded into that register that reach
    it}, following the code's jumps from each `mov` of an import's slot; and the
    loads that reach no call."""
    where = {address: i for i, (address, _) in enumerate(instructions)}
    calls, unused = {}, []
    for i, (address, text) in enumerate(instructions):
        load = re.fullmatch(r"mov\s+0x([0-9a-f]+),%(e\w\w)", text)
        if not load or int(load.group(1), 16) not in slots:
            continue
        register, target, reached = load.group(2), slots[int(load.group(1), 16)], False
        written = re.compile(rf"(,%({register}|{ALIASES.get(register, register)})|^pop\s+%{register})$")
        pending, seen = [i + 1], set()
        while pending:
            j = pending.pop()
            if j in seen or j >= len(instructions):
                continue
            seen.add(j)
            text_j = instructions[j][1]
            if re.fullmatch(rf"call\s+\*%{register}", text_j):
                calls.setdefault(j, set()).add(target)
                reached = True
                if register in ("eax", "ecx", "edx"):
                    continue  # a callee may change these
            elif re.fullmatch(rf"lea\s+0x0\(%{register}(,%eiz,1)?\),%{register}", text_j):
                pass  # padding that changes nothing
            elif written.search(text_j) or text_j.startswith(("ret", "jmp   *", "ud2")):
                continue
            if jump := re.fullmatch(r"(j\w+)\s+(?:0x)?([0-9a-f]+)( <.*>)?", text_j):
                pending.append(where.get(int(jump.group(2), 16), len(instructions)))
                if jump.group(1) == "jmp":
                    continue
            pending.append(j + 1)
        if not reached:
            unused.append(f"{address:#x}: {text}: no call through it is seen")
    return calls, unused


def main(tool, library, tables_directory):
    tables = import_tables(tables_directory)
    slots = import_slots(pathlib.Path(library).read_bytes())
    imported = set(slots.values())
    tabled = {(dll, function) for dll, rows in tables.items() for function in rows}
    failures = [f"the tables have a row for {dll} {function}, which the DLL does not import"
                for dll, function in sorted(tabled - imported, key=str)]
    failures += [f"the DLL imports {dll} {function}, which the tables have no row for"
                 for dll, function in sorted(imported - tabled, key=str)]
    slots = {address: target for address, target in slots.items() if target[0] in CHECKED}
    rows = frame_rows(tool, library)
    instructions = [(int(m.group(1), 16), m.group(2).strip())
                    for m in re.finditer(r"^ *([0-9a-f]+):\t(.*)$", objdump(tool, library, "-d", "--no-show-raw-insn"), re.M)]
    thunks = {address: slots[int(m.group(1), 16)] for address, text in instructions
              if (m := re.fullmatch(r"jmp\s+\*0x([0-9a-f]+)", text)) and int(m.group(1), 16) in slots}
    through_registers, unused_loads = register_calls(instructions, slots)
    failures += unused_loads
    sites, unseen = 0, 0
    for i, (address, text) in enumerate(instructions[:-1]):
        targets = set()
        if m := re.fullmatch(r"call\s+\*0x([0-9a-f]+)", text):
            targets = {slots[int(m.group(1), 16)]} if int(m.group(1), 16) in slots else set()
        elif m := re.fullmatch(r"call\s+(?:0x)?([0-9a-f]+)( <.*>)?", text):
            targets = {thunks[int(m.group(1), 16)]} if int(m.group(1), 16) in thunks else set()
        elif i in through_registers:
            targets = through_registers[i]
        elif address not in thunks and not text.startswith("mov ") and any(f"0x{slot:x}" in text for slot in slots):
            failures.append(f"{address:#x}: {text}: an import used in a way this check does not read")
        for dll, function in sorted(targets, key=str):
            described = f"{dll}!{function}" if isinstance(function, str) else f"{dll} ordinal {function}"
            expected = tables.get(dll, {}).get(function)
            if expected is None:
                continue  # said above
            removed = bytes_after(instructions, i, rows)
            sites += 1
            if removed == "unseen":
                unseen += 1
            elif removed is None:
                failures.append(f"{address:#x}: calls {described}; cannot tell the argument bytes from the code after it")
            elif removed != expected:
                failures.append(f"{address:#x}: calls {described} with {removed} bytes of arguments; it takes {expected}")
    if failures:
        sys.exit(f"{library}:\n" + "\n".join(failures))
    print(f"the tables hold exactly the DLL's {len(imported)} imports; {sites} calls of USER32, KERNEL32 and DRAVO2 "
          f"imports pass the bytes the tables give ({unseen} end their function at once, where the bytes cannot be seen)")


if __name__ == "__main__":
    main(*sys.argv[1:])
