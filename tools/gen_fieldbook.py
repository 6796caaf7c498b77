#!/usr/bin/env python3
"""Writes a seeded, varied field book for the differential check.

gen_fieldbook.py SEED OUT

Most records are ordinary set-ups and detail points on a grid of control
points; a few per book are the records that exercise the checks: duplicates,
pegs, check sights, orientation distances, angles out of range, run-together
and blank fields, long names, control points that are missing.
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
    with open(sys.argv[2], "wb") as out:
        out.write((sep.join(lines) + sep).encode("latin-1"))


main()
