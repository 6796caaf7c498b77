#!/usr/bin/env python3
"""Writes the example instrument files of this folder from chosen true
coordinates, so that the coordinates computed from them can be checked.

Known points and detail points are given by X (northing), Y (easting), H.
Every observation is computed from them: slope distance, zenith angle and a
horizontal circle reading with an arbitrary zero per set-up.
"""
import math

KNOWN = {  # name: (x, y, h)
    "KC01": (5000.000, 3000.000, 10.000),
    "KC02": (5100.000, 3050.000, 12.000),
    "KC03": (4950.000, 3120.000, 11.000),
}
DETAIL = {
    "101": (5030.000, 3040.000, 10.500),
    "102": (4980.000, 3060.000, 10.200),
    "103": (5060.000, 2990.000, 11.300),
    "104": (5010.000, 3100.000, 10.800),
    "105": (4990.000, 3150.000, 10.900),
    "106": (4920.000, 3100.000, 10.100),
}


def point(name):
    return KNOWN.get(name) or DETAIL[name]


def observe(station, ih, target, prism, circle_zero):
    xs, ys, hs = point(station)
    xt, yt, ht = point(target)
    dx, dy = xt - xs, yt - ys
    hd = math.hypot(dx, dy)
    dh = (ht + prism) - (hs + ih)
    sd = math.hypot(hd, dh)
    zenith = math.degrees(math.atan2(hd, dh))
    azimuth = math.degrees(math.atan2(dy, dx)) % 360
    reading = (azimuth - circle_zero) % 360
    return sd, zenith, reading


def rec(code, fields):
    s = list(code)
    for col, text in fields:
        while len(s) < col - 1:
            s.append(" ")
        for i, ch in enumerate(text):
            p = col - 1 + i
            if p < len(s):
                s[p] = ch
            else:
                s.append(ch)
    return "".join(s)


def f10(x, decimals):
    return f"{x:.{decimals}f}"[:10].ljust(10)


def f16(x):
    return f"{x:.8f}".rjust(16)


def r16(text):
    return text.rjust(16)


def write(name, lines):
    with open(name, "wb") as out:
        out.write(("\r\n".join(lines) + "\r\n").encode("ascii"))


# Set-ups: station, instrument height, backsight, circle zero, then the
# observations in order as (target, prism height); the backsight is among them.
SETUPS = [
    ("KC01", 1.500, "KC02", 37.25,
     [("101", 1.500), ("KC02", 1.500), ("102", 1.500), ("103", 2.000), ("104", 2.000)]),
    ("KC03", 1.450, "KC01", 301.5,
     [("KC01", 1.700), ("105", 1.700), ("106", 1.700)]),
]

IDS = {"KC01": "0001", "KC02": "0002", "KC03": "0003"}


def sdr_id(name):
    return IDS.get(name) or name.rjust(4, "0")


def make_sdr():
    lines = ["00NMSDR20     V03-05    01-Jan-24 08:00 113111"]
    for name, (x, y, h) in KNOWN.items():
        lines.append(rec("08KI", [(5, IDS[name]), (9, f10(x, 4)), (19, f10(y, 4)),
                                  (29, f10(h, 4)), (49, name)]))
    for station, ih, backsight, zero, obs in SETUPS:
        lines.append(rec("02TP", [(5, IDS[station]), (39, f10(ih, 3))]))
        lines.append(rec("07TP", [(5, IDS[station]), (9, IDS[backsight])]))
        prism = None
        for target, height in obs:
            if height != prism:
                lines.append(rec("03NM", [(5, f10(height, 3))]))
                prism = height
            sd, z, ha = observe(station, ih, target, height, zero)
            lines.append(rec("09F1", [(5, IDS[station]), (9, sdr_id(target)), (13, f10(sd, 4)),
                                      (23, f10(z, 6)), (33, f10(ha, 6)), (43, "12")]))
    write("job-sdr.sdr", lines)


def make_obs():
    lines = ["00NMSDR33  V04-04.34    01-Jan-24 08:00 111111"]
    for name, (x, y, h) in KNOWN.items():
        lines.append(rec("08KI", [(5, r16(name)), (21, f16(x)), (37, f16(y)), (53, f16(h))]))
    for station, ih, backsight, zero, obs in SETUPS:
        xs, ys, hs = point(station)
        lines.append(rec("02TP", [(5, r16(station)), (21, f16(xs)), (37, f16(ys)), (53, f16(hs)),
                                  (69, f16(ih))]))
        lines.append(rec("07TP", [(5, r16(station)), (21, r16(backsight))]))
        prism = None
        for target, height in obs:
            if height != prism:
                lines.append(rec("03NM", [(5, f"{height:.8f}".ljust(16))]))
                prism = height
            sd, z, ha = observe(station, ih, target, height, zero)
            lines.append(rec("09F1", [(5, r16(station)), (21, r16(target)), (37, f16(sd)),
                                      (53, f16(z)), (69, f16(ha))]))
    write("job-obs.obs", lines)


def make_set():
    # The first observation after each set-up is its backsight.
    setups = [
        ("KC01", 1.500, "KC02", 37.25,
         [("KC02", 1.500), ("101", 1.500), ("102", 1.500), ("103", 2.000), ("104", 2.000)]),
        ("KC02", 1.520, "KC01", 12.0, [("KC01", 1.600), ("103", 1.600)]),
        ("KC03", 1.450, "KC01", 301.5, [("KC01", 1.700), ("105", 1.700), ("106", 1.800)]),
    ]
    lines = ["00NMSDR33 V04-04.02     01-Jan-24 08:00 111111"]
    for station, ih, backsight, zero, obs in setups:
        xs, ys, hs = point(station)
        lines.append(rec("02TP", [(5, r16(IDS[station])), (21, f16(xs)), (37, f16(ys)),
                                  (53, f16(hs)), (69, f16(ih)), (85, r16(station))]))
        prism = None
        for target, height in obs:
            if height != prism:
                lines.append(rec("03NM", [(5, f"{height:.8f}".ljust(16))]))
                prism = height
            sd, z, ha = observe(station, ih, target, height, zero)
            ident = IDS.get(target) or target
            code = target if target in KNOWN else "10"
            lines.append(rec("09F1", [(5, r16(IDS[station])), (21, r16(ident)), (37, f16(sd)),
                                      (53, f16(z)), (69, f16(ha)), (85, r16(code))]))
    write("job-set.set", lines)


if __name__ == "__main__":
    make_sdr()
    make_obs()
    make_set()
