#!/usr/bin/env python3
"""Writes the hand-made inputs of fuzz/corpus/profile/ (the stereo profile reader).

The example profiles (example_*.ovo) come from the ovo-profile tool instead:
  ovo-profile write examples/profiles/NAME.txt -o fuzz/corpus/profile/example_NAME.ovo
"""
import os
import struct

FOLDER = os.path.join(os.path.dirname(os.path.abspath(__file__)), "corpus", "profile")


def header(validity=1):
    return struct.pack(">4sII4s", b"\0\0\0\0", validity, 0, b"\0\0\0\0")


def item(item_id, data_type, count, payload=b""):
    return struct.pack(">Ihh", item_id, data_type, count) + payload


def words(item_id, *values, data_type=0x1003):
    return item(item_id, data_type, len(values), b"".join(struct.pack(">I", v) for v in values))


def real(item_id, value):
    return item(item_id, 0x1003, 1, struct.pack(">f", value))


def pad(items):
    return b"".join(items) + item(0, 0, 0) * (24 - len(items))


ENABLED = [words(0x2301, 1), words(0x2403, 1)]

FILES = {
    "empty.ovo": b"",
    "short_header.ovo": header()[:10],
    "header_only.ovo": header(),
    "validity_zero.ovo": header(0) + pad([real(0x2001, -0.035)] + ENABLED),
    "plain.ovo": header() + pad([words(0x2301, 0), words(0x2403, 1), words(0x2201, 640, 720)]),
    "screen_size.ovo": header() + pad([words(0x2302, 1), words(0x2202, 1280, 720), words(0x2201, 800, 480)] + ENABLED),
    "duplicate_split.ovo": header() + pad([words(0x2101, 0x3101), words(0x2101, 0x3102)] + ENABLED),
    "text_five_bytes.ovo": header() + pad([item(0x2501, 0x1005, 5, b"abcd\0"), real(0x2001, -0.035)] + ENABLED),
    "text_over_slot.ovo": header() + pad([item(0x2501, 0x1005, 200, bytes(range(200))), words(0x2101, 0x3102)] + ENABLED),
    "words_over_slot.ovo": header() + pad([words(0x2303, *range(40)), words(0x2102, 0x3107)] + ENABLED),
    "words_huge_count.ovo": header() + item(0x2001, 0x1003, 32767, b"\xbd\x0f\x5c\x29" * 8),
    "negative_counts.ovo": header() + pad([item(0x2001, 0x1003, -1), item(0x2501, 0x1005, -5), real(0x2003, -3.0)] + ENABLED),
    "unknown_type.ovo": header() + pad([item(0x2001, 0x0042, 3), real(0x2002, 0.01)] + ENABLED),
    "truncated_word.ovo": header() + words(0x2201, 640, 720)[:14],
    "truncated_head.ovo": header() + words(0x2301, 1) + b"\x00\x00\x24",
    "trailing_bytes.ovo": header() + pad(ENABLED) + b"trailing bytes are never read",
    "all_unused.ovo": header() + pad([words(i, 1) for i in (0x2303, 0x2305, 0x2306, 0x2307)]
                                     + [item(0x2501, 0x1005, 8, b"Paladog\0"), words(0x2304, 1, data_type=0x1004)] + ENABLED),
}

if __name__ == "__main__":
    os.makedirs(FOLDER, exist_ok=True)
    for name, content in FILES.items():
        with open(os.path.join(FOLDER, name), "wb") as file:
            file.write(content)
