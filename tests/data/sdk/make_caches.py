# SPDX-License-Identifier: MIT
# Copyright (c) Tarnell FBX contributors
#
# Makes the point caches that caches_7400_ascii.fbx refers to, in the folder "caches" next to this file:
#
#     python3 make_caches.py
#
# Each has three points; at frame f of 24 per second the point p is at (p, f * f, number of the cache).
import pathlib
import struct

FOLDER = pathlib.Path(__file__).parent / "caches"
POINT_COUNT = 3
TICKS_PER_FRAME = 250  # of 6000 per second


def numbers(frame, cache):
    return [number for p in range(POINT_COUNT) for number in (p, frame * frame, cache)]


class Layout:
    """Chunks of a Maya cache: a tag, a size and the content, padded to a multiple of the alignment."""

    def __init__(self, suffix, group, head, alignment):
        self.suffix, self.group_tag, self.head, self.alignment = suffix, group, head, alignment

    def chunk(self, tag, content):
        return struct.pack(self.head, tag, len(content)) + content + bytes(-len(content) % self.alignment)

    def group(self, kind, *chunks):
        content = kind + b"".join(chunks)
        return struct.pack(self.head, self.group_tag, len(content)) + content

    def number(self, tag, value):
        return self.chunk(tag, struct.pack(">i", value))

    def start(self, first_tick, last_tick):
        return self.group(b"CACH", self.chunk(b"VRSN", b"0.1\0"), self.number(b"STIM", first_tick),
                          self.number(b"ETIM", last_tick))

    def channel(self, tag, values):
        letter = {b"FVCA": "f", b"DVCA": "d"}[tag]
        return (self.chunk(b"CHNM", b"wave\0") + self.number(b"SIZE", POINT_COUNT)
                + self.chunk(tag, struct.pack(f">{len(values)}{letter}", *values)))


MC = Layout(".mc", b"FOR4", ">4sI", 4)
MCX = Layout(".mcx", b"FOR8", ">4s4xQ", 8)


def write_description(name, kind, file_format, channel_type, frames, frame_step):
    first, last = frames[0] * TICKS_PER_FRAME, frames[-1] * TICKS_PER_FRAME
    text = f"""<?xml version="1.0"?>
<Autodesk_Cache_File>
  <cacheType Type="{kind}" Format="{file_format}"/>
  <time Range="{first}-{last}"/>
  <cacheTimePerFrame TimePerFrame="{TICKS_PER_FRAME}"/>
  <cacheVersion Version="2.0"/>
  <extra>made by make_caches.py</extra>
  <Channels>
    <channel0 ChannelName="wave" ChannelType="{channel_type}" ChannelInterpretation="positions" SamplingType="Regular" \
SamplingRate="{frame_step * TICKS_PER_FRAME}" StartTime="{first}" EndTime="{last}"/>
  </Channels>
</Autodesk_Cache_File>
"""
    (FOLDER / f"{name}.xml").write_text(text, encoding="ascii", newline="\n")


def write_one_file(name, layout, tag, frames, cache):
    samples = [layout.group(b"MYCH", layout.number(b"TIME", frame * TICKS_PER_FRAME),
                            layout.channel(tag, numbers(frame, cache))) for frame in frames]
    (FOLDER / (name + layout.suffix)).write_bytes(layout.start(0, 1) + b"".join(samples))


def write_file_per_frame(name, layout, tag, frames, cache):
    for frame in frames:
        tick = frame * TICKS_PER_FRAME
        content = layout.start(tick, tick) + layout.group(b"MYCH", layout.channel(tag, numbers(frame, cache)))
        (FOLDER / f"{name}Frame{frame}{layout.suffix}").write_bytes(content)


def write_point_cache(name, frames, cache):
    head = struct.pack("<12siiffi", b"POINTCACHE2", 1, POINT_COUNT, frames[0], 1.0, len(frames))
    samples = [struct.pack(f"<{3 * POINT_COUNT}f", *numbers(frame, cache)) for frame in frames]
    (FOLDER / f"{name}.pc2").write_bytes(head + b"".join(samples))


def main():
    FOLDER.mkdir(exist_ok=True)
    write_description("wide", "OneFile", "mcx", "FloatVectorArray", [0, 1, 2], 1)
    write_one_file("wide", MCX, b"FVCA", [0, 1, 2], 1)
    write_description("narrow", "OneFile", "mcc", "DoubleVectorArray", [0, 2, 4], 2)
    write_one_file("narrow", MC, b"DVCA", [0, 2, 4], 2)
    write_description("files", "OneFilePerFrame", "mcc", "FloatVectorArray", [0, 1, 2], 1)
    write_file_per_frame("files", MC, b"FVCA", [0, 1, 2], 3)
    write_point_cache("max", [1, 2, 3], 4)


if __name__ == "__main__":
    main()
