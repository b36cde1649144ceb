#!/usr/bin/env python3
"""Works links on a screen of its own with a real mouse and keyboard, and sees what arrives in the programs that open and print.

    desktop_test.py PROGRAM        PROGRAM is desktop_links
"""
import os
import pathlib
import queue
import select
import shutil
import subprocess
import sys
import tempfile
import threading
import time
import unittest

PROGRAM = None
PATIENCE = 20  # seconds for what takes a moment


def wait_for(what, found):
    """Waits until found() gives something true, and gives that."""
    end = time.monotonic() + PATIENCE
    while time.monotonic() < end:
        value = found()
        if value:
            return value
        time.sleep(0.02)
    raise AssertionError(f"waited in vain for {what}")


class Screen:
    """An X server without a screen."""

    def __init__(self):
        read, write = os.pipe()
        self.server = subprocess.Popen(
            ["Xvfb", "-displayfd", str(write), "-screen", "0", "1024x768x24", "-nolisten", "tcp", "-noreset"],
            pass_fds=[write], stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL)
        os.close(write)
        number = b""
        while not number.endswith(b"\n"):
            ready, _, _ = select.select([read], [], [], PATIENCE)
            part = os.read(read, 16) if ready else b""
            if not part:
                raise RuntimeError("Xvfb does not start")
            number += part
        os.close(read)
        self.display = ":" + number.decode().strip()

    def stop(self):
        self.server.terminate()
        self.server.wait()


def write_program(file, text):
    file.parent.mkdir(parents=True, exist_ok=True)
    file.write_text(text)
    file.chmod(0o755)


class Desktop(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.scratch = tempfile.TemporaryDirectory(prefix="links-")
        root = cls.root = pathlib.Path(cls.scratch.name)
        cls.screen = Screen()
        cls.arrived = root / "arrived"
        cls.printed = root / "printed"
        # A program that writes down each argument that it is opened with, ended by a zero byte.
        note = '#!/bin/sh\nfor argument in "$@"; do printf "%s\\000" "$argument"; done >> "{file}"\n'
        write_program(root / "bin/viewer", note.format(file=cls.arrived))
        write_program(root / "bin/lp", note.format(file=cls.printed))
        applications = root / "data/applications"
        applications.mkdir(parents=True)
        types = ["text/plain", "inode/directory", "x-scheme-handler/https", "x-scheme-handler/mailto"]
        (applications / "viewer.desktop").write_text(
            f'[Desktop Entry]\nType=Application\nName=Viewer\nExec=viewer %u\nMimeType={";".join(types)};\n')
        home = root / "home"
        runtime = root / "runtime"
        for folder in (home, runtime, root / "config", root / "cache"):
            folder.mkdir(mode=0o700)
        keep = {name: os.environ[name] for name in ("ASAN_OPTIONS", "LSAN_OPTIONS", "UBSAN_OPTIONS") if name in os.environ}
        cls.environment = {
            **keep, "PATH": f"{root}/bin:/usr/local/bin:/usr/bin:/bin", "DISPLAY": cls.screen.display, "HOME": str(home), "LC_ALL": "C.UTF-8",
            "XDG_DATA_HOME": f"{root}/data", "XDG_CONFIG_HOME": f"{root}/config", "XDG_CACHE_HOME": f"{root}/cache",
            "XDG_RUNTIME_DIR": str(runtime), "QT_QPA_PLATFORM": "xcb", "BROWSER": "/no browser",
        }
        cls.run_tool("update-desktop-database", str(applications))
        cls.run_tool("xdg-mime", "default", "viewer.desktop", *types)

        cls.files = root / "the files"
        cls.files.mkdir()
        cls.odd = "a b'c\" $(touch pwned) ;&|.txt"
        for name in ("plain.txt", cls.odd, "--help", "line\nfeed.txt"):
            (cls.files / name).write_text("text\n")
        (cls.files / "unknown.zzz").write_bytes(b"\0\1\2\3" * 100)
        write_program(cls.files / "script.sh", f'#!/bin/sh\ntouch "{root}/pwned"\n')
        links = {
            "file": f"{cls.files}/plain.txt", "folder": str(cls.files), "web": "https://example.org/a?b=c&d=$(e)",
            "mail": "somebody@example.org", "filePrint": f"{cls.files}/plain.txt", "missing": f"{cls.files}/missing.txt",
            "quietLost": f"{cls.files}/no/such.txt", "odd": f"{cls.files}/{cls.odd}", "option": "--help",
            "lines": f"{cls.files}/line\nfeed.txt", "quietUnknown": f"{cls.files}/unknown.zzz", "quietScript": f"{cls.files}/script.sh",
        }
        cls.places = {name: (170, 22 + 30 * row) for row, name in enumerate(links)}
        cls.program = subprocess.Popen([PROGRAM, *(f"{name}={target}" for name, target in links.items())], cwd=cls.files,
                                       env=cls.environment, stdin=subprocess.PIPE, stdout=subprocess.PIPE, text=True)
        cls.lines = queue.Queue()
        threading.Thread(target=lambda: [cls.lines.put(line.rstrip("\n")) for line in cls.program.stdout], daemon=True).start()
        assert cls.lines.get(timeout=PATIENCE) == "ready"
        window = wait_for("the window", lambda: cls.tool_output("xdotool", "search", "--onlyvisible", "--name", "desktop_links"))
        cls.window = window.split()[0]
        cls.run_tool("xdotool", "windowfocus", "--sync", cls.window)

    @classmethod
    def tearDownClass(cls):
        cls.program.stdin.close()
        status = cls.program.wait(timeout=PATIENCE)
        cls.screen.stop()
        cls.scratch.cleanup()
        assert status == 0, f"the program ended with {status}"

    @classmethod
    def run_tool(cls, *words):
        subprocess.run(words, env=cls.environment, check=True, timeout=PATIENCE, stdout=subprocess.DEVNULL)

    @classmethod
    def tool_output(cls, *words):
        return subprocess.run(words, env=cls.environment, timeout=PATIENCE, capture_output=True, text=True).stdout

    def setUp(self):
        for file in (self.arrived, self.printed):
            file.unlink(missing_ok=True)
        self.move_away()
        self.settle()

    def settle(self):
        """All that was sent before has been worked off; forgets what was said."""
        self.ask("focus")

    def tool(self, *words):
        self.run_tool("xdotool", *words)

    def move_to(self, name):
        self.tool("mousemove", *map(str, self.places[name]))

    def move_away(self):
        self.tool("mousemove", "600", "450")

    def click(self, name, button="1"):
        self.move_to(name)
        self.tool("click", button)

    def ask(self, request):
        """The answer to a request; what was said before it is kept in self.said."""
        self.program.stdin.write(request + "\n")
        self.program.stdin.flush()
        self.said = []
        verb = request.split()[0]
        while True:
            line = self.lines.get(timeout=PATIENCE)
            if line.split(" ")[0] == verb:
                return line[len(verb) + 1:]
            self.said.append(line)

    def expect_said(self, *expected):
        said = []

        def all_there():
            self.ask("focus")
            said.extend(self.said)
            return len(said) >= len(expected)
        wait_for(expected, all_there)
        self.assertEqual(said, list(expected))

    def expect_color(self, name, color):
        def parts(text):
            return [int(text[i:i + 2], 16) for i in (1, 3, 5)]

        # The strokes of a small text are narrower than a pixel.
        def is_near():
            return max(abs(a - b) for a, b in zip(parts(self.ask("color " + name)), parts(color))) < 48
        wait_for(f"{name} in {color}, it is in {self.ask('color ' + name)}", is_near)

    def expect_arrival(self, file, *expected):
        def arrived():
            return file.exists() and file.read_bytes().split(b"\0")[:-1]
        self.assertEqual([argument.decode() for argument in wait_for(f"the arrival of {expected}", arrived)], list(expected))

    def focus(self, name):
        for _ in range(2 * len(self.places)):
            if self.ask("focus") == name:
                return
            self.tool("key", "Tab")
        self.fail(f"no Tab leads to {name}")

    def test_1_colour_follows_the_mouse(self):
        self.expect_color("file", "#0000c0")
        self.move_to("file")
        self.expect_color("file", "#c00000")
        self.move_away()  # in one jump, over the edge strip
        self.expect_color("file", "#0000c0")

    def test_2_click_opens_a_file_in_the_desktops_program(self):
        self.click("file")
        self.expect_arrival(self.arrived, f"{self.files}/plain.txt")
        self.expect_said("file MouseDown", "file MouseUp", "file Click")
        self.move_away()
        self.expect_color("file", "#800080")

    def test_folder(self):
        self.click("folder")
        self.expect_arrival(self.arrived, str(self.files))

    def test_web_address(self):
        self.click("web")
        self.expect_arrival(self.arrived, "https://example.org/a?b=c&d=$(e)")

    def test_mail_address(self):
        self.click("mail")
        self.expect_arrival(self.arrived, "mailto:somebody@example.org")

    def test_keyboard_alone(self):
        self.focus("folder")
        self.tool("key", "Return")
        self.expect_arrival(self.arrived, str(self.files))
        self.arrived.unlink()
        self.focus("mail")
        self.tool("key", "space")
        self.expect_arrival(self.arrived, "mailto:somebody@example.org")
        self.settle()
        self.assertEqual(self.ask("cursor mail"), "hand")

    def test_print(self):
        self.click("filePrint")
        self.expect_arrival(self.printed, "--", f"{self.files}/plain.txt")
        self.assertFalse(self.arrived.exists())

    def test_missing_file_is_told_in_a_box(self):
        self.click("missing")
        box = wait_for("the box", lambda: [w for w in self.tool_output("xdotool", "search", "--onlyvisible", "--name", "desktop_links").split()
                                           if w != self.window])[0]
        self.tool("windowfocus", "--sync", box)
        self.tool("key", "Return")
        wait_for("the box to go", lambda: box not in self.tool_output("xdotool", "search", "--onlyvisible", "--name", "desktop_links").split())
        self.tool("windowfocus", "--sync", self.window)
        self.assertFalse(self.arrived.exists())

    def test_messages_of_failures(self):
        self.assertEqual(self.ask("open quietLost"), "Unable to find file")
        self.assertEqual(self.ask("open quietUnknown"), "No application associated with file")

    def test_odd_names_are_data(self):
        self.click("odd")
        self.expect_arrival(self.arrived, f"{self.files}/{self.odd}")
        self.arrived.unlink()
        self.click("option")
        self.expect_arrival(self.arrived, f"{self.files}/--help")
        self.assertFalse((self.files / "pwned").exists())

    def test_name_with_a_line_feed(self):
        self.click("lines")
        self.expect_arrival(self.arrived, f"{self.files}/line\nfeed.txt")

    def test_script_is_never_run(self):
        self.assertEqual(self.ask("open quietScript"), "Unable to view file")
        self.assertFalse((self.root / "pwned").exists())

    def test_context_menu_copies_by_keyboard(self):
        self.focus("web")
        self.tool("key", "Menu")
        wait_for("the menu", lambda: self.ask("popup") == "open")
        self.tool("key", "c")
        wait_for("the copy", lambda: self.ask("clipboard") == "https://example.org/a?b=c&d=$(e)")
        self.assertFalse(self.arrived.exists())


def main():
    global PROGRAM
    PROGRAM = os.path.abspath(sys.argv.pop(1))
    missing = [tool for tool in ("Xvfb", "xdotool", "xdg-open", "xdg-mime", "update-desktop-database", "file") if not shutil.which(tool)]
    if missing:
        sys.exit("these are needed and not there: " + ", ".join(missing))
    unittest.main(verbosity=2)


if __name__ == "__main__":
    main()
