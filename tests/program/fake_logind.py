#!/usr/bin/python3
"""A login manager for tests, on the bus that DBUS_SYSTEM_BUS_ADDRESS names. It prints a line when
it is there, when somebody keeps it from sleeping, when somebody holds a session and when nobody
keeps it from sleeping any more. Its method dorbo.Test.Sleep tells that the machine is about to
sleep."""

import os

import dbus
import dbus.mainloop.glib
import dbus.service
from gi.repository import GLib

NAME = "org.freedesktop.login1"
MANAGER = NAME + ".Manager"
SESSION = "/session"
TEST = "dorbo.Test"


def tell(line):
    print(line, flush=True)


def tell_of_sessions():
    """A client gets the name of its session, then asks the bus who answers for it and holds it when
    that answer is there. No call to us shows this, so the bus is watched. What we send a client after
    it has asked reaches it after the answer."""
    bus = dbus.bus.BusConnection(os.environ["DBUS_SYSTEM_BUS_ADDRESS"])
    named = set()

    def see(_bus, message):
        client = message.get_sender()
        if message.get_member() in ("GetSession", "GetSessionByPID"):
            named.add(client)
        elif message.get_member() == "GetNameOwner" and client in named:
            named.remove(client)
            tell("session")

    bus.add_message_filter(see)
    calls = [f"type='method_call',member='{name}'"
             for name in ("GetSession", "GetSessionByPID", "GetNameOwner")]
    bus.call_blocking(dbus.BUS_DAEMON_NAME, dbus.BUS_DAEMON_PATH,
                      dbus.BUS_DAEMON_IFACE + ".Monitoring", "BecomeMonitor", "asu", (calls, 0))
    return bus


def awake_no_more(pipe, _condition):
    os.close(pipe)
    tell("released")
    return False


class Manager(dbus.service.Object):
    @dbus.service.method(MANAGER, in_signature="u", out_signature="o")
    def GetSessionByPID(self, _pid):
        return dbus.ObjectPath(SESSION)

    @dbus.service.method(MANAGER, in_signature="s", out_signature="o")
    def GetSession(self, _name):
        return dbus.ObjectPath(SESSION)

    @dbus.service.method(MANAGER, in_signature="ssss", out_signature="h")
    def Inhibit(self, _what, _who, _why, _mode):
        reading, writing = os.pipe()
        GLib.io_add_watch(reading, GLib.IO_HUP, awake_no_more)
        taken = dbus.types.UnixFd(writing)
        os.close(writing)
        tell("inhibited")
        return taken

    @dbus.service.signal(MANAGER, signature="b")
    def PrepareForSleep(self, before):
        pass

    @dbus.service.method(TEST, in_signature="", out_signature="")
    def Sleep(self):
        self.PrepareForSleep(True)


class Session(dbus.service.Object):
    @dbus.service.method(NAME + ".Session", in_signature="b", out_signature="")
    def SetIdleHint(self, _idle):
        pass

    @dbus.service.method(NAME + ".Session", in_signature="b", out_signature="")
    def SetLockedHint(self, _locked):
        pass

    @dbus.service.signal(NAME + ".Session", signature="")
    def Lock(self):
        pass


def main():
    dbus.mainloop.glib.DBusGMainLoop(set_as_default=True)
    watch = tell_of_sessions()
    bus = dbus.SystemBus()
    name = dbus.service.BusName(NAME, bus)
    manager = Manager(bus, "/org/freedesktop/login1")
    session = Session(bus, SESSION)
    tell("ready")
    GLib.MainLoop().run()
    return watch, name, manager, session


main()
