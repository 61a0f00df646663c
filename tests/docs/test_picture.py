#!/usr/bin/env python3
"""The README's picture of a terminal shows what `vkcim report` prints on the example host.

With VK_WRITE_PICTURES=1 it is drawn anew.
"""
import os
import pathlib
import subprocess
import sys
import tempfile
from xml.sax.saxutils import escape

ROOT = pathlib.Path(__file__).resolve().parent.parent.parent
PICTURE = ROOT / "docs/pictures/report.svg"
COLUMNS, SECTIONS = 84, 2  # the computer and its chassis: the rest speaks of the host that the command runs on
WIDTH, HEIGHT, MARGIN = 8.4, 18, 14


def report():
    environment = {"PATH": os.environ["PATH"], "COLUMNS": str(COLUMNS), "NVLOG_SINK": "none", "LC_ALL": "C.UTF-8",
                   "VK_INSTRUMENTATION_TREE": str(ROOT / "docs/examples/rack-server.json")}
    done = subprocess.run([os.environ["VKCIM"], "report"], env=environment, stdout=subprocess.PIPE, check=True, text=True)
    return "\n\n".join(done.stdout.split("\n\n")[:SECTIONS + 1]) + "\n\n…"


def drawn(text):
    lines = ["$ vkcim report", *text.splitlines()]
    width, height = COLUMNS * WIDTH + 2 * MARGIN, len(lines) * HEIGHT + 2 * MARGIN
    rows = "".join(f'<text x="{MARGIN}" y="{MARGIN + HEIGHT * (number + 0.75):g}">{escape(line)}</text>\n'
                   for number, line in enumerate(lines) if line)
    return (f'<svg xmlns="http://www.w3.org/2000/svg" width="{width:g}" height="{height:g}" font-family="monospace" '
            f'font-size="14" fill="#e6e6e6" xml:space="preserve">\n'
            f'<rect width="100%" height="100%" rx="8" fill="#1e2227"/>\n{rows}</svg>\n')


def main():
    picture = drawn(report())
    if os.environ.get("VK_WRITE_PICTURES"):
        PICTURE.write_text(picture, encoding="utf-8")
    elif PICTURE.read_text(encoding="utf-8") != picture:
        with tempfile.NamedTemporaryFile("w", suffix=".svg", delete=False, encoding="utf-8") as file:
            file.write(picture)
        sys.exit(f"{PICTURE} shows another report than {file.name}; VK_WRITE_PICTURES=1 draws it anew")


if __name__ == "__main__":
    main()
