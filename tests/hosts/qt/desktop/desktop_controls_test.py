#!/usr/bin/env python3
"""Works a bar, a score and a list of pairs on a screen of its own with a real mouse and keyboard.

    desktop_controls_test.py PROGRAM        PROGRAM is desktop_controls
"""
import os
import pathlib
import queue
import shutil
import subprocess
import sys
import tempfile
import threading
import unittest

from desktop_test import PATIENCE, Screen, wait_for

PROGRAM = None


class DesktopControls(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.scratch = tempfile.TemporaryDirectory(prefix="controls-")
        root = pathlib.Path(cls.scratch.name)
        cls.screen = Screen()
        keep = {name: os.environ[name] for name in ("ASAN_OPTIONS", "LSAN_OPTIONS", "UBSAN_OPTIONS") if name in os.environ}
        cls.environment = {**keep, "PATH": "/usr/local/bin:/usr/bin:/bin", "DISPLAY": cls.screen.display, "HOME": str(root),
                           "LC_ALL": "C.UTF-8", "XDG_RUNTIME_DIR": str(root), "QT_QPA_PLATFORM": "xcb"}
        cls.program = subprocess.Popen([PROGRAM], env=cls.environment, stdin=subprocess.PIPE, stdout=subprocess.PIPE, text=True)
        cls.lines = queue.Queue()
        threading.Thread(target=lambda: [cls.lines.put(line.rstrip("\n")) for line in cls.program.stdout], daemon=True).start()
        cls.said = []
        wait_for("the program", lambda: cls.lines.get(timeout=PATIENCE) == "ready")
        search = ("xdotool", "search", "--onlyvisible", "--name", "desktop_controls")
        window = wait_for("the window", lambda: subprocess.run(search, env=cls.environment, timeout=PATIENCE, capture_output=True,
                                                               text=True).stdout)
        cls.tool("windowfocus", "--sync", window.split()[0])

    @classmethod
    def tearDownClass(cls):
        cls.program.stdin.close()
        status = cls.program.wait(timeout=PATIENCE)
        cls.program.stdout.close()
        cls.screen.stop()
        cls.scratch.cleanup()
        assert status == 0, f"the program ended with {status}"

    @classmethod
    def tool(cls, *words):
        subprocess.run(("xdotool", *map(str, words)), env=cls.environment, check=True, timeout=PATIENCE, stdout=subprocess.DEVNULL)

    def setUp(self):
        self.tool("mousemove", 600, 450)
        self.ask("focus")
        self.said.clear()

    def ask(self, request):
        """The answer to a request; what was said before it is added to self.said."""
        self.program.stdin.write(request + "\n")
        self.program.stdin.flush()
        verb = request.split()[0]
        while True:
            word, _, rest = self.lines.get(timeout=PATIENCE).partition(" ")
            if word == verb:
                return rest
            self.said.append(f"{word} {rest}")

    def wait_for_answer(self, request, wanted):
        wait_for(f"{request}: {wanted}", lambda: self.ask(request) == wanted)

    def wait_for_said(self, *wanted):
        def said():
            self.ask("focus")
            return len(self.said) >= len(wanted)
        wait_for(f"{wanted}, said was {self.said}", said)
        self.assertEqual(self.said, list(wanted))

    def place(self, name):
        return [int(number) for number in self.ask("place " + name).split()]

    def move_into(self, name, x=None, y=None):
        """The pointer goes to a point of a control, else to its middle."""
        left, top, width, height = self.place(name)
        self.tool("mousemove", left + (width // 2 if x is None else x), top + (height // 2 if y is None else y))

    def drag_bar(self, to):
        """Drags the bar by its middle to places of the pointer, one after the other."""
        self.move_into("bar")
        self.tool("mousedown", 1)
        for x in to:
            self.tool("mousemove", x, 50)
        self.tool("mouseup", 1)

    def bar_moves(self):
        return [int(line.split()[-1]) for line in self.said if line.startswith("bar Moved")]

    def expect_bar_at(self, x):
        """The bar stands there, its neighbours touch it, and their outer edges are where they were."""
        self.wait_for_answer("place bar", f"{x} 20 8 60")
        self.assertEqual(self.ask("place left"), f"0 20 {x} 60")
        self.assertEqual(self.ask("place right"), f"{x + 8} 20 {640 - x - 8} 60")

    def test_dragged_bar_goes_where_the_pointer_goes(self):
        start = self.place("bar")[0]
        self.drag_bar(range(start + 14, start + 104, 10))
        self.expect_bar_at(start + 90)
        self.assertIn("bar AfterMove", self.said)
        moves = self.bar_moves()
        self.assertEqual(moves, sorted(moves))
        self.said.clear()
        self.drag_bar(range(start + 84, start + 3, -10))
        self.expect_bar_at(start)
        moves = self.bar_moves()
        self.assertEqual(moves, sorted(moves, reverse=True))

    def test_dragged_bar_stops_at_its_limits(self):
        start = self.place("bar")[0]
        self.drag_bar([start - 60, 1])
        self.expect_bar_at(50)
        self.drag_bar([200, 400, 639])
        self.expect_bar_at(640 - 60 - 8)
        self.drag_bar([start + 4])
        self.expect_bar_at(start)

    def test_bar_by_keys(self):
        start = self.place("bar")[0]
        for _ in range(8):
            if self.ask("focus") == "bar":
                break
            self.tool("key", "Tab")
        self.wait_for_answer("focus", "bar")
        self.tool("key", "Right")
        self.expect_bar_at(start + 8)
        self.tool("key", "shift+Left")
        self.expect_bar_at(start + 7)
        self.tool("key", "Home")
        self.expect_bar_at(50)
        self.tool("key", "End")
        self.expect_bar_at(640 - 60 - 8)
        self.assertEqual(self.said.count("bar AfterMove"), 4)
        self.drag_bar([start + 4])
        self.expect_bar_at(start)

    def test_click_on_a_score(self):
        self.move_into("card", 50, 20)
        self.tool("click", 1)
        x, y = self.inside_card(50, 20)
        self.wait_for_said(f"card MouseDown 1 0 {x} {y}", f"card MouseUp 1 0 {x} {y}", "card Click")

    def inside_card(self, x, y):
        """A place in twips, which the picture box counts from within its border."""
        border, twips_per_pixel = 2, 15
        return (x - border) * twips_per_pixel, (y - border) * twips_per_pixel

    def test_double_click_on_a_score(self):
        self.move_into("card", 50, 20)
        self.tool("click", "--repeat", 2, "--delay", 20, 1)
        x, y = self.inside_card(50, 20)
        self.wait_for_said(f"card MouseDown 1 0 {x} {y}", f"card MouseUp 1 0 {x} {y}", "card Click", "card DblClick",
                           f"card MouseUp 1 0 {x} {y}")

    def test_pointer_over_a_score(self):
        self.move_into("card", 70, 10)
        self.move_into("card", 71, 12)
        x, y = self.inside_card(71, 12)
        self.wait_for_answer("moved", f"0 {x} {y}")

    def test_keys_on_a_score(self):
        self.move_into("card", 50, 20)
        self.tool("click", 1)
        self.wait_for_answer("focus", "card")
        self.said.clear()
        self.tool("key", "k")
        self.wait_for_said("card KeyDown 75 0", "card KeyPress 107", "card KeyUp 75 0")

    def test_pointer_that_rests_on_a_score_shows_its_tip(self):
        self.move_into("card", 60, 20)
        self.tool("mousemove_relative", 3, 0)
        self.wait_for_answer("tip", "Health 50%")

    def open_list(self):
        self.move_into("list")
        self.tool("click", 1)
        self.wait_for_answer("popup", "open")

    def test_list_by_mouse(self):
        self.open_list()
        x, y = self.ask("row 2").split()
        self.tool("mousemove", x, int(y) - 2)
        self.tool("mousemove", x, y)
        self.wait_for_answer("current", "Blue")
        self.tool("click", 1)
        self.wait_for_answer("popup", "none")
        self.wait_for_answer("text", "Blue")
        self.assertEqual(self.said, ["list Click"])

    def test_list_by_letters(self):
        self.open_list()
        self.tool("type", "gree")
        self.wait_for_answer("current", "Green")
        self.tool("key", "Return")
        self.wait_for_answer("popup", "none")
        self.wait_for_answer("text", "Green")

    def test_wheel_over_the_closed_list(self):
        before = self.ask("text")
        self.move_into("list")
        for button in (4, 5, 5):
            self.tool("click", button)
        self.move_into("card", 50, 20)
        self.tool("click", 1)  # what comes after the wheel has come
        wait_for("the click", lambda: self.ask("focus") is not None and "card Click" in self.said)
        self.assertEqual(self.ask("text"), before)
        self.assertNotIn("list Click", self.said)

    def test_locked_list_is_a_label(self):
        self.assertEqual(self.ask("shown"), "listItems(0)")
        self.ask("lock on")
        self.wait_for_answer("shown", "labItem")
        self.move_into("list")
        self.tool("click", 1)
        self.move_into("card", 50, 20)
        self.tool("click", 1)
        wait_for("the click", lambda: self.ask("focus") is not None and "card Click" in self.said)
        self.assertEqual(self.ask("popup"), "none")
        self.ask("lock off")
        self.wait_for_answer("shown", "listItems(0)")


def main():
    global PROGRAM
    PROGRAM = os.path.abspath(sys.argv.pop(1))
    missing = [tool for tool in ("Xvfb", "xdotool") if not shutil.which(tool)]
    if missing:
        sys.exit("these are needed and not there: " + ", ".join(missing))
    unittest.main(verbosity=2)


if __name__ == "__main__":
    main()
