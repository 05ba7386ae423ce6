#!/usr/bin/python3
"""The game as a screen reader meets it over AT-SPI, run by scripts/atspi-check.sh.

The game must be running on the xcb platform with its accessibility on: it
registers, its six cards and the count are readable, and a key that chooses a
card arrives as a state change of that card.
"""
import re
import subprocess
import sys
import time

import pyatspi
from gi.repository import GLib

CARD = re.compile(r"^(Ace|Two|Three|Four|Five|Six|Seven|Eight|Nine|Ten|Jack|Queen|King) of (Spades|Diamonds|Hearts|Clubs)$")
events = []


def fail(message):
    print(f"AT-SPI check: FAILED: {message}", file=sys.stderr)
    sys.exit(1)


def pump():
    context = GLib.MainContext.default()
    while context.pending():
        context.iteration(False)


def wait_for(what, test, timeout=10.0):
    """The first true answer of test, asked until timeout; fails with what."""
    end = time.monotonic() + timeout
    while time.monotonic() < end:
        pump()
        try:
            answer = test()
        except Exception:  # an object can go stale while the game changes it
            answer = None
        if answer:
            return answer
        time.sleep(0.05)
    fail(f"no {what} within {timeout:.0f} s")


def named(root, name):
    return pyatspi.findDescendant(root, lambda node: node is not None and node.name == name)


def children(node):
    return [node.getChildAtIndex(i) for i in range(node.childCount)]


def key(*names):
    subprocess.run(["xdotool", "key", "--delay", "60", *names], check=True)


def focused_table(desktop):
    """The game's card table once it has registered and holds the focus."""
    app = wait_for("application named Vennick on the accessibility bus",
                   lambda: next((a for a in desktop if a is not None and a.name == "Vennick"), None))
    table = wait_for("card table in the game's tree", lambda: named(app, "Card table"))
    # Without a window manager the window gets the X focus from xdotool; keys
    # go to it once the screen reader's view says the table has the focus.
    window = subprocess.run(["xdotool", "search", "--sync", "--onlyvisible", "--name", "^Vennick$"],
                            check=True, capture_output=True, text=True, timeout=10).stdout.split()[0]
    subprocess.run(["xdotool", "windowfocus", "--sync", window], check=True, timeout=10)
    wait_for("focus on the card table", lambda: table.getState().contains(pyatspi.STATE_FOCUSED))
    return table


def main():
    table = focused_table(pyatspi.Registry.getDesktop(0))
    key("Return")
    hand = named(table, "Your hand")
    cards = wait_for("six cards in your hand after Enter", lambda: len(children(hand)) == 6 and children(hand))
    names = [card.name for card in cards]
    if not all(CARD.match(name) for name in names):
        fail(f"cards not named as cards: {names}")

    pyatspi.Registry.registerEventListener(events.append, "object:state-changed:checked")
    key("1")
    wait_for("checked state change of the first card after the key 1",
             lambda: any(e.source_name == names[0] and e.detail1 == 1 for e in events))
    if not cards[0].getState().contains(pyatspi.STATE_CHECKED):
        fail(f"{names[0]} is not checked after the key 1")

    key("2", "Return")
    count = wait_for("count on the table after Send To Crib",
                     lambda: next((c for c in children(table) if re.match(r"^Count: \d+$", c.name)), None))
    print(f"AT-SPI check: passed: {', '.join(names)}; {names[0]} checked by key; {count.name}")


if __name__ == "__main__":
    main()
