#!/usr/bin/python3
"""Drives pallax-window as a screen reader does: drive.py STEP...

  has NAME         waits for something that is seen and has this name
  lacks NAME       waits until nothing has it
  press NAME       presses the button with this name
  open NAME        goes to the row with this name by keys, and presses Enter
  focus NAME       goes to it
  pushed NAME      waits until the row with this name is pushed sideways
  key KEY          presses a key: Escape, Right, m
  type NAME=TEXT   puts the text into the field with this name
  menu NAME        opens the menu and chooses the entry with this name
  entry NAME       chooses the entry in the menu that is open
  windows COUNT    waits until so many windows are open
  tree             prints all names

A * in a NAME stands for any text. Prints what failed and ends with status 1.
"""
import fnmatch
import sys
import time

import gi

gi.require_version("Atspi", "2.0")
from gi.repository import Atspi  # noqa: E402

PATIENCE = 30  # seconds
LEAVES = (Atspi.Role.LABEL, Atspi.Role.IMAGE, Atspi.Role.SCROLL_BAR, Atspi.Role.LEVEL_BAR)
KEYS = {"space": 0x20, "Tab": 0xFF09, "Up": 0xFF52, "Return": 0xFF0D, "Escape": 0xFF1B, "Right": 0xFF53, "Left": 0xFF51, "Down": 0xFF54, "Home": 0xFF50, "End": 0xFF57}


def children(node):
    try:
        return [node.get_child_at_index(index) for index in range(node.get_child_count())]
    except Exception:  # it is gone
        return []


def windows():
    for application in children(Atspi.get_desktop(0)):
        try:
            if application is not None and "pallax" in (application.get_name() or "").lower():
                yield from children(application)
        except Exception:  # it is gone
            continue


def walk(node):
    if node is None:
        return
    yield node
    for child in children(node):
        yield from walk(child)


def role_of(node):
    try:
        return node.get_role()
    except Exception:  # it is gone
        return None


def walk_back(node, is_row=False):
    """The same nodes from the last one, without what is in rows, whose names say it: each takes long to ask."""
    if node is None:
        return
    role = role_of(node)
    if role not in LEAVES and not is_row:
        for child in reversed(children(node)):
            yield from walk_back(child, role == Atspi.Role.LIST_ITEM)
    yield node


def is_shown(node):
    states = node.get_state_set()
    return states.contains(Atspi.StateType.VISIBLE)


def is_drawn(node):
    """Of a dialog's buttons, which it has twice, one above the other and side by side."""
    node.clear_cache()
    return node.get_component_iface().get_size().x > 0


def find(name, role=None):
    """The last one: pages that are covered by others come before them."""
    for window in reversed(list(windows())):
        for node in walk_back(window):
            try:
                own = node.get_name() or ""
                matches = fnmatch.fnmatchcase(own, name.replace("[", "[[]"))
                if matches and (role is None or node.get_role() == role) and is_shown(node):
                    if role == Atspi.Role.PUSH_BUTTON and not is_drawn(node):
                        continue
                    return node
            except Exception:  # it is gone
                continue
    return None


def await_result(look, what):
    end = time.monotonic() + PATIENCE
    while time.monotonic() < end:
        result = look()
        if result:
            return result
        time.sleep(0.05)
    sys.exit(what + "\n" + tree())


def tree():
    lines = []
    for window in windows():
        for node in walk(window):
            lines.append("%s %r" % (node.get_role_name(), node.get_name()))
    return "\n".join(lines)


def press_key(name):
    code = KEYS[name] if name in KEYS else ord(name)
    Atspi.generate_keyboard_event(code, None, Atspi.KeySynthType.SYM)


def has_focus(node):
    node.clear_cache()
    return node.get_state_set().contains(Atspi.StateType.FOCUSED)


def row_of(name):
    """The row with this name, or the one that has something of this name in it."""
    node = find(name)
    while node is not None and node.get_role() != Atspi.Role.LIST_ITEM:
        node = node.get_parent()
    return node


def walk_to(name):
    """Goes to a row of a list by Tab and the arrows, as a user without a mouse does.

    Where the row is is asked again before every key: a list may be sorted meanwhile.
    """
    for _ in range(90):
        item = await_result(lambda: row_of(name), "no row " + name)
        rows = children(item.get_parent())
        at = next((index for index, row in enumerate(rows) if has_focus(row)), None)
        wanted = item.get_index_in_parent()
        if at == wanted:
            return
        press_key("Tab" if at is None else "Down" if at < wanted else "Up")
        time.sleep(0.1)
    sys.exit("cannot go to the row " + name + "\n" + tree())


def is_pushed(row):
    values = [node.get_value_iface() for node in walk(row)]
    return any(value is not None and value.get_current_value() > 0 for value in values)


def field(name):
    for window in windows():
        for node in walk(window):
            if node.get_role() in (Atspi.Role.TEXT, Atspi.Role.ENTRY) and node.get_name() == name:
                if node.get_editable_text_iface() is not None:
                    return node
    return None


def step(verb, argument):
    if verb == "has":
        await_result(lambda: find(argument), "nothing is named " + argument)
    elif verb == "lacks":
        await_result(lambda: find(argument) is None, "still there: " + argument)
    elif verb == "press":
        button = await_result(
            lambda: find(argument, Atspi.Role.PUSH_BUTTON) or find(argument, Atspi.Role.TOGGLE_BUTTON),
            "no button " + argument,
        )
        button.get_action_iface().do_action(0)
    elif verb == "open":
        walk_to(argument)
        press_key("Return")
    elif verb == "menu":
        step("press", "Menu")
        step("entry", argument)
    elif verb == "entry":
        entry = await_result(lambda: find(argument, Atspi.Role.MENU_ITEM), "no entry " + argument)
        entry.get_action_iface().do_action(0)
    elif verb == "windows":
        await_result(lambda: len(list(windows())) == int(argument), "not so many windows: " + argument)
    elif verb == "focus":
        walk_to(argument)
    elif verb == "pushed":
        await_result(lambda: is_pushed(row_of(argument)), "not pushed sideways: " + argument)
    elif verb == "key":
        press_key(argument)
    elif verb == "type":
        name, text = argument.split("=", 1)
        node = await_result(lambda: field(name), "no field " + name)
        node.get_editable_text_iface().set_text_contents(text)
    else:
        sys.exit("unknown step " + verb)


def main(words):
    while words:
        if words[0] == "tree":
            print(tree())
            words = words[1:]
        else:
            step(words[0], words[1])
            words = words[2:]


main(sys.argv[1:])
