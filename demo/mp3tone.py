"""Tones as MP3 streams, MPEG-1 layer III, mono, 44.1 kHz, 32 kbit/s.

A tone that stays is one line of the spectrum that has the same size in every granule, its sign
changing in a pattern of four. So nothing is analysed: the lines are written down as they are, of
size 1, in the part of a granule that holds ones and zeros, and its gain says how loud they are.
"""

import math

RATE = 44100
LINES = 576  # of a granule, and its length in samples
FRAME_BYTES = 104  # 144 * 32000 / 44100
HEADER = bytes((0xFF, 0xFB, 0x10, 0xC0))  # layer III, no checksum, 32 kbit/s, 44.1 kHz, mono
SIDE_BYTES = 17
LOUDEST = 200  # global gain; 4 more are twice as loud


class Bits:
    def __init__(self):
        self.text = ""

    def put(self, value, width):
        self.text += format(value, f"0{width}b")

    def bytes(self, length):
        padded = self.text.ljust(length * 8, "0")
        return int(padded, 2).to_bytes(length, "big")


def line_of(frequency):
    """The line whose middle is nearest."""
    return round(frequency / (RATE / 2 / LINES) - 0.5)


def sign(line, granule):
    """-1 or 1: the phase moves on by line + 1/2 half turns from one granule to the next."""
    return 1 if math.cos(math.pi / 4 + math.pi * (line + 0.5) * granule) > 0 else -1


def granule_bits(lines, granule):
    """Four lines at a time: which are not zero, each bit turned over, then the signs of those."""
    bits = Bits()
    for first in range(0, max(lines) + 1, 4):
        four = range(first, first + 4)
        bits.put(15 - sum(8 >> place for place, line in enumerate(four) if line in lines), 4)
        for line in four:
            if line in lines:
                bits.put(1 if sign(line, granule) < 0 else 0, 1)
    return bits


def side_info(granules, gains):
    side = Bits()
    side.put(0, 9 + 5 + 4)  # all of it stands in this frame; no scale factors are shared
    for granule, gain in zip(granules, gains):
        side.put(len(granule.text), 12)
        side.put(0, 9)  # no line is greater than 1
        side.put(gain, 8)
        side.put(0, 4 + 1 + 15 + 7 + 2)  # no scale factors, one long window
        side.put(1, 1)  # the table of four bits each
    return side.bytes(SIDE_BYTES)


def gain_at(granule, count):
    """Struck like a bell: each note fades to a hundredth."""
    return LOUDEST - round(27 * granule / count)


def tone(frequencies, seconds):
    """The stream of a chord of these frequencies in Hz, a whole number of frames."""
    lines = {line_of(frequency) for frequency in frequencies}
    frames = round(seconds * RATE / (2 * LINES))
    stream = b""
    for frame in range(frames):
        numbers = (2 * frame, 2 * frame + 1)
        granules = [granule_bits(lines, number) for number in numbers]
        gains = [gain_at(number, 2 * frames) for number in numbers]
        both = Bits()
        both.text = granules[0].text + granules[1].text
        room = FRAME_BYTES - len(HEADER) - SIDE_BYTES
        stream += HEADER + side_info(granules, gains) + both.bytes(room)
    return stream
