#!/usr/bin/env python3
"""Makes the captures of this directory: short ones of our own making, the same bytes every time.

Usage: make-captures.py        Writes them beside itself; twins_tests --rebless then writes their twins.
"""
import importlib.util
import pathlib
import struct

HERE = pathlib.Path(__file__).resolve().parent
START = 1299230102  # 2011-03-04 09:15:02 UTC
LINK_TYPES = {"ifx": 147, "gsm": 148, "cdma": 149, "lte": 150, "utran": 151}


def load(path):
    spec = importlib.util.spec_from_file_location("records", path)
    module = importlib.util.module_from_spec(spec)
    spec.loader.exec_module(module)
    return module


def write(name, technology, messages):
    with open(HERE / name, "wb") as out:
        out.write(struct.pack("<IHHiIII", 0xA1B2C3D4, 2, 4, 0, 0, 131072, LINK_TYPES[technology]))
        for i, message in enumerate(messages):
            out.write(struct.pack("<IIII", START + i, 0, len(message), len(message)) + message)


lte = load(HERE / "../../resources/make-lte-capture.py")
near, far, other = lte.CELLS[0], lte.CELLS[1], lte.CELLS[2]
serving = lte.serving_cell(near)

write("lte-idle.pcap", "lte", [
    lte.SIM,
    lte.CONTEXTS,
    lte.cell_array(near),
    serving,
    lte.antennas(2),
    lte.idle_measurement(near, -92.5, -8.25),
    lte.idle_neighbours(near, [(far, -101, -12), (other, -110, -15)]),
    lte.candidates(near, [(far, -101, -12)]),
])
write("lte-connected.pcap", "lte", [
    serving,
    lte.connected_measurement(near, -95, -9, 4321, [(cell, -100 - i, -10 - i) for i, cell in enumerate(lte.CELLS[1:])]),
    lte.serving_cell(other),
    lte.connected_measurement(other, -89.75, -7.5, 17, [(far, -99, -11)]),
])
# What a line may bring: no prefix, a foreign log type, a foreign code, records cut short, property lists that are none.
write("lte-odd.pcap", "lte", [
    b"",
    b"\x81",
    serving[2:],
    bytes([254]) + serving[3:],
    lte.packet(0x1234, b"nobody reads this"),
    lte.serving_cell(far)[:-1],
    lte.antennas(4)[:20],
    lte.packet(0xB0C1, bytes(3)),
    lte.packet(1, b"<plist", 255),
    lte.packet(0, b"no property list", 255),
    lte.packet(0xB179, bytes(4)),
    b"\x81\x00" * 7,
])
