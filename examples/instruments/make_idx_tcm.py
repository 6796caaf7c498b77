#!/usr/bin/env python3
"""Writes the example Topcom files job-idx.idx and job-tcm.tcm, the control
points they are computed with (job-idx-tcm-control.txt) and the expected
coordinates (job-idx.expected.txt, job-tcm.expected.txt).

The points are laid out first (true coordinates to the millimetre); the
observations are then computed from them the way each instrument records them:

- keyword file: Hz and Vz in decimal degrees (6 decimals), slope distance and
  prism height, the circle reading zero on the orientation point;
- Topcom 226: packed readings DDD MMSS to the whole second with the circle set
  near zero on the orientation point (number 0, its name as description),
  horizontal distance, zenith angle, prism height.

Each point is drawn until the field book that the converter makes of its
observations (readings to the whole second, distances reduced to the
millimetre) leads back to it within a quarter of a millimetre, so the computed
coordinates are the true ones to the millimetre. The keyword file's first
sight of each set-up, on the orientation point, is also written as a detail
record named after that point; it comes back within a millimetre or two.

Usage: python3 make_idx_tcm.py [folder]   (default: the folder of this script)

Expected files: one line per detail point in observation order,
"point NAME X Y H", and "peg NAME X Y H" for a peg set out.
"""

import math
import os
import random
import sys

CONTROL = {
    "GPS01": (2341520.412, 585310.227, 8.412),
    "GPS02": (2341688.905, 585402.618, 9.037),
    "GPS03": (2341605.330, 585561.774, 7.865),
    "GPS04": (2341432.118, 585498.501, 8.120),
}


def azimuth(frm, to):
    return math.degrees(math.atan2(to[1] - frm[1], to[0] - frm[0])) % 360.0


def whole_seconds(deg):
    return round(deg * 3600.0) / 3600.0


def point_from(st, ih, az, hd, zenith, prism):
    a = math.radians(az)
    dz = hd / math.tan(math.radians(zenith))
    return (st[0] + hd * math.cos(a), st[1] + hd * math.sin(a), st[2] + ih + dz - prism)


def sight(st, ih, pt, prism):
    """Horizontal distance and zenith angle (degrees) from st to pt."""
    hd = math.hypot(pt[0] - st[0], pt[1] - st[1])
    dz = pt[2] + prism - st[2] - ih
    return hd, 90.0 - math.degrees(math.atan2(dz, hd))


def close(p, q):
    return all(abs(u - v) < 0.00025 for u, v in zip(p, q))


def draw(rng, st, test):
    while True:
        a = rng.uniform(0.0, 2.0 * math.pi)
        d = rng.uniform(15.0, 140.0)
        p = (round(st[0] + d * math.cos(a), 3), round(st[1] + d * math.sin(a), 3),
             round(st[2] + rng.uniform(-2.0, 2.0), 3))
        obs = test(p)
        if obs is not None:
            return p, obs


def idx_job(rng, expected):
    """Keyword file: set-ups with STN_ID and INST_HT, SLOPE observations."""
    out = ["HEADER", "\tVERSION 1.20", "\tSYSTEM\t\"0\"", "\tUNITS", "\t\tANGULAR DEG",
           "\t\tLINEAR  METRE", "\tEND UNITS", "\tPROJECT", "\t\tNAME\t\"JOB-IDX\"",
           "\tEND PROJECT", "END HEADER", "THEODOLITE"]
    # Station, instrument height, orientation point, prism heights of its points.
    plan = [("GPS01", 1.452, "GPS02", [1.5, 1.5, 1.5, 1.5, 1.5]),
            ("GPS02", 1.515, "GPS03", [1.5, 1.5, 2.0, 2.0, 2.0]),
            ("GPS04", 1.380, "GPS03", [2.0, 2.0, 1.3, 1.3])]
    target = 1000
    number = 100
    for index, (name, ih, orient, prisms) in enumerate(plan):
        st = CONTROL[name]
        az0 = azimuth(st, CONTROL[orient])
        out += ["\tSETUP", "\t\tSTN_NO\t%d" % target, "\t\tSTN_ID\t\"%s\"" % name,
                "\t\tINST_HT\t%.6f;" % ih, "\tEND SETUP",
                "\tSLOPE(TgtNo, TgtID, CfgNo, Hz, Vz, SDist, RefHt, Date, Ppm, ApplType, Flags)"]

        def observe(p, prism):
            hz = round((azimuth(st, p) - az0) % 360.0, 6)
            hd, vz = sight(st, ih, p, prism)
            vz = round(vz, 6)
            sd = round(hd / math.sin(math.radians(vz)), 3)
            book_hd = round(abs(sd * math.sin(vz * 3.14159265358979 / 180.0000001)), 3)
            back = point_from(st, ih, az0 + whole_seconds(hz), book_hd, whole_seconds(vz), prism)
            return (hz, vz, sd) if close(back, p) else None

        sights = [(orient, CONTROL[orient], 1.5, observe(CONTROL[orient], 1.5))]
        for prism in prisms:
            number += 1
            p, obs = draw(rng, st, lambda q, pr=prism: observe(q, pr))
            sights.append((str(number), p, prism, obs))
        for tname, p, prism, obs in sights:
            target += 1
            hz, vz, sd = obs if obs is not None else observe_plain(st, ih, az0, p, prism)
            out.append("\t\t%d,\t\"%s\",\t1,\t%.6f,\t%.6f,\t%.6f,\t%.6f,\t06-12-2026/%02d:%02d:00.0,"
                       "\t0.000000,\t107,\t00001100;"
                       % (target, tname, hz, vz, sd, prism, 8 + index, target % 60))
            expected.append("point %s %.3f %.3f %.3f" % ((tname,) + tuple(p)))
        out.append("\tEND SLOPE")
    out.append("END THEODOLITE")
    return out


def observe_plain(st, ih, az0, p, prism):
    """The orientation sight need not come back within a quarter millimetre."""
    hd, vz = sight(st, ih, p, prism)
    vz = round(vz, 6)
    return round((azimuth(st, p) - az0) % 360.0, 6), vz, round(hd / math.sin(math.radians(vz)), 3)


def packed_columns(deg):
    """DDD in 4 columns, a blank, MMSS in 4 (whole seconds)."""
    s = round(deg * 3600.0) % (360 * 3600)
    d, rest = divmod(s, 3600)
    m, sec = divmod(rest, 60)
    return "%4d %02d%02d" % (d, m, sec)


def tcm_line(number, reading, zenith, hd, prism, desc=""):
    line = " " * 25 + "%6s" % number + packed_columns(reading) + packed_columns(zenith)
    line += " " * 9 + "%9.3f%6.3f" % (hd, prism)
    return (line + " " + desc).rstrip()


def tcm_job(rng, expected):
    out = ["TOPCOM 226  JOB-TCM  06-12-2026"]
    # Station, instrument height, orientation point, circle on it (seconds),
    # prism heights, peg set out by the first point.
    plan = [("GPS03", 1.47, "GPS04", 0, [1.5, 1.5, 2.0, 2.0], "CP7"),
            ("GPS01", 1.41, "GPS04", 2, [2.0, 1.6, 1.6], None),
            ("GPS02", 1.55, "GPS01", 0, [1.5, 1.5, 1.5], None)]
    number = 200
    for name, ih, orient, circle, prisms, peg in plan:
        st = CONTROL[name]
        az0 = azimuth(st, CONTROL[orient])
        out.append("%-10s%6.2f" % (name, ih))
        hd, vz = sight(st, ih, CONTROL[orient], 1.5)
        out.append(tcm_line(0, circle / 3600.0, vz, hd, 1.5, orient))
        # Its description names the orientation point, so the field book's
        # record only checks the orientation distance.

        def observe(p, prism):
            reading = whole_seconds((azimuth(st, p) - az0) % 360.0 + circle / 3600.0)
            hd_p, vz_p = sight(st, ih, p, prism)
            hd_p, vz_p = round(hd_p, 3), whole_seconds(vz_p)
            back = point_from(st, ih, az0 + reading - circle / 3600.0, hd_p, vz_p, prism)
            return (reading, vz_p, hd_p) if close(back, p) else None

        for k, prism in enumerate(prisms):
            number += 1
            p, (reading, vz_p, hd_p) = draw(rng, st, lambda q, pr=prism: observe(q, pr))
            desc = peg if (k == 0 and peg) else ""
            out.append(tcm_line(number, reading, vz_p, hd_p, prism, desc))
            # A description longer than 2 characters names a peg, which is not
            # a detail point.
            kind = "peg %s" % desc if desc else "point %d" % number
            expected.append("%s %.3f %.3f %.3f" % ((kind,) + tuple(p)))
    return out


def write(folder, name, lines):
    with open(os.path.join(folder, name), "wb") as f:
        f.write(("\r\n".join(lines) + "\r\n").encode("latin-1"))


def main():
    folder = sys.argv[1] if len(sys.argv) > 1 else os.path.dirname(os.path.abspath(__file__))
    rng = random.Random(2026)
    control = ["TR %-8s%14.3f%13.3f%9.3f" % ((n,) + c) for n, c in CONTROL.items()]
    write(folder, "job-idx-tcm-control.txt", control)
    expected = []
    write(folder, "job-idx.idx", idx_job(rng, expected))
    write(folder, "job-idx.expected.txt", expected)
    expected = []
    write(folder, "job-tcm.tcm", tcm_job(rng, expected))
    write(folder, "job-tcm.expected.txt", expected)


if __name__ == "__main__":
    main()
