"""What the library is to reach, for the levels "best" and "16-byte"."""

RADII = (1, 2, 4, 8, 16, 32, 64, 100)
LEVELS = ("best", "16-byte")


def each(kind, rows, best, narrow, **more):
    """One goal per row: `best` and `narrow` are the limits of the two levels, None where there is none."""
    return [dict(kind=kind, row=row, limits=dict(zip(LEVELS, (best, narrow))), **more) for row in rows]


def blends(*operations):
    return [f"blend/{operation}/{data}/512x128" for operation in operations for data in ("text", "random")]


def goals():
    """`kind`: timesLiteral and timesPeer are at least, nsPerPixel, us and overRow at most the limit."""
    both = ("LINE48", "TITLE160")
    listed = []
    for radius, best, narrow in ((8, 40, 30), (32, 300, 220), (100, 1800, 1000)):
        listed += each("timesLiteral", [f"stroke/outside/TITLE160/R:{radius}"], best, narrow)
    listed += each("timesLiteral", ["stroke/inside/TITLE160/R:100"], 10000, 6000)
    listed += [goal for line in both for goal in each(
        "overRow", [f"stroke/outside/{line}/R:100"], 3, 4, other=f"stroke/outside/{line}/R:4")]
    for line in both:
        for radius in RADII:
            narrow = 1 if radius >= 4 else None
            listed += each("timesPeer", [f"stroke/outside/{line}/R:{radius}"], 1, narrow, peer="OpenCV")
            if line == "TITLE160" and radius > 32:
                continue
            for peer in ("libass", "FreeType"):
                listed += each("timesPeer", [f"stroke/outside/{line}/R:{radius}"], 1, 1, peer=peer)
    for radius, best, narrow in ((2, 45, 16), (8, 100, 30), (32, 120, 40), (100, 190, 60)):
        rows = [f"shadow/outer/{line}/R:{radius}" for line in both]
        listed += each("timesLiteral", rows, best, narrow)
        listed += each("timesPeer", rows, 5, None, peer="OpenCV")
    listed += each("timesLiteral", [f"growth/47-passes/{line}" for line in both], 90, 50)
    listed += each("nsPerPixel", blends("src-over", "dst-over", "mask-mode1", "mask-mode2", "mask-mode3",
                                        "mask-mode7", "composite"), 0.12, 0.35)
    listed += each("nsPerPixel", [f"fill/{kind}/LINE48" for kind in ("linear", "radial", "pattern")],
                   0.4, 0.6)
    for look, line, best, narrow in (
            ("A", "LINE48", 80, 160), ("A", "TITLE160", 250, 500), ("B", "LINE48", 90, 180),
            ("B", "TITLE160", 160, 400), ("C", "LINE48", 120, 250), ("C", "TITLE160", 400, 800),
            ("A", "GLYPH48", 8, 15)):
        listed += each("us", [f"look/{look}/{line}"], best, narrow)
    # Against the literal form on the machine of the run.
    for look, best, narrow in (("B", 36, 20), ("C", 25, 15)):
        listed += each("timesLiteral", [f"look/{look}/TITLE160"], best, narrow)
    # What is more than one source-over, and what another library has as well.
    listed += each("overRow", ["blend/mask-mode7/text/512x128", "blend/composite/text/512x128"], 1.5, 1.5,
                   other="blend/src-over/text/512x128")
    listed += each("timesPeer", [f"blend/{operation}/random/512x128" for operation in
                                 ("src-over", "dst-over", "mask-mode1", "mask-mode2")],
                   None, round(1 / 1.3, 2), peer="pixman")
    # The modern face against the classes, glyph by glyph.
    for onto in ("picture", "page"):
        listed += each("overRow", [f"look/glyphs/{onto}/painter"], 1.1, 1.1,
                       other=f"look/glyphs/{onto}/classes")
    return listed
