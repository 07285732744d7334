#!/usr/bin/python3
"""Stand-ins for the services that a device may have on its system bus, with a small fixed state each.

Usage: bus_services.py ADDRESS SERVICE...   (prints "ready"; services: nm, refusing-nm, supplicant, iwd, bluez, connman, resolved, broken)
"""
import sys

import dbus
import dbus.mainloop.glib
import dbusmock
from gi.repository import GLib

dbus.mainloop.glib.DBusGMainLoop(set_as_default=True)
kept = []


def service(name, path, interface, properties=None, manager=False):
    # A connection each: all of them want the root object.
    bus = dbus.bus.BusConnection(sys.argv[1])
    kept.append(dbus.service.BusName(name, bus, do_not_queue=True))
    main = dbusmock.DBusMockObject(kept[-1], path, interface, properties or {}, is_object_manager=manager)
    kept.append(main)
    return main


def text(value):
    return dbus.ByteArray(value)


def network_manager():
    nm, base = "org.freedesktop.NetworkManager", "/org/freedesktop/NetworkManager"
    main = service(nm, base, nm, {"WirelessEnabled": True, "WirelessHardwareEnabled": True})
    main.AddMethod(nm, "GetDeviceByIpIface", "s", "o",
                   "if args[0] == 'wlan7': raise dbus.exceptions.DBusException("
                   "'silent', name='org.freedesktop.DBus.Error.NoReply')\n"
                   "ret = dbus.ObjectPath('%s/Devices/' + {'wlan0': '1', 'wlan1': '2', 'wlan4': '4', 'wlan5': '5',"
                   " 'wlan6': '6', 'wlan8': '8', 'wlan11': '9'}[args[0]])" % base)
    device = nm + ".Device"
    main.AddObject(base + "/Devices/1", device, {
        "Managed": True, "ActiveConnection": dbus.ObjectPath(base + "/ActiveConnection/1"),
        "Dhcp4Config": dbus.ObjectPath(base + "/DHCP4Config/1"), "Dhcp6Config": dbus.ObjectPath(base + "/DHCP6Config/1"),
        "Ip4Config": dbus.ObjectPath(base + "/IP4Config/1"), "Ip6Config": dbus.ObjectPath(base + "/IP6Config/1"),
    }, [])
    dbusmock.get_object(base + "/Devices/1").AddMethod(
        device + ".Wireless", "RequestScan", "a{sv}", "", "")
    dbusmock.get_object(base + "/Devices/1").AddProperty(
        device + ".Wireless", "PermHwAddress", "02:00:00:00:0A:00")
    main.AddObject(base + "/Devices/2", device, {"Managed": False}, [])
    main.AddObject(base + "/Devices/4", device, {"Managed": True}, [])
    dbusmock.get_object(base + "/Devices/4").AddMethod(
        device + ".Wireless", "RequestScan", "a{sv}", "", "raise dbus.exceptions.DBusException("
        "'Not authorized', name='org.freedesktop.NetworkManager.Device.PermissionDenied')")
    main.AddObject(base + "/Devices/5", device, {
        "Managed": True, "ActiveConnection": dbus.ObjectPath(base + "/ActiveConnection/5"),
        "Dhcp4Config": dbus.ObjectPath(base + "/DHCP4Config/5")}, [])
    main.AddObject(base + "/ActiveConnection/5", nm + ".Connection.Active",
                   {"Connection": dbus.ObjectPath(base + "/Settings/5")}, [])
    main.AddObject(base + "/Devices/6", device, {"Managed": True, "ActiveConnection": dbus.ObjectPath("/")}, [])
    main.AddObject(base + "/Devices/8", device, {"Managed": True}, [])
    dbusmock.get_object(base + "/Devices/8").AddMethod(
        device + ".Wireless", "RequestScan", "a{sv}", "", "raise dbus.exceptions.DBusException("
        "'Scanning not allowed while already scanning', name='org.freedesktop.NetworkManager.Device.NotAllowed')")
    main.AddObject(base + "/Devices/9", device, {
        "Managed": True, "ActiveConnection": dbus.ObjectPath(base + "/ActiveConnection/1"),
        "Dhcp4Config": dbus.ObjectPath("/"), "Dhcp6Config": dbus.ObjectPath(base + "/DHCP6Config/1")}, [])
    main.AddObject(base + "/ActiveConnection/1", nm + ".Connection.Active",
                   {"Connection": dbus.ObjectPath(base + "/Settings/1")}, [])
    main.AddObject(base + "/DHCP4Config/1", nm + ".DHCP4Config", {"Options": dbus.Dictionary({
        "domain_name_servers": "192.168.1.1 192.168.1.2", "default_url": "https://p.example/api",
        "vendor_encapsulated_options": "EXAMPLE_METERED"}, signature="sv")}, [])
    main.AddObject(base + "/DHCP6Config/1", nm + ".DHCP6Config", {"Options": dbus.Dictionary({
        "dhcp6_v6_captive_portal": "https://p.example/six"}, signature="sv")}, [])
    main.AddObject(base + "/IP4Config/1", nm + ".IP4Config", {"NameserverData": dbus.Array([
        dbus.Dictionary({"address": "192.168.1.1"}, signature="sv")], signature="a{sv}")}, [])
    main.AddObject(base + "/IP6Config/1", nm + ".IP6Config", {"Nameservers": dbus.Array([
        text(bytes.fromhex("20010db8000000000000000000000053"))], signature="ay")}, [])

    settings, paths = nm + ".Settings", []

    def connection(number, sections):
        path = "%s/Settings/%d" % (base, number)
        paths.append(path)
        value = dbus.Dictionary({name: dbus.Dictionary(keys, signature="sv") for name, keys in sections.items()},
                                signature="sa{sv}")
        main.AddObject(path, settings + ".Connection", {}, [])
        target = dbusmock.get_object(path)
        target.connection_settings = value
        target.AddMethod(settings + ".Connection", "GetSettings", "", "a{sa{sv}}", "ret = self.connection_settings")

    connection(1, {"connection": {"type": "802-11-wireless", "timestamp": dbus.UInt64(1700000000)},
                   "802-11-wireless": {"ssid": text(b"Home \xff"), "seen-bssids": dbus.Array(
                       ["02:00:00:00:00:01", "02:00:00:00:00:02"], signature="s")},
                   "802-11-wireless-security": {"key-mgmt": "sae"},
                   "ipv4": {"method": "manual", "dns": dbus.Array([dbus.UInt32(0x09090909)], signature="u")},
                   "ipv6": {"method": "auto", "dns": dbus.Array(
                       [text(bytes.fromhex("262000fe000000000000000000000009"))], signature="ay")},
                   "proxy": {"method": dbus.Int32(1), "pac-url": "http://wpad/"}})
    connection(2, {"connection": {"type": "802-3-ethernet"}, "802-3-ethernet": {}})
    connection(3, {"connection": {"type": "802-11-wireless", "autoconnect": False, "interface-name": "wlan0"},
                   "802-11-wireless": {"ssid": text(b"Cellar"), "hidden": True}})
    connection(6, {"connection": {"type": "802-11-wireless", "interface-name": "wlan1"},
                   "802-11-wireless": {"ssid": text(b"Elsewhere")}})
    connection(7, {"connection": {"type": "802-11-wireless"},
                   "802-11-wireless": {"ssid": text(b"Stick"), "mac-address": text(b"\x02\0\0\0\x0b\0")}})
    connection(4, {"connection": {"type": "802-11-wireless"},
                   "802-11-wireless": {"ssid": text(b"Hotspot"), "mode": "ap"}})
    # One that belongs to somebody else.
    main.AddObject(base + "/Settings/5", settings + ".Connection", {}, [])
    dbusmock.get_object(base + "/Settings/5").AddMethod(
        settings + ".Connection", "GetSettings", "", "a{sa{sv}}", "raise dbus.exceptions.DBusException("
        "'not yours', name='org.freedesktop.NetworkManager.Settings.PermissionDenied')")
    main.AddObject(base + "/Settings", settings, {}, [])
    dbusmock.get_object(base + "/Settings").AddMethod(
        settings, "ListConnections", "", "ao",
        "ret = dbus.Array([dbus.ObjectPath(p) for p in %r] + [dbus.ObjectPath('%s/Settings/99')], signature='o')"
        % (paths, base))


def supplicant():
    name, base = "fi.w1.wpa_supplicant1", "/fi/w1/wpa_supplicant1"
    main = service(name, base, name)
    main.AddMethod(name, "GetInterface", "s", "o",
                   "if args[0] not in ('wlan0', 'wlan3'): raise dbus.exceptions.DBusException('no', "
                   "name='fi.w1.wpa_supplicant1.InterfaceUnknown')\n"
                   "ret = dbus.ObjectPath('%s/Interfaces/0')" % base)
    networks = [base + "/Interfaces/0/Networks/%d" % i for i in range(4)]
    main.AddObject(base + "/Interfaces/0", name + ".Interface", {"Networks": dbus.Array(
        [dbus.ObjectPath(each) for each in networks], signature="o")},
        [("Scan", "a{sv}", "", "")])
    for path, enabled, properties in (
            (networks[0], True, {"ssid": '"Home"', "key_mgmt": "WPA-PSK SAE", "proto": "WPA RSN", "mode": "0"}),
            (networks[2], False, {"ssid": '"Own"', "key_mgmt": "NONE", "mode": "2"}),
            (networks[3], True, {"ssid": '"Mesh"', "key_mgmt": "SAE", "mode": "5"}),
            (networks[1], False, {"ssid": "c3bf00", "key_mgmt": "NONE", "scan_ssid": "1", "wep_key0": "*"})):
        main.AddObject(path, name + ".Network", {
            "Enabled": enabled, "Properties": dbus.Dictionary(properties, signature="sv")}, [])


def iwd():
    name = "net.connman.iwd"
    main = service(name, "/", name + ".Test", manager=True)
    main.AddObject("/net/connman/iwd/0/3", name + ".Device", {"Name": "wlan0"}, [])
    main.AddObject("/net/connman/iwd/0/5", name + ".Device", {"Name": "wlan2"}, [])
    for device in ("3", "5"):
        dbusmock.get_object("/net/connman/iwd/0/" + device).AddMethod(name + ".Station", "Scan", "", "", "")
    main.AddObject("/net/connman/iwd/0/10", name + ".Device", {"Name": "wlan10"}, [])
    dbusmock.get_object("/net/connman/iwd/0/10").AddMethod(
        name + ".Station", "Scan", "", "", "raise dbus.exceptions.DBusException("
        "'Operation already in progress', name='net.connman.iwd.InProgress')")
    main.AddObject("/net/connman/iwd/a_psk", name + ".KnownNetwork", {
        "Name": "Home", "Type": "psk", "Hidden": False, "AutoConnect": True,
        "LastConnectedTime": "2023-11-14T22:13:20Z"}, [])
    main.AddObject("/net/connman/iwd/b_open", name + ".KnownNetwork", {
        "Name": "Cafe", "Type": "open", "Hidden": True, "AutoConnect": False}, [])


def bluez():
    name = "org.bluez"
    main = service(name, "/", name + ".Test", manager=True)
    main.AddObject("/org/bluez/hci0", name + ".Adapter1", {"Powered": True}, [])
    for number, paired, connected in ((1, True, True), (2, True, False), (3, False, False)):
        main.AddObject("/org/bluez/hci0/dev_%d" % number, name + ".Device1",
                       {"Paired": paired, "Connected": connected}, [])


def connman():
    name = "net.connman"
    main = service(name, "/", name + ".Manager")

    def entry(path, state, interface, **more):
        values = {"State": state, "Ethernet": dbus.Dictionary({"Interface": interface}, signature="sv")}
        values.update({key.replace("_", "."): value for key, value in more.items()})
        return dbus.Struct((dbus.ObjectPath("/net/connman/service/" + path), dbus.Dictionary(values, signature="sv")),
                           signature="oa{sv}")

    def method(value):
        return dbus.Dictionary({"Method": value}, signature="sv")

    main.connman_services = dbus.Array([
        entry("wifi_nearby", "idle", "wlan12", IPv4_Configuration=method("dhcp")),
        entry("wifi_home", "online", "wlan12", IPv4=method("auto"), IPv4_Configuration=method("dhcp"),
              IPv6_Configuration=method("off"),
              Nameservers=dbus.Array(["9.9.9.9", "bogus"]), Nameservers_Configuration=dbus.Array(["9.9.9.9"]),
              Proxy=method("auto"), Proxy_Configuration=method("manual")),
        entry("wifi_hall", "ready", "wlan13", IPv4_Configuration=method("manual"), IPv6=method("auto"),
              Nameservers=dbus.Array(["192.168.1.1", "2001:db8::53"]), Proxy=method("auto")),
        entry("wifi_odd", "ready", "wlan14", IPv4=method("fixed"), IPv6_Configuration=method("new")),
        entry("ethernet", "ready", "eth0", Nameservers=dbus.Array(["10.0.0.1", "192.168.1.1"]))],
        signature="(oa{sv})")
    main.AddMethod(name + ".Manager", "GetServices", "", "a(oa{sv})", "ret = self.connman_services")


def resolved():
    name = "org.freedesktop.resolve1"
    main = service(name, "/org/freedesktop/resolve1", name + ".Manager")
    main.AddProperty(name + ".Manager", "DNS", dbus.Array([
        dbus.Struct([dbus.Int32(0), dbus.Int32(2), text(b"\xcb\x00\x71\x0a")], signature="iiay"),
        dbus.Struct([dbus.Int32(2), dbus.Int32(2), text(b"\x0a\x09\x09\x01")], signature="iiay"),
        dbus.Struct([dbus.Int32(3), dbus.Int32(2), text(b"\xc0\xa8\x01\x01")], signature="iiay")], signature="(iiay)"))
    main.AddMethod(name + ".Manager", "GetLink", "i", "o", "ret = dbus.ObjectPath('/l/%d' % args[0])")
    main.AddObject("/l/3", name + ".Link", {"DNS": dbus.Array([
        dbus.Struct([dbus.Int32(2), text(b"\xc0\xa8\x01\x01")], signature="iay"),
        dbus.Struct([dbus.Int32(10), text(bytes(15) + b"\x01")], signature="iay"),
        dbus.Struct([dbus.Int32(2), text(b"\x01")], signature="iay")], signature="(iay)")}, [])


def broken():
    name = "org.example.broken"
    main = service(name, "/", name)
    main.AddMethod(name, "Deep", "", "v",
                   "v = dbus.String('x', variant_level=1)\nfor i in range(20): v = dbus.Array([v], signature='v')\nret = v")
    main.AddMethod(name, "Fail", "", "",
                   "raise dbus.exceptions.DBusException('not for you', name='org.freedesktop.DBus.Error.AccessDenied')")
    main.AddMethod(name, "Numbers", "", "ynqiuxtdba{us}",
                   "ret = (dbus.Byte(200), dbus.Int16(-5), dbus.UInt16(65535), dbus.Int32(-7), dbus.UInt32(8),"
                   " dbus.Int64(-9), dbus.UInt64(2**64 - 1), 0.5, True, dbus.Dictionary({7: 'seven'}, signature='us'))")
    main.AddMethod(name, "Sleep", "", "", "import time; time.sleep(3600)")


def refusing_network_manager():
    nm = "org.freedesktop.NetworkManager"

    class Refusing(dbus.service.Object):
        methods = {}  # dbusmock looks there first

        @dbus.service.method("org.freedesktop.DBus.Properties", in_signature="ssv")
        def Set(self, interface, name, value):
            raise dbus.exceptions.DBusException(
                "Not authorized to perform this operation", name=nm + ".PermissionDenied")

    bus = dbus.bus.BusConnection(sys.argv[1])
    kept.append(dbus.service.BusName(nm, bus, do_not_queue=True))
    kept.append(Refusing(kept[-1], "/org/freedesktop/NetworkManager"))


for each in sys.argv[2:]:
    {"nm": network_manager, "refusing-nm": refusing_network_manager, "supplicant": supplicant, "iwd": iwd, "bluez": bluez,
     "connman": connman, "resolved": resolved,
     "broken": broken}[each]()
print("ready", flush=True)
GLib.MainLoop().run()
