"""Numbers and tables as the document shows them."""


def number(value):
    """With three digits that mean something."""
    if value >= 1e6:
        return f"{number(value / 1e6)} M"
    if value >= 1000:
        return f"{float(f'{value:.3g}'):,.0f}"
    return f"{float(f'{value:.3g}'):g}"


def seconds(value):
    for unit, scale in (("s", 1), ("ms", 1e3), ("µs", 1e6)):
        if value * scale >= 1:
            return f"{number(value * scale)} {unit}"
    return f"{number(value * 1e9)} ns"


def megabytes(kib):
    return f"{number(kib * 1024 / 1e6)} MB"


def times(ratio):
    """How many times as much; less than a half as a part."""
    if ratio >= 0.5:
        return f"{ratio:.0f}" if ratio >= 20 else f"{ratio:.2g}"
    return f"1/{float(f'{1 / ratio:.2g}'):g}"


def table(head, rows):
    lines = [head, ["---"] * len(head), *rows]
    return "\n".join("| " + " | ".join(map(str, line)) + " |" for line in lines)
