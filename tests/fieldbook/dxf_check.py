#!/usr/bin/env python3
"""An independent reading of a DXF file that we wrote: ezdxf reads it, audits it, and compares what it
finds with what the test expected.

    dxf_check.py FILE [--points POINTS] [--texts TEXTS] [--layers LAYERS]

POINTS: one line per POINT entity, in the order of the file: "x y z LAYER" (LAYER optional).
TEXTS: one line per TEXT entity, in the order of the file: "LAYER<tab>text" (UTF-8), optionally followed
by "<tab>x y", where the text stands.
LAYERS: one line per layer that the LAYER table must hold (others may be there too): "NAME", optionally
followed by " colour".

Exit status: 0 when everything agrees; 1 when the file cannot be read or the audit finds errors or has
to fix something; 2 when the file disagrees with what was expected. Every finding is printed.
"""

import argparse
import sys

try:
    import ezdxf
except ImportError:
    print("ezdxf introuvable pour ce python3 : installer python3-ezdxf (scripts/install-deps)")
    sys.exit(3)

# Coordinates are written to the micrometre: half of it is the largest rounding.
TOLERANCE = 0.6e-6


def read_lines(path):
    with open(path, encoding="utf-8") as f:
        return [line.rstrip("\r\n") for line in f if line.strip()]


def main():
    parser = argparse.ArgumentParser()
    parser.add_argument("file")
    parser.add_argument("--points")
    parser.add_argument("--texts")
    parser.add_argument("--layers")
    args = parser.parse_args()

    try:
        doc = ezdxf.readfile(args.file)
    except (IOError, ezdxf.DXFStructureError) as error:
        print(f"lecture impossible : {error}")
        return 1

    status = 0
    auditor = doc.audit()
    for entry in auditor.errors:
        print(f"audit, erreur : {entry.message}")
    # ezdxf 0.18 takes the SEQEND that ends a polyline inside a block for an entity without owner, in the
    # release-12 files that it writes itself as well: that fix is shown, not held against the file.
    fixes = 0
    for entry in auditor.fixes:
        seqend_in_block = entry.message.startswith("Deleted SEQEND(") and entry.message.endswith(
            "with invalid owner handle #None.")
        print(f"audit, correction{' (ezdxf 0.18, SEQEND dans un bloc)' if seqend_in_block else ''} : {entry.message}")
        fixes += 0 if seqend_in_block else 1
    if auditor.has_errors or fixes:
        status = 1

    if doc.dxfversion != "AC1009":
        print(f"version {doc.dxfversion}, AC1009 attendue")
        status = 2

    msp = doc.modelspace()

    # What the audit lets pass and a CAD program would not: an entity on a layer that the table does not
    # declare, an insertion of a block that is not defined, a text without height, a point outside the
    # extents of the header.
    layers = {layer.dxf.name for layer in doc.layers}
    for layout in [msp] + [block for block in doc.blocks if not block.is_any_layout]:
        for entity in layout:
            if entity.dxf.layer not in layers:
                print(f"{entity.dxftype()} sur le calque {entity.dxf.layer}, absent de la table des calques")
                status = 2
            if entity.dxftype() == "INSERT" and entity.dxf.name not in doc.blocks:
                print(f"INSERT du bloc {entity.dxf.name}, qui n'est pas défini")
                status = 2
            if entity.dxftype() == "TEXT" and not entity.dxf.height > 0:
                print(f"TEXT {entity.dxf.text!r} de hauteur {entity.dxf.height}")
                status = 2
    low = doc.header.get("$EXTMIN")
    high = doc.header.get("$EXTMAX")
    if low is None or high is None:
        print("$EXTMIN ou $EXTMAX absent de l'en-tête")
        status = 2
    else:
        for point in msp.query("POINT"):
            where = point.dxf.location
            if any(w < a - TOLERANCE or w > b + TOLERANCE for w, a, b in zip(where, low, high)):
                print(f"point {tuple(where)} hors de l'étendue {tuple(low)} - {tuple(high)}")
                status = 2
    print("entités : " + ", ".join(f"{kind} {len(msp.query(kind))}" for kind in
                                    ("POINT", "TEXT", "LINE", "POLYLINE", "INSERT")))

    if args.points:
        expected = [line.split() for line in read_lines(args.points)]
        found = list(msp.query("POINT"))
        if len(found) != len(expected):
            print(f"{len(found)} points lus, {len(expected)} attendus")
            status = 2
        for rank, (point, fields) in enumerate(zip(found, expected)):
            location = point.dxf.location
            want = [float(v) for v in fields[:3]]
            if any(abs(a - b) > TOLERANCE for a, b in zip(location, want)):
                print(f"point {rank + 1} : lu {tuple(location)}, attendu {tuple(want)}")
                status = 2
            if len(fields) > 3 and point.dxf.layer != fields[3]:
                print(f"point {rank + 1} : calque {point.dxf.layer}, attendu {fields[3]}")
                status = 2

    if args.texts:
        expected = [line.split("\t") for line in read_lines(args.texts)]
        found = list(msp.query("TEXT"))
        if len(found) != len(expected):
            print(f"{len(found)} textes lus, {len(expected)} attendus")
            status = 2
        for rank, (text, (layer, words, *where)) in enumerate(zip(found, expected)):
            # A character outside the drawing's code page is stored as \U+XXXX: read as a CAD program
            # shows it.
            shown = ezdxf.decode_dxf_unicode(text.dxf.text)
            if text.dxf.layer != layer or shown != words:
                print(f"texte {rank + 1} : lu {text.dxf.layer!r} {shown!r}, attendu {layer!r} {words!r}")
                status = 2
            if where:
                want = [float(v) for v in where[0].split()]
                insert = text.dxf.insert
                if any(abs(a - b) > TOLERANCE for a, b in zip(insert, want)):
                    print(f"texte {rank + 1} {shown!r} : à {tuple(insert)}, attendu à {tuple(want)}")
                    status = 2

    if args.layers:
        colours = {layer.dxf.name: layer.dxf.color for layer in doc.layers}
        for name, *colour in (line.split() for line in read_lines(args.layers)):
            if name not in colours:
                print(f"calque {name} absent de la table des calques")
                status = 2
            elif colour and colours[name] != int(colour[0]):
                print(f"calque {name} de couleur {colours[name]}, attendue {colour[0]}")
                status = 2

    return status


if __name__ == "__main__":
    sys.exit(main())
