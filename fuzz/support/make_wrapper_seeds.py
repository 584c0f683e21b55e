#!/usr/bin/env python3
"""Writes the eps_wrapper seeds: each EPS seed of is_this_eps behind a
parameter header in the layout ParameterBytes.h reads (eight lengths of
three bytes, position, two flag bytes, command length, command)."""
import pathlib
import struct

here = pathlib.Path(__file__).resolve().parent.parent
eps_dir = here / "corpus" / "is_this_eps"
out_dir = here / "corpus" / "eps_wrapper"


def length(points):
    return bytes([0]) + struct.pack("<h", int(points * 4))


def header(image, page, imageable, position, flags, command=b""):
    data = b"".join(length(v) for v in image + page + imageable)
    return data + bytes([position]) + struct.pack("<H", flags) + bytes([len(command)]) + command


# A4 with margins, centred, shrink to fit; a fixed custom size, top left,
# rotated page; the picture's own size with no page and no command.
layouts = {
    "a4-centred": header([0, 0], [595, 842], [12, 12, 583, 830], 4, 0b000000001,
                         b"<< /PageSize [595 842] >> setpagedevice"),
    "custom-top-left": header([144, 72], [842, 595], [0, 0, 0, 0], 1, 0b111100010),
    "own-size": header([0, 0], [0, 0], [0, 0, 0, 0], 5, 0x8000),
}

out_dir.mkdir(parents=True, exist_ok=True)
for eps in sorted(eps_dir.glob("*.eps")):
    for name, head in layouts.items():
        (out_dir / f"{eps.stem}-{name}").write_bytes(head + eps.read_bytes())
