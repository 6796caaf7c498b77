"""Opens drawing files with an independent DXF reader (ezdxf) and checks that
it finds every point and label where the survey put them: no audit errors,
the counts of POINT and TEXT entities, their layers, drawing x = easting Y,
drawing y = northing X, label heights and the names' TCVN3 bytes.

Usage: dxf_reader_check.py FOLDER...   (the expected drawing files of the tests)
"""
import math
import os
import sys

import ezdxf

# Per file: points as (layer, X, Y); labels as (layer, X, Y, height, name bytes).
# A label sits half a detail label's height north and east of its point.
EXPECTED = {
    "control_and_detail.dxf": {
        "points": [
            ("KC", 2345678.123, 567890.456),
            ("KC", 2345600, 567800.5),
            ("KC", 2345678.123, 567890.456),
            ("KC", 0.5, -0.25),
            ("KC", 0, 0),
            ("DIEM", 2345678.123, 567890.456),
            ("DIEM", 2345700.001, 567900.999),
            ("DIEM", -12.5, 7),
            ("DIEM", 1000, 200),
        ],
        "labels": [
            ("KC-ID", 2345679.123, 567891.456, 3, b"P1"),
            ("KC-ID", 2345601, 567801.5, 3, b"\xa7\xd3i1"),
            ("KC-ID", 2345679.123, 567891.456, 3, b"P1"),
            ("KC-ID", 1.5, 0.75, 3, b"ABCDEFGHIJKL"),
            ("KC-ID", 1, 1, 3, b"BAD"),
            ("DIEM_ID", 2345679.123, 567891.456, 2, b"15"),
            ("DIEM_ID", 2345701.001, 567901.999, 2, b""),
            ("DIEM_ID", -11.5, 8, 2, b"C\xacng"),
            ("DIEM_ID", 1001, 201, 2, b"ABCDEFGHIJKL"),
        ],
    },
    "height_not_a_number.dxf": {
        "points": [("DIEM", 100.25, 200.75)],
        "labels": [("DIEM_ID", 100.25, 200.75, 0, b"7")],
    },
    "no_points.dxf": {"points": [], "labels": []},
    # The seeded run of products/run/job.asc: stations at KC1 (1000, 1000)
    # facing KC2 due south and at the peg CP1 (1040, 1000) facing KC1.
    "job.dxf": {
        "points": [
            ("KC", 1000, 1000),
            ("KC", 900, 1000),
            ("KC", 1000, 1100),
            ("KC", 1040, 1000),
            ("KC", 1040, 995),
            ("KC", 1040, 994),
            ("DIEM", 1000, 900),
            ("DIEM", 950, 1000),
            ("DIEM", 978.433, 978.433),
            ("DIEM", 980, 1000),
            ("DIEM", 1012, 1000),
            ("DIEM", 1040, 990),
        ],
        "labels": [
            ("KC-ID", 1001, 1001, 3, b"KC1"),
            ("KC-ID", 901, 1001, 3, b"KC2"),
            ("KC-ID", 1001, 1101, 3, b"KC3"),
            ("KC-ID", 1041, 1001, 3, b"CP1"),
            ("KC-ID", 1041, 996, 3, b"CP2"),
            ("KC-ID", 1041, 995, 3, b"CP3"),
            ("DIEM_ID", 1001, 901, 2, b"1"),
            ("DIEM_ID", 951, 1001, 2, b"2"),
            ("DIEM_ID", 979.433, 979.433, 2, b"3"),
            ("DIEM_ID", 981, 1001, 2, b"4"),
            ("DIEM_ID", 1013, 1001, 2, b"LONGPOINTNAM"),
            ("DIEM_ID", 1041, 991, 2, b"21"),
        ],
    },
}


def close(a, b):
    return math.isclose(a, b, rel_tol=0, abs_tol=1e-9)


def check(path, expected):
    faults = []
    doc = ezdxf.readfile(path)
    auditor = doc.audit()
    faults += [f"audit error: {e.message}" for e in auditor.errors]
    faults += [f"audit fix: {e.message}" for e in auditor.fixes]
    msp = doc.modelspace()
    points = [
        (e.dxf.layer, e.dxf.location.y, e.dxf.location.x) for e in msp if e.dxftype() == "POINT"
    ]
    labels = [
        (
            e.dxf.layer,
            e.dxf.insert.y,
            e.dxf.insert.x,
            e.dxf.height,
            e.dxf.text.encode("latin-1"),
        )
        for e in msp
        if e.dxftype() == "TEXT"
    ]
    others = [e.dxftype() for e in msp if e.dxftype() not in ("POINT", "TEXT")]
    if others:
        faults.append(f"unexpected entities {others}")
    if len(points) != len(expected["points"]):
        faults.append(f"{len(points)} points, expected {len(expected['points'])}")
    if len(labels) != len(expected["labels"]):
        faults.append(f"{len(labels)} labels, expected {len(expected['labels'])}")
    for got, want in zip(points, expected["points"]):
        if got[0] != want[0] or not close(got[1], want[1]) or not close(got[2], want[2]):
            faults.append(f"point {got} expected {want}")
    for got, want in zip(labels, expected["labels"]):
        if (
            got[0] != want[0]
            or not all(close(g, w) for g, w in zip(got[1:4], want[1:4]))
            or got[4] != want[4]
        ):
            faults.append(f"label {got} expected {want}")
    return faults


def main():
    paths = {
        name: os.path.join(folder, name)
        for folder in sys.argv[1:]
        for name in os.listdir(folder)
        if name.endswith(".dxf")
    }
    names = sorted(paths)
    failed = False
    if sorted(EXPECTED) != names:
        print(f"drawing files {names}, expected {sorted(EXPECTED)}")
        failed = True
    for name in names:
        if name not in EXPECTED:
            continue
        faults = check(paths[name], EXPECTED[name])
        for fault in faults:
            print(f"{name}: {fault}")
        failed = failed or bool(faults)
    print("FAILED" if failed else f"{len(names)} drawing files read back")
    return 1 if failed else 0


if __name__ == "__main__":
    sys.exit(main())
