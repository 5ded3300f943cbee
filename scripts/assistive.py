"""A record typed in with a screen reader on the line; see assistive.sh. What is there is read from the
bus of the readers alone, and waited for there; keys come from the X server."""

import subprocess
import sys
import time

import pyatspi
from gi.repository import GLib

PATIENCE = 10  # seconds for each thing that has to show


told = None  # what had the focus according to the last event


def hear(event):
    global told
    if event.detail1:
        told = event.source


def application():
    for found in pyatspi.Registry.getDesktop(0):
        if found is not None and found.name == "songcase":
            found.setCacheMask(pyatspi.cache.NONE)
            return found
    return None


def nodes(node):
    """All that show below a node, and itself. Nodes go while they are read."""
    try:
        if node.getRole() != pyatspi.ROLE_APPLICATION and not has(node, pyatspi.STATE_SHOWING):
            return
        yield node
        for child in range(node.childCount):
            yield from nodes(node[child])
    except (LookupError, RuntimeError, AttributeError):
        return


def has(node, state):
    return node.getState().contains(state)


def find(role, name, *states):
    for node in nodes(application()):
        if node.getRole() == role and node.name == name and all(has(node, s) for s in states):
            return node
    return None


def text(node):
    return node.queryText().getText(0, -1)


def wait(what, condition):
    end = time.monotonic() + PATIENCE
    while True:
        while GLib.MainContext.default().iteration(False):
            pass
        try:
            found = condition()
            if found:
                return found
        except (LookupError, RuntimeError, AttributeError, NotImplementedError):
            pass  # gone while it was looked at
        if time.monotonic() > end:
            raise TimeoutError(what)
        time.sleep(0.02)


def press(*keys):
    subprocess.run(["xdotool", "key", "--clearmodifiers", *keys], check=True)


def type_text(letters):
    subprocess.run(["xdotool", "type", "--clearmodifiers", "--delay", "15", letters], check=True)


def control(role, name):
    return wait(f'a {role} named "{name}"', lambda: find(role, name))


def focused(role, name):
    return wait(f'the focus on the {role} "{name}"', lambda: find(role, name, pyatspi.STATE_FOCUSED))


def tracks():
    return find(pyatspi.ROLE_TABLE, "Tracks of the disc")


def cell(row, column):
    return tracks().queryTable().getAccessibleAt(row, column).name


def at(row, column):
    """The keys are the grid's, and it has gone to this cell."""

    def is_current():
        here = tracks().queryTable().getAccessibleAt(row, column)
        return has(here, pyatspi.STATE_FOCUSED) and has(tracks(), pyatspi.STATE_FOCUSED)

    wait(f"the grid on row {row}, column {column}", is_current)


def head(column):
    return ["Track", "Artist", "Title", "Genre", "Hityear"][column]


def type_into(column, letters, shown=None):
    type_text(letters)
    holds(column, shown or letters)


def holds(column, letters):
    """The field of the cell that is being edited, which is no node of the table, holds this text."""
    name = head(column)
    wait(
        f'"{letters}" in the field "{name}" of the grid',
        lambda: told.name == name and told.getRole() == pyatspi.ROLE_TEXT and text(told) == letters,
    )


def to_the_grid():
    focused(pyatspi.ROLE_TEXT, "Title:")
    press("Tab")
    focused(pyatspi.ROLE_COMBO_BOX, "Genre:")
    press("Tab")
    focused(pyatspi.ROLE_TEXT, "Hityear:")
    type_text("1985")  # an empty year is not left
    press("Tab")


def suggestions():
    return find(pyatspi.ROLE_LIST, "Suggestions")


def chosen():
    """The number of the suggestion that is marked, -1 if none is."""
    entries = suggestions()
    marked = [i for i in range(entries.childCount) if has(entries[i], pyatspi.STATE_SELECTED)]
    return marked[0] if marked else -1


def saved(count):
    wait(
        f"{count} compilation in the browser",
        lambda: find(pyatspi.ROLE_STATUS_BAR, f"Number of compilations in your collection: {count}"),
    )


def main():
    pyatspi.Registry.registerEventListener(hear, "object:state-changed:focused")
    wait("the program on the bus", application)
    control(pyatspi.ROLE_TABLE, "Compilations")
    press("F2")
    for name in ("Title:", "Hityear:"):
        control(pyatspi.ROLE_TEXT, name)
    control(pyatspi.ROLE_COMBO_BOX, "Genre:")
    control(pyatspi.ROLE_TABLE, "Tracks of the disc")
    control(pyatspi.ROLE_PUSH_BUTTON, "Insert track")

    title = focused(pyatspi.ROLE_TEXT, "Title:")
    type_text("Zebra")
    wait('"Zebra" in the title', lambda: text(title) == "Zebra")
    to_the_grid()

    for row, artist in enumerate(("Ann", "Anton")):
        at(row, 1)
        type_into(1, artist)
        press("Tab")
        at(row, 2)
        type_into(2, "Song")
        press("Return")
        at(row + 1, 2)
        press("shift+Tab")
    at(2, 1)
    press("ctrl+s")
    saved(1)

    type_into(1, "An")
    wait("two suggestions", lambda: suggestions().childCount == 2)
    for step, entry in (("Down", 0), ("Down", 1), ("Up", 0), ("Down", 1)):
        press(step)
        wait(f"suggestion {entry} after {step}", lambda: chosen() == entry)
    press("Tab")
    at(2, 2)
    wait('"Anton" in the third row', lambda: cell(2, 1) == "Anton")

    type_into(2, "wo")
    press("Home")
    type_into(2, "T", "Two")
    press("End")
    type_into(2, "!", "Two!")
    press("Return")
    at(3, 2)
    wait('"Two!" in the third row', lambda: cell(2, 2) == "Two!")
    press("ctrl+s")


def show_tree():
    def depth(node):
        return 0 if node.getRole() == pyatspi.ROLE_APPLICATION else 1 + depth(node.parent)

    for node in nodes(application()):
        mark = "  <- focus" if has(node, pyatspi.STATE_FOCUSED) else ""
        print(f"{'  ' * depth(node)}{node.getRoleName()} {node.name!r}{mark}")


try:
    main()
except TimeoutError as error:
    print(f"FAILED: {error} did not come. This is on the bus:")
    show_tree()
    sys.exit(1)
