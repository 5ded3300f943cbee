"""What assistive.sh does once there are a display and a bus: assistive.py PROGRAM."""
import signal
import subprocess
import sys
import time

import gi

gi.require_version("Atspi", "2.0")
from gi.repository import Atspi, GLib  # noqa: E402

LONGEST = 20  # seconds that anything may take


def wait(what, found):
    """What `found` gives as soon as it gives anything; ends the script if it never does."""
    end = time.monotonic() + LONGEST
    while time.monotonic() < end:
        try:
            answer = found()
        except GLib.Error:  # it went while it was looked at
            answer = None
        if answer:
            return answer
        time.sleep(0.05)
    sys.exit(f"FAILED: {what}")


def everything(top, depth=12):
    """All that is shown below an object of the bus. Rows are not: a reader asks for those it wants."""
    if top is None or depth == 0:
        return
    yield top
    if top.get_role() in (Atspi.Role.TABLE, Atspi.Role.TREE, Atspi.Role.LIST):
        return
    for i in range(top.get_child_count()):
        yield from everything(top.get_child_at_index(i), depth - 1)


def shows(thing):
    return thing.get_state_set().contains(Atspi.StateType.SHOWING)


def application():
    desktop = Atspi.get_desktop(0)
    apps = [desktop.get_child_at_index(i) for i in range(desktop.get_child_count())]
    return next((app for app in apps if app and app.get_name() == "songcase"), None)


def named(role, name):
    def look():
        return next((one for one in everything(application())
                     if one.get_role() == role and one.get_name() == name and shows(one)), None)
    return wait(f"no {role.value_nick} named {name!r}", look)


def focused():
    for one in everything(application()):
        states = one.get_state_set()
        if states.contains(Atspi.StateType.FOCUSED) and one.get_role() == Atspi.Role.TEXT:
            return one
    return None


def press(*keys):
    subprocess.run(["xdotool", "key", "--clearmodifiers", *keys], check=True)


def type_text(text):
    subprocess.run(["xdotool", "type", "--delay", "20", text], check=True)


def expect_field(what, text, caret):
    """The focus is in a field with this text, the cursor at this place in it."""
    def fits():
        field = focused()
        if field is None:
            return False
        count = Atspi.Text.get_character_count(field)
        return Atspi.Text.get_text(field, 0, count) == text and Atspi.Text.get_caret_offset(field) == caret
    wait(f"{what}: a field with {text!r}, the cursor at {caret}", fits)


def expect_cell(what, text):
    """The first track's artist; a field in a cell is no part of the tree, so it is left before."""
    def fits():
        table = named(Atspi.Role.TABLE, "Tracks of the disc")
        return Atspi.Table.get_accessible_at(table, 0, 1).get_name() == text
    wait(f"{what}: {text!r} in the cell", fits)


def main():
    program = subprocess.Popen([sys.argv[1]])
    try:
        wait("the program is not on the bus", application)
        named(Atspi.Role.TOOL_BAR, "Toolbar")
        named(Atspi.Role.MENU_ITEM, "File")
        named(Atspi.Role.TABLE, "Compilations")
        named(Atspi.Role.PUSH_BUTTON, "Delete CD")
        window = wait("no window", lambda: subprocess.run(
            ["xdotool", "search", "--onlyvisible", "--pid", str(program.pid), "--name", "Songcase"],
            capture_output=True, text=True, check=False).stdout.split())[0]
        subprocess.run(["xdotool", "windowfocus", window], check=True)
        press("F2")
        named(Atspi.Role.TABLE, "Tracks of the disc")
        wait("no field has the focus", focused)
        type_text("title")
        press("Home")
        expect_field("Home in a field", "title", 0)
        press("Tab", "Tab")
        type_text("1985")  # an empty year is no year, and Tab stays there
        press("Tab")
        type_text("ab")
        press("Home")
        type_text("x")
        press("End")
        type_text("y")
        press("Tab")
        expect_cell("End in a cell", "xaby")
        press("shift+Tab")
        type_text("ann")
        named(Atspi.Role.LIST, "Suggestions")
        press("Down", "Down", "Return")
        press("Tab")
        expect_cell("Down and Enter in the suggestions", "Annabel")
    finally:
        program.send_signal(signal.SIGTERM)
    sys.exit(program.wait(LONGEST))


if __name__ == "__main__":
    main()
