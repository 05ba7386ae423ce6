#!/usr/bin/python3
"""Starts the game (the command given) once Orca is up and plays one deal by keys, as a blind player would, for
scripts/orca-deal.sh: Enter deals, 1 and 2 choose, Enter sends, each card of
the hand is laid by the key its description names, Enter presses Ok, and
Enter goes through the show. It reads the game over AT-SPI (after Orca has come up) only to know what
a player who listens would know: which button is shown, which cards are held.
"""
import subprocess
import sys
import time

import pyatspi

from atspi_check import children, fail, focused_table, key, named, pump, wait_for


def shown_buttons(table):
    return [c.name for c in children(table)
            if c.getRole() == pyatspi.ROLE_PUSH_BUTTON and c.getState().contains(pyatspi.STATE_SHOWING)]


def held(table):
    """The keys of the cards in hand; in the show the hand is turned up, keyless."""
    return [card.description.split()[-1] for card in children(named(table, "Your hand")) if card.description]


def press(*names):
    key(*names)
    time.sleep(1.5)  # time for the screen reader to speak
    pump()


def main():
    desktop = pyatspi.Registry.getDesktop(0)
    wait_for("Orca on the accessibility bus",
             lambda: any(a is not None and a.name.lower() == "orca" for a in desktop), timeout=30)
    game = subprocess.Popen(sys.argv[1:])
    try:
        play(desktop)
    finally:
        game.terminate()
        game.wait(timeout=10)


def play(desktop):
    table = focused_table(desktop)
    time.sleep(2)

    for keys in (["Return"], ["1"], ["2"], ["Return"]):
        press(*keys)
    end = time.monotonic() + 90
    while not any(b.startswith("Score") for b in shown_buttons(table)):
        if time.monotonic() > end:
            fail("the play did not end")
        if "Ok" in shown_buttons(table):
            press("Return")
            continue
        # The first card that fits under 31 leaves the hand.
        keys = held(table)
        for digit in keys:
            press(digit)
            if len(held(table)) < len(keys):
                break
        else:
            time.sleep(0.5)
    while "Deal" not in shown_buttons(table):
        if time.monotonic() > end:
            fail("the show did not end")
        press("Return")
    time.sleep(2)


if __name__ == "__main__":
    main()
