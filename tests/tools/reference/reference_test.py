"""The pages in docs/reference are just what tessel-reference makes of the class tables.

usage: reference_test.py [emulator...] tessel-reference docs/reference
"""

import pathlib
import subprocess
import sys
import tempfile


def pages(folder):
    return {path.name: path.read_text(encoding="utf-8") for path in pathlib.Path(folder).glob("*.md")}


def main():
    *program, kept = sys.argv[1:]
    with tempfile.TemporaryDirectory() as folder:
        subprocess.run([*program, folder], check=True)
        made = pages(folder)
    if not made:
        sys.exit("tessel-reference made no page")
    stale = sorted(name for name in made.keys() | pages(kept).keys() if made.get(name) != pages(kept).get(name))
    if stale:
        sys.exit(f"not what the tables say: {', '.join(stale)}; run: build/bin/tessel-reference docs/reference")


if __name__ == "__main__":
    main()
