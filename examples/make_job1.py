#!/usr/bin/env python3
"""Writes the example field book job1.asc and its expected coordinates.

The points are laid out first (true coordinates to the millimetre); the
observations are then computed from them the way a total station records
them: horizontal readings zero on the orientation point, packed DDDMMSS to the
second, horizontal distances to the millimetre, zenith angles,
prism heights. Each point is drawn until its rounded observations lead back to
it within a quarter of a millimetre, so the computed coordinates are the true
ones to the millimetre.

Usage: python3 make_job1.py [folder]   (default: the folder of this script)

Writes job1.asc (TCVN3 text, CR LF) and job1.expected.txt: one line per
detail point in the order of the coordinate text file, "point NAME X Y H
[CODE [NOTE]]", and one line per auxiliary peg, "peg NAME X Y H".
"""

import math
import os
import random
import sys

RHO = 180.0 / math.pi

# Control points: name, X (northing), Y (easting), H.
CONTROL = {
    "DC01": (2345612.345, 567123.456, 12.345),
    "DC02": (2345812.210, 567251.874, 13.102),
    "DC03": (2345480.731, 567402.115, 11.876),
    "DC04": (2345702.562, 567560.388, 12.950),
}

# TCVN3 bytes of a few Vietnamese notes (house, fence, road, wall).
NOTES = {
    "nha": b"nh\xb5",  # nhà
    "rao": b"r\xb5o",  # rào
    "duong": b"\xae\xad\xeang",  # đường
    "tuong": b"t\xad\xeang",  # tường
}
CODES = ["N", "R", "D", "T", "10"]


def azimuth(frm, to):
    """Azimuth from frm to to, degrees clockwise from north, in [0, 360)."""
    a = math.degrees(math.atan2(to[1] - frm[1], to[0] - frm[0]))
    return a % 360.0


def packed(deg):
    """Decimal degrees as packed text DDDMMSS, to the whole second (a peg's
    reading must fit in 7 characters for the auxiliary-peg file)."""
    seconds = round(deg * 3600.0) % (360 * 3600)
    d, rest = divmod(seconds, 3600)
    m, s = divmod(rest, 60)
    return "%03d%02d%02d" % (d, m, s)


def unpacked(text):
    """Packed text back to decimal degrees."""
    d, m, s = int(text[0:3]), int(text[3:5]), float(text[5:])
    return d + m / 60.0 + s / 3600.0


class Station:
    def __init__(self, name, pos, ih, orient, orient_pos):
        self.name, self.pos, self.ih = name, pos, ih
        self.orient, self.orient_pos = orient, orient_pos
        self.az0 = azimuth(pos, orient_pos)

    def observe(self, point, prism):
        """Reading, distance and zenith texts of a sight to point."""
        dx, dy = point[0] - self.pos[0], point[1] - self.pos[1]
        dist = math.hypot(dx, dy)
        reading = packed((azimuth(self.pos, point) - self.az0) % 360.0)
        dist_text = "%.3f" % dist
        dz = point[2] - (self.pos[2] + self.ih - prism)
        zenith = packed(90.0 - math.degrees(math.atan2(dz, float(dist_text))))
        return reading, dist_text, zenith

    def implied(self, reading, dist_text, zenith, prism):
        """The point that the rounded observations give back."""
        a = math.radians(self.az0 + unpacked(reading))
        s = float(dist_text)
        z = self.pos[2] + math.tan(math.radians(90.0 - unpacked(zenith))) * s
        return (self.pos[0] + math.cos(a) * s, self.pos[1] + math.sin(a) * s,
                z + self.ih - prism)


def draw_point(rng, st, prism, dmin, dmax):
    """A point in mm whose rounded observations lead back within 0.25 mm."""
    while True:
        a = rng.uniform(0.0, 2.0 * math.pi)
        d = rng.uniform(dmin, dmax)
        p = (round(st.pos[0] + d * math.cos(a), 3),
             round(st.pos[1] + d * math.sin(a), 3),
             round(st.pos[2] + rng.uniform(-2.5, 2.5), 3))
        obs = st.observe(p, prism)
        back = st.implied(*obs, prism)
        if all(abs(u - v) < 0.00025 for u, v in zip(back, p)):
            return p, obs


def record(name, obs, prism, *extra):
    reading, dist, zenith = obs
    line = ("%-6s%9s%10s%9s%6.2f" % (name, reading, dist, zenith, prism)).encode()
    for word in extra:
        line += b" " + (word if isinstance(word, bytes) else word.encode())
    return line


def main():
    folder = sys.argv[1] if len(sys.argv) > 1 else os.path.dirname(os.path.abspath(__file__))
    rng = random.Random(2003)
    known = dict(CONTROL)
    lines = []
    expected = []
    number = 0

    def control_line(name):
        x, y, h = CONTROL[name]
        return ("TR %-8s%14.3f%13.3f%9.3f" % (name, x, y, h)).encode()

    # DC04 is defined at the end of the book: control points may stand anywhere.
    for name in ("DC01", "DC02", "DC03"):
        lines.append(control_line(name))

    # Station, instrument height, orientation point, peg set out (name or None).
    plan = [
        ("DC01", 1.45, "DC02", "CP1"),
        ("CP1", 1.50, "DC01", None),  # the peg of the first station
        ("DC03", 1.40, "DC04", "CP2"),
        ("DC04", 1.42, "CP2", None),  # oriented on the peg of the third
    ]
    for index, (name, ih, orient, peg) in enumerate(plan):
        st = Station(name, known[name], ih, orient, known[orient])
        lines.append(("TR %s %.2f" % (name, ih)).encode())
        lines.append(("DKD %s" % orient).encode())
        # The distance to the orientation point, checked against the coordinates.
        prism = 1.50
        lines.append(record(orient, st.observe(known[orient], prism), prism, orient))
        for k in range(25):
            number += 1
            prism = rng.choice([1.50, 1.50, 1.80, 2.00])
            p, obs = draw_point(rng, st, prism, 12.0, 160.0)
            kind = k % 5
            words = []
            if kind in (1, 3):
                words = [rng.choice(CODES)]
            elif kind == 4:
                note = rng.choice(sorted(NOTES))
                words = [rng.choice(CODES), NOTES[note]]
            lines.append(record(str(number), obs, prism, *words))
            expected.append(
                b"point %d %.3f %.3f %.3f" % (number, p[0], p[1], p[2])
                + b"".join(b" " + (w if isinstance(w, bytes) else w.encode()) for w in words))
            if peg and k == 11:
                prism = 1.50
                q, qobs = draw_point(rng, st, prism, 60.0, 120.0)
                lines.append(record(peg, qobs, prism, peg))
                known[peg] = q
                expected.append(b"peg %s %.3f %.3f %.3f" % (peg.encode(), q[0], q[1], q[2]))
        # A check sight on another known point closes each station.
        check = {0: "DC03", 1: "DC02", 2: "DC01", 3: "DC03"}[index]
        prism = 1.50
        obs = st.observe(known[check], prism)
        if index == 1:
            # No reading recorded: the run makes one up from the coordinates.
            obs = ("0", obs[1], obs[2])
        lines.append(record("K%d" % (index + 1), obs, prism, check, "KT"))

    lines.append(control_line("DC04"))

    with open(os.path.join(folder, "job1.asc"), "wb") as f:
        f.write(b"".join(line + b"\r\n" for line in lines))
    with open(os.path.join(folder, "job1.expected.txt"), "wb") as f:
        f.write(b"".join(line + b"\r\n" for line in expected))


if __name__ == "__main__":
    main()
