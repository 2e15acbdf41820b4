#!/usr/bin/python3
"""A login manager for tests, on the bus that DBUS_SYSTEM_BUS_ADDRESS names. It prints a line when
it is there, when somebody keeps it from sleeping and when nobody does so any more. Its method
dorbo.Test.Sleep tells that the machine is about to sleep."""

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
    bus = dbus.SystemBus()
    name = dbus.service.BusName(NAME, bus)
    manager = Manager(bus, "/org/freedesktop/login1")
    session = Session(bus, SESSION)
    tell("ready")
    GLib.MainLoop().run()
    return name, manager, session


main()
