#!/usr/bin/env python3
"""Makes seeds for the fuzz targets of this directory out of the captures under tests/captures: the same bytes every time.

Usage: make-corpus.py          Writes corpus/TARGET/from-NAME; what was made by hand beside it stays.
"""
import pathlib
import plistlib
import struct

plistlib.PLISTHEADER = b'<?xml version="1.0" encoding="UTF-8"?>\n'  # without a document type, as Kelvo writes them
HERE = pathlib.Path(__file__).resolve().parent
CAPTURES = HERE / "../captures"
FAMILIES = {147: "ifxmessages", 148: "gsmmessages", 149: "cdmamessages", 150: "ltemessages", 151: "utranmessages"}
HEADER = struct.Struct("<IHHiIII")
PACKET = struct.Struct("<IIII")


def packets(capture):
    """The link type and the messages of a capture in this machine's usual byte order."""
    link = HEADER.unpack_from(capture)[6]
    at, messages = HEADER.size, []
    while at < len(capture):
        length = PACKET.unpack_from(capture, at)[2]
        at += PACKET.size
        messages.append(capture[at:at + length])
        at += length
    return link, messages


def write(target, name, content):
    directory = HERE / "corpus" / target
    directory.mkdir(parents=True, exist_ok=True)
    (directory / f"from-{name}").write_bytes(content)


def snapshot(messages):
    entry = {"DisplayState": b"".join(messages), "Display": {"Cell": {"MCC": "262"}}, "ExtraInfo": {},
             "Date": "2011-03-04 09:15:02 +0100", "Description": "Snapshot (2011-03-04 09:15:02 +0100)"}
    dlf = {"Description": "DLF binary (161 bytes)", "DLF": bytes(161)}
    return {"Timestamp": "2011-03-04 09:15:02 +0000", "Data": [entry, dlf], "Description": "by the river"}


def frame(body):
    """A frame of a modem's diagnostic port."""
    crc = 0xFFFF
    for byte in body:
        crc ^= byte
        for _ in range(8):
            crc = crc >> 1 ^ 0x8408 if crc & 1 else crc >> 1
    raw = body + struct.pack("<H", crc ^ 0xFFFF)
    return raw.replace(b"\x7d", b"\x7d\x5d").replace(b"\x7e", b"\x7d\x5e") + b"\x7e"


def record_frame(message):
    """A message (its prefix taken off) as a modem sends it."""
    record = message[3:] if message[0] == 0x81 else message[1:]
    return frame(struct.pack("<BBH", 0x10, 0, len(record)) + record)


def conversation():
    """What a modem answers from the first question on; the session's target frames the bodies itself."""
    head = b"\x73\0\0\0"
    ranges = [0, 0xA02, 0, 0, 0x910, 0x420, 0, 0x4FF, 0, 0, 0x38A, 0x201, 0, 0x1FF, 0, 0]
    yield b"\0" + b"Jan 01 202012:00:00Jan 02 202012:00:00TARGET99"
    yield b"\x7c" + bytes(11) + b"BUILD-1\0"
    yield head + struct.pack("<II16I", 1, 0, *ranges)
    for id, items in enumerate(ranges):
        yield head + struct.pack("<IIII", 3, 0, id, items) + bytes((items + 7) // 8)


dialogue = list(conversation())
mask = dialogue[3 + 0xB]
record = struct.pack("<BBHHHQ", 0x10, 2, 14, 14, 0xB0C2, 72659535985485082) + b"\1\2"
for name, last in {"records": [record, b"\x98\1\0\0\1\0\0\0" + record], "encrypted": [b"\x9e\1\2"],
                   "refused": [b"\x14" + mask[:8] + mask[12:]], "texts": [b"\x79\0\0\4"]}.items():
    write("session", name, b"".join(struct.pack("<H", len(body)) + body for body in dialogue + last))

# Newer layouts: the master information block of version 2, and part 25 of the serving cell in every mode.
newer = [(0xB0C1, bytes([2, 73, 0, 0x21, 7, 0, 0, 0xFC, 3, 2, 50])), (0xB0C2, bytes([3]) + bytes(28)),
         (0xB179, bytes([4]) + bytes(23) + bytes([1, 1, 0, 0]) + bytes(28)), (0xB17F, bytes([5]) + bytes(35)),
         (0xB180, bytes([5]) + bytes(7) + struct.pack("<I", 1 << 6) + bytes([1]) + bytes(27)),
         (0xB193, struct.pack("<BBHBBH", 1, 1, 0, 25, 18, 96) + bytes(92)),
         (0x51FC, bytes(25) + bytes([1]) + bytes(25)), (0x4005, bytes([0x81, 1]) + bytes(5 + 16 + 13)),
         (0x7150, bytes([0x64, 0xF0, 0, 1, 0x64, 0xF0, 0x70]) + bytes(12)), (0x5B2C, bytes(5))]
sent = [struct.pack("<BHHQ", 1, 12 + len(body), code, 72659535985485082) + body for code, body in newer]
write("recordadapter", "newer", b"".join(struct.pack("<H", len(packet)) + packet for packet in sent))

for path in sorted(CAPTURES.glob("*.pcap")):
    raw = path.read_bytes()
    link, messages = packets(raw)
    write(FAMILIES[link], path.stem, b"".join(struct.pack("<H", len(message)) + message for message in messages))
    write("capture", path.name, raw)
    write("framing", path.stem, b"".join(messages))
    if link != 147:
        bare = [message[2:] if message[0] == 0x81 else message for message in messages if len(message) > 15]
        write("recordadapter", path.stem, b"".join(struct.pack("<H", len(message)) + message for message in bare))
        write("recordings", f"{path.stem}.dlf", b"".join(message[1:] for message in bare[:40]))
        write("recordings", f"{path.stem}.frames", b"".join(record_frame(message) for message in messages[:40] if len(message) > 15))
        write("framereader", path.stem, b"".join(record_frame(message) for message in messages[:20] if len(message) > 15))
    for i, message in enumerate(messages[:4]):
        # as one datagram of a port: magic, kind, flags, reserved, id, sequence, length
        header = struct.pack("<IBBHiII", 0x314B4C56, 1, i % 2, 0, 0, i, len(message))
        write("portdatagram", f"{path.stem}-{i}", header + message)
    write("share", path.stem, b"".join(struct.pack("<H", len(message)) + message for message in messages))
    write("share", f"{path.stem}.xml", plistlib.dumps(snapshot(messages), sort_keys=False))
    write("snapshot", f"{path.stem}.xml", plistlib.dumps(snapshot(messages), sort_keys=False))
    write("snapshot", f"{path.stem}.bplist", plistlib.dumps(snapshot(messages), fmt=plistlib.FMT_BINARY, sort_keys=False))
