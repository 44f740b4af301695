#!/usr/bin/python3
"""A service under ModemManager's name that tells what no ModemManager should, on a private bus.

Runs a command there and gives its exit status. Lines written into $WORLD/control make it attack:

  types     properties, SIM, bearers and cells of wrong types
  missing   a modem without any property
  huge      texts of 1 MiB, with control characters
  flood N   N signals of changed levels, as fast as the bus takes them
  level DBM the RSRP of the first modem
  crowd N   N modems appear
  gone      they disappear
  sane      the first modem as it was at the start
"""
import os
import subprocess
import sys
import tempfile

import dbus
import dbus.mainloop.glib
import dbus.service
from gi.repository import GLib

MM = "org.freedesktop.ModemManager1"
ROOT = "/org/freedesktop/ModemManager1"
FIRST = f"{ROOT}/Modem/0"
MODEM, SIGNAL = f"{MM}.Modem", f"{MM}.Modem.Signal"
HUGE = "\x1b[2J\n" + "x" * (1 << 20)


def dictionary(**entries):
    return dbus.Dictionary(entries, signature="sv")


def sane(model="Sane 1"):
    return {
        MODEM: dictionary(
            Model=model, Device=f"/sys/devices/{model}", State=dbus.Int32(8), AccessTechnologies=dbus.UInt32(0x4000),
            SignalQuality=dbus.Struct((dbus.UInt32(61), True), signature="ub")),
        SIGNAL: dictionary(Rate=dbus.UInt32(2), Lte=dictionary(rsrp=dbus.Double(-95)))}


def wrong(interfaces):
    """Each property of another type than it should be, and paths that lead nowhere."""
    types = [dbus.Array([1, 2], signature="u"), dbus.Double("nan"), "text", dbus.Boolean(True), dbus.Byte(7),
             dictionary(deep=dictionary(deeper=dbus.Array([dictionary()], signature="a{sv}"))),
             dbus.UInt64(2**64 - 1), dbus.Int64(-2**63)]
    names = ["Model", "State", "Sim", "Bearers", "SignalQuality", "AccessTechnologies", "Manufacturer", "PowerState",
             "UnlockRequired", "OwnNumbers", "CurrentBands", "Rate", "Lte", "Nr5g", "Location", "Enabled",
             "SignalsLocation", "RegistrationState", "OperatorName", "InitialEpsBearer"]
    interfaces = list(interfaces) + [f"{MODEM}.Modem3gpp", f"{MODEM}.ModemCdma", f"{MODEM}.Location", "not known"]
    return [(interface, {name: types[(number + turn) % len(types)] for number, name in enumerate(names)})
            for turn in range(len(types)) for interface in interfaces]


class Manager(dbus.service.Object):
    def __init__(self, name):
        super().__init__(name, ROOT)
        self.objects = {FIRST: sane()}

    @dbus.service.method("org.freedesktop.DBus.ObjectManager", out_signature="a{oa{sa{sv}}}")
    def GetManagedObjects(self):
        return self.objects

    @dbus.service.signal("org.freedesktop.DBus.ObjectManager", signature="oa{sa{sv}}")
    def InterfacesAdded(self, path, interfaces):
        self.objects[path] = interfaces

    @dbus.service.signal("org.freedesktop.DBus.ObjectManager", signature="oas")
    def InterfacesRemoved(self, path, interfaces):
        self.objects.pop(path, None)

    def attack(self, line):
        word, _, count = line.partition(" ")
        first = self.first
        if word == "types":
            for interface, properties in wrong(sane()):
                first.PropertiesChanged(interface, dbus.Dictionary(properties, signature="sv"), [])
            first.cells = dbus.Array([7, 8], signature="i")
        elif word == "missing":
            self.InterfacesAdded(FIRST, {MODEM: dictionary()})
        elif word == "huge":
            first.PropertiesChanged(MODEM, dictionary(Model=HUGE, Manufacturer=HUGE, **{HUGE: HUGE}), [])
            self.InterfacesAdded(FIRST, {HUGE: dictionary(Model=HUGE)})
        elif word == "flood":
            for number in range(int(count)):
                first.PropertiesChanged(SIGNAL, dictionary(Lte=dictionary(rsrp=dbus.Double(-60 - number % 60))), [])
        elif word == "level":
            first.PropertiesChanged(SIGNAL, dictionary(Lte=dictionary(rsrp=dbus.Double(float(count)))), [])
        elif word == "crowd":
            for number in range(1, int(count) + 1):
                self.InterfacesAdded(f"{ROOT}/Modem/{number}", sane(f"Crowd {number}"))
        elif word == "gone":
            for path in [x for x in self.objects if x != FIRST]:
                self.InterfacesRemoved(path, [MODEM, SIGNAL])
        elif word == "sane":
            first.cells = dbus.Array([], signature="a{sv}")
            self.InterfacesRemoved(FIRST, [MODEM, SIGNAL])
            self.InterfacesAdded(FIRST, sane())


class Modem(dbus.service.Object):
    cells = dbus.Array([], signature="a{sv}")

    @dbus.service.method(MODEM, out_signature="v")
    def GetCellInfo(self):
        return self.cells

    @dbus.service.method("org.freedesktop.DBus.Properties", in_signature="s", out_signature="v")
    def GetAll(self, interface):
        return f"all of {interface}"

    @dbus.service.signal("org.freedesktop.DBus.Properties", signature="sa{sv}as")
    def PropertiesChanged(self, interface, changed, invalidated):
        pass


def main():
    with tempfile.TemporaryDirectory(prefix="hostile.") as folder:
        os.environ["WORLD"] = folder
        os.environ["DBUS_SYSTEM_BUS_ADDRESS"] = f"unix:path={folder}/bus.sock"
        bus = subprocess.Popen(["dbus-daemon", "--session", "--nofork", "--nopidfile", "--print-address",
                                f"--address=unix:path={folder}/bus.sock"], stdout=subprocess.PIPE)
        bus.stdout.readline()
        dbus.mainloop.glib.DBusGMainLoop(set_as_default=True)
        connection = dbus.SystemBus()
        name = dbus.service.BusName(MM, connection)
        manager = Manager(name)
        manager.first = Modem(connection, FIRST)
        os.mkfifo(f"{folder}/control")
        control = os.fdopen(os.open(f"{folder}/control", os.O_RDWR | os.O_NONBLOCK))

        def attack(*_):
            for line in control:
                manager.attack(line.strip())
            return True
        GLib.io_add_watch(control, GLib.IO_IN, attack)
        loop = GLib.MainLoop()
        command = subprocess.Popen(sys.argv[sys.argv.index("--") + 1:])
        GLib.child_watch_add(GLib.PRIORITY_DEFAULT, command.pid, lambda _pid, status: (
            setattr(command, "returncode", os.waitstatus_to_exitcode(status)), loop.quit()))
        loop.run()
        bus.terminate()
        bus.wait()
    sys.exit(command.returncode)


if __name__ == "__main__":
    main()
