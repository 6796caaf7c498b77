#!/usr/bin/env python3
"""Writes a seeded, varied field book for the differential check.

gen_fieldbook.py SEED OUT

Most records are ordinary set-ups and detail points on a grid of control
points; a few per book are the records that exercise the checks: duplicates,
pegs, check sights, orientation distances, angles out of range, run-together
and blank fields, long names, control points that are missing. Then the
corners that real files have: tabs (also at the end of a line), runs of
blanks, blanks before a record, names of 12 characters and more, and line
ends of CR alone.
"""
import random
import sys


def packed(rng, low=0.0, high=360.0):
    deg = rng.uniform(low, high)
    d = int(deg)
    m = int((deg - d) * 60)
    s = (deg - d - m / 60) * 3600
    text = f"{d:03d}{m:02d}{int(s):02d}"
    if rng.random() < 0.3:
        text += f".{rng.randint(0, 9)}"
    return text


def corner(rng, line):
    """The line as a real file may hold it, now and then."""
    roll = rng.random()
    fields = line.split(" ")
    if roll < 0.02:
        return line + "\t"  # a field left empty at the end
    if roll < 0.03 and len(fields) > 1:
        return "\t".join(fields) + "\t"
    if roll < 0.05 and len(fields) > 1:
        return (" " * rng.randint(2, 4)).join(fields)
    if roll < 0.06:
        return " " * rng.randint(1, 3) + line
    if roll < 0.075 and len(fields) > 1 and fields[0] not in ("TR", "DKD"):
        # a point name of 12 characters or more
        fields[0] = (fields[0] + "ABCDEFGHIJKLMNOP")[: rng.randint(12, 14)]
        return " ".join(fields)
    if roll < 0.08 and len(fields) > 2 and fields[0] == "TR":
        fields[1] = (fields[1] + "-ABCDEFGHIJKLMNOP")[: rng.randint(12, 13)]
        return " ".join(fields)
    return line


def main():
    seed = int(sys.argv[1])
    rng = random.Random(seed)
    lines = []
    controls = []
    # A job of a few hundred metres somewhere in the national grid.
    x0 = rng.uniform(1.0e6, 2.5e6)
    y0 = rng.uniform(3.0e5, 7.0e5)
    for k in range(rng.randint(2, 8)):
        name = rng.choice(["K", "DC", "GPS", "IV-"]) + str(k)
        x = f"{x0 + rng.uniform(-500, 500):.{rng.randint(0, 3)}f}"
        y = f"{y0 + rng.uniform(-500, 500):.{rng.randint(0, 3)}f}"
        h = f" {rng.uniform(0, 50):.3f}" if rng.random() < 0.7 else ""
        controls.append(name)
        lines.append(f"TR {name} {x} {y}{h}")
    pegs = []
    for s in range(rng.randint(1, 6)):
        known = controls + pegs
        station = rng.choice(known)
        orient = rng.choice([c for c in known if c != station] or known)
        if rng.random() < 0.05:
            orient = "MISSING" + str(s)
        height = f"{rng.uniform(1.2, 1.7):.2f}"
        lines.append(f"TR {station} {height}" if rng.random() > 0.03 else f"TR {station}")
        lines.append(f"DKD {orient}")
        for p in range(rng.randint(0, 40)):
            name = f"{s}{p:03d}" if rng.random() > 0.02 else "LONGNAME" * 2
            reading = packed(rng)
            dist = f"{rng.uniform(0.5, 400):.3f}"
            zen = packed(rng, 80, 100)
            prism = f"{rng.uniform(0, 2):.2f}"
            roll = rng.random()
            if roll < 0.03:
                peg = f"CP{s}{p}"
                pegs.append(peg)
                lines.append(f"{name} {reading} {dist} {zen} {prism} {peg}")
            elif roll < 0.05:
                lines.append(f"{name} {reading} {dist} {zen} {prism} {rng.choice(known)} KT")
            elif roll < 0.06:
                lines.append(f"{orient} 0000000 {dist} {zen} {prism} {orient}")
            elif roll < 0.07:
                lines.append(f"{name} 3615000 {dist} {zen} {prism}")
            elif roll < 0.08:
                lines.append(f"{name}{reading} {dist} {zen}")
            elif roll < 0.09:
                lines.append(f"{name} {reading} 2500.5 {zen} {prism} N")
            elif roll < 0.10:
                lines.append("")
            elif roll < 0.12:
                lines.append(f"{name} {reading} {dist} {zen} {prism} {rng.choice(['N', 'T', '12', '1.5'])} ghi_chu")
            else:
                lines.append(f"{name} {reading} {dist} {zen} {prism}")
    if rng.random() < 0.2:
        lines.insert(rng.randrange(len(lines) + 1), f"TR {controls[0]} 1000.000 2000.000")
    sep = "\r\n" if rng.random() < 0.9 else "\n"
    # The corners draw from a generator of their own, so that the books
    # above stay as they were drawn.
    corners = random.Random(seed * 7919 + 1)
    lines = [corner(corners, line) for line in lines]
    if corners.random() < 0.05:
        sep = "\r"
    with open(sys.argv[2], "wb") as out:
        out.write((sep.join(lines) + sep).encode("latin-1"))


main()
