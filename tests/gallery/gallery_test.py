"""Uses the gallery as people do, with keys alone and with the pointer, and compares what the controls say.

    gallery_test.py GALLERY SCALE [unittest's own arguments]
"""

import ctypes
import os
import sys
import tempfile
import unittest

from screen import Gallery, Screen, missing

SKIPPED = 77

# Where the tab key stops, in its order: of radio buttons and tools only the one that is on.
STOPS = ["gallery/" + name for name in (
    "tool/region push check tristate radio/medium icon flat round toggle alert/note alert/question alert/warning "
    "alert/error start name password notes size/Field strength/Field angle angleNumber level levelNumber context "
    "noise paper zoom actions flyout page first disclose cells files cancel ok").split()]

NOTES = r"Several lines, scrolled\nas far as needed,\nby wheel, bar and caret.\n\nThe end."

# With the focus on a control: keys, and what they lead to. Every part ends as it began, or goes on with the next one.
# Keys within a tuple open or close a window.
BY_KEYS = [
    ("tool/region", ["Right"], ["value tools click gallery/tool/direction"]),
    ("tool/direction", ["Up"], ["value tools click gallery/tool/region"]),
    ("push", ["space"], ["value push click 1", "command push"]),
    ("push", ["Return"], ["value push click 1", "command push"]),
    ("check", ["alt+p"], ["value push click 1", "command push"]),
    ("check", ["space", "space"], ["value check click 0", "value check click 1"]),
    ("tristate", ["space", "space", "alt+s"], [f"value tristate click {n}" for n in (0, 1, 2)]),
    ("radio/medium", ["Right"], ["value radio/high click 1"]),
    ("radio/high", ["Right"], ["value radio/low click 1"]),
    ("icon", ["space"], ["value icon click 1", "command icon"]),
    ("flat", ["space"], ["value flat click 1", "command flat"]),
    ("round", ["space"], ["value round click 1", "command round"]),
    ("toggle", ["space", "space"], ["value toggle click 1", "value toggle click 0"]),
    ("alert/note", [("space",), ("Return",)], ["value alert/note click 1", "command alert/note",
                                               "answer Sarnik/Alert/Ok"]),
    ("alert/question", [("space",), ("alt+d",)], ["value alert/question click 1", "command alert/question",
                                                  "answer Sarnik/Alert/Other"]),
    ("alert/question", [("space",), "Tab", "Left", ("Escape",)],
     ["value alert/question click 1", "command alert/question", "answer Sarnik/Alert/Cancel"]),
    ("alert/warning", [("space",), "Tab", ("space",)],
     ["value alert/warning click 1", "command alert/warning", "answer Sarnik/Alert/NAME"]),
    ("alert/error", [("space",), ("Escape",)], ["value alert/error click 1", "command alert/error",
                                                "answer Sarnik/Alert/Ok"]),
    ("start", ["space"], ["value start click 1", "command start"]),
    ("name", ["A", "ctrl+a", "ctrl+c", "End", "ctrl+v", "ctrl+z", "Return"],
     ['value name editBegin "The quick brown fox"', 'value name edit "A"', 'value name edit "AA"',
      'value name edit "A"', 'value name editEnd "A"']),
    ("name", ["b", "Escape"], ['value name editBegin "A"', 'value name edit "b"', 'value name editEnd "A"']),
    ("password", ["ctrl+c", "End", "ctrl+v", "x", "Escape"],
     ['value password editBegin "secret"', 'value password edit "secretA"', 'value password edit "secretAx"',
      'value password editEnd "secret"']),
    ("notes", ["ctrl+a", "x", "Return", "y", "Escape"],
     [f'value notes editBegin "{NOTES}"', 'value notes edit "x"', 'value notes edit "x\\n"',
      'value notes edit "x\\ny"', f'value notes editEnd "{NOTES}"']),
    ("size/Field", ["Up"], ["value size editBegin 40", "value size edit 41", "value size editEnd 41"]),
    ("size/Field", ["Prior"], ["value size editBegin 41", "value size edit 51", "value size editEnd 51"]),
    ("size/Field", ["ctrl+a", "7", "Return"], ["value size editBegin 51", "value size edit 7", "value size editEnd 7"]),
    ("strength/Field", ["ctrl+a", "3", "period", "2", "Return"],
     ["value strength editBegin 30.5", "value strength edit 3", "value strength edit 3", "value strength edit 3.2",
      "value strength editEnd 3.2"]),
    ("angle", ["Right"], ["value angle editBegin 45", "value angle edit 46", "value angle editEnd 46"]),
    ("angle", ["ctrl+z", "ctrl+shift+z"], ["command sarnik/command/undo", "command sarnik/command/redo"]),
    ("angleNumber", ["ctrl+a", "3", "7", "0", "Return"],
     ["value angleNumber editBegin 46", "value angleNumber edit 3", "value angleNumber edit 37",
      "value angleNumber editEnd 10"]),
    ("level", ["End"], ["value level editBegin 4", "value level edit 10", "value level editEnd 10"]),
    ("level", ["Home"], ["value level editBegin 10", "value level edit 0", "value level editEnd 0"]),
    ("levelNumber", ["Up"], ["value levelNumber editBegin 0", "value levelNumber edit #",
                             "value levelNumber editEnd #"]),
    ("context", [("Menu",), "Down", ("Return",)], ["menu menu/context gallery/command/colour/Base+1",
                                                   "value context click 1"]),
    ("noise", ["Down", "h"], ["value noise click 1", "value noise click 3"]),
    ("noise", [("F4",), "Up", ("Return",)], ["value noise click 2"]),
    ("noise", [("space",), "Up", ("Escape",)], []),
    ("paper", ["ctrl+a", "B", "5", "Return"], ['value paper editBegin "A4"', 'value paper edit "B"',
                                               'value paper edit "B5"', 'value paper editEnd "B5"']),
    ("paper", [("alt+Down",), "End", ("Return",)], ["value paper click 3"]),
    ("zoom", ["ctrl+a", "1", "5", "0", "Return"], ["value zoom editEnd 1.5"]),
    ("zoom", [("F4",), "Down", ("Return",)], ["menu menu/zoom gallery/command/zoom/Base+1",
                                              "command command/zoom/Base+1"]),
    ("actions", [("space",), "Down", ("Return",), ("Return",)],
     ["menu menu/action gallery/command/about", "command command/about", "answer Sarnik/Alert/Ok"]),
    ("actions", [("alt+a",), ("Escape",)], []),
    ("flyout", [("space",), "u", ("Return",)], ["menu menu/action sarnik/command/undo", "command sarnik/command/undo"]),
    ("first", ["space"], ["value first click 1"]),
    ("page", ["Down"], ["value page click 1"]),
    ("second", ["4", "2", "Return"], ["value second editBegin 7", "value second edit 4", "value second edit 42",
                                      "value second editEnd 42"]),
    ("disclose", ["space", "space"], ["value disclose click 0", "value disclose click 1"]),
    ("cells", ["Right", "shift+Right", "ctrl+a", "Home"],
     ["value cells click #", "value cells click #", "value cells click #", "value cells click 0"]),
    ("files", ["Down", "shift+Down", "End"], ["value files click #", "value files click #", "value files click 2"]),
    # The menu bar, and what opens without a focus of its own.
    ("files", [("F10",), ("Right",), ("Right",), "Down", "Down", ("Return",)],
     ["menu menu/view gallery/command/zoom/Base+2", "command command/zoom/Base+2"]),
    ("files", [("alt+v",), "4", ("Return",)], ["menu menu/view gallery/command/zoom/Base+4", "command command/zoom/Base+4"]),
    ("files", [("ctrl+o",), ("Escape",)], ["command command/open", "file -"]),
    ("files", [("alt+f",), "Down", ("Return",), "ctrl+a", "n", "e", "w", ("Return",)],
     ["menu menu/file gallery/command/save", "command command/save", "file HOME/new.png"]),
]


def full(line, home):
    """A line of the tables as the log has it."""
    what, _, rest = line.partition(" ")
    if what in ("value", "menu", "command") and not rest.startswith("sarnik/"):
        rest = "gallery/" + rest
    return f"{what} {rest}".replace("HOME", home).replace("NAME", "Cancel")


class OnScreen(unittest.TestCase):
    binary, scale = "", 1

    def setUp(self):
        self.screen = Screen(900 * self.scale, 700 * self.scale)
        self.gallery = None

    def tearDown(self):
        self.screen.end()
        if self.gallery is not None:
            self.gallery.end()

    def start(self, **environment):
        self.gallery = Gallery(self.binary, self.screen, self.scale, **environment)
        self.gallery.show()
        return self.gallery

    def test_tab_stops_at_every_control_once_and_shift_tab_goes_back(self):
        g = self.start()
        for key, stops in (("Tab", STOPS[1:] + STOPS[:1]), ("shift+Tab", STOPS[:0:-1] + STOPS[:1])):
            for stop in stops:
                before = g.focus
                g.keys(key)
                g.until(lambda: g.focus != before, f"{key} has not left {before}")
                self.assertEqual(g.focus, stop)

    def test_every_control_works_by_keys_alone(self):
        g = self.start()
        for control, keys, told in BY_KEYS:
            g.go("gallery/" + control)
            for key in keys:
                if isinstance(key, tuple):
                    g.switch(*key)
                else:
                    g.keys(key)
            try:
                g.expect(*(full(line, g.folder.name) for line in told))
            except AssertionError as e:
                raise AssertionError(f"{control}, {keys}: {e}") from None
            if control == "start":
                self.assertEqual({g.told(), g.told()}, {"timer ended", "primes 33860"})
            g.show()
        g.go("gallery/cells")
        g.keys("Escape")
        g.expect("value gallery/cancel click 1", "command gallery/cancel", "ended gallery/cancel")
        self.assertEqual((g.status(), g.said()), (0, ""))

    def test_every_control_works_by_the_pointer(self):
        g = self.start()
        row = lambda n: [20, 2 + 22 * n + 11]  # of a menu that has opened below

        def tells(*lines):
            g.expect(*(full(line, g.folder.name) for line in lines))

        def clicks(name, value, command=False, **where):
            g.click("gallery/" + name, **where)
            tells(f"value {name} click {value}", *([f"command {name}"] if command else []))

        def pulls(name, control, start, end, least, most):
            g.pull("gallery/" + name, start, end)
            tells(f"value {control} dragBegin #")
            last = g.told()
            self.assertRegex(last, f"^value gallery/{control} dragEnd ")
            self.assertEqual(last.split()[-1], g.drags[-1])
            self.assertTrue(least <= float(g.drags[-1]) <= most and len(g.drags) > 1, (name, g.drags))

        g.screen.do("mousemove", *g.point("gallery/push"))
        g.until(lambda: g.help.startswith("A push button"), "no help")
        clicks("push", 1, command=True)
        g.click("gallery/never")
        g.pull("gallery/push", (0.5, 0.5), (2, 0.5))  # let go outside of it
        g.click("gallery/tool/zoom")
        tells("value tools click gallery/tool/zoom")
        clicks("check", 0, x=0.1)
        g.click("gallery/name")  # is disabled
        clicks("check", 1, x=0.9)
        clicks("tristate", 0)
        clicks("radio/low", 1)
        for name in ("icon", "flat", "round", "start"):
            clicks(name, 1, command=True)
        self.assertEqual({g.told(), g.told()}, {"timer ended", "primes 33860"})
        clicks("toggle", 1)
        for name in ("note", "question", "warning", "error"):
            clicks("alert/" + name, 1, command=True)
            g.until(lambda: "Sarnik/Alert/Ok" in g.at and g.focus, "no alert")
            g.click("Sarnik/Alert/Ok")
            tells("answer Sarnik/Alert/Ok")
            g.show()

        g.click("gallery/name", x=0.1, times=2)  # a word
        g.type("A ")
        tells('value name editBegin "The quick brown fox"', 'value name edit "A quick brown fox"',
              'value name edit "A  quick brown fox"')
        g.pull("gallery/name", (0.99, 0.5), (0, 0.5))
        g.keys("x")
        tells('value name edit "x"')
        g.pull("gallery/notes", (0.97, 0.4), (0.97, 1.2))  # its scroll bar
        tells('value name editEnd "x"')
        g.click("gallery/notes", x=0.8, y=0.9)
        g.type("!")
        tells(f'value notes editBegin "{NOTES}"', f'value notes edit "{NOTES}!"')
        g.click("gallery/password")
        tells(f'value notes editEnd "{NOTES}!"')
        pulls("size/Slider", "size", (0.3, 0.5), (1, 0.5), 499, 499)
        pulls("strength/Slider", "strength", (0.3, 0.5), (0, 0.5), 0, 0)
        pulls("angle", "angle", (0.9, 0.5), (0.5, 0), 80, 100)
        pulls("level", "level", (0.3, 0.6), (0.3, 0), 10, 10)
        g.click("gallery/strength/Slider", button=4, times=3)
        tells("value strength editBegin 0")
        while (line := g.told()).startswith("value gallery/strength edit "):
            pass
        self.assertEqual(line, "value gallery/strength editEnd 3")
        g.pull("gallery/level", (0.3, 0), (0.3, 0.5), held=True)
        g.keys("Escape")
        g.screen.do("mouseup", 1)
        tells("value level dragBegin 10", "value level dragEnd 10")

        x, y = g.point("gallery/context")
        g.click("gallery/context", button=3)
        g.screen.do("mousemove", x + 20 * g.scale, y + (4 + 22 + 11) * g.scale, "click", 1)
        tells("menu menu/context gallery/command/colour/Base+1", "value context click 1")
        g.pull("gallery/noise", (0.5, 0.5), row(3))
        tells("value noise click 3")
        g.pull("gallery/paper", (0.95, 0.5), row(0))
        tells("value paper click 0")
        g.pull("gallery/zoom", (0.5, 0.5), row(4))
        tells("menu menu/zoom gallery/command/zoom/Base+4", "command command/zoom/Base+4")
        g.pull("gallery/actions", (0.5, 0.5), [20, -60])  # let go beside the menu
        g.pull("gallery/page", (0.5, 0.5), row(1))
        tells("value page click 1")
        g.until(lambda: "gallery/second" in g.at, "no second page")
        clicks("disclose", 0)
        g.until(lambda: "gallery/cells" not in g.at, "still disclosed")
        clicks("disclose", 1)
        g.until(lambda: "gallery/cells" in g.at, "not disclosed")
        g.pull("gallery/cells", (0.1, 0.5), (0.4, 0.5))
        tells("value cells click 0", "value cells click 1")
        g.pull("gallery/cellScroller/XBar", (0.1, 0.5), (1, 0.5))
        g.until(lambda: int(g.scrolled.split(",")[0] or 0) > 200, "not scrolled")
        clicks("files", 1, y=0.4)
        g.pull("gallery/menuBar", (0.02, 0.5), row(0))
        tells("menu menu/file gallery/command/open", "command command/open")
        g.until(lambda: "gallery/ok" not in g.at and g.focus, "no file dialog")
        g.keys("Escape")
        tells("file -")
        g.show()
        clicks("ok", 1, command=True)
        tells("ended gallery/ok")
        self.assertEqual((g.status(), g.said()), (0, ""))

    def test_closing_takes_back_a_drag_under_way(self):
        g = self.start()
        window = g.screen.keyboard()
        g.pull("gallery/size/Slider", (0.3, 0.5), (0.6, 0.5), held=True)
        g.expect("value gallery/size dragBegin 40")
        close_window(self.screen.name, window)
        g.expect("value gallery/size dragEnd 40", "ended")
        self.assertEqual((g.status(), g.said()), (0, ""))

    def test_the_end_of_the_screen_is_told_and_ends_the_program(self):
        def menu(g):
            g.switch("alt+f")

        def alert(g):
            g.switch("F1")

        def drag(g):
            g.pull("gallery/size/Slider", (0.3, 0.5), (0.6, 0.5), held=True)

        for doing in (lambda g: None, menu, alert, drag, lambda g: g.click("gallery/start")):
            g = self.start()
            doing(g)
            self.screen.end()
            self.assertEqual(g.status(), 1)
            self.assertEqual(g.said(), "stillmark_gallery: The connection to the display was lost.\n")
            g.end()
            self.setUp()

    def test_runs_without_fonts(self):
        with tempfile.TemporaryDirectory() as empty:
            with open(os.path.join(empty, "fonts.conf"), "w", encoding="utf-8") as config:
                config.write("<fontconfig/>")
            for setup in ({"FONTCONFIG_FILE": config.name}, {"FONTCONFIG_PATH": os.path.join(empty, "none")},
                          {"FONTCONFIG_FILE": os.path.join(empty, "none.conf")}):
                g = self.start(**setup)
                g.go("gallery/name")
                g.keys("x")
                g.expect('value gallery/name editBegin "The quick brown fox"', 'value gallery/name edit "x"')
                g.keys("ctrl+q")
                self.assertEqual(g.status(), 0, (setup, g.said()))
                g.end()


class ClientMessage(ctypes.Structure):
    _fields_ = [("type", ctypes.c_int), ("serial", ctypes.c_ulong), ("sent", ctypes.c_int),
                ("display", ctypes.c_void_p), ("window", ctypes.c_ulong), ("message", ctypes.c_ulong),
                ("format", ctypes.c_int), ("data", ctypes.c_long * 5), ("rest", ctypes.c_long * 16)]


def close_window(screen, window):
    """As the close button of a window manager does it."""
    x = ctypes.CDLL("libX11.so.6")
    x.XOpenDisplay.restype = ctypes.c_void_p
    display = ctypes.c_void_p(x.XOpenDisplay(screen.encode()))
    atom = lambda name: x.XInternAtom(display, name, 0)
    data = (ctypes.c_long * 5)(atom(b"WM_DELETE_WINDOW"), 0, 0, 0, 0)
    message = ClientMessage(33, 0, 1, display, window, atom(b"WM_PROTOCOLS"), 32, data)
    x.XSendEvent(display, ctypes.c_ulong(window), 0, ctypes.c_long(0), ctypes.byref(message))
    x.XCloseDisplay(display)


def main():
    lacking = missing()
    if lacking:
        print("skipped: there is no " + " and no ".join(lacking) + " here")
        return SKIPPED
    OnScreen.binary, OnScreen.scale = os.path.abspath(sys.argv[1]), int(sys.argv[2])
    return 0 if unittest.main(argv=sys.argv[:1] + sys.argv[3:], exit=False, verbosity=2).result.wasSuccessful() else 1


if __name__ == "__main__":
    sys.exit(main())
