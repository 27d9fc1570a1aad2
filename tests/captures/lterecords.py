"""Builders of LTE records, for make-captures.py."""
import plistlib
import struct

plistlib.PLISTHEADER = b'<?xml version="1.0" encoding="UTF-8"?>\n'  # without a document type, as the service writes them

# position in metres, physical cell id, cell identity, downlink EARFCN, resource blocks, tracking area, band
CELLS = [
    (0, 301, 19467523, 5780, 50, 4566, 17),
    (700, 112, 19467524, 5780, 50, 4566, 17),
    (1500, 87, 19467779, 5780, 50, 4566, 17),
    (2200, 214, 19468035, 2075, 100, 4567, 4),
    (3100, 45, 19468036, 2075, 100, 4567, 4),
    (3900, 398, 19468291, 2075, 100, 4567, 4),
]


def packet(code, payload, kind=1):
    """One message: the prefix, then log type, record length, code, timestamp, payload."""
    body = struct.pack("<HHQ", 12 + len(payload), code, 0) + payload
    return b"\x81\x00" + bytes([kind]) + body


def extended(code, tree):
    return packet(code, plistlib.dumps(tree, fmt=plistlib.FMT_XML, sort_keys=False), 255)


def bits(*fields):
    """A little-endian 32-bit word of (value, lowest bit) pairs."""
    word = 0
    for value, low in fields:
        word |= int(value) << low
    return struct.pack("<I", word)


def clamp(value, low, high):
    return max(low, min(high, int(round(value))))


def serving_cell(cell):
    _, pci, identity, earfcn, blocks, area, band = cell
    uplink = earfcn + 18000
    payload = bytearray(25)
    struct.pack_into("<HHHBBIHI", payload, 1, pci, earfcn, uplink, blocks, blocks, identity, area, band)
    return packet(0xB0C2, bytes(payload))


def antennas(count):
    payload = bytearray(9)
    payload[7] = count
    return packet(0xB0C1, bytes(payload))


def idle_measurement(cell, rsrp, rsrq):
    level = clamp((rsrp + 140) / 0.25, 0, 511)
    quality = clamp((rsrq + 30) / 0.25, 0, 127)
    rssi = clamp((rsrp + 27 + 140) / 0.5, 0, 511)
    payload = bytes([3, 0, 0, 0]) + struct.pack("<HH", cell[3], cell[1] | 5 << 9)
    payload += bits((level, 0), (level, 9), (quality, 18), (quality, 25))
    payload += bits((rssi, 0), (8, 9), (53, 15), (53, 22))
    payload += bits((clamp(rsrp + 124 + 30, 0, 127), 0), (0, 7), (31, 13), (4, 19), (1, 25), (9, 26))
    return packet(0xB17F, payload)


def idle_neighbors(serving, others):
    payload = bytes([2, 0, 0, 0]) + struct.pack("<HH", serving[3], 8 | (len(others) - 1) << 6)
    for cell, rsrp, rsrq in others:
        level = clamp((rsrp + 140) / 0.5, 0, 511)
        rssi = clamp((rsrp + 27 + 140) / 0.5, 0, 255)
        quality = clamp((rsrq + 30) / 0.25, 0, 127)
        payload += bits((cell[1], 0), (rssi, 9), (level, 17))
        payload += bits((level, 0), (quality, 9), (quality, 16), (clamp(rsrp + 124 + 30, 0, 127), 23))
        payload += struct.pack("<HH", 120, 0) + bits((cell[1] % 1024, 0), (cell[1] * 61, 11)) + bytes(4)
    return packet(0xB180, payload)


def candidates(serving, others):
    payload = bytes([1, 0]) + struct.pack("<HHH", serving[3], serving[1], 1)
    cell = others[0][0]
    payload += struct.pack("<HHHH", 5, 0, cell[3], cell[1] << 7) + bytes(4)
    return packet(0xB186, payload)


def connected_measurement(cell, rsrp, rsrq, subframe, others):
    measured = others[:3]
    payload = bytes([1, 0, 0, 0]) + struct.pack("<HHHHHBB", cell[3], cell[1], subframe % 10240, clamp((rsrp + 140) / 0.25, 0, 511),
                          clamp((rsrq + 20) / 0.125, 0, 255), len(measured), max(0, len(others) - 3))
    for other, level, quality in measured:
        payload += struct.pack("<HHH", other[1], clamp((level + 140) / 0.25, 0, 511), clamp((quality + 20) / 0.125, 0, 255))
    for other, _, _ in others[3:]:
        payload += struct.pack("<H", other[1])
    return packet(0xB179, payload)


def cell_array(cell):
    prefix = "kPLCellMonitor"
    return extended(1, [{
        prefix + "CellRadioAccessTechnology": prefix + "RadioAccessTechnologyLTE",
        prefix + "CellType": prefix + "CellTypeServing",
        prefix + "TAC": cell[5],
        prefix + "CellId": cell[2],
        prefix + "PID": cell[1],
        prefix + "BandInfo": cell[6],
        prefix + "UARFCN": cell[3],
    }])


SIM = extended(0, {
    "kSimFile_ICCID": "8949020000012345678",
    "kSimFile_MSISDN": "+491700000000",
    "kSimFile_ACC": "0020",
    "kSimFile_HPPLMN": "30 min",
    "kSimFile_AD": "00 00 00 02",
})
CONTEXTS = extended(2, [
    {"APN": "internet", "Type": "IPv4v6", "Address": "10.64.17.3", "State": "Active"},
    {"APN": "ims", "Type": "IPv6", "Address": "2001:db8::17", "State": "Active"},
])

