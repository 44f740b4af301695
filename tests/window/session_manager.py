#!/usr/bin/python3
"""A session manager that writes what keeps the machine awake: session_manager.py FILE"""
import sys

from gi.repository import Gio, GLib

XML = """<node><interface name="org.gnome.SessionManager">
<method name="Inhibit"><arg type="s" direction="in"/><arg type="u" direction="in"/>
<arg type="s" direction="in"/><arg type="u" direction="in"/><arg type="u" direction="out"/></method>
<method name="Uninhibit"><arg type="u" direction="in"/></method>
</interface></node>"""
COOKIE = 7
LOGOUT, SWITCH, SUSPEND, IDLE = 1, 2, 4, 8

log = open(sys.argv[1], "a", buffering=1)


def called(_bus, _sender, _path, _interface, method, arguments, invocation):
    if method == "Inhibit":
        application, _window, reason, flags = arguments.unpack()
        kept = [name for name, bit in (("suspend", SUSPEND), ("idle", IDLE)) if flags & bit]
        if flags & (LOGOUT | SWITCH):
            kept.append("more")
        log.write("inhibit %s %s: %s\n" % (application, "+".join(kept), reason))
        invocation.return_value(GLib.Variant("(u)", (COOKIE,)))
    else:
        log.write("uninhibit %d\n" % arguments.unpack())
        invocation.return_value(None)


bus = Gio.bus_get_sync(Gio.BusType.SESSION)
interface = Gio.DBusNodeInfo.new_for_xml(XML).interfaces[0]
bus.register_object("/org/gnome/SessionManager", interface, called, None, None)
Gio.bus_own_name_on_connection(
    bus, "org.gnome.SessionManager", Gio.BusNameOwnerFlags.NONE, lambda *_: print("ready", flush=True), None)
GLib.MainLoop().run()
