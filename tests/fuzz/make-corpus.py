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


for path in sorted(CAPTURES.glob("*.pcap")):
    raw = path.read_bytes()
    link, messages = packets(raw)
    write(FAMILIES[link], path.stem, b"".join(struct.pack("<H", len(message)) + message for message in messages))
    write("capture", path.name, raw)
    write("framing", path.stem, b"".join(messages))
    for i, message in enumerate(messages[:4]):
        # as one datagram of a port: magic, kind, flags, reserved, id, sequence, length
        header = struct.pack("<IBBHiII", 0x314B4C56, 1, i % 2, 0, 0, i, len(message))
        write("portdatagram", f"{path.stem}-{i}", header + message)
    write("snapshot", f"{path.stem}.xml", plistlib.dumps(snapshot(messages), sort_keys=False))
    write("snapshot", f"{path.stem}.bplist", plistlib.dumps(snapshot(messages), fmt=plistlib.FMT_BINARY, sort_keys=False))
