#!/usr/bin/env python3
"""Makes the captures of this directory: short ones of our own making, the same bytes every time.

Usage: make-captures.py        Writes them beside itself; twins_tests --rebless then writes their twins.
"""
import pathlib
import struct

import lterecords as lte

HERE = pathlib.Path(__file__).resolve().parent
START = 1299230102  # 2011-03-04 09:15:02 UTC
LINK_TYPES = {"ifx": 147, "gsm": 148, "cdma": 149, "lte": 150, "utran": 151}


def write(name, technology, messages):
    with open(HERE / name, "wb") as out:
        out.write(struct.pack("<IHHiIII", 0xA1B2C3D4, 2, 4, 0, 0, 131072, LINK_TYPES[technology]))
        for i, message in enumerate(messages):
            out.write(struct.pack("<IIII", START + i, 0, len(message), len(message)) + message)


near, far, other = lte.CELLS[0], lte.CELLS[1], lte.CELLS[2]
serving = lte.serving_cell(near)

write("lte-idle.pcap", "lte", [
    lte.SIM,
    lte.CONTEXTS,
    lte.cell_array(near),
    serving,
    lte.antennas(2),
    lte.idle_measurement(near, -92.5, -8.25),
    lte.idle_neighbors(near, [(far, -101, -12), (other, -110, -15)]),
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


def record(code, size, *fields):
    """A packet of `size` bytes with (offset, struct format, value) in it; offsets count from the log type byte."""
    payload = bytearray(size - 13)
    for offset, form, value in fields:
        struct.pack_into("<" + form, payload, offset - 13, value)
    return lte.packet(code, bytes(payload))


prefix = "kPLCellMonitor"
write("gsm-cells.pcap", "gsm", [
    lte.SIM,
    lte.CONTEXTS,
    record(0x5134, 26, (13, "H", 975), (15, "H", 42), (17, "H", 4711)),
    record(0x51FF, 23, (14, "B", 2), (15, "H", 512), (17, "B", 21), (19, "H", 700), (21, "B", 63)),
    record(0x5137, 57, (15, "B", 200), (16, "I", 17), (20, "I", 12), (28, "B", 2), (29, "H", 512), (43, "H", 700)),
    record(0x51F8, 19, (13, "B", 5), (14, "B", 2), (15, "H", 975), (17, "H", 512)),
    record(0x5137, 28),
    lte.extended(1, [
        {
            prefix + "CellRadioAccessTechnology": prefix + "RadioAccessTechnologyGSM",
            prefix + "CellType": prefix + "CellTypeServing",
            prefix + "MCC": 262,
            prefix + "MNC": 1,
            prefix + "LAC": 4566,
            prefix + "CellId": 4712,
            prefix + "ARFCN": 976,
            prefix + "BandInfo": 900,
            prefix + "RSSI": -71,
        },
        {
            prefix + "CellRadioAccessTechnology": prefix + "RadioAccessTechnologyUMTS",
            prefix + "CellType": prefix + "CellTypeNeighbor",
            prefix + "UARFCN": 10588,
            prefix + "SCN": 311,
            prefix + "RSCP": -95,
            prefix + "ECN0": 32767,
        },
    ]),
])
write("cdma-evdo.pcap", "cdma", [
    record(0x1183, 50, (13, "B", 25), (14, "B", 1 << 3 | 2), (15, "b", -71), (16, "b", -74), (17, "b", 5),
           (18, "H", 123), (36, "B", 5), (37, "B", 4), (38, "H", 0x3456), (40, "B", 0x12), (41, "B", 7)),
    record(0x12B6, 49, (15, "B", 2), (25, "H", 123), (27, "H", 256), (37, "H", 51), (39, "H", 0)),
    record(0x108A, 37, (22, "B", 1), (23, "H", 65535)),
    record(0x1192, 241, (13, "I", 100), (17, "I", 0)),
    record(0x1192, 241, (13, "I", 110), (17, "I", 800)),
    record(0x134F, 190, (13, "B", 2), (42, "I", 4), (46, "I", 2), (50, "H", 1001), (52, "H", 7), (131, "B", 3),
           (133, "B", 6), (184, "H", 777)),
    record(0x1183, 49, (36, "B", 1)),
])


def neighbor(uarfcn, cell, level, status, joint):
    return uarfcn | cell << 14 | level << 21 | status << 29 | joint << 31


write("utran-cells.pcap", "utran", [
    record(0xD0E0, 15, (13, "B", 1), (14, "B", 3)),
    record(0xD0E2, 26, (14, "B", 2), (15, "B", 9), (17, "H", 10054), (19, "H", 10055), (21, "I", 0xFFFFFFFE), (25, "B", 1)),
    record(0xD00A, 200, (16, "B", 2 << 1), (168, "I", neighbor(10054, 77, 128, 2, 1)),
           (184, "I", neighbor(10063, 12, 0, 3, 0))),
    record(0xD00E, 25, (16, "B", 1), (17, "H", 42)),
    record(0xD00C, 365, (14, "H", 1 << 12 | 2 << 6), (17, "B", 5), (18, "B", 6), (19, "B", 7), (20, "B", 8),
           (357, "B", 3), (358, "B", 4), (359, "B", 10), (364, "B", 15)),
    record(0xD00A, 20),
])
plist = lte.plistlib
write("ifx-tree.pcap", "ifx", [
    plist.dumps({"Serving": {"Cell": "old"}}),
    plist.dumps({
        "Serving": {"Cell": {"ARFCN": "975"}},
        "Neighbours": ["left out", {"ARFCN": "512", "RSSI": "-71"}, {"ARFCN": "700"}],
        "Registration": {"MCC": "262", "MNC": "01"},
    }, fmt=plist.FMT_BINARY, sort_keys=False),
])
